#pragma once

#include <QQuickView>
#include <functional>

#include "platform/ui/screen.h"

namespace wp::tv {

/// What the viewer does, as the window hears it. *Main*.
struct Input {
    std::function<void(ui::Key)> press;
    std::function<void(const QString&)> type;
    /// What an input method is composing; empty when it is done.
    std::function<void(const QString&)> compose;
    std::function<void()> close;
    /// Whether typed text has somewhere to go.
    std::function<bool()> takesText;
    /// The place of the cursor in the window, for an input method's own window beside it.
    std::function<QRectF()> cursor;
};

/// The window: it hands keys and typed text on, and paints the scene.
class Window final : public QQuickView {
  public:
    explicit Window(Input input);

    /// Tells an input method whether there is a field, and that the cursor moved.
    void fieldChanged();

  protected:
    void keyPressEvent(QKeyEvent* event) override;
    bool event(QEvent* event) override;

  private:
    class InputMethodItem;

    Input input_;
    InputMethodItem* inputMethod_;
    bool mayRepeat_ = false;  ///< what is held was pressed in a field
};

}  // namespace wp::tv
