#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "platform/records.h"
#include "service/network_name.h"
#include "service/outcome.h"
#include "service/thresholds.h"

namespace wp {

/// The security of a remembered network, with the numbers under which the document carries them.
enum class SavedSecurity : int {
    open = 0,
    owe = 1,
    wep = 2,
    wpaPersonal = 3,
    wpa2Personal = 4,
    sae = 5,
    enterprise = 6,
    unknown = 7,
};

/// One network that the device remembers.
struct SavedNetwork {
    NetworkName name;
    SavedSecurity security = SavedSecurity::unknown;
    bool passpoint = false;
    bool enabled = true;  ///< joined without asking
    bool captive = false;
    bool hidden = false;          ///< asked for by name, because its access points do not tell it
    bool seenSeveralAPs = false;  ///< under more than one access point's address
    std::optional<Date> lastJoined;
};

/// The networks of the one store that the interface is managed from.
struct SavedNetworks {
    std::string store;  ///< for the log: "NetworkManager", "wpa_supplicant", "iwd"
    std::vector<SavedNetwork> networks;
};

/// Test 47: whether many networks are remembered. Information: "PNLCount".
Outcome remembersManyNetworks(const Known<SavedNetworks>& saved, const SavedNetworkLimits& limits = {});
/// Test 48: whether a hidden one is among them: each is asked for by name in every scan.
Outcome remembersHiddenNetworks(const Known<SavedNetworks>& saved);
/// Test 29: whether two that are enabled have one name and different kinds of security. A password with and
/// without SAE is one kind, since networks change over from one to the other.
Outcome remembersConflictingSecurity(const Known<SavedNetworks>& saved);

/// The names, as bytes, of enabled networks that have several kinds of security, with what they have. *Any* thread.
std::map<std::vector<std::uint8_t>, std::set<SavedSecurity>> conflictingNames(const SavedNetworks& saved);

/// The remembered network of this name, enabled ones first, then the one joined last; null where there is
/// none.
const SavedNetwork* findSaved(const SavedNetworks& saved, const NetworkName& name);

/// The record of a remembered network. \param seenSeveralAPs what the scan says of the same name.
std::shared_ptr<const PreferredNetworkRecord> recordOf(const SavedNetwork& network, bool seenSeveralAPs);

}  // namespace wp
