#include "screens/tv/window.h"

#include <QGuiApplication>
#include <QInputMethodEvent>
#include <QKeyEvent>
#include <QQuickItem>

#include "screens/tv/key_map.h"

namespace wp::tv {

/// Has the scene's focus, so that what an input method commits comes here.
class Window::InputMethodItem final : public QQuickItem {
  public:
    InputMethodItem(QQuickItem* parent, const Input& input) : QQuickItem(parent), input_(input) {
        setFlag(ItemIsFocusScope);
        setFocus(true);
    }

    void fieldChanged() {
        bool takesText = input_.takesText();
        if (flags().testFlag(ItemAcceptsInputMethod) != takesText) {
            setFlag(ItemAcceptsInputMethod, takesText);
            if (!takesText) input_.compose({});
        }
        updateInputMethod(Qt::ImQueryInput | Qt::ImEnabled);
    }

    /// The scene puts the cursor into its place while it is painted.
    void framePainted() {
        if (!input_.takesText() || cursor_ == input_.cursor()) return;
        cursor_ = input_.cursor();
        updateInputMethod(Qt::ImCursorRectangle);
    }

  protected:
    void inputMethodEvent(QInputMethodEvent* event) override {
        if (!event->commitString().isEmpty()) input_.type(event->commitString());
        input_.compose(event->preeditString());
        event->accept();
    }

    QVariant inputMethodQuery(Qt::InputMethodQuery query) const override {
        switch (query) {
            case Qt::ImEnabled:
                return input_.takesText();
            case Qt::ImCursorRectangle:
                return input_.cursor();
            case Qt::ImHints:
                // A network's name is no prose.
                return static_cast<int>(Qt::ImhNoPredictiveText | Qt::ImhNoAutoUppercase);
            default:
                return QQuickItem::inputMethodQuery(query);
        }
    }

  private:
    void updateInputMethod(Qt::InputMethodQueries queries) {
        // Under Wayland without a seat nothing has the focus, and the toolkit's input method crashes when it is asked.
        if (QGuiApplication::focusObject() == this) QGuiApplication::inputMethod()->update(queries);
    }

    const Input& input_;
    QRectF cursor_;
};

Window::Window(Input input)
    : input_(std::move(input)), inputMethod_(new InputMethodItem(contentItem(), input_)) {
    setResizeMode(QQuickView::SizeRootObjectToView);
    setColor(Qt::white);
    connect(this, &QQuickWindow::frameSwapped, this, [this] { inputMethod_->framePainted(); });
}

void Window::fieldChanged() {
    inputMethod_->fieldChanged();
}

void Window::keyPressEvent(QKeyEvent* event) {
    event->accept();
    if (auto key = keyOf(static_cast<Qt::Key>(event->key()), event->nativeScanCode())) {
        // A key that is still held from one question must not answer the next; on the keys of a field it repeats them.
        if (!event->isAutoRepeat()) mayRepeat_ = *key != ui::Key::back && input_.takesText();
        bool isDecision = *key == ui::Key::select || *key == ui::Key::back;
        if (!isDecision || !event->isAutoRepeat() || (mayRepeat_ && input_.takesText())) input_.press(*key);
        return;
    }
    bool isCommand =
        event->modifiers().testFlag(Qt::ControlModifier) || event->modifiers().testFlag(Qt::AltModifier);
    QString text = event->text();
    if (!isCommand && !text.isEmpty() && text.front().isPrint()) input_.type(text);
}

bool Window::event(QEvent* event) {
    if (event->type() == QEvent::Close) {
        event->ignore();
        input_.close();
        return true;
    }
    return QQuickView::event(event);
}

}  // namespace wp::tv
