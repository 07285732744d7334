"""Runs scenarios inside the lab's machine: several share one start of it, two machines run side by side."""

import os
import subprocess
from concurrent.futures import ThreadPoolExecutor
from dataclasses import dataclass
from pathlib import Path
from typing import Callable

from . import script
from .description import Scenario

LAB = Path(__file__).resolve().parent.parent
# How many scenarios share one start of the machine: a start takes about two seconds, and a machine that
# hangs or falls takes the rest of its share with it.
SHARE = 8


def kind(asked: str | None) -> str:
    """Which machine run-in-lab takes."""
    cache = Path(os.environ.get("LAB_CACHE", LAB / ".cache"))
    return asked or ("uml" if os.access(cache / "uml" / "linux", os.X_OK) else "qemu")


@dataclass(frozen=True)
class Outcome:
    setup: str  # what the set-up printed
    exit: int | None  # the program's exit status; None: it never ended
    result: str
    log: str
    air: str


def _read(path: Path) -> str:
    return path.read_text(encoding="utf-8", errors="surrogateescape") if path.exists() else ""


def _outcome(folder: Path, scenario: Scenario) -> Outcome:
    part = {kind: _read(folder / f"{scenario.name}.{kind}") for kind in ("setup", "exit", "json", "log", "air")}
    return Outcome(part["setup"], int(part["exit"]) if part["exit"].strip() else None, part["json"], part["log"], part["air"])


def _start(folder: Path, share: list[Scenario], machine: str | None) -> None:
    names = [str(folder / f"{scenario.name}") for scenario in share]
    limit = 60 + 150 * len(share)
    command = [LAB / "run-in-lab", "-r", "0", "-t", str(limit), "-w", folder, "-k", folder / f"kernel-{share[0].name}.log"]
    if share[0].headers.get("time", "simulated") == "simulated" and machine != "qemu":
        command.append("-T")
    if machine:
        command += ["-b", machine]
    ended = subprocess.run([*command, LAB / "inside-scenarios", *names], capture_output=True, text=True, check=False)
    if ended.returncode:
        for scenario in share:
            with (folder / f"{scenario.name}.setup").open("a", encoding="utf-8") as notes:
                notes.write(f"the machine ended with {ended.returncode}\n{ended.stdout[-2000:]}{ended.stderr[-2000:]}")


def _shares(scenarios: list[Scenario], jobs: int) -> list[list[Scenario]]:
    """Scenarios of one kind of time together, spread evenly over the machines."""
    shares = []
    for time in ("simulated", "real"):
        kind = [s for s in scenarios if s.headers.get("time", "simulated") == time]
        count = max(min(jobs, len(kind)), -(-len(kind) // SHARE))
        shares += [kind[i::count] for i in range(count)]
    return [share for share in shares if share]


def run_all(
    scenarios: list[Scenario], folder: Path, action: Callable[[Scenario, str], str], jobs: int, machine: str | None
) -> dict[str, Outcome]:
    """Sets each scenario up, does `action` (bash, from the scenario and its output prefix) and returns what came of it."""
    for scenario in scenarios:
        out = folder / scenario.name
        (folder / f"{scenario.name}.sh").write_text(script.set_up(scenario) + action(scenario, str(out)), encoding="utf-8")
    with ThreadPoolExecutor(jobs) as pool:
        list(pool.map(lambda share: _start(folder, share, machine), _shares(scenarios, jobs)))
    return {scenario.name: _outcome(folder, scenario) for scenario in scenarios}
