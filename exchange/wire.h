#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "exchange/codec.h"
#include "exchange/json_reader.h"

namespace wp {

// The wire between the host and the service that it started: one JSON object a line, both ways, in UTF-8. The
// service inherits its end of the socket pair as file descriptor `kWireDescriptor`, and speaks first: a greeting.
// Every request but the cancelling carries a number of its own, and its answer carries the same; answers come in any
// order. Every `…Line` function gives the whole line with its newline; every `read…` takes one line without it. *Any*
// thread.

constexpr int kWireDescriptor = 3;
/// The longest line that either side accepts, in bytes.
constexpr std::size_t kLongestLine = std::size_t{16} << 20;
/// The code of the error with which a cancelled request is answered.
constexpr int kCancelledCode = 8;

/// The error of every request that was cancelled: "cancelled (code 8)".
Error cancelledError();

/// `{"configuration": {…}}`, what the service tells of the configuration that it works with, or
/// `{"refused": "text"}`, what is wrong with it and where; then the service ends.
struct Greeting {
    DictionaryPointer configuration;  ///< null: refused
    std::string refused;
};

std::string greetingLine(const Greeting& greeting);
std::variant<Greeting, Refusal> readGreeting(std::string_view line);

/// `{"id": N, "request": "test", "test": 34, "configuration": {…}}`, "status", "wifi",
/// `{"id": N, "request": "setPower", "power": true}`, and `{"request": "cancel"}`, upon which every
/// outstanding request is answered with `cancelledError`.
struct WireRequest {
    enum class Kind { test, status, wifi, setPower, cancel };

    Kind kind = Kind::cancel;
    std::uint64_t id = 0;             ///< not for `cancel`
    int test = 0;                     ///< `test` alone
    DictionaryPointer configuration;  ///< `test` alone; null when absent
    bool power = false;               ///< `setPower` alone
};

std::string requestLine(const WireRequest& request);
std::variant<WireRequest, Refusal> readRequest(std::string_view line);

/// `{"id": N, "wifi": {…}}`, or an error in place of the description.
struct WiFiResponse {
    std::optional<WiFiDescription> wifi;
    std::optional<Error> error;
};

/// `{"id": N}` and the keys of the recording's answer.
std::string testAnswerLine(std::uint64_t id, const DiagnosticsTestResponse& response);
/// `{"id": N, "status": {…}}`.
std::string statusAnswerLine(std::uint64_t id, const DiagnosticsStatusResponse& response);
std::string wifiAnswerLine(std::uint64_t id, const WiFiResponse& response);
/// `{"id": N}`, or with "error" what kept the power from being set.
std::string setPowerAnswerLine(std::uint64_t id, const std::optional<Error>& error);
/// `{"event": {"power": false}}`: the power changed.
std::string powerEventLine(bool power);
/// `{"note": "text"}`: something that a person should know, such as what a missing permission costs.
std::string noteLine(std::string_view text);

/// An answer; what it holds is read by the function for the kind of request that has this number.
struct WireAnswer {
    std::uint64_t id = 0;
    Value json;
};
struct PowerEvent {
    bool power = false;
};
struct Note {
    std::string text;
};
using WireMessage = std::variant<WireAnswer, PowerEvent, Note, Refusal>;

WireMessage readMessage(std::string_view line);

/// These throw `Refused`.
DiagnosticsTestResponse testAnswer(const WireAnswer& answer);
DiagnosticsStatusResponse statusAnswer(const WireAnswer& answer);
WiFiResponse wifiAnswer(const WireAnswer& answer);
std::optional<Error> setPowerAnswer(const WireAnswer& answer);

}  // namespace wp
