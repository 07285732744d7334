#pragma once

#include <mutex>
#include <string>
#include <string_view>
#include <vector>

#include "platform/log.h"

namespace wp::host {

/// The text with what could steer a terminal made visible: control characters and bytes that are no UTF-8 as
/// `\xNN`, with the number of the character or byte. *Any*.
std::string withVisibleControls(std::string_view text);

/// Standard error: the diagnostic's log, the host's notes, and on a terminal one progress line, which is
/// erased before any other line. *Any* thread.
class DiagnosticsLog final : public Log {
  public:
    enum class Progress { shown, hidden };

    /// Progress is shown only where the descriptor is a terminal.
    DiagnosticsLog(int descriptor, Progress progress) : descriptor_(descriptor), progress_(progress) {}
    ~DiagnosticsLog() override;

    bool isErrorEnabled(int category) const override;
    /// `error[CATEGORY] MESSAGE`.
    void error(int category, std::string_view message) override;

    /// `note: TEXT`: something that the reader should know and that is no line of the diagnostic.
    void note(std::string_view text);
    /// `wifi-profile: TEXT`: why the program ends.
    void message(std::string_view text);

    void showProgress(std::string_view text);
    void eraseProgress();

    /// Keeps lines back while a screen is drawn on the same terminal.
    void hold();
    /// Writes what was kept back.
    void release();
    /// Drops all later lines of the diagnostic: nobody waits for a run that was broken off.
    void mute();

  private:
    void writeLine(const std::string& line);
    void write(const std::string& text);
    void erase();

    int descriptor_;
    Progress progress_;
    mutable std::mutex mutex_;
    bool isProgressVisible_ = false;
    bool isHeld_ = false;
    bool isMuted_ = false;
    std::vector<std::string> held_;
};

}  // namespace wp::host
