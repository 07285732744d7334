#include "linux/files/octets.h"

#include <charconv>

namespace wp {
namespace {

bool addOctet(std::string_view digits, std::string& octets) {
    unsigned value = 0;
    const auto [end, failed] = std::from_chars(digits.data(), digits.data() + digits.size(), value, 16);
    if (digits.empty() || digits.size() > 2 || failed != std::errc() || end != digits.data() + digits.size())
        return false;
    octets += static_cast<char>(value);
    return true;
}

}  // namespace

std::optional<std::string> octetsFrom(std::string_view text) {
    std::string octets;
    const bool isParted = text.find(':') != text.npos;
    if (text.empty()) return octets;
    if (!isParted && text.size() % 2 != 0) return std::nullopt;
    while (true) {
        const std::size_t size = isParted ? text.find(':') : 2;
        if (!addOctet(text.substr(0, size), octets)) return std::nullopt;
        if (size >= text.size()) return octets;
        text.remove_prefix(isParted ? size + 1 : size);
    }
}

}  // namespace wp
