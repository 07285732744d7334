#include "service/network_tests.h"

#include <algorithm>
#include <set>

#include "service/judged.h"

namespace wp {
namespace {

std::uint8_t lowerCase(std::uint8_t letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<std::uint8_t>(letter + ('a' - 'A')) : letter;
}

/// Networks that are secured in different ways are different networks, though they have one name.
bool differInSecurity(const std::vector<const AccessPoint*>& network) {
    std::set<SecurityClass> classes;
    for (const AccessPoint* each : network) classes.insert(classOf(securityOf(each->says.security)));
    classes.erase(SecurityClass::unknown);
    return classes.size() > 1;
}

Outcome securityProblem(const SecuritySuites& suites, bool found) {
    // What was read before the element broke off proves a finding, not the lack of one.
    if (suites.malformed && !found)
        return failure(Reason::malformed, "what the access point says of its security breaks off");
    return problem(found, {{"Security", nameOf(securityOf(suites))}});
}

bool usesWep(const SecuritySuites& suites) {
    return securityOf(suites) == Security::wep || ((suites.pairwise | suites.group) & SecuritySuites::kWep);
}

}  // namespace

bool isCommonName(const NetworkName& name, const std::vector<NetworkName>& common) {
    return std::ranges::any_of(common, [&](const NetworkName& each) {
        return std::ranges::equal(each.bytes(), name.bytes(), {}, lowerCase, lowerCase);
    });
}

Outcome beaconIntervalIsLong(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const std::optional<std::uint16_t> interval = (*judged)->beaconInterval;
    if (!interval) return failure(Reason::unsupported, "the driver does not tell the beacon interval");
    if (*interval == 0) return failure(Reason::malformed, "the access point names a beacon interval of 0");
    return problem(*interval > kLongestBeaconInterval, {{"BeaconInterval", std::int64_t{*interval}}});
}

Outcome dtimIntervalIsLong(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    std::optional<std::uint8_t> period;
    if (!facts.named && facts.station) period = facts.station->dtimPeriod;
    // 0 is the driver's word for a beacon that it has not heard yet.
    if (period.value_or(0) == 0) period = (*judged)->says.dtimPeriod;
    if (!period) return failure(Reason::unsupported, "no beacon with a DTIM period was heard");
    if (*period == 0) return failure(Reason::malformed, "the access point names a DTIM period of 0");
    return problem(*period > kLongestDtimPeriod, {{"DTIMInterval", std::int64_t{*period}}});
}

Outcome securityIsOpen(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const SecuritySuites& suites = (*judged)->says.security;
    const Security security = securityOf(suites);
    // Whatever breaks off, one of these says that it is not open.
    if (suites.privacy || suites.rsn || suites.wpa) return problem(false, {{"Security", nameOf(security)}});
    return securityProblem(suites, classOf(security) == SecurityClass::open);
}

Outcome securityIsWep(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const SecuritySuites& suites = (*judged)->says.security;
    return securityProblem(suites, usesWep(suites));
}

Outcome securityIsWpa(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const SecuritySuites& suites = (*judged)->says.security;
    return securityProblem(suites, suites.wpa || (suites.rsnPairwise & SecuritySuites::kTkip));
}

Outcome nameIsAmbiguous(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const NetworkName& name = (*judged)->says.name;
    if (name.absent()) return failure(Reason::notFound, "no frame has told the network's name");
    bool found = isCommonName(name, facts.settings.vendors.commonNames);
    if (!found) {
        const Known<std::vector<const AccessPoint*>> network = judgedNetwork(facts);
        if (!network) return network.error();
        found = differInSecurity(*network);
    }
    return problem(found, {{"NetworkName", textFromName(name)}});
}

Outcome nameIsHidden(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    const std::optional<bool> hides = (*judged)->says.hidesName;
    if (!hides) return failure(Reason::unsupported, "no beacon was heard, and only a beacon tells");
    return problem(*hides);
}

Outcome isPasspoint(const Facts& facts) {
    const Known<const AccessPoint*> judged = judgedAccessPoint(facts);
    if (!judged) return judged.error();
    // The sign-up network beside a hotspot carries the same element and is not one.
    return problem((*judged)->says.hotspot && !(*judged)->says.onlineSignUp);
}

}  // namespace wp
