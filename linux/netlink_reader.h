#pragma once

#include <cstring>
#include <optional>
#include <string>
#include <type_traits>

#include "service/bytes.h"

namespace wp {

/// A row of netlink attributes, read within bounds. A row that breaks off ends before the broken attribute.
/// *Any* thread.
class Attributes {
  public:
    Attributes() = default;
    explicit Attributes(Bytes bytes) : bytes_(bytes) {}

    /// Calls `visit(type, content)` for each attribute.
    template <class Visit>
    void forEach(Visit visit) const {
        Bytes rest = bytes_;
        while (const std::optional<Bytes> attribute = takeAttribute(rest)) {
            visit(typeOf(*attribute), attribute->subspan(kHeaderSize));
        }
    }

    /// The content of the first attribute of this type.
    std::optional<Bytes> find(std::uint16_t type) const;
    bool has(std::uint16_t type) const { return find(type).has_value(); }
    /// The attributes nested in the first one of this type; an empty row where there is none.
    Attributes nested(std::uint16_t type) const { return Attributes(find(type).value_or(Bytes())); }

    /// The number in the first attribute of this type; nothing when it is absent or has another size.
    template <class Number>
    std::optional<Number> number(std::uint16_t type) const {
        const std::optional<Bytes> content = find(type);
        return content ? numberIn<Number>(*content) : std::nullopt;
    }

    /// The text in the first attribute of this type, without its final zero.
    std::optional<std::string> text(std::uint16_t type) const;

    /// The number that these bytes are, in the machine's order.
    template <class Number>
    static std::optional<Number> numberIn(Bytes content) {
        static_assert(std::is_integral_v<Number>);
        if (content.size() != sizeof(Number)) return std::nullopt;
        Number number;
        std::memcpy(&number, content.data(), sizeof number);
        return number;
    }

  private:
    static constexpr std::size_t kHeaderSize = 4;

    static std::uint16_t typeOf(Bytes attribute);
    /// Cuts the next attribute, header and content, off the front.
    static std::optional<Bytes> takeAttribute(Bytes& rest);

    Bytes bytes_;
};

/// One netlink message of a buffer.
struct NetlinkMessage {
    std::uint16_t type = 0;
    std::uint16_t flags = 0;
    std::uint32_t sequence = 0;
    Bytes payload;

    /// The attributes after a header of this size; an empty row where the payload is shorter.
    Attributes attributesAfter(std::size_t headerSize) const {
        return Attributes(payload.size() > headerSize ? payload.subspan(headerSize) : Bytes());
    }
};

/// Cuts the next message off the front; nothing at the end and where a message breaks off. *Any* thread.
std::optional<NetlinkMessage> takeNetlinkMessage(Bytes& rest);

/// Calls `visit(message)` for each message of a buffer that carries content (no acknowledgements, errors or ends).
template <class Visit>
void forEachContent(Bytes buffer, Visit visit) {
    constexpr std::uint16_t kFirstContentType = 0x10;
    while (const std::optional<NetlinkMessage> message = takeNetlinkMessage(buffer)) {
        if (message->type >= kFirstContentType) visit(*message);
    }
}

/// Calls `visit(header, attributes)` for each message of this type that has room for the header.
template <class Header, class Visit>
void forEachOfType(std::uint16_t type, Bytes buffer, Visit visit) {
    constexpr std::size_t kAligned = (sizeof(Header) + 3) & ~std::size_t{3};
    forEachContent(buffer, [&](const NetlinkMessage& message) {
        Header header;
        if (message.type != type || message.payload.size() < sizeof header) return;
        std::memcpy(&header, message.payload.data(), sizeof header);
        visit(header, message.attributesAfter(kAligned));
    });
}

}  // namespace wp
