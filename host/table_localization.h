#pragma once

#include <mutex>

#include "host/locale.h"
#include "host/string_table.h"
#include "host/unicode/unicode.h"
#include "platform/localization.h"

namespace wp::host {

/// String tables of the program, and the order of names in a language.
class TableLocalization final : public Localization {
  public:
    /// The choice's table must be one of `stringTableNames()`.
    explicit TableLocalization(const LocaleChoice& choice);

    std::string localizedString(std::string_view key) const override;
    std::string collationKey(std::string_view name) const override;

  private:
    StringTable table_;
    std::string collationLocale_;
    // Made with the first name that is sorted: a run without the list never pays for it.
    mutable std::once_flag orderOnce_;
    mutable NameOrder order_;
};

}  // namespace wp::host
