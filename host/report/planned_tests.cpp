#include "host/report/planned_tests.h"

#include <algorithm>
#include <string_view>

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

}  // namespace wp::host
