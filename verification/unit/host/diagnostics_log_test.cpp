#include "host/diagnostics_log.h"

#include <gtest/gtest.h>
#include <sys/mman.h>
#include <unistd.h>

namespace wp::host {
namespace {

/// A descriptor that keeps what is written to it.
class Written {
  public:
    Written() : descriptor_(memfd_create("log", MFD_CLOEXEC)) {}
    ~Written() { close(descriptor_); }
    int descriptor() const { return descriptor_; }
    std::string text() const {
        std::string text(static_cast<std::size_t>(lseek(descriptor_, 0, SEEK_END)), '\0');
        EXPECT_EQ(pread(descriptor_, text.data(), text.size(), 0), static_cast<ssize_t>(text.size()));
        return text;
    }

  private:
    int descriptor_;
};

TEST(DiagnosticsLog, AnErrorLineNamesItsCategory) {
    Written written;
    DiagnosticsLog log(written.descriptor(), DiagnosticsLog::Progress::hidden);

    log.error(3, "[ERROR] - Wi-Fi Profile: Results not found.");
    log.note("no permission to scan");
    log.message("--list: needs a screen");

    EXPECT_EQ(written.text(),
              "error[3] [ERROR] - Wi-Fi Profile: Results not found.\n"
              "note: no permission to scan\n"
              "wifi-profile: --list: needs a screen\n");
}

TEST(DiagnosticsLog, ControlCharactersAndBrokenUtf8CannotReachTheTerminal) {
    EXPECT_EQ(withVisibleControls("a\n\x1b[2J\x7f"), "a\\x0a\\x1b[2J\\x7f");
    EXPECT_EQ(withVisibleControls("\xc2\x9b"
                                  "31m"),
              "\\x9b31m");
    EXPECT_EQ(withVisibleControls("\xff\xc3("), "\\xff\\xc3(");
    EXPECT_EQ(withVisibleControls(std::string_view("\0", 1)), "\\x00");
    EXPECT_EQ(withVisibleControls("Größe 漢字 %n \\"), "Größe 漢字 %n \\");
}

TEST(DiagnosticsLog, TheProgressLineIsErasedBeforeEveryOtherLine) {
    Written written;
    DiagnosticsLog log(written.descriptor(), DiagnosticsLog::Progress::shown);

    log.showProgress("Ping LAN (27/40)");
    log.error(3, "x");
    log.showProgress("Ping WAN (28/40)");
    log.eraseProgress();
    log.eraseProgress();

    EXPECT_EQ(written.text(),
              "\r\x1b[K\x1b[?7lPing LAN (27/40)\x1b[?7h"
              "\r\x1b[K"
              "error[3] x\n"
              "\r\x1b[K\x1b[?7lPing WAN (28/40)\x1b[?7h"
              "\r\x1b[K");
}

TEST(DiagnosticsLog, NoProgressIsShownWhereNobodySeesIt) {
    Written written;
    DiagnosticsLog log(written.descriptor(), DiagnosticsLog::Progress::hidden);

    log.showProgress("Ping LAN (27/40)");
    log.eraseProgress();

    EXPECT_EQ(written.text(), "");
}

TEST(DiagnosticsLog, LinesAreKeptBackWhileAScreenIsDrawn) {
    Written written;
    DiagnosticsLog log(written.descriptor(), DiagnosticsLog::Progress::shown);

    log.hold();
    log.error(0, "one");
    log.note("two");
    log.showProgress("Ping LAN (27/40)");
    EXPECT_EQ(written.text(), "");
    log.release();

    EXPECT_EQ(written.text(), "error[0] one\nnote: two\n");
}

TEST(DiagnosticsLog, ABrokenOffRunSaysNothingMore) {
    Written written;
    DiagnosticsLog log(written.descriptor(), DiagnosticsLog::Progress::hidden);

    EXPECT_TRUE(log.isErrorEnabled(3));
    log.mute();
    log.error(3, "x");
    log.message("interrupted");

    EXPECT_FALSE(log.isErrorEnabled(3));
    EXPECT_EQ(written.text(), "wifi-profile: interrupted\n");
}

}  // namespace
}  // namespace wp::host
