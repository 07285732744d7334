#include "host/diagnostics_log.h"

#include <unistd.h>

#include <cerrno>
#include <cstdio>

#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

bool isControl(char32_t number) {
    return number < 0x20 || (number >= 0x7F && number <= 0x9F);
}

std::string visible(char32_t number) {
    char text[16];
    std::snprintf(text, sizeof text, "\\x%02x", static_cast<unsigned>(number));
    return text;
}

}  // namespace

std::string withVisibleControls(std::string_view text) {
    std::string result;
    result.reserve(text.size());
    while (!text.empty()) {
        ui::Utf8Character first = ui::takeCharacter(text);
        if (!first.value) {
            result += visible(static_cast<unsigned char>(first.bytes[0]));
        } else if (isControl(*first.value)) {
            result += visible(*first.value);
        } else {
            result += first.bytes;
        }
    }
    return result;
}

DiagnosticsLog::~DiagnosticsLog() {
    release();
    eraseProgress();
}

bool DiagnosticsLog::isErrorEnabled(int) const {
    std::lock_guard lock(mutex_);
    return !isMuted_;
}

void DiagnosticsLog::error(int category, std::string_view message) {
    std::lock_guard lock(mutex_);
    if (isMuted_) return;
    writeLine("error[" + std::to_string(category) + "] " + withVisibleControls(message) + "\n");
}

void DiagnosticsLog::note(std::string_view text) {
    std::lock_guard lock(mutex_);
    writeLine("note: " + withVisibleControls(text) + "\n");
}

void DiagnosticsLog::message(std::string_view text) {
    std::lock_guard lock(mutex_);
    writeLine("wifi-profile: " + withVisibleControls(text) + "\n");
}

void DiagnosticsLog::showProgress(std::string_view text) {
    std::lock_guard lock(mutex_);
    if (progress_ == Progress::hidden || isHeld_ || isMuted_) return;
    // No wrap at the right margin: a line that wrapped could not be erased with one carriage return.
    write("\r\x1b[K\x1b[?7l" + withVisibleControls(text) + "\x1b[?7h");
    isProgressVisible_ = true;
}

void DiagnosticsLog::eraseProgress() {
    std::lock_guard lock(mutex_);
    erase();
}

void DiagnosticsLog::hold() {
    std::lock_guard lock(mutex_);
    erase();
    isHeld_ = true;
}

void DiagnosticsLog::release() {
    std::lock_guard lock(mutex_);
    isHeld_ = false;
    for (const std::string& line : held_) write(line);
    held_.clear();
}

void DiagnosticsLog::mute() {
    std::lock_guard lock(mutex_);
    isMuted_ = true;
}

void DiagnosticsLog::writeLine(const std::string& line) {
    if (isHeld_) {
        held_.push_back(line);
        return;
    }
    erase();
    write(line);
}

void DiagnosticsLog::erase() {
    if (isProgressVisible_) write("\r\x1b[K");
    isProgressVisible_ = false;
}

void DiagnosticsLog::write(const std::string& text) {
    std::size_t done = 0;
    while (done < text.size()) {
        ssize_t count = ::write(descriptor_, text.data() + done, text.size() - done);
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return;  // a closed standard error cannot be told about
        done += static_cast<std::size_t>(count);
    }
}

}  // namespace wp::host
