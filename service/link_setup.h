#pragma once

#include <string>
#include <vector>

#include "service/address_configuration.h"
#include "service/captive_portal.h"
#include "service/double_translation.h"
#include "service/maker.h"
#include "service/reachability.h"

namespace wp {

/// How the interface is set up, by its connection manager, else by what the kernel and the files of the system
/// give away.
struct LinkSetup {
    /// "NetworkManager", "systemd-networkd", "ConnMan"; "addresses": nobody, so that those were looked at; "ifupdown": the same, held
    /// together with what its file says; "dhcpcd": an address stands in its settings.
    std::string toldBy;
    AddressMethods methods;
    Known<NameServers> nameServers;
    Known<WebProxyPlaces> proxies;
    std::vector<IPAddress> servers;             ///< whom to ask for names over this interface
    std::vector<IPAddress> serversElsewhere{};  ///< whom the device asks over another one
    FamiliesOut leadsOut;                       ///< by its default routes; over both where it has none
    std::string portalApi;                      ///< what the lease names; empty where it names none
    Known<std::string> leaseText;               ///< the vendor's text in the lease, empty where it has none
};

/// What the router says of itself on the local network.
struct RouterAnswers {
    RouterDescription description;
    std::optional<IPAddress> external;  ///< its outer address
};

/// What became of the two requests to the vendor's service.
struct VendorContacts {
    Known<ServiceContact> reach;
    Known<ServiceContact> retrieve;
    ClockCheck clock;
};

}  // namespace wp
