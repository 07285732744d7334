#include "linux/netlink_reader.h"

#include <linux/netlink.h>

#include <algorithm>

namespace wp {
namespace {

/// Netlink pads everything to four bytes; the last padding may be left out.
Bytes afterPadded(Bytes bytes, std::size_t size) {
    return bytes.subspan(std::min((size + 3) & ~std::size_t{3}, bytes.size()));
}

}  // namespace

std::uint16_t Attributes::typeOf(Bytes attribute) {
    std::uint16_t type;
    std::memcpy(&type, attribute.data() + 2, sizeof type);
    return type & NLA_TYPE_MASK;
}

std::optional<Bytes> Attributes::takeAttribute(Bytes& rest) {
    if (rest.size() < kHeaderSize) return std::nullopt;
    std::uint16_t size;
    std::memcpy(&size, rest.data(), sizeof size);
    if (size < kHeaderSize || size > rest.size()) return std::nullopt;
    const Bytes attribute = rest.first(size);
    rest = afterPadded(rest, size);
    return attribute;
}

std::optional<Bytes> Attributes::find(std::uint16_t type) const {
    Bytes rest = bytes_;
    while (const std::optional<Bytes> attribute = takeAttribute(rest)) {
        if (typeOf(*attribute) == type) return attribute->subspan(kHeaderSize);
    }
    return std::nullopt;
}

std::optional<std::string> Attributes::text(std::uint16_t type) const {
    const std::optional<Bytes> content = find(type);
    if (!content) return std::nullopt;
    return std::string(content->begin(), std::ranges::find(*content, 0));
}

std::optional<NetlinkMessage> takeNetlinkMessage(Bytes& rest) {
    nlmsghdr header;
    if (rest.size() < sizeof header) return std::nullopt;
    std::memcpy(&header, rest.data(), sizeof header);
    if (header.nlmsg_len < sizeof header || header.nlmsg_len > rest.size()) return std::nullopt;
    const Bytes payload = rest.subspan(sizeof header, header.nlmsg_len - sizeof header);
    rest = afterPadded(rest, header.nlmsg_len);
    return NetlinkMessage{header.nlmsg_type, header.nlmsg_flags, header.nlmsg_seq, payload};
}

}  // namespace wp
