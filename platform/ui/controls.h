#pragma once

#include <algorithm>
#include <string>

#include "platform/ui/view.h"

namespace wp::ui {

/// A progress bar. *Main*.
class ProgressView : public View {
  public:
    enum class Style { standard = 0 };

    explicit ProgressView(Style style = Style::standard) : style_(style) {}

    Style style() const { return style_; }
    /// The fraction done, 0 to 1, in single precision.
    float progress() const { return progress_; }
    /// A value outside is taken as the nearest one inside; one that is no number as 0.
    void setProgress(float progress) { set(progress_, progress > 0 ? std::min(progress, 1.0F) : 0.0F); }
    /// Of how many equal steps the whole consists, for a front end that says n/m; 0: not known.
    int stepCount() const { return stepCount_; }
    void setStepCount(int count) { set(stepCount_, count); }
    const Color& trackColor() const { return trackColor_; }
    void setTrackColor(Color color) { set(trackColor_, color); }

    /// 10 points high, seen from three metres; as wide as the layout wants.
    IntrinsicSize intrinsicSize(double) const override { return {std::nullopt, 10}; }

  private:
    Style style_;
    float progress_ = 0;
    int stepCount_ = 0;
    Color trackColor_ = Color::white(0.9);
};

/// A sign that something is going on. *Main*.
class ActivityIndicator : public View {
  public:
    enum class Style { whiteLarge = 0, white = 1, gray = 2 };

    explicit ActivityIndicator(Style style) : style_(style) {}

    Style style() const { return style_; }
    bool isAnimating() const { return animating_; }
    void startAnimating() { set(animating_, true); }
    void stopAnimating() { set(animating_, false); }

  private:
    Style style_;
    bool animating_ = false;
};

/// A picture of the program's resources by its name. *Main*.
class ImageView : public View {
  public:
    /// Vibrant: drawn in the colours of what is behind it, where the front end can.
    enum class Kind { plain, vibrant };

    explicit ImageView(std::string imageName, Kind kind = Kind::plain)
        : imageName_(std::move(imageName)), kind_(kind) {}

    const std::string& imageName() const { return imageName_; }
    Kind kind() const { return kind_; }
    /// The picture's size, which the front end knows; as long as it does not say, 240 by 240.
    Size imageSize() const { return imageSize_; }
    void setImageSize(Size size) { setContent(imageSize_, size); }

    IntrinsicSize intrinsicSize(double) const override { return {imageSize_.width, imageSize_.height}; }

  private:
    std::string imageName_;
    Kind kind_;
    Size imageSize_ = {240, 240};
};

}  // namespace wp::ui
