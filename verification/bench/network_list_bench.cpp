// What a scan costs on its way into the list: de-duplication, sort and difference together, and beside them the
// same by plain means (standard maps, the collator asked in every comparison); and a whole rescan up to the
// redrawn headless screen.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <map>
#include <string>
#include <vector>

#include "host/table_localization.h"
#include "network_list/scan_list.h"
#include "screens/headless/headless_screen.h"
#include "verification/unit/network_list/list_run.h"

namespace wp {
namespace {

using namespace fakes;

/// So many names, each heard from two access points; every third one is another in the second scan.
ArrayPointer scanOf(int names, int scan) {
    std::vector<AccessPoint> points;
    for (int point = 0; point < 2; ++point) {
        for (int i = 0; i < names; ++i) {
            int number = i * 7919 % names;
            std::string name = "Network " + std::to_string(number % 3 == 0 ? number + scan * names : number);
            points.push_back({name, "02:" + std::to_string(i), -90 + (i * 31 + point * 17) % 60});
        }
    }
    return scanArray(points);
}

const Localization& localization() {
    static const host::TableLocalization icu({"en", "en"});
    return icu;
}

std::size_t difference(const ScanList& before, const ScanList& after) {
    std::size_t changes = 0;
    for (const auto& network : before.filteredWiFiScanResults)
        changes += !after.filteredNetworks.contains(*network->ssid);
    for (const auto& network : after.filteredWiFiScanResults)
        changes += !before.filteredNetworks.contains(*network->ssid);
    return changes;
}

void rebuiltList(benchmark::State& state) {
    int names = static_cast<int>(state.range(0));
    ArrayPointer first = scanOf(names, 0);
    ArrayPointer second = scanOf(names, 1);
    ScanList before;
    reduceScan(first, nullptr, before);
    before.sort(localization());
    for (auto _ : state) {
        ScanList after;
        reduceScan(second, nullptr, after);
        after.sort(localization());  // every key anew, as in a first list
        benchmark::DoNotOptimize(difference(before, after));
    }
    state.SetComplexityN(names);
}

void rebuiltListWithKnownNames(benchmark::State& state) {
    int names = static_cast<int>(state.range(0));
    ArrayPointer second = scanOf(names, 1);
    ScanList before;
    reduceScan(scanOf(names, 0), nullptr, before);
    before.sort(localization());
    for (auto _ : state) {
        ScanList after;
        reduceScan(second, nullptr, after);
        after.sort(localization(), &before);
        benchmark::DoNotOptimize(difference(before, after));
    }
    state.SetComplexityN(names);
}

using PlainList = std::map<std::string, WiFiScanResultPointer>;

std::vector<WiFiScanResultPointer> plainRebuild(const ArrayPointer& scan, PlainList& list) {
    for (const Value& value : *scan) {
        auto entry = value.asRecord<WiFiScanResult>();
        auto held = list.find(*entry->ssid);
        if (held == list.end() || entry->rssi > held->second->rssi) list[*entry->ssid] = entry;
    }
    std::vector<WiFiScanResultPointer> sorted;
    for (const auto& [name, entry] : list) sorted.push_back(entry);
    std::stable_sort(sorted.begin(), sorted.end(), [](const auto& left, const auto& right) {
        return localization().collationKey(*left->ssid) < localization().collationKey(*right->ssid);
    });
    return sorted;
}

void plainBaseline(benchmark::State& state) {
    int names = static_cast<int>(state.range(0));
    ArrayPointer second = scanOf(names, 1);
    PlainList before;
    auto rowsBefore = plainRebuild(scanOf(names, 0), before);
    for (auto _ : state) {
        PlainList after;
        auto rows = plainRebuild(second, after);
        std::size_t changes = 0;
        for (const auto& network : rowsBefore) changes += !after.count(*network->ssid);
        for (const auto& network : rows) changes += !before.count(*network->ssid);
        benchmark::DoNotOptimize(changes);
    }
    state.SetComplexityN(names);
}

/// A rescan with a third of the networks replaced, from the key on the refresh row to the redrawn screen.
void rescanToScreen(benchmark::State& state) {
    int names = static_cast<int>(state.range(0));
    Activity activity;
    MainQueue unused(activity);
    ListRun run;
    headless::HeadlessScreen headless(run.device.screen, unused);
    DiagnosticsTestResponse scans[2];
    for (int scan : {0, 1})
        scans[scan] = outcome(false, true, Dictionary::make({{"ScanResults", scanOf(names, scan)}}));
    run.device.service.setOutcome(kScanTest, scans[0]);
    run.showList();
    headless.draw();
    int next = 1;
    for (auto _ : state) {
        run.device.service.setOutcome(kScanTest, scans[next]);
        next = 1 - next;
        run.refresh();
        headless.draw();
    }
    if (run.repairs() || headless.faults()) state.SkipWithError("the table was repaired");
    state.SetComplexityN(names);
}

BENCHMARK(rebuiltList)->Arg(50)->Arg(200)->Arg(1000)->Arg(10000)->Unit(benchmark::kMicrosecond)->Complexity();
BENCHMARK(rebuiltListWithKnownNames)->Arg(1000)->Arg(10000)->Unit(benchmark::kMicrosecond);
BENCHMARK(plainBaseline)
    ->Arg(50)
    ->Arg(200)
    ->Arg(1000)
    ->Arg(10000)
    ->Unit(benchmark::kMicrosecond)
    ->Complexity();
BENCHMARK(rescanToScreen)->Arg(200)->Arg(1000)->Unit(benchmark::kMicrosecond);

}  // namespace
}  // namespace wp
