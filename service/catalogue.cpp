#include "service/catalogue.h"

#include <algorithm>

#include "service/connectivity_tests.h"
#include "service/network_tests.h"
#include "service/radio_tests.h"
#include "service/scan_tests.h"

namespace wp {
namespace {

constexpr Fact kJudged[] = {Fact::judged};
constexpr Fact kNetwork[] = {Fact::judged, Fact::nearby};
constexpr Fact kStation[] = {Fact::judged, Fact::station};
constexpr Fact kSignal[] = {Fact::judged, Fact::station, Fact::survey};
constexpr Fact kCountry[] = {Fact::judged, Fact::nearby, Fact::regulation};
constexpr Fact kNearby[] = {Fact::nearby};
constexpr Fact kListened[] = {Fact::nearby, Fact::listened};
constexpr Fact kAddresses[] = {Fact::link, Fact::addresses};
constexpr Fact kGateway[] = {Fact::gatewayEcho};

// clang-format off
constexpr NumberedTest kTests[] = {
    { 3, Subject::joined,  kGateway,     gatewayAnswers},
    { 6, Subject::joined,  {},           nullptr},
    { 7, Subject::joined,  {},           nullptr},
    { 8, Subject::joined,  {},           nullptr},
    { 9, Subject::joined,  {},           nullptr},
    {11, Subject::joined,  {},           nullptr},
    {12, Subject::joined,  kAddresses,   hasIPv4Address},
    {13, Subject::joined,  kAddresses,   hasIPv6Address},
    {14, Subject::device,  {},           nullptr},
    {15, Subject::device,  {},           nullptr},
    {16, Subject::device,  {},           nullptr},
    {17, Subject::device,  {},           nullptr},
    {18, Subject::device,  {},           nullptr},
    {19, Subject::device,  {},           nullptr},
    {20, Subject::device,  {},           nullptr},
    {22, Subject::device,  {},           nullptr},
    {24, Subject::network, {},           nullptr},
    {25, Subject::joined,  {},           nullptr},
    {26, Subject::joined,  {},           nullptr},
    {27, Subject::joined,  kJudged,      usesFortyMegahertzIn2GHz},
    {28, Subject::network, kCountry,     countryCodesConflict},
    {29, Subject::device,  {},           nullptr},
    {30, Subject::joined,  kListened,    foundHiddenNetworks},
    {31, Subject::scan,    kNearby,      foundNoNetworks},
    {32, Subject::network, kSignal,      signalIsPoor},
    {33, Subject::network, {},           nullptr},
    {34, Subject::network, kJudged,      beaconIntervalIsLong},
    {35, Subject::joined,  kStation,     dtimIntervalIsLong},
    {36, Subject::network, kNetwork,     modesConflict11AC},
    {37, Subject::network, kNetwork,     modesConflict11N},
    {38, Subject::network, kJudged,      securityIsOpen},
    {39, Subject::network, kJudged,      securityIsWep},
    {40, Subject::network, kJudged,      securityIsWpa},
    {41, Subject::network, kJudged,      ratesAreLegacy},
    {42, Subject::network, kNetwork,     nameIsAmbiguous},
    {43, Subject::network, kJudged,      nameIsHidden},
    {44, Subject::network, {},           nullptr},
    {45, Subject::network, kJudged,      isPasspoint},
    {46, Subject::network, {},           nullptr},
    {47, Subject::device,  {},           nullptr},
    {48, Subject::device,  {},           nullptr},
};
// clang-format on

}  // namespace

std::span<const NumberedTest> numberedTests() {
    return kTests;
}

const NumberedTest* findTest(int number) {
    const NumberedTest* found = std::ranges::lower_bound(kTests, number, {}, &NumberedTest::number);
    return found != std::end(kTests) && found->number == number ? found : nullptr;
}

Outcome judge(const NumberedTest& test, const Facts& facts) {
    if (test.verdict != nullptr) return test.verdict(facts);
    return failure(Reason::unsupported, "test " + std::to_string(test.number) + " is not measured yet");
}

}  // namespace wp
