#include "service/elements.h"

#include <array>

namespace wp {
namespace {

using Slot = Element Elements::*;

constexpr std::uint8_t kVendor = 221;
constexpr std::uint8_t kExtension = 255;

constexpr std::array<Slot, 256> singleSlots() {
    std::array<Slot, 256> slots{};
    slots[0] = &Elements::name;
    slots[1] = &Elements::rates;
    slots[5] = &Elements::trafficMap;
    slots[7] = &Elements::country;
    slots[11] = &Elements::load;
    slots[42] = &Elements::protection;
    slots[45] = &Elements::htCapabilities;
    slots[48] = &Elements::rsn;
    slots[50] = &Elements::extendedRates;
    slots[61] = &Elements::htOperation;
    slots[68] = &Elements::wapi;
    slots[85] = &Elements::multipleBssidIndex;
    slots[107] = &Elements::interworking;
    slots[127] = &Elements::extendedCapabilities;
    slots[191] = &Elements::vhtCapabilities;
    slots[192] = &Elements::vhtOperation;
    return slots;
}

constexpr std::array<Slot, 256> kSingle = singleSlots();

/// Vendor elements are told apart by three bytes of the vendor and one of its type.
Slot vendorSlot(std::uint32_t vendorAndType) {
    switch (vendorAndType) {
        case 0x0050F201:
            return &Elements::wpa;
        case 0x0050F204:
            return &Elements::wps;
        case 0x506F9A10:
            return &Elements::hotspot;
        case 0x506F9A12:
            return &Elements::onlineSignUp;
        case 0x506F9A1C:
            return &Elements::oweTransition;
        case 0x506F9A29:
            return &Elements::rsnOverride;
        case 0x506F9A2A:
            return &Elements::rsnOverride2;
        default:
            return nullptr;
    }
}

Slot extensionSlot(std::uint8_t extension) {
    switch (extension) {
        case 35:
            return &Elements::heCapabilities;
        case 36:
            return &Elements::heOperation;
        case 106:
            return &Elements::ehtOperation;
        case 108:
            return &Elements::ehtCapabilities;
        default:
            return nullptr;
    }
}

void keep(Elements& elements, Slot slot, Bytes body) {
    if (slot == nullptr || (elements.*slot).present()) return;
    elements.*slot = {body.data(), static_cast<std::uint8_t>(body.size())};
}

void keepByKind(Elements& elements, std::uint8_t identifier, Bytes body) {
    if (identifier == kVendor) {
        if (body.size() >= 4) keep(elements, vendorSlot(bigEndian32(body, 0)), body.subspan(4));
    } else if (identifier == kExtension) {
        if (!body.empty()) keep(elements, extensionSlot(body[0]), body.subspan(1));
    } else {
        keep(elements, kSingle[identifier], body);
    }
}

constexpr Slot kAll[] = {
    &Elements::name,
    &Elements::rates,
    &Elements::trafficMap,
    &Elements::country,
    &Elements::load,
    &Elements::protection,
    &Elements::htCapabilities,
    &Elements::rsn,
    &Elements::extendedRates,
    &Elements::htOperation,
    &Elements::wapi,
    &Elements::multipleBssidIndex,
    &Elements::interworking,
    &Elements::hotspot,
    &Elements::extendedCapabilities,
    &Elements::wpa,
    &Elements::vhtCapabilities,
    &Elements::wps,
    &Elements::vhtOperation,
    &Elements::heOperation,
    &Elements::heCapabilities,
    &Elements::ehtOperation,
    &Elements::ehtCapabilities,
    &Elements::onlineSignUp,
    &Elements::oweTransition,
    &Elements::rsnOverride,
    &Elements::rsnOverride2,
};

}  // namespace

Elements decodeElements(Bytes bytes) {
    Elements elements;
    elements.malformed = !forEachElement(
        bytes, [&](std::uint8_t identifier, Bytes body) { keepByKind(elements, identifier, body); });
    return elements;
}

void addMissingElements(Elements& elements, const Elements& others) {
    for (const Slot slot : kAll) {
        if (!(elements.*slot).present()) elements.*slot = others.*slot;
    }
}

}  // namespace wp
