#pragma once

#include <initializer_list>
#include <string_view>
#include <vector>

#include "service/access_point.h"
#include "service/facts.h"

namespace wp {

using Frame = std::vector<std::uint8_t>;

/// A frame of these elements, each already with identifier and length.
inline Frame operator+(Frame left, const Frame& right) {
    left.insert(left.end(), right.begin(), right.end());
    return left;
}

inline Frame element(std::uint8_t identifier, const Frame& body) {
    return Frame{identifier, static_cast<std::uint8_t>(body.size())} + body;
}

inline Frame nameElement(std::string_view name) {
    return element(0, Frame(name.begin(), name.end()));
}

inline Frame vendorElement(std::uint32_t vendorAndType, const Frame& body = {}) {
    const Frame head{static_cast<std::uint8_t>(vendorAndType >> 24),
                     static_cast<std::uint8_t>(vendorAndType >> 16),
                     static_cast<std::uint8_t>(vendorAndType >> 8), static_cast<std::uint8_t>(vendorAndType)};
    return element(221, head + body);
}

inline Frame suiteList(std::uint32_t vendor, const std::vector<std::uint8_t>& types) {
    Frame list{static_cast<std::uint8_t>(types.size()), 0};
    for (const std::uint8_t type : types) {
        list = list + Frame{static_cast<std::uint8_t>(vendor >> 16), static_cast<std::uint8_t>(vendor >> 8),
                            static_cast<std::uint8_t>(vendor), type};
    }
    return list;
}

/// An RSN element with one group cipher.
inline Frame rsnElement(std::uint8_t group, const std::vector<std::uint8_t>& pairwise,
                        const std::vector<std::uint8_t>& keys, std::uint8_t capabilities = 0) {
    return element(48, Frame{1, 0, 0x00, 0x0F, 0xAC, group} + suiteList(0x000FAC, pairwise) +
                           suiteList(0x000FAC, keys) + Frame{capabilities, 0});
}

/// A WPA element with TKIP for its group.
inline Frame wpaElement(const std::vector<std::uint8_t>& pairwise, const std::vector<std::uint8_t>& keys) {
    return vendorElement(0x0050F201, Frame{1, 0, 0x00, 0x50, 0xF2, 2} + suiteList(0x0050F2, pairwise) +
                                         suiteList(0x0050F2, keys));
}

constexpr std::uint16_t kPrivacy = 0x0010;

/// An access point that was heard by this beacon only.
inline AccessPoint heard(const Frame& beacon, std::uint32_t frequency = 2412, int signal = -50,
                         std::uint16_t capability = 0) {
    static std::uint8_t last = 0;
    AccessPoint accessPoint;
    accessPoint.address = {2, 0, 0, 0, ++last, 0};  // each a device of its own
    accessPoint.frequency = frequency;
    accessPoint.signal = signal;
    accessPoint.beaconInterval = 100;
    accessPoint.capability = capability;
    accessPoint.elements = beacon;
    accessPoint.beaconElements = beacon;
    accessPoint.says = decodeAdvertised(capability, beacon, Bytes(beacon));
    return accessPoint;
}

/// The facts of a device that is joined to the first of these access points and hears them all.
inline Facts joinedTo(std::vector<AccessPoint> nearby) {
    nearby.front().joined = true;
    Facts facts;
    facts.link = Link{"wlan0", 3, 0, true, nearby.front()};
    facts.nearby = std::move(nearby);
    facts.listened = std::vector<AccessPoint>();
    return facts;
}

/// The facts of a device that is joined to nothing and is asked about a name.
inline Facts askedAbout(std::string_view name, std::vector<AccessPoint> nearby) {
    Facts facts;
    facts.named = nameFromText(name);
    facts.link = Link{"wlan0", 3, 0, true, std::nullopt};
    facts.nearby = std::move(nearby);
    facts.listened = std::vector<AccessPoint>();
    return facts;
}

}  // namespace wp
