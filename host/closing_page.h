#pragma once

#include <chrono>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "host/host_page.h"
#include "host/report/report.h"
#include "host/report/texts.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"

namespace wp::host {

/// How long the page stands by itself: some 120 words are read in half of that, and a television that nobody
/// looks at any more is free again soon.
inline constexpr std::chrono::seconds kClosingPageTime{60};

/// The last page of a run: the sentence on the whole, how the page is closed, and the most important findings with
/// what to do, each in one row. The select key closes it on any row. *Main*.
class ClosingPage final : public HostPage, private ui::TableViewDataSource, private ui::TableViewDelegate {
  public:
    /// The texts stay where they are as long as the page.
    ClosingPage(const Report& report, const Texts& texts);

    /// Tells the viewer how long the page still stands by itself.
    void showTimeLeft(std::chrono::seconds left);
    void close() { isClosed_ = true; }
    bool isClosed() const { return isClosed_; }

    std::string screenName() const override { return "closing"; }

  private:
    struct Section {
        std::optional<std::string> title;
        std::string text;
        std::string detail;
    };

    void addFinding(const ReportedFinding& finding);

    int numberOfSectionsInTableView(ui::SettingsTableView&) override;
    int tableViewNumberOfRowsInSection(ui::SettingsTableView&, int section) override;
    std::optional<std::string> tableViewTitleForHeaderInSection(ui::SettingsTableView&, int section) override;
    std::shared_ptr<ui::TableViewCell> tableViewCellForRowAtIndexPath(ui::SettingsTableView& table,
                                                                      ui::IndexPath path) override;
    double tableViewHeightForHeaderInSection(ui::SettingsTableView&, int section) override;
    double tableViewHeightForFooterInSection(ui::SettingsTableView&, int section) override;
    void tableViewDidSelectRowAtIndexPath(ui::SettingsTableView&, ui::IndexPath) override { close(); }
    bool tableViewCanFocusRowAtIndexPath(ui::SettingsTableView&, ui::IndexPath) override { return true; }
    std::optional<ui::IndexPath> indexPathForPreferredFocusedViewInTableView(
        ui::SettingsTableView&) override {
        return ui::IndexPath{0, 0};
    }

    const Texts& texts_;
    std::vector<Section> sections_;
    bool isClosed_ = false;
};

/// Shows the page until it is closed, the time is over, the run is broken off (whoever breaks it off wakes the
/// front end's queue), or nobody can press a key any more. Afterwards the screen is empty. *Main*.
void showClosingPage(const std::shared_ptr<ClosingPage>& page, ui::Screen& screen, ui::FrontEnd& frontEnd,
                     std::chrono::milliseconds time, const std::function<bool()>& isBrokenOff);

}  // namespace wp::host
