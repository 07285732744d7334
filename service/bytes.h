#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

namespace wp {

/// Bytes from outside, read only through bounds that the reader has checked. They live as long as the buffer
/// that they point into.
using Bytes = std::span<const std::uint8_t>;

/// Two bytes, the lower first. The caller has checked that `at + 2 <= bytes.size()`. *Any* thread.
inline std::uint16_t littleEndian16(Bytes bytes, std::size_t at) {
    return static_cast<std::uint16_t>(bytes[at] | (bytes[at + 1] << 8));
}

/// Four bytes, the highest first. The caller has checked that `at + 4 <= bytes.size()`. *Any* thread.
inline std::uint32_t bigEndian32(Bytes bytes, std::size_t at) {
    return std::uint32_t{bytes[at]} << 24 | std::uint32_t{bytes[at + 1]} << 16 |
           std::uint32_t{bytes[at + 2]} << 8 | bytes[at + 3];
}

}  // namespace wp
