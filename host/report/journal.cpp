#include "host/report/journal.h"

#include <algorithm>

#include "exchange/answer_book.h"
#include "host/report/catalogue.h"
#include "host/report/planned_tests.h"

namespace wp::host {

DiagnosticsTestResponse Journal::runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) {
    for (const DiagnosticsTestRequest& request : requests) tell(request);
    DiagnosticsTestResponse response = client_.runTestRequests(requests);
    // A response to several requests does not say which test it is about; the diagnostic asks for one.
    if (requests.size() != 1) return response;
    const DiagnosticsTestRequest& request = requests.front();
    std::lock_guard lock(mutex_);
    answers_.push_back(
        answerFrom(request.testID, networkOfRequest(request.testID, request.configuration), response));
    return response;
}

DiagnosticsStatusResponse Journal::queryStatus() {
    DiagnosticsStatusResponse response = client_.queryStatus();
    // What stands beside an error the diagnostic does not take for the joined network, either.
    const bool isTold = !response.error || response.error->code == 0;
    std::lock_guard lock(mutex_);
    statusTold_ = statusTold_.value_or(false) || isTold;
    if (isTold) joinedName_ = response.status ? response.status->ssid : std::nullopt;
    return response;
}

void Journal::tell(const DiagnosticsTestRequest& request) {
    const CatalogueEntry* entry = catalogueEntry(request.testID);
    if (!entry || entry->scope == TestScope::list) return;
    TestStep step{request.testID, entry->name};
    {
        std::lock_guard lock(mutex_);
        // The device's tests come first, and their configuration names the selected network where there is one.
        if (begun_ == 0) planned_ = plannedTests(joinedName_, networkNameIn(request.configuration));
        step.number = ++begun_;
        step.count = std::max(planned_, begun_);
    }
    observer_(step);
}

Evidence Journal::evidence(std::int64_t statusCode, const DictionaryPointer& data) const {
    std::lock_guard lock(mutex_);
    Evidence evidence = evidenceFrom(statusCode, data, answers_);
    if (joinedName_) evidence.joinedName = joinedName_;
    evidence.isStatusUntold = !statusTold_.value_or(true);
    return evidence;
}

}  // namespace wp::host
