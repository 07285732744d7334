#include "linux/config.h"

#include <fcntl.h>

#include <cerrno>
#include <charconv>
#include <cstring>

#include "exchange/descriptor.h"
#include "exchange/object_reader.h"
#include "linux/files/key_value_file.h"
#include "platform/json_writer.h"
#include "service/ip_address.h"

namespace wp {
namespace {

constexpr std::size_t kLongestFile = 1U << 20, kLongestText = 512, kMostEntries = 256;

/// The first eleven are those that a desktop's connection manager never takes for one network in two places; the others
/// are makers' and words that say nothing.
// clang-format off
constexpr const char* kCommonNames[] = {
    "linksys", "linksys-a", "linksys-g", "default", "belkin54g", "netgear", "o2dsl", "wlan", "alice-wlan",
    "speedport w 501v", "turbonett", "dlink", "d-link", "tp-link", "asus", "home", "wifi", "wi-fi", "wireless",
    "guest", "internet", "router", "network", "setup",
};
// clang-format on

struct EndpointKey {
    const char* key;
    std::string Endpoints::*place;
    enum class Form { text, address4, address6, name, plainUrl, secureUrl, hostAndPort } form;
};

using Form = EndpointKey::Form;

// clang-format off
constexpr EndpointKey kEndpointKeys[] = {
    {"certificateAuthorities", &Endpoints::certificateAuthorities, Form::text},
    {"name",                   &Endpoints::name,                   Form::name},
    {"nameWildcard",           &Endpoints::nameWildcard,           Form::name},
    {"pingIPv4",               &Endpoints::pingIPv4,               Form::address4},
    {"pingIPv6",               &Endpoints::pingIPv6,               Form::address6},
    {"portalPlain",            &Endpoints::portalPlain,            Form::plainUrl},
    {"portalSecure",           &Endpoints::portalSecure,           Form::secureUrl},
    {"stun",                   &Endpoints::stun,                   Form::hostAndPort},
    {"vendorBodyPrefix",       &Endpoints::vendorBodyPrefix,       Form::text},
    {"vendorHost",             &Endpoints::vendorHost,             Form::hostAndPort},
    {"vendorUrl",              &Endpoints::vendorUrl,              Form::secureUrl},
};
// clang-format on

bool isName(std::string_view text) {
    return text.size() <= 253 && text.find_first_not_of(
                                     "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ"
                                     "0123456789-._") == text.npos;
}

/// What a text of the form must be; null where it is.
const char* faultOf(Form form, const std::string& text) {
    const auto address = IPAddress::fromText(text);
    switch (form) {
        case Form::text:
            return nullptr;
        case Form::address4:
            return address && address->isIPv4() ? nullptr : "must be an IPv4 address";
        case Form::address6:
            return address && !address->isIPv4() ? nullptr : "must be an IPv6 address";
        case Form::name:
            return isName(text) ? nullptr : "must be a host's name";
        case Form::plainUrl:
            return text.starts_with("http://") ? nullptr : "must begin with http://";
        case Form::secureUrl:
            return text.starts_with("https://") ? nullptr : "must begin with https://";
        case Form::hostAndPort:
            return hostAndPort(text) ? nullptr : "must be HOST:PORT";
    }
    return nullptr;
}

std::string readBoundedText(const Value& json, const Place& place) {
    std::string text = readText(json, place);
    if (text.size() > kLongestText) place.refuse("must have at most 512 bytes");
    return text;
}

void readEndpoints(const Value& json, const Place& place, Endpoints& endpoints) {
    ObjectReader reader(json, place);
    for (const EndpointKey& each : kEndpointKeys) {
        const Value* value = reader.find(each.key);
        if (value == nullptr) continue;
        const Place here(place, each.key);
        std::string text = readBoundedText(*value, here);
        const char* fault = text.empty() ? nullptr : faultOf(each.form, text);
        if (fault != nullptr) here.refuse(fault);
        endpoints.*each.place = std::move(text);
    }
    reader.finish();
}

void readCount(ObjectReader& reader, const char* key, unsigned& into) {
    if (const Value* value = reader.find(key))
        into = static_cast<unsigned>(readInteger(*value, Place(reader.place(), key), 0, 100'000));
}

void readShare(ObjectReader& reader, const char* key, double& into, double most) {
    const Value* value = reader.find(key);
    if (value == nullptr) return;
    const Place here(reader.place(), key);
    into = readNumber(*value, here);
    if (!(into > 0 && into <= most)) here.refuse("must be above 0 and at most " + std::to_string(most));
}

void readThresholds(const Value& json, const Place& place, Thresholds& thresholds) {
    ObjectReader reader(json, place);
    readCount(reader, "connectedBluetooth", thresholds.bluetooth.connected);
    readCount(reader, "pairedBluetooth", thresholds.bluetooth.paired);
    readCount(reader, "savedNetworks", thresholds.saved.count);
    readCount(reader, "advertisedLoad", thresholds.congestion.advertisedLoad);
    readShare(reader, "channelLoad", thresholds.congestion.load, 1.0);
    readShare(reader, "overlap", thresholds.congestion.overlap, 1000.0);
    reader.finish();
}

/// "00:1A:2B", of at least `least` and at most `most` bytes.
std::vector<std::uint8_t> readOctets(const Value& json, const Place& place, std::size_t least,
                                     std::size_t most) {
    const std::string text = readText(json, place);
    std::vector<std::uint8_t> octets;
    for (std::size_t at = 0; at < text.size(); at += 3) {
        unsigned octet = 0;
        const char* start = text.data() + at;
        const bool whole = at + 2 <= text.size() && (at + 2 == text.size() || text[at + 2] == ':');
        const auto [end, failed] = std::from_chars(start, whole ? start + 2 : start, octet, 16);
        if (failed != std::errc() || end != start + 2) place.refuse("must be octets such as 02:00:5E");
        octets.push_back(static_cast<std::uint8_t>(octet));
    }
    if (octets.size() < least || octets.size() > most || text.ends_with(":"))
        place.refuse("must be octets such as 02:00:5E");
    return octets;
}

VendorPrefix readPrefix(const Value& json, const Place& place) {
    const auto octets = readOctets(json, place, 3, 3);
    return {octets[0], octets[1], octets[2]};
}

/// Replaces the list by what the array under the key holds, each read by `readOne`.
template <class T, class ReadOne>
void readList(ObjectReader& reader, const char* key, std::vector<T>& into, ReadOne readOne) {
    const Value* value = reader.find(key);
    if (value == nullptr) return;
    const Place here(reader.place(), key);
    const ArrayPointer array = readArray(*value, here);
    if (array->size() > kMostEntries) here.refuse("must have at most 256 entries");
    into.clear();
    for (std::size_t i = 0; i < array->size(); ++i) into.push_back(readOne((*array)[i], Place(here, i)));
}

Vendors::Hotspot::VendorElement readVendorElement(const Value& json, const Place& place) {
    ObjectReader reader(json, place);
    Vendors::Hotspot::VendorElement element;
    element.prefix = readPrefix(reader.need("prefix"), Place(place, "prefix"));
    if (const Value* type = reader.find("type"))
        element.type = static_cast<std::uint8_t>(readInteger(*type, Place(place, "type"), 0, 255));
    reader.finish();
    return element;
}

void readBaseStation(const Value& json, const Place& place, Vendors::BaseStation& vendor) {
    ObjectReader reader(json, place);
    readList(reader, "manufacturers", vendor.manufacturers, readBoundedText);
    readList(reader, "addressPrefixes", vendor.prefixes, readPrefix);
    reader.finish();
}

void readHotspot(const Value& json, const Place& place, Vendors::Hotspot& vendor) {
    ObjectReader reader(json, place);
    readList(reader, "vendorElements", vendor.elements, readVendorElement);
    readList(reader, "addressPrefixes", vendor.addressPrefixes,
             [](const Value& each, const Place& here) { return readOctets(each, here, 1, 6); });
    readList(reader, "leaseTexts", vendor.leaseTexts, readBoundedText);
    reader.finish();
}

NetworkName readName(const Value& json, const Place& place) {
    const std::optional<NetworkName> name = nameFromText(readText(json, place));
    if (!name || name->absent()) place.refuse("must be a network's name of 1 to 32 bytes");
    return *name;
}

void readVendors(const Value& json, const Place& place, Config& config) {
    ObjectReader reader(json, place);
    if (const Value* value = reader.find("baseStation"))
        readBaseStation(*value, Place(place, "baseStation"), config.vendors.baseStation);
    if (const Value* value = reader.find("hotspot"))
        readHotspot(*value, Place(place, "hotspot"), config.vendors.hotspot);
    readList(reader, "commonNames", config.vendors.commonNames, readName);
    if (const Value* value = reader.find("peerLinkIndicator"))
        config.peerLinkIndicator = readBoundedText(*value, Place(place, "peerLinkIndicator"));
    reader.finish();
}

void readTop(const Value& json, Config& config) {
    const Place top;
    ObjectReader reader(json, top);
    if (const Value* value = reader.find("endpoints"))
        readEndpoints(*value, Place(top, "endpoints"), config.endpoints);
    if (const Value* value = reader.find("thresholds"))
        readThresholds(*value, Place(top, "thresholds"), config.thresholds);
    if (const Value* value = reader.find("vendors")) readVendors(*value, Place(top, "vendors"), config);
    if (const Value* value = reader.find("capabilities"))
        for (const auto& [name, isThere] : readFlags(*value, Place(top, "capabilities")))
            config.capabilities[name] = isThere;
    reader.finish();
}

/// Why a file is not taken, in the system's words where it was not opened; empty for one that need not be there and is
/// not.
std::string faultOf(const std::string& file, bool needed) {
    const Descriptor opened(::open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (opened) return "is no regular file of at most 1 MiB";
    const int error = errno;
    if (!needed && (error == ENOENT || error == ENOTDIR)) return {};
    return std::string("cannot be read: ") + std::strerror(error);
}

}  // namespace

Config Config::defaults() {
    Config config;
    // The block of addresses that is set aside for examples in documents (RFC 7042).
    const VendorPrefix example = {0x00, 0x00, 0x5E};
    config.vendors.baseStation = {{"Example Networks"}, {}};
    // No text of leases: with one set, a network without a lease cannot be told from a hotspot.
    config.vendors.hotspot = {{{example, std::uint8_t{0x53}}}, {{0x00, 0x00, 0x5E, 0x00, 0x53}}, {}};
    for (const char* name : kCommonNames) config.vendors.commonNames.push_back(*nameFromText(name));
    return config;
}

std::optional<Refusal> applyConfig(std::string_view json, Config& config) {
    const auto read = readJSON(json, {.bytes = kLongestFile, .depth = 16});
    if (const Refusal* refusal = std::get_if<Refusal>(&read)) return *refusal;
    try {
        Config changed = config;
        readTop(std::get<Value>(read), changed);
        config = std::move(changed);
        return std::nullopt;
    } catch (const Refused& refused) {
        return refused.refusal();
    }
}

std::vector<std::string> configFiles(const std::string& home, const std::string& root) {
    std::vector<std::string> files = {root + "/etc/wifi-profile/vendors.json",
                                      root + "/etc/wifi-profile/config.json"};
    if (!home.empty()) files.push_back(home + "/wifi-profile/config.json");
    return files;
}

std::variant<Config, std::string> loadConfig(const std::vector<std::string>& files,
                                             const std::string& named) {
    Config config = Config::defaults();
    std::vector<std::string> all = files;
    if (!named.empty()) all.push_back(named);
    for (const std::string& file : all) {
        const bool isNamed = &file == &all.back() && !named.empty();
        const auto text = readSmallFile(file, kLongestFile);
        const std::string fault = text ? "" : faultOf(file, isNamed);
        if (!fault.empty()) return file + ": " + fault;
        const auto refusal = text ? applyConfig(*text, config) : std::nullopt;
        if (refusal) return file + ": " + refusal->text();
    }
    return config;
}

DictionaryPointer toldOf(const Config& config) {
    const DictionaryPointer endpoints = Dictionary::make();
    for (const EndpointKey& each : kEndpointKeys) endpoints->setValue(each.key, config.endpoints.*each.place);
    const DictionaryPointer capabilities =
        Dictionary::make({config.capabilities.begin(), config.capabilities.end()});
    const auto& [bluetooth, saved, congestion] = config.thresholds;
    const DictionaryPointer thresholds = Dictionary::make({{"connectedBluetooth", bluetooth.connected},
                                                           {"pairedBluetooth", bluetooth.paired},
                                                           {"savedNetworks", saved.count},
                                                           {"advertisedLoad", congestion.advertisedLoad},
                                                           {"channelLoad", congestion.load},
                                                           {"overlap", congestion.overlap}});
    return Dictionary::make(
        {{"capabilities", capabilities}, {"endpoints", endpoints}, {"thresholds", thresholds}});
}

std::optional<HostAndPort> hostAndPort(std::string_view text) {
    const std::size_t colon = text.rfind(':');
    if (colon == text.npos) return std::nullopt;
    HostAndPort result{std::string(text.substr(0, colon)), 0};
    const std::string_view port = text.substr(colon + 1);
    const auto [end, failed] = std::from_chars(port.data(), port.data() + port.size(), result.port);
    if (failed != std::errc() || end != port.data() + port.size() || result.port == 0) return std::nullopt;
    const bool bracketed = result.host.starts_with("[") && result.host.ends_with("]");
    if (bracketed) {
        result.host = result.host.substr(1, result.host.size() - 2);
        if (!IPAddress::fromText(result.host)) return std::nullopt;
    }
    if (result.host.empty() || (!bracketed && !isName(result.host))) return std::nullopt;
    return result;
}

}  // namespace wp
