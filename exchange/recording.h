#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "exchange/codec.h"
#include "exchange/json_reader.h"
#include "exchange/object_reader.h"

namespace wp {

/// The answer to one test request.
struct RecordedAnswer {
    int test = 0;
    std::optional<std::string> networkName;  ///< answers only requests about this network; absent: about none
    std::optional<Value> maxScanCacheAge;    ///< a number; absent: any age
    DiagnosticsTestResponse response;
    std::chrono::milliseconds delay{0};  ///< how long the answer takes
};

/// A change of Wi-Fi power that comes from outside, counted from the registration of the power callback.
struct RecordedPowerEvent {
    std::chrono::milliseconds after{0};
    bool power = false;
};

/// What the platform and the diagnostics service answered in one run. As it stands here: a radio with one
/// device that is switched on, not connected, no capability, no automation, no answers, no events.
struct Recording {
    std::string description;
    Flags capabilities;
    bool automation = false;
    WiFiDescription wifi;
    std::vector<DiagnosticsStatusResponse> status;  ///< one a query; the last serves all later ones
    std::vector<RecordedAnswer> answers;
    std::vector<RecordedPowerEvent> events;
};

/// The recording that the JSON text holds. A text that breaks a rule of the format anywhere is refused as a
/// whole, with the place and the reason. *Any* thread.
std::variant<Recording, Refusal> readRecording(std::string_view text);

/// The same from a file, `-` being standard input. *Any* thread.
std::variant<Recording, Refusal> loadRecording(const std::string& path);

/// The JSON text from which `readRecording` makes an equal recording; it ends with a newline. *Any* thread.
std::string recordingText(const Recording& recording);

}  // namespace wp
