"""Holds what the program said against what a scenario wants."""

import json
import re
from dataclasses import dataclass

from .catalogue import DOCUMENT_NAMES, SECTIONS, test_of
from .description import Scenario, Want


@dataclass(frozen=True)
class Verdict:
    test: int | None
    place: str
    wanted: str
    got: str
    right: bool


_ABSENT = object()


def _show(value: object) -> str:
    return "absent" if value is _ABSENT else json.dumps(value, ensure_ascii=False)


def _find(data: dict, place: str) -> object:
    section, _, key = place.partition(".")
    found: object = data.get(DOCUMENT_NAMES[section], {})
    for part in key.split(".") if key else ():
        if not isinstance(found, dict) or part not in found:
            return _ABSENT
        found = found[part]
    return found


def _error_codes(log: str, name: str) -> list[int]:
    """The error codes with which the service answered a test."""
    pattern = re.escape(f"Wi-Fi Profile: {name} failed with error: ") + r".*\(code (-?\d+)\)$"
    return [int(code) for code in re.findall(pattern, log, re.MULTILINE)]


def _is_right(want: Want, found: object) -> bool:
    if want.kind == "range":
        number = isinstance(found, (int, float)) and not isinstance(found, bool)
        return number and want.value[0] <= found <= want.value[1]
    if want.kind == "empty":
        return found == {}
    if want.kind == "present":
        return found is not _ABSENT
    if want.kind == "absent":
        return found is _ABSENT
    return type(found) is type(want.value) and found == want.value


def judge(scenario: Scenario, result: dict, log: str) -> list[Verdict]:
    data = result.get("data", {})
    verdicts = []
    for want in scenario.wants:
        if want.place == "status":
            found = result.get("statusCode", _ABSENT)
            verdicts.append(Verdict(None, want.place, str(want), _show(found), _is_right(want, found)))
            continue
        section, _, key = want.place.partition(".")
        test = test_of(section, key) if key else None
        found = _find(data, want.place)
        right, got = _is_right(want, found), _show(found)
        if want.kind == "absent" and want.value is not None and right:
            codes = _error_codes(log, test.name)
            right = want.value in codes
            got += f" {'/'.join(map(str, codes)) or '(no reason in the log)'}"
        verdicts.append(Verdict(test.number if test else None, want.place, str(want), got, right))
    return verdicts + _unexpected_findings(scenario, data)


def _unexpected_findings(scenario: Scenario, data: dict) -> list[Verdict]:
    """A finding that the scenario does not name is a false alarm."""
    named = {want.place for want in scenario.wants}
    verdicts = []
    for section, tests in SECTIONS.items():
        for test in tests:
            place = f"{section}.{test.key}"
            found = _find(data, place)
            if place not in named and test.finding is not None and found is not _ABSENT and found == test.finding:
                verdicts.append(Verdict(test.number, place, "no finding", _show(found), False))
    return verdicts
