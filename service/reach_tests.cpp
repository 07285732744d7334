#include "service/reach_tests.h"

#include <algorithm>

#include "service/connectivity_tests.h"
#include "service/judged.h"

namespace wp {
namespace {

const AccessPoint* joined(const Facts& facts) {
    return facts.link && facts.link->joined ? &*facts.link->joined : nullptr;
}

AirFacts airOf(const Facts& facts) {
    return {facts.nearby, facts.airtime, facts.allowedChannels};
}

/// Whether the scan heard the name from more than one access point.
bool heardFromSeveral(const Facts& facts, const NetworkName& name) {
    if (!facts.nearby || name.absent()) return false;
    return std::ranges::count_if(*facts.nearby, [&](const AccessPoint& each) {
               return !each.directOnly && each.says.name == name;
           }) > 1;
}

/// What the joined network's router says of itself; else why nobody knows who made the access point.
Known<RouterDescription> routerOf(const Facts& facts) {
    constexpr const char* kSilent = "the access point does not say who made it";
    if (facts.named) return failure(Reason::unsupported, kSilent);
    if (facts.router) return facts.router->description;
    Error error = facts.router.error();
    if (error.code != static_cast<int>(Reason::cancelled))
        error.message = std::string(kSilent) + ", and nor does its router: " + error.message;
    return error;
}

}  // namespace

Known<std::string> leaseTextOf(const Facts& facts) {
    if (facts.named)
        return failure(Reason::unsupported,
                       "some hotspots show in their lease alone, and of a named network there is none");
    return facts.setup ? facts.setup->leaseText : facts.setup.error();
}

Outcome outsideAnswers(const Facts& facts) {
    if (!facts.outsideEcho) return facts.outsideEcho.error();
    return works(facts.outsideEcho->isAnswered(),
                 {{"PingResult", std::make_shared<PingStatistics>(statisticsOf(*facts.outsideEcho))}});
}

Outcome namesResolve(const Facts& facts) {
    return resolvesNames(facts.nameAnswer);
}

Outcome isTranslatedTwice(const Facts& facts) {
    return hasDoubleTranslation(facts.translation);
}

Outcome vendorIsReached(const Facts& facts) {
    if (!facts.vendorService) return facts.vendorService.error();
    return reachesVendor(facts.vendorService->reach, facts.vendorService->clock);
}

Outcome vendorContentArrives(const Facts& facts) {
    if (!facts.vendorService) return facts.vendorService.error();
    return retrievesFromVendor(facts.vendorService->retrieve, facts.settings.vendorContent,
                               facts.vendorService->clock);
}

Outcome channelIsFull(const Facts& facts) {
    const auto judged = judgedAsHeardLast(facts);
    if (!judged) return judged.error();
    return channelIsCongested(**judged, airOf(facts), joined(facts), facts.settings.thresholds.congestion);
}

Outcome band2IsFull(const Facts& facts) {
    return band2IsCongested(airOf(facts), joined(facts), facts.settings.thresholds.congestion);
}

Outcome band5IsFull(const Facts& facts) {
    return band5IsCongested(airOf(facts), joined(facts), facts.settings.thresholds.congestion);
}

Outcome isVendorsBaseStation(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    return isVendorBaseStation(**judged, routerOf(facts), facts.settings.vendors.baseStation);
}

Outcome isVendorsHotspot(const Facts& facts) {
    const auto judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    return isVendorHotspot(**judged, leaseTextOf(facts), facts.settings.vendors.hotspot);
}

Outcome hasPortal(const Facts& facts) {
    if (facts.named)
        return isRememberedAsCaptive(facts.saved, *facts.named, heardFromSeveral(facts, *facts.named));
    const AccessPoint* own = joined(facts);
    if (facts.link && own == nullptr)
        return failure(Reason::notJoined, facts.link->interfaceName + " is not joined to a network");
    if (!facts.link) return facts.link.error();
    return isCaptive(facts.portal, facts.saved, own->says.name, heardFromSeveral(facts, own->says.name));
}

}  // namespace wp
