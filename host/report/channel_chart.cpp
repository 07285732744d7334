#include "host/report/channel_chart.h"

#include <algorithm>
#include <span>

#include "host/report/heard_networks.h"
#include "host/unicode/unicode.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

constexpr std::size_t kMostNetworks = 12;  // in one band; more make no picture
constexpr int kColumns = 80, kIndent = 2;

/// A stretch of the spectrum whose channels are drawn side by side, `columns` for each `step` MHz.
struct Stretch {
    int from, to;  ///< MHz
    int step, columns;
    int firstChannel, channelStep;  ///< the channels that are named, from the first step on
    int namedEvery;                 ///< steps from one named channel to the next
};

struct BandPicture {
    HeardBand band;
    const char* name;
    std::span<const Stretch> stretches;
};

// Channel 1 of 2.4 GHz has its centre at 2412 MHz, 36 at 5180, 100 at 5500, 149 at 5745; 1 of 6 GHz at 5955.
constexpr Stretch k2GHz[] = {{2400, 2490, 5, 3, -1, 1, 1}};
constexpr Stretch k5GHz[] = {
    {5170, 5330, 20, 2, 36, 4, 2}, {5490, 5730, 20, 2, 100, 4, 2}, {5735, 5895, 20, 2, 149, 4, 2}};
constexpr Stretch k6GHz[] = {{5945, 7125, 20, 1, 1, 4, 8}};

constexpr BandPicture kBands[] = {{HeardBand::ghz2, "BAND_2", k2GHz},
                                  {HeardBand::ghz5, "BAND_5", k5GHz},
                                  {HeardBand::ghz6, "BAND_6", k6GHz}};

int widthOf(const Stretch& stretch) {
    return (stretch.to - stretch.from) / stretch.step * stretch.columns;
}

int widthOf(const BandPicture& picture) {
    int width = 0;
    for (const Stretch& stretch : picture.stretches) width += widthOf(stretch);
    return width;
}

/// The names of the channels above their places.
std::string scaleOf(const BandPicture& picture) {
    std::string scale(static_cast<std::size_t>(widthOf(picture)), ' ');
    int start = 0;
    for (const Stretch& stretch : picture.stretches) {
        int steps = (stretch.to - stretch.from) / stretch.step;
        for (int at = 0; at < steps; at += stretch.namedEvery) {
            int channel = stretch.firstChannel + at * stretch.channelStep;
            // 14 lies apart from the other channels of 2.4 GHz and is used in one country for 802.11b alone.
            if (channel < 1 || (picture.band == HeardBand::ghz2 && channel > 13)) continue;
            std::string label = std::to_string(channel);
            // Above the middle, where there is room for that.
            const int room = std::max(stretch.columns - static_cast<int>(label.size()), 0);
            const int column = start + at * stretch.columns + room / 2;
            const auto place = static_cast<std::size_t>(column);
            if (place + label.size() <= scale.size()) scale.replace(place, label.size(), label);
        }
        start += widthOf(stretch);
    }
    return scale;
}

/// The stronger, the denser; what a radio decodes well begins at -67 dBm, what it defers to at -82 dBm.
char markOf(const HeardNetwork& network) {
    int signal = network.signal.value_or(-100);
    return signal >= -55 ? '#' : signal >= -67 ? '=' : signal >= -82 ? '-' : '.';
}

std::string barOf(const BandPicture& picture, const HeardNetwork& network) {
    std::string bar(static_cast<std::size_t>(widthOf(picture)), ' ');
    int start = 0;
    for (const Stretch& stretch : picture.stretches) {
        for (auto [low, high] : network.spans) {
            int from = std::max(low, stretch.from), to = std::min(high, stretch.to);
            if (from >= to) continue;
            int first = start + (from - stretch.from) * stretch.columns / stretch.step;
            int last = start + ((to - stretch.from) * stretch.columns - 1) / stretch.step;
            for (int at = first; at <= last; ++at) bar[static_cast<std::size_t>(at)] = markOf(network);
        }
        start += widthOf(stretch);
    }
    return bar;
}

/// The name, cut to the columns.
std::string fitted(const std::string& text, int columns) {
    if (columnsOf(text) <= columns) return text;
    std::vector<std::string> lines = wrappedLines(text, columns - 1);
    return (lines.empty() ? "" : lines.front()) + "…";
}

std::string lineOf(const BandPicture& picture, const HeardNetwork& network, const Texts& texts) {
    std::string signal = network.signal ? std::to_string(*network.signal) : "";
    signal.insert(0, signal.size() < 5 ? 5 - signal.size() : 0, ' ');
    std::string line = std::string(kIndent, ' ') + barOf(picture, network) + signal;
    line += network.joined ? " *" : network.selected ? " +" : "  ";
    std::string name = network.name ? ui::displayForm(*network.name) : texts.text("CHART_HIDDEN");
    return line + fitted(name, kColumns - kIndent - widthOf(picture) - 7);
}

void addBand(const BandPicture& picture, const Evidence& evidence, const Texts& texts,
             std::vector<std::string>& lines) {
    std::vector<HeardNetwork> networks = networksHeard(evidence, picture.band);
    if (networks.empty()) return;
    if (!lines.empty()) lines.emplace_back();
    lines.push_back(texts.text(picture.name));
    std::string scale = std::string(kIndent, ' ') + scaleOf(picture);
    lines.push_back(scale.substr(0, scale.find_last_not_of(' ') + 1));
    std::size_t drawn = 0;
    for (const HeardNetwork& network : networks) {
        bool isOwn = network.joined || network.selected;
        if (drawn >= kMostNetworks && !isOwn) continue;
        lines.push_back(lineOf(picture, network, texts));
        ++drawn;
    }
    if (drawn < networks.size())
        lines.push_back(std::string(kIndent, ' ') +
                        texts.text("CHART_MORE", {{"count", std::to_string(networks.size() - drawn)}}));
}

}  // namespace

std::vector<std::string> channelChart(const Evidence& evidence, const Texts& texts) {
    std::vector<std::string> lines;
    for (const BandPicture& picture : kBands) addBand(picture, evidence, texts, lines);
    return lines;
}

}  // namespace wp::host
