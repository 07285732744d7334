#include "exchange/record_forms.h"

#include <limits>

#include "exchange/date_text.h"
#include "exchange/object_reader.h"

namespace wp {
namespace {

using Entries = Dictionary::Entries;

void put(Entries& entries, const char* key, const std::optional<std::string>& text) {
    if (text) entries.emplace(key, *text);
}

Value encode(const PreferredNetworkRecord& record) {
    Entries entries{{"security", record.security}, {"passpoint", record.passpoint},
                    {"enabled", record.enabled},   {"captive", record.captive},
                    {"hidden", record.hidden},     {"multiAP", record.multiAP}};
    put(entries, "ssid", record.ssid);
    if (record.lastJoined) entries.emplace("lastJoined", exactISO8601Text(*record.lastJoined));
    return Dictionary::make(std::move(entries));
}

Value encode(const PingStatistics& record) {
    Entries entries{{"count", record.count},
                    {"packetLoss", record.packetLoss},
                    {"min", record.min},
                    {"max", record.max},
                    {"avg", record.avg},
                    {"stddev", record.stddev},
                    {"timestamp", record.timestamp}};
    put(entries, "interface", record.interfaceName);
    return Dictionary::make(std::move(entries));
}

Value encode(const WiFiScanResult& record) {
    Entries entries{{"rssi", record.rssi}};
    put(entries, "ssid", record.ssid);
    put(entries, "bssid", record.bssid);
    return Dictionary::make(std::move(entries));
}

Value encode(const WiFiStatus& record) {
    Entries entries;
    put(entries, "ssid", record.ssid);
    put(entries, "bssid", record.bssid);
    return Dictionary::make(std::move(entries));
}

/// The fields of a record, each optional.
class Fields {
  public:
    Fields(const Value& json, const Place& place) : reader_(json, place) {}

    std::optional<std::string> text(std::string_view key) {
        const Value* value = reader_.findNonNull(key);
        if (!value) return std::nullopt;
        return readText(*value, at(key));
    }
    std::int64_t integer(std::string_view key) {
        using Limits = std::numeric_limits<std::int64_t>;
        const Value* value = reader_.findNonNull(key);
        return value ? readInteger(*value, at(key), Limits::min(), Limits::max()) : 0;
    }
    bool flag(std::string_view key) {
        const Value* value = reader_.findNonNull(key);
        return value && readFlag(*value, at(key));
    }
    double number(std::string_view key, double otherwise) {
        const Value* value = reader_.findNonNull(key);
        return value ? readNumber(*value, at(key)) : otherwise;
    }
    std::optional<Date> date(std::string_view key) {
        std::optional<std::string> written = text(key);
        if (!written) return std::nullopt;
        if (std::optional<Date> date = readISO8601(*written)) return date;
        at(key).refuse("must be an ISO 8601 time with its zone, such as 2024-05-01T12:00:00Z");
    }
    void finish() const { reader_.finish(); }

  private:
    Place at(std::string_view key) const { return Place(reader_.place(), key); }

    ObjectReader reader_;
};

Value decodePreferredNetwork(const Value& json, const Place& place) {
    Fields fields(json, place);
    auto record = std::make_shared<PreferredNetworkRecord>();
    record->ssid = fields.text("ssid");
    record->security = fields.integer("security");
    record->passpoint = fields.flag("passpoint");
    record->enabled = fields.flag("enabled");
    record->captive = fields.flag("captive");
    record->hidden = fields.flag("hidden");
    record->multiAP = fields.flag("multiAP");
    record->lastJoined = fields.date("lastJoined");
    fields.finish();
    return record;
}

Value decodePing(const Value& json, const Place& place) {
    Fields fields(json, place);
    auto record = std::make_shared<PingStatistics>();
    record->interfaceName = fields.text("interface");
    record->count = fields.integer("count");
    record->packetLoss = fields.number("packetLoss", PingStatistics::unknown);
    record->min = fields.number("min", PingStatistics::unknown);
    record->max = fields.number("max", PingStatistics::unknown);
    record->avg = fields.number("avg", PingStatistics::unknown);
    record->stddev = fields.number("stddev", PingStatistics::unknown);
    record->timestamp = fields.number("timestamp", 0);
    fields.finish();
    return record;
}

Value decodeChannel(const Value& json, const Place& place) {
    Fields fields(json, place);
    auto record = std::make_shared<WiFiChannel>(fields.integer("channel"));
    fields.finish();
    return record;
}

Value decodeScanResult(const Value& json, const Place& place) {
    Fields fields(json, place);
    auto record = std::make_shared<WiFiScanResult>();
    record->ssid = fields.text("ssid");
    record->bssid = fields.text("bssid");
    record->rssi = fields.integer("rssi");
    fields.finish();
    return record;
}

Value decodeScanResults(const Value& json, const Place& place) {
    Array records;
    ArrayPointer entries = readArray(json, place);
    records.reserve(entries->size());
    for (std::size_t i = 0; i < entries->size(); ++i)
        records.push_back(decodeScanResult((*entries)[i], Place(place, i)));
    return records;
}

using Decode = Value (*)(const Value&, const Place&);
struct RecordKey {
    std::string_view key;
    Decode decode;
};
// clang-format off
constexpr RecordKey kRecordKeys[] = {
    {"PreferredNetwork",  decodePreferredNetwork},
    {"PingResult",        decodePing},
    {"CurrentChannel",    decodeChannel},
    {"2GHzChannel",       decodeChannel},
    {"5GHzChannel",       decodeChannel},
    {"5GHz40MHzChannel",  decodeChannel},
    {"5GHzNonDFSChannel", decodeChannel},
    {"ScanResults",       decodeScanResults},
};
// clang-format on

const RecordKey* findKey(std::string_view infoKey) {
    for (const RecordKey& row : kRecordKeys)
        if (row.key == infoKey) return &row;
    return nullptr;
}

}  // namespace

Value encodeRecord(const Record& record) {
    if (const auto* preferred = dynamic_cast<const PreferredNetworkRecord*>(&record))
        return encode(*preferred);
    if (const auto* ping = dynamic_cast<const PingStatistics*>(&record)) return encode(*ping);
    if (const auto* channel = dynamic_cast<const WiFiChannel*>(&record))
        return Dictionary::make({{"channel", channel->channel}});
    if (const auto* scan = dynamic_cast<const WiFiScanResult*>(&record)) return encode(*scan);
    if (const auto* status = dynamic_cast<const WiFiStatus*>(&record)) return encode(*status);
    return NullMarker{};
}

bool isRecordKey(std::string_view infoKey) {
    return findKey(infoKey) != nullptr;
}

Value decodeRecord(std::string_view infoKey, const Value& json, const Place& place) {
    return findKey(infoKey)->decode(json, place);
}

}  // namespace wp
