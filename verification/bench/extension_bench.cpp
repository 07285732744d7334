#include <benchmark/benchmark.h>

#include <ctime>

#include "verification/unit/fakes/diagnostic_run.h"

// What the extension itself costs: the service of these runs answers at once, and their clock is a virtual one, so
// that the half second before the end is not waited for.

namespace {

using wp::Dictionary;
using wp::DictionaryPointer;
using namespace wp::fakes;

/// Every test answers with all the information that any test reads.
void answerEverything(FakeDiagnosticsClient& service) {
    auto remembered = std::make_shared<wp::PreferredNetworkRecord>();
    remembered->ssid = "Home";
    remembered->lastJoined = wp::Date{780'000'000};
    auto ping = std::make_shared<wp::PingStatistics>();
    ping->interfaceName = "wlan0";
    auto channel = std::make_shared<wp::WiFiChannel>(36);
    DictionaryPointer info = Dictionary::make({{"BTConnectedCount", 1},
                                               {"BTPairedCount", 2},
                                               {"PNLCount", 3},
                                               {"BeaconInterval", 100},
                                               {"DTIMInterval", 2},
                                               {"Security", "WPA2"},
                                               {"NetworkName", "Home"},
                                               {"PreferredNetwork", remembered},
                                               {"SupportedPHYModes", "802.11ac"},
                                               {"MarlixModelName", "M5"},
                                               {"PingResult", ping},
                                               {"CurrentChannel", channel},
                                               {"2GHzChannel", channel},
                                               {"5GHzChannel", channel},
                                               {"5GHz40MHzChannel", channel},
                                               {"5GHzNonDFSChannel", channel},
                                               {"AdoptedCountryCode", "DE"},
                                               {"RSSI", -50},
                                               {"Noise", -95}});
    service.setDefaultOutcome(outcome(false, true, info));
    service.setJoinedNetwork("Home");
}

double processorSeconds() {
    timespec now{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
}

/// A whole run of 56 tests from `start` to the sealed result; making device and screen is not counted.
void wholeRunOf56Tests(benchmark::State& state, const wp::DiagnosticsTestResponse* everyTest) {
    for (auto _ : state) {
        DiagnosticRun run(NetworkList::hidden, "Office");
        answerEverything(run.device.service);
        if (everyTest) run.device.service.setDefaultOutcome(*everyTest);
        double begin = processorSeconds();
        run.runToEnd();
        state.SetIterationTime(processorSeconds() - begin);
        if (run.statusCode() != 0 || run.controller->completedTests() != 56) {
            state.SkipWithError("the run did not go through its 56 tests");
            break;
        }
    }
}

void runOnAnInstantService(benchmark::State& state) {
    wholeRunOf56Tests(state, nullptr);
}
BENCHMARK(runOnAnInstantService)->UseManualTime()->Unit(benchmark::kMicrosecond);

/// The same with every test failing, each with its log line.
void runOnAServiceThatFails(benchmark::State& state) {
    const wp::DiagnosticsTestResponse error = failure(110, "timed out");
    wholeRunOf56Tests(state, &error);
}
BENCHMARK(runOnAServiceThatFails)->UseManualTime()->Unit(benchmark::kMicrosecond);

}  // namespace
