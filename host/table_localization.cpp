#include "host/table_localization.h"

namespace wp::host {

TableLocalization::TableLocalization(const LocaleChoice& choice)
    : table_(stringTable(choice.stringTable).value_or(StringTable{})), collationLocale_(choice.collation) {}

std::string TableLocalization::localizedString(std::string_view key) const {
    auto found = table_.find(key);
    return found == table_.end() ? "" : found->second;
}

std::string TableLocalization::collationKey(std::string_view name) const {
    std::call_once(orderOnce_, [this] { order_ = nameOrder(collationLocale_); });
    return order_(name);
}

}  // namespace wp::host
