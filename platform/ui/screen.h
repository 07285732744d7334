#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ui/alert_controller.h"
#include "platform/ui/index_path.h"
#include "platform/ui/layout_solver.h"
#include "platform/ui/table_view.h"
#include "platform/ui/text_measurer.h"
#include "platform/ui/view_controller.h"

namespace wp::ui {

/// The keys of a remote control, and those that a keyboard adds for the text field.
enum class Key { up, down, left, right, select, back, backspace, deleteForward, home, end };

/// What the one front end of a screen is told. Each call comes after the fact, with the tree as it is now.
/// *Main*.
class ScreenObserver {
  public:
    virtual ~ScreenObserver() = default;
    /// Some view looks different, came or went.
    virtual void viewsChanged() {}
    /// All rows are new.
    virtual void tableReloaded(SettingsTableView& /*table*/) {}
    /// One outermost batch was applied.
    virtual void tableChanged(SettingsTableView& /*table*/, const TableChanges& /*changes*/) {}
    virtual void tableScrolled(SettingsTableView& /*table*/, Animated) {}
    /// The focused row or the alert's focus is another.
    virtual void focusChanged() {}
    virtual void alertPresented(AlertController& /*alert*/, Animated) {}
    /// A text, the cursor or an action's enabled state.
    virtual void alertChanged(AlertController& /*alert*/) {}
    virtual void alertDismissed(AlertController& /*alert*/) {}
    /// Whether something still moves on the front end.
    virtual bool isAnimating() const { return false; }
};

/// The root of what is shown: one controller with its views, the alerts over it, the focus and the keys.
///
/// A front end mirrors it: it finds the views by `identifiers.h`, paints them, and sends keys back. What is
/// shown by name: title, description and status are `Label`s, progress is a `ProgressView`, table is a
/// `SettingsTableView`; a missing view is one that is not built yet, `isHidden` one that shows nothing.
/// `screenName` says which screen it is. *Main*.
class Screen {
  public:
    /// The note takes one line for the person who runs the program ("table: section 1 ...").
    explicit Screen(std::function<void(std::string_view)> note = nullptr, Size size = {1920, 1080});
    ~Screen();
    Screen(const Screen&) = delete;
    Screen& operator=(const Screen&) = delete;

    /// @name The host's side
    /// @{
    /// Shows the controller in place of the one before; null shows nothing and drops all alerts.
    void setRootViewController(std::shared_ptr<ViewController> controller);
    ViewController* rootViewController() const { return controller_.get(); }
    /// Called when the viewer leaves by the back key with no alert shown.
    void setBackHandler(std::function<void()> handler) { backHandler_ = std::move(handler); }
    /// @}

    /// @name A front end's side
    /// @{
    void setObserver(ScreenObserver* observer) { observer_ = observer; }
    /// Null: the fixed table. The screen does not own it.
    void setTextMeasurer(const TextMeasurer* measurer);
    const TextMeasurer& textMeasurer() const;
    Size size() const { return size_; }
    void setSize(Size size);
    void press(Key key);
    /// False when no text field has the focus.
    bool typeText(std::string_view text);
    bool clearText();
    /// Solves the constraints if anything changed; frames are valid afterwards.
    void layoutIfNeeded();
    const LayoutReport& layoutReport() const { return layoutReport_; }
    bool isAnimating() const { return observer_ && observer_->isAnimating(); }
    /// @}

    /// @name What is shown
    /// @{
    /// "none" before there are views, else the controller's word for it.
    std::string screenName() const;
    /// The view with the identifier; null while there is none.
    View* view(std::string_view identifier) const;
    template <class T>
    T* viewAs(std::string_view identifier) const {
        return dynamic_cast<T*>(view(identifier));
    }
    /// Null while there is none.
    SettingsTableView* table() const;
    /// The alert on top; null when none is shown.
    std::shared_ptr<AlertController> alert() const { return alerts_.empty() ? nullptr : alerts_.back(); }
    /// The row that the keys go to: nothing while an alert is shown.
    std::optional<IndexPath> focusedIndexPath() const;
    bool isInputAccepted() const { return controller_ && controller_->acceptsInput(); }
    /// Whether a key was pressed since the controller is shown.
    bool hasKeyBeenPressed() const { return keyPressed_; }
    /// @}

    /// @name The tree's side
    /// @{
    void presentAlert(std::shared_ptr<AlertController> alert, Animated animated);
    void dismissAlert(AlertController& alert);
    void alertChanged(AlertController& alert);
    void viewChanged();
    void takeLayoutReport(LayoutReport report);
    void tableReloaded(SettingsTableView& table);
    void tableChanged(SettingsTableView& table, const TableChanges& changes);
    void tableScrolled(SettingsTableView& table, Animated animated);
    void focusChanged();
    void focusPreferredView();
    void setFirstResponder(ViewController* controller) { firstResponder_ = controller; }
    ViewController* firstResponder() const { return firstResponder_; }
    void note(std::string_view line);
    /// @}

  private:
    void pressInTable(Key key);
    void pressInAlert(AlertController& alert, Key key);
    bool editField(AlertController& alert, TextField& field, Key key);
    void pressBackInAlert(AlertController& alert);
    void choose(AlertController& alert, AlertAction& action);

    std::function<void(std::string_view)> note_;
    std::function<void()> backHandler_;
    Size size_;
    std::shared_ptr<ViewController> controller_;
    std::vector<std::shared_ptr<AlertController>> alerts_;
    ScreenObserver* observer_ = nullptr;
    const TextMeasurer* measurer_ = nullptr;
    ViewController* firstResponder_ = nullptr;
    LayoutReport layoutReport_;
    bool keyPressed_ = false;
};

}  // namespace wp::ui
