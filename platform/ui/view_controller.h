#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ui/alert_controller.h"
#include "platform/ui/view.h"

namespace wp::ui {

class Screen;

enum class InterfaceOrientation { unknown = 0, portrait = 1 };
/// Masks of orientations; a mask has the bit of an orientation's number.
inline constexpr unsigned kOrientationMaskPortrait = 1U << 1;
inline constexpr unsigned kOrientationMaskAll = 0x1E;

/// The base of a controller that owns one screen's views. *Main*.
class ViewController : public std::enable_shared_from_this<ViewController> {
  public:
    ViewController();
    virtual ~ViewController();

    /// Never null: a plain view until another is set.
    const std::shared_ptr<View>& view() const { return view_; }
    void setView(std::shared_ptr<View> view);
    /// The screen that shows the controller; null while none does.
    Screen* screen() const { return screen_; }

    /// Shows the alert over everything. Without a screen it waits until there is one.
    void presentAlert(std::shared_ptr<AlertController> alert, Animated animated);
    /// The alert on top; null when none is shown.
    std::shared_ptr<AlertController> presentedAlert() const;

    /// Lets the focus go where the controller's views want it, whatever has it now. An alert that is shown
    /// keeps the keys.
    void setNeedsFocusUpdate() { needsFocusUpdate_ = true; }
    void updateFocusIfNeeded();
    void becomeFirstResponder();
    bool isFirstResponder() const;

    virtual bool prefersStatusBarHidden() const { return false; }
    virtual bool shouldAutorotate() const { return true; }
    virtual unsigned supportedInterfaceOrientations() const { return kOrientationMaskAll; }
    virtual InterfaceOrientation preferredInterfaceOrientationForPresentation() const {
        return InterfaceOrientation::unknown;
    }
    /// Called before a layout when the view asked for it.
    virtual void updateViewConstraints();
    bool automaticallyAdjustsScrollViewInsets() const { return adjustsInsets_; }
    void setAutomaticallyAdjustsScrollViewInsets(bool adjusts) { adjustsInsets_ = adjusts; }

    /// Which of its screens the controller shows, as a word for scripts and transcripts.
    virtual std::string screenName() const { return "none"; }
    /// While false no key and no action of an alert reaches the controller.
    virtual bool acceptsInput() const { return true; }

  private:
    friend class Screen;

    void attach(Screen* screen);

    std::shared_ptr<View> view_;
    Screen* screen_ = nullptr;
    std::vector<std::shared_ptr<AlertController>> waitingAlerts_;
    bool needsFocusUpdate_ = false;
    bool adjustsInsets_ = true;
};

}  // namespace wp::ui
