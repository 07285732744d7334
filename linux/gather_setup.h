#pragma once

#include "linux/stop_signal.h"
#include "service/facts.h"

namespace wp {

// What this device itself is set up to, from its connection manager, its message bus and its files. Each function
// blocks until it has the fact, cannot have it, or `until` ends it, and changes nothing. *Any* thread.

/// Of NetworkManager, systemd-networkd or ConnMan where one of them manages the interface, else from addresses, leases and
/// the resolver's file.
Known<LinkSetup> gatherSetup(const Link& link, const Until& until);

/// The networks that are remembered by whatever manages the interface: NetworkManager, iwd or wpa_supplicant. ConnMan does not
/// tell them.
Known<SavedNetworks> gatherSaved(const Link& link, const Until& until);

Known<Bluetooth> gatherBluetooth(const Until& until);

/// The Wi-Fi driver's switch for sharing its airtime with Bluetooth. \param root a root folder
Known<bool> gatherAirtimeSharing(const Link& link, const std::string& root = "");

/// The peer-to-peer links on the interface's radio. \param indicator the file that the device's maker names
Known<PeerLinks> gatherPeerLinks(const Link& link, const std::string& indicator, const Until& until);

}  // namespace wp
