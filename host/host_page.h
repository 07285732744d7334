#pragma once

#include <memory>
#include <string>

#include "platform/ui/controls.h"
#include "platform/ui/label.h"
#include "platform/ui/table_view.h"
#include "platform/ui/view_controller.h"

namespace wp::host {

/// A screen of the host's own, in the looks of the diagnostic's: a title, and in one column a picture, a text, a
/// bar and a line below it. *Main*.
class HostPage : public ui::ViewController {
  protected:
    /// Where the column stands, in points.
    struct Column {
        double leading = 0;
        double width = 0;
    };

    HostPage(const std::string& title, const std::string& description, Column column);

    ui::ProgressView& progress() const { return *progress_; }
    ui::Label& status() const { return *status_; }
    /// A table at the right edge, below the title. It asks whoever it is told to ask.
    ui::SettingsTableView& addTable(double width);

  private:
    void buildTitle(ui::View& root, const std::string& title);
    void buildColumn(ui::View& root, const std::string& description, Column column);

    std::shared_ptr<ui::ProgressView> progress_;
    std::shared_ptr<ui::Label> status_;
};

}  // namespace wp::host
