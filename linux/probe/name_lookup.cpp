#include "linux/probe/name_lookup.h"

#include <ares.h>
#include <netdb.h>
#include <sys/random.h>

#include <algorithm>
#include <array>
#include <iterator>
#include <memory>
#include <span>

#include "linux/probe/ip_socket.h"
#include "linux/wait_any.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

constexpr int kTryMilliseconds = 2000, kTries = 2;
/// How long the other family may take once one has answered by which the interface leads out (RFC 8305 waits 50 ms for
/// IPv6). Some servers pass over questions for IPv6; one for IPv4 is answered, but late where no cache holds it.
constexpr std::chrono::milliseconds kOtherFamily{50};
constexpr std::chrono::milliseconds kIPv4BesideIPv6{1000};
constexpr int kInternet = 1;
constexpr int kMostAddresses = 32;
constexpr std::size_t kLongestAnswer = 65'535;
constexpr std::size_t kMostServers = 6;

struct LibraryUser {
    LibraryUser() { ares_library_init(ARES_LIB_INIT_ALL); }
};

struct Destroy {
    void operator()(ares_channel channel) const { ares_destroy(channel); }
};
using Channel = std::unique_ptr<std::remove_pointer_t<ares_channel>, Destroy>;

/// What the lookups of one name have brought so far.
struct Lookup {
    std::vector<IPAddress> addresses;
    std::string why;
    int running = 0;
    bool heard = false;  ///< whether a server said anything
};

enum class Zones { told, leftOut };

/// The list in the library's form. \param zones whether link-local servers name their interface
std::string listOf(const NameServerSet& whom, Zones zones) {
    std::string list;
    for (const IPAddress& server : whom.servers) {
        const bool hasZone = zones == Zones::told && server.linkLocal() && !server.isIPv4();
        const std::string zone = hasZone && !whom.interfaceName.empty() ? "%" + whom.interfaceName : "";
        const std::string port = std::to_string(whom.port);
        if (!list.empty()) list += ",";
        // The zone stands behind the port in this list.
        list += server.isIPv4() ? server.text() + ":" + port : "[" + server.text() + "]:" + port + zone;
    }
    return list;
}

/// Older versions of the library refuse a list with a zone in it, and later ones want it. A socket that is bound to
/// the interface reaches the server without one too.
int setServers(ares_channel channel, const NameServerSet& whom) {
    const int status = ares_set_servers_ports_csv(channel, listOf(whom, Zones::told).c_str());
    if (status != ARES_EBADSTR) return status;
    return ares_set_servers_ports_csv(channel, listOf(whom, Zones::leftOut).c_str());
}

/// Binds a socket of the library to the interface of that name, or refuses the socket: the library's own way goes over
/// any interface where it cannot be bound.
int bindToInterface(ares_socket_t socket, int, void* name) {
    const std::string& interfaceName = *static_cast<const std::string*>(name);
    const auto size = static_cast<socklen_t>(interfaceName.size());
    return ::setsockopt(socket, SOL_SOCKET, SO_BINDTODEVICE, interfaceName.c_str(), size) == 0 ? 0 : -1;
}

/// \param whom outlives the channel
/// \param moreFlags of the library, beyond that the name is taken as it is
Known<Channel> openChannel(const NameServerSet& whom, int tries, int moreFlags = 0) {
    if (const auto refusal = refusalOf(whom.interfaceName)) return *refusal;
    static const LibraryUser user;
    ares_options options{};
    char lookups[] = "b";
    options.flags = ARES_FLAG_NOSEARCH | ARES_FLAG_NOALIASES | moreFlags;
    options.timeout = kTryMilliseconds;
    options.tries = tries;
    options.lookups = lookups;
    ares_channel raw = nullptr;
    const int mask = ARES_OPT_FLAGS | ARES_OPT_TIMEOUTMS | ARES_OPT_TRIES | ARES_OPT_LOOKUPS;
    int status = ares_init_options(&raw, &options, mask);
    Channel channel(raw);
    if (status == ARES_SUCCESS) status = setServers(raw, whom);
    if (status != ARES_SUCCESS)
        return failure(Reason::unavailable,
                       std::string("names cannot be asked for: ") + ares_strerror(status));
    if (!whom.interfaceName.empty())
        ares_set_socket_configure_callback(raw, bindToInterface,
                                           const_cast<std::string*>(&whom.interfaceName));
    return channel;
}

/// What a status of the library says about the server.
std::string codeOf(int status) {
    switch (status) {
        case ARES_SUCCESS:
            return "NOERROR";
        case ARES_ENODATA:
            return "NODATA";
        case ARES_ENOTFOUND:
            return "NXDOMAIN";
        case ARES_ESERVFAIL:
            return "SERVFAIL";
        case ARES_EREFUSED:
            return "REFUSED";
        case ARES_EFORMERR:
            return "FORMERR";
        case ARES_ENOTIMP:
            return "NOTIMP";
        case ARES_ECONNREFUSED:
            return "unreachable";
        default:
            return "timeout";
    }
}

bool isAnswer(const std::string& code) {
    return code != "timeout" && code != "unreachable";
}

template <RecordType kType>
void keepAnswer(void* place, int status, int, unsigned char* answer, int size) {
    auto& lookup = *static_cast<Lookup*>(place);
    --lookup.running;
    lookup.heard |= isAnswer(codeOf(status));
    if (status == ARES_SUCCESS)
        std::ranges::copy(addressesFromAnswer(kType, {answer, static_cast<std::size_t>(size)}),
                          std::back_inserter(lookup.addresses));
    else if (status != ARES_ENODATA || lookup.why.empty())
        lookup.why = ares_strerror(status);
}

bool hasAny(const Lookup& lookup, bool ipv4) {
    return std::ranges::any_of(lookup.addresses,
                               [ipv4](const IPAddress& each) { return each.isIPv4() == ipv4; });
}

/// How long to go on after what has come; as long as for any answer where it leads nowhere.
std::optional<std::chrono::milliseconds> patienceFor(const Lookup& lookup, FamiliesOut leadsOut) {
    if (leadsOut.ipv4 && hasAny(lookup, true)) return kOtherFamily;
    if (leadsOut.ipv6 && hasAny(lookup, false)) return leadsOut.ipv4 ? kIPv4BesideIPv6 : kOtherFamily;
    return std::nullopt;
}

/// One channel's sockets as `poll` wants them.
std::vector<pollfd> socketsOf(ares_channel channel) {
    std::array<ares_socket_t, ARES_GETSOCK_MAXNUM> sockets;
    const int bits = ares_getsock(channel, sockets.data(), ARES_GETSOCK_MAXNUM);
    std::vector<pollfd> descriptors;
    for (int i = 0; i < ARES_GETSOCK_MAXNUM; ++i) {
        short events = 0;
        if (ARES_GETSOCK_READABLE(bits, i)) events |= POLLIN;
        if (ARES_GETSOCK_WRITABLE(bits, i)) events |= POLLOUT;
        if (events != 0) descriptors.push_back({sockets[static_cast<std::size_t>(i)], events, 0});
    }
    return descriptors;
}

std::chrono::microseconds patienceOf(ares_channel channel) {
    timeval most{1, 0};
    const timeval* patience = ares_timeout(channel, &most, &most);
    return std::chrono::seconds(patience->tv_sec) + std::chrono::microseconds(patience->tv_usec);
}

void process(ares_channel channel, std::span<const pollfd> sockets) {
    for (const pollfd& each : sockets)
        ares_process_fd(channel, (each.revents & ~POLLOUT) != 0 ? each.fd : ARES_SOCKET_BAD,
                        (each.revents & POLLOUT) != 0 ? each.fd : ARES_SOCKET_BAD);
    ares_process_fd(channel, ARES_SOCKET_BAD, ARES_SOCKET_BAD);
}

/// Waits for the channels' sockets, or for the first of their own timeouts.
Wait turn(std::span<const ares_channel> channels, const Until& until) {
    std::vector<pollfd> descriptors;
    std::vector<std::size_t> ends;
    std::chrono::microseconds patience = 1s;
    for (ares_channel each : channels) {
        std::ranges::copy(socketsOf(each), std::back_inserter(descriptors));
        ends.push_back(descriptors.size());
        patience = std::min(patience, patienceOf(each));
    }
    const Wait wait = waitAny(descriptors, until.within(patience));
    if (wait == Wait::stopped) return wait;
    std::size_t begin = 0;
    for (std::size_t i = 0; i < channels.size(); begin = ends[i++])
        process(channels[i], std::span(descriptors).subspan(begin, ends[i] - begin));
    return Clock::now() >= until.deadline ? Wait::timeout : Wait::ready;
}

/// The addresses in what the library's reader of one record type finds.
template <class Record, class Read>
std::vector<IPAddress> addressesBy(Read read, std::size_t addressSize, Bytes answer) {
    std::array<Record, kMostAddresses> found;
    int count = kMostAddresses;
    std::vector<IPAddress> addresses;
    if (answer.size() > kLongestAnswer ||
        read(answer.data(), static_cast<int>(answer.size()), nullptr, found.data(), &count) != ARES_SUCCESS)
        return addresses;
    for (int i = 0; i < count; ++i) {
        // The address stands first in the record.
        const auto* bytes = reinterpret_cast<const std::uint8_t*>(&found[static_cast<std::size_t>(i)]);
        addresses.push_back(*IPAddress::fromBytes({bytes, addressSize}));
    }
    return addresses;
}

/// One server that is asked by itself.
struct Asking {
    NameServerSet whom;
    NameServerAnswer answer;
    Clock::time_point start = Clock::now();
    bool running = true;
    Channel channel;  // last: it answers to the others when it goes
};

void keepServerAnswer(void* place, int status, int, unsigned char*, int) {
    auto& asking = *static_cast<Asking*>(place);
    asking.running = false;
    asking.answer.code = codeOf(status);
    asking.answer.answered = isAnswer(asking.answer.code);
    asking.answer.took = std::chrono::duration<double, std::milli>(Clock::now() - asking.start).count();
}

}  // namespace

std::vector<IPAddress> addressesFromAnswer(RecordType type, Bytes answer) {
    return type == RecordType::a ? addressesBy<ares_addrttl>(ares_parse_a_reply, 4, answer)
                                 : addressesBy<ares_addr6ttl>(ares_parse_aaaa_reply, 16, answer);
}

Known<NameAnswer> lookUpName(const std::string& name, const NameServerSet& whom, const Until& until) {
    const auto start = Clock::now();
    NameAnswer answer;
    answer.name = name;
    if (whom.servers.empty()) {
        answer.why = "there is no name server";
        return answer;
    }
    Lookup lookup;  // outlives the channel, which answers to it when it goes
    const auto channel = openChannel(whom, kTries);
    if (!channel) return channel.error();
    lookup.running = 2;
    constexpr int kIPv4 = static_cast<int>(RecordType::a), kIPv6 = static_cast<int>(RecordType::aaaa);
    ares_query(channel->get(), name.c_str(), kInternet, kIPv4, keepAnswer<RecordType::a>, &lookup);
    ares_query(channel->get(), name.c_str(), kInternet, kIPv6, keepAnswer<RecordType::aaaa>, &lookup);
    Until patience = until;
    std::optional<Clock::time_point> usableAt;
    while (lookup.running > 0) {
        if (const auto more = patienceFor(lookup, whom.leadsOut)) {
            if (!usableAt) usableAt = Clock::now();
            patience = patience.within(*more);
        }
        const Wait wait = turn(std::array{channel->get()}, patience);
        if (wait == Wait::stopped) return waitFailure(wait, "the name server");
        if (wait == Wait::timeout) break;
    }
    answer.took =
        std::chrono::duration_cast<std::chrono::milliseconds>(usableAt.value_or(Clock::now()) - start);
    answer.heard = lookup.heard;
    answer.addresses = lookup.addresses;
    if (lookup.addresses.empty())
        answer.why = lookup.why.empty() ? "no name server answered in time" : lookup.why;
    return answer;
}

Known<std::vector<NameServerAnswer>> askEachServer(const std::string& name, const NameServerSet& whom,
                                                   const Until& until) {
    std::vector<std::unique_ptr<Asking>> all;
    for (const IPAddress& server : whom.servers) {
        if (all.size() == kMostServers) break;
        auto& asking = *all.emplace_back(std::make_unique<Asking>());
        asking.whom = {{server}, whom.interfaceName, whom.port};
        // Each answer is wanted as it is; the library would pass over a refusal.
        auto channel = openChannel(asking.whom, 1, ARES_FLAG_NOCHECKRESP);
        if (!channel) return channel.error();
        asking.answer.server = server;
        asking.channel = std::move(*channel);
        ares_query(asking.channel.get(), name.c_str(), kInternet, static_cast<int>(RecordType::a),
                   keepServerAnswer, &asking);
    }
    std::vector<ares_channel> channels;
    for (const auto& each : all) channels.push_back(each->channel.get());
    while (std::ranges::any_of(all, [](const auto& each) { return each->running; })) {
        const Wait wait = turn(channels, until);
        if (wait == Wait::stopped) return waitFailure(wait, "the name server");
        if (wait == Wait::timeout) break;
    }
    for (ares_channel each : channels) ares_cancel(each);
    std::vector<NameServerAnswer> answers;
    for (const auto& each : all) answers.push_back(each->answer);
    return answers;
}

std::string freshName(const std::string& wildcardSuffix) {
    std::array<std::uint8_t, 8> bytes{};
    (void)!::getrandom(bytes.data(), bytes.size(), 0);
    std::string name;
    for (const std::uint8_t byte : bytes) name += static_cast<char>('a' + byte % 26);
    return name + (wildcardSuffix.starts_with(".") ? "" : ".") + wildcardSuffix;
}

}  // namespace wp
