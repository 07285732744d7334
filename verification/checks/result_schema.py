#!/usr/bin/python3
"""Holds docs/result.schema.json against the page that explains the result, and results against the schema: those that
the whole-program cases expect, those of the sample fleet and the demo recordings, and changed ones that it must refuse.

usage: result_schema.py PROGRAM
"""
import copy
import json
import pathlib
import re
import subprocess
import sys

import jsonschema

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "verification/lab"))
from scenario_runner.schema import SCHEMA, breaches  # noqa: E402

PAGE = ROOT / "docs/result_document.md"
CASES = ROOT / "verification/cases"
FLEET = ROOT / "verification/fleet/results"
REFUSED = ROOT / "verification/data/results/refused.json"
FULLEST = CASES / "joined_and_selected/expected/result.json"
DEMOS = ("home", "troubled", "selected")

# A recording may state values that no live service has, and they come out as they are.
ODD = {"odd_answers": ["data/currentNetwork/DTIMInterval"]}

# The objects that the page explains, each by one place where it stands in a full result.
OBJECTS = {
    "data/device": "device",
    "data/currentNetwork": "currentNetwork",
    "data/selectedNetwork": "currentNetwork",
    "data/currentNetwork/preferredNetwork": "preferredNetwork",
    "data/currentNetwork/pingLANResult": "pingResult",
}

def expected_results():
    """Name of the case, file and result, for every result among the files that the cases expect and in the fleet."""
    for file in sorted([*CASES.glob("*/expected/*"), *FLEET.glob("*/*")]):
        text = file.read_text(encoding="utf-8", errors="replace")
        if text.startswith("{") and '"statusCode"' in text:
            yield file.parent.parent.name, file, json.loads(text)


def check_expected():
    results = list(expected_results())
    if not results:
        yield "no case expects a result"
    for case, file, result in results:
        if breaches(result) != ODD.get(case, []):
            yield f"{file.relative_to(ROOT)}: breaks the schema at {breaches(result)}, not at {ODD.get(case, [])}"


def check_demos(program):
    runs = {name: subprocess.Popen([program, "run", "--demo", name], stdout=subprocess.PIPE, stderr=subprocess.PIPE)
            for name in DEMOS}
    for name, run in runs.items():
        output, error = run.communicate()
        if run.returncode != 0:
            yield f"demo {name}: ended with {run.returncode}: {error.decode()}"
        elif breaches(json.loads(output)):
            yield f"demo {name}: breaks the schema at {breaches(json.loads(output))}"


ABSENT = object()


def changed(result, at, value):
    """A copy with the value at the place, or without what stands there."""
    result = copy.deepcopy(result)
    *way, key = at.split("/")
    inner = result
    for step in way:
        inner = inner[step]
    inner[key] = value
    if value is ABSENT:
        del inner[key]
    return result


def check_refusals(good):
    for change in json.loads(REFUSED.read_text(encoding="utf-8"))["changes"]:
        at = change["at"]
        if breaches(changed(good, at, change["value"])) != [at]:
            yield f"{change['why']}: {at} = {change['value']!r} breaks {breaches(changed(good, at, change['value']))}"
    for at in ("unknown", "data/unknown", *(f"{place}/unknown" for place in OBJECTS)):
        if breaches(changed(good, at, 1)) != [at]:
            yield f"{at}: a key that is not explained is let in"
    for at in ("statusCode", "data", "data/device", "data/currentNetwork", "data/selectedNetwork"):
        if breaches(changed(good, at, ABSENT)) != [at]:
            yield f"{at}: may be missing"


def allowed_at():
    """Place in a full result -> key -> (type word of the page, whether it may be null), as the schema has them."""
    kinds = SCHEMA["$defs"]
    allowed = {place: {key: type_of(rule) for key, rule in kinds[kind]["properties"].items()}
               for place, kind in OBJECTS.items()}
    for key in kinds["selectedNetwork"]["propertyNames"]["not"]["enum"]:
        del allowed["data/selectedNetwork"][key]
    return allowed


def type_of(rule):
    if "$ref" in rule:
        rule = SCHEMA["$defs"][rule["$ref"].rsplit("/", 1)[1]]
    types = rule["type"] if isinstance(rule["type"], list) else [rule["type"]]
    return {"object": "dictionary"}.get(types[0], types[0]), "null" in types


def explained_at():
    """The same as the page explains it."""
    sections = {}
    for part in re.split(r"^##+ ", PAGE.read_text(encoding="utf-8"), flags=re.MULTILINE)[1:]:
        title, _, body = part.partition("\n")
        sections[title] = [line.split("|")[1:-1] for line in body.splitlines() if line.startswith("| `")]
    network = sections['"currentNetwork" and "selectedNetwork"']
    return {
        "data/device": keys_of(sections['"device"'], 2),
        "data/currentNetwork": keys_of(network, 2),
        "data/selectedNetwork": keys_of([row for row in network if "**c**" not in row[0]], 2),
        "data/currentNetwork/preferredNetwork": keys_of(sections["`preferredNetwork`"], 1, 2),
        "data/currentNetwork/pingLANResult": keys_of(sections["`pingLANResult`, `pingWANResult`"], 1, 2),
    }


def keys_of(rows, type_column, null_column=None):
    return {key: (re.match(r"\w+", row[type_column].strip())[0],
                  null_column is not None and row[null_column].strip() != "")
            for row in rows for key in re.findall(r"`(\w+)`", row[0])}


def check_page():
    page, allowed = explained_at(), allowed_at()
    for place in OBJECTS:
        for key in sorted(page[place].keys() | allowed[place].keys()):
            if page[place].get(key) != allowed[place].get(key):
                yield f"{place}/{key}: page {page[place].get(key)}, schema {allowed[place].get(key)}"
    codes = {int(code) for code in re.findall(r"^\| (-?\d) \|", PAGE.read_text(encoding="utf-8"), re.MULTILINE)}
    if codes != set(SCHEMA["properties"]["statusCode"]["enum"]):
        yield f"statusCode: page {sorted(codes)}"
    names = (ROOT / "service/security.cpp").read_text(encoding="utf-8").partition("nameOf(")[2]
    if set(re.findall(r'return "([^"]+)"', names)) != set(SCHEMA["$defs"]["currentNetwork"]["properties"]["security"]["enum"]):
        yield "security: not the names that service/security.cpp gives"


def main():
    jsonschema.Draft202012Validator.check_schema(SCHEMA)
    good = json.loads(FULLEST.read_text(encoding="utf-8"))
    faults = [*check_page(), *check_expected(), *check_demos(sys.argv[1]), *check_refusals(good)]
    for fault in faults:
        print(fault)
    print(f"{len(faults)} faults")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
