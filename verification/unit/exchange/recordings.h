#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <variant>

#include "exchange/replay.h"
#include "verification/unit/places.h"

namespace wp {

/// The folder of the tests' recordings.
inline const std::string kFolder = sourceFolder() + "/verification/unit/exchange/recordings/";

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

/// A request for an answer of this age, in seconds.
inline DictionaryPointer configuration(Value age, std::optional<std::string> name = std::nullopt) {
    DictionaryPointer dictionary = Dictionary::make({{"MaxScanCacheAge", std::move(age)}});
    if (name) dictionary->setValue("NetworkName", *name);
    return dictionary;
}

}  // namespace wp
