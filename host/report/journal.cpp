#include "host/report/journal.h"

#include "exchange/answer_book.h"

namespace wp::host {

DiagnosticsTestResponse Journal::runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) {
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
    if (response.status) {
        std::lock_guard lock(mutex_);
        joinedName_ = response.status->ssid;
    }
    return response;
}

Evidence Journal::evidence(std::int64_t statusCode, const DictionaryPointer& data) const {
    std::lock_guard lock(mutex_);
    Evidence evidence = evidenceFrom(statusCode, data, answers_);
    if (joinedName_) evidence.joinedName = joinedName_;
    return evidence;
}

}  // namespace wp::host
