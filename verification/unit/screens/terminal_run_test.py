#!/usr/bin/env python3
"""Looks at whole runs on the terminal from outside: the program on a recording, keys in, picture out.

terminal_run_test.py PROGRAM [TEST ...]
"""
import json
import os
import re
import shlex
import signal
import sys
import unittest

from tmux_terminal import OVER, WRAPPED, Terminal

PROGRAM = ""

HOSTILE = "\x1b]0;owned\x07\x1b[2J\u009b2J\u202e%n"


def scan(*names):
    return {"test": 31, "didPass": True, "info": {"ScanResults": [
        {"ssid": name, "bssid": f"02:00:00:00:00:{number:02x}", "rssi": -40 - number}
        for number, name in enumerate(names, 1)]}}


def recording(**keys):
    """Joined to Northlight; a test of Bluetooth that takes as long as the run is looked at."""
    return {"format": "wifi-profile-recording", "version": 1,
            "status": [{"ssid": "Northlight", "bssid": "02:00:00:00:00:01"}],
            "answers": [scan("Northlight", "東京ネット", HOSTILE, "Café"),
                        {"test": 19, "didPass": True, "delayMs": 3600000}], **keys}


# A joined network that works and has a weak signal; every test is answered at once.
QUICK = {**recording(), "answers": [
    {"test": test, "didPass": True, "result": True} for test in [6, 9, 11, 32]]}


class TerminalRun(unittest.TestCase):
    def start(self, answers=None, options="--list", script=WRAPPED, output="> result", **more):
        terminal = Terminal("while [ ! -e go ]; do sleep 0.01; done; " + script.format(
            program=f"{shlex.quote(PROGRAM)} run --locale en_GB --replay recording {options} {output}"), **more)
        self.addCleanup(terminal.close)
        terminal.path("recording").write_text(json.dumps(answers or recording()))
        terminal.path("go").touch()
        return terminal

    def assertRestored(self, terminal):
        terminal.waitFor(OVER)
        self.assertEqual(terminal.waitForFile("after"), terminal.waitForFile("before"))
        self.assertEqual(terminal.state("#{alternate_on} #{cursor_flag}"), "0 1")

    def testPicksANetworkWatchesTheBarAndLeaves(self):
        terminal = self.start()
        terminal.waitFor("  東京ネット")
        terminal.press("Down", "Down")
        terminal.waitFor("▸ Café")
        terminal.press("Enter")
        terminal.waitFor("“Café”")
        terminal.press("Enter")
        # Five device tests are done, the sixth takes its time; 11 + 29 + 16 tests in all.
        terminal.waitFor("] 5/56")
        terminal.waitFor("▹ Café")
        terminal.press("Escape")
        self.assertEqual(terminal.waitForFile("status"), "3")
        self.assertRestored(terminal)
        self.assertEqual(terminal.path("result").read_text(), "")

    def testPrintsTheResultBesideTheScreenAndTheLogAfterIt(self):
        answers = recording()
        del answers["answers"][1]
        terminal = self.start(answers)
        terminal.waitFor("▸ Northlight")
        terminal.press("Enter")
        terminal.waitFor("▸[ Yes ]")
        terminal.press("Enter")
        terminal.waitFor("The test is finished")
        # Whoever reads the result does not wait for the viewer.
        self.assertEqual(json.loads(terminal.waitForFile("result", end="\n}\n"))["statusCode"], 0)
        terminal.press("Enter")
        self.assertEqual(terminal.waitForFile("status"), "0")
        self.assertRestored(terminal)
        self.assertIn("error[3] [ERROR] - Wi-Fi Profile: Poor Signal failed", terminal.picture())

    def testTestsAHiddenNetworkByItsTypedName(self):
        terminal = self.start()
        terminal.waitFor("  東京ネット")
        terminal.press("End", "Up", "Enter")
        terminal.waitFor("Done")
        terminal.type("versteckt ü東")
        terminal.waitFor("› versteckt ü東")
        terminal.press("Down", "Right", "Enter")
        terminal.waitFor("  versteckt ü東")
        terminal.press("Home", "Enter")
        terminal.waitFor("“versteckt ü東”")

    def testShowsAHostileNameHarmlessly(self):
        terminal = self.start()
        title = terminal.state("#{pane_title}")
        shown = "\\x1B]0;owned\\x07\\x1B[2J\\x9B2J\\u{202E}%n"
        terminal.waitFor("  " + shown)
        terminal.press("Down", "Enter")
        picture = terminal.waitFor("“" + shown)
        self.assertIn("Wi-Fi Diagnostics", picture)
        self.assertEqual(terminal.state("#{pane_title}"), title)

    def testSaysThatTheWiFiWentOffByItsStatus(self):
        terminal = self.start(recording(events=[{"afterMs": 50, "power": False}]))
        terminal.waitFor("The test is finished")
        terminal.press("Escape")
        self.assertEqual(terminal.waitForFile("status"), "15")
        self.assertRestored(terminal)

    def testGivesTheTerminalBackWhenItIsBrokenOff(self):
        for number in [signal.SIGTERM, signal.SIGINT, signal.SIGHUP]:
            with self.subTest(signal=number.name):
                terminal = self.start()
                terminal.waitFor("▸ Northlight")
                os.kill(terminal.child(), number)
                self.assertEqual(terminal.waitForFile("status"), str(128 + number))
                self.assertRestored(terminal)
                self.assertEqual(terminal.path("result").read_text(), "")

    def testEndsByTheInterruptKeyInTheMiddleOfATest(self):
        terminal = self.start(script="trap : INT; " + WRAPPED)
        terminal.waitFor("▸ Northlight")
        terminal.press("Enter", "Enter")
        terminal.waitFor("] 5/40")
        terminal.press("C-c")
        self.assertEqual(terminal.waitForFile("status"), "130")
        self.assertRestored(terminal)

    def testPlaysAScriptOnTheTerminalAndLeavesTheRestToTheViewer(self):
        terminal = self.start(options="--list --remote 'wait down screen' --transcript lines")
        terminal.waitFor("▸ \\x1B]0")
        terminal.press("Up")
        terminal.waitFor("▸ Northlight")
        self.assertEqual(len(terminal.path("lines").read_text().splitlines()), 1)
        terminal.press("Escape")
        self.assertEqual(terminal.waitForFile("status"), "3")

    def testShowsTheOutcomeUntilItIsClosed(self):
        for key in ["Enter", "Escape"]:
            with self.subTest(key=key):
                terminal = self.start(QUICK, "--screen terminal")
                terminal.waitFor("The test is finished", "works, but one thing makes it slow",
                                 "Problem: Network “Northlight”", "The signal is weak.",
                                 re.compile("Close with OK or Back, or wait [1-9][05]? seconds."))
                terminal.press("Down", "Up", key)
                self.assertEqual(terminal.waitForFile("status"), "0")
                self.assertRestored(terminal)

    def testPrintsTheResultOnTheTerminalWhenThePageIsClosed(self):
        terminal = self.start(QUICK, "--screen terminal --format text --record copy", output="")
        terminal.waitFor("The test is finished")
        self.assertTrue(terminal.path("copy").exists())
        terminal.press("Enter")
        self.assertEqual(terminal.waitForFile("status"), "0")
        self.assertIn("The signal is weak.", terminal.waitFor(OVER))

    def testPrintsTheResultThoughAnotherFileCannotBeWritten(self):
        terminal = self.start(QUICK, "--screen terminal --format text --automation /dev/full", output="")
        terminal.waitFor("The test is finished")
        terminal.press("Enter")
        self.assertEqual(terminal.waitForFile("status"), "1")
        self.assertRestored(terminal)
        picture = terminal.picture("-S", "-200")
        self.assertIn("The signal is weak.", picture)
        self.assertIn("--automation: /dev/full: not written: No space left on device", picture)

    def testKeepsTheResultThatASignalFindsOnTheClosingPage(self):
        terminal = self.start(QUICK, "--screen terminal", output="")
        terminal.waitFor("The test is finished")
        os.kill(terminal.child(), signal.SIGTERM)
        self.assertEqual(terminal.waitForFile("status"), "0")
        self.assertRestored(terminal)
        self.assertIn('"statusCode":0', terminal.picture("-S", "-200").replace(" ", "").replace("\n", ""))

    def testShowsNoClosingPageWithAScriptOrWhereItIsNotWanted(self):
        for options in ["--no-closing-page", "--remote wait"]:
            with self.subTest(options=options):
                terminal = self.start(QUICK, "--screen terminal " + options)
                self.assertEqual(terminal.waitForFile("status"), "0")
                self.assertRestored(terminal)

    def testSaysWithoutTheListWhichTestIsRunning(self):
        terminal = self.start(options="--screen terminal")
        picture = terminal.waitFor("Testing the Wi-Fi connection.", "Bluetooth devices connected (6 of 40)", "13 %")
        self.assertNotIn("Choose", picture)
        terminal.press("Escape")
        self.assertEqual(terminal.waitForFile("status"), "3")
        self.assertRestored(terminal)

    def testRefusesATerminalThatCannotDrawIt(self):
        terminal = self.start(script="{program} 2> message; echo $? > status; exec sleep 1000",
                              environment={"TERM": "dumb"}, options="--list --screen terminal")
        self.assertEqual(terminal.waitForFile("status"), "2")
        message = terminal.path("message").read_text()
        self.assertEqual(message.count("\n"), 1)
        self.assertIn('a terminal "dumb" (TERM) cannot place text on its screen', message)
        self.assertEqual(terminal.path("result").read_text(), "")


if __name__ == "__main__":
    PROGRAM = os.path.abspath(sys.argv.pop(1))
    unittest.main()
