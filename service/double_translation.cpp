#include "service/double_translation.h"

#include <algorithm>

namespace wp {
namespace {

using Basis = TranslationBasis;

TranslationVerdict verdict(bool twice, Basis basis, std::string why) {
    return {twice, basis, std::move(why)};
}

/// By the routers on the way; the first one is the gateway and has an inner address in any case.
Known<TranslationVerdict> judgeHops(const TranslationEvidence& evidence) {
    const IPAddress* shared = nullptr;
    for (std::size_t distance = 1; distance < evidence.hops.size(); ++distance) {
        if (!evidence.hops[distance]) continue;
        const IPAddress& hop = *evidence.hops[distance];
        if (hop.global() && shared == nullptr) return verdict(false, Basis::hops, "outside at " + hop.text());
        if (hop.global()) break;
        const bool own = std::any_of(evidence.own.begin(), evidence.own.end(), [&](const OwnAddress& each) {
            return hop.sharesPrefix(each.address, each.prefixLength);
        });
        if (hop.privateUse() && !own)
            return verdict(true, Basis::hops, "likely: another inner network at " + hop.text());
        if (hop.sharedUse()) shared = &hop;
    }
    if (shared != nullptr) return verdict(true, Basis::sharedHop, "carrier-grade: " + shared->text());
    return failure(Reason::timeout, "neither the router nor a server outside answered");
}

}  // namespace

Known<TranslationVerdict> judgeTranslation(const TranslationEvidence& evidence) {
    const bool translated = std::any_of(evidence.own.begin(), evidence.own.end(),
                                        [](const OwnAddress& each) { return each.address.privateUse(); });
    if (!translated)
        return verdict(false, Basis::noInnerAddress, "the interface has no private IPv4 address");
    const auto& external = evidence.gatewayExternal;
    if (external && external->sharedUse())
        return verdict(true, Basis::routerShared, "carrier-grade: " + external->text());
    if (external && external->privateUse())
        return verdict(true, Basis::routerInside, "the router is inside too: " + external->text());
    if (external && evidence.mapped) {
        const bool differ = *external != *evidence.mapped;
        return verdict(
            differ, Basis::twoOuterAddresses,
            "the router has " + external->text() + ", a server outside sees " + evidence.mapped->text());
    }
    if (external) return verdict(false, Basis::routerOutside, "the router is outside: " + external->text());
    return judgeHops(evidence);
}

Outcome hasDoubleTranslation(const Known<TranslationEvidence>& evidence) {
    if (!evidence) return evidence.error();
    const auto judged = judgeTranslation(*evidence);
    if (!judged) return judged.error();
    return problem(judged->twice);
}

}  // namespace wp
