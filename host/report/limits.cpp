#include "host/report/limits.h"

#include <cmath>

#include "host/report/evidence.h"

namespace wp::host {
namespace {

constexpr double kLargestCount = 1e9;

TextValues oneLimit(std::int64_t number) {
    return {{"limit", std::to_string(number)}};
}

TextValues limitsOfChannel(int testID, const CongestionLimits& limits, const Texts& texts) {
    TextValues values = {
        {"load", texts.number(100 * limits.load, 0)},
        {"overlap", texts.number(limits.overlap, limits.overlap == std::floor(limits.overlap) ? 0 : 1)}};
    if (testID == 24) values.emplace_back("advertised", std::to_string(limits.advertisedLoad));
    return values;
}

void replace(unsigned& limit, const DictionaryPointer& configured, const char* key) {
    std::optional<double> number = numberIn(configured, key);
    if (number && *number >= 0 && *number <= kLargestCount) limit = static_cast<unsigned>(*number);
}

void replace(double& limit, const DictionaryPointer& configured, const char* key) {
    limit = numberIn(configured, key).value_or(limit);
}

}  // namespace

Thresholds thresholdsFrom(const DictionaryPointer& configured) {
    Thresholds thresholds;
    replace(thresholds.bluetooth.connected, configured, "connectedBluetooth");
    replace(thresholds.bluetooth.paired, configured, "pairedBluetooth");
    replace(thresholds.saved.count, configured, "savedNetworks");
    replace(thresholds.congestion.advertisedLoad, configured, "advertisedLoad");
    replace(thresholds.congestion.load, configured, "channelLoad");
    replace(thresholds.congestion.overlap, configured, "overlap");
    return thresholds;
}

Thresholds thresholdsOf(const Evidence& evidence, const Thresholds& others) {
    auto told = [&](Part part, int testID) {
        return dictionaryIn(detailsOf(evidence, part, testID), "Thresholds");
    };
    Thresholds thresholds = others;
    replace(thresholds.bluetooth.connected, told(Part::device, 19), "devices");
    replace(thresholds.bluetooth.paired, told(Part::device, 18), "devices");
    replace(thresholds.saved.count, told(Part::device, 47), "networks");
    DictionaryPointer channel = told(Part::joined, 24);
    replace(thresholds.congestion.load, channel, "measuredLoad");
    replace(thresholds.congestion.overlap, channel, "overlap");
    return thresholds;
}

TextValues limitsOf(int testID, const Thresholds& thresholds, const Texts& texts) {
    switch (testID) {
        case 3:
        case 6:
            return oneLimit(kEchoRequests);
        case 7:
            return oneLimit(kNameTime.count());
        case 9:
        case 11:
            return oneLimit(kServiceTime.count());
        case 18:
            return oneLimit(thresholds.bluetooth.paired);
        case 19:
            return oneLimit(thresholds.bluetooth.connected);
        case 24:
        case 25:
        case 26:
            return limitsOfChannel(testID, thresholds.congestion, texts);
        case 28:
            return oneLimit(kWeakestCountrySignal);
        case 32:
            return {{"limit", std::to_string(kWeakestSignal)},
                    {"noise", std::to_string(kLeastSignalToNoise)}};
        case 34:
            return oneLimit(kLongestBeaconInterval);
        case 35:
            return oneLimit(kLongestDtimPeriod);
        case 41:
            return oneLimit(kFastest11bRate / 2);
        case 47:
            return oneLimit(thresholds.saved.count);
        default:
            return {};
    }
}

}  // namespace wp::host
