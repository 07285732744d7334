#include "exchange/json_reader.h"

#include <algorithm>
#include <limits>
#include <nlohmann/json.hpp>
#include <optional>
#include <vector>

#include "exchange/place.h"

namespace wp {
namespace {

std::string linePlace(std::string_view text, std::size_t offset) {
    std::string_view before = text.substr(0, offset);
    auto lines = std::count(before.begin(), before.end(), '\n');
    std::size_t lineStart = before.rfind('\n') + 1;  // npos + 1 is the text's own start
    return "line " + std::to_string(lines + 1) + ", column " + std::to_string(before.size() - lineStart + 1);
}

/// The parser's own words without its tags; what it quotes of the text may be anything.
std::string reasonFrom(std::string_view words) {
    if (words.find("UTF-8") != std::string_view::npos) return "invalid UTF-8";
    std::size_t start = words.find(" - ");
    std::string reason(start == std::string_view::npos ? words : words.substr(start + 3));
    constexpr std::size_t longest = 160;
    if (reason.size() > longest) reason = reason.substr(0, longest) + "…";
    std::replace_if(
        reason.begin(), reason.end(), [](unsigned char c) { return c < 0x20 || c == 0x7F; }, ' ');
    return "not valid JSON: " + reason;
}

/// Builds the value from the parser's events.
class Builder final : public nlohmann::json_sax<nlohmann::json> {
  public:
    Builder(std::string_view text, std::size_t depthLimit) : text_(text), depthLimit_(depthLimit) {}

    bool null() override { return put(NullMarker{}); }
    bool boolean(bool flag) override { return put(flag); }
    bool number_integer(number_integer_t number) override { return put(std::int64_t{number}); }
    bool number_unsigned(number_unsigned_t number) override {
        constexpr auto signedLimit = static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
        if (number <= signedLimit) return put(static_cast<std::int64_t>(number));
        return put(std::uint64_t{number});
    }
    bool number_float(number_float_t number, const string_t& digits) override {
        // The parser falls back to a double where an integer does not fit.
        bool isInteger = digits.find_first_not_of("-0123456789") == string_t::npos;
        if (isInteger) return refuse(nextPlace(), "an integer beyond 64 bits");
        return put(double{number});
    }
    bool string(string_t& text) override { return put(std::move(text)); }
    bool binary(binary_t&) override { return refuse(nextPlace(), "not valid JSON"); }

    bool start_object(std::size_t) override { return open(true); }
    bool start_array(std::size_t) override { return open(false); }
    bool key(string_t& key) override {
        Frame& frame = frames_.back();
        frame.key = std::move(key);
        if (!frame.entries.contains(frame.key)) return true;
        return refuse(nextPlace(), "the key stands twice");
    }
    bool end_object() override {
        Value object = Dictionary::make(std::move(frames_.back().entries));
        frames_.pop_back();
        return put(std::move(object));
    }
    bool end_array() override {
        Value array = std::move(frames_.back().elements);
        frames_.pop_back();
        return put(std::move(array));
    }

    bool parse_error(std::size_t position, const std::string&,
                     const nlohmann::detail::exception& error) override {
        if (dynamic_cast<const nlohmann::json::out_of_range*>(&error))
            return refuse(nextPlace(), "a number too large for a double");
        std::size_t offset = std::min(position == 0 ? 0 : position - 1, text_.size());
        return refuse(linePlace(text_, offset), reasonFrom(error.what()));
    }

    std::variant<Value, Refusal> take() {
        if (refusal_) return *std::move(refusal_);
        return std::move(top_);
    }

  private:
    struct Frame {
        bool isObject = false;
        std::string key;
        Dictionary::Entries entries;
        Array elements;
    };

    bool open(bool isObject) {
        if (frames_.size() >= depthLimit_)
            return refuse(nextPlace(), "nested deeper than " + std::to_string(depthLimit_) + " levels");
        Frame frame;
        frame.isObject = isObject;
        frames_.push_back(std::move(frame));
        return true;
    }

    bool put(Value value) {
        if (frames_.empty()) {
            top_ = std::move(value);
        } else if (Frame& frame = frames_.back(); frame.isObject) {
            frame.entries.emplace(std::move(frame.key), std::move(value));
        } else {
            frame.elements.push_back(std::move(value));
        }
        return true;
    }

    bool refuse(std::string place, std::string reason) {
        refusal_ = Refusal{std::move(place), std::move(reason)};
        return false;
    }

    /// The path to the value that comes next.
    std::string nextPlace() const {
        std::string path;
        for (const Frame& frame : frames_) {
            if (frame.isObject) {
                appendKey(path, frame.key);
            } else {
                path += '[' + std::to_string(frame.elements.size()) + ']';
            }
        }
        return path;
    }

    std::string_view text_;
    std::size_t depthLimit_;
    std::vector<Frame> frames_;
    Value top_;
    std::optional<Refusal> refusal_;
};

}  // namespace

std::variant<Value, Refusal> readJSON(std::string_view text, const JSONLimits& limits) {
    if (text.size() > limits.bytes)
        return Refusal{"", "longer than " + std::to_string(limits.bytes) + " bytes"};
    Builder builder(text, limits.depth);
    nlohmann::json::sax_parse(text.begin(), text.end(), &builder);
    auto outcome = builder.take();
    // The parser takes a NUL behind the value for the end of the text, whatever follows.
    std::size_t zero = text.find('\0');
    if (std::holds_alternative<Refusal>(outcome) || zero == std::string_view::npos) return outcome;
    return Refusal{linePlace(text, zero), "not valid JSON: a NUL byte behind the value"};
}

}  // namespace wp
