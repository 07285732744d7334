#pragma once

#include <memory>
#include <mutex>

#include "host/locale.h"
#include "host/string_table.h"
#include "platform/localization.h"

namespace wp::host {

/// String tables of the program and ICU's collation: case is ignored, accents count, and so do blanks and
/// punctuation.
class IcuLocalization final : public Localization {
  public:
    /// The choice's table must be one of `stringTableNames()`.
    explicit IcuLocalization(const LocaleChoice& choice);
    ~IcuLocalization() override;

    std::string localizedString(std::string_view key) const override;
    std::string collationKey(std::string_view name) const override;

  private:
    struct Collation;
    const Collation& collation() const;

    StringTable table_;
    std::string collationLocale_;
    // Made with the first name that is sorted: a run without the list never pays for ICU's data.
    mutable std::once_flag collationOnce_;
    mutable std::unique_ptr<Collation> collation_;
};

}  // namespace wp::host
