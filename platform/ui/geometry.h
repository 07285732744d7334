#pragma once

namespace wp::ui {

/// All lengths are in points; a screen has 1920 by 1080 of them unless it says otherwise. Origin: top left.
struct Point {
    double x = 0;
    double y = 0;
    friend bool operator==(Point, Point) = default;
};

struct Size {
    double width = 0;
    double height = 0;
    friend bool operator==(Size, Size) = default;
};

struct Rect {
    double x = 0;
    double y = 0;
    double width = 0;
    double height = 0;

    double right() const { return x + width; }
    double bottom() const { return y + height; }
    friend bool operator==(Rect, Rect) = default;
};

struct EdgeInsets {
    double top = 0;
    double left = 0;
    double bottom = 0;
    double right = 0;
    friend bool operator==(EdgeInsets, EdgeInsets) = default;
};

}  // namespace wp::ui
