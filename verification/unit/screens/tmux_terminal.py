"""A terminal for tests: a program in it, keys in, picture out."""
import os
import pathlib
import re
import shlex
import subprocess
import tempfile
import time

# Only a failure takes as long.
PATIENCE = 30

# What ends a terminal and clears up after it, once whoever holds the other end of its standard input has gone.
KEEPER = 'read -r line; tmux -S "$0/socket" kill-server 2> /dev/null; rm -rf "$0"'


def holds(found, wanted):
    if callable(wanted):
        return wanted(found)
    return wanted.search(found) if isinstance(wanted, re.Pattern) else wanted in found


class Terminal:
    """A terminal with a shell script in it; gone with the test, even one that is killed, and everything in it."""

    def __init__(self, script, columns=100, rows=30, environment=None):
        self.directory = tempfile.mkdtemp()
        self.socket = os.path.join(self.directory, "socket")
        # A process of nobody's: what kills the test with all its children does not reach it.
        self.keeper = subprocess.Popen(["setsid", "--fork", "sh", "-c", KEEPER, self.directory],
                                       stdin=subprocess.PIPE, stdout=subprocess.PIPE)
        variables = {"LC_ALL": "C.UTF-8", **(environment or {})}
        exports = "".join(f"export {name}={shlex.quote(value)}; " for name, value in variables.items())
        self.tmux("-f", "/dev/null", "new-session", "-d", "-x", str(columns), "-y", str(rows),
                  "cd " + shlex.quote(self.directory) + "; " + exports + script)

    def tmux(self, *words):
        run = subprocess.run(["tmux", "-u", "-S", self.socket, *words], stdout=subprocess.PIPE,
                             stderr=subprocess.PIPE, check=False)
        if run.returncode != 0:
            raise AssertionError(f"tmux {words}: {run.stderr.decode()}")
        return run.stdout.decode()

    def press(self, *keys):
        self.tmux("send-keys", *keys)

    def type(self, text):
        self.tmux("send-keys", "-l", text)

    def picture(self, *options):
        return self.tmux("capture-pane", "-p", *options)

    def state(self, form):
        return self.tmux("display-message", "-p", form).strip()

    def resize(self, columns, rows):
        self.tmux("resize-window", "-x", str(columns), "-y", str(rows))

    def path(self, name):
        return pathlib.Path(self.directory, name)

    def waitFor(self, *wanted, get=None):
        """Waits for a picture (or what `get` returns) that holds each text, matches each pattern and fulfils each function.

        A picture may be taken in the middle of being drawn: only what was waited for is sure to be in it, and what
        stands above that.
        """
        get = get or self.picture
        end = time.monotonic() + PATIENCE
        while True:
            found = get()
            missing = [each for each in wanted if not holds(found, each)]
            if not missing:
                return found
            if time.monotonic() > end:
                raise AssertionError(f"waited in vain for {missing}; last seen:\n{found}")
            time.sleep(0.01)

    def waitForState(self, form, value):
        self.waitFor(lambda state: state == value, get=lambda: self.state(form))

    def waitForFile(self, name, end="\n"):
        """The content of a file that somebody else writes, once it has its end."""
        def content():
            return self.path(name).read_text() if self.path(name).exists() else ""
        return self.waitFor(lambda text: text.endswith(end), get=content).strip()

    def close(self):
        self.keeper.communicate()

    def child(self):
        """The program that the terminal's shell runs."""
        shell = self.state("#{pane_pid}")
        children = self.waitFor(lambda text: text != "", get=lambda: pathlib.Path(
            f"/proc/{shell}/task/{shell}/children").read_text().strip())
        return int(children.split()[0])


# What the shell says once the program is gone: no program says it.
OVER = "the shell again"
# Leaves behind the terminal's modes before and after, the exit status, and a shell that waits.
WRAPPED = f"stty -g > before; {{program}}; echo $? > status; stty -g > after; echo {OVER}; exec sleep 1000"
