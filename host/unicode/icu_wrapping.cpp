#include <unicode/brkiter.h>
#include <unicode/uchar.h>
#include <unicode/unistr.h>

#include <memory>

#include "host/unicode/icu_functions.h"

namespace wp::host::icu_functions {
namespace {

int columnsOf(UChar32 character) {
    std::int8_t category = u_charType(character);
    bool isMark = category == U_NON_SPACING_MARK || category == U_ENCLOSING_MARK || category == U_FORMAT_CHAR;
    if (isMark) return 0;
    int width = u_getIntPropertyValue(character, UCHAR_EAST_ASIAN_WIDTH);
    return width == U_EA_WIDE || width == U_EA_FULLWIDTH ? 2 : 1;
}

int columnsOf(const icu::UnicodeString& text) {
    int columns = 0;
    for (std::int32_t at = 0; at < text.length(); at = text.moveIndex32(at, 1))
        columns += columnsOf(text.char32At(at));
    return columns;
}

icu::UnicodeString unicode(std::string_view text) {
    return icu::UnicodeString::fromUTF8(
        icu::StringPiece(text.data(), static_cast<std::int32_t>(text.size())));
}

/// Whether the text breaks at this place between a number and its unit, which belong on one line.
bool partsUnit(const icu::UnicodeString& text, std::int32_t at) {
    if (at < 2 || text[at - 1] != u' ' || !u_isdigit(text[at - 2])) return false;
    for (const char16_t* unit : {u"dBm", u"dB", u"MHz", u"GHz", u"Mb/s", u"ms", u"s", u"%"}) {
        icu::UnicodeString word(unit);
        std::int32_t end = at + word.length();
        if (text.compare(at, word.length(), word) == 0 && (end >= text.length() || !u_isalnum(text[end])))
            return true;
    }
    return false;
}

/// The lines of one text while pieces are added that must not be broken.
class LineMaker {
  public:
    explicit LineMaker(int columns) : columns_(columns) {}

    void add(icu::UnicodeString piece) {
        icu::UnicodeString visible = piece;
        visible.trim();
        if (columnsOf(line_) + columnsOf(visible) > columns_) end();
        while (columnsOf(visible) > columns_) addStart(piece, visible);
        line_ += piece;
    }
    std::vector<std::string> finished() {
        end();
        return std::move(lines_);
    }

  private:
    void end() {
        line_.trim();
        std::string text;
        if (!line_.isEmpty()) lines_.push_back(line_.toUTF8String(text));
        line_.remove();
    }
    /// A line full of the beginning of a piece that no line holds.
    void addStart(icu::UnicodeString& piece, icu::UnicodeString& visible) {
        std::int32_t count = 0;
        for (int used = 0; used + columnsOf(piece.char32At(count)) <= columns_;) {
            used += columnsOf(piece.char32At(count));
            count = piece.moveIndex32(count, 1);
        }
        line_ = piece.tempSubString(0, count);
        end();
        piece.remove(0, count);
        visible = piece;
        visible.trim();
    }

    int columns_;
    icu::UnicodeString line_;
    std::vector<std::string> lines_;
};

}  // namespace

int columnsOf(std::string_view text) {
    return columnsOf(unicode(text));
}

std::vector<std::string> wrappedLines(std::string_view text, int columns) {
    UErrorCode status = U_ZERO_ERROR;
    std::unique_ptr<icu::BreakIterator> breaks(
        icu::BreakIterator::createLineInstance(icu::Locale::getRoot(), status));
    icu::UnicodeString whole = unicode(text);
    LineMaker lines(columns);
    if (!breaks || U_FAILURE(status)) {
        lines.add(whole);
        return lines.finished();
    }
    breaks->setText(whole);
    std::int32_t from = breaks->first();
    for (std::int32_t to = breaks->next(); to != icu::BreakIterator::DONE; to = breaks->next()) {
        if (partsUnit(whole, to)) continue;
        lines.add(whole.tempSubString(from, to - from));
        from = to;
    }
    return lines.finished();
}

std::string withUnitsKept(std::string_view text) {
    icu::UnicodeString kept = unicode(text);
    for (std::int32_t at = 1; at < kept.length(); ++at)
        if (partsUnit(kept, at)) kept.setCharAt(at - 1, u'\u00A0');
    std::string out;
    return kept.toUTF8String(out);
}

}  // namespace wp::host::icu_functions
