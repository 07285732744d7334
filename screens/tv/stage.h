#pragma once

#include <QObject>
#include <QQuickItem>

#include "platform/ui/screen.h"
#include "screens/tv/looks.h"
#include "screens/tv/table_model.h"

namespace wp::tv {

/// What the scene paints, property by property: the view tree as it was when it was last taken over. *Main*.
class Stage final : public QObject {
    Q_OBJECT
    Q_PROPERTY(wp::tv::LabelLook title MEMBER title_ NOTIFY titleChanged)
    Q_PROPERTY(wp::tv::LabelLook description MEMBER description_ NOTIFY descriptionChanged)
    Q_PROPERTY(wp::tv::LabelLook status MEMBER status_ NOTIFY statusChanged)
    Q_PROPERTY(wp::tv::ProgressLook progress MEMBER progress_ NOTIFY progressChanged)
    Q_PROPERTY(wp::tv::ImageLook image MEMBER image_ NOTIFY imageChanged)
    Q_PROPERTY(wp::tv::TableLook table MEMBER table_ NOTIFY tableChanged)
    Q_PROPERTY(wp::tv::AlertLook alert MEMBER alert_ NOTIFY alertChanged)
    Q_PROPERTY(QVariantList keyboard MEMBER keyboard_ NOTIFY keyboardChanged)
    Q_PROPERTY(wp::tv::TableModel* lines READ lines CONSTANT)
    /// How many dots of the screen a point is.
    Q_PROPERTY(double unit MEMBER unit_ NOTIFY unitChanged)
    Q_PROPERTY(bool hasMotion READ hasMotion CONSTANT)
    Q_PROPERTY(QString fontFamily READ fontFamily CONSTANT)

  public:
    explicit Stage(Motion motion) : motion_(motion) {}

    TableModel* lines() { return &lines_; }
    bool hasMotion() const { return motion_ == Motion::full; }
    QString fontFamily() const;
    void setUnit(double unit) { set(unit_, unit, &Stage::unitChanged); }
    bool hasLeavingLines() const { return lines_.hasLeaving(); }

    /// Follows the table at once, batch by batch.
    void reload(const ui::SettingsTableView& table);
    void apply(const ui::SettingsTableView& table, const ui::TableChanges& changes);
    /// Tells the tree how large the picture is, before a layout.
    static void givePictureSize(ui::Screen& screen);
    /// Takes over everything else, as the layout left it. The text is what an input method is composing.
    void takeOver(ui::Screen& screen, const QString& composed);
    /// Tells a screen reader that this part of the scene has the focus now; the toolkit's own focus never moves.
    Q_INVOKABLE static void tellFocus(QQuickItem* item);
    /// Tells a screen reader that the select key works on it now, or does no longer.
    Q_INVOKABLE static void tellUse(QQuickItem* item);
    /// Tells a screen reader that the bar has another value.
    Q_INVOKABLE static void tellValue(QQuickItem* bar, int value);
    /// For a text in the middle of a width: how much of it to use, so that no word is left alone on the last line.
    Q_INVOKABLE static double balancedWidth(const QString& text, int fontSize, double width);
    void takeKeyboard(QVariantList keys) { set(keyboard_, std::move(keys), &Stage::keyboardChanged); }

  signals:
    void titleChanged();
    void descriptionChanged();
    void statusChanged();
    void progressChanged();
    void imageChanged();
    void tableChanged();
    void alertChanged();
    void keyboardChanged();
    void unitChanged();

  private:
    template <class Look>
    void set(Look& place, Look look, void (Stage::*changed)()) {
        if (place == look) return;
        place = std::move(look);
        emit(this->*changed)();
    }
    void takeTable(const ui::Screen& screen);

    Motion motion_;
    FlatTable flatTable_;
    TableModel lines_;
    const ui::SettingsTableView* mirrored_ = nullptr;
    LabelLook title_;
    LabelLook description_;
    LabelLook status_;
    ProgressLook progress_;
    ImageLook image_;
    TableLook table_;
    AlertLook alert_;
    QVariantList keyboard_;
    double unit_ = 1;
};

}  // namespace wp::tv
