#include "host/report/comparison.h"

#include <algorithm>
#include <optional>

#include "host/report/causes.h"
#include "host/report/checks.h"
#include "host/report/measured.h"
#include "host/report/report.h"

namespace wp::host {
namespace {

using Kind = ReportedChange::Kind;

/// The same test of both runs.
struct Pair {
    bool wasFinding, isFinding;
    std::string valueBefore, valueNow;
};

std::optional<Kind> kindOf(const Pair& pair) {
    if (pair.wasFinding != pair.isFinding) return pair.isFinding ? Kind::appeared : Kind::gone;
    bool isOther = pair.isFinding && pair.valueBefore != pair.valueNow;
    return isOther ? std::optional(Kind::value) : std::nullopt;
}

/// Whether the report of a run with these causes tells the check as a finding, not as harmless.
bool isTold(const Check& check, const std::vector<Cause>& causes) {
    return check.isFinding() && std::ranges::none_of(causes, [&](const Cause& cause) {
               return cause.doer == Doer::nobody && cause.testID == check.test->testID &&
                      cause.part == check.part;
           });
}

std::string sentenceOf(Kind kind, int testID, const Texts& texts) {
    constexpr const char* kKeys[] = {"CHANGE_APPEARED", "CHANGE_GONE", "CHANGE_VALUE"};
    return texts.text(kKeys[static_cast<std::size_t>(kind)],
                      {{"what", texts.text(testKey(testID, "FOUND"))}});
}

/// Goes through the tests of both runs.
class Comparer {
  public:
    Comparer(const Evidence& earlier, const Evidence& evidence, const Texts& texts)
        : earlier_(earlier), evidence_(evidence), texts_(texts), before_(earlier), now_(evidence) {}

    Comparison compare() {
        noteOther("CHANGE_JOINED", earlier_.joinedName, evidence_.joinedName);
        noteOther("CHANGE_SELECTED", earlier_.selectedName, evidence_.selectedName);
        for (Part part : {Part::device, Part::joined, Part::selected}) noteUntold(part);
        for (const Check& check : now_.all())
            if (const Check* same = before_.find(check.test->testID, check.part)) add(*same, check);
        std::ranges::stable_sort(comparison_.changes, {}, &ReportedChange::kind);
        return std::move(comparison_);
    }

  private:
    void noteOther(const char* key, const std::optional<std::string>& before,
                   const std::optional<std::string>& now) {
        if (!before || !now || before == now) return;
        comparison_.notes.push_back(
            texts_.text(key, {{"before", networkText(before, texts_)}, {"now", networkText(now, texts_)}}));
    }

    void noteUntold(Part part) {
        if (!wasTested(earlier_, part)) return;
        if (!wasTested(evidence_, part)) {
            comparison_.notes.push_back(
                texts_.text("CHANGE_UNTESTED", {{"part", partText(earlier_, part, texts_)}}));
            return;
        }
        std::vector<std::string> tests;
        for (const Check& check : now_.all()) {
            const Check* same =
                check.part == part && !check.verdict ? before_.find(check.test->testID, part) : nullptr;
            if (same && same->verdict) tests.push_back(texts_.text(testKey(check.test->testID, "NAME")));
        }
        if (tests.empty()) return;
        comparison_.notes.push_back(texts_.text(
            "CHANGE_UNTOLD", {{"part", partText(evidence_, part, texts_)}, {"tests", texts_.list(tests)}}));
    }

    void add(const Check& earlier, const Check& now) {
        if (!earlier.verdict || !now.verdict) return;
        const Pair pair{isTold(earlier, causesBefore_), isTold(now, causesNow_),
                        measuredText(earlier_, earlier, texts_), measuredText(evidence_, now, texts_)};
        const std::optional<Kind> kind = kindOf(pair);
        if (!kind) return;
        const int testID = now.test->testID;
        comparison_.changes.push_back({*kind, now.part, testID, sentenceOf(*kind, testID, texts_),
                                       partText(evidence_, now.part, texts_), pair.valueBefore,
                                       pair.valueNow});
    }

    const Evidence& earlier_;
    const Evidence& evidence_;
    const Texts& texts_;
    const Checks before_, now_;
    const std::vector<Cause> causesBefore_ = causesOf(earlier_, before_),
                             causesNow_ = causesOf(evidence_, now_);
    Comparison comparison_;
};

}  // namespace

Comparison compared(const Evidence& earlier, const Evidence& evidence, const Texts& texts) {
    return Comparer(earlier, evidence, texts).compare();
}

}  // namespace wp::host
