#!/usr/bin/env python3
"""Checks who includes whom: each room may see only the rooms that it stands on.

Run from anywhere; prints one line for each include that breaks a rule and exits 1 if there is any.
"""
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parents[2]

# Room (a path prefix) -> prefixes that it may include besides its own. The most specific room counts.
MAY_INCLUDE = {
    "platform": [],
    "lifecycle": ["platform"],
    "tests": ["platform", "lifecycle"],
    "network_list": ["platform", "lifecycle"],
    "service": ["platform"],
    "exchange": ["platform"],
    "linux": ["platform", "service", "exchange/codec.h", "exchange/wire.h", "exchange/json_reader.h",
              "exchange/object_reader.h", "exchange/place.h", "exchange/descriptor.h"],
    "screens/remote": ["platform"],
    "screens/headless": ["platform", "screens/remote"],
    "screens/terminal": ["platform", "screens/remote"],
    "screens/tv": ["platform", "screens/remote"],
    "host": ["platform", "exchange", "screens"],
    "host/modules": [],
    "host/unicode": ["host/modules"],
    "host/report": ["platform", "exchange", "host/string_table.h", "host/unicode/unicode.h", "service/thresholds.h"],
}
STANDARD_LIBRARY_ONLY = {"platform", "lifecycle", "tests", "network_list", "service"}
INCLUDE = re.compile(r'^\s*#\s*include\s+(?:"([^"]+)"|<([^>]+)>)')


def room_of(path):
    rooms = [room for room in MAY_INCLUDE if path.startswith(room + "/")]
    return max(rooms, key=len, default=None)


def fault(room, quoted, angled):
    if quoted is not None:
        allowed = [room, *MAY_INCLUDE[room]]
        inside = any(quoted == name or quoted.startswith((name + "/", name + ".")) for name in allowed)
        return None if inside else f'"{quoted}" is not for {room}/'
    if room in STANDARD_LIBRARY_ONLY and ("/" in angled or "." in angled):
        return f"<{angled}>: {room}/ uses the standard library alone"
    return None


def main():
    faults, files = [], 0
    for room in MAY_INCLUDE:
        for path in sorted((ROOT / room).rglob("*")):
            name = path.relative_to(ROOT).as_posix()
            if path.suffix not in (".h", ".cpp") or room_of(name) != room:
                continue
            files += 1
            for number, line in enumerate(path.read_text(encoding="utf-8").splitlines(), 1):
                match = INCLUDE.match(line)
                why = fault(room, *match.groups()) if match else None
                if why:
                    faults.append(f"{name}:{number}: {why}")
    for line in faults:
        print(line)
    print(f"{files} files, {len(faults)} faults")
    return 1 if faults or files == 0 else 0


if __name__ == "__main__":
    sys.exit(main())
