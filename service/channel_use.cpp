#include "service/channel_use.h"

#include <optional>

namespace wp {
namespace {

/// A channel number of the band's own counting, as a centre frequency.
std::uint32_t centreOf(Band band, unsigned number) {
    return (band == Band::ghz6 ? 5950 : 5000) + 5 * number;
}

/// Two centres of which the second, where it is not 0, says what lies beyond the first 80 MHz.
ChannelUse wideUse(Band band, unsigned first, unsigned second) {
    const unsigned apart = first > second ? first - second : second - first;
    if (second != 0 && apart == 8) return {160, {centreOf(band, second)}};
    if (second != 0 && apart > 8) return {160, {centreOf(band, first), centreOf(band, second)}};
    return {80, {centreOf(band, first)}};
}

/// 80 MHz and more on 5 GHz; nothing for narrower ones.
std::optional<ChannelUse> byVht(Bytes operation) {
    if (operation.size() < 3 || operation[0] == 0 || operation[1] == 0) return std::nullopt;
    if (operation[0] == 2) return ChannelUse{160, {centreOf(Band::ghz5, operation[1])}};
    return wideUse(Band::ghz5, operation[1], operation[2]);
}

/// On 6 GHz the HE operation carries the width, behind parts that may be there or not.
std::optional<ChannelUse> byHe(Bytes operation) {
    constexpr std::size_t kFixed = 6, kVhtPart = 3, kCohostedPart = 1;
    if (operation.size() < kFixed) return std::nullopt;
    const unsigned flags = operation[1] | operation[2] << 8U;
    if ((flags & 0x200U) == 0) return std::nullopt;
    const std::size_t at =
        kFixed + ((flags & 0x40U) != 0 ? kVhtPart : 0) + ((flags & 0x80U) != 0 ? kCohostedPart : 0);
    if (operation.size() < at + 4) return std::nullopt;
    const unsigned width = operation[at + 1] & 3U, first = operation[at + 2], second = operation[at + 3];
    if (first == 0) return std::nullopt;
    if (width < 2) return ChannelUse{20U << width, {centreOf(Band::ghz6, first)}};
    return wideUse(Band::ghz6, first, width == 3 ? second : 0);
}

std::optional<ChannelUse> byEht(Band band, Bytes operation) {
    constexpr std::size_t kFixed = 5;
    if (operation.size() < kFixed + 3 || (operation[0] & 1) == 0) return std::nullopt;
    const unsigned width = operation[kFixed] & 7U, first = operation[kFixed + 1],
                   second = operation[kFixed + 2];
    const unsigned centre = width >= 3 ? second : first;
    if (width > 4 || centre == 0) return std::nullopt;
    return ChannelUse{20U << width, {centreOf(band, centre)}};
}

ChannelUse byHt(const AccessPoint& accessPoint) {
    if (accessPoint.says.htSecondary == 1) return {40, {accessPoint.frequency + 10}};
    if (accessPoint.says.htSecondary == 3) return {40, {accessPoint.frequency - 10}};
    return {20, {accessPoint.frequency}};
}

}  // namespace

ChannelUse channelUseOf(const AccessPoint& accessPoint) {
    const Band band = accessPoint.band();
    if (band != Band::ghz5 && band != Band::ghz6) return byHt(accessPoint);
    const Elements elements = elementsOf(accessPoint);
    if (const auto use = byEht(band, elements.ehtOperation.bytes())) return *use;
    const auto use =
        band == Band::ghz5 ? byVht(elements.vhtOperation.bytes()) : byHe(elements.heOperation.bytes());
    return use ? *use : byHt(accessPoint);
}

std::vector<Span> occupiedBy(const AccessPoint& accessPoint) {
    const ChannelUse use = channelUseOf(accessPoint);
    const auto half = static_cast<std::uint32_t>(use.width / use.centres.size() / 2);
    std::vector<Span> spans;
    for (const std::uint32_t centre : use.centres) spans.push_back({centre - half, centre + half});
    return spans;
}

}  // namespace wp
