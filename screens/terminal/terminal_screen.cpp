#include "screens/terminal/terminal_screen.h"

#include <poll.h>
#include <signal.h>
#include <unistd.h>

#include <algorithm>

#include "platform/ui/display_text.h"
#include "screens/terminal/guard.h"
#include "screens/terminal/session.h"
#include "screens/terminal/wake.h"

namespace wp::terminal {
namespace {

constexpr char32_t kEscape = 0x1B;
constexpr char32_t kDelete = 0x7F;
// Part of a key's bytes may be there before the rest.
constexpr int kMostEmptyReads = 100;

constexpr char32_t control(char letter) {
    return static_cast<char32_t>(letter - 'A' + 1);
}

}  // namespace

class TerminalScreen::Loop : private ui::ScreenObserver {
  public:
    Loop(std::shared_ptr<Wake> wake, std::unique_ptr<Session> session, ui::Screen& screen, MainQueue& queue,
         Texts texts)
        : wake_(std::move(wake)),
          session_(std::move(session)),
          screen_(screen),
          queue_(queue),
          texts_(std::move(texts)) {
        screen_.setObserver(this);
        // The handler may still run on another thread when it has been taken back: it keeps its own hold.
        queue_.setWakeHandler([wake = wake_] { wake->wake(); });
    }

    ~Loop() override {
        queue_.setWakeHandler(nullptr);
        screen_.setObserver(nullptr);
    }

    bool runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) {
        for (;;) {
            wake_->drain();
            takeSignals();
            queue_.runPending();
            bool isFulfilled = condition();
            if (!isFulfilled) isFulfilled = takeKeys(condition);
            drawIfNeeded();
            if (isFulfilled) return true;
            if (end && Clock::now() >= *end) return false;
            wait(end);
        }
    }

    bool isLost() const { return isLost_; }

  private:
    void viewsChanged() override { isUpToDate_ = false; }
    void tableReloaded(ui::SettingsTableView&) override { isUpToDate_ = false; }
    void tableChanged(ui::SettingsTableView&, const ui::TableChanges&) override { isUpToDate_ = false; }
    void focusChanged() override { isUpToDate_ = false; }
    void alertPresented(ui::AlertController&, ui::Animated) override { isUpToDate_ = false; }
    void alertChanged(ui::AlertController&) override { isUpToDate_ = false; }
    void alertDismissed(ui::AlertController&) override { isUpToDate_ = false; }

    void takeSignals() {
        if (wake_->takeStop()) {
            session_->leave();
            wake_->stop();
            wake_->takeContinued();
            session_->comeBack();
            isUpToDate_ = false;
        }
        if (wake_->takeContinued()) {
            session_->leave();
            session_->comeBack();
            isUpToDate_ = false;
        }
        if (wake_->takeResized()) {
            session_->resize();
            isUpToDate_ = false;
        }
    }

    /// Takes all keys that were pressed. Returns whether the condition came to hold; later keys then wait.
    bool takeKeys(const std::function<bool()>& condition) {
        while (!isLost_) {
            Input input = session_->read();
            if (input.kind == Input::Kind::lost) loseTerminal();
            if (input.kind == Input::Kind::lost || input.kind == Input::Kind::none) break;
            emptyReads_ = 0;
            press(input);
            queue_.runPending();
            if (condition()) return true;
        }
        return false;
    }

    void loseTerminal() {
        isLost_ = true;
        kill(getpid(), SIGHUP);
    }

    void press(const Input& input) {
        using Kind = Input::Kind;
        bool isInField = screen_.alert() && screen_.alert()->focusedTextField();
        switch (input.kind) {
            case Kind::up:
                return screen_.press(ui::Key::up);
            case Kind::down:
                return screen_.press(ui::Key::down);
            case Kind::left:
                return screen_.press(ui::Key::left);
            case Kind::right:
                return screen_.press(ui::Key::right);
            case Kind::pageUp:
                return pressOften(ui::Key::up, rowsPerPage(session_->rows()));
            case Kind::pageDown:
                return pressOften(ui::Key::down, rowsPerPage(session_->rows()));
            case Kind::home:
                return isInField ? screen_.press(ui::Key::home) : pressOften(ui::Key::up, allRows());
            case Kind::end:
                return isInField ? screen_.press(ui::Key::end) : pressOften(ui::Key::down, allRows());
            case Kind::erase:
                return screen_.press(ui::Key::backspace);
            case Kind::remove:
                return screen_.press(ui::Key::deleteForward);
            case Kind::character:
                return pressCharacter(input.character);
            default:
                return;
        }
    }

    void pressCharacter(char32_t c) {
        switch (c) {
            case U'\r':
            case U'\n':
                return screen_.press(ui::Key::select);
            case U'\t':
                return screen_.press(ui::Key::down);
            case kEscape:
                return screen_.press(ui::Key::back);
            case kDelete:
            case control('H'):
                return screen_.press(ui::Key::backspace);
            case control('D'):
                return screen_.press(ui::Key::deleteForward);
            case control('A'):
                return screen_.press(ui::Key::home);
            case control('E'):
                return screen_.press(ui::Key::end);
            case control('U'):
                screen_.clearText();
                return;
            case control('L'):
                session_->invalidate();
                isUpToDate_ = false;
                return;
            default:
                if (c >= U' ') screen_.typeText(ui::encodeUtf8(c));
        }
    }

    void pressOften(ui::Key key, int times) {
        if (screen_.alert()) times = 1;
        for (int i = 0; i < times; ++i) screen_.press(key);
    }

    int allRows() const {
        int rows = 0;
        if (const ui::SettingsTableView* table = screen_.table())
            for (int section = 0; section < table->numberOfSections(); ++section)
                rows += table->numberOfRows(section);
        return rows;
    }

    void drawIfNeeded() {
        if (isUpToDate_ || isLost_) return;
        screen_.layoutIfNeeded();
        session_->show(
            draw(screen_, session_->rows(), session_->columns(), session_->charset(), texts_, firstLine_));
        isUpToDate_ = true;
    }

    void wait(std::optional<Clock::time_point> end) {
        std::optional<Clock::time_point> until = queue_.nextDeadline();
        if (end && (!until || *end < *until)) until = end;
        int timeout = -1;
        if (until) {
            auto left = std::chrono::ceil<std::chrono::milliseconds>(*until - Clock::now()).count();
            timeout = static_cast<int>(std::clamp<long>(left, 0, 60L * 60 * 1000));
        }
        pollfd descriptors[] = {{wake_->descriptor(), POLLIN, 0}, {session_->descriptor(), POLLIN, 0}};
        int ready = poll(descriptors, isLost_ ? 1 : 2, timeout);
        // A terminal that is readable for ever and never gives a key is no longer ours.
        if (ready > 0 && descriptors[1].revents != 0 && !isLost_ && ++emptyReads_ > kMostEmptyReads)
            loseTerminal();
    }

    std::shared_ptr<Wake> wake_;
    std::unique_ptr<Session> session_;
    ui::Screen& screen_;
    MainQueue& queue_;
    Texts texts_;
    int firstLine_ = 0;
    int emptyReads_ = 0;
    bool isUpToDate_ = false;
    bool isLost_ = false;
};

TerminalScreen::Opened TerminalScreen::open(ui::Screen& screen, MainQueue& queue, Texts texts) {
    // Before the session: the drawing library leaves signals alone that somebody has taken already.
    auto wake = std::make_shared<Wake>();
    auto session = Session::open();
    if (auto* why = std::get_if<std::string>(&session)) return *why;
    auto loop =
        std::make_unique<Loop>(std::move(wake), std::move(std::get<std::unique_ptr<Session>>(session)),
                               screen, queue, std::move(texts));
    return std::unique_ptr<TerminalScreen>(new TerminalScreen(std::move(loop)));
}

TerminalScreen::TerminalScreen(std::unique_ptr<Loop> loop) : loop_(std::move(loop)) {}

TerminalScreen::~TerminalScreen() = default;

bool TerminalScreen::runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) {
    return loop_->runUntil(condition, end);
}

bool TerminalScreen::takesKeys() const {
    return !loop_->isLost();
}

void TerminalScreen::restoreNow() {
    Guard::restoreNow();
}

}  // namespace wp::terminal
