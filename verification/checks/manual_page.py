#!/usr/bin/env python3
"""Checks the manual page: a linter finds nothing in it, and it has the options that the program's own help lists, with
the same values, and no others.

usage: manual_page.py PROGRAM
"""
import pathlib
import re
import subprocess
import sys

PAGE = pathlib.Path(__file__).resolve().parents[2] / "docs/wifi-profile.1"
# An option at the beginning of a line, and its value in capitals.
LISTED = re.compile(r"^ +(--[a-z-]+(?: \[?[A-Z]+\]?)?)(?:  |$)", re.MULTILINE)
DESCRIBED = re.compile(r'^\.(?:BI|BR|B) (\\-\\-[a-z\\-]+(?: ?".*?")?)$', re.MULTILINE)


def options_of_program(program):
    listed = {"--version"}
    for command in ("run", "report", "tests"):
        helped = subprocess.run([program, command, "--help"], capture_output=True, text=True, check=False)
        if helped.returncode == 0:
            listed |= set(LISTED.findall(helped.stdout))
    return listed


def options_of_page():
    text = PAGE.read_text(encoding="utf-8")
    plain = (re.sub(r"\\f.|\"", "", option).replace("\\-", "-") for option in DESCRIBED.findall(text))
    return {" ".join(option.split()) for option in plain}


def main():
    lint = subprocess.run(["mandoc", "-T", "lint", "-W", "warning", PAGE], capture_output=True, text=True, check=False)
    faults = lint.stdout.splitlines()
    program, page = options_of_program(sys.argv[1]), options_of_page()
    faults += [f"{PAGE.name}: {option} is not described as the program lists it" for option in sorted(program - page)]
    faults += [f"{PAGE.name}: {option} is no option of the program" for option in sorted(page - program)]
    for fault in faults:
        print(fault)
    print(f"{len(program)} options, {len(faults)} faults")
    return 1 if faults or not program else 0


if __name__ == "__main__":
    sys.exit(main())
