#include "service/catalogue.h"

#include <algorithm>

#include "service/connectivity_tests.h"
#include "service/device_tests.h"
#include "service/network_tests.h"
#include "service/radio_tests.h"
#include "service/reach_tests.h"
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

constexpr Fact kSetup[] = {Fact::setup};
constexpr Fact kSaved[] = {Fact::saved};
constexpr Fact kBluetooth[] = {Fact::bluetooth};
constexpr Fact kSharing[] = {Fact::link, Fact::bluetooth, Fact::driverSharesAirtime};
constexpr Fact kPeers[] = {Fact::peerLinks};
constexpr Fact kOutside[] = {Fact::outsideEcho};
constexpr Fact kNames[] = {Fact::nameAnswer};
constexpr Fact kTranslation[] = {Fact::translation};
constexpr Fact kVendor[] = {Fact::vendorService};
constexpr Fact kChannel[] = {Fact::judged, Fact::link, Fact::nearby, Fact::airtime, Fact::allowedChannels};
constexpr Fact kMaker[] = {Fact::judged, Fact::router};
constexpr Fact kHotspot[] = {Fact::judged, Fact::setup};
constexpr Fact kPortal[] = {Fact::link, Fact::nearby, Fact::saved, Fact::portal};

// clang-format off
constexpr NumberedTest kTests[] = {
    { 3, Subject::joined,  kGateway,     gatewayAnswers},
    { 6, Subject::joined,  kOutside,     outsideAnswers},
    { 7, Subject::joined,  kNames,       namesResolve},
    { 8, Subject::joined,  kTranslation, isTranslatedTwice},
    { 9, Subject::joined,  kVendor,      vendorIsReached},
    {11, Subject::joined,  kVendor,      vendorContentArrives},
    {12, Subject::joined,  kAddresses,   hasIPv4Address},
    {13, Subject::joined,  kAddresses,   hasIPv6Address},
    {14, Subject::device,  kSetup,       ipv4IsCustom},
    {15, Subject::device,  kSetup,       ipv6IsCustom},
    {16, Subject::device,  kSetup,       nameServersAreCustom},
    {17, Subject::device,  kSetup,       webProxyIsCustom},
    {18, Subject::device,  kBluetooth,   manyBluetoothPaired},
    {19, Subject::device,  kBluetooth,   manyBluetoothConnected},
    {20, Subject::device,  kSharing,     bluetoothSharesAirtime},
    {22, Subject::device,  kPeers,       peerLinkTakesTurns},
    {24, Subject::network, kChannel,     channelIsFull},
    {25, Subject::joined,  kChannel,     band2IsFull},
    {26, Subject::joined,  kChannel,     band5IsFull},
    {27, Subject::joined,  kJudged,      usesFortyMegahertzIn2GHz},
    {28, Subject::network, kCountry,     countryCodesConflict},
    {29, Subject::device,  kSaved,       savedSecurityConflicts},
    {30, Subject::joined,  kListened,    foundHiddenNetworks},
    {31, Subject::scan,    kNearby,      foundNoNetworks},
    {32, Subject::network, kSignal,      signalIsPoor},
    {33, Subject::network, kMaker,       isVendorsBaseStation},
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
    {44, Subject::network, kHotspot,     isVendorsHotspot},
    {45, Subject::network, kJudged,      isPasspoint},
    {46, Subject::network, kPortal,      hasPortal},
    {47, Subject::device,  kSaved,       manyNetworksSaved},
    {48, Subject::device,  kSaved,       hiddenNetworksSaved},
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
