// Reads any bytes as a recording. What is accepted must be written in a form that is accepted again and written
// alike, also without its names and addresses.

#include <cstdint>
#include <cstdlib>
#include <iostream>
#include <string_view>

#include "exchange/anonymise.h"
#include "exchange/recording.h"

namespace {

void require(bool holds, const std::string& what) {
    if (holds) return;
    std::cerr << what << "\n";
    std::abort();
}

wp::Recording readBack(const std::string& text) {
    auto outcome = wp::readRecording(text);
    auto* refusal = std::get_if<wp::Refusal>(&outcome);
    require(!refusal, "refused what was written: " + (refusal ? refusal->text() : "") + "\n" + text);
    return std::get<wp::Recording>(std::move(outcome));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    auto outcome = wp::readRecording({reinterpret_cast<const char*>(data), size});
    if (auto* refusal = std::get_if<wp::Refusal>(&outcome)) {
        require(refusal->text().find('\n') == std::string::npos, "a refusal of several lines");
        return 0;
    }
    const auto& recording = std::get<wp::Recording>(outcome);
    std::string text = wp::recordingText(recording);
    require(wp::recordingText(readBack(text)) == text, "reads back differently:\n" + text);
    std::string anonymous = wp::recordingText(wp::anonymised(recording));
    require(wp::recordingText(readBack(anonymous)) == anonymous, "reads back differently:\n" + anonymous);
    return 0;
}
