#pragma once

#include <string>
#include <string_view>

namespace wp {

/// The extension's string table and the user's collation. *Any* thread.
class Localization {
  public:
    virtual ~Localization() = default;

    /// The text under the key in the default table of the user's language; "" when the key is missing.
    virtual std::string localizedString(std::string_view key) const = 0;

    /// A sort key for the name: keys compare by bytes as the names do in the user's locale, with letter case
    /// ignored and accents kept. Equal keys: the names collate as equal.
    virtual std::string collationKey(std::string_view name) const = 0;
};

/// The format with its one "%@" replaced by the argument; a format without one stays as it is. The argument
/// is text and never a format.
std::string formatted(std::string_view format, std::string_view argument);

}  // namespace wp
