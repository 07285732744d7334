#include "service/catalogue.h"

#include <algorithm>

#include "service/connectivity_tests.h"
#include "service/details.h"
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
constexpr Fact kVendor[] = {Fact::vendorService, Fact::portal};  // whose answer tells the time
constexpr Fact kChannel[] = {Fact::judged, Fact::link, Fact::nearby, Fact::airtime, Fact::allowedChannels};
constexpr Fact kMaker[] = {Fact::judged, Fact::router};
constexpr Fact kHotspot[] = {Fact::judged, Fact::setup};
constexpr Fact kPortal[] = {Fact::link, Fact::nearby, Fact::saved, Fact::portal};

// clang-format off
constexpr NumberedTest kTests[] = {
    { 3, Subject::joined,  kGateway,     gatewayAnswers,            gatewayDetails},
    { 6, Subject::joined,  kOutside,     outsideAnswers,            outsideDetails},
    { 7, Subject::joined,  kNames,       namesResolve,              nameDetails},
    { 8, Subject::joined,  kTranslation, isTranslatedTwice,         translationDetails},
    { 9, Subject::joined,  kVendor,      vendorIsReached,           vendorReachDetails},
    {11, Subject::joined,  kVendor,      vendorContentArrives,      vendorContentDetails},
    {12, Subject::joined,  kAddresses,   hasIPv4Address,            ipv4Details},
    {13, Subject::joined,  kAddresses,   hasIPv6Address,            ipv6Details},
    {14, Subject::device,  kSetup,       ipv4IsCustom,              ipv4MethodDetails},
    {15, Subject::device,  kSetup,       ipv6IsCustom,              ipv6MethodDetails},
    {16, Subject::device,  kSetup,       nameServersAreCustom,      nameServerDetails},
    {17, Subject::device,  kSetup,       webProxyIsCustom,          webProxyDetails},
    {18, Subject::device,  kBluetooth,   manyBluetoothPaired,       pairedDetails},
    {19, Subject::device,  kBluetooth,   manyBluetoothConnected,    connectedDetails},
    {20, Subject::device,  kSharing,     bluetoothSharesAirtime,    sharedAirtimeDetails},
    {22, Subject::device,  kPeers,       peerLinkTakesTurns,        peerLinkDetails},
    {24, Subject::network, kChannel,     channelIsFull,             channelDetails},
    {25, Subject::joined,  kChannel,     band2IsFull,               band2Details},
    {26, Subject::joined,  kChannel,     band5IsFull,               band5Details},
    {27, Subject::joined,  kJudged,      usesFortyMegahertzIn2GHz,  widthDetails},
    {28, Subject::network, kCountry,     countryCodesConflict,      countryDetails},
    {29, Subject::device,  kSaved,       savedSecurityConflicts,    savedConflictDetails},
    {30, Subject::joined,  kListened,    foundHiddenNetworks,       hiddenNetworkDetails},
    {31, Subject::scan,    kNearby,      foundNoNetworks,           scanDetails},
    {32, Subject::network, kSignal,      signalIsPoor,              signalDetails},
    {33, Subject::network, kMaker,       isVendorsBaseStation,      baseStationDetails},
    {34, Subject::network, kJudged,      beaconIntervalIsLong,      beaconDetails},
    {35, Subject::joined,  kStation,     dtimIntervalIsLong,        dtimDetails},
    {36, Subject::network, kNetwork,     modesConflict11AC,         modes11ACDetails},
    {37, Subject::network, kNetwork,     modesConflict11N,          modes11NDetails},
    {38, Subject::network, kJudged,      securityIsOpen,            securityDetails},
    {39, Subject::network, kJudged,      securityIsWep,             securityDetails},
    {40, Subject::network, kJudged,      securityIsWpa,             securityDetails},
    {41, Subject::network, kJudged,      ratesAreLegacy,            rateDetails},
    {42, Subject::network, kNetwork,     nameIsAmbiguous,           ambiguousNameDetails},
    {43, Subject::network, kJudged,      nameIsHidden,              hiddenNameDetails},
    {44, Subject::network, kHotspot,     isVendorsHotspot,          hotspotDetails},
    {45, Subject::network, kJudged,      isPasspoint,               hotspotElementDetails},
    {46, Subject::network, kPortal,      hasPortal,                 portalDetails},
    {47, Subject::device,  kSaved,       manyNetworksSaved,         savedCountDetails},
    {48, Subject::device,  kSaved,       hiddenNetworksSaved,       savedHiddenDetails},
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
