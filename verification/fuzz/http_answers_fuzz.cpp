#include <cstdlib>

#include "linux/probe/http_answer.h"
#include "linux/probe/web_place.h"

using namespace wp;

namespace {

constexpr std::size_t kRoom = 512;

HttpAnswer answerTo(std::string_view bytes, std::size_t step) {
    HttpAnswer answer(kRoom);
    for (std::size_t at = 0; at < bytes.size(); at += step) answer.take(bytes.substr(at, step));
    answer.close();
    return answer;
}

/// A target must be fit for a request, and mean the same once it was taken apart.
void checkTarget(const std::string& target) {
    if (target.size() > kLongestUrl) std::abort();
    for (const char c : target)
        if (c <= ' ' || c >= 0x7F) std::abort();
    const auto place = webPlace(target);
    if (place && webPlace(place->origin() + place->path) != place) std::abort();
}

}  // namespace

/// What a web server sends. It must mean the same however it is cut on the way, and stay within its bounds; where it
/// redirects to must be fit for a request.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const HttpAnswer whole = answerTo(bytes, size + 1), cut = answerTo(bytes, 3);
    if (!whole.ended() || whole.body().size() > kRoom) std::abort();
    if (whole.status() != cut.status() || whole.body() != cut.body()) std::abort();
    if (whole.isWhole() != cut.isWhole()) std::abort();
    for (const char* name : {"Location", "Date", "Content-Length"})
        if (whole.header(name) != cut.header(name)) std::abort();
    HttpAnswer broken(kRoom);
    broken.take(bytes);
    broken.breakOff();
    if (!broken.ended() || (broken.isWhole() && !whole.isWhole()) || broken.body() != whole.body())
        std::abort();
    httpDate(whole.header("Date"));
    checkTarget(resolveReference("http://r.example/a/b?c", whole.header("Location")));
    // The same bytes as two lines: an address, and a reference in what lies there.
    const std::size_t line = bytes.find('\n');
    if (line != bytes.npos) checkTarget(resolveReference(bytes.substr(0, line), bytes.substr(line + 1)));
    return 0;
}
