#pragma once

#include "platform/value.h"

namespace wp {

/// The host's support for test automation. *Main*.
class TestAutomation {
  public:
    virtual ~TestAutomation() = default;

    virtual bool isEnabled() const = 0;
    /// Hands a configuration dictionary to the automation that drives the test.
    virtual void postConfiguration(DictionaryPointer configuration) = 0;
};

}  // namespace wp
