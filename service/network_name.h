#pragma once

#include <array>
#include <compare>
#include <optional>
#include <string>
#include <string_view>

#include "service/bytes.h"

namespace wp {

/// The name of a network as it is in the air: up to 32 bytes without any meaning. Names compare by their
/// bytes.
class NetworkName {
  public:
    static constexpr std::size_t kMaximumSize = 32;

    /// An empty name, which stands for no name.
    NetworkName() = default;
    /// The name of these bytes; bytes beyond the 32nd are dropped.
    explicit NetworkName(Bytes bytes);

    Bytes bytes() const { return {bytes_.data(), size_}; }

    /// Whether the name says nothing: no byte at all, or zeros only, as access points send that hide theirs.
    bool absent() const;

    friend bool operator==(const NetworkName&, const NetworkName&) = default;

  private:
    std::array<std::uint8_t, kMaximumSize> bytes_{};
    std::uint8_t size_ = 0;
};

/// The name as text. Valid UTF-8 stands as it is; in any other name each byte that is no UTF-8 becomes `\xNN`
/// (two upper-case digits). So that `nameFromText` finds the bytes again, the backslash of a name that itself
/// holds such a sequence becomes `\x5C`. *Any* thread.
std::string textFromName(const NetworkName& name);

/// The inverse of `textFromName`; nothing when the bytes are more than a name can have. *Any* thread.
std::optional<NetworkName> nameFromText(std::string_view text);

/// Whether the name ends in "_nomap" in any mix of upper and lower case: its owner asks not to be mapped, and
/// such a network is neither probed nor tested. *Any* thread.
bool optsOutOfTests(const NetworkName& name);

}  // namespace wp
