#!/usr/bin/env python3
"""Checks that docs/ names what the rows of the catalogue say: each test with its number, its name in the log and its
verdict's key in catalogue.md, and each result key in result_document.md; and that fleet.md counts as findings what the
lab's scenarios do."""
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.append(str(ROOT / "verification/lab"))
from scenario_runner import catalogue as lab_catalogue  # noqa: E402

ROW = re.compile(r'\{\s*(\d+), "(\w+)",\s+(never|always|passed|notPassed),\s+(\S+),\s+(\S+),\s+(".*?"|none),\s+(".*?")\}')


def rows():
    for source in sorted((ROOT / "tests").glob("*_tests.cpp")):
        for line in source.read_text(encoding="utf-8").splitlines():
            match = ROW.search(line)
            if match:
                yield match.groups()


def fleet_faults():
    """The two lists of keys in the page's view of findings: those that are one when false, and those that never are."""
    page = (ROOT / "docs/fleet.md").read_text(encoding="utf-8")
    lists = [set(re.findall(r"'(\w+)'", listed)) for listed in re.findall(r"key NOT IN \(([^)]*)\)", page)]
    tests = lab_catalogue.DEVICE + lab_catalogue.NETWORK
    wanted = [{test.key for test in tests if test.finding is finding} for finding in (False, None)]
    return [] if lists == wanted else [f"docs/fleet.md: the lists of keys are {lists}, not {wanted}"]


def main():
    catalogue = (ROOT / "docs/catalogue.md").read_text(encoding="utf-8")
    document = (ROOT / "docs/result_document.md").read_text(encoding="utf-8")
    faults, count = fleet_faults(), 0
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
