#include "lifecycle/wifi_profile_view_controller.h"
#include "platform/localization.h"
#include "platform/ui/identifiers.h"

namespace wp {
namespace {

constexpr double kAlphaOfDimmedTable = 0.5;

}  // namespace

void WiFiProfileViewController::showProgress() {
    progressScreenVisible_ = true;
    enableTableViewSelection(false);
    scrollToSelectedNetwork();
    setNeedsFocusUpdate();
    updateFocusIfNeeded();
    // Without the list the tests begin before there are views; they then start as on the list's screen.
    if (!tableView_) return;
    tableView_->reloadData();
    tableView_->setAlpha(kAlphaOfDimmedTable);
    descriptionLabel_->setHidden(true);
    progressView_->setHidden(false);
    mainLabel_->setText(platform_.localization.localizedString("PROGRESS_TEXT"));
    mainLabel_->setHidden(false);
}

void WiFiProfileViewController::updateProgress() {
    ++completedTests_;
    platform_.mainQueue.async([self = self()] {
        // Deliberate: the counters as they are now, so that the bar of several updates shows the newest.
        auto completed = static_cast<float>(self->completedTests_.load());
        auto total = static_cast<float>(self->totalTests_.load());
        if (!self->progressView_) return;
        self->progressView_->setStepCount(self->totalTests_);
        self->progressView_->setProgress(completed / total);
    });
}

void WiFiProfileViewController::displayProgressScreen() {
    constexpr ui::Priority kLabelHugging = 251;
    progressScreenVisible_ = true;
    removeNavigationBarButtons();
    if (tableView_) tableView_->removeFromSuperview();

    mainLabel_ = std::make_shared<ui::Label>();
    mainLabel_->setIdentifier(ui::identifiers::status);
    mainLabel_->setOpaque(false);
    mainLabel_->setContentMode(ui::ContentMode::left);
    mainLabel_->setContentHuggingPriority(ui::Axis::horizontal, kLabelHugging);
    mainLabel_->setContentHuggingPriority(ui::Axis::vertical, kLabelHugging);
    mainLabel_->setTextAlignment(ui::TextAlignment::center);
    mainLabel_->setLineBreakMode(ui::LineBreakMode::byWordWrapping);
    mainLabel_->setNumberOfLines(3);
    mainLabel_->setBaselineAdjustment(ui::BaselineAdjustment::none);
    mainLabel_->setPreferredMaxLayoutWidth(280);
    mainLabel_->setFont(ui::Font::system(27));
    mainLabel_->setText(platform_.localization.localizedString("PROGRESS_TEXT"));
    mainLabel_->setTextColor(ui::Color::black());
    mainLabel_->setLaidOutByConstraints(true);

    progressView_ = std::make_shared<ui::ProgressView>(ui::ProgressView::Style::standard);
    progressView_->setIdentifier(ui::identifiers::progress);
    progressView_->setProgress(0);
    progressView_->setContentHuggingPriority(ui::Axis::vertical, ui::priority::high);
    progressView_->setLaidOutByConstraints(true);

    view()->setNeedsUpdateConstraints();
    view()->addSubview(mainLabel_);
    view()->addSubview(progressView_);
}

}  // namespace wp
