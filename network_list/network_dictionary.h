#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/records.h"

namespace wp {

/// Networks by name, compared exactly, in the order in which their names were first stored. *Any* thread, one
/// at a time.
class NetworkDictionary {
  public:
    /// The network under the name; null when there is none, and for an absent name.
    WiFiScanResultPointer network(const std::optional<std::string>& name) const;
    bool contains(const std::string& name) const { return places_.count(name) > 0; }

    /// Stores the network under its name, in the place of one that is there. A network without a name is not
    /// stored.
    void set(WiFiScanResultPointer network);
    /// Removes what stands under the name, if anything does.
    void remove(const std::string& name);

    std::size_t size() const { return places_.size(); }
    std::vector<WiFiScanResultPointer> values() const;

  private:
    std::unordered_map<std::string, std::size_t> places_;
    std::vector<WiFiScanResultPointer> networks_;  ///< null where one was removed
};

}  // namespace wp
