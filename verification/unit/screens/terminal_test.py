#!/usr/bin/env python3
"""Looks at the terminal screen from outside, with a sample list on it.

terminal_test.py PROGRAM [TEST ...]
"""
import os
import shlex
import signal
import subprocess
import sys
import tempfile
import time
import unittest

from tmux_terminal import OVER, PATIENCE, WRAPPED, Terminal

PROGRAM = ""


class TerminalScreen(unittest.TestCase):
    maxDiff = None

    def start(self, script=None, names=None, **options):
        words = [PROGRAM]
        if names is not None:
            file = tempfile.NamedTemporaryFile()
            file.write(b"".join(name + b"\0" for name in names))
            file.flush()
            self.addCleanup(file.close)
            words.append(file.name)
        terminal = Terminal((script or "{program}; exec sleep 1000").format(program=shlex.join(words)), **options)
        self.addCleanup(terminal.close)
        return terminal

    def testShowsTheListInThePlacesOfItsCells(self):
        terminal = self.start(names=["東京ネット".encode(), "cafe\u0301 x".encode(), "\U0001F600 home".encode()])
        terminal.waitFor("Esc Back")
        self.assertEqual(terminal.picture().rstrip("\n"), """\
      Wi-Fi Diagnostics

      Choose the network to look at. What is measured stays on this device until you hand it
      on.

      ┌──────────────────────────────────────────────────────────────────────────────────────┐
      │ Selected network                                                                     │
      │ ▸ Home                                                                               │
      │                                                                                      │
      │ Choose a network                                                                     │
      │   東京ネット                                                                         │
      │   cafe\u0301 x                                                                             │
      │   \U0001F600 home                                                                            │
      │   Other ...                                                                          │
      │   Refresh                                                                            │
""" + "      │" + " " * 86 + "│\n" + ("      │" + " " * 86 + "│\n") * 12 + "      └" + "─" * 86 + """┘
      ↑↓ Move   Enter Select   Esc Back""")

    def testMovesTheFocusWithTheArrows(self):
        terminal = self.start()
        terminal.waitFor("▸ Home")
        terminal.press("Down", "Down")
        terminal.waitFor("▸ Office")
        terminal.press("Up")
        terminal.waitFor("▸ Café")
        terminal.press("End")
        terminal.waitFor("▸ Refresh")
        terminal.press("Home")
        terminal.waitFor("▸ Home")

    def testShowsTheFocusReversedOnATerminalWithoutColours(self):
        terminal = self.start(environment={"TERM": "vt100"})
        terminal.waitFor("▸ Home")
        line = next(line for line in terminal.picture("-e").splitlines() if "Home" in line)
        self.assertIn("\x1b[1m\x1b[7m", line.replace("\x1b[1;7m", "\x1b[1m\x1b[7m"))
        self.assertNotIn("\x1b[3", line.replace("\x1b[39m", ""))

    def testScrollsALongListWithItsFocus(self):
        terminal = self.start(names=[b"Network %03d" % number for number in range(200)])
        terminal.waitFor("▸ Home")
        terminal.press("NPage")
        terminal.waitFor("▸ Network 018")
        terminal.press("End")
        picture = terminal.waitFor("▸ Refresh")
        self.assertIn("Network 199", picture)
        self.assertNotIn("Selected network", picture)
        terminal.press("PPage")
        terminal.waitFor("▸ Network 182")

    def testTypesEditsAndTakesAName(self):
        terminal = self.start()
        terminal.waitFor("▸ Home")
        terminal.press("End", "Up", "Enter")
        terminal.waitFor("› Network name")
        terminal.type("東京x e")
        terminal.waitFor("› 東京x e")
        terminal.waitForState("#{cursor_flag}", "1")
        terminal.press("BSpace", "Home", "DC")
        terminal.waitFor("› 京x ")
        terminal.press("Left", "Right", "Right")
        terminal.type("Ü")
        terminal.waitFor("› 京xÜ ")
        terminal.press("Down", "Right", "Enter")
        terminal.waitFor("  京xÜ")
        terminal.waitForState("#{cursor_flag}", "0")

    def testLeavesAnAlertAndThenTheListByEsc(self):
        terminal = self.start(WRAPPED)
        terminal.waitFor("▸ Home")
        terminal.press("Enter")
        terminal.waitFor("▸[ Yes ]")
        terminal.press("Escape")
        terminal.waitFor(lambda picture: "[ Yes ]" not in picture)
        terminal.press("Escape")
        self.assertEqual(terminal.waitForFile("status"), "3")

    def testTakesEscAndAnArrowPressedTogetherForTwoKeys(self):
        terminal = self.start()
        terminal.waitFor("▸ Home")
        terminal.press("Enter")
        terminal.waitFor("▸[ Yes ]")
        terminal.press("Escape", "Down")
        terminal.waitFor(lambda picture: "[ Yes ]" not in picture)

    def testShowsTheBarWithItsCount(self):
        terminal = self.start()
        terminal.waitFor("▸ Home")
        terminal.press("Enter", "Enter")
        terminal.waitFor("[█████████████████░", "] 4/11", "▹ Home", "Looking at the network ...")

    def testLetsNothingOfANameReachTheTerminal(self):
        names = [b"\x1b]0;owned\x07", b"\x1b[2J", b"\x9b2J", "\u009b2J".encode(), b"a\rb", b"a\bb",
                 b"\x1b]52;c;aGFja2Vk\x07", b"\xff" * 32, b"%n%s", b'"><script>', b"$(reboot)",
                 "\u202eevil".encode(), "\u2066\u200f\u200b".encode(), "\U000e0041".encode(),
                 "\u2028".encode(), b"\x1bP1$r\x1b\\", b"\x0e\x0f", b"a\nb", b"\x1b[?1049l"]
        script = "while [ ! -e go ]; do sleep 0.01; done; {program}; exec sleep 1000"
        terminal = self.start(script, names=names, rows=40)
        title = terminal.state("#{pane_title}")
        terminal.tmux("pipe-pane", "-o", "cat > " + shlex.quote(str(terminal.path("sent"))))
        terminal.path("go").touch()
        picture = terminal.waitFor("Refresh", "Esc Back")

        for shown in ["\\x1B]0;owned\\x07", "  \\x1B[2J", "  \\x9B2J", "a\\x0Db", "a\\x08b",
                      "\\x1B]52;c;aGFja2Vk\\x07", "\\xFF" * 20, "  %n%s", '  "><script>', "  $(reboot)",
                      "\\u{202E}evil", "\\u{2066}\\u{200F}\\u{200B}", "\\u{E0041}", "\\u{2028}",
                      "\\x1BP1$r\\x1B\\", "\\x0E\\x0F", "a\\x0Ab", "\\x1B[?1049l"]:
            self.assertIn(shown, picture)
        self.assertIn("Wi-Fi Diagnostics", picture)
        for row in picture.splitlines()[6:38]:
            self.assertEqual(row[6], "│")
            self.assertEqual(row[93], "│")
        self.assertEqual(terminal.state("#{pane_title}"), title)
        self.assertEqual(terminal.state("#{alternate_on}"), "1")
        self.assertEqual(terminal.tmux("list-buffers"), "")
        for _ in names:
            terminal.press("Down", "Enter")
            terminal.waitFor("▸[ Yes ]")
            terminal.press("Escape")
            terminal.waitFor(lambda text: "[ Yes ]" not in text)
        sent = terminal.waitFor(lambda data: b"Refresh" in data, get=lambda: terminal.path("sent").read_bytes())
        for forbidden in [b"\x1b]", b"\x9b2J", b"\xc2\x9b", b"\x1bP", b"\xe2\x80\xae", b"\xff", b"\x0e"]:
            self.assertNotIn(forbidden, sent)

    def testAsksForALargerWindowAndDrawsAnewInOne(self):
        terminal = self.start()
        terminal.waitFor("▸ Home")
        terminal.press("Down")
        terminal.resize(59, 30)
        picture = terminal.waitFor("Please make this window larger: at least 60 by 16.")
        self.assertEqual(picture.strip().count("\n"), 0)
        terminal.resize(100, 15)
        terminal.waitFor(lambda text: "larger" in text and "Café" not in text)
        terminal.resize(60, 16)
        terminal.waitFor("▸ Café")
        terminal.resize(160, 50)
        terminal.waitFor("─" * 86, lambda text: "".join(text.splitlines()[49:]).strip().startswith("↑↓ Move"))
        terminal.resize(20, 3)
        terminal.waitFor("Please make this", "window larger: at", "least 60 by 16.")

    def testNeedsOnlyAsciiWhereTheTerminalHasNoMore(self):
        terminal = self.start(environment={"LC_ALL": "C"}, names=["Café".encode()])
        picture = terminal.waitFor("> Home", "Caf\\u{00E9}", "Esc Back")
        self.assertTrue(picture.isascii())

    def assertRestored(self, terminal):
        terminal.waitFor(OVER)
        self.assertEqual(terminal.waitForFile("after"), terminal.waitForFile("before"))
        self.assertEqual(terminal.state("#{alternate_on} #{cursor_flag} #{keypad_flag}"), "0 1 0")
        self.assertNotIn("Home", terminal.picture())

    def testGivesTheTerminalBackAtItsEnd(self):
        terminal = self.start(WRAPPED)
        terminal.waitFor("▸ Home")
        terminal.press("Escape")
        self.assertRestored(terminal)
        self.assertEqual(terminal.waitForFile("status"), "3")
        self.assertIn("left\n", terminal.picture())

    def testGivesTheTerminalBackWhenItIsKilled(self):
        for number in [signal.SIGTERM, signal.SIGHUP, signal.SIGINT, signal.SIGQUIT, signal.SIGABRT]:
            with self.subTest(signal=number.name):
                terminal = self.start(WRAPPED)
                terminal.waitFor("▸ Home")
                os.kill(terminal.child(), number)
                self.assertEqual(terminal.waitForFile("status"), str(128 + number))
                self.assertRestored(terminal)

    def testGivesTheTerminalBackWhenItIsInterruptedByAKey(self):
        terminal = self.start("trap : INT; " + WRAPPED)
        terminal.waitFor("▸ Home")
        terminal.press("C-c")
        self.assertEqual(terminal.waitForFile("status"), "130")
        self.assertRestored(terminal)

    def testGivesTheTerminalBackWhileItIsSuspendedAndDrawsAnewAfterwards(self):
        terminal = self.start("export PS1='ready> ' PROGRAM={program}; exec sh -i")
        terminal.waitFor("ready>")
        terminal.type("stty -g > before; $PROGRAM; stty -g > after; echo a''fter\n")
        terminal.waitFor("▸ Home")
        terminal.press("Down")
        terminal.waitFor("▸ Café")
        terminal.press("C-z")
        terminal.waitFor("Stopped")
        self.assertEqual(terminal.state("#{alternate_on} #{cursor_flag}"), "0 1")
        terminal.type("fg\n")
        terminal.waitFor("▸ Café")
        terminal.press("Down")
        terminal.waitFor("▸ Office")
        terminal.press("Escape")
        terminal.waitFor("left\n")
        terminal.type("stty -g > after; echo end > done\n")
        terminal.waitForFile("done")
        self.assertEqual(terminal.waitForFile("after"), terminal.waitForFile("before"))

    def testEndsWithItsTerminal(self):
        terminal = self.start("exec {program}")
        terminal.waitFor("▸ Home")
        program = int(terminal.state("#{pane_pid}"))
        terminal.tmux("kill-pane")
        end = time.monotonic() + PATIENCE
        while os.path.exists(f"/proc/{program}"):
            self.assertLess(time.monotonic(), end, "still there")
            time.sleep(0.01)

    def refusal(self, environment):
        terminal = self.start("{program} 2> message; echo $? > status; exec sleep 1000", environment=environment)
        self.assertEqual(terminal.waitForFile("status"), "2")
        return terminal.path("message").read_text()

    def testSaysWhyATerminalCannotCarryAScreen(self):
        self.assertEqual(self.refusal({"TERM": "dumb"}),
                         'a terminal "dumb" (TERM) cannot place text on its screen\n')
        self.assertEqual(self.refusal({"TERM": ""}), "TERM is not set, so nothing is known of the terminal\n")
        self.assertEqual(self.refusal({"TERM": "no-such"}), 'nothing is known of a terminal "no-such" (TERM)\n')

    def testSaysThatThereIsNoTerminal(self):
        run = subprocess.run([PROGRAM], stdin=subprocess.DEVNULL, stdout=subprocess.PIPE, stderr=subprocess.PIPE,
                             start_new_session=True, check=False)
        self.assertEqual(run.returncode, 2)
        self.assertEqual(run.stdout, b"")
        self.assertTrue(run.stderr.startswith(b"there is no terminal to draw on (/dev/tty: "), run.stderr)


if __name__ == "__main__":
    PROGRAM = os.path.abspath(sys.argv.pop(1))
    unittest.main()
