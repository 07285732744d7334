#include "platform/value.h"

#include <type_traits>

namespace wp {

Value::Value(Array elements) : storage_(std::make_shared<const Array>(std::move(elements))) {}

bool operator==(const Value& left, const Value& right) {
    if (left.storage_.index() != right.storage_.index()) return false;
    return std::visit(
        [&right](const auto& content) {
            using Content = std::decay_t<decltype(content)>;
            const Content& other = *right.as<Content>();
            if constexpr (std::is_same_v<Content, ArrayPointer>) {
                return content == other || (content && other && *content == *other);
            } else if constexpr (std::is_same_v<Content, DictionaryPointer>) {
                return content == other || (content && other && content->entries() == other->entries());
            } else {
                return content == other;
            }
        },
        left.storage_);
}

std::optional<Value> Dictionary::value(std::string_view key) const {
    std::lock_guard lock(mutex_);
    auto found = entries_.find(key);
    if (found == entries_.end()) return std::nullopt;
    return found->second;
}

void Dictionary::setValue(std::string_view key, Value value) {
    std::lock_guard lock(mutex_);
    entries_.insert_or_assign(std::string(key), std::move(value));
}

void Dictionary::removeValue(std::string_view key) {
    std::lock_guard lock(mutex_);
    auto found = entries_.find(key);
    if (found != entries_.end()) entries_.erase(found);
}

std::size_t Dictionary::size() const {
    std::lock_guard lock(mutex_);
    return entries_.size();
}

Dictionary::Entries Dictionary::entries() const {
    std::lock_guard lock(mutex_);
    return entries_;
}

}  // namespace wp
