#pragma once

#include "host/host_page.h"
#include "host/report/journal.h"
#include "host/report/texts.h"

namespace wp::host {

/// Shows during a run without the list which test is running. The diagnostic has no screen for that: without the
/// list its own says what to choose. *Main*.
class RunningPage final : public HostPage {
  public:
    /// \param description what is going on, as the diagnostic says it
    RunningPage(const std::string& title, const std::string& description, const Texts& texts);

    void show(const TestStep& step);

    std::string screenName() const override { return "running"; }

  private:
    const Texts& texts_;
};

}  // namespace wp::host
