#include "host/report/heard_networks.h"

#include <algorithm>
#include <map>
#include <tuple>

namespace wp::host {
namespace {

const char* wordOf(HeardBand band) {
    return band == HeardBand::ghz2 ? "2.4GHz" : band == HeardBand::ghz5 ? "5GHz" : "6GHz";
}

Array arrayIn(const DictionaryPointer& dictionary, std::string_view key) {
    std::optional<Value> value = dictionary ? dictionary->value(key) : std::nullopt;
    const ArrayPointer* array = value ? value->as<ArrayPointer>() : nullptr;
    return array ? **array : Array{};
}

std::optional<int> integerIn(const DictionaryPointer& dictionary, std::string_view key) {
    std::optional<double> number = numberIn(dictionary, key);
    bool isSane = number && *number >= -1e6 && *number <= 1e6;
    return isSane ? std::optional(static_cast<int>(*number)) : std::nullopt;
}

/// A network twice 80 MHz wide that lies apart has two centres, and half of the width around each.
std::vector<std::pair<int, int>> spansOf(const DictionaryPointer& entry) {
    std::vector<std::pair<int, int>> spans;
    Array centres = arrayIn(entry, "centreFrequencies");
    if (centres.empty())
        if (std::optional<Value> frequency = entry->value("frequency")) centres.push_back(*frequency);
    int width = integerIn(entry, "width").value_or(20) / std::max(1, static_cast<int>(centres.size()));
    for (const Value& centre : centres) {
        DictionaryPointer one = Dictionary::make({{"centre", centre}});
        if (std::optional<int> middle = integerIn(one, "centre"))
            spans.emplace_back(*middle - width / 2, *middle + width / 2);
    }
    return spans;
}

HeardNetwork networkOf(const Evidence& evidence, const DictionaryPointer& entry) {
    HeardNetwork network;
    network.name = textIn(entry, "ssid");
    network.signal = integerIn(entry, "rssi");
    network.channel = integerIn(entry, "channel").value_or(0);
    network.spans = spansOf(entry);
    network.joined = flagIn(entry, "joined") == true;
    network.selected = network.name && network.name == evidence.selectedName && !network.joined;
    return network;
}

/// Of both networks' tests, since each phase may have missed what the other heard; the joined one's come first.
Array entriesOf(const Evidence& evidence) {
    Array entries = arrayIn(detailsOf(evidence, Part::joined, 24), "networks");
    for (const Value& value : arrayIn(detailsOf(evidence, Part::selected, 24), "networks"))
        entries.push_back(value);
    return entries;
}

constexpr int kNoSignal = -1000;

}  // namespace

std::vector<HeardNetwork> networksHeard(const Evidence& evidence, HeardBand band) {
    std::map<std::string, HeardNetwork> byAddress;
    for (const Value& value : entriesOf(evidence)) {
        const DictionaryPointer* entry = value.as<DictionaryPointer>();
        if (!entry || textIn(*entry, "band") != wordOf(band)) continue;
        HeardNetwork network = networkOf(evidence, *entry);
        HeardNetwork& kept = byAddress[textIn(*entry, "bssid").value_or("")];
        if (!kept.name) kept = std::move(network);
    }
    std::vector<HeardNetwork> networks;
    for (auto& [address, network] : byAddress) networks.push_back(std::move(network));
    std::ranges::stable_sort(networks, {}, [](const HeardNetwork& network) {
        return std::tuple(-network.signal.value_or(kNoSignal), network.channel, network.name);
    });
    return networks;
}

}  // namespace wp::host
