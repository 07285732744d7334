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

}  // namespace

/// What a web server sends. It must mean the same however it is cut on the way, and stay within its bounds; where it
/// redirects to must be fit for a request.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const HttpAnswer whole = answerTo(bytes, size + 1), cut = answerTo(bytes, 3);
    if (!whole.ended() || whole.body().size() > kRoom) std::abort();
    if (whole.status() != cut.status() || whole.body() != cut.body()) std::abort();
    for (const char* name : {"Location", "Date", "Content-Length"})
        if (whole.header(name) != cut.header(name)) std::abort();
    httpDate(whole.header("Date"));
    const std::string target = resolveReference("http://r.example/a/b?c", whole.header("Location"));
    for (const char c : target)
        if (c <= ' ' || c >= 0x7F) std::abort();
    if (const auto place = webPlace(target); place && webPlace(place->origin() + place->path) != place)
        std::abort();
    return 0;
}
