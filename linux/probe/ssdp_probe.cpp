#include "linux/probe/ssdp_probe.h"

#include "linux/probe/ip_socket.h"
#include "linux/probe/ssdp.h"
#include "linux/probe/web_client.h"
#include "linux/probe/web_place.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

/// A router waits up to the second that the search allows before it answers; one lost datagram is made up for.
const std::vector<std::chrono::milliseconds> kPauses = {500ms};
constexpr auto kSearchTime = 1500ms, kFetchTime = 1000ms;

bool liesOn(const std::string& url, const IPAddress& router) {
    return IPAddress::fromText(hostOf(url)) == router;
}

Known<std::string> findDescription(const RouterPlace& router, const Until& until) {
    const auto socket = ipSocket(SOCK_DGRAM, router.searched, router.interfaceName);
    if (!socket) return socket.error();
    const std::string search = ssdpSearch();
    std::string location;
    const Wait wait = exchangeDatagrams(
        *socket, SocketAddress::of(router.searched, router.port),
        {reinterpret_cast<const std::uint8_t*>(search.data()), search.size()}, kPauses,
        [&](Bytes message, const SocketAddress& sender) {
            const auto named =
                locationFromSsdp({reinterpret_cast<const char*>(message.data()), message.size()});
            if (sender.address() != router.address || !named || !liesOn(*named, router.address)) return false;
            location = *named;
            return true;
        },
        until.within(kSearchTime));
    if (location.empty()) return waitFailure(wait, "the router's description");
    return location;
}

/// The body of what lies at the URL; empty where nothing does.
Known<std::string> fetch(WebRequest request, const RouterPlace& router, const Until& until) {
    if (!liesOn(request.url, router.address)) return std::string();
    request.interfaceName = router.interfaceName;
    auto answers = runWebRequests({request}, until.within(kFetchTime));
    if (!answers) return answers.error();
    const WebAnswer& answer = answers->front();
    return answer.status == 200 ? answer.body : std::string();
}

}  // namespace

Known<RouterAnswers> askRouter(const RouterPlace& router, const Until& until) {
    const auto location = findDescription(router, until);
    if (!location) return location.error();
    WebRequest request;
    request.url = *location;
    const auto xml = fetch(request, router, until);
    if (!xml) return xml.error();
    const DeviceDescription description = readDeviceDescription(*xml);
    RouterAnswers answers{description.router, std::nullopt};
    if (description.controlUrl.empty()) return answers;
    const std::string& base = description.urlBase.empty() ? *location : description.urlBase;
    request.url = resolveReference(base, description.controlUrl);
    request.headers = {"Content-Type: text/xml; charset=\"utf-8\"",
                       "SOAPAction: \"" + description.serviceType + "#GetExternalIPAddress\""};
    request.post = externalAddressQuestion(description.serviceType);
    const auto soap = fetch(request, router, until);
    if (!soap) return soap.error();
    answers.external = addressFromSoap(*soap);
    return answers;
}

}  // namespace wp
