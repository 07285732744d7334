#include "screens/remote/tokens.h"

namespace wp::remote {
namespace {

bool isBlank(char c) {
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

class Splitter {
  public:
    explicit Splitter(std::string_view script) : rest_(script) {}

    Tokens split() {
        while (skipToToken()) {
            RawToken token{"", line_};
            if (!readToken(token.text)) return std::move(result_);
            result_.tokens.push_back(std::move(token));
        }
        return std::move(result_);
    }

  private:
    char take() {
        char c = rest_.front();
        rest_.remove_prefix(1);
        if (c == '\n') ++line_;
        return c;
    }

    bool skipToToken() {
        while (!rest_.empty()) {
            if (rest_.front() == '#') {
                while (!rest_.empty() && rest_.front() != '\n') take();
            } else if (isBlank(rest_.front())) {
                take();
            } else {
                return true;
            }
        }
        return false;
    }

    bool readToken(std::string& text) {
        while (!rest_.empty() && !isBlank(rest_.front())) {
            int start = line_;
            char c = take();
            bool isWhole = true;
            if (c == '\'') {
                isWhole = readSingleQuoted(text);
            } else if (c == '"') {
                isWhole = readDoubleQuoted(text);
            } else if (c == '\\') {
                isWhole = readEscaped(text);
            } else {
                text += c;
            }
            if (!isWhole) return fail(c, start);
        }
        return true;
    }

    bool readSingleQuoted(std::string& text) {
        while (!rest_.empty()) {
            char c = take();
            if (c == '\'') return true;
            text += c;
        }
        return false;
    }

    bool readDoubleQuoted(std::string& text) {
        while (!rest_.empty()) {
            char c = take();
            if (c == '"') return true;
            if (c == '\\' && !rest_.empty()) {
                char escaped = take();
                if (std::string_view("\"\\$`\n").find(escaped) == std::string_view::npos) text += '\\';
                if (escaped != '\n') text += escaped;
            } else {
                text += c;
            }
        }
        return false;
    }

    bool readEscaped(std::string& text) {
        if (rest_.empty()) return false;
        char c = take();
        if (c != '\n') text += c;
        return true;
    }

    bool fail(char opener, int line) {
        result_.tokens.clear();
        result_.error = opener == '\\' ? "nothing follows the backslash at the end"
                                       : std::string("the quote ") + opener + " is never closed";
        result_.errorLine = line;
        return false;
    }

    std::string_view rest_;
    int line_ = 1;
    Tokens result_;
};

}  // namespace

Tokens splitTokens(std::string_view script) {
    return Splitter(script).split();
}

}  // namespace wp::remote
