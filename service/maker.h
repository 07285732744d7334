#pragma once

#include <array>
#include <optional>
#include <string>
#include <vector>

#include "service/access_point.h"
#include "service/outcome.h"

namespace wp {

/// What an access point says of its maker in its Wi-Fi Protected Setup elements, each text as far as it is
/// valid UTF-8 without control characters.
struct WpsDescription {
    std::string manufacturer;
    std::string modelName;
    std::string modelNumber;
    std::string deviceName;
};

/// Reads the attributes of all WPS elements of a frame, which may be spread over several. *Any* thread.
WpsDescription decodeWps(Bytes elements);

/// What a router says of itself on the local network.
struct RouterDescription {
    std::string manufacturer;
    std::string modelName;
    std::string friendlyName;
};

using VendorPrefix = std::array<std::uint8_t, 3>;

/// The makers that the tests look for; a device maker's own data file fills it.
struct Vendors {
    /// Whose base stations are told apart by test 33.
    struct BaseStation {
        std::vector<std::string> manufacturers;  ///< texts with which the maker's name begins, without case
        std::vector<VendorPrefix> prefixes;      ///< of the access point's address
    };
    /// Whose personal hotspots are told apart by test 44; any one rule suffices.
    struct Hotspot {
        struct VendorElement {
            VendorPrefix prefix;
            std::optional<std::uint8_t> type;
        };
        std::vector<VendorElement> elements;
        std::vector<std::vector<std::uint8_t>> addressPrefixes;  ///< one to six bytes of the address
        std::vector<std::string> leaseTexts;                     ///< contained in the lease's vendor text
    };
    BaseStation baseStation;
    Hotspot hotspot;
    /// Names that access points carry out of the box, and words that say nothing, for test 42; without case.
    std::vector<NetworkName> commonNames;
};

/// Test 33: whether the access point is the vendor's. Information: "MarlixModelName", where a model is told.
/// Cannot tell where a maker's name would decide and nobody names one.
/// \param router what the router says of itself, for the joined network only; else why that is not known
Outcome isVendorBaseStation(const AccessPoint& accessPoint, const Known<RouterDescription>& router,
                            const Vendors::BaseStation& vendor);

/// Which kinds of rules say that an access point is a hotspot of the vendor's.
struct HotspotMatches {
    bool element = false;
    bool addressPrefix = false;
    bool leaseText = false;
    bool any() const { return element || addressPrefix || leaseText; }
};
/// Which of the vendor's rules match. *Any* thread.
/// \param leaseText the vendor's text in the lease, for the joined network only; else why there is none
HotspotMatches hotspotMatches(const AccessPoint& accessPoint, const Known<std::string>& leaseText,
                              const Vendors::Hotspot& vendor);

/// Test 44: whether the access point is a personal hotspot of the vendor's; parameters as above. Cannot tell where
/// only a lease could, and there is none.
Outcome isVendorHotspot(const AccessPoint& accessPoint, const Known<std::string>& leaseText,
                        const Vendors::Hotspot& vendor);

}  // namespace wp
