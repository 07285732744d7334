#include "host/recorded_evidence.h"

#include <algorithm>

#include "exchange/answer_book.h"
#include "exchange/wire.h"
#include "host/preparation.h"
#include "host/run.h"

namespace wp::host {
namespace {

constexpr std::int64_t kUsualScanCacheAge = 60;
constexpr double kHighestScanCacheAge = 600;
constexpr std::size_t kLongestRequestedName = 32;
constexpr int kListsTest = 31;

constexpr int kNoManager = -2;
constexpr int kNoDevice = -3;
constexpr int kPowerDeclined = -4;
constexpr int kPowerOff = -5;

bool isListRun(const Recording& recording) {
    return std::ranges::any_of(recording.answers,
                               [](const RecordedAnswer& answer) { return answer.test == kListsTest; });
}

bool hasError(const DiagnosticsStatusResponse& status) {
    return status.error && status.error->code != 0;
}

/// The list asks for the status again and again, and the last that it was told goes for the tests. A run without
/// the list asks once.
void keepStatusOfTests(Recording& recording) {
    auto last = std::find_if_not(recording.status.rbegin(), recording.status.rend(), hasError);
    if (isListRun(recording) && last != recording.status.rend()) recording.status = {*last};
}

bool isRequestable(const Value& age) {
    auto isWithin = [](auto number) { return number >= 0 && number <= kHighestScanCacheAge; };
    if (const auto* number = age.as<std::int64_t>()) return isWithin(static_cast<double>(*number));
    if (const auto* number = age.as<std::uint64_t>()) return isWithin(static_cast<double>(*number));
    const auto* number = age.as<double>();
    return number && isWithin(*number);
}

/// The first age of the tests' answers that a request may ask for. Where there is none, answers of any age do.
Value takeScanCacheAge(Recording& recording) {
    for (const RecordedAnswer& answer : recording.answers)
        if (answer.test != kListsTest && answer.maxScanCacheAge && isRequestable(*answer.maxScanCacheAge))
            return *answer.maxScanCacheAge;
    for (RecordedAnswer& answer : recording.answers) answer.maxScanCacheAge.reset();
    return kUsualScanCacheAge;
}

std::size_t characters(std::string_view text) {
    return static_cast<std::size_t>(
        std::ranges::count_if(text, [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) != 0x80U; }));
}

/// A name that was typed, or spelled byte by byte, may be longer than a request takes. It is tested under another.
class SelectedName {
  public:
    /// The first network that the answers name, from here on under the name for the request.
    explicit SelectedName(Recording& recording) {
        auto named = std::ranges::find_if(
            recording.answers, [](const RecordedAnswer& answer) { return answer.networkName.has_value(); });
        if (named == recording.answers.end()) return;
        name_ = requested_ = named->networkName;
        if (characters(*name_) <= kLongestRequestedName) return;
        // As long as a request takes, and in bytes longer than any network's.
        requested_ = "";
        for (std::size_t i = 0; i < kLongestRequestedName; ++i) *requested_ += "\u2026";
        for (RecordedAnswer& answer : recording.answers)
            if (answer.networkName == name_) answer.networkName = requested_;
    }

    void putInto(Dictionary& parameters) const {
        if (requested_) parameters.setValue("networkName", *requested_);
    }
    void restoreIn(Evidence& evidence) const {
        if (!requested_) return;
        if (evidence.selectedName == requested_) evidence.selectedName = name_;
        for (Answer& answer : evidence.answers)
            if (answer.networkName == requested_) answer.networkName = name_;
    }

  private:
    std::optional<std::string> name_;
    std::optional<std::string> requested_;
};

bool hasTested(const Recording& recording) {
    return std::ranges::any_of(recording.answers,
                               [](const RecordedAnswer& answer) { return isDeviceTest(answer.test); });
}

/// When the power goes off all that is still asked is cancelled. Of a switch after the last answer nobody can tell whether
/// it ended the run: it goes for one that came later.
bool wasCutOffByPower(const Recording& recording) {
    bool wentOff =
        std::ranges::any_of(recording.events, [](const RecordedPowerEvent& event) { return !event.power; });
    bool isCancelled = std::ranges::any_of(recording.answers, [](const RecordedAnswer& answer) {
        return answer.response.error && answer.response.error->code == kCancelledCode;
    });
    return wentOff && (isCancelled || !hasTested(recording));
}

/// How a run with the list ended without having tested all that it was to test; nothing for any other.
std::optional<int> earlyEnd(const Recording& recording) {
    const WiFiDescription& wifi = recording.wifi;
    bool isUntested = !hasTested(recording);
    if (isUntested && (!wifi.radio || !wifi.client)) return kNoManager;
    if (isUntested && wifi.devices.empty()) return kNoDevice;
    if (wasCutOffByPower(recording)) return kPowerOff;
    // Where Wi-Fi was switched on, the list has asked for the status, and then scanned.
    bool wasLeftOff =
        !wifi.power && recording.events.empty() && recording.status.empty() && !isListRun(recording);
    return isUntested && wasLeftOff ? std::optional(kPowerDeclined) : std::nullopt;
}

/// The evidence of a run that ended before the first test.
Evidence untested(const Recording& recording) {
    Evidence evidence = evidenceFrom(0, Dictionary::make(), {});
    if (!recording.status.empty() && !hasError(recording.status.back()) && recording.status.back().status)
        evidence.joinedName = recording.status.back().status->ssid;
    return evidence;
}

Evidence replayed(const std::shared_ptr<const Recording>& recording, DictionaryPointer parameters,
                  const ReportOptions& options) {
    Preparation prepared;
    prepared.parameters = std::move(parameters);
    prepared.locale = localeChoice(options.locale);
    prepared.recording = recording;
    RunOptions run;
    run.extension = options.extension;
    return replayedEvidence(run, prepared);
}

/// The list's scans are no part of a run without the list, but what they heard is worth telling.
void addListScan(const Recording& recording, Evidence& evidence) {
    for (const RecordedAnswer& answer : recording.answers)
        if (answer.test == kListsTest)
            evidence.answers.push_back(answerFrom(kListsTest, std::nullopt, answer.response));
}

}  // namespace

Evidence evidenceFromRecording(Recording recording, const ReportOptions& options) {
    for (RecordedAnswer& answer : recording.answers) answer.delay = {};
    keepStatusOfTests(recording);
    SelectedName selected(recording);
    DictionaryPointer parameters = Dictionary::make();
    parameters->setValue("reprofileWithUI", false);
    parameters->setValue("maxScanCacheAge", takeScanCacheAge(recording));
    selected.putInto(*parameters);
    auto prepared = std::make_shared<const Recording>(std::move(recording));
    std::optional<int> code = earlyEnd(*prepared);
    Evidence evidence = code && !hasTested(*prepared) ? untested(*prepared)
                                                      : replayed(prepared, std::move(parameters), options);
    if (code) evidence.statusCode = *code;
    selected.restoreIn(evidence);
    addListScan(*prepared, evidence);
    return evidence;
}

}  // namespace wp::host
