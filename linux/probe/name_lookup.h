#pragma once

#include <string>
#include <vector>

#include "linux/stop_signal.h"
#include "service/ip_address.h"
#include "service/reachability.h"

namespace wp {

/// Whom to ask for names, and over which interface.
struct NameServerSet {
    std::vector<IPAddress> servers;
    std::string interfaceName;  ///< empty: any
    std::uint16_t port = 53;
    FamiliesOut leadsOut{};
};

/// Asks for the name's addresses of both families at once, each server 2 s, twice. Addresses by which the interface does
/// not lead out end no wait for others; IPv6 alone does not for a second, since it often leads nowhere. No cache and no
/// hosts file of this device is looked into. What the servers say, and that none of them answers, are both answers; that
/// there is none to be asked too. An error is only that the lookup was stopped, or could not begin, above all because it
/// may not go over the interface. *Any* thread.
Known<NameAnswer> lookUpName(const std::string& name, const NameServerSet& whom, const Until& until);

enum class RecordType : int { a = 1, aaaa = 28 };

/// The addresses of this type, at most 32, in a name server's whole answer; none where it is broken or says no.
/// *Any* thread.
std::vector<IPAddress> addressesFromAnswer(RecordType type, Bytes answer);

/// Asks each of the first six servers by itself for the name's IPv4 address, all at once, once, for up to 2 s: which of
/// them work, which the lookup of a name does not tell as long as one does. An error is only that it was stopped, or
/// could not begin. *Any* thread.
Known<std::vector<NameServerAnswer>> askEachServer(const std::string& name, const NameServerSet& whom,
                                                   const Until& until);

/// A name that no cache holds: eight random letters before the suffix, for a zone that answers to every name.
std::string freshName(const std::string& wildcardSuffix);

}  // namespace wp
