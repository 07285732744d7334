#include "screens/terminal/session.h"

// Without macros a call is a function: the library's own names (clear, move, erase) stay out of the way.
#define NCURSES_NOMACROS 1
#include <curses.h>
#include <fcntl.h>
#include <langinfo.h>
#include <poll.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <cerrno>
#include <clocale>
#include <cstdlib>
#include <cstring>
#include <map>

#include "screens/terminal/terminfo.h"

namespace wp::terminal {
namespace {

// The time in which the rest of a key's escape sequence must follow, so that Esc itself is a quick key.
constexpr int kEscapeDelay = 25;
constexpr short kAccentPair = 1;
constexpr short kBarPair = 2;

short pairOf(Ink ink) {
    switch (ink) {
        case Ink::accent:
            return kAccentPair;
        case Ink::bar:
            return kBarPair;
        case Ink::plain:
            break;
    }
    return 0;
}

attr_t attributesOf(const Style& style) {
    return (style.bold ? A_BOLD : 0U) | (style.dim ? A_DIM : 0U) | (style.reverse ? A_REVERSE : 0U);
}

bool isHungUp(int terminal) {
    pollfd descriptor{terminal, POLLIN, 0};
    return poll(&descriptor, 1, 0) > 0 && (descriptor.revents & (POLLHUP | POLLERR | POLLNVAL)) != 0;
}

Input keyInput(wint_t key) {
    using Kind = Input::Kind;
    static const std::map<wint_t, Input> keys = {
        {KEY_UP, {Kind::up}},
        {KEY_DOWN, {Kind::down}},
        {KEY_LEFT, {Kind::left}},
        {KEY_RIGHT, {Kind::right}},
        {KEY_PPAGE, {Kind::pageUp}},
        {KEY_NPAGE, {Kind::pageDown}},
        {KEY_HOME, {Kind::home}},
        {KEY_END, {Kind::end}},
        {KEY_BACKSPACE, {Kind::erase}},
        {KEY_DC, {Kind::remove}},
        {KEY_ENTER, {Kind::character, U'\r'}},
        {KEY_BTAB, {Kind::up}},
    };
    auto found = keys.find(key);
    return found == keys.end() ? Input{Kind::character, 0} : found->second;
}

}  // namespace

std::variant<std::unique_ptr<Session>, std::string> Session::open() {
    int terminal = ::open("/dev/tty", O_RDWR | O_CLOEXEC | O_NOCTTY);
    if (terminal < 0)
        return "there is no terminal to draw on (/dev/tty: " + std::string(std::strerror(errno)) + ")";
    std::unique_ptr<Session> session(new Session(terminal));
    std::string why;
    if (!session->start(why)) return why;
    return session;
}

Session::Session(int terminal) : terminal_(terminal) {}

bool Session::start(std::string& why) {
    std::setlocale(LC_CTYPE, "");
    if (std::string_view(nl_langinfo(CODESET)) == "UTF-8") charset_ = Charset::unicode;
    if (tcgetattr(terminal_, &modes_) != 0) {
        why = "the terminal's modes cannot be read (" + std::string(std::strerror(errno)) + ")";
        return false;
    }
    TerminalDescription description = describeTerminal(terminal_);
    if (description.unfit) {
        why = *description.unfit;
        return false;
    }
    output_ = fdopen(fcntl(terminal_, F_DUPFD_CLOEXEC, 0), "w");
    input_ = fdopen(fcntl(terminal_, F_DUPFD_CLOEXEC, 0), "r");
    guard_ = std::make_unique<Guard>(terminal_, modes_, description.leavingSequence);
    screen_ = newterm(nullptr, output_, input_);
    if (screen_ == nullptr) {
        why = "the terminal cannot be set up for a screen";
        return false;
    }
    configure();
    return true;
}

void Session::configure() {
    cbreak();
    noecho();
    nonl();
    intrflush(stdscr, FALSE);
    keypad(stdscr, TRUE);
    nodelay(stdscr, TRUE);
    set_escdelay(kEscapeDelay);
    typeahead(-1);  // a picture is drawn whole, also when the next key is there already
    curs_set(0);
    const char* noColour = std::getenv("NO_COLOR");
    bool isColourWanted = noColour == nullptr || *noColour == '\0';
    hasColours_ = isColourWanted && has_colors() && start_color() == OK && use_default_colors() == OK &&
                  init_pair(kAccentPair, COLOR_CYAN, -1) == OK && init_pair(kBarPair, COLOR_GREEN, -1) == OK;
}

Session::~Session() {
    if (screen_ != nullptr) {
        curs_set(1);
        endwin();
        guard_.reset();
        delscreen(screen_);
    }
    if (output_ != nullptr) std::fclose(output_);
    if (input_ != nullptr) std::fclose(input_);
    close(terminal_);
}

int Session::rows() const {
    return getmaxy(stdscr);
}

int Session::columns() const {
    return getmaxx(stdscr);
}

void Session::show(const Canvas& picture) {
    bool isSameSize = shown_ && shown_->rows() == picture.rows() && shown_->columns() == picture.columns();
    if (!isSameSize) {
        shown_.reset();
        werase(stdscr);
    }
    for (int row = 0; row < picture.rows(); ++row) showRow(picture, row);
    shown_ = std::make_unique<Canvas>(picture);
    curs_set(picture.cursor.isVisible() ? 1 : 0);
    if (picture.cursor.isVisible()) wmove(stdscr, picture.cursor.row, picture.cursor.column);
    wrefresh(stdscr);
}

void Session::showRow(const Canvas& picture, int row) {
    bool isChanged = !shown_;
    for (int column = 0; column < picture.columns() && !isChanged; ++column)
        isChanged = !(picture.at(row, column) == shown_->at(row, column));
    for (int column = 0; column < picture.columns() && isChanged; ++column) {
        const Canvas::Square& square = picture.at(row, column);
        if (square.text.empty()) continue;
        cchar_t cell{};
        short pair = hasColours_ ? pairOf(square.style.ink) : short{0};
        setcchar(&cell, square.text.c_str(), attributesOf(square.style), pair, nullptr);
        mvwadd_wch(stdscr, row, column, &cell);
    }
}

Input Session::read() {
    wint_t key = 0;
    switch (wget_wch(stdscr, &key)) {
        case KEY_CODE_YES:
            return keyInput(key);
        case OK:
            return {Input::Kind::character, static_cast<char32_t>(key)};
        default:
            return {isHungUp(terminal_) ? Input::Kind::lost : Input::Kind::none};
    }
}

void Session::resize() {
    winsize size{};
    if (ioctl(terminal_, TIOCGWINSZ, &size) != 0 || size.ws_row == 0 || size.ws_col == 0) return;
    resizeterm(size.ws_row, size.ws_col);
    invalidate();
}

void Session::invalidate() {
    shown_.reset();
    clearok(curscr, TRUE);
}

void Session::leave() {
    curs_set(1);
    endwin();
    guard_->disarm();
}

void Session::comeBack() {
    guard_->arm();
    reset_prog_mode();
    resize();
    invalidate();
}

}  // namespace wp::terminal
