#!/usr/bin/env python3
"""Checks that no two sources of a test program have a helper function of the same name.

They are compiled together, so that a call could take the other source's helper. Prints one line for each such name and
exits 1 if there is any.
"""
import collections
import pathlib
import re
import sys

VERIFICATION = pathlib.Path(__file__).resolve().parents[1]
PROGRAM = re.compile(r"^(wp_unit_test|add_executable)\((\w+)(.*?)\)$", re.MULTILINE | re.DOTALL)
TOGETHER = "set_target_properties({} PROPERTIES UNITY_BUILD ON"
SOURCE = re.compile(r"[\w./]+\.cpp")
# What begins at a line's start and has a type before its name, such as std::function<void()>; a test has none.
HELPER = re.compile(r"^(?!class |struct |using |namespace )[A-Za-z_](?:[^\n(=<]|<[^\n=]*?>)*[ &*](\w+)\(", re.MULTILINE)


def main():
    programs, faults = 0, []
    for listing in sorted([*VERIFICATION.glob("*/CMakeLists.txt"), *VERIFICATION.glob("unit/*/CMakeLists.txt")]):
        text = listing.read_text(encoding="utf-8")
        for kind, program, body in PROGRAM.findall(text):
            if kind == "add_executable" and TOGETHER.format(program) not in text:
                continue
            programs += 1
            sources = collections.defaultdict(set)
            for source in SOURCE.findall(body):
                for name in HELPER.findall((listing.parent / source).read_text(encoding="utf-8")):
                    sources[name].add(source)
            faults += [f"{program}: {name}() is in {' and in '.join(sorted(where))}"
                       for name, where in sorted(sources.items()) if len(where) > 1]
    print("\n".join([*faults, f"{programs} test programs, {len(faults)} faults"]))
    return 1 if faults or programs == 0 else 0


if __name__ == "__main__":
    sys.exit(main())
