#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "lifecycle/wifi_profile_view_controller.h"

namespace wp::rows {

using Controller = WiFiProfileViewController;
using DeviceOperation = void (Controller::*)();
using NetworkOperation = void (Controller::*)(const DictionaryPointer&, const DictionaryPointer&);

enum class Gate { never, always, passed, notPassed };

/// What one operation of the catalogue must do, written down a second time and on its own.
struct Row {
    const char* name;
    DeviceOperation deviceOperation;  // one of the two
    NetworkOperation networkOperation;
    int testID;
    const char* resultKey;
    Gate gate;
    const char* infoKey;
    const char* infoResultKey;
    const char* missingLine;
    const char* failureLine;  // up to the error
};

/// The device's tests, in the order of their phase.
const std::vector<Row>& deviceRows();
/// The network's tests, in the order of their phase; the one that only the network list runs is the last.
const std::vector<Row>& networkRows();
std::vector<Row> allRows();

/// Something of the kind that the service delivers under the row's information key.
Value sampleInformation(const Row& row, const char* text = "as delivered");

}  // namespace wp::rows
