#include "linux/dbus/bus_value.h"

#include <limits>

namespace wp {
namespace {

const BusValue kNone;
const BusValue::List kNoList;
const BusValue::Map kNoMap;
const BusValue::Bytes kNoBytes;

}  // namespace

const BusValue& BusValue::operator[](std::string_view key) const {
    const Map& entries = map();
    const auto found = entries.find(key);
    return found == entries.end() ? kNone : found->second;
}

const BusValue::List& BusValue::list() const {
    const List* elements = as<List>();
    return elements != nullptr ? *elements : kNoList;
}

const BusValue::Map& BusValue::map() const {
    const Map* entries = as<Map>();
    return entries != nullptr ? *entries : kNoMap;
}

const BusValue::Bytes& BusValue::bytes() const {
    const Bytes* content = as<Bytes>();
    return content != nullptr ? *content : kNoBytes;
}

bool BusValue::flag(bool otherwise) const {
    const bool* content = as<bool>();
    return content != nullptr ? *content : otherwise;
}

std::string BusValue::text(std::string_view otherwise) const {
    const std::string* content = as<std::string>();
    return content != nullptr ? *content : std::string(otherwise);
}

std::optional<std::int64_t> BusValue::number() const {
    if (const auto* content = as<std::int64_t>()) return *content;
    const auto* content = as<std::uint64_t>();
    if (content == nullptr || *content > std::uint64_t{std::numeric_limits<std::int64_t>::max()})
        return std::nullopt;
    return static_cast<std::int64_t>(*content);
}

}  // namespace wp
