#include "host/host_page.h"

#include "platform/ui/identifiers.h"

namespace wp::host {
namespace {

using enum ui::Attribute;
using enum ui::Relation;

constexpr ui::Size kSize{1920, 1080};
constexpr double kTextOpacity = 0.6;
// As the other screens have it, but darker: a page that is read from three metres, not a list that is used.
constexpr double kTitleOpacity = 0.6;
/// The sentence that matters most on a page is larger than its other texts.
constexpr ui::Font kDescriptionFont = ui::Font::system(34);
constexpr double kDescriptionOpacity = 0.85;
constexpr int kDescriptionLines = 5;
constexpr int kStatusLines = 3;

ui::Anchor of(ui::View& view, ui::Attribute attribute) {
    return {&view, attribute};
}

/// Makes it a part of the page that constraints place.
void add(ui::View& root, const std::shared_ptr<ui::View>& view, const char* identifier) {
    view->setIdentifier(identifier);
    view->setLaidOutByConstraints(true);
    root.addSubview(view);
}

std::shared_ptr<ui::Label> addLabel(ui::View& root, const char* identifier, int lines) {
    auto label = std::make_shared<ui::Label>();
    label->setFont(ui::Font::body());
    label->setNumberOfLines(lines);
    label->setAdjustsFontSizeToFitWidth(true);
    label->setTextColor(ui::Color::white(0, kTextOpacity));
    label->setTextAlignment(ui::TextAlignment::center);
    add(root, label, identifier);
    return label;
}

}  // namespace

HostPage::HostPage(const std::string& title, const std::string& description, Column column) {
    auto root = std::make_shared<ui::View>(ui::Rect{0, 0, kSize.width, kSize.height});
    root->setIdentifier("view");
    root->setBackgroundColor(ui::Color::white());
    setView(root);
    buildTitle(*root, title);
    buildColumn(*root, description, column);
}

void HostPage::buildTitle(ui::View& root, const std::string& title) {
    std::shared_ptr<ui::Label> label = addLabel(root, ui::identifiers::title, 1);
    label->setText(title);
    label->setFont(ui::Font::title2());
    label->setTextColor(ui::Color::white(0, kTitleOpacity));
    // clang-format off
    ui::activateConstraints({
        {of(*label, top),      equal, of(root, top),      57},
        {of(*label, leading),  equal, of(root, leading),  90},
        {of(*label, trailing), equal, of(root, trailing), -90},
    });
    // clang-format on
}

void HostPage::buildColumn(ui::View& root, const std::string& description, Column column) {
    auto area = std::make_shared<ui::View>();
    add(root, area, "imageArea");
    auto image = std::make_shared<ui::ImageView>("wifi", ui::ImageView::Kind::vibrant);
    add(root, image, ui::identifiers::image);
    std::shared_ptr<ui::Label> text = addLabel(root, ui::identifiers::description, kDescriptionLines);
    text->setText(description);
    text->setFont(kDescriptionFont);
    text->setTextColor(ui::Color::white(0, kDescriptionOpacity));
    progress_ = std::make_shared<ui::ProgressView>();
    progress_->setTrackColor(ui::Color::lightGray());
    add(root, progress_, ui::identifiers::progress);
    status_ = addLabel(root, ui::identifiers::status, kStatusLines);
    // clang-format off
    ui::activateConstraints({
        {of(*area, top),         equal, of(root, top),            180},
        {of(*area, leading),     equal, of(root, leading),        column.leading},
        {of(*area, width),       equal, {},                       column.width},
        {of(*area, height),      equal, {},                       440},
        {of(*image, centerX),    equal, of(*area, centerX)},
        {of(*image, centerY),    equal, of(*area, centerY)},
        {of(*text, top),         equal, of(*area, bottom)},
        {of(*text, centerX),     equal, of(*area, centerX)},
        {of(*text, width),       equal, of(*area, width)},
        {of(*progress_, top),    equal, of(*text, lastBaseline),  26},
        {of(*progress_, centerX), equal, of(*area, centerX)},
        {of(*progress_, width),  equal, {},                       370},
        {of(*status_, top),      equal, of(*progress_, bottom),   20},
        {of(*status_, centerX),  equal, of(*area, centerX)},
        {of(*status_, width),    equal, of(*area, width)},
    });
    // clang-format on
}

ui::SettingsTableView& HostPage::addTable(double width) {
    ui::View& root = *view();
    auto table = std::make_shared<ui::SettingsTableView>(root.frame(), ui::SettingsTableView::Style::grouped);
    // Above as far as the focus grows, so that the table's edge does not cut it; below as far as the screen's margin.
    table->setContentInset({12, 0, 60, 0});
    add(root, table, ui::identifiers::table);
    // clang-format off
    ui::activateConstraints({
        {of(*table, top),             equal, of(root, top),      162},
        {of(*table, bottom),          equal, of(root, bottom)},
        {of(*table, trailing),        equal, of(root, trailing), -100},
        {of(*table, ui::Attribute::width), equal, {},            width},
    });
    // clang-format on
    return *table;
}

}  // namespace wp::host
