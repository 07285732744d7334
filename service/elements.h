#pragma once

#include "service/bytes.h"

namespace wp {

/// One information element: the bytes after its identifier and length (and, for vendor and extension
/// elements, after what tells them apart). An element of length zero is present and empty.
struct Element {
    const std::uint8_t* data = nullptr;
    std::uint8_t size = 0;

    bool present() const { return data != nullptr; }
    Bytes bytes() const { return {data, size}; }
};

/// The information elements that the tests read, each the first of its kind, as places in the bytes that were
/// decoded.
struct Elements {
    Element name;                  ///< 0
    Element rates;                 ///< 1
    Element trafficMap;            ///< 5, in beacons only
    Element country;               ///< 7
    Element load;                  ///< 11
    Element protection;            ///< 42
    Element htCapabilities;        ///< 45
    Element rsn;                   ///< 48
    Element extendedRates;         ///< 50
    Element htOperation;           ///< 61
    Element wapi;                  ///< 68
    Element multipleBssidIndex;    ///< 85, of a network that another one's beacon tells
    Element interworking;          ///< 107
    Element extendedCapabilities;  ///< 127
    Element vhtCapabilities;       ///< 191
    Element vhtOperation;          ///< 192
    Element heCapabilities;        ///< 255, 35
    Element heOperation;           ///< 255, 36
    Element ehtOperation;          ///< 255, 106
    Element ehtCapabilities;       ///< 255, 108
    Element wpa;                   ///< vendor 00-50-F2, 1
    Element wps;                   ///< vendor 00-50-F2, 4 (its first fragment)
    Element hotspot;               ///< vendor 50-6F-9A, 16
    Element onlineSignUp;          ///< vendor 50-6F-9A, 18
    Element oweTransition;         ///< vendor 50-6F-9A, 28
    Element rsnOverride;   ///< vendor 50-6F-9A, 41: like the RSN element, for stations that look for it
    Element rsnOverride2;  ///< vendor 50-6F-9A, 42: another one

    bool malformed = false;  ///< an element's length reached beyond the end; those before it are kept
};

/// Finds the elements in the body of a beacon or a probe response. It allocates nothing and never reads past
/// the end. *Any* thread.
Elements decodeElements(Bytes bytes);

/// Fills what `elements` lacks from `others`, so that a probe response and the beacon of the same access
/// point complete each other. *Any* thread.
void addMissingElements(Elements& elements, const Elements& others);

/// Calls `visit(identifier, body)` for each element up to the first malformed one; returns whether all were
/// well formed.
template <class Visit>
bool forEachElement(Bytes bytes, Visit visit) {
    while (bytes.size() >= 2) {
        const std::size_t length = bytes[1];
        if (length > bytes.size() - 2) return false;
        visit(bytes[0], bytes.subspan(2, length));
        bytes = bytes.subspan(2 + length);
    }
    return bytes.empty();
}

}  // namespace wp
