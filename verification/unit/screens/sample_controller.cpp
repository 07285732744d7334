#include "verification/unit/screens/sample_controller.h"

#include "platform/ui/identifiers.h"

namespace wp {

using ui::AlertAction;

std::shared_ptr<ui::Label> SampleController::addLabel(const char* identifier, const std::string& text) {
    auto label = std::make_shared<ui::Label>(ui::Rect{0, 0, 800, 100});
    label->setIdentifier(identifier);
    label->setText(text);
    view()->addSubview(label);
    return label;
}

void SampleController::buildViews() {
    title_ = addLabel(ui::identifiers::title, "Wi-Fi Diagnostics");
    description_ = addLabel(ui::identifiers::description,
                            "Choose the network to look at. What is measured stays on this device until you "
                            "hand it on.");
    status_ = addLabel(ui::identifiers::status, "");
    status_->setHidden(true);
    progress_ = std::make_shared<ui::ProgressView>();
    progress_->setIdentifier(ui::identifiers::progress);
    progress_->setHidden(true);
    view()->addSubview(progress_);
    table_ = std::make_shared<ui::SettingsTableView>(ui::Rect{1060, 162, 760, 918},
                                                     ui::SettingsTableView::Style::grouped);
    table_->setIdentifier(ui::identifiers::table);
    table_->setDataSource(this);
    table_->setDelegate(this);
    view()->addSubview(table_);
    table_->reloadData();
}

void SampleController::showProgress(int done, int whole) {
    isProgressShown_ = true;
    table_->setAllowsSelection(false);
    table_->setAlpha(0.5);
    table_->reloadData();
    description_->setHidden(true);
    progress_->setHidden(false);
    progress_->setStepCount(whole);
    progress_->setProgress(static_cast<float>(done) / static_cast<float>(whole));
    status_->setText("Looking at the network ...");
    status_->setHidden(false);
}

void SampleController::ask(const std::string& name) {
    auto alert = std::make_shared<ui::AlertController>(
        "Confirm", "Look at the network \u201C" + name + "\u201D?", ui::AlertController::Style::alert);
    alert->addAction(std::make_shared<AlertAction>("Yes", AlertAction::Style::standard,
                                                   [this, name](AlertAction&) { chosen = name; }));
    alert->addAction(std::make_shared<AlertAction>("No", AlertAction::Style::standard));
    presentAlert(alert, ui::Animated::yes);
}

void SampleController::askForName() {
    auto alert = std::make_shared<ui::AlertController>(std::nullopt, "Type the network's name.",
                                                       ui::AlertController::Style::alert);
    auto done = std::make_shared<AlertAction>("Done", AlertAction::Style::standard,
                                              [this, raw = alert.get()](AlertAction&) {
                                                  selected = raw->textFields().front()->text();
                                                  table_->reloadData();
                                              });
    done->setEnabled(false);
    alert->addTextField([raw = done.get()](ui::TextField& field) {
        field.setPlaceholder("Network name");
        field.addTarget([raw](ui::TextField& edited) { raw->setEnabled(!edited.text().empty()); });
    });
    alert->addAction(std::make_shared<AlertAction>("Cancel", AlertAction::Style::cancel));
    alert->addAction(done);
    presentAlert(alert, ui::Animated::yes);
}

int SampleController::tableViewNumberOfRowsInSection(ui::SettingsTableView&, int section) {
    if (section == 0) return selected.empty() ? 0 : 1;
    return section == 1 ? static_cast<int>(names.size()) : 1;
}

std::optional<std::string> SampleController::tableViewTitleForHeaderInSection(ui::SettingsTableView&,
                                                                              int section) {
    if (section == 0 && !selected.empty()) return "Selected network";
    if (section == 1) return "Choose a network";
    return std::nullopt;
}

std::shared_ptr<ui::TableViewCell> SampleController::tableViewCellForRowAtIndexPath(
    ui::SettingsTableView& table, ui::IndexPath path) {
    auto cell = table.dequeueReusableCell("cell", path);
    cell->setUserInteractionEnabled(path.section == 0 || !isProgressShown_);
    switch (path.section) {
        case 0:
            cell->setText(selected);
            break;
        case 1:
            cell->setText(names[static_cast<std::size_t>(path.row)]);
            break;
        case 2:
            cell->setText("Other ...");
            break;
        default:
            cell->setText("Refresh");
            break;
    }
    return cell;
}

double SampleController::tableViewHeightForHeaderInSection(ui::SettingsTableView&, int section) {
    return section < 2 ? ui::SettingsTableView::kAutomaticDimension
                       : ui::SettingsTableView::kSmallestPositive;
}

double SampleController::tableViewHeightForFooterInSection(ui::SettingsTableView&, int) {
    return ui::SettingsTableView::kSmallestPositive;
}

void SampleController::tableViewDidSelectRowAtIndexPath(ui::SettingsTableView&, ui::IndexPath path) {
    if (path.section == 0) ask(selected);
    if (path.section == 1) ask(names[static_cast<std::size_t>(path.row)]);
    if (path.section == 2) askForName();
}

std::optional<ui::IndexPath> SampleController::indexPathForPreferredFocusedViewInTableView(
    ui::SettingsTableView& table) {
    auto visible = table.indexPathsForVisibleRows();
    return visible.empty() ? std::nullopt : std::optional(visible.front());
}

}  // namespace wp
