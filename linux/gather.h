#pragma once

#include <functional>
#include <optional>
#include <string>

#include "linux/echo_socket.h"
#include "linux/radio_socket.h"
#include "linux/scanner.h"
#include "service/facts.h"

namespace wp {

// One function for each kind of fact. Each blocks its thread until it has the fact, cannot have it, or `until`
// ends it, and changes nothing on the machine but the scan that it was asked for. *Any* thread.

/// The Wi-Fi interface to look at: the named one, else the first that has joined a network, else the first.
Known<Link> gatherLink(const std::optional<std::string>& wantedInterface, const Until& until);

/// The link as its addresses, routes and set-up know it: under name and number of the bridge or bond that it is part of.
Link addressed(const Link& link);
/// Whether a switch, of software or of hardware, keeps the interface's radio off. \param root a root folder
bool isSwitchedOff(const std::string& interfaceName, const std::string& root = "");
/// Whether the interface has left the network that it was joined to, has gone down or is gone. That it roamed to another
/// access point is no loss.
bool hasLostNetwork(const Link& link, const Until& until);
/// The reason why nothing can be told of an interface that is down.
Error isDown(const Link& link);

/// The link's parameters and its signal, sampled over one second.
Known<Station> gatherStation(const Link& link, const Until& until);
Known<Survey> gatherSurvey(const Link& link, const Until& until);
Known<Regulation> gatherRegulation(const Link& link, const Until& until);
Known<Addresses> gatherAddresses(const Link& link, const Until& until);
/// Echo requests to the address over the link. Where all stay unanswered because this device drops the answers, that is the
/// error.
Known<Echo> askForEcho(const Link& link, const IPAddress& target, EchoSocket& socket, HomeChannel::Stay& stay,
                       const Until& until);
/// Those to the router.
Known<Echo> gatherGatewayEcho(const Link& link, EchoSocket& socket, HomeChannel::Stay& stay,
                              const Until& until);

/// Whether the kernel has lately heard from this address on the link, as from a router that ignores echo requests.
bool answersAsNeighbour(const Link& link, const std::string& address, const Until& until);

/// What the radio counted within one second on the channel of the joined network; nothing where none is joined or nothing
/// is counted. Visits to other channels in between only make it longer.
Known<Airtime> gatherAirtime(const Link& link, HomeChannel::Stay& stay, const Until& until);
/// The channels on which radio and regulatory domain allow a network.
Known<AllowedChannels> gatherAllowedChannels(const Link& link, const Until& until);
AllowedChannels allowedAmong(const std::vector<RadioChannel>& channels);

/// Why there is no interface, or none of that name, that joins networks: one may be an access point, or listen only.
Error noStation(const std::vector<RadioInterface>& all, const std::optional<std::string>& wanted);
/// All station interfaces of this machine, those in use first.
Known<std::vector<RadioInterface>> gatherStationInterfaces(const Until& until);
/// What an interface is used for, the most first.
enum class Use { joined, up, down };
/// Joined ones first, then those that are up, each in the kernel's order; the first is the one that is looked at.
/// @param useOf asked once for each
void putInUseFirst(std::vector<RadioInterface>& interfaces,
                   const std::function<Use(const RadioInterface&)>& useOf);

}  // namespace wp
