#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace wp {

/// A value that came over the message bus, with variants unwrapped. Numbers are as wide as they get; paths
/// and signatures are texts; a dictionary with keys that are no texts has them in decimal.
class BusValue {
  public:
    using Bytes = std::vector<std::uint8_t>;
    using List = std::vector<BusValue>;
    using Map = std::map<std::string, BusValue, std::less<>>;
    using Storage = std::variant<std::monostate, bool, std::int64_t, std::uint64_t, double, std::string,
                                 Bytes, List, Map>;

    BusValue() = default;
    template <class T>
    explicit BusValue(T content) : content_(std::move(content)) {}

    /// The content as one of the storage's kinds; null where it is of another.
    template <class T>
    const T* as() const {
        return std::get_if<T>(&content_);
    }

    /// What a dictionary holds under the key, or under key after key; an empty value where there is none.
    const BusValue& operator[](std::string_view key) const;
    /// The elements of a list; none where this is no list.
    const List& list() const;
    /// The entries of a dictionary; none where this is no dictionary.
    const Map& map() const;
    /// The bytes; none where this is not bytes.
    const Bytes& bytes() const;

    bool flag(bool otherwise = false) const;
    std::string text(std::string_view otherwise = {}) const;
    /// Whole numbers of either sign, as far as they fit.
    std::optional<std::int64_t> number() const;
    bool empty() const { return content_.index() == 0; }

  private:
    Storage content_;
};

}  // namespace wp
