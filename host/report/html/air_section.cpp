#include "host/report/html/air_section.h"

#include <algorithm>

#include "host/report/heard_networks.h"
#include "host/report/html/channel_picture.h"
#include "host/report/html/ping_picture.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

struct BandOfAir {
    HeardBand heard;
    ChannelPicture::Band pictured;
    const char* name;
    const char* identifier;
};

constexpr BandOfAir kBands[] = {{HeardBand::ghz2, ChannelPicture::Band::ghz2, "BAND_2", "band-2"},
                                {HeardBand::ghz5, ChannelPicture::Band::ghz5, "BAND_5", "band-5"},
                                {HeardBand::ghz6, ChannelPicture::Band::ghz6, "BAND_6", "band-6"}};

Array arrayIn(const DictionaryPointer& dictionary, std::string_view key) {
    const std::optional<Value> value = dictionary ? dictionary->value(key) : std::nullopt;
    const ArrayPointer* array = value ? value->as<ArrayPointer>() : nullptr;
    return array && *array ? **array : Array();
}

std::vector<int> radarChannels(const Evidence& evidence) {
    std::vector<int> channels;
    for (const Part part : {Part::joined, Part::selected}) {
        for (const Value& value : arrayIn(detailsOf(evidence, part, 24), "channels")) {
            const DictionaryPointer* entry = value.as<DictionaryPointer>();
            const std::optional<double> number = entry ? numberIn(*entry, "channel") : std::nullopt;
            if (number && *number > 14 && *number < 200 && flagIn(*entry, "radar") == true)
                channels.push_back(static_cast<int>(*number));
        }
        if (!channels.empty()) break;
    }
    return channels;
}

int widthOf(const HeardNetwork& network) {
    int width = 0;
    for (const auto& [low, high] : network.spans) width += high - low;
    return width;
}

class AirWriter {
  public:
    AirWriter(const Evidence& evidence, const Texts& texts, Markup& markup)
        : evidence_(evidence), texts_(texts), markup_(markup) {}

    void writeChannels() {
        bool begun = false;
        for (const BandOfAir& band : kBands) {
            const std::vector<HeardNetwork> networks = networksHeard(evidence_, band.heard);
            if (networks.empty()) continue;
            if (!begun) {
                markup_.open("section");
                markup_.element("h2", texts_.text("CHART"));
                markup_.element("p", texts_.text("HTML_CHANNELS_LEGEND"), {{"class", "legend"}});
                begun = true;
            }
            writeBand(band, networks);
        }
        if (begun) markup_.close();
    }

    void writePings() {
        bool begun = false;
        for (const auto& [testID, title, identifier] :
             {std::tuple{3, "FACT_ROUTER", "ping-3"}, std::tuple{6, "FACT_OUTSIDE", "ping-6"}}) {
            const Array times = arrayIn(detailsOf(evidence_, Part::joined, testID), "roundTripTimes");
            if (times.empty()) continue;
            if (!begun) {
                markup_.open("section");
                markup_.element("h2", texts_.text("HTML_PINGS"));
                begun = true;
            }
            writePing(texts_.text(title), identifier, times);
        }
        if (begun) markup_.close();
    }

  private:
    std::string nameOf(const HeardNetwork& network) const {
        return network.name ? ui::displayForm(*network.name) : texts_.text("CHART_HIDDEN");
    }

    PicturedNetwork pictured(const HeardNetwork& network) const {
        using Role = PicturedNetwork::Role;
        const Role role = network.joined ? Role::joined : network.selected ? Role::selected : Role::other;
        return {nameOf(network), network.signal, network.spans, role};
    }

    void writeBand(const BandOfAir& band, const std::vector<HeardNetwork>& networks) {
        ChannelPicture picture;
        picture.band = band.pictured;
        picture.words.identifier = band.identifier;
        picture.words.title = texts_.text("HTML_CHANNELS_TITLE", {{"band", texts_.text(band.name)}});
        picture.words.description = describe(networks);
        if (band.heard == HeardBand::ghz5) picture.radarChannels = radarChannels(evidence_);
        if (!picture.radarChannels.empty()) picture.radar = texts_.text("HTML_RADAR");
        for (const HeardNetwork& network : networks) picture.networks.push_back(pictured(network));
        markup_.raw("\n");
        markup_.open("figure");
        markup_.element("figcaption", texts_.text(band.name));
        drawChannels(picture, markup_);
        writeTable(picture.words.title, networks);
        markup_.close();
    }

    std::string describe(const std::vector<HeardNetwork>& networks) const {
        const std::string count = std::to_string(networks.size());
        const auto joined = std::find_if(networks.begin(), networks.end(),
                                         [](const HeardNetwork& network) { return network.joined; });
        if (joined == networks.end()) return texts_.text("HTML_CHANNELS_OTHERS", {{"count", count}});
        return texts_.text(
            "HTML_CHANNELS_JOINED",
            {{"count", count}, {"name", nameOf(*joined)}, {"channel", std::to_string(joined->channel)}});
    }

    void writeTable(const std::string& title, const std::vector<HeardNetwork>& networks) {
        markup_.open("table", {{"aria-label", title}});
        markup_.open("tr");
        for (const auto& [key, kind] : {std::pair{"HTML_COLUMN_NUMBER", "figure"},
                                        {"HTML_COLUMN_NAME", ""},
                                        {"HTML_COLUMN_CHANNEL", "figure"},
                                        {"HTML_COLUMN_WIDTH", "figure"},
                                        {"HTML_COLUMN_SIGNAL", "figure"}})
            markup_.element("th", texts_.text(key),
                            *kind ? Markup::Attributes{{"scope", "col"}, {"class", kind}}
                                  : Markup::Attributes{{"scope", "col"}});
        markup_.close();
        for (std::size_t i = 0; i < networks.size(); ++i) writeRow(i + 1, networks[i]);
        markup_.close();
    }

    void writeRow(std::size_t number, const HeardNetwork& network) {
        const bool own = network.joined || network.selected;
        markup_.raw("\n");
        markup_.open("tr", own ? Markup::Attributes{{"class", "own"}} : Markup::Attributes{});
        figure(std::to_string(number));
        markup_.open("td", {{"dir", "auto"}});
        markup_.text(nameOf(network));
        if (own) markup_.text(texts_.aside(texts_.text(network.joined ? "HTML_JOINED" : "HTML_SELECTED")));
        markup_.close();
        figure(std::to_string(network.channel));
        figure(texts_.text("HTML_WIDTH", {{"width", std::to_string(widthOf(network))}}));
        figure(network.signal ? texts_.text("HTML_SIGNAL", {{"signal", texts_.number(*network.signal, 0)}})
                              : texts_.text("HTML_UNKNOWN"));
        markup_.close();
    }

    void figure(const std::string& text) { markup_.element("td", text, {{"class", "figure"}}); }

    void writePing(const std::string& title, const char* identifier, const Array& times) {
        PingPicture picture;
        picture.words.identifier = identifier;
        picture.words.title = title;
        for (const Value& value : times) {
            const DictionaryPointer one = Dictionary::make({{"time", value}});
            picture.times.push_back(numberIn(one, "time"));
            const auto& time = picture.times.back();
            picture.labels.push_back(
                time ? texts_.text("HTML_TIME", {{"time", texts_.number(*time, *time < 10 ? 1 : 0)}})
                     : texts_.text("HTML_LOST"));
        }
        picture.words.description = texts_.list(picture.labels);
        markup_.raw("\n");
        markup_.open("figure");
        markup_.element("figcaption", title);
        drawPings(picture, markup_);
        markup_.close();
    }

    const Evidence& evidence_;
    const Texts& texts_;
    Markup& markup_;
};

}  // namespace

void writeAir(const Evidence& evidence, const Texts& texts, Markup& markup) {
    AirWriter writer(evidence, texts, markup);
    writer.writeChannels();
    writer.writePings();
}

}  // namespace wp::host
