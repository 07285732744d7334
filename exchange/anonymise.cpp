#include "exchange/anonymise.h"

#include <algorithm>
#include <array>

#include "exchange/anonymous_addresses.h"
#include "exchange/anonymous_names.h"
#include "platform/records.h"

namespace wp {
namespace {

/// Info keys whose values say nothing about whose network it is.
constexpr std::array<std::string_view, 6> kKeptKeys{"AdoptedCountryCode", "IPv4ConfigMethod",
                                                    "IPv6ConfigMethod",   "MarlixModelName",
                                                    "Security",           "SupportedPHYModes"};
/// Info keys whose texts are network names, also of networks that nothing else mentions.
constexpr std::array<std::string_view, 4> kNameKeys{"NetworkName", "SSID", "networkName", "ssid"};
constexpr std::string_view kDetails = "Details", kDetailName = "ssid", kDetailPage = "url",
                           kDetailWhy = "why";

template <std::size_t count>
bool contains(const std::array<std::string_view, count>& keys, std::string_view key) {
    return std::find(keys.begin(), keys.end(), key) != keys.end();
}

/// A portal's page tells whose network it is and, behind its host, which device asks: the scheme alone stays. (Of a
/// page without one, what stands before "://" may be all of that.)
std::string hiddenPage(const std::string& url) {
    const char* const scheme = url.starts_with("https://")  ? "https://"
                               : url.starts_with("http://") ? "http://"
                                                            : "";
    return scheme + std::string("portal.example/");
}

/// Calls `visit(key, value)` for every entry of the value's dictionaries, at any depth.
template <class Visit>
void forEachEntry(const Value& value, const Visit& visit) {
    if (const auto* array = value.as<ArrayPointer>(); array && *array) {
        for (const Value& element : **array) forEachEntry(element, visit);
    } else if (const auto* dictionary = value.as<DictionaryPointer>(); dictionary && *dictionary) {
        for (const auto& [key, entry] : (*dictionary)->entries()) {
            visit(key, entry);
            forEachEntry(entry, visit);
        }
    }
}

/// Every network name that the recording mentions.
class NameCollector {
  public:
    std::set<std::string> collect(const Recording& recording) {
        for (const DiagnosticsStatusResponse& status : recording.status)
            if (status.status) add(status.status->ssid);
        for (const RecordedAnswer& answer : recording.answers) {
            add(answer.networkName);
            if (!answer.response.results) continue;
            for (const DiagnosticsTestResultPointer& result : *answer.response.results)
                if (result && result->info) addFrom(result->info);
        }
        return std::move(names_);
    }

  private:
    void add(const std::optional<std::string>& name) {
        if (name) names_.insert(*name);
    }
    void addFromRecord(const Value& value) {
        if (auto preferred = value.asRecord<PreferredNetworkRecord>()) add(preferred->ssid);
        if (auto heard = value.asRecord<WiFiScanResult>()) add(heard->ssid);
    }
    void addFrom(const DictionaryPointer& info) {
        forEachEntry(info, [this](const std::string& key, const Value& value) {
            addFromRecord(value);
            if (const auto* array = value.as<ArrayPointer>(); array && *array)
                for (const Value& element : **array) addFromRecord(element);
            if (const auto* text = value.as<std::string>(); text && contains(kNameKeys, key)) add(*text);
        });
    }

    std::set<std::string> names_;
};

class Anonymiser {
  public:
    explicit Anonymiser(const std::set<std::string>& names) : names_(names) {}

    void replaceIn(Recording& recording) {
        recording.description = sentence(recording.description);
        for (std::string& device : recording.wifi.devices) device = addresses_.replacedWithin(device);
        for (DiagnosticsStatusResponse& status : recording.status) {
            if (status.status) status.status = std::make_shared<const WiFiStatus>(record(*status.status));
            replaceIn(status.error);
        }
        for (RecordedAnswer& answer : recording.answers) {
            if (answer.networkName) answer.networkName = names_.replaced(*answer.networkName);
            replaceIn(answer.response.error);
            if (!answer.response.results) continue;
            for (DiagnosticsTestResultPointer& result : *answer.response.results) replaceIn(result);
        }
    }

  private:
    std::string sentence(const std::string& text) {
        return addresses_.replacedWithin(names_.replacedWithin(text));
    }

    void replaceIn(std::optional<Error>& error) {
        if (error) error->message = sentence(error->message);
    }

    void replaceIn(DiagnosticsTestResultPointer& result) {
        if (!result || !result->info) return;
        Dictionary::Entries entries = result->info->entries();
        for (auto& [key, value] : entries) {
            if (key == kDetails) {
                value = replacedInDetails(key, value);
            } else if (!contains(kKeptKeys, key)) {
                value = replaced(value);
            }
        }
        result = std::make_shared<const DiagnosticsTestResult>(
            DiagnosticsTestResult{result->result, result->didPass, Dictionary::make(std::move(entries))});
    }

    Value replaced(const Value& value) {
        if (const auto* text = value.as<std::string>()) {
            std::string name = names_.replaced(*text);
            return name == *text ? sentence(name) : name;
        }
        if (const auto* array = value.as<ArrayPointer>(); array && *array) {
            Array elements;
            for (const Value& element : **array) elements.push_back(replaced(element));
            return elements;
        }
        if (const auto* dictionary = value.as<DictionaryPointer>(); dictionary && *dictionary) {
            Dictionary::Entries entries;
            for (const auto& [key, entry] : (*dictionary)->entries())
                entries.emplace(addresses_.replacedWithin(names_.replaced(key)), replaced(entry));
            return Dictionary::make(std::move(entries));
        }
        return replacedRecord(value);
    }

    /// Details hold names under one key alone, and the words of others under another; any other text may equal a name
    /// by chance and is a word of its own.
    Value replacedInDetails(std::string_view key, const Value& value) {
        if (const auto* text = value.as<std::string>()) {
            if (key == kDetailName) return names_.replaced(*text);
            if (key == kDetailWhy) return sentence(*text);
            return key == kDetailPage ? hiddenPage(*text) : addresses_.replacedWithin(*text);
        }
        if (const auto* array = value.as<ArrayPointer>(); array && *array) {
            Array elements;
            for (const Value& element : **array) elements.push_back(replacedInDetails(key, element));
            return elements;
        }
        if (const auto* dictionary = value.as<DictionaryPointer>(); dictionary && *dictionary) {
            Dictionary::Entries entries;
            for (const auto& [inner, entry] : (*dictionary)->entries())
                entries.emplace(inner, replacedInDetails(inner, entry));
            return Dictionary::make(std::move(entries));
        }
        return value;
    }

    Value replacedRecord(const Value& value) {
        if (auto heard = value.asRecord<WiFiScanResult>())
            return std::make_shared<const WiFiScanResult>(record(*heard));
        if (auto preferred = value.asRecord<PreferredNetworkRecord>()) {
            auto copy = std::make_shared<PreferredNetworkRecord>(*preferred);
            if (copy->ssid) copy->ssid = names_.replaced(*copy->ssid);
            return copy;
        }
        if (auto pinged = value.asRecord<PingStatistics>()) {
            auto copy = std::make_shared<PingStatistics>(*pinged);
            if (copy->interfaceName) copy->interfaceName = addresses_.replacedWithin(*copy->interfaceName);
            return copy;
        }
        return value;
    }

    /// A scan entry or a status.
    template <class Named>
    Named record(Named copy) {
        if (copy.ssid) copy.ssid = names_.replaced(*copy.ssid);
        if (copy.bssid) copy.bssid = addresses_.hardwareAddress(*copy.bssid);
        return copy;
    }

    AnonymousNames names_;
    AnonymousAddresses addresses_;
};

}  // namespace

Recording anonymised(const Recording& recording, const std::set<std::string>& otherNames) {
    std::set<std::string> names = networkNamesIn(recording);
    names.insert(otherNames.begin(), otherNames.end());
    Recording copy = recording;
    Anonymiser(names).replaceIn(copy);
    return copy;
}

std::set<std::string> networkNamesIn(const Recording& recording) {
    return NameCollector().collect(recording);
}

}  // namespace wp
