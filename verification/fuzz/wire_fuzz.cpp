// Reads any bytes as lines of the wire, as the service reads requests and the host reads messages.

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "exchange/wire.h"

namespace {

/// Reads the answer as the host does, whatever it asked for.
template <class Read>
void tryToRead(Read read, const wp::WireAnswer& answer) {
    try {
        read(answer);
    } catch (const wp::Refused&) {
    }
}

void readAsMessage(std::string_view line) {
    wp::WireMessage message = wp::readMessage(line);
    const auto* answer = std::get_if<wp::WireAnswer>(&message);
    if (!answer) return;
    tryToRead(wp::testAnswer, *answer);
    tryToRead(wp::statusAnswer, *answer);
    tryToRead(wp::wifiAnswer, *answer);
    tryToRead(wp::setPowerAnswer, *answer);
}

void readAsRequest(std::string_view line) {
    auto outcome = wp::readRequest(line);
    const auto* request = std::get_if<wp::WireRequest>(&outcome);
    if (!request) return;
    std::string written = wp::requestLine(*request);
    auto again = wp::readRequest(std::string_view(written).substr(0, written.size() - 1));
    if (!std::holds_alternative<wp::WireRequest>(again)) std::abort();
    if (wp::requestLine(std::get<wp::WireRequest>(again)) != written) std::abort();
}

void readAsGreeting(std::string_view line) {
    auto outcome = wp::readGreeting(line);
    const auto* greeting = std::get_if<wp::Greeting>(&outcome);
    if (!greeting) return;
    std::string written = wp::greetingLine(*greeting);
    auto again = wp::readGreeting(std::string_view(written).substr(0, written.size() - 1));
    if (!std::holds_alternative<wp::Greeting>(again)) std::abort();
    if (wp::greetingLine(std::get<wp::Greeting>(again)) != written) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::string_view text(reinterpret_cast<const char*>(data), size);
    while (!text.empty()) {
        std::string_view line = text.substr(0, text.find('\n'));
        readAsMessage(line);
        readAsRequest(line);
        readAsGreeting(line);
        text.remove_prefix(std::min(text.size(), line.size() + 1));
    }
    return 0;
}
