#include "lifecycle/wifi_profile_view_controller.h"
#include "network_list/scan_list.h"
#include "network_list/wifi_header_view.h"
#include "platform/capabilities.h"
#include "platform/localization.h"
#include "platform/ui/identifiers.h"
#include "platform/ui/screen.h"

namespace wp {
namespace {

using enum ui::Attribute;
using enum ui::Relation;
using ui::Anchor;

constexpr double kTextOpacity = 0.6;
constexpr double kTitleOpacity = 0.4;

const ui::Font& bodyFont() {
    static const ui::Font font = ui::Font::body();
    return font;
}

const ui::Font& titleFont() {
    static const ui::Font font = ui::Font::title2();
    return font;
}

Anchor of(const std::shared_ptr<ui::View>& view, ui::Attribute attribute) {
    return {view.get(), attribute};
}

std::shared_ptr<ui::View> makeView(const char* identifier) {
    auto view = std::make_shared<ui::View>();
    view->setIdentifier(identifier);
    view->setLaidOutByConstraints(true);
    return view;
}

std::shared_ptr<ui::Label> makeContentLabel(const char* identifier, int lines) {
    auto label = std::make_shared<ui::Label>();
    label->setIdentifier(identifier);
    label->setFont(bodyFont());
    label->setNumberOfLines(lines);
    label->setAdjustsFontSizeToFitWidth(true);
    label->setLineBreakMode(ui::LineBreakMode::byTruncatingTail);
    label->setTextColor(ui::Color::white(0, kTextOpacity));
    label->setTextAlignment(ui::TextAlignment::center);
    label->setLaidOutByConstraints(true);
    return label;
}

}  // namespace

WiFiProfileViewController::~WiFiProfileViewController() = default;

void WiFiProfileViewController::updateViewConstraints() {
    DiagnosticViewController::updateViewConstraints();
}

void WiFiProfileViewController::setupViewWithNetworkList(bool) {
    view()->setBackgroundColor(ui::Color::white());
    tableViewWidth_ = 760;
    tableViewPadding_ = {162, 0, 0, 100};
    tableViewContentInsets_ = {0, 0, 60, 0};
    setAutomaticallyAdjustsScrollViewInsets(false);

    ui::Size size = platform_.screen.size();
    auto root = std::make_shared<ui::View>(ui::Rect{0, 0, size.width, size.height});
    root->setIdentifier("view");
    buildTable(root);
    buildContent(root);
    buildNavigationBar(root);
    // Deliberate: the plain cell, not the one with a detail text.
    tableView_->registerCellClass<ui::TableViewCell>("cellIdentifier");
    becomeFirstResponder();
    setNeedsFocusUpdate();
    updateFocusIfNeeded();
}

void WiFiProfileViewController::buildTable(const std::shared_ptr<ui::View>& root) {
    tableView_ =
        std::make_shared<ui::SettingsTableView>(root->frame(), ui::SettingsTableView::Style::grouped);
    tableView_->setIdentifier(ui::identifiers::table);
    tableView_->setContentInset(tableViewContentInsets_);
    tableView_->setLaidOutByConstraints(true);
    tableView_->setDelegate(this);
    tableView_->setDataSource(this);
    root->addSubview(tableView_);
    setView(root);
    // clang-format off
    ui::activateConstraints({
        {of(tableView_, top),      equal, of(root, top),      tableViewPadding_.top},
        {of(tableView_, bottom),   equal, of(root, bottom),   tableViewPadding_.bottom},
        {of(tableView_, trailing), equal, of(root, trailing), -tableViewPadding_.right},
        {of(tableView_, width),    equal, {},                 tableViewWidth_},
    });
    // clang-format on
}

void WiFiProfileViewController::buildContent(const std::shared_ptr<ui::View>& root) {
    descriptionLabel_ = makeContentLabel(ui::identifiers::description, 5);
    descriptionLabel_->setText(platform_.localization.localizedString("WIFI_DESCRIPTION"));
    mainLabel_ = makeContentLabel(ui::identifiers::status, 1);
    mainLabel_->setHidden(true);
    progressView_ = std::make_shared<ui::ProgressView>(ui::ProgressView::Style::standard);
    progressView_->setIdentifier(ui::identifiers::progress);
    progressView_->setProgress(0);
    progressView_->setTrackColor(ui::Color::lightGray());
    progressView_->setLaidOutByConstraints(true);
    progressView_->setHidden(true);

    auto imageArea = makeView("imageArea");
    auto image = std::make_shared<ui::ImageView>("wifi", ui::ImageView::Kind::vibrant);
    image->setIdentifier(ui::identifiers::image);
    image->setLaidOutByConstraints(true);
    const std::shared_ptr<ui::View> views[] = {imageArea, descriptionLabel_, progressView_, mainLabel_,
                                               image};
    for (const auto& view : views) root->addSubview(view);
    // clang-format off
    ui::activateConstraints({
        {of(imageArea, top),            equal,          of(root, top),                       180},
        {of(imageArea, leading),        equal,          of(root, leading),                   90},
        {of(imageArea, height),         equal,          {},                                  654},
        {of(imageArea, width),          equal,          {},                                  870},
        {of(descriptionLabel_, top),    greaterOrEqual, of(imageArea, bottom)},
        {of(descriptionLabel_, centerX), equal,         of(imageArea, centerX)},
        {of(descriptionLabel_, width),  equal,          of(imageArea, width)},
        {of(progressView_, top),        equal,          of(descriptionLabel_, lastBaseline), 26},
        {of(progressView_, centerX),    equal,          of(imageArea, centerX)},
        {of(progressView_, width),      equal,          {},                                  370},
        {of(mainLabel_, lastBaseline),  equal,          of(progressView_, bottom),           38},
        {of(mainLabel_, centerX),       equal,          of(imageArea, centerX)},
        {of(mainLabel_, width),         equal,          of(imageArea, width)},
        {of(image, centerX),            equal,          of(imageArea, centerX)},
        {of(image, centerY),            equal,          of(imageArea, centerY)},
    });
    // clang-format on
}

void WiFiProfileViewController::buildNavigationBar(const std::shared_ptr<ui::View>& root) {
    auto bar = makeView("navigationBar");
    root->addSubview(bar);
    navigationBarLabel_ = std::make_shared<ui::Label>();
    navigationBarLabel_->setIdentifier(ui::identifiers::title);
    navigationBarLabel_->setFont(titleFont());
    navigationBarLabel_->setNumberOfLines(1);
    navigationBarLabel_->setLineBreakMode(ui::LineBreakMode::byTruncatingTail);
    navigationBarLabel_->setTextColor(ui::Color::white(0, kTitleOpacity));
    navigationBarLabel_->setTextAlignment(ui::TextAlignment::center);
    navigationBarLabel_->setLaidOutByConstraints(true);
    bool saysWLAN = platform_.capabilities.booleanAnswer("wapi");
    navigationBarLabel_->setText(
        platform_.localization.localizedString(saysWLAN ? "WLAN_DIAGNOSTICS" : "WIFI_DIAGNOSTICS"));
    bar->addSubview(navigationBarLabel_);
    // clang-format off
    ui::activateConstraints({
        {of(bar, top),                    equal, of(root, top)},
        {of(bar, leading),                equal, of(root, leading)},
        {of(bar, height),                 equal, {},                                145},
        {of(bar, width),                  equal, of(root, width)},
        {of(navigationBarLabel_, top),    equal, of(bar, top),                      57},
        {of(navigationBarLabel_, leading), equal, of(bar, leading),                 90},
        {of(bar, trailing),               equal, of(navigationBarLabel_, trailing), 90},
    });
    // clang-format on
}

}  // namespace wp
