#include "service/captive_portal.h"

namespace wp {
namespace {

using End = PortalAnswer::End;

PortalVerdict open(std::string why) {
    return {false, PortalKind::none, std::move(why)};
}

PortalVerdict portal(PortalKind kind, std::string why) {
    return {true, kind, std::move(why)};
}

bool isRedirect(int status) {
    return status >= 300 && status <= 399 && status != 304;
}

// One byte is what some proxies add to an empty page.
bool isEmptyPage(const PortalAnswer& plain) {
    return plain.status == 200 && plain.bodySize <= 1;
}

/// Whether it tells anything; a page of which nothing came is not an empty one.
bool isAnswer(const PortalAnswer& plain) {
    return plain.end == End::answered && (plain.bodyIsWhole || !isEmptyPage(plain));
}

bool opens(const PortalAnswer& secure) {
    return secure.end == End::answered && secure.status >= 200 && secure.status <= 299;
}

Known<PortalVerdict> judgePlain(const PortalAnswer& plain, const PortalAnswer& secure) {
    const std::string status = std::to_string(plain.status);
    if (plain.status == 204) return open("open: status 204");
    if (plain.status == 511) return portal(PortalKind::status511, "status 511");
    if (isRedirect(plain.status))
        return portal(PortalKind::redirect, plain.location.empty()
                                                ? "suspected: status " + status + " to nowhere"
                                                : "redirected with status " + status);
    if (isEmptyPage(plain)) {
        if (opens(secure)) return open("open: an empty page, and the secure probe got through");
        return failure(Reason::timeout, "an empty page over HTTP and no answer over HTTPS");
    }
    if (plain.status >= 200 && plain.status <= 399)
        return portal(PortalKind::alteredPage, "suspected: status " + status);
    if (opens(secure)) return open("partial: status " + status + " over HTTP, HTTPS got through");
    return failure(Reason::timeout, "status " + status + " over HTTP and no answer over HTTPS");
}

const SavedNetwork* remembered(const Known<SavedNetworks>& saved, const NetworkName& name) {
    return saved ? findSaved(*saved, name) : nullptr;
}

Dictionary::Entries information(const SavedNetwork* network, bool seenSeveralAPs) {
    if (network == nullptr) return {};
    return {{"PreferredNetwork", recordOf(*network, seenSeveralAPs)}};
}

}  // namespace

Known<PortalVerdict> judgePortal(const PortalEvidence& evidence) {
    if (evidence.declared.unrestricted) return open("the network says that it has no portal");
    if (evidence.declared.captive) {
        const std::string why = "the network's own API says so";
        if (!*evidence.declared.captive) return open(why);
        return portal(PortalKind::declared, evidence.declared.page.empty()
                                                ? why + "; the address of its page is too long to tell"
                                                : why);
    }
    if (isAnswer(evidence.plain)) return judgePlain(evidence.plain, evidence.secure);
    if (opens(evidence.secure)) return open("partial: HTTPS got through, HTTP did not");
    if (evidence.plain.end == End::answered)
        return failure(Reason::timeout,
                       "the page over HTTP never came, and HTTPS did not get through: " + evidence.plain.why);
    if (evidence.plain.server && evidence.plain.server->privateUse())
        return open("no Internet: the probe's name has the private address " + evidence.plain.server->text() +
                    ", and nothing answers there");
    return failure(Reason::timeout, "no probe was answered: " + evidence.plain.why);
}

std::optional<Connectivity> connectivityOf(const PortalEvidence& evidence) {
    const auto judged = judgePortal(evidence);
    if (judged && judged->captive) return Connectivity::portal;
    const PortalAnswer& plain = evidence.plain;
    if (evidence.secure.end == End::untold) return std::nullopt;
    const bool secure = opens(evidence.secure);
    if (!isAnswer(plain)) return secure ? Connectivity::partial : Connectivity::none;
    const bool isThrough = plain.status == 204 || isEmptyPage(plain);
    if (isThrough) return secure ? Connectivity::full : Connectivity::partial;
    return secure ? std::optional(Connectivity::partial) : std::nullopt;
}

Outcome isCaptive(const Known<PortalEvidence>& evidence, const Known<SavedNetworks>& saved,
                  const NetworkName& name, bool seenSeveralAPs) {
    if (!evidence) return evidence.error();
    const auto judged = judgePortal(*evidence);
    if (!judged) return judged.error();
    return problem(judged->captive, information(remembered(saved, name), seenSeveralAPs));
}

Outcome isRememberedAsCaptive(const Known<SavedNetworks>& saved, const NetworkName& name,
                              bool seenSeveralAPs) {
    if (!saved) return saved.error();
    const SavedNetwork* network = remembered(saved, name);
    if (network == nullptr) return failure(Reason::notFound, "no remembered network has this name");
    return problem(network->captive, information(network, seenSeveralAPs));
}

}  // namespace wp
