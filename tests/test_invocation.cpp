#include <string>

#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/localization.h"
#include "tests/test_row.h"

namespace wp {
namespace {

constexpr int kLogCategory = 3;
constexpr std::string_view kPrefix = "[ERROR] - Wi-Fi Profile: ";

bool isOpen(InfoGate gate, bool didPass) {
    switch (gate) {
        case InfoGate::never:
            return false;
        case InfoGate::always:
            return true;
        case InfoGate::passed:
            return didPass;
        case InfoGate::notPassed:
            return !didPass;
    }
    return false;
}

}  // namespace

void WiFiProfileViewController::runTest(const TestRow& row, Configuration configuration,
                                        Results resultsDictionary) const {
    DictionaryPointer info = infoOfTest(row, configuration, resultsDictionary);
    if (info) storeInfoValue(row, *info, resultsDictionary);
}

DictionaryPointer WiFiProfileViewController::infoOfTest(const TestRow& row, Configuration configuration,
                                                        Results resultsDictionary) const {
    DiagnosticsTestResultPointer result = resultOfTest(row, configuration);
    if (!result) return nullptr;
    resultsDictionary->setValue(row.resultKey, result->result);
    return infoOfResult(row, *result);
}

DiagnosticsTestResultPointer WiFiProfileViewController::resultOfTest(const TestRow& row,
                                                                     Configuration configuration) const {
    DiagnosticsTestResponse response =
        platform_.diagnosticsClient.runTestRequests({{row.testID, configuration}});
    if (response.error && response.error->code != 0) {
        logTestFailure(row, *response.error);
        return nullptr;
    }
    return testResultFromResults(response.results);
}

DiagnosticsTestResultPointer WiFiProfileViewController::testResultFromResults(
    const std::optional<DiagnosticsTestResults>& results) const {
    if (!results || results->empty()) {
        logNotFound("Results");
        return nullptr;
    }
    if (!results->front()) logNotFound("Test Result");
    return results->front();
}

DictionaryPointer WiFiProfileViewController::infoOfResult(const TestRow& row,
                                                          const DiagnosticsTestResult& result) const {
    if (!isOpen(row.gate, result.didPass)) return nullptr;
    if (!result.info) logNotFound("Info");
    return result.info;
}

void WiFiProfileViewController::storeInfoValue(const TestRow& row, const Dictionary& info,
                                               Results resultsDictionary) const {
    std::optional<Value> value = info.value(row.infoKey);
    if (value) {
        resultsDictionary->setValue(row.infoResultKey, std::move(*value));
    } else {
        logNotFound(row.missingName);
    }
}

ArrayPointer WiFiProfileViewController::infoArray(const TestRow& row, const Dictionary& info) const {
    std::optional<Value> value = info.value(row.infoKey);
    const ArrayPointer* array = value ? value->as<ArrayPointer>() : nullptr;
    if (array && *array) return *array;
    logNotFound(row.missingName);
    return nullptr;
}

void WiFiProfileViewController::logTestFailure(const TestRow& row, const Error& error) const {
    if (!platform_.log.isErrorEnabled(kLogCategory)) return;
    std::string format = std::string(kPrefix).append(row.failureName).append(" failed with error: %@");
    platform_.log.error(kLogCategory, formatted(format, error.text()));
}

void WiFiProfileViewController::logNotFound(std::string_view name) const {
    if (!platform_.log.isErrorEnabled(kLogCategory)) return;
    platform_.log.error(kLogCategory, std::string(kPrefix).append(name).append(" not found."));
}

}  // namespace wp
