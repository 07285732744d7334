#include "screens/remote/script.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <cstdio>
#include <cstring>
#include <memory>
#include <system_error>

#include "platform/ui/display_text.h"
#include "screens/remote/tokens.h"

namespace wp::remote {
namespace {

struct Word {
    std::string_view name;
    Action action;
};

constexpr std::array kWords = std::to_array<Word>({
    {"up", Action::up},
    {"down", Action::down},
    {"left", Action::left},
    {"right", Action::right},
    {"select", Action::select},
    {"back", Action::back},
    {"clear", Action::clear},
    {"wait", Action::wait},
    {"screen", Action::screen},
});

constexpr std::string_view kKnown =
    "up, down, left, right, select, back, type:TEXT, clear, wait, sleep:MS, screen, shot:FILE.png, @FILE";

// A day: a longer pause in a script is a slip of the finger.
constexpr long kLongestSleep = 24L * 60 * 60 * 1000;

bool isUtf8(std::string_view text) {
    while (!text.empty())
        if (!ui::takeCharacter(text).value) return false;
    return true;
}

/// Reads one token into the step. Returns why it could not.
std::optional<std::string> readType(std::string_view text, Step& step) {
    if (!isUtf8(text)) return "the text is not UTF-8";
    step.action = Action::type;
    step.text = text;
    return std::nullopt;
}

std::optional<std::string> readSleep(std::string_view text, Step& step) {
    long time = 0;
    auto [end, status] = std::from_chars(text.data(), text.data() + text.size(), time);
    bool isNumber = status == std::errc() && end == text.data() + text.size() && text[0] != '-';
    if (!isNumber || time > kLongestSleep)
        return "sleep needs whole milliseconds from 0 to " + std::to_string(kLongestSleep);
    step.action = Action::sleep;
    step.time = std::chrono::milliseconds(time);
    return std::nullopt;
}

std::optional<std::string> readShot(std::string_view file, Pictures pictures, Step& step) {
    constexpr std::string_view kEnding = ".png";
    if (pictures == Pictures::refused) return "only the tv screen takes pictures";
    if (file.size() <= kEnding.size() || !file.ends_with(kEnding))
        return "shot needs the name of a file that ends in .png";
    step.action = Action::shot;
    step.text = file;
    return std::nullopt;
}

std::optional<std::string> readStep(std::string_view token, Pictures pictures, Step& step) {
    auto isWord = [&](const Word& word) { return word.name == token; };
    if (auto word = std::find_if(kWords.begin(), kWords.end(), isWord); word != kWords.end()) {
        step.action = word->action;
        return std::nullopt;
    }
    auto colon = token.find(':');
    std::string_view name = token.substr(0, colon);
    std::string_view value = colon == std::string_view::npos ? "" : token.substr(colon + 1);
    if (colon != std::string_view::npos) {
        if (name == "type") return readType(value, step);
        if (name == "sleep") return readSleep(value, step);
        if (name == "shot") return readShot(value, pictures, step);
    }
    return "not one of " + std::string(kKnown);
}

/// More than any hand or bench writes; a device file that never ends is refused here.
constexpr std::size_t kLongestFile = 1 << 20;

std::optional<std::string> readFile(const std::string& file, std::string& content) {
    std::unique_ptr<std::FILE, int (*)(std::FILE*)> stream(std::fopen(file.c_str(), "rb"), std::fclose);
    if (!stream) return std::string(std::strerror(errno));
    std::array<char, 4096> buffer;
    while (std::size_t count = std::fread(buffer.data(), 1, buffer.size(), stream.get())) {
        content.append(buffer.data(), count);
        if (content.size() > kLongestFile) return "longer than " + std::to_string(kLongestFile) + " bytes";
    }
    if (std::ferror(stream.get()) != 0) return std::string(std::strerror(errno));
    return std::nullopt;
}

class Reader {
  public:
    explicit Reader(Pictures pictures) : pictures_(pictures) {}

    Script read(std::string_view argument) {
        readAll(argument, "");
        if (script_.error) script_.steps.clear();
        return std::move(script_);
    }

  private:
    void readAll(std::string_view source, const std::string& file) {
        Tokens split = splitTokens(source);
        if (split.error) return fail(linePlace(file, split.errorLine) + *split.error);
        int count = 0;
        for (const RawToken& token : split.tokens) {
            std::string place = linePlace(file, token.line) + "token " + std::to_string(++count) + " \"" +
                                ui::displayForm(token.text) + "\"";
            if (token.text.starts_with('@')) {
                readFileToken(token.text.substr(1), file, place);
            } else {
                readPlainToken(token.text, place);
            }
            if (script_.error) return;
        }
    }

    void readPlainToken(const std::string& token, const std::string& place) {
        Step step;
        step.place = place;
        if (auto reason = readStep(token, pictures_, step)) return fail(place + ": " + *reason);
        script_.steps.push_back(std::move(step));
    }

    void readFileToken(const std::string& name, const std::string& outer, const std::string& place) {
        if (!outer.empty()) return fail(place + ": a script file names no further file");
        std::string content;
        if (auto reason = readFile(name, content)) return fail(place + ": " + *reason);
        // Some editors begin a file of UTF-8 with it.
        constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
        std::string_view words = content;
        if (words.starts_with(kByteOrderMark)) words.remove_prefix(kByteOrderMark.size());
        readAll(words, name);
    }

    static std::string linePlace(const std::string& file, int line) {
        return file.empty() ? "" : ui::displayForm(file) + ":" + std::to_string(line) + ": ";
    }

    void fail(std::string reason) { script_.error = std::move(reason); }

    Pictures pictures_;
    Script script_;
};

}  // namespace

Script readScript(std::string_view argument, Pictures pictures) {
    return Reader(pictures).read(argument);
}

}  // namespace wp::remote
