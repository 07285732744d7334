#!/usr/bin/env python3
"""Holds docs/tests/ against the code: every numbered test stands in one of its pages, every threshold that a page names
has its value in the source file that the page names, and no number that a verdict goes by is missing from the pages."""
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parents[2]
ROW = re.compile(r"^\| `([\w/.]+)` \| `(\w+)` \| (-?[\d.]+) \|", re.MULTILINE)
# A verdict's own numbers: constants of service/, and the limits that a configuration may set.
CONSTANT = re.compile(r"constexpr (?:int|unsigned|double|std::size_t|std::uint\d+_t|(?:std::chrono::)?(?:milli)?seconds) ([^;]*);")
LIMIT = re.compile(r"struct \w+Limits \{(.*?)\n\};", re.DOTALL)
NAMED = re.compile(r"(\w+)\s*(?:=\s*|\{)(-?[\d.']+)\}?(?=[,;]|$)")
# Numbers of protocols and forms, by which nothing is judged.
NO_THRESHOLDS = {"kFirstMembershipSelector", "kFastestDirectSequenceRate", "kVendor", "kExtension", "kVendorElement", "kEscapeSize",
                 "kSecondaryAbove", "kSecondaryBelow", "kOlderStationsPresent", "kProtectionInUse", "kUnknownSignal", "kMaximumSize", "kFixed",
                 "kVhtPart", "kCohostedPart"}  # fmt: skip


def numbers_in(text: str) -> dict[str, str]:
    found = dict(NAMED.findall("".join(f"{declared};" for declared in CONSTANT.findall(text))))
    for limits in LIMIT.findall(text):
        found |= dict(NAMED.findall(re.sub(r"^\s*(///.*|unsigned |double )", "", limits, flags=re.MULTILINE)))
    return {name: value.replace("'", "") for name, value in found.items()}


def tests_of(page: str) -> set[int]:
    """The numbers in the first column of its tables, which begin a cell or follow a comma."""
    cells = re.findall(r"^\| ((?:\d+[^|]*))\|", page, re.MULTILINE)
    numbers = [int(n) for cell in cells for n in re.findall(r"(?:^|, )(\d+)\b", cell)]
    return set(numbers)


def main() -> int:
    pages = {path: path.read_text(encoding="utf-8") for path in sorted((ROOT / "docs/tests").glob("*.md"))}
    catalogue = (ROOT / "service/catalogue.cpp").read_text(encoding="utf-8")
    faults, named = [], set()
    for path, page in pages.items():
        for file, name, value in ROW.findall(page):
            named.add((file, name))
            found = numbers_in((ROOT / file).read_text(encoding="utf-8")).get(name)
            if found is None or float(found) != float(value):
                faults.append(f"{path.name}: {name} is {value} here, and {found} in {file}")
    for source in sorted((ROOT / "service").glob("*.[ch]*")):
        file = str(source.relative_to(ROOT))
        for name in numbers_in(source.read_text(encoding="utf-8")):
            if (file, name) not in named and name not in NO_THRESHOLDS:
                faults.append(f"docs/tests: no page names {name} of {file}")
    tests = {int(n) for n in re.findall(r"^ +\{ *(\d+), Subject::", catalogue, re.MULTILINE)}
    told = set().union(*(tests_of(page.partition("## Thresholds")[0]) for page in pages.values()))
    faults += [f"docs/tests: no page tells of test {n}" for n in sorted(tests - told)]
    for fault in faults:
        print(fault)
    print(f"{len(named)} thresholds, {len(tests)} tests, {len(faults)} faults")
    return 1 if faults or not named or not tests else 0


if __name__ == "__main__":
    sys.exit(main())
