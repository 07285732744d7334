#include "screens/tv/stage.h"

#include <QAccessible>
#include <cmath>

#include "platform/ui/controls.h"
#include "platform/ui/display_text.h"
#include "platform/ui/identifiers.h"
#include "platform/ui/label.h"
#include "screens/tv/text_measurer.h"

namespace wp::tv {
namespace {

constexpr ui::Font kFieldFont = ui::Font::system(34);

QString displayed(std::string_view text) {
    return QString::fromStdString(ui::displayForm(text));
}

/// A text of the program's own: its line breaks stay.
QString displayedLines(std::string_view text) {
    QString lines;
    while (true) {
        std::size_t end = text.find('\n');
        lines += displayed(text.substr(0, end));
        if (end == std::string_view::npos) return lines;
        lines += QLatin1Char('\n');
        text.remove_prefix(end + 1);
    }
}

QColor colorOf(const ui::Color& color) {
    return QColor::fromRgbF(static_cast<float>(color.red), static_cast<float>(color.green),
                            static_cast<float>(color.blue), static_cast<float>(color.alpha));
}

QRectF rectOf(const ui::View& view) {
    ui::Rect frame = view.frameOnScreen();
    return {frame.x, frame.y, frame.width, frame.height};
}

int alignmentOf(ui::TextAlignment alignment) {
    switch (alignment) {
        case ui::TextAlignment::center:
            return Qt::AlignHCenter;
        case ui::TextAlignment::right:
            return Qt::AlignRight;
        default:
            return Qt::AlignLeft;
    }
}

LabelLook lookOf(const ui::Label* label) {
    if (!label) return {};
    LabelLook look;
    look.isShown = !label->isHidden();
    look.frame = rectOf(*label);
    look.text = displayedLines(label->text());
    look.color = colorOf(label->textColor());
    look.fontSize = static_cast<int>(std::lround(label->fittingFont().size));
    look.lines = label->numberOfLines();
    look.alignment = alignmentOf(label->textAlignment());
    return look;
}

ProgressLook lookOf(const ui::ProgressView* bar) {
    if (!bar) return {};
    return {!bar->isHidden(), rectOf(*bar), static_cast<double>(bar->progress()), colorOf(bar->trackColor())};
}

ImageLook lookOf(const ui::ImageView* image) {
    if (!image) return {};
    return {!image->isHidden(), rectOf(*image), QString::fromStdString(image->imageName())};
}

QVariantList actionsOf(const ui::AlertController& alert) {
    QVariantList actions;
    for (std::size_t index = 0; index < alert.actions().size(); ++index) {
        const ui::AlertAction& action = *alert.actions()[index];
        bool isFocused =
            alert.focus() == ui::AlertController::Focus{ui::AlertController::Focus::On::action, index};
        actions << QVariant::fromValue(ActionLook{displayed(action.title()), action.isEnabled(), isFocused});
    }
    return actions;
}

AlertLook lookOf(const ui::AlertController& alert, const QString& composed) {
    AlertLook look;
    look.isShown = true;
    look.title = displayedLines(alert.title().value_or(""));
    look.message = displayedLines(alert.message().value_or(""));
    look.actions = actionsOf(alert);
    if (alert.textFields().empty()) return look;
    const ui::TextField& field = *alert.textFields().front();
    look.hasField = true;
    look.isFieldFocused = alert.focusedTextField() == &field;
    std::string_view text = field.text();
    QString before = displayed(text.substr(0, field.cursor())) + composed;
    look.text = before + displayed(text.substr(field.cursor()));
    look.cursor = static_cast<int>(before.size());
    look.cursorX = cursorPosition(look.text, look.cursor, kFieldFont);
    look.textWidth = cursorPosition(look.text, static_cast<int>(look.text.size()), kFieldFont);
    look.placeholder = displayed(field.placeholder());
    return look;
}

}  // namespace

QString Stage::fontFamily() const {
    return QString::fromLatin1(kFontFamily);
}

void Stage::reload(const ui::SettingsTableView& table) {
    // The rows of a table that comes up are there with it.
    Motion motion = mirrored_ == &table ? motion_ : Motion::none;
    mirrored_ = &table;
    LineChanges changes = flatTable_.reload(table);
    lines_.play(flatTable_.lines(), changes, motion);
}

void Stage::apply(const ui::SettingsTableView& table, const ui::TableChanges& batch) {
    if (mirrored_ != &table) return reload(table);
    LineChanges changes = flatTable_.apply(table, batch);
    lines_.play(flatTable_.lines(), changes, motion_);
}

void Stage::givePictureSize(ui::Screen& screen) {
    constexpr ui::Size kSize{520, 520};
    if (auto* image = screen.viewAs<ui::ImageView>(ui::identifiers::image)) image->setImageSize(kSize);
}

void Stage::takeOver(ui::Screen& screen, const QString& composed) {
    using namespace ui::identifiers;
    set(title_, lookOf(screen.viewAs<ui::Label>(title)), &Stage::titleChanged);
    set(description_, lookOf(screen.viewAs<ui::Label>(description)), &Stage::descriptionChanged);
    set(status_, lookOf(screen.viewAs<ui::Label>(status)), &Stage::statusChanged);
    set(progress_, lookOf(screen.viewAs<ui::ProgressView>(progress)), &Stage::progressChanged);
    set(image_, lookOf(screen.viewAs<ui::ImageView>(image)), &Stage::imageChanged);
    takeTable(screen);
    AlertLook alert = alert_;
    alert.isShown = false;
    if (auto shown = screen.alert()) alert = lookOf(*shown, composed);
    set(alert_, std::move(alert), &Stage::alertChanged);
}

void Stage::tellFocus(QQuickItem* item) {
    if (!item) return;
    QAccessibleEvent event(item, QAccessible::Focus);
    QAccessible::updateAccessibility(&event);
}

void Stage::tellUse(QQuickItem* item) {
    QAccessible::State changed;
    changed.disabled = true;
    QAccessibleStateChangeEvent event(item, changed);
    QAccessible::updateAccessibility(&event);
}

void Stage::tellValue(QQuickItem* bar, int value) {
    QAccessibleValueChangeEvent event(bar, value);
    QAccessible::updateAccessibility(&event);
}

double Stage::balancedWidth(const QString& text, int fontSize, double width) {
    return tv::balancedWidth(TextMeasurer(), text, ui::Font::system(fontSize), width);
}

void Stage::takeTable(const ui::Screen& screen) {
    const ui::SettingsTableView* table = screen.table();
    if (!table) {
        mirrored_ = nullptr;
        LineChanges changes = flatTable_.clear();
        lines_.play({}, changes, Motion::none);
        return set(table_, TableLook{}, &Stage::tableChanged);
    }
    // A table's first layout loads it without a word.
    if (table != mirrored_) reload(*table);
    flatTable_.refresh(*table);
    lines_.setWindow(table->contentOffset(), table->frame().height);
    lines_.play(flatTable_.lines(), {}, motion_);
    lines_.setFocused(screen.focusedIndexPath());
    TableLook look;
    look.isShown = !table->isHidden();
    look.frame = rectOf(*table);
    look.opacity = table->alpha();
    look.offset = table->contentOffset();
    look.isMuted = !table->allowsSelection();
    look.hasMoreAbove = table->contentOffset() > 0;
    look.hasMoreBelow = table->contentHeight() - table->contentInset().bottom >
                        table->contentOffset() + table->frame().height;
    set(table_, look, &Stage::tableChanged);
}

}  // namespace wp::tv
