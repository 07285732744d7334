"""A terminal for tests: a program in it, keys in, picture out."""
import os
import pathlib
import shlex
import subprocess
import tempfile
import time

# Only a failure takes as long.
PATIENCE = 30


class Terminal:
    """A terminal with a shell script in it; gone with the test, and everything in it."""

    def __init__(self, script, columns=100, rows=30, environment=None):
        self.directory = tempfile.TemporaryDirectory()
        self.socket = os.path.join(self.directory.name, "socket")
        variables = {"LC_ALL": "C.UTF-8", **(environment or {})}
        exports = "".join(f"export {name}={shlex.quote(value)}; " for name, value in variables.items())
        self.tmux("-f", "/dev/null", "new-session", "-d", "-x", str(columns), "-y", str(rows),
                  "cd " + shlex.quote(self.directory.name) + "; " + exports + script)

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
        return pathlib.Path(self.directory.name, name)

    def waitFor(self, what, get=None):
        """Waits until the picture (or what `get` returns) holds the text or fulfils the function."""
        get = get or self.picture
        end = time.monotonic() + PATIENCE
        while True:
            found = get()
            if what(found) if callable(what) else what in found:
                return found
            if time.monotonic() > end:
                raise AssertionError(f"waited in vain for {what!r}; last seen:\n{found}")
            time.sleep(0.01)

    def waitForFile(self, name):
        def content():
            return self.path(name).read_text() if self.path(name).exists() else ""
        return self.waitFor(lambda text: text.endswith("\n"), content).strip()

    def close(self):
        subprocess.run(["tmux", "-S", self.socket, "kill-server"], stderr=subprocess.DEVNULL, check=False)
        self.directory.cleanup()

    def child(self):
        """The program that the terminal's shell runs."""
        shell = self.state("#{pane_pid}")
        children = self.waitFor(lambda text: text != "", lambda: pathlib.Path(
            f"/proc/{shell}/task/{shell}/children").read_text().strip())
        return int(children.split()[0])


# Leaves behind the terminal's modes before and after, the exit status, and a shell that waits.
WRAPPED = "stty -g > before; {program}; echo $? > status; stty -g > after; echo finished; exec sleep 1000"
