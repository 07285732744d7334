#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "exchange/place.h"
#include "platform/value.h"

namespace wp {

/// The content as a number of the type, or a refusal that says what is wanted.
bool readFlag(const Value& json, const Place& place);
std::int64_t readInteger(const Value& json, const Place& place, std::int64_t least, std::int64_t most);
double readNumber(const Value& json, const Place& place);
std::string readText(const Value& json, const Place& place);
ArrayPointer readArray(const Value& json, const Place& place);
/// An object of flags by name, such as a device's capabilities.
using Flags = std::map<std::string, bool, std::less<>>;
Flags readFlags(const Value& json, const Place& place);

/// Reads one JSON object field by field; what no field asked for is refused in the end. Every function throws
/// `Refused`.
class ObjectReader {
  public:
    /// The place must outlive the reader.
    ObjectReader(const Value& json, const Place& place);

    const Place& place() const { return place_; }

    /// The value under the key, which counts as known from now on; null where it is absent.
    const Value* find(std::string_view key);
    /// The same, but a value that is null counts as absent.
    const Value* findNonNull(std::string_view key);
    /// The same, but a key that is absent is refused.
    const Value& need(std::string_view key);

    /// Refuses a key that nothing asked for.
    void finish() const;

  private:
    const Place& place_;
    Dictionary::Entries entries_;
    std::vector<std::string_view> known_;
};

}  // namespace wp
