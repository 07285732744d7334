"""What the programs of the lab need on the machine below it.

User-mode Linux counts no user time of its own. It runs the code of its programs as it is, in processes of the machine
below: one for each address space, children of the lab's kernel, which waits for each when its program has ended. The machine
below counts their user time, and adds it to the kernel's "children that have ended" (cutime in /proc/PID/stat).
"""

import os
import time
from pathlib import Path

BETWEEN_LOOKS_S = 0.02
TICK_S = 1 / os.sysconf("SC_CLK_TCK")


class Process:
    """A process of this machine, as /proc/PID/stat told it when it was looked at."""

    def __init__(self, folder: Path) -> None:
        name, _, after = (folder / "stat").read_text().rpartition(")")
        fields = after.split()
        self.number = int(folder.name)
        self.name = name.partition("(")[2]
        self.parent = int(fields[1])
        self.ended_children_user_s = int(fields[13]) * TICK_S


def processes() -> dict[int, Process]:
    found = {}
    for folder in Path("/proc").glob("[0-9]*"):
        try:
            found[int(folder.name)] = Process(folder)
        except (FileNotFoundError, ProcessLookupError):
            pass  # it ended meanwhile
    return found


def kernel_started_by(starter: int) -> Process | None:
    """The lab's kernel among the descendants of a process. It may have ended since."""
    all_of_them = processes()

    def descends(process: Process) -> bool:
        while process.number != starter and process.parent in all_of_them:
            process = all_of_them[process.parent]
        return process.number == starter

    for each in all_of_them.values():
        parent = all_of_them.get(each.parent)
        if each.name == "linux" and parent and parent.name != "linux" and descends(each):
            return each
    return None


class UserTime:
    """The user time of the lab's programs that ended between two marks: files that a script in the lab makes."""

    def __init__(self, marks: list[Path]) -> None:
        self.marks = marks
        self.seen: list[float] = []

    def look(self, starter: int) -> None:
        if len(self.seen) < len(self.marks) and self.marks[len(self.seen)].exists():
            kernel = kernel_started_by(starter)
            if kernel is not None:
                self.seen.append(kernel.ended_children_user_s)

    def watch(self, running) -> None:
        """Until the starter of the lab (a Popen) has ended; what an earlier one showed is forgotten."""
        self.seen = []
        while running.poll() is None:
            self.look(running.pid)
            time.sleep(BETWEEN_LOOKS_S)

    def between(self) -> list[float]:
        """Seconds of user time from each mark to the next; fewer where the lab ended before a mark was seen."""
        return [later - earlier for earlier, later in zip(self.seen, self.seen[1:])]
