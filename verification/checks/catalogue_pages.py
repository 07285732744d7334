#!/usr/bin/env python3
"""Checks that docs/ names what the rows of the catalogue say: each test with its number, its name in the log and its
verdict's key in catalogue.md, and each result key in result_document.md."""
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parents[2]
ROW = re.compile(r'\{\s*(\d+), "(\w+)",\s+(never|always|passed|notPassed),\s+(\S+),\s+(\S+),\s+(".*?"|none),\s+(".*?")\}')


def rows():
    for source in sorted((ROOT / "tests").glob("*_tests.cpp")):
        for line in source.read_text(encoding="utf-8").splitlines():
            match = ROW.search(line)
            if match:
                yield match.groups()


def main():
    catalogue = (ROOT / "docs/catalogue.md").read_text(encoding="utf-8")
    document = (ROOT / "docs/result_document.md").read_text(encoding="utf-8")
    faults, count = [], 0
    for number, key, gate, info_key, info_result_key, _, name in rows():
        count += 1
        read = {"never": "", "notPassed": "not passed"}.get(gate, gate)
        start = f"| {number} | {name.strip(chr(34))} | `{key}` | {read} |".replace("|  |", "| |")
        if start not in catalogue:
            faults.append(f'docs/catalogue.md: no row "{start}"')
        if info_key != "none" and info_key not in catalogue:
            faults.append(f"docs/catalogue.md: {info_key} of test {number} is not named")
        keys = [key] + ([info_result_key.strip('"')] if info_result_key.startswith('"') else [])
        faults += [f"docs/result_document.md: `{k}` is not explained" for k in keys if f"`{k}`" not in document]
    if count != 41:
        faults.append(f"tests/: {count} rows found where there should be 41")
    for fault in faults:
        print(fault)
    print(f"{count} rows, {len(faults)} faults")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
