#include <unicode/coll.h>
#include <unicode/unistr.h>

#include <memory>

#include "host/unicode/icu_functions.h"

namespace wp::host::icu_functions {
namespace {

std::shared_ptr<const icu::Collator> collatorOf(const std::string& locale) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale wanted = locale.empty() ? icu::Locale::getRoot() : icu::Locale(locale.c_str());
    const std::shared_ptr<icu::Collator> collator(icu::Collator::createInstance(wanted, status));
    if (!collator) return nullptr;
    // Some locales ignore blanks and punctuation by default; in names of networks they count.
    collator->setAttribute(UCOL_ALTERNATE_HANDLING, UCOL_NON_IGNORABLE, status);
    collator->setStrength(icu::Collator::SECONDARY);
    return collator;
}

std::string sortKey(const icu::Collator& collator, std::string_view name) {
    const icu::UnicodeString text =
        icu::UnicodeString::fromUTF8(icu::StringPiece(name.data(), static_cast<std::int32_t>(name.size())));
    std::string key(64 + 4 * name.size(), '\0');
    auto* bytes = reinterpret_cast<std::uint8_t*>(key.data());
    std::int32_t length = collator.getSortKey(text, bytes, static_cast<std::int32_t>(key.size()));
    if (length > static_cast<std::int32_t>(key.size())) {
        key.resize(static_cast<std::size_t>(length));
        bytes = reinterpret_cast<std::uint8_t*>(key.data());
        length = collator.getSortKey(text, bytes, length);
    }
    key.resize(static_cast<std::size_t>(length > 0 ? length - 1 : 0));  // ICU ends a key with a zero byte
    return key;
}

}  // namespace

NameOrder nameOrder(const std::string& locale) {
    const std::shared_ptr<const icu::Collator> collator = collatorOf(locale);
    if (!collator) return [](std::string_view name) { return std::string(name); };
    return [collator](std::string_view name) { return sortKey(*collator, name); };
}

}  // namespace wp::host::icu_functions
