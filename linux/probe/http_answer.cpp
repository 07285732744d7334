#include "linux/probe/http_answer.h"

#include <algorithm>
#include <charconv>
#include <ctime>

namespace wp {
namespace {

// Pages send long lists of what they allow; that is as much as common servers and clients bear.
constexpr std::size_t kLongestLine = 16384;
constexpr std::size_t kLongestHead = 65536;
// The size of a chunk with what may be said about it.
constexpr std::size_t kLongestChunkLine = 256;
constexpr int kMostInterim = 8;

std::string_view trimmed(std::string_view text) {
    const std::size_t start = text.find_first_not_of(" \t");
    if (start == text.npos) return {};
    return text.substr(start, text.find_last_not_of(" \t") - start + 1);
}

char lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
}

bool equalWithoutCase(std::string_view a, std::string_view b) {
    return std::ranges::equal(a, b, [](char x, char y) { return lower(x) == lower(y); });
}

/// A number that is all of the text.
std::optional<std::uint64_t> numberIn(std::string_view text, int base) {
    std::uint64_t number = 0;
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, number, base);
    return error == std::errc() && stop == end ? std::optional(number) : std::nullopt;
}

/// The one length that all say; a list of equal ones is allowed.
std::optional<std::uint64_t> lengthIn(std::string_view list) {
    std::optional<std::uint64_t> length;
    while (true) {
        const std::size_t comma = std::min(list.find(','), list.size());
        const auto number = numberIn(trimmed(list.substr(0, comma)), 10);
        if (!number || (length && *length != *number)) return std::nullopt;
        length = number;
        if (comma == list.size()) return length;
        list.remove_prefix(comma + 1);
    }
}

}  // namespace

void HttpAnswer::take(std::string_view bytes) {
    while (!bytes.empty() && !ended()) {
        if (part_ == Part::chunk || part_ == Part::counted || part_ == Part::untilClosed) {
            takeBody(bytes);
            continue;
        }
        const auto line = takeLine(bytes);
        if (!line) return;
        if (part_ == Part::statusLine)
            takeStatusLine(*line);
        else if (part_ == Part::header)
            takeHeader(*line);
        else if (part_ == Part::chunkSize)
            takeChunkSize(*line);
        else
            part_ = line->empty() ? Part::chunkSize : Part::broken;
    }
}

void HttpAnswer::close() {
    if (part_ == Part::untilClosed) part_ = Part::end;
    breakOff();
}

void HttpAnswer::breakOff() {
    if (!ended()) part_ = Part::broken;
}

std::string_view HttpAnswer::header(std::string_view name) const {
    const auto found = std::ranges::find_if(
        headers_, [name](const auto& each) { return equalWithoutCase(each.first, name); });
    return found == headers_.end() ? std::string_view() : std::string_view(found->second);
}

/// The values of all headers of that name, as the one list that they stand for (RFC 9110, 5.3).
std::string HttpAnswer::all(std::string_view name) const {
    std::string list;
    for (const auto& [each, value] : headers_)
        if (equalWithoutCase(each, name)) list += (list.empty() ? "" : ", ") + value;
    return list;
}

/// The next whole line without its end; it stays until the next one is taken.
std::optional<std::string_view> HttpAnswer::takeLine(std::string_view& bytes) {
    const std::size_t end = bytes.find('\n');
    const std::string_view piece = bytes.substr(0, end);
    line_ += piece.substr(0, kLongestLine + 1);
    bytes.remove_prefix(end == bytes.npos ? bytes.size() : end + 1);
    if (!hasHead_) headSize_ += piece.size() + 1;
    const std::size_t longest = hasHead_ ? kLongestChunkLine : kLongestLine;
    if (line_.size() > longest || headSize_ > kLongestHead) {
        part_ = Part::broken;
        return std::nullopt;
    }
    if (end == std::string_view::npos) return std::nullopt;
    whole_ = std::exchange(line_, {});
    if (whole_.ends_with('\r')) whole_.pop_back();
    return whole_;
}

void HttpAnswer::takeStatusLine(std::string_view line) {
    // "HTTP/1.1 204 No Content"
    constexpr std::size_t kStatus = 9, kEnd = 12;
    const bool formed = line.starts_with("HTTP/1.") && line.size() >= kEnd && line[kStatus - 1] == ' ' &&
                        (line.size() == kEnd || line[kEnd] == ' ');
    const auto number = formed ? numberIn(line.substr(kStatus, kEnd - kStatus), 10) : std::nullopt;
    if (!number || *number < 100) {
        part_ = Part::broken;
        return;
    }
    status_ = static_cast<int>(*number);
    part_ = Part::header;
}

void HttpAnswer::takeHeader(std::string_view line) {
    if (line.empty()) return endHead();
    if (line[0] == ' ' || line[0] == '\t') {
        if (!headers_.empty()) headers_.back().second.append(" ").append(trimmed(line));
        return;
    }
    const std::size_t colon = line.find(':');
    if (colon == line.npos) return;
    headers_.emplace_back(trimmed(line.substr(0, colon)), trimmed(line.substr(colon + 1)));
}

void HttpAnswer::endHead() {
    constexpr int kSwitching = 101;
    if (status_ < 200 && status_ != kSwitching) {
        headers_.clear();
        part_ = ++interim_ > kMostInterim ? Part::broken : Part::statusLine;
        return;
    }
    hasHead_ = true;
    chooseBody();
    if (part_ == Part::counted && left_ == 0) part_ = Part::end;
}

/// How long the body is (RFC 9112, 6.3).
void HttpAnswer::chooseBody() {
    if (status_ < 200 || status_ == 204 || status_ == 304) {
        part_ = Part::end;
        return;
    }
    const std::string codings = all("Transfer-Encoding");
    if (!codings.empty()) {
        const std::string_view last = trimmed(std::string_view(codings).substr(codings.rfind(',') + 1));
        part_ = equalWithoutCase(last, "chunked") ? Part::chunkSize : Part::untilClosed;
        return;
    }
    const auto announced = lengthIn(all("Content-Length"));
    left_ = announced.value_or(0);
    part_ = announced ? Part::counted : Part::untilClosed;
}

void HttpAnswer::takeChunkSize(std::string_view line) {
    const auto size = numberIn(trimmed(line.substr(0, line.find(';'))), 16);
    left_ = size.value_or(0);
    if (!size)
        part_ = Part::broken;
    else  // What follows the last chunk, headers once more, says nothing that is asked for.
        part_ = *size == 0 ? Part::end : Part::chunk;
}

void HttpAnswer::takeBody(std::string_view& bytes) {
    const bool isCounted = part_ != Part::untilClosed;
    const std::size_t there =
        isCounted && left_ < bytes.size() ? static_cast<std::size_t>(left_) : bytes.size();
    const std::size_t room = longestBody_ - body_.size();
    body_.append(bytes.substr(0, std::min(there, room)));
    bytes.remove_prefix(there);
    if (isCounted) left_ -= there;
    if (there > room)
        part_ = Part::end;
    else if (isCounted && left_ == 0)
        part_ = part_ == Part::chunk ? Part::chunkEnd : Part::end;
}

std::optional<std::int64_t> httpDate(std::string_view text) {
    const std::string whole(text.substr(0, 64));
    for (const char* form :
         {"%a, %d %b %Y %H:%M:%S GMT", "%A, %d-%b-%y %H:%M:%S GMT", "%a %b %d %H:%M:%S %Y"}) {
        std::tm moment{};
        const char* const end = ::strptime(whole.c_str(), form, &moment);
        if (end == whole.c_str() + whole.size()) return ::timegm(&moment);
    }
    return std::nullopt;
}

}  // namespace wp
