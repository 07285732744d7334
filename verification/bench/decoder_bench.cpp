#include <benchmark/benchmark.h>

#include <cstring>
#include <fstream>
#include <iterator>

#include "linux/radio_messages.h"

namespace wp {
namespace {

std::vector<std::uint8_t> capturedScan(const std::string& scenario) {
    std::ifstream file(WP_SOURCE_DIR "/verification/data/netlink/" + scenario + "-scan.bin",
                       std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// The richest beacon of the captures: 802.11ax with all that belongs to it.
std::vector<std::uint8_t> richBeacon() {
    std::vector<std::uint8_t> richest;
    for (const AccessPoint& each : readAccessPoints(capturedScan("wifi6"), 0)) {
        if (each.elements.size() > richest.size()) richest = each.elements;
    }
    return richest;
}

void DecodeBeacon(benchmark::State& state) {
    const std::vector<std::uint8_t> beacon = richBeacon();
    for (auto _ : state) benchmark::DoNotOptimize(decodeAdvertised(0x0411, beacon, Bytes(beacon)));
    state.SetLabel(std::to_string(beacon.size()) + " bytes");
}
BENCHMARK(DecodeBeacon);

/// A dump of access points with probe response and beacon each, as the kernel sends it, made longer by repeating the
/// captured messages.
std::vector<std::uint8_t> dumpOf(std::size_t accessPoints) {
    std::vector<std::uint8_t> dump;
    for (const char* scenario : {"wifi6", "phy-conflict-11ac", "wpa1-other-country", "good-home"}) {
        const std::vector<std::uint8_t> captured = capturedScan(scenario);
        dump.insert(dump.end(), captured.begin(), captured.end());
    }
    const std::size_t once = readAccessPoints(dump, 0).size();
    const std::vector<std::uint8_t> pattern = dump;
    for (std::size_t count = once; count < accessPoints; count += once) {
        dump.insert(dump.end(), pattern.begin(), pattern.end());
    }
    return dump;
}

void ReadDump(benchmark::State& state) {
    const std::vector<std::uint8_t> dump = dumpOf(static_cast<std::size_t>(state.range(0)));
    std::size_t read = 0;
    for (auto _ : state) {
        const std::vector<AccessPoint> accessPoints = readAccessPoints(dump, 0);
        read = accessPoints.size();
        benchmark::DoNotOptimize(accessPoints.data());
    }
    state.counters["access points"] = static_cast<double>(read);
}
BENCHMARK(ReadDump)->Arg(1000)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace wp
