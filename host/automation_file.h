#pragma once

#include <mutex>
#include <optional>

#include "host/output_file.h"
#include "platform/test_automation.h"

namespace wp::host {

/// Test automation whose postings go to a file as JSON, in the form of the result document; without a file
/// they are only taken. *Main*.
class AutomationFile final : public TestAutomation {
  public:
    AutomationFile(bool isEnabled, std::optional<OutputFile> file)
        : isEnabled_(isEnabled), file_(std::move(file)) {}

    bool isEnabled() const override { return isEnabled_; }
    /// Keeps the configuration as it is at this moment.
    void postConfiguration(DictionaryPointer configuration) override;

    /// Writes what was posted; without a posting there is no file. Throws `Exit` (status 1) on failure.
    void write() const;

  private:
    bool isEnabled_;
    std::optional<OutputFile> file_;
    std::string posted_;
};

}  // namespace wp::host
