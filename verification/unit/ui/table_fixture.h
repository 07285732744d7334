#pragma once

#include <algorithm>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/ui/identifiers.h"
#include "platform/ui/screen.h"

namespace wp::ui::testing {

using Rows = std::vector<std::string>;

/// "a b|c": two sections, the first with the rows "a" and "b".
inline std::vector<Rows> sectionsOf(const std::string& text) {
    std::vector<Rows> sections(1);
    for (std::size_t begin = 0; begin < text.size();) {
        std::size_t end = std::min(text.find_first_of(" |", begin), text.size());
        if (end > begin) sections.back().push_back(text.substr(begin, end - begin));
        if (end < text.size() && text[end] == '|') sections.emplace_back();
        begin = end + 1;
    }
    return sections;
}

/// A data source and delegate whose rows the test sets.
struct FakeTable final : TableViewDataSource, TableViewDelegate {
    std::vector<Rows> sections;
    std::vector<std::optional<std::string>> titles;
    std::vector<std::string> disabled;
    std::vector<std::string> unfocusable;
    std::optional<IndexPath> preferred;
    std::vector<IndexPath> chosen;
    int cellsAsked = 0;

    int numberOfSectionsInTableView(SettingsTableView&) override { return static_cast<int>(sections.size()); }
    int tableViewNumberOfRowsInSection(SettingsTableView&, int section) override {
        return static_cast<int>(sections[section].size());
    }
    std::optional<std::string> tableViewTitleForHeaderInSection(SettingsTableView&, int section) override {
        return section < static_cast<int>(titles.size()) ? titles[section] : std::nullopt;
    }
    std::shared_ptr<TableViewCell> tableViewCellForRowAtIndexPath(SettingsTableView& table,
                                                                  IndexPath path) override {
        ++cellsAsked;
        auto cell = table.dequeueReusableCell("cell", path);
        cell->setText(sections[path.section][path.row]);
        cell->setUserInteractionEnabled(!isIn(disabled, cell->text()));
        return cell;
    }
    double tableViewHeightForHeaderInSection(SettingsTableView&, int) override {
        return SettingsTableView::kAutomaticDimension;
    }
    double tableViewHeightForFooterInSection(SettingsTableView&, int) override {
        return SettingsTableView::kSmallestPositive;
    }
    void tableViewDidSelectRowAtIndexPath(SettingsTableView& table, IndexPath path) override {
        chosen.push_back(path);
        table.deselectRow(path, Animated::yes);
    }
    bool tableViewCanFocusRowAtIndexPath(SettingsTableView&, IndexPath path) override {
        return !isIn(unfocusable, sections[path.section][path.row]);
    }
    std::optional<IndexPath> indexPathForPreferredFocusedViewInTableView(SettingsTableView&) override {
        return preferred;
    }

  private:
    static bool isIn(const std::vector<std::string>& names, const std::string& name) {
        return std::find(names.begin(), names.end(), name) != names.end();
    }
};

/// A front end that keeps what it is told.
struct RecordingObserver final : ScreenObserver {
    std::vector<TableChanges> changes;
    int reloads = 0;
    int alertsPresented = 0;
    int alertsDismissed = 0;
    int alertChanges = 0;
    int focusChanges = 0;
    int viewChanges = 0;
    bool moving = false;

    void viewsChanged() override { ++viewChanges; }
    void tableReloaded(SettingsTableView&) override { ++reloads; }
    void tableChanged(SettingsTableView&, const TableChanges& change) override { changes.push_back(change); }
    void focusChanged() override { ++focusChanges; }
    void alertPresented(AlertController&, Animated) override { ++alertsPresented; }
    void alertChanged(AlertController&) override { ++alertChanges; }
    void alertDismissed(AlertController&) override { ++alertsDismissed; }
    bool isAnimating() const override { return moving; }
};

struct FakeController final : ViewController {
    bool accepts = true;
    bool acceptsInput() const override { return accepts; }
    std::string screenName() const override { return "list"; }
};

/// A screen that shows one table of the test's rows.
struct TableOnScreen {
    explicit TableOnScreen(const std::string& sections) : TableOnScreen(sectionsOf(sections)) {}
    explicit TableOnScreen(std::vector<Rows> sections) {
        data.sections = std::move(sections);
        table->setIdentifier(identifiers::table);
        table->setDelegate(&data);
        table->setDataSource(&data);
        auto root = std::make_shared<View>();
        root->addSubview(table);
        controller->setView(root);
        screen.setRootViewController(controller);
        screen.setObserver(&observer);
        controller->setNeedsFocusUpdate();
        controller->updateFocusIfNeeded();
    }
    ~TableOnScreen() { screen.setObserver(nullptr); }

    /// The rows that the table shows now, section by section.
    std::vector<Rows> shown() const {
        std::vector<Rows> all(table->numberOfSections());
        for (int section = 0; section < table->numberOfSections(); ++section)
            for (int row = 0; row < table->numberOfRows(section); ++row)
                all[section].push_back(table->cellForRow({row, section})->text());
        return all;
    }

    /// The text of the row with the focus; empty when none has it.
    std::string focusedText() const {
        auto path = table->lastFocusedIndexPath();
        return path ? table->cellForRow(*path)->text() : "";
    }

    void moveFocusTo(IndexPath path) {
        screen.press(Key::up);  // from now on a key was pressed
        table->focusRow(path);
    }

    FakeTable data;
    RecordingObserver observer;
    std::vector<std::string> notes;
    Screen screen{[this](std::string_view line) { notes.emplace_back(line); }};
    std::shared_ptr<FakeController> controller = std::make_shared<FakeController>();
    std::shared_ptr<SettingsTableView> table =
        std::make_shared<SettingsTableView>(Rect{0, 0, 760, 918}, SettingsTableView::Style::grouped);
};

}  // namespace wp::ui::testing
