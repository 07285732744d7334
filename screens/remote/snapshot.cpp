#include "screens/remote/snapshot.h"

#include "platform/json_writer.h"
#include "platform/ui/controls.h"
#include "platform/ui/identifiers.h"
#include "platform/ui/label.h"
#include "platform/value.h"

namespace wp::remote {
namespace {

Value textOrNull(const std::optional<std::string>& text) {
    return text ? Value(*text) : Value();
}

Value labelText(const ui::Screen& screen, const char* identifier) {
    const auto* label = screen.viewAs<ui::Label>(identifier);
    return label && !label->isHidden() ? Value(label->text()) : Value();
}

Value progressOf(const ui::Screen& screen) {
    const auto* bar = screen.viewAs<ui::ProgressView>(ui::identifiers::progress);
    return bar && !bar->isHidden() ? Value(shortestDecimal(bar->progress())) : Value();
}

Value rowOf(const ui::Screen& screen, const ui::SettingsTableView& table, ui::IndexPath path) {
    const ui::TableViewCell& cell = *table.cellForRow(path);
    return Dictionary::make({
        {"enabled", cell.isUserInteractionEnabled()},
        {"focused", screen.focusedIndexPath() == path},
        {"text", cell.text()},
    });
}

Value sectionOf(const ui::Screen& screen, const ui::SettingsTableView& table, int section) {
    Array rows;
    for (int row = 0; row < table.numberOfRows(section); ++row)
        rows.push_back(rowOf(screen, table, {row, section}));
    return Dictionary::make({
        {"header", textOrNull(table.titleForHeader(section))},
        {"rows", std::move(rows)},
    });
}

Value tableOf(const ui::Screen& screen) {
    const ui::SettingsTableView* table = screen.table();
    if (!table) return {};
    Array sections;
    for (int section = 0; section < table->numberOfSections(); ++section)
        sections.push_back(sectionOf(screen, *table, section));
    return Dictionary::make({
        {"alpha", table->alpha()},
        {"sections", std::move(sections)},
        {"selectionEnabled", table->allowsSelection()},
    });
}

Value actionsOf(const ui::AlertController& alert) {
    using Focus = ui::AlertController::Focus;
    Array actions;
    for (std::size_t index = 0; index < alert.actions().size(); ++index) {
        const ui::AlertAction& action = *alert.actions()[index];
        actions.push_back(Dictionary::make({
            {"enabled", action.isEnabled()},
            {"focused", alert.focus() == Focus{Focus::On::action, index}},
            {"style", action.style() == ui::AlertAction::Style::cancel ? "cancel" : "default"},
            {"title", action.title()},
        }));
    }
    return actions;
}

Value fieldOf(const ui::AlertController& alert) {
    if (alert.textFields().empty()) return {};
    const ui::TextField& field = *alert.textFields().front();
    return Dictionary::make({{"placeholder", field.placeholder()}, {"text", field.text()}});
}

Value alertOf(const ui::Screen& screen) {
    auto alert = screen.alert();
    if (!alert) return {};
    return Dictionary::make({
        {"actions", actionsOf(*alert)},
        {"message", textOrNull(alert->message())},
        {"textField", fieldOf(*alert)},
        {"title", textOrNull(alert->title())},
    });
}

}  // namespace

std::string snapshot(ui::Screen& screen) {
    screen.layoutIfNeeded();
    Value object = Dictionary::make({
        {"alert", alertOf(screen)},
        {"description", labelText(screen, ui::identifiers::description)},
        {"progress", progressOf(screen)},
        {"screen", screen.screenName()},
        {"status", labelText(screen, ui::identifiers::status)},
        {"table", tableOf(screen)},
        {"title", labelText(screen, ui::identifiers::title)},
    });
    return jsonText(object, JSONStyle::compact);
}

}  // namespace wp::remote
