#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "exchange/json_reader.h"

namespace wp {

/// Where in a JSON document a value stands, as a chain up to the top; it costs nothing until a refusal spells
/// it out. The parents and keys must outlive it.
class Place {
  public:
    Place() = default;
    Place(const Place& parent, std::string_view key) : parent_(&parent), key_(key) {}
    Place(const Place& parent, std::size_t index) : parent_(&parent), index_(index), isIndex_(true) {}

    /// The path, such as `answers[3].info["odd key"]`; empty at the top.
    std::string text() const;

    /// Throws the refusal of what stands here.
    [[noreturn]] void refuse(std::string reason) const;

  private:
    const Place* parent_ = nullptr;
    std::string_view key_;
    std::size_t index_ = 0;
    bool isIndex_ = false;
};

/// Appends a step into an object to a path: `.name`, or `["odd name"]` where it is no plain word.
void appendKey(std::string& path, std::string_view key);

}  // namespace wp
