"""Reads a scenario: a small text file that says what is on the air and what the program must say about it.

    # One line on what it shows.
    time simulated             header lines: see HEADERS
    [ap wlan1 10.0.0.1/24]     hostapd's lines; the address is optional and brings DHCP and DNS
    [station wlan0]            lines of one wpa_supplicant network block; waits until it has joined
    [shell]                    bash with lib.sh, at this place of the order
    [run]                      arguments of `wifi-profile run`
    [during]                   bash with screen.sh: the program runs on a terminal meanwhile, and its list is looked at
    [air]                      patterns that `iw scan dump -b` must show, to check the set-up itself
    [want]                     the truth, one value a line: see `wanted`
"""

import json
import re
import shlex
from dataclasses import dataclass, field
from pathlib import Path

from .catalogue import SECTIONS, test_of

# name: allowed values (None: anything)
HEADERS = {
    "time": ("simulated", "real"),  # simulated: waiting costs nothing, round trips take 0 ms
    "short": ("yes",),  # also runs in `make test`, on the machine without a kernel build
    "address": ("dhcp", "none"),  # whether the station asks for an address once it has joined
    "user": None,  # who runs the program (root)
    "radios": None,  # how many (as many as the set-up names)
    "country": None,  # the kernel's regulatory domain before the set-up (US)
    "hwsim": None,  # options of the simulated radios
    "machine": ("uml",),  # only the kernel that is built for the lab can show it
    "environment": None,  # NAME=VALUE for the program
}


class BadScenario(Exception):
    pass


@dataclass(frozen=True)
class Want:
    place: str  # "status", "section" or "section.key"
    kind: str  # "value", "range", "absent", "present", "empty"
    value: object = None  # for "absent": the service's error code, if it matters

    def __str__(self) -> str:
        if self.kind == "value":
            return json.dumps(self.value, ensure_ascii=False)
        if self.kind == "range":
            return f"{self.value[0]}..{self.value[1]}"
        if self.kind == "empty":
            return "{}"
        return self.kind if self.value is None else f"{self.kind} {self.value}"


@dataclass
class Scenario:
    name: str
    title: str
    headers: dict[str, str] = field(default_factory=dict)
    steps: list[tuple[str, list[str], list[str]]] = field(default_factory=list)  # (kind, arguments, lines)
    arguments: list[str] = field(default_factory=list)
    during: list[str] = field(default_factory=list)
    air: list[str] = field(default_factory=list)
    wants: list[Want] = field(default_factory=list)

    def radios(self) -> int:
        if "radios" in self.headers:
            return int(self.headers["radios"])
        numbers = [int(n) for _, words, _ in self.steps for word in words for n in re.findall(r"^wlan(\d+)$", word)]
        return max(numbers, default=0) + 1


def wanted(line: str) -> Want:
    """`status -6`, `current {}`, `current.security "Open"`, `current.RSSI -40..-20`,
    `selected.isHiddenNetwork absent 3` (cannot tell, with the service's error code 3), `current.noise present`."""
    place, _, text = line.partition(" ")
    text = text.strip()
    section, _, key = place.partition(".")
    if place != "status" and section not in SECTIONS:
        raise BadScenario(f"'{place}' is no place in the result")
    if key and not test_of(section, key):
        raise BadScenario(f"no test writes '{key}'")
    if not key and place != "status":
        if text != "{}":
            raise BadScenario(f"a whole section can only be wanted empty: {place} {{}}")
        return Want(place, "empty")
    if text == "present":
        return Want(place, "present")
    if absent := re.fullmatch(r"absent(?: (\d+))?", text):
        return Want(place, "absent", int(absent[1]) if absent[1] else None)
    if limits := re.fullmatch(r"(-?[\d.]+)\.\.(-?[\d.]+)", text):
        return Want(place, "range", (float(limits[1]), float(limits[2])))
    try:
        return Want(place, "value", json.loads(text))
    except json.JSONDecodeError:
        raise BadScenario(f"'{text}' is neither JSON nor a range, 'absent' or 'present'") from None


def _content(lines: list[str]) -> list[str]:
    return [line.strip() for line in lines if line.strip() and not line.lstrip().startswith("#")]


def read(path: Path) -> Scenario:
    lines = path.read_text(encoding="utf-8").splitlines()
    if not lines or not lines[0].startswith("# "):
        raise BadScenario(f"{path.name}:1: the first line must say what it shows, after '# '")
    scenario = Scenario(path.stem, lines[0][2:])
    kind, arguments, body, start = "", [], [], 1

    def end_section() -> None:
        try:
            _end_section(scenario, kind, arguments, body)
        except (BadScenario, ValueError) as problem:
            raise BadScenario(f"{path.name}:{start}: {problem}") from None

    for number, line in enumerate(lines[1:], 2):
        if match := re.fullmatch(r"\[(ap|station|shell|run|during|air|want)\b\s*(.*)\]", line):
            end_section()
            kind, arguments, body, start = match[1], match[2].split(), [], number
        else:
            body.append(line)
    end_section()
    if not scenario.wants:
        raise BadScenario(f"{path.name}: nothing is wanted")
    return scenario


def _end_section(scenario: Scenario, kind: str, arguments: list[str], body: list[str]) -> None:
    if kind == "":
        for line in _content(body):
            name, _, value = line.partition(" ")
            allowed = HEADERS.get(name, ())
            if allowed is not None and value not in allowed:
                raise BadScenario(f"'{line}': unknown header or value")
            scenario.headers[name] = value
    elif kind in ("ap", "station", "shell"):
        scenario.steps.append((kind, arguments, body))
    elif kind == "run":
        scenario.arguments = shlex.split(" ".join(_content(body)))
    elif kind == "during":
        scenario.during += body
    elif kind == "air":
        scenario.air += _content(body)
        for pattern in scenario.air:
            re.compile(pattern)
    else:
        scenario.wants += [wanted(line) for line in _content(body)]


def read_all(folder: Path) -> list[Scenario]:
    return [read(path) for path in sorted(folder.glob("*.scenario"))]
