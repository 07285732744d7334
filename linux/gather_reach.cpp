#include "linux/gather_reach.h"

#include <algorithm>
#include <ctime>
#include <future>
#include <system_error>

#include "linux/address_details.h"
#include "linux/gather.h"
#include "linux/probe/name_lookup.h"
#include "linux/probe/port_mapping.h"
#include "linux/probe/portal_api.h"
#include "linux/probe/ssdp_probe.h"
#include "linux/probe/translation_probes.h"
#include "linux/probe/web_client.h"
#include "linux/probe/web_place.h"
#include "linux/reverse_path_filter.h"
#include "linux/route_query.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

constexpr auto kTranslationTime = 1s;
constexpr std::size_t kBeginningOfPage = 256;

Error notConfigured(const std::string& what) {
    return failure(Reason::badConfiguration, "no endpoint is configured for " + what);
}

Error notJoined(const Link& link) {
    return failure(Reason::notJoined, link.interfaceName + " is not joined to a network");
}

/// The way out by IPv4, with its router where that is one of IPv4 itself; else why there is none.
Known<WayOut> wayOutByIPv4(const Link& link, const Until& until) {
    const auto ways = gatherWaysOut(link, until);
    if (!ways) return ways.error();
    if (ways->empty() || !ways->front().isIPv4)
        return failure(Reason::notJoined, link.interfaceName + " has no default route for IPv4");
    WayOut way = ways->front();
    if (way.router && !way.router->isIPv4()) way.router.reset();
    return way;
}

/// A resolver on the device itself cannot be reached over the interface.
NameServerSet serversOf(const Link& link, const LinkSetup& setup) {
    const bool here =
        std::ranges::any_of(setup.servers, [](const IPAddress& each) { return each.loopback(); });
    return {.servers = setup.servers,
            .interfaceName = here ? "" : link.interfaceName,
            .leadsOut = setup.leadsOut};
}

/// Asks the link's name servers. Where none says anything because this device drops what they say, that is the error.
Known<NameAnswer> askForName(const std::string& name, const Link& link, const LinkSetup& setup,
                             const Until& until) {
    if (setup.servers.empty() && !setup.serversElsewhere.empty())
        return failure(Reason::unavailable, "no name server of " + link.interfaceName + " is known: to " +
                                                setup.serversElsewhere.front().text() +
                                                " another interface leads");
    auto answer = lookUpName(name, serversOf(link, setup), until.within(kNameTime));
    if (!answer || answer->heard) return answer;
    const auto dropped = droppedByFilter(link, setup.servers, until);
    return dropped ? Known<NameAnswer>(*dropped) : answer;
}

/// Where a host can be asked, whose name may be an address itself; else why it cannot.
Known<NameAnswer> lookUpHost(const std::string& host, const Link& link, const LinkSetup& setup,
                             const Until& until) {
    if (const auto address = IPAddress::fromText(host)) {
        NameAnswer literal;
        literal.addresses = {*address};
        return literal;
    }
    auto answer = askForName(host, link, setup, until);
    if (!answer) return answer;
    auto places = placesOf(*answer);
    if (places.empty()) answer->why = whyNowhere(*answer);
    answer->addresses = std::move(places);
    return answer;
}

/// A request to a URL of the configuration, with the addresses of its host.
Known<WebRequest> requestFor(const std::string& url, const Link& link, const LinkSetup& setup,
                             const Endpoints& endpoints, const Until& until) {
    WebRequest request;
    if (url.empty()) return request;
    const auto host = lookUpHost(hostOf(url), link, setup, until);
    if (!host) return host.error();
    request.url = url;
    request.interfaceName = link.interfaceName;
    request.addresses = host->addresses;
    request.whyNoAddress = host->why;
    request.authorities = endpoints.certificateAuthorities;
    return request;
}

/// A certificate that does not hold comes from somebody else or from the clock of this device.
PortalAnswer::End portalEnd(const WebAnswer& answer, const WebRequest& request) {
    if (answer.end == WebAnswer::End::answered) return PortalAnswer::End::answered;
    const bool isAsked = !request.url.empty() && answer.end == WebAnswer::End::failed;
    return isAsked ? PortalAnswer::End::noAnswer : PortalAnswer::End::untold;
}

PortalAnswer portalAnswer(const WebAnswer& answer, const WebRequest& request) {
    PortalAnswer portal;
    portal.end = portalEnd(answer, request);
    portal.status = answer.status;
    portal.bodySize = answer.body.size();
    portal.location = answer.location;
    portal.server = answer.server;
    if (!portal.server && !request.addresses.empty()) portal.server = request.addresses.front();
    portal.why = answer.why;
    portal.clockOffset = answer.clockOffset;
    portal.bodyIsWhole = answer.bodyCame == WebAnswer::Body::whole;
    return portal;
}

/// Why no server could be connected to that may well be there: this device drops what it says.
std::optional<Error> droppedAnswer(const WebRequest& request, const WebAnswer& answer, const Link& link,
                                   const Until& until) {
    if (answer.end != WebAnswer::End::failed || answer.steps.connect) return std::nullopt;
    return droppedByFilter(link, request.addresses, until);
}

/// What the network declares. An API is believed only over a secure connection.
Known<PortalDeclaration> askPortalApi(const Link& link, const LinkSetup& setup, const Endpoints& endpoints,
                                      const Until& until) {
    PortalDeclaration declaration;
    declaration.unrestricted = meansNoPortal(setup.portalApi);
    if (!setup.portalApi.starts_with("https://")) return declaration;
    auto request = requestFor(setup.portalApi, link, setup, endpoints, until);
    if (!request) return request.error();
    request->headers = {"Accept: application/captive+json"};
    request->longestBody = kLongestPortalAnswer;
    const auto answers = runWebRequests({*request}, until);
    if (!answers) return answers.error();
    const WebAnswer& answer = answers->front();
    if (answer.end == WebAnswer::End::answered && answer.status == 200)
        if (const auto told = portalFromApi(answer.body)) {
            declaration.captive = told->captive;
            declaration.page = told->page;
        }
    return declaration;
}

/// A redirecting or refusing plain answer is a portal's, whatever the other says. An empty one is none, but how far the
/// network reaches only both tell; the vendor's service is waited for as long.
bool decides(const std::optional<WebAnswer>& plain) {
    if (!plain || plain->end != WebAnswer::End::answered) return false;
    return plain->status == 511 || (plain->status >= 300 && plain->status <= 399) ||
           (plain->status == 200 && plain->body.size() > 1);
}

ServiceContact contactOf(const WebAnswer& answer) {
    ServiceContact contact;
    contact.why = answer.why;
    contact.status = answer.status;
    contact.body = answer.body;
    contact.steps = answer.steps;
    contact.fault = answer.fault;
    contact.server = answer.server;
    contact.clockOffset = answer.clockOffset;
    switch (answer.end) {
        case WebAnswer::End::answered:
            contact.end = ServiceContact::End::reached;
            break;
        case WebAnswer::End::badCertificate:
            contact.end = ServiceContact::End::badCertificate;
            break;
        case WebAnswer::End::noAuthorities:
        case WebAnswer::End::failed:
            contact.end = ServiceContact::End::failed;
            break;
    }
    return contact;
}

/// The day on which the compiler saw this file, in seconds since 1970; the clock of a device that was without
/// power is far before it.
std::time_t buildDay() {
    std::tm day{};
    // "Nov 20 2026"
    return ::strptime(__DATE__, "%b %d %Y", &day) != nullptr ? ::timegm(&day) : 0;
}

Known<ServiceContact> contact(const std::string& url, bool connectOnly, const Link& link,
                              const LinkSetup& setup, const Endpoints& endpoints, const Until& until) {
    if (url.empty() || url == "https://") return notConfigured("the vendor's service");
    auto request = requestFor(url, link, setup, endpoints, until);
    if (!request) return request.error();
    request->connectOnly = connectOnly;
    const auto answers = runWebRequests({*request}, until);
    if (!answers) return answers.error();
    // Without them nothing can be said of the network.
    if (answers->front().end == WebAnswer::End::noAuthorities)
        return failure(Reason::badConfiguration, answers->front().why);
    if (const auto dropped = droppedAnswer(*request, answers->front(), link, until)) return *dropped;
    return contactOf(answers->front());
}

/// Runs the function on a thread of its own; where the system has none left, once its result is wanted.
template <class Function>
auto beside(Function function) {
    try {
        return std::async(std::launch::async, function);
    } catch (const std::system_error&) {
        return std::async(std::launch::deferred, function);
    }
}

template <class T>
std::optional<T> optionalOf(const Known<T>& known) {
    return known ? std::optional<T>(*known) : std::nullopt;
}

Known<IPAddress> askStun(const Link& link, const LinkSetup& setup, const Endpoints& endpoints,
                         const Until& until) {
    const auto server = hostAndPort(endpoints.stun);
    if (!server) return notConfigured("STUN");
    const auto host = lookUpHost(server->host, link, setup, until);
    if (!host) return host.error();
    for (const IPAddress& each : host->addresses)
        if (each.isIPv4()) return askMappedAddress(each, server->port, link.interfaceName, until);
    return failure(Reason::unavailable, "the STUN server has no IPv4 address");
}

}  // namespace

Known<Echo> gatherOutsideEcho(const Link& link, const Endpoints& endpoints, EchoSocket& socket,
                              HomeChannel::Stay& stay, const Until& until) {
    if (!link.joined) return notJoined(link);
    const auto ways = gatherWaysOut(link, until);
    if (!ways) return ways.error();
    if (ways->empty()) return failure(Reason::notJoined, link.interfaceName + " has no default route");
    for (const WayOut& each : *ways)
        if (const auto target = IPAddress::fromText(each.isIPv4 ? endpoints.pingIPv4 : endpoints.pingIPv6))
            return askForEcho(link, *target, socket, stay, until);
    return notConfigured("the ping beyond the router");
}

Known<NameAnswer> gatherNameAnswer(const Link& link, const LinkSetup& setup, const Endpoints& endpoints,
                                   const Until& until) {
    if (!link.joined) return notJoined(link);
    if (endpoints.nameWildcard.empty() && endpoints.name.empty()) return notConfigured("names");
    const std::string name =
        endpoints.nameWildcard.empty() ? endpoints.name : freshName(endpoints.nameWildcard);
    const NameServerSet servers = serversOf(link, setup);
    auto each = beside([&] { return askEachServer(name, servers, until.within(kNameTime)); });
    Known<NameAnswer> answer = askForName(name, link, setup, until);
    const auto answers = each.get();
    if (answer && answers) answer->servers = *answers;
    return answer;
}

Known<PortalEvidence> gatherPortal(const Link& link, const LinkSetup& setup, const Endpoints& endpoints,
                                   const Until& until) {
    if (!link.joined) return notJoined(link);
    auto api = beside([&] { return askPortalApi(link, setup, endpoints, until); });
    const std::string &plainUrl = endpoints.portalPlain, &secureUrl = endpoints.portalSecure;
    auto secureRequest = beside([&] { return requestFor(secureUrl, link, setup, endpoints, until); });
    auto plain = requestFor(plainUrl, link, setup, endpoints, until);
    // Whether there is a page can be told from its beginning; one that never ends need not be waited for.
    if (plain) plain->longestBody = kBeginningOfPage;
    const auto secure = secureRequest.get();
    Known<std::vector<WebAnswer>> answers;
    if (!plain || !secure)
        answers = plain ? secure.error() : plain.error();
    else
        answers = runWebRequests({*plain, *secure}, until, [](const auto& all) { return decides(all[0]); });
    const auto declared = api.get();
    if (!answers) return answers.error();
    if (!declared) return declared.error();
    if (plainUrl.empty() && !declared->captive && !declared->unrestricted)
        return notConfigured("the captive portal's probe");
    const bool isTold =
        declared->captive || declared->unrestricted || (*answers)[0].end == WebAnswer::End::answered;
    if (!isTold) {
        if (const auto dropped = droppedAnswer(*plain, (*answers)[0], link, until)) return *dropped;
        if (const auto dropped = droppedAnswer(*secure, (*answers)[1], link, until)) return *dropped;
    }
    return PortalEvidence{*declared, portalAnswer((*answers)[0], *plain),
                          portalAnswer((*answers)[1], *secure)};
}

Known<VendorContacts> gatherVendorService(const Link& link, const LinkSetup& setup,
                                          const Endpoints& endpoints, const Until& until) {
    if (!link.joined) return notJoined(link);
    auto retrieve =
        beside([&] { return contact(endpoints.vendorUrl, false, link, setup, endpoints, until); });
    VendorContacts contacts;
    contacts.reach = contact("https://" + endpoints.vendorHost, true, link, setup, endpoints, until);
    contacts.retrieve = retrieve.get();
    contacts.clock.beforeBuild = std::time(nullptr) < buildDay();
    return contacts;
}

Known<RouterAnswers> gatherRouter(const Link& link, const Until& until) {
    if (!link.joined) return notJoined(link);
    const auto way = wayOutByIPv4(link, until);
    if (!way) return way.error();
    if (!way->router) return failure(Reason::notJoined, link.interfaceName + kNoRouter);
    return askRouter({*way->router, link.interfaceName}, until);
}

Known<TranslationEvidence> gatherTranslation(const Link& link, const LinkSetup& setup,
                                             const std::optional<IPAddress>& toldByRouter,
                                             const Endpoints& endpoints, const Until& until) {
    if (!link.joined) return notJoined(link);
    const auto details = gatherAddressDetails(link.interfaceIndex, until);
    if (!details) return details.error();
    TranslationEvidence evidence;
    for (const AddressDetails& each : *details)
        if (each.assigned.address.isIPv4() && !each.assigned.address.linkLocal())
            evidence.own.push_back({each.assigned.address, each.prefixLength});
    if (evidence.own.empty()) return failure(Reason::notJoined, link.interfaceName + " has no IPv4 address");
    const auto way = wayOutByIPv4(link, until);
    if (!way) return way.error();

    const Until each = until.within(kTranslationTime);
    auto external = beside([&] {
        if (!way->router) return Known<IPAddress>(failure(Reason::notJoined, link.interfaceName + kNoRouter));
        return askExternalAddress(*way->router, kPortMappingPort, evidence.own.front().address,
                                  link.interfaceName, each);
    });
    auto mapped = beside([&] { return askStun(link, setup, endpoints, each); });
    const auto target = IPAddress::fromText(endpoints.pingIPv4);
    const auto hops = target ? listHops(*target, link.interfaceName, each)
                             : Known<std::vector<std::optional<IPAddress>>>(notConfigured("the way out"));
    evidence.mapped = optionalOf(mapped.get());
    evidence.gatewayExternal = optionalOf(external.get());
    if (!evidence.gatewayExternal) evidence.gatewayExternal = toldByRouter;
    if (hops) evidence.hops = *hops;
    if (until.stop->raised()) return waitFailure(Wait::stopped, "the way out");
    return evidence;
}

}  // namespace wp
