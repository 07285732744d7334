#include "exchange/request_list.h"

namespace wp {

DiagnosticsTestResponse answerInTurn(
    const std::vector<DiagnosticsTestRequest>& requests,
    const std::function<DiagnosticsTestResponse(const DiagnosticsTestRequest&)>& answer) {
    if (requests.size() == 1) return answer(requests.front());
    DiagnosticsTestResponse joined;
    if (requests.empty()) joined.results.emplace();
    for (const DiagnosticsTestRequest& request : requests) {
        DiagnosticsTestResponse one = answer(request);
        if (one.results) {
            if (!joined.results) joined.results.emplace();
            joined.results->insert(joined.results->end(), one.results->begin(), one.results->end());
        }
        if (one.error) joined.error = std::move(one.error);
        if (joined.error && joined.error->code != 0) break;
    }
    return joined;
}

}  // namespace wp
