#pragma once

#include <map>
#include <set>
#include <string>
#include <string_view>

namespace wp {

/// Replacements for network names. Not for several threads at once.
class AnonymousNames {
  public:
    /// Fixes the replacement of each of these names.
    explicit AnonymousNames(const std::set<std::string>& names);

    /// The replacement of a known name; any other text as it stands.
    std::string replaced(const std::string& text) const;

    /// The text with each known name of at least three bytes replaced that stands in it as a word of its own.
    std::string replacedWithin(std::string_view text) const;

  private:
    std::map<std::string, std::string, std::less<>> replacements_;
};

}  // namespace wp
