#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "service/ip_address.h"

namespace wp {

/// What dnsmasq is told, by its command line and its files, of whom it asks for names.
struct DnsmasqSettings {
    std::vector<IPAddress> servers;  ///< entered by a person, for all names
    std::vector<IPAddress>
        special;  ///< of them those that it asks at another port, or over one interface alone
    std::vector<std::string> resolverFiles;
    bool readsResolverFiles = true;
    bool answersAtAll = true;          ///< and not on other interfaces than loopback alone
    bool answersAtUsualPort = true;    ///< where those ask who go by the resolver's file
    bool namesInterfaces = false;      ///< on which it answers beside its addresses, and on loopback then
    std::vector<IPAddress> listensAt;  ///< empty: everywhere
    bool heedsBus = false;             ///< somebody may tell it servers over the message bus
    std::vector<std::string> files;    ///< with more settings
    bool readsDefaultFile = true;      ///< unless the command line names another in its place
    /// The same, with endings that are left out or alone count: "PATH,.old,*.conf".
    std::vector<std::string> folders;
};

/// Reads the settings of a file of dnsmasq's in addition to what was read. *Any* thread.
void readDnsmasqFile(std::string_view text, DnsmasqSettings& into);
/// Reads those of its command line. \param words program and arguments
void readDnsmasqCommand(const std::vector<std::string>& words, DnsmasqSettings& into);

/// Whom the device's own dnsmasq asks.
struct DnsmasqServers {
    std::vector<IPAddress> asked;    ///< as everybody can ask them
    std::vector<IPAddress> entered;  ///< those that stand in its settings
    bool heedsBus = false;           ///< there may be more
};

/// The servers that are asked by the one dnsmasq that answers on this device itself and asks others. Nothing where none does, or
/// several do, or where it is told over the message bus alone. *Any* thread.
/// \param root a root folder
std::optional<DnsmasqServers> dnsmasqServers(const std::string& root = "");

}  // namespace wp
