#include "host/progress_client.h"

#include <algorithm>

#include "host/report/catalogue.h"

namespace wp::host {
namespace {

bool isOptedOut(std::string_view name) {
    constexpr std::string_view suffix = "_nomap";
    if (name.size() < suffix.size()) return false;
    std::string_view end = name.substr(name.size() - suffix.size());
    return std::equal(end.begin(), end.end(), suffix.begin(), [](char left, char right) {
        return (left >= 'A' && left <= 'Z' ? left - 'A' + 'a' : left) == right;
    });
}

int testsOf(bool (*isWanted)(TestScope)) {
    auto wanted = [&](const CatalogueEntry& entry) { return isWanted(entry.scope); };
    return static_cast<int>(std::count_if(catalogue().begin(), catalogue().end(), wanted));
}

std::optional<std::string> networkNameOf(const DictionaryPointer& configuration) {
    std::optional<Value> value = configuration ? configuration->value("NetworkName") : std::nullopt;
    const std::string* name = value ? value->as<std::string>() : nullptr;
    return name ? std::optional(*name) : std::nullopt;
}

}  // namespace

int plannedTests(const std::optional<std::string>& joined, const std::optional<std::string>& selected) {
    int tests = testsOf([](TestScope scope) { return scope == TestScope::device; });
    if (joined && !isOptedOut(*joined))
        tests += testsOf([](TestScope scope) {
            return scope == TestScope::joined || scope == TestScope::joinedAndSelected;
        });
    if (selected && selected != joined && !isOptedOut(*selected))
        tests += testsOf([](TestScope scope) { return scope == TestScope::joinedAndSelected; });
    return tests;
}

DiagnosticsTestResponse ProgressClient::runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) {
    for (const DiagnosticsTestRequest& request : requests) tell(request);
    return client_.runTestRequests(requests);
}

DiagnosticsStatusResponse ProgressClient::queryStatus() {
    DiagnosticsStatusResponse response = client_.queryStatus();
    if (response.status) {
        std::lock_guard lock(mutex_);
        joined_ = response.status->ssid;
    }
    return response;
}

void ProgressClient::tell(const DiagnosticsTestRequest& request) {
    const CatalogueEntry* entry = catalogueEntry(request.testID);
    if (!entry || entry->scope == TestScope::list) return;
    TestStep step{request.testID, entry->name};
    {
        std::lock_guard lock(mutex_);
        // The device's tests come first, and their configuration names the selected network where there is one.
        if (begun_ == 0) planned_ = plannedTests(joined_, networkNameOf(request.configuration));
        step.number = ++begun_;
        step.count = std::max(planned_, begun_);
    }
    observer_(step);
}

}  // namespace wp::host
