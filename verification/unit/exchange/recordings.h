#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <variant>

#include "exchange/replay.h"

namespace wp {

/// The folder of the tests' recordings.
inline const std::string kFolder = WP_SOURCE_DIR "/verification/unit/exchange/recordings/";

inline Recording accepted(std::variant<Recording, Refusal> outcome) {
    if (auto* refusal = std::get_if<Refusal>(&outcome)) {
        ADD_FAILURE() << refusal->text();
        return {};
    }
    return std::get<Recording>(std::move(outcome));
}

/// What reading a recording with these keys beside format and version gives.
inline std::variant<Recording, Refusal> readStated(const std::string& keys) {
    return readRecording(R"({"format": "wifi-profile-recording", "version": 1, )" + keys + "}");
}

inline RecordingPointer stated(const std::string& keys) {
    return std::make_shared<const Recording>(accepted(readStated(keys)));
}

}  // namespace wp
