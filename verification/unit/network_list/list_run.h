#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/ui/controls.h"
#include "platform/ui/identifiers.h"
#include "verification/unit/fakes/diagnostic_run.h"

namespace wp::fakes {

/// One access point as a scan hears it; without a name it is hidden.
struct AccessPoint {
    std::optional<std::string> ssid;
    std::optional<std::string> bssid;
    std::int64_t rssi = -60;
};

inline WiFiScanResultPointer scanEntry(const AccessPoint& point) {
    auto entry = std::make_shared<WiFiScanResult>();
    entry->ssid = point.ssid;
    entry->bssid = point.bssid;
    entry->rssi = point.rssi;
    return entry;
}

inline ArrayPointer scanArray(const std::vector<AccessPoint>& points) {
    Array array;
    for (const AccessPoint& point : points) array.push_back(scanEntry(point));
    return std::make_shared<const Array>(std::move(array));
}

/// The service's answer to the list's scan.
inline DiagnosticsTestResponse scanOutcome(const std::vector<AccessPoint>& points) {
    return outcome(points.empty(), true, Dictionary::make({{"ScanResults", scanArray(points)}}));
}

constexpr int kScanTest = 31;

/// A key's text in the fake table, "text of KEY", as its key; every other text as it is.
inline std::string keyOf(const std::string& text) {
    constexpr std::string_view kPrefix = "text of ";
    return text.starts_with(kPrefix) ? text.substr(kPrefix.size()) : text;
}

/// The table as text: sections are separated by " / ", a title stands in brackets, the row with the focus
/// after ">", a row that takes no touches after "~".
inline std::string picture(const ui::Screen& screen) {
    ui::SettingsTableView* table = screen.table();
    if (!table) return "no table";
    std::string text;
    for (int section = 0; section < table->numberOfSections(); ++section) {
        if (section > 0) text += " / ";
        if (table->titleForHeader(section)) text += "(" + keyOf(*table->titleForHeader(section)) + ")";
        for (int row = 0; row < table->numberOfRows(section); ++row) {
            ui::IndexPath path{row, section};
            if (row > 0 || table->titleForHeader(section)) text += row > 0 ? ", " : " ";
            if (screen.focusedIndexPath() == path) text += ">";
            if (!table->cellForRow(path)->isUserInteractionEnabled()) text += "~";
            text += keyOf(table->cellForRow(path)->text());
        }
    }
    return text;
}

/// The alert on top as text: "title | message | [field] | action, >focused, ~disabled".
inline std::string alertPicture(const ui::Screen& screen) {
    auto alert = screen.alert();
    if (!alert) return "no alert";
    std::string text = keyOf(alert->title().value_or("-")) + " | " + keyOf(alert->message().value_or("-"));
    for (const auto& field : alert->textFields()) text += " | [" + field->text() + "]";
    text += " | ";
    for (std::size_t i = 0; i < alert->actions().size(); ++i) {
        const ui::AlertAction& action = *alert->actions()[i];
        if (i > 0) text += ", ";
        if (alert->focus() == ui::AlertController::Focus{ui::AlertController::Focus::On::action, i})
            text += ">";
        if (!action.isEnabled()) text += "~";
        text += keyOf(action.title());
    }
    return text;
}

/// A run with the list on a device of fakes, one step at a time, with its screen.
struct ListRun : DiagnosticRun {
    explicit ListRun(std::optional<std::string> networkName = std::nullopt)
        : DiagnosticRun(NetworkList::shown, std::move(networkName)) {
        device.screen.setRootViewController(controller);
    }
    ~ListRun() { device.screen.setRootViewController(nullptr); }

    void hear(const std::vector<AccessPoint>& points) {
        device.service.setOutcome(kScanTest, scanOutcome(points));
    }
    void join(const std::string& ssid, const std::string& bssid) {
        device.service.setJoinedNetwork(ssid, bssid);
    }
    /// Starts the run and shows the first list.
    void showList() {
        controller->start();
        device.queues.runReady();
    }
    void press(std::initializer_list<ui::Key> keys) {
        for (ui::Key key : keys) device.screen.press(key);
    }
    /// Puts the focus on the row with the text and presses select; nothing where there is none.
    void choose(const std::string& text) {
        focus(text);
        device.screen.press(ui::Key::select);
    }
    void focus(const std::string& text) {
        ui::SettingsTableView& table = *device.screen.table();
        for (int section = 0; section < table.numberOfSections(); ++section)
            for (int row = 0; row < table.numberOfRows(section); ++row)
                if (keyOf(table.cellForRow({row, section})->text()) == text) table.focusRow({row, section});
    }
    void refresh() {
        choose("REFRESH");
        device.queues.runReady();
    }
    /// Types the name into the question for another network and takes it over.
    void typeOther(const std::string& name) {
        choose("OTHER");
        device.screen.typeText(name);
        press({ui::Key::down, ui::Key::down, ui::Key::select});
    }

    std::string list() { return picture(device.screen); }
    std::string alert() { return alertPicture(device.screen); }
    std::string selected() { return controller->inputs()->selectedNetworkName().value_or("(none)"); }
    int repairs() { return controller->tableView()->repairs(); }
};

}  // namespace wp::fakes
