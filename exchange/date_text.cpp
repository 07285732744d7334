#include "exchange/date_text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <cmath>

#include "platform/date_formatter.h"

namespace wp {
namespace {

/// Takes a text apart from its front. Once something did not fit, `failed` stays set.
class Scanner {
  public:
    explicit Scanner(std::string_view text) : rest_(text) {}

    bool failed() const { return failed_; }
    bool atEnd() const { return rest_.empty(); }

    bool take(char wanted) {
        if (rest_.empty() || rest_.front() != wanted) return false;
        rest_.remove_prefix(1);
        return true;
    }

    void expect(char wanted) { failed_ = !take(wanted) || failed_; }

    /// Exactly so many digits, within the bounds.
    int number(std::size_t digits, int least, int most) {
        int value = 0;
        std::string_view field = rest_.substr(0, digits);
        if (field.size() != digits || !std::all_of(field.begin(), field.end(), isDigit)) return fail();
        for (char digit : field) value = 10 * value + (digit - '0');
        rest_.remove_prefix(digits);
        return value < least || value > most ? fail() : value;
    }

    /// The digits after a decimal point, as a number below one.
    double fraction() {
        auto end = std::find_if_not(rest_.begin(), rest_.end(), isDigit);
        auto length = static_cast<std::size_t>(end - rest_.begin());
        if (length == 0) return fail();
        std::string digits = "0." + std::string(rest_.substr(0, length));
        double value = 0;
        std::from_chars(digits.data(), digits.data() + digits.size(), value);
        rest_.remove_prefix(length);
        return value;
    }

  private:
    static bool isDigit(char c) { return c >= '0' && c <= '9'; }
    int fail() {
        failed_ = true;
        return 0;
    }

    std::string_view rest_;
    bool failed_ = false;
};

/// The zone's distance from UTC in minutes.
int takeOffset(Scanner& scanner) {
    if (scanner.take('Z')) return 0;
    int sign = scanner.take('-') ? -1 : 1;
    if (sign > 0) scanner.expect('+');
    int minutes = 60 * scanner.number(2, 0, 23);
    if (scanner.take(':') || !scanner.atEnd()) minutes += scanner.number(2, 0, 59);
    return sign * minutes;
}

}  // namespace

std::optional<Date> readISO8601(std::string_view text) {
    using namespace std::chrono;
    Scanner scanner(text);
    int yearNumber = scanner.number(4, 0, 9999);
    scanner.expect('-');
    int monthNumber = scanner.number(2, 1, 12);
    scanner.expect('-');
    int dayNumber = scanner.number(2, 1, 31);
    scanner.expect('T');
    int seconds = 3600 * scanner.number(2, 0, 23);
    scanner.expect(':');
    seconds += 60 * scanner.number(2, 0, 59);
    scanner.expect(':');
    seconds += scanner.number(2, 0, 59);
    double fraction = scanner.take('.') || scanner.take(',') ? scanner.fraction() : 0;
    seconds -= 60 * takeOffset(scanner);
    year_month_day calendar(year(yearNumber), month(static_cast<unsigned>(monthNumber)),
                            day(static_cast<unsigned>(dayNumber)));
    if (scanner.failed() || !scanner.atEnd() || !calendar.ok()) return std::nullopt;
    auto days = (sys_days(calendar) - sys_days(year(2001) / 1 / 1)).count();
    double whole = 86400.0 * static_cast<double>(days) + seconds;
    // A fraction finer than the sum holds is cut like any other, it does not become the next second.
    return Date{std::min(whole + fraction, std::nextafter(whole + 1, whole))};
}

std::string exactISO8601Text(Date date) {
    std::string text = iso8601Text(date);
    double seconds = date.secondsSinceReference;
    double fraction = seconds - std::floor(seconds);
    if (!(fraction > 0 && fraction < 1)) return text;
    std::array<char, 400> digits{};  // the smallest double has 325 digits in front of its first one
    auto written =
        std::to_chars(digits.data(), digits.data() + digits.size(), fraction, std::chars_format::fixed);
    if (written.ec != std::errc()) return text;
    text.pop_back();  // the Z
    text.append(digits.data() + 1, written.ptr);
    return text + 'Z';
}

}  // namespace wp
