#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/ui/geometry.h"
#include "platform/ui/layout_constraint.h"
#include "platform/ui/style.h"
#include "platform/ui/text_measurer.h"

namespace wp::ui {

class Screen;

/// A rectangle of the screen, retained: it keeps its properties, its subviews and the constraints that place
/// them; a front end paints what it finds. A hidden view keeps its place in the layout. *Main*.
class View : public std::enable_shared_from_this<View> {
  public:
    /// Autoresizing: the width follows the superview's.
    static constexpr unsigned kFlexibleWidth = 2;

    explicit View(Rect frame = {}) : frame_(frame) {}
    virtual ~View();
    View(const View&) = delete;
    View& operator=(const View&) = delete;

    /// @name The tree
    /// @{
    void addSubview(std::shared_ptr<View> view);
    /// Takes the view out of the tree, and with it every constraint that ties it to views outside itself.
    void removeFromSuperview();
    const std::vector<std::shared_ptr<View>>& subviews() const { return subviews_; }
    View* superview() const { return superview_; }
    /// The topmost view above this one; itself when it stands in no other.
    View& root();
    /// Whether the view is this one or stands below it.
    bool contains(const View& view) const;
    /// This view or the first one below it with the identifier; null when there is none.
    View* viewWithIdentifier(std::string_view identifier);
    /// The screen that shows the tree; null while none does.
    Screen* screen() const;
    /// Made by the screen on the root of what it shows.
    void setScreen(Screen* screen);
    /// @}

    /// @name Looks
    /// @{
    const std::string& identifier() const { return identifier_; }
    void setIdentifier(std::string identifier) { identifier_ = std::move(identifier); }
    bool isHidden() const { return hidden_; }
    void setHidden(bool hidden) { set(hidden_, hidden); }
    double alpha() const { return alpha_; }
    void setAlpha(double alpha) { set(alpha_, alpha); }
    const Color& backgroundColor() const { return backgroundColor_; }
    void setBackgroundColor(Color color) { set(backgroundColor_, color); }
    bool isOpaque() const { return opaque_; }
    void setOpaque(bool opaque) { set(opaque_, opaque); }
    ContentMode contentMode() const { return contentMode_; }
    void setContentMode(ContentMode mode) { set(contentMode_, mode); }
    /// Whether the view takes touches; a view that does not can still have the focus.
    bool isUserInteractionEnabled() const { return userInteractionEnabled_; }
    void setUserInteractionEnabled(bool enabled) { set(userInteractionEnabled_, enabled); }
    /// @}

    /// @name Layout
    /// @{
    /// In the superview's coordinates.
    const Rect& frame() const { return frame_; }
    void setFrame(Rect frame);
    /// In the coordinates of the root view.
    Rect frameOnScreen() const;
    unsigned autoresizingMask() const { return autoresizingMask_; }
    void setAutoresizingMask(unsigned mask) { autoresizingMask_ = mask; }
    /// True: constraints place the view. False (as made): its frame stays as it was set.
    bool isLaidOutByConstraints() const { return laidOutByConstraints_; }
    void setLaidOutByConstraints(bool laidOut) { laidOutByConstraints_ = laidOut; }
    const std::vector<LayoutConstraint>& constraints() const { return constraints_; }
    void addConstraint(const LayoutConstraint& constraint);

    /// How strongly the view pulls towards its content's size, and resists being smaller.
    Priority contentHuggingPriority(Axis axis) const { return hugging_[index(axis)]; }
    void setContentHuggingPriority(Axis axis, Priority priority);
    Priority compressionResistancePriority(Axis axis) const { return resistance_[index(axis)]; }
    void setCompressionResistancePriority(Axis axis, Priority priority);

    /// The size that the content asks for, by axis; nothing where it asks for none. The width (0: unknown)
    /// is what the layout has settled so far, for text that wraps.
    struct IntrinsicSize {
        std::optional<double> width;
        std::optional<double> height;
    };
    virtual IntrinsicSize intrinsicSize(double /*width*/) const { return {}; }
    /// From the last baseline down to the lower edge, wrapped to the width; 0 for a view without text.
    virtual double lastBaselineOffsetFromBottom(double /*width*/) const { return 0; }

    void setNeedsLayout();
    bool needsLayout() const { return needsLayout_; }
    /// Solves the constraints of the whole tree, if anything changed since the last time.
    void layoutIfNeeded();
    /// Places what constraints do not; called top down after they are solved.
    virtual void layoutSubviews() {}
    void setNeedsUpdateConstraints() { needsUpdateConstraints_ = true; }
    void clearNeedsUpdateConstraints() { needsUpdateConstraints_ = false; }
    bool needsUpdateConstraints() const { return needsUpdateConstraints_; }
    const TextMeasurer& textMeasurer() const;
    /// @}

  protected:
    /// Tells the screen's front end that something looks different now.
    void changed();
    /// Stores the value; tells the front end when it is a new one.
    template <class T>
    void set(T& place, const T& value) {
        if (place == value) return;
        place = value;
        changed();
    }
    /// The same for what also changes the size that the content asks for.
    template <class T>
    void setContent(T& place, const T& value) {
        if (place == value) return;
        place = value;
        setNeedsLayout();
        changed();
    }

  private:
    static constexpr std::size_t index(Axis axis) { return axis == Axis::horizontal ? 0 : 1; }
    void dropConstraintsWith(const View& removed);
    void layoutSubviewsBelow();

    std::string identifier_;
    Rect frame_;
    View* superview_ = nullptr;
    Screen* screen_ = nullptr;
    std::vector<std::shared_ptr<View>> subviews_;
    std::vector<LayoutConstraint> constraints_;
    Color backgroundColor_ = Color::clear();
    double alpha_ = 1;
    Priority hugging_[2] = {priority::low, priority::low};
    Priority resistance_[2] = {priority::high, priority::high};
    unsigned autoresizingMask_ = 0;
    ContentMode contentMode_ = ContentMode::scaleToFill;
    bool hidden_ = false;
    bool opaque_ = true;
    bool userInteractionEnabled_ = true;
    bool laidOutByConstraints_ = false;
    bool needsLayout_ = true;
    bool needsUpdateConstraints_ = false;
};

}  // namespace wp::ui
