#include "linux/files/proxy_settings.h"

#include <cstdint>
#include <optional>
#include <string_view>

#include "linux/files/key_value_file.h"
#include "linux/files/user_folder.h"
#include "service/bytes.h"

namespace wp {
namespace {

constexpr std::size_t kLongestDatabase = 8U << 20;
constexpr const char* kVariables[] = {"http_proxy", "https_proxy", "all_proxy",
                                      "HTTP_PROXY", "HTTPS_PROXY", "ALL_PROXY"};
constexpr std::string_view kProxyMode = "/org/gnome/system/proxy/mode";

/// A reader of the hash table in which the desktop keeps its settings: a header, a table of contents whose keys
/// are chained to their parents, and values at offsets into the file. All numbers have the lower byte first.
class SettingsDatabase {
  public:
    explicit SettingsDatabase(std::string_view bytes)
        : bytes_(reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()) {}

    std::optional<std::string> text(std::string_view wanted) const {
        constexpr std::string_view kSignature = "GVariant";
        if (!between(0, 24) || view(0, 8) != kSignature) return std::nullopt;
        const std::size_t start = number(16), end = number(20);
        if (end < start + 8 || !between(start, end)) return std::nullopt;
        const std::size_t filters = number(start) & 0x07FF'FFFFU, buckets = number(start + 4);
        const std::size_t first = start + 8 + 4 * filters + 4 * buckets;
        if (first > end) return std::nullopt;
        const std::size_t count = (end - first) / kItem;
        for (std::size_t i = 0; i < count; ++i)
            if (bytes_[first + i * kItem + 14] == 'v' && keyOf(first, count, i) == wanted)
                return textAt(first + i * kItem);
        return std::nullopt;
    }

  private:
    static constexpr std::size_t kItem = 24, kDeepest = 32;

    bool between(std::size_t start, std::size_t end) const { return start <= end && end <= bytes_.size(); }
    std::size_t number(std::size_t at) const {
        return littleEndian16(bytes_, at) | std::size_t{littleEndian16(bytes_, at + 2)} << 16;
    }
    std::string_view view(std::size_t start, std::size_t end) const {
        return {reinterpret_cast<const char*>(bytes_.data()) + start, end - start};
    }

    /// An item's key with those of its parents before it.
    std::string keyOf(std::size_t first, std::size_t count, std::size_t index) const {
        std::string key;
        for (std::size_t depth = 0; depth < kDeepest && index < count; ++depth) {
            const std::size_t item = first + index * kItem;
            const std::size_t start = number(item + 8), size = littleEndian16(bytes_, item + 12);
            if (!between(start, start + size)) return {};
            key.insert(0, view(start, start + size));
            index = number(item + 4);
        }
        return key;
    }

    /// A value that is a text: its bytes, a zero, then a zero and the letter of its type.
    std::optional<std::string> textAt(std::size_t item) const {
        const std::size_t start = number(item + 16), end = number(item + 20);
        if (!between(start, end) || end - start < 3) return std::nullopt;
        const std::string_view value = view(start, end);
        if (!value.ends_with(std::string_view("\0\0s", 3))) return std::nullopt;
        return std::string(value.substr(0, value.size() - 3));
    }

    Bytes bytes_;
};

}  // namespace

std::vector<std::string> proxyVariables(const std::map<std::string, std::string>& environment,
                                        const std::string& where) {
    std::vector<std::string> places;
    for (const char* name : kVariables) {
        const auto found = environment.find(name);
        if (found != environment.end() && !found->second.empty()) places.push_back(where + ": " + name);
    }
    return places;
}

std::string proxyModeInSettingsDatabase(const std::string& bytes) {
    return SettingsDatabase(bytes).text(kProxyMode).value_or("");
}

std::vector<std::string> findProxies(const std::function<const char*(const char*)>& variable,
                                     const std::string& root) {
    std::map<std::string, std::string> environment;
    for (const char* name : kVariables)
        if (const char* value = variable(name)) environment[name] = value;
    auto places = proxyVariables(environment, "environment");
    if (const auto text = readSmallFile(root + "/etc/environment")) {
        const auto more = proxyVariables(readAssignments(*text), "/etc/environment");
        places.insert(places.end(), more.begin(), more.end());
    }
    const std::string folder = userConfigFolder(variable);
    const auto database =
        folder.empty() ? std::nullopt : readSmallFile(root + folder + "/dconf/user", kLongestDatabase);
    const std::string mode = database ? proxyModeInSettingsDatabase(*database) : "";
    if (mode == "manual" || mode == "auto") places.push_back("desktop settings: " + mode);
    return places;
}

}  // namespace wp
