#pragma once

#include <string>
#include <vector>

#include "platform/main_queue.h"
#include "platform/ui/front_end.h"
#include "platform/ui/screen.h"

namespace wp::headless {

/// A front end without a picture: it lays the tree out (by the fixed table of text sizes) and keeps a mirror
/// of the table's rows from the changes that it is told, as a screen with a picture does. Nobody can press
/// keys on it but a script. *Main*.
class HeadlessScreen final : public ui::FrontEnd, private ui::ScreenObserver {
  public:
    /// Mirrors the screen from now to its end. Neither is kept alive.
    HeadlessScreen(ui::Screen& screen, MainQueue& queue);
    ~HeadlessScreen() override;
    HeadlessScreen(const HeadlessScreen&) = delete;
    HeadlessScreen& operator=(const HeadlessScreen&) = delete;

    bool runUntil(const std::function<bool()>& condition,
                  std::optional<Clock::time_point> end = std::nullopt) override;
    bool takesKeys() const override { return false; }

    /// Brings layout and mirror up to date.
    void draw();

    /// The texts of the rows by section, as the changes so far made them.
    const std::vector<std::vector<std::string>>& rows() const { return rows_; }
    /// How often the changes did not lead to the rows that the table then had. 0 in a healthy program.
    int faults() const { return faults_; }

  private:
    using Rows = std::vector<std::vector<std::string>>;

    void viewsChanged() override { isUpToDate_ = false; }
    void focusChanged() override { isUpToDate_ = false; }
    void tableReloaded(ui::SettingsTableView& table) override;
    void tableChanged(ui::SettingsTableView& table, const ui::TableChanges& changes) override;
    bool apply(const ui::SettingsTableView& table, const ui::TableChanges& changes);
    void adopt(const ui::SettingsTableView* table);
    static Rows rowsOf(const ui::SettingsTableView& table);

    ui::Screen& screen_;
    MainQueue& queue_;
    const ui::SettingsTableView* mirrored_ = nullptr;
    Rows rows_;
    int faults_ = 0;
    bool isUpToDate_ = false;
};

}  // namespace wp::headless
