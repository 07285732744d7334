#pragma once

#include <string>
#include <vector>

#include "service/ip_address.h"
#include "service/outcome.h"

namespace wp {

/// How the interface gets its addresses, in the words of the connection manager: "auto", "dhcp", "manual",
/// "link-local", "shared", "ignore", "disabled". Where no manager tells and the addresses themselves had to
/// be looked at: "dynamic" or "static".
struct AddressMethods {
    Known<std::string> ipv4;
    Known<std::string> ipv6;
};

/// One address as the kernel keeps it, for devices without a manager that tells.
struct AssignedAddress {
    IPAddress address;
    bool permanent = false;  ///< without an end to its life
    /// It was made of a router's advertisement or as a link-local one, or a lease of DHCPv6 grants it.
    bool byItself = false;
};

/// The kernel's own switches for IPv6 on the interface.
struct KernelIPv6 {
    bool disabled = false;
    bool acceptsAdvertisements = true;
    /// A client looks at advertisements in the kernel's place, and sets what they grant without an end as a person would.
    bool setByClient = false;
};

/// How addresses of one family are to be set by a file's word, for devices where the program that goes by it cannot be asked.
struct FamilyPlan {
    std::string method;                ///< "auto", "manual", "link-local"; empty where the file does not say
    std::vector<IPAddress> addresses;  ///< entered there by hand
};

/// Whether the interface has an address that stands in the file, without an end as such addresses are. *Any* thread.
bool isAssigned(const FamilyPlan& plan, const std::vector<AssignedAddress>& addresses);

/// What a file says of one interface.
struct InterfacePlan {
    FamilyPlan ipv4, ipv6;
    std::vector<IPAddress> servers;  ///< name servers entered there by hand
};

/// The method of IPv4 as the addresses give it away: an address without an end that no lease accounts for was
/// put there by hand. Where there is no address a plan tells; so it does of an address that stands in it. An address without
/// an end on an interface that is to ask for one tells nothing. *Any* thread.
/// \param hasLease whether there is a lease in force, or a client that may have one
Known<std::string> methodFromIPv4Addresses(const std::vector<AssignedAddress>& addresses, bool hasLease,
                                           const FamilyPlan& plan = {});
/// The same for IPv6, where a client's address without an end tells nothing. *Any* thread.
Known<std::string> methodFromIPv6Addresses(const std::vector<AssignedAddress>& addresses,
                                           const KernelIPv6& kernel, const FamilyPlan& plan = {});

/// Whether all addresses of the interface were put there by hand, so that neither a lease nor an advertisement can have
/// brought name servers along. *Any* thread.
bool allSetByHand(const std::vector<AssignedAddress>& addresses);

/// Test 14: whether IPv4 is set up in any other way than by itself. Information: "IPv4ConfigMethod".
Outcome usesCustomIPv4(const AddressMethods& methods);
/// Test 15: the same for IPv6; switched off counts as custom. Information: "IPv6ConfigMethod".
Outcome usesCustomIPv6(const AddressMethods& methods);

/// The name servers of the interface, by where they come from.
struct NameServers {
    std::vector<IPAddress> manual;     ///< entered by a person
    std::vector<IPAddress> effective;  ///< those that are asked, behind a resolver on the device itself
    std::vector<IPAddress> offered;    ///< by DHCP or a router's advertisement
    bool offerKnown = false;           ///< whether what the network offers could be read at all
    std::vector<IPAddress> routers{};  ///< the interface's; where the offer is not known they may well be it
    bool advertisementsKnown = true;   ///< whether the offer holds servers of IPv6 that a router advertises
};

/// Test 16: whether a name server was entered by hand, or one is asked that the network did not offer. A
/// resolver on the device itself whose own servers are not known cannot be judged. Where the offer is not known, a server
/// that is the network's own router is taken for offered: asking it means going the network's way in any case.
Outcome usesCustomNameServers(const Known<NameServers>& servers);

/// Where a proxy is set, for example "environment: https_proxy"; empty when nowhere.
using WebProxyPlaces = std::vector<std::string>;

/// Test 17: whether a proxy, or a script that finds one, is set anywhere. One that the network offers by DHCP
/// is not the device's own setting and does not count.
Outcome usesCustomWebProxy(const Known<WebProxyPlaces>& places);

}  // namespace wp
