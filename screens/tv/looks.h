#pragma once

#include <QColor>
#include <QObject>
#include <QRectF>
#include <QString>
#include <QVariantList>

namespace wp::tv {

/// What the scene paints of a label. Lengths are in points.
struct LabelLook {
    Q_GADGET
    Q_PROPERTY(bool isShown MEMBER isShown)
    Q_PROPERTY(QRectF frame MEMBER frame)
    Q_PROPERTY(QString text MEMBER text)
    Q_PROPERTY(QColor color MEMBER color)
    Q_PROPERTY(int fontSize MEMBER fontSize)
    Q_PROPERTY(int lines MEMBER lines)
    Q_PROPERTY(int alignment MEMBER alignment)
  public:
    bool isShown = false;
    QRectF frame;
    QString text;
    QColor color;
    int fontSize = 1;
    int lines = 1;
    int alignment = Qt::AlignLeft;
    friend bool operator==(const LabelLook&, const LabelLook&) = default;
};

struct ProgressLook {
    Q_GADGET
    Q_PROPERTY(bool isShown MEMBER isShown)
    Q_PROPERTY(QRectF frame MEMBER frame)
    Q_PROPERTY(double fraction MEMBER fraction)
    Q_PROPERTY(QColor track MEMBER track)
  public:
    bool isShown = false;
    QRectF frame;
    double fraction = 0;
    QColor track;
    friend bool operator==(const ProgressLook&, const ProgressLook&) = default;
};

struct ImageLook {
    Q_GADGET
    Q_PROPERTY(bool isShown MEMBER isShown)
    Q_PROPERTY(QRectF frame MEMBER frame)
    Q_PROPERTY(QString name MEMBER name)
  public:
    bool isShown = false;
    QRectF frame;
    QString name;
    friend bool operator==(const ImageLook&, const ImageLook&) = default;
};

struct TableLook {
    Q_GADGET
    Q_PROPERTY(bool isShown MEMBER isShown)
    Q_PROPERTY(QRectF frame MEMBER frame)
    Q_PROPERTY(double opacity MEMBER opacity)
    Q_PROPERTY(double offset MEMBER offset)
    Q_PROPERTY(bool isMuted MEMBER isMuted)
    Q_PROPERTY(bool hasMoreAbove MEMBER hasMoreAbove)
    Q_PROPERTY(bool hasMoreBelow MEMBER hasMoreBelow)
  public:
    bool isShown = false;
    QRectF frame;
    double opacity = 1;
    double offset = 0;
    /// Arrows move the focus, but nothing can be chosen now.
    bool isMuted = false;
    bool hasMoreAbove = false;  ///< rows outside the table's edges
    bool hasMoreBelow = false;
    friend bool operator==(const TableLook&, const TableLook&) = default;
};

/// An alert; one that is no longer shown keeps its texts while it fades away.
struct AlertLook {
    Q_GADGET
    Q_PROPERTY(bool isShown MEMBER isShown)
    Q_PROPERTY(QString title MEMBER title)
    Q_PROPERTY(QString message MEMBER message)
    Q_PROPERTY(bool hasField MEMBER hasField)
    Q_PROPERTY(bool isFieldFocused MEMBER isFieldFocused)
    Q_PROPERTY(QString text MEMBER text)
    Q_PROPERTY(QString placeholder MEMBER placeholder)
    Q_PROPERTY(int cursor MEMBER cursor)
    Q_PROPERTY(double cursorX MEMBER cursorX)
    Q_PROPERTY(double textWidth MEMBER textWidth)
    Q_PROPERTY(QVariantList actions MEMBER actions)
  public:
    bool isShown = false;
    QString title;
    QString message;
    bool hasField = false;
    bool isFieldFocused = false;
    QString text;  ///< of the field, with what an input method is composing
    QString placeholder;
    int cursor = 0;      ///< in the text, UTF-16 units
    double cursorX = 0;  ///< from the text's left edge
    double textWidth = 0;
    QVariantList actions;  ///< of `ActionLook`
    friend bool operator==(const AlertLook&, const AlertLook&) = default;
};

/// A key of the keyboard on the screen.
struct KeyLook {
    Q_GADGET
    Q_PROPERTY(QString label MEMBER label)
    Q_PROPERTY(QString name MEMBER name)
    Q_PROPERTY(int row MEMBER row)
    Q_PROPERTY(int column MEMBER column)
    Q_PROPERTY(int width MEMBER width)
    Q_PROPERTY(bool isFocused MEMBER isFocused)
    Q_PROPERTY(bool isEnabled MEMBER isEnabled)
    Q_PROPERTY(bool isOn MEMBER isOn)
    Q_PROPERTY(bool isFunction MEMBER isFunction)
  public:
    QString label;
    QString name;  ///< as it is read out
    int row = 0;
    int column = 0;  ///< of `Keyboard::kColumns`
    int width = 2;
    bool isFocused = false;
    bool isEnabled = true;
    bool isOn = false;
    bool isFunction = false;
    friend bool operator==(const KeyLook&, const KeyLook&) = default;
};

struct ActionLook {
    Q_GADGET
    Q_PROPERTY(QString title MEMBER title)
    Q_PROPERTY(bool isEnabled MEMBER isEnabled)
    Q_PROPERTY(bool isFocused MEMBER isFocused)
  public:
    QString title;
    bool isEnabled = true;
    bool isFocused = false;
    friend bool operator==(const ActionLook&, const ActionLook&) = default;
};

}  // namespace wp::tv
