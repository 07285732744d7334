#pragma once

#include <string_view>

namespace wp {

/// When a test's information dictionary is read.
enum class InfoGate {
    never,      ///< the test has no information value
    always,     ///< whatever the outcome
    passed,     ///< only when the test passed
    notPassed,  ///< only when it did not
};

/// What makes one numbered test different from the next.
struct TestRow {
    int testID;
    std::string_view resultKey;      ///< where the test's verdict goes
    InfoGate gate;                   ///< when the information is read
    std::string_view infoKey;        ///< what is read from it
    std::string_view infoResultKey;  ///< where that goes
    std::string_view missingName;    ///< what the log calls it when it is not there
    std::string_view failureName;    ///< what the log calls the test when the service reports an error
};

}  // namespace wp
