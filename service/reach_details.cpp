#include <algorithm>

#include "service/detail_values.h"

namespace wp {
namespace {

Details echoDetails(const Known<Echo>& echo) {
    if (!echo) return {};
    return {{"target", echo->target},
            {"roundTripTimes", listOf(echo->roundTrips, [](const std::optional<double>& time) {
                 return time ? Value(rounded(*time)) : Value();
             })}};
}

std::string_view wordOf(ServiceContact::End end) {
    switch (end) {
        case ServiceContact::End::reached:
            return "reached";
        case ServiceContact::End::badCertificate:
            return "badCertificate";
        case ServiceContact::End::failed:
            break;
    }
    return "failed";
}

std::string_view wordOf(CertificateFault fault) {
    constexpr std::string_view kWords[] = {"none",       "notYetValid",   "expired", "wrongHost",
                                           "selfSigned", "unknownIssuer", "revoked", "other"};
    return kWords[static_cast<std::size_t>(fault)];
}

std::string_view wordOf(TranslationBasis basis) {
    constexpr std::string_view kWords[] = {"noInnerAddress",    "routerInside",  "routerShared",
                                           "twoOuterAddresses", "routerOutside", "hops",
                                           "sharedHop"};
    return kWords[static_cast<std::size_t>(basis)];
}

std::string_view wordOf(PortalKind kind) {
    constexpr std::string_view kWords[] = {"none", "declared", "redirect", "status511", "alteredPage"};
    return kWords[static_cast<std::size_t>(kind)];
}

std::string_view wordOf(Connectivity connectivity) {
    constexpr std::string_view kWords[] = {"full", "partial", "portal", "none"};
    return kWords[static_cast<std::size_t>(connectivity)];
}

/// The vendor's own service tells the time best; on a certificate that does not hold it tells nothing, but the
/// portal's plain probe may.
void addClock(Details& details, const Facts& facts, const ServiceContact& contact) {
    if (contact.clockOffset) {
        details.emplace("clockOffset", *contact.clockOffset);
        details.emplace("clockSource", "service");
    } else if (facts.portal && facts.portal->plain.clockOffset) {
        details.emplace("clockOffset", *facts.portal->plain.clockOffset);
        details.emplace("clockSource", "portalProbe");
    }
    details.emplace("clockBeforeBuild", facts.vendorService->clock.beforeBuild);
}

Details contactDetails(const Facts& facts, const Known<ServiceContact>& contact) {
    if (!contact) return {};
    Details details{{"end", wordOf(contact->end)}};
    addText(details, "why", contact->why);
    if (contact->server) details.emplace("server", contact->server->text());
    addKnown(details, "connectTime", rounded(contact->steps.connect));
    addKnown(details, "secureTime", rounded(contact->steps.secure));
    addKnown(details, "firstByteTime", rounded(contact->steps.firstByte));
    if (contact->status != 0) details.emplace("status", contact->status);
    if (contact->fault != CertificateFault::none) details.emplace("certificateFault", wordOf(contact->fault));
    addClock(details, facts, *contact);
    return details;
}

Details addressDetails(const Facts& facts, Address::Family family) {
    if (!facts.addresses) return {};
    Array addresses;
    for (const Address& each : *facts.addresses) {
        const auto address = IPAddress::fromBytes(each.bytes);
        if (each.family != family || !address) continue;
        addresses.push_back(Dictionary::make(
            {{"address", address->text()}, {"global", each.global}, {"usable", each.usable}}));
    }
    return {{"addresses", std::move(addresses)}};
}

void addPortalAnswer(Details& details, std::string_view key, const PortalAnswer& answer) {
    if (answer.end == PortalAnswer::End::answered) details.emplace(key, answer.status);
}

}  // namespace

Details gatewayDetails(const Facts& facts) {
    return echoDetails(facts.gatewayEcho);
}

Details outsideDetails(const Facts& facts) {
    return echoDetails(facts.outsideEcho);
}

Details nameDetails(const Facts& facts) {
    Details details;
    addThresholds(details, {{"slowTime", kSlowName.count()}, {"verySlowTime", kVerySlowName.count()}});
    if (!facts.nameAnswer) return details;
    const NameAnswer& answer = *facts.nameAnswer;
    details.emplace("name", answer.name);
    details.emplace("time", answer.took.count());
    addText(details, "why", answer.why);
    details.emplace("addresses", listOf(answer.addresses, [](const IPAddress& each) { return each.text(); }));
    details.emplace("servers", listOf(answer.servers, [](const NameServerAnswer& each) {
                        return Dictionary::make({{"address", each.server.text()},
                                                 {"answered", each.answered},
                                                 {"code", each.code},
                                                 {"time", rounded(each.took)}});
                    }));
    return details;
}

Details translationDetails(const Facts& facts) {
    if (!facts.translation) return {};
    const TranslationEvidence& evidence = *facts.translation;
    Details details{
        {"ownAddresses", listOf(evidence.own, [](const OwnAddress& own) { return own.address.text(); })},
        {"hops", listOf(evidence.hops, [](const std::optional<IPAddress>& hop) {
             return hop ? Value(hop->text()) : Value();
         })}};
    if (evidence.gatewayExternal) details.emplace("routerAddress", evidence.gatewayExternal->text());
    if (evidence.mapped) details.emplace("seenAddress", evidence.mapped->text());
    if (const auto judged = judgeTranslation(evidence)) details.emplace("judgedBy", wordOf(judged->basis));
    return details;
}

Details vendorReachDetails(const Facts& facts) {
    return facts.vendorService ? contactDetails(facts, facts.vendorService->reach) : Details();
}

Details vendorContentDetails(const Facts& facts) {
    return facts.vendorService ? contactDetails(facts, facts.vendorService->retrieve) : Details();
}

Details ipv4Details(const Facts& facts) {
    return addressDetails(facts, Address::Family::ipv4);
}

Details ipv6Details(const Facts& facts) {
    return addressDetails(facts, Address::Family::ipv6);
}

Details portalDetails(const Facts& facts) {
    if (facts.named || !facts.portal) return {};
    const PortalEvidence& evidence = *facts.portal;
    Details details;
    addPortalAnswer(details, "plainStatus", evidence.plain);
    addPortalAnswer(details, "secureStatus", evidence.secure);
    if (const auto connectivity = connectivityOf(evidence))
        details.emplace("connectivity", wordOf(*connectivity));
    if (evidence.plain.server) details.emplace("server", evidence.plain.server->text());
    const auto judged = judgePortal(evidence);
    if (!judged) return details;
    details.emplace("kind", wordOf(judged->kind));
    details.emplace("why", judged->why);
    addText(details, "url",
            judged->kind == PortalKind::declared ? evidence.declared.page : evidence.plain.location);
    return details;
}

}  // namespace wp
