#include "platform/json_writer.h"

#include <array>
#include <charconv>
#include <cmath>
#include <string_view>

#include "platform/date_formatter.h"

namespace wp {
namespace {

/// The length of the well-formed UTF-8 sequence that the text begins with; 0 when it begins with none.
std::size_t sequenceLength(std::string_view text) {
    auto byte = [&](std::size_t i) { return i < text.size() ? static_cast<unsigned char>(text[i]) : 0U; };
    auto isTail = [&](std::size_t i) { return (byte(i) & 0xC0U) == 0x80U; };
    unsigned lead = byte(0);
    if (lead < 0x80) return 1;
    if (lead >= 0xC2 && lead <= 0xDF) return isTail(1) ? 2 : 0;
    if (lead >= 0xE0 && lead <= 0xEF) {
        bool isOverlong = lead == 0xE0 && byte(1) < 0xA0;
        bool isSurrogate = lead == 0xED && byte(1) > 0x9F;
        return isTail(1) && isTail(2) && !isOverlong && !isSurrogate ? 3 : 0;
    }
    if (lead >= 0xF0 && lead <= 0xF4) {
        bool isOverlong = lead == 0xF0 && byte(1) < 0x90;
        bool isBeyond = lead == 0xF4 && byte(1) > 0x8F;
        return isTail(1) && isTail(2) && isTail(3) && !isOverlong && !isBeyond ? 4 : 0;
    }
    return 0;
}

void appendEscape(std::string& out, unsigned codePoint) {
    constexpr std::string_view digits = "0123456789abcdef";
    out += "\\u";
    for (int shift = 12; shift >= 0; shift -= 4) out += digits[(codePoint >> shift) & 0xFU];
}

void appendASCII(std::string& out, char character) {
    switch (character) {
        case '"':
            out += "\\\"";
            return;
        case '\\':
            out += "\\\\";
            return;
        case '\b':
            out += "\\b";
            return;
        case '\f':
            out += "\\f";
            return;
        case '\n':
            out += "\\n";
            return;
        case '\r':
            out += "\\r";
            return;
        case '\t':
            out += "\\t";
            return;
        default:
            break;
    }
    auto code = static_cast<unsigned char>(character);
    if (code < 0x20 || code == 0x7F) {
        appendEscape(out, code);
    } else {
        out += character;
    }
}

void appendSequence(std::string& out, std::string_view sequence) {
    auto tail = [&](std::size_t i) { return static_cast<unsigned char>(sequence[i]) & 0x3FU; };
    if (sequence.size() == 2 && sequence[0] == '\xC2' && tail(1) < 0x20) {
        appendEscape(out, 0x80U | tail(1));
    } else if (sequence == "\u2028" || sequence == "\u2029") {
        appendEscape(out, 0x2000U | tail(2));
    } else {
        out += sequence;
    }
}

void appendText(std::string& out, std::string_view text) {
    out += '"';
    while (!text.empty()) {
        std::size_t length = sequenceLength(text);
        if (length == 1) {
            appendASCII(out, text.front());
        } else if (length == 0) {
            out += "\uFFFD";
        } else {
            appendSequence(out, text.substr(0, length));
        }
        text.remove_prefix(length == 0 ? 1 : length);
    }
    out += '"';
}

/// Plain digits between 0.0001 and 10^16, an exponent beyond.
void appendDouble(std::string& out, double number) {
    if (!std::isfinite(number)) {
        out += "null";
        return;
    }
    double magnitude = std::fabs(number);
    bool isPlain = magnitude == 0 || (magnitude >= 1e-4 && magnitude < 1e16);
    std::array<char, 64> buffer{};
    auto written = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number,
                                 isPlain ? std::chars_format::fixed : std::chars_format::scientific);
    std::string_view digits(buffer.data(), static_cast<std::size_t>(written.ptr - buffer.data()));
    out += digits;
    if (isPlain && digits.find('.') == std::string_view::npos) out += ".0";
}

class Writer {
  public:
    Writer(std::string& out, JSONStyle style) : out_(out), isIndented_(style == JSONStyle::indented) {}

    void write(const Value& value) {
        std::visit([this](const auto& content) { append(content); }, value.storage());
    }

  private:
    void append(NullMarker) { out_ += "null"; }
    void append(bool flag) { out_ += flag ? "true" : "false"; }
    void append(std::int64_t number) { out_ += std::to_string(number); }
    void append(std::uint64_t number) { out_ += std::to_string(number); }
    void append(double number) { appendDouble(out_, number); }
    void append(const std::string& text) { appendText(out_, text); }
    void append(Date date) { appendText(out_, iso8601Text(date)); }
    void append(const RecordPointer&) { out_ += "null"; }

    void append(const ArrayPointer& array) {
        if (!array) return append(NullMarker{});
        open('[');
        for (const Value& element : *array) {
            next();
            write(element);
        }
        close(']');
    }

    void append(const DictionaryPointer& dictionary) {
        if (!dictionary) return append(NullMarker{});
        open('{');
        for (const auto& [key, value] : dictionary->entries()) {
            next();
            appendText(out_, key);
            out_ += isIndented_ ? ": " : ":";
            write(value);
        }
        close('}');
    }

    void open(char bracket) {
        out_ += bracket;
        ++depth_;
        isFirst_ = true;
    }

    void next() {
        if (!isFirst_) out_ += ',';
        isFirst_ = false;
        breakLine();
    }

    void close(char bracket) {
        --depth_;
        if (!isFirst_) breakLine();
        isFirst_ = false;
        out_ += bracket;
    }

    void breakLine() {
        if (!isIndented_) return;
        out_ += '\n';
        out_.append(2 * depth_, ' ');
    }

    std::string& out_;
    bool isIndented_;
    bool isFirst_ = true;
    std::size_t depth_ = 0;
};

}  // namespace

std::string jsonText(const Value& value, JSONStyle style) {
    std::string out;
    Writer(out, style).write(value);
    return out;
}

double shortestDecimal(float number) {
    std::array<char, 64> buffer{};
    auto written = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number);
    double wide = number;
    std::from_chars(buffer.data(), written.ptr, wide);
    return wide;
}

}  // namespace wp
