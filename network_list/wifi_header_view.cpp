#include "network_list/wifi_header_view.h"

#include "platform/ui/table_view.h"

namespace wp {
namespace {

constexpr double kFontSize = 13;
constexpr double kGrayLevel = 0.4;
constexpr double kLeftInset = 18;
constexpr double kInsetBesideBackground = 15;
constexpr double kTextTop = 10;
constexpr double kSpinnerTop = 8;
constexpr double kSpinnerGap = 10;

}  // namespace

WiFiHeaderView::WiFiHeaderView(ui::Rect frame, const std::string& text, bool showSpinner) : View(frame) {
    setBackgroundColor(ui::Color::clear());
    setAutoresizingMask(kFlexibleWidth);
    headerText_ = std::make_shared<ui::Label>();
    headerText_->setFont(ui::Font::system(kFontSize));
    headerText_->setTextColor(ui::Color::white(kGrayLevel));
    headerText_->setBackgroundColor(ui::Color::clear());
    headerText_->setText(text);
    addSubview(headerText_);
    if (showSpinner) {
        spinner_ = std::make_shared<ui::ActivityIndicator>(ui::ActivityIndicator::Style::gray);
        addSubview(spinner_);
    }
    layoutIfNeeded();
}

void WiFiHeaderView::layoutSubviews() {
    View::layoutSubviews();
    double left = kLeftInset;
    auto table = dynamic_cast<const ui::SettingsTableView*>(superview());
    if (table && table->backgroundInset()) left = *table->backgroundInset() + kInsetBesideBackground;
    headerText_->sizeToFit();
    double width = headerText_->frame().width;
    double height = headerText_->frame().height;
    if (spinner_) spinner_->setFrame({left + width + kSpinnerGap, kSpinnerTop, height, height});
    headerText_->setFrame({left, kTextTop, width, height});
}

}  // namespace wp
