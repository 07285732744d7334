#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/main_queue.h"
#include "platform/ui/controls.h"
#include "platform/ui/label.h"
#include "platform/ui/screen.h"
#include "platform/ui/table_view.h"

namespace wp {

/// A screen of the kind that the front ends mirror: texts, a bar and a list of four sections. A name asks for
/// confirmation, "Other" for a name, "Refresh" is a row of its own.
class SampleController final : public ui::ViewController,
                               private ui::TableViewDataSource,
                               private ui::TableViewDelegate {
  public:
    std::string selected = "Home";
    std::vector<std::string> names = {"Café", "Office"};
    std::string chosen;

    void buildViews();
    /// Shows the bar in place of the description, the list frozen.
    void showProgress(int done, int whole);
    void ask(const std::string& name);
    void askForName();

    ui::SettingsTableView& table() { return *table_; }
    ui::Label& description() { return *description_; }
    ui::Label& status() { return *status_; }
    ui::ProgressView& progress() { return *progress_; }

    std::string screenName() const override { return isProgressShown_ ? "progress" : "list"; }

  private:
    int numberOfSectionsInTableView(ui::SettingsTableView&) override { return 4; }
    int tableViewNumberOfRowsInSection(ui::SettingsTableView&, int section) override;
    std::optional<std::string> tableViewTitleForHeaderInSection(ui::SettingsTableView&, int section) override;
    std::shared_ptr<ui::TableViewCell> tableViewCellForRowAtIndexPath(ui::SettingsTableView& table,
                                                                      ui::IndexPath path) override;
    double tableViewHeightForHeaderInSection(ui::SettingsTableView&, int) override;
    double tableViewHeightForFooterInSection(ui::SettingsTableView&, int) override;
    void tableViewDidSelectRowAtIndexPath(ui::SettingsTableView&, ui::IndexPath path) override;
    bool tableViewCanFocusRowAtIndexPath(ui::SettingsTableView&, ui::IndexPath) override { return true; }
    std::optional<ui::IndexPath> indexPathForPreferredFocusedViewInTableView(ui::SettingsTableView&) override;

    std::shared_ptr<ui::Label> addLabel(const char* identifier, const std::string& text);

    std::shared_ptr<ui::SettingsTableView> table_;
    std::shared_ptr<ui::Label> title_;
    std::shared_ptr<ui::Label> description_;
    std::shared_ptr<ui::Label> status_;
    std::shared_ptr<ui::ProgressView> progress_;
    bool isProgressShown_ = false;
};

}  // namespace wp
