#include "lifecycle/network_name.h"

#include <algorithm>
#include <string_view>

const char kNetworkName[] = "networkName";

namespace wp {
namespace {

// The suffix is plain ASCII, and no other character is lower-cased to one of its letters.
char lowerCased(char letter) {
    return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

}  // namespace

bool isNoMapName(const std::optional<std::string>& name) {
    constexpr std::string_view kSuffix = "_nomap";
    if (!name || name->size() < kSuffix.size()) return false;
    return std::equal(kSuffix.rbegin(), kSuffix.rend(), name->rbegin(),
                      [](char wanted, char letter) { return wanted == lowerCased(letter); });
}

}  // namespace wp
