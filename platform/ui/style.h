#pragma once

namespace wp::ui {

/// Red, green, blue and opacity, each 0 to 1.
struct Color {
    double red = 0;
    double green = 0;
    double blue = 0;
    double alpha = 1;

    static constexpr Color white(double level, double alpha = 1) { return {level, level, level, alpha}; }
    static constexpr Color black() { return white(0); }
    static constexpr Color white() { return white(1); }
    static constexpr Color lightGray() { return white(2.0 / 3); }
    static constexpr Color clear() { return white(0, 0); }
    friend bool operator==(const Color&, const Color&) = default;
};

enum class TextStyle {
    system,  ///< the plain system font of a given size
    body,    ///< running text
    title2,  ///< the second of the title styles
};

/// A font by its role and size in points. A front end answers with a face of its own.
struct Font {
    TextStyle style = TextStyle::system;
    double size = 29;

    static constexpr Font system(double size) { return {TextStyle::system, size}; }
    /// 29 points: read from three metres on a screen of 1080 lines.
    static constexpr Font body() { return {TextStyle::body, 29}; }
    /// 57 points: below the 60 that a title bar 145 points high has room for.
    static constexpr Font title2() { return {TextStyle::title2, 57}; }
    friend bool operator==(const Font&, const Font&) = default;
};

enum class TextAlignment { left = 0, center = 1, right = 2 };
enum class LineBreakMode { byWordWrapping = 0, byTruncatingTail = 4 };
enum class BaselineAdjustment { alignBaselines = 0, alignCenters = 1, none = 2 };
enum class ContentMode { scaleToFill = 0, left = 7 };
/// How a row comes and goes. A front end without motion may ignore it.
enum class RowAnimation { fade = 0, none = 5 };
enum class Animated { no, yes };

}  // namespace wp::ui
