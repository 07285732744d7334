#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace wp::host {

/// Which texts a run shows and by which locale its names are sorted.
struct LocaleChoice {
    std::string stringTable;  ///< one of `stringTableNames()`
    std::string collation;    ///< an ICU locale name, "" for the root locale

    friend bool operator==(const LocaleChoice&, const LocaleChoice&) = default;
};

/// The choice for a name that a person gave (`de`, `de_AT.UTF-8`, `ja-JP`, `x-keys`); nothing when no string
/// table has that language. *Any*.
std::optional<LocaleChoice> localeNamed(std::string_view name);

/// The environment's choice, as other programs take it: texts by LC_ALL, LC_MESSAGES, LANG, sorting by
/// LC_ALL, LC_COLLATE, LANG, the first that is set and not empty. A language without a string table gets the
/// default table and keeps its sorting; "C" and "POSIX" sort by the root locale. *Main*, before threads
/// begin.
LocaleChoice localeOfEnvironment();

}  // namespace wp::host
