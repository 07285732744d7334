#include "host/report/html/ping_picture.h"

#include <algorithm>
#include <cstdio>

namespace wp::host {
namespace {

constexpr double kWidth = 360, kTop = 24, kBottom = 96, kMost = 72;
constexpr double kFloor = 1;  // ms: answers that are all quicker than this are not drawn as if they differed

std::string coordinate(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.1f", value);
    return text;
}

void drawLost(double middle, Markup& markup) {
    const std::string left = coordinate(middle - 8), right = coordinate(middle + 8);
    const std::string upper = coordinate(kBottom - 20), lower = coordinate(kBottom - 4);
    markup.empty("path", {{"class", "lost"},
                          {"d", "M" + left + " " + upper + "L" + right + " " + lower + "M" + left + " " +
                                    lower + "L" + right + " " + upper}});
}

void drawAnswer(double middle, double width, double share, Markup& markup) {
    const double height = std::max(2.0, share * (kBottom - kTop));
    markup.empty("rect", {{"class", "answer"},
                          {"x", coordinate(middle - width / 2)},
                          {"y", coordinate(kBottom - height)},
                          {"width", coordinate(width)},
                          {"height", coordinate(height)}});
}

}  // namespace

void drawPings(const PingPicture& picture, Markup& markup) {
    markup.openPicture("pings", "0 0 360 120", picture.words);
    double longest = kFloor;
    for (const auto& time : picture.times) longest = std::max(longest, time.value_or(0));
    const double step = kWidth / static_cast<double>(std::max<std::size_t>(1, picture.times.size()));
    for (std::size_t i = 0; i < picture.times.size(); ++i) {
        const double middle = step * (static_cast<double>(i) + 0.5);
        const auto& time = picture.times[i];
        if (time) drawAnswer(middle, std::min(step * 0.5, kMost / 2), *time / longest, markup);
        if (!time) drawLost(middle, markup);
        if (i < picture.labels.size())
            markup.element("text", picture.labels[i],
                           {{"class", "value"}, {"x", coordinate(middle)}, {"y", coordinate(kBottom + 18)}});
    }
    markup.empty("line", {{"class", "base"},
                          {"x1", "0"},
                          {"x2", coordinate(kWidth)},
                          {"y1", coordinate(kBottom)},
                          {"y2", coordinate(kBottom)}});
    markup.close();
}

}  // namespace wp::host
