#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/ui/text_field.h"

namespace wp::ui {

class AlertController;
class Screen;

/// One choice of an alert. *Main*.
class AlertAction {
  public:
    enum class Style { standard = 0, cancel = 1 };
    using Handler = std::function<void(AlertAction&)>;

    /// An action without a handler only closes its alert.
    AlertAction(std::string title, Style style, Handler handler = nullptr)
        : title_(std::move(title)), style_(style), handler_(std::move(handler)) {}

    const std::string& title() const { return title_; }
    Style style() const { return style_; }
    bool hasHandler() const { return handler_ != nullptr; }
    bool isEnabled() const { return enabled_; }
    /// A disabled action can be focused, but not chosen.
    void setEnabled(bool enabled);

  private:
    friend class AlertController;
    friend class Screen;

    std::string title_;
    Style style_;
    Handler handler_;
    bool enabled_ = true;
    AlertController* alert_ = nullptr;
};

/// A question over the screen: texts, at most one text field in use, actions. Shown and closed by the
/// screen. *Main*.
class AlertController {
  public:
    enum class Style { actionSheet = 0, alert = 1 };
    /// What has the focus: a text field or an action, by its number.
    struct Focus {
        enum class On { nothing, field, action } on = On::nothing;
        std::size_t index = 0;
        friend bool operator==(const Focus&, const Focus&) = default;
    };

    AlertController(std::optional<std::string> title, std::optional<std::string> message, Style style)
        : title_(std::move(title)), message_(std::move(message)), style_(style) {}
    ~AlertController();

    const std::optional<std::string>& title() const { return title_; }
    const std::optional<std::string>& message() const { return message_; }
    Style style() const { return style_; }

    void addAction(std::shared_ptr<AlertAction> action);
    const std::vector<std::shared_ptr<AlertAction>>& actions() const { return actions_; }
    /// Adds a field and lets the caller configure it.
    void addTextField(const std::function<void(TextField&)>& configure);
    const std::vector<std::unique_ptr<TextField>>& textFields() const { return textFields_; }

    const Focus& focus() const { return focus_; }
    /// The field that has the focus; null when an action has it.
    TextField* focusedTextField() const;

  private:
    friend class AlertAction;
    friend class Screen;

    /// Fields first, then actions, in their order.
    void moveFocus(int direction);
    void moveFocusAmongActions(int direction);
    void focusFirst();
    AlertAction* cancelAction() const;
    bool hasActionWithoutHandler() const;

    std::optional<std::string> title_;
    std::optional<std::string> message_;
    Style style_;
    std::vector<std::shared_ptr<AlertAction>> actions_;
    std::vector<std::unique_ptr<TextField>> textFields_;
    Focus focus_;
    Screen* screen_ = nullptr;  ///< while it is shown
};

}  // namespace wp::ui
