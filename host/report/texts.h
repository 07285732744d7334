#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "host/string_table.h"

namespace wp::host {

/// Values for the "{name}" places of a text.
using TextValues = std::vector<std::pair<std::string, std::string>>;

/// The texts of reports and of the catalogue in one language (`resources/strings/report.*.strings`). In the
/// table `x-keys` each text is its key, with the values of its places after one blank each. *Any* thread.
class Texts {
  public:
    /// \param table one of `stringTableNames()`
    explicit Texts(std::string_view table);

    /// The text with its places filled. A key that the language lacks gives the key itself.
    std::string text(std::string_view key, const TextValues& values = {}) const;
    bool has(std::string_view key) const { return table_.find(key) != table_.end(); }

    /// A number as people of the language write it, with that many decimals.
    std::string number(double value, int decimals) const;

    /// What stands between two sentences: a blank, or nothing in a script without blanks.
    std::string space() const;

    /// What follows another text in brackets of the language's script; nothing for nothing.
    std::string aside(const std::string& text) const;

    /// The words one after another, with the language's comma between them.
    std::string list(const std::vector<std::string>& words) const;

    /// The name of the table.
    const std::string& language() const { return language_; }

  private:
    std::string language_;
    bool showsKeys_;
    StringTable table_;
};

/// The names of the places of a text, in their order; a name that stands twice is named twice. *Any*.
std::vector<std::string> placesOf(std::string_view text);

}  // namespace wp::host
