#include "host/report/checks.h"

namespace wp::host {

bool Check::isFinding() const {
    if (!verdict || test->foundWhen == FoundWhen::never) return false;
    return *verdict == (test->foundWhen == FoundWhen::isTrue);
}

bool Check::isUntold() const {
    // The list's test is made only with the list, and what it answers may have come before the result's.
    if (test->scope == TestScope::list) return !verdict && answer && answer->error;
    return !verdict;
}

Checks::Checks(const Evidence& evidence) {
    for (Part part : {Part::device, Part::joined, Part::selected}) {
        bool tested = wasTested(evidence, part);
        for (const CatalogueEntry& test : catalogue()) {
            if (!concerns(test, part)) continue;
            Check check{&test, part, verdictOf(evidence, part, test), answerTo(evidence, part, test.testID)};
            bool isListsOwn = test.scope == TestScope::list;
            if ((tested && !isListsOwn) || check.verdict || check.answer) all_.push_back(check);
        }
    }
}

const Check* Checks::find(int testID, Part part) const {
    for (const Check& check : all_)
        if (check.test->testID == testID && check.part == part) return &check;
    return nullptr;
}

bool Checks::is(bool verdict, int testID, Part part) const {
    const Check* check = find(testID, part);
    return check && check->verdict == verdict;
}

}  // namespace wp::host
