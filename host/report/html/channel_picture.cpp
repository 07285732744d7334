#include "host/report/html/channel_picture.h"

#include <algorithm>
#include <cstdio>
#include <span>
#include <utility>

#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

using Role = PicturedNetwork::Role;

// All lengths are in the picture's own units, which the page scales to its width.
constexpr double kLeft = 44, kRight = 708, kTop = 40, kBottom = 280, kGap = 14;
constexpr double kStrongest = -20, kWeakest = -100;  // dBm
constexpr double kLetter = 7.4, kWideLetter = 13.5, kLine = 17;
constexpr std::size_t kLongestName = 20;

/// A stretch of the spectrum, and which of its channels are named.
struct Stretch {
    int from, to;  ///< MHz
    int firstChannel, firstCentre;
    int channelStep, lastChannel;
};

// A device's channels: 1 to 13 of 2.4 GHz, the three stretches of 5 GHz with what lies between left out, 6 GHz.
constexpr Stretch k2GHz[] = {{2397, 2487, 1, 2412, 1, 13}};
constexpr Stretch k5GHz[] = {
    {5170, 5330, 36, 5180, 8, 64}, {5490, 5730, 100, 5500, 8, 144}, {5735, 5895, 149, 5745, 8, 177}};
constexpr Stretch k6GHz[] = {{5945, 7125, 1, 5955, 16, 233}};

std::span<const Stretch> stretchesOf(ChannelPicture::Band band) {
    if (band == ChannelPicture::Band::ghz2) return k2GHz;
    if (band == ChannelPicture::Band::ghz5) return k5GHz;
    return k6GHz;
}

std::string coordinate(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.1f", value);
    return text;
}

/// Where frequencies lie in the picture.
class Scale {
  public:
    explicit Scale(std::span<const Stretch> stretches) : stretches_(stretches) {
        int sum = 0;
        for (const Stretch& each : stretches_) sum += each.to - each.from;
        const double gaps = kGap * static_cast<double>(stretches_.size() - 1);
        unit_ = (kRight - kLeft - gaps) / sum;
    }
    double begin(std::size_t index) const {
        double x = kLeft;
        for (std::size_t i = 0; i < index; ++i) x += unit_ * (stretches_[i].to - stretches_[i].from) + kGap;
        return x;
    }
    double at(std::size_t index, int frequency) const {
        return begin(index) + unit_ * (frequency - stretches_[index].from);
    }

  private:
    std::span<const Stretch> stretches_;
    double unit_ = 1;
};

double heightOf(int signal) {
    const double clamped = std::clamp(static_cast<double>(signal), kWeakest + 2, kStrongest);
    return kBottom - (clamped - kWeakest) / (kStrongest - kWeakest) * (kBottom - kTop);
}

struct Box {
    double left, right, top;
    bool meets(const Box& other) const {
        return left < other.right && other.left < right && top < other.top + kLine && other.top < top + kLine;
    }
};

/// A name cut to what a picture has room for, and how wide it is about.
std::pair<std::string, double> shortened(const std::string& name) {
    const std::string shown = ui::displayForm(name);
    std::string text;
    double width = 0;
    std::size_t count = 0;
    for (std::string_view rest = shown; !rest.empty(); ++count) {
        if (count == kLongestName) return {text + "…", width + kWideLetter};
        const ui::Utf8Character next = ui::takeCharacter(rest);
        text += next.bytes;
        width += next.value.value_or(0) >= 0x1100 ? kWideLetter : kLetter;
    }
    return {text, width};
}

class Drawing {
  public:
    Drawing(const ChannelPicture& picture, Markup& markup)
        : picture_(picture), markup_(markup), stretches_(stretchesOf(picture.band)), scale_(stretches_) {}

    void draw() {
        markup_.openPicture("channels", "0 0 720 320", picture_.words);
        drawHatch();
        drawRadar();
        drawGrid();
        for (std::size_t i = 0; i < stretches_.size(); ++i) drawChannelNames(i);
        for (const Role role : {Role::other, Role::selected, Role::joined})
            for (const PicturedNetwork& network : picture_.networks)
                if (network.role == role) drawShape(network);
        drawLabels();
        markup_.close();
    }

  private:
    std::string hatch() const { return picture_.words.identifier + "-hatch"; }

    void drawHatch() {
        markup_.open("defs");
        markup_.open("pattern", {{"id", hatch()},
                                 {"width", "7"},
                                 {"height", "7"},
                                 {"patternUnits", "userSpaceOnUse"},
                                 {"patternTransform", "rotate(45)"}});
        markup_.empty("line", {{"class", "hatch"}, {"x1", "0"}, {"y1", "0"}, {"x2", "0"}, {"y2", "7"}});
        markup_.close();
        markup_.close();
    }

    void drawGrid() {
        for (int signal = -90; signal <= -30; signal += 20) {
            const std::string y = coordinate(heightOf(signal));
            markup_.empty("line", {{"class", "grid"},
                                   {"x1", coordinate(kLeft)},
                                   {"x2", coordinate(kRight)},
                                   {"y1", y},
                                   {"y2", y}});
            markup_.element("text", "\u2212" + std::to_string(-signal),
                            {{"class", "scale"}, {"x", coordinate(kLeft - 6)}, {"y", y}, {"dy", "4"}});
        }
        markup_.element("text", "dBm", {{"class", "note"}, {"x", "2"}, {"y", "22"}});
        for (std::size_t i = 0; i < stretches_.size(); ++i)
            markup_.empty("line", {{"class", "base"},
                                   {"x1", coordinate(scale_.begin(i))},
                                   {"x2", coordinate(scale_.at(i, stretches_[i].to))},
                                   {"y1", coordinate(kBottom)},
                                   {"y2", coordinate(kBottom)}});
    }

    void drawChannelNames(std::size_t index) {
        const Stretch& stretch = stretches_[index];
        int place = 0;
        for (int channel = stretch.firstChannel; channel <= stretch.lastChannel;
             channel += stretch.channelStep, ++place) {
            const int centre = stretch.firstCentre + 5 * (channel - stretch.firstChannel);
            markup_.element("text", std::to_string(channel),
                            {{"class", place % 2 == 0 ? "channel" : "channel between"},
                             {"x", coordinate(scale_.at(index, centre))},
                             {"y", coordinate(kBottom + 24)}});
        }
    }

    /// Channels that are shared with radar, as a line of their own under the base.
    void drawRadar() {
        if (picture_.radar.empty()) return;
        bool named = false;
        for (std::size_t i = 0; i < stretches_.size(); ++i)
            for (const int channel : picture_.radarChannels) {
                const int centre = 5000 + 5 * channel;
                if (centre < stretches_[i].from || centre > stretches_[i].to) continue;
                const double x = scale_.at(i, centre - 10);
                markup_.empty("rect", {{"class", "radar"},
                                       {"x", coordinate(x)},
                                       {"y", coordinate(kTop - 12)},
                                       {"width", coordinate(scale_.at(i, centre + 10) - x)},
                                       {"height", coordinate(kBottom - kTop + 12)}});
                if (!std::exchange(named, true))
                    markup_.element(
                        "text", picture_.radar,
                        {{"class", "note"}, {"x", coordinate(x + 2)}, {"y", coordinate(kTop - 18)}});
            }
    }

    void drawShape(const PicturedNetwork& network) {
        if (!network.signal) return;
        const std::string y = coordinate(heightOf(*network.signal));
        for (std::size_t i = 0; i < stretches_.size(); ++i)
            for (const auto& [low, high] : network.spans) {
                const int from = std::max(low, stretches_[i].from), to = std::min(high, stretches_[i].to);
                if (from >= to) continue;
                const double left = scale_.at(i, from), right = scale_.at(i, to);
                const double slope = std::min(5.0, (right - left) / 4);
                const std::string path = "M" + coordinate(left) + " " + coordinate(kBottom) + "L" +
                                         coordinate(left + slope) + " " + y + "H" +
                                         coordinate(right - slope) + "L" + coordinate(right) + " " +
                                         coordinate(kBottom) + "Z";
                Markup::Attributes attributes{{"d", path}, {"class", classOf(network.role)}};
                if (network.role == Role::joined)
                    attributes.push_back({"style", "fill:url(#" + hatch() + ")"});
                markup_.empty("path", attributes);
            }
    }

    static std::string classOf(Role role) {
        return role == Role::joined     ? "network joined"
               : role == Role::selected ? "network selected"
                                        : "network";
    }

    /// The middle of the network's first part that is in the picture.
    std::optional<double> middleOf(const PicturedNetwork& network) const {
        for (std::size_t i = 0; i < stretches_.size(); ++i)
            for (const auto& [low, high] : network.spans) {
                const int from = std::max(low, stretches_[i].from), to = std::min(high, stretches_[i].to);
                if (from < to) return (scale_.at(i, from) + scale_.at(i, to)) / 2;
            }
        return std::nullopt;
    }

    void drawLabels() {
        for (const bool own : {true, false})
            for (std::size_t i = 0; i < picture_.networks.size(); ++i)
                if ((picture_.networks[i].role != Role::other) == own) drawLabel(i);
    }

    /// Number and name above the shape, higher where another label is in the way; the number alone where there
    /// is no room at all.
    void drawLabel(std::size_t index) {
        const PicturedNetwork& network = picture_.networks[index];
        const auto middle = middleOf(network);
        if (!middle || !network.signal) return;
        const std::string number = std::to_string(index + 1);
        auto [name, width] = shortened(network.name);
        double half = (width + kLetter * static_cast<double>(number.size() + 1)) / 2;
        std::optional<Box> box = freeBox(*middle, half, heightOf(*network.signal));
        if (!box) {
            name.clear();
            half = kLetter * static_cast<double>(number.size()) / 2 + 2;
            box = freeBox(*middle, half, heightOf(*network.signal));
        }
        if (!box) return;
        taken_.push_back(*box);
        markup_.open("text", {{"class", network.role == Role::other ? "label" : "label own"},
                              {"x", coordinate((box->left + box->right) / 2)},
                              {"y", coordinate(box->top + kLine - 5)}});
        markup_.element("tspan", number, {{"class", "number"}});
        if (!name.empty()) markup_.element("tspan", " " + name, {{"class", "name"}});
        markup_.close();
    }

    std::optional<Box> freeBox(double middle, double half, double shapeTop) const {
        const double centre = std::clamp(middle, kLeft + half, std::max(kLeft + half, kRight - half));
        for (Box box{centre - half, centre + half, shapeTop - kLine}; box.top >= 0; box.top -= 4)
            if (std::none_of(taken_.begin(), taken_.end(), [&](const Box& each) { return box.meets(each); }))
                return box;
        return std::nullopt;
    }

    const ChannelPicture& picture_;
    Markup& markup_;
    std::span<const Stretch> stretches_;
    Scale scale_;
    std::vector<Box> taken_;
};

}  // namespace

void drawChannels(const ChannelPicture& picture, Markup& markup) {
    Drawing(picture, markup).draw();
}

}  // namespace wp::host
