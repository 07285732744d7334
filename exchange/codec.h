#pragma once

#include <string>
#include <vector>

#include "exchange/object_reader.h"
#include "exchange/place.h"
#include "platform/diagnostics.h"
#include "platform/value.h"

namespace wp {

// The one codec of answers: recordings and the wire carry them in the same form. `encode…` gives what
// `jsonText` writes, `decode…` reads what `readJSON` gave and throws `Refused` with the place where it is not
// of the form. All of it: *Any* thread.

/// What is known of a device's Wi-Fi hardware.
struct WiFiDescription {
    enum class SetPower { works, ignored };

    bool radio = true;
    bool client = true;  ///< whether a manager client can be had
    std::vector<std::string> devices = {"wlan0"};
    bool power = true;
    SetPower setPower = SetPower::works;  ///< written only when `ignored`

    friend bool operator==(const WiFiDescription&, const WiFiDescription&) = default;
};

/// An info dictionary of a test result. The keys that hold service records ("PreferredNetwork", "PingResult",
/// the five channel keys, "ScanResults") become objects; a key whose value is null is left out. A record
/// under any other key has an object's form too, a date is its text, but they come back as what JSON has.
Value encodeInfo(const Dictionary& info);
DictionaryPointer decodeInfo(const Value& json, const Place& place);

/// `{"code", "message"}`.
Value encodeError(const Error& error);
Error decodeError(const Value& json, const Place& place);

/// The keys of one test's answer: "result", "didPass" and "info" for exactly one result, otherwise "results",
/// none for results that are absent; "error" where there is one.
void encodeResponse(const DiagnosticsTestResponse& response, Dictionary::Entries& into);
DiagnosticsTestResponse decodeResponse(ObjectReader& reader);

/// The keys of one status: "ssid", "bssid", "error", each absent where it has nothing to say. An error
/// without a name or address beside it comes back without a status.
Value encodeStatus(const DiagnosticsStatusResponse& response);
Value encodeStatus(const DiagnosticsStatusResponse& response);
DiagnosticsStatusResponse decodeStatus(const Value& json, const Place& place);

Value encodeWiFi(const WiFiDescription& wifi);
WiFiDescription decodeWiFi(const Value& json, const Place& place);

}  // namespace wp
