#include "host/icu_localization.h"

#include <unicode/coll.h>
#include <unicode/unistr.h>

namespace wp::host {

struct IcuLocalization::Collation {
    explicit Collation(const std::string& locale) {
        UErrorCode status = U_ZERO_ERROR;
        icu::Locale wanted = locale.empty() ? icu::Locale::getRoot() : icu::Locale(locale.c_str());
        collator.reset(icu::Collator::createInstance(wanted, status));
        if (!collator) return;
        // Some locales ignore blanks and punctuation by default; in names of networks they count.
        collator->setAttribute(UCOL_ALTERNATE_HANDLING, UCOL_NON_IGNORABLE, status);
        collator->setStrength(icu::Collator::SECONDARY);
    }
    std::unique_ptr<icu::Collator> collator;
};

IcuLocalization::IcuLocalization(const LocaleChoice& choice)
    : table_(stringTable(choice.stringTable).value_or(StringTable{})), collationLocale_(choice.collation) {}

IcuLocalization::~IcuLocalization() = default;

std::string IcuLocalization::localizedString(std::string_view key) const {
    auto found = table_.find(key);
    return found == table_.end() ? "" : found->second;
}

const IcuLocalization::Collation& IcuLocalization::collation() const {
    std::call_once(collationOnce_, [this] { collation_ = std::make_unique<Collation>(collationLocale_); });
    return *collation_;
}

std::string IcuLocalization::collationKey(std::string_view name) const {
    const icu::Collator* collator = collation().collator.get();
    // Without ICU's data the names still have one fixed order.
    if (!collator) return std::string(name);
    icu::UnicodeString text =
        icu::UnicodeString::fromUTF8(icu::StringPiece(name.data(), static_cast<std::int32_t>(name.size())));
    std::string key(64 + 4 * name.size(), '\0');
    auto* bytes = reinterpret_cast<std::uint8_t*>(key.data());
    std::int32_t length = collator->getSortKey(text, bytes, static_cast<std::int32_t>(key.size()));
    if (length > static_cast<std::int32_t>(key.size())) {
        key.resize(static_cast<std::size_t>(length));
        bytes = reinterpret_cast<std::uint8_t*>(key.data());
        length = collator->getSortKey(text, bytes, length);
    }
    key.resize(static_cast<std::size_t>(length > 0 ? length - 1 : 0));  // ICU ends a key with a zero byte
    return key;
}

}  // namespace wp::host
