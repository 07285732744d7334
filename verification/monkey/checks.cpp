#include "verification/monkey/checks.h"

#include <set>

#include "network_list/scan_list.h"
#include "platform/ui/identifiers.h"

namespace wp::monkey {
namespace {

void require(bool holds, const std::string& what) {
    if (!holds) throw Broken(what);
}

void requireText(const ui::SettingsTableView& table, ui::IndexPath path, const std::string& text) {
    std::string shown = table.cellForRow(path)->text();
    require(shown == text, "row " + std::to_string(path.row) + " of section " + std::to_string(path.section) +
                               " shows \"" + shown + "\" for \"" + text + "\"");
}

/// What the keys reach, as text: it changes when a key is answered.
std::string focus(const ui::Screen& screen) {
    if (auto alert = screen.alert()) {
        return "alert " + std::to_string(static_cast<int>(alert->focus().on)) + " " +
               std::to_string(alert->focus().index);
    }
    auto path = screen.focusedIndexPath();
    return path ? std::to_string(path->section) + " " + std::to_string(path->row) : "nothing";
}

}  // namespace

void checkTable(const ui::Screen& screen, const WiFiProfileViewController& controller) {
    ui::SettingsTableView* table = screen.table();
    if (!table) return;
    require(table->numberOfSections() == 4, "the table has no four sections");
    std::optional<std::string> selected = controller.inputs()->selectedNetworkName();
    require(table->numberOfRows(0) == (selected ? 1 : 0),
            "the selected network has a row too many or too few");
    if (selected) requireText(*table, {0, 0}, *selected);
    const NetworkArray& networks = controller.filteredWiFiScanResults();
    require(table->numberOfRows(1) == static_cast<int>(networks.size()),
            "networks are shown that are not listed");
    for (std::size_t row = 0; row < networks.size(); ++row)
        requireText(*table, {static_cast<int>(row), 1}, *networks[row]->ssid);
    auto focused = table->lastFocusedIndexPath();
    require(focused && table->hasRow(*focused), "no row has the focus");
    require(screen.layoutReport().conflicts.empty(), "the layout has a conflict");
}

void checkCalm(const ui::Screen& screen, const WiFiProfileViewController& controller) {
    const ui::SettingsTableView* table = screen.table();
    if (!table) return;
    require(table->repairs() == 0, "the table repaired itself");
    std::optional<std::string> selected = controller.inputs()->selectedNetworkName();
    require(!selected || !controller.filteredNetworks().contains(*selected),
            "the selected network can be chosen again");
    std::set<std::string> names;
    for (const auto& network : controller.filteredWiFiScanResults())
        require(names.insert(*network->ssid).second, "a network stands there twice");
}

void checkOutcome(ui::Screen& screen, WiFiProfileViewController& controller) {
    if (controller.isFinished()) {
        static const std::set<std::int64_t> kCodes = {0, -2, -3, -4, -5, -6, -7};
        auto code = controller.result().statusCode();
        require(code && kCodes.count(*code), "the run is over without one of its status codes");
        std::string before = focus(screen);
        for (ui::Key key : {ui::Key::down, ui::Key::up, ui::Key::select}) screen.press(key);
        require(focus(screen) == before, "a key reached the diagnostic after its end");
        return;
    }
    require(!controller.result().statusCode(), "the run has a status code and goes on");
    std::string before = focus(screen);
    screen.press(ui::Key::down);
    std::string below = focus(screen);
    screen.press(ui::Key::up);
    require(below != before || focus(screen) != before, "the screen answers no key");
}

}  // namespace wp::monkey
