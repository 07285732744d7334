"""Prints what came out: the table of wanted and got verdicts, the accuracy of each test, and the closing line."""

from collections import defaultdict

from .catalogue import SECTIONS
from .description import Scenario
from .verdicts import Verdict

ROW = "{:<30} {:>4}  {:<40} {:<28} {:<28} {}"


def _cut(text: str, width: int) -> str:
    return text if len(text) <= width else text[: width - 1] + "…"


def _closing(passed: int, failed: int) -> int:
    print(f"\n{passed} passed, {failed} failed")
    return 1 if failed else 0


def problems(found: dict[str, str]) -> int:
    for name, problem in found.items():
        print(f"{'FAIL' if problem else 'ok':5} {name}")
        if problem:
            print("      " + problem.rstrip().replace("\n", "\n      "))
    failed = sum(bool(p) for p in found.values())
    return _closing(len(found) - failed, failed)


def _accuracy(verdicts: list[Verdict]) -> None:
    """Per test: how often its finding, its absence and "cannot tell" were wanted, and how often the program was right."""
    rows: dict[int, dict[str, int]] = defaultdict(lambda: defaultdict(int))
    tests = {test.number: test for section in SECTIONS.values() for test in section}
    for verdict in verdicts:
        if verdict.test is None or verdict.place.split(".")[1] != tests[verdict.test].key:
            continue
        finding = tests[verdict.test].finding
        kind = "cannot tell" if verdict.wanted.startswith("absent") else "quiet"
        if verdict.wanted == str(True if finding is None else finding).lower():
            kind = "finding"
        rows[verdict.test][kind] += 1
        rows[verdict.test]["right"] += verdict.right
        rows[verdict.test]["all"] += 1
    print(f"\n{'test':>4}  {'key':<40} {'finding':>8} {'without':>8} {'cannot tell':>12} {'right':>10}")
    for number, row in sorted(rows.items()):
        share = f"{row['right']}/{row['all']}"
        print(f"{number:>4}  {tests[number].key:<40} {row['finding']:>8} {row['quiet']:>8} {row['cannot tell']:>12} {share:>10}")
    right, total = (sum(row[column] for row in rows.values()) for column in ("right", "all"))
    if total:
        print(f"accuracy: {right} of {total} verdicts, {100 * right / total:.1f} %")


def matrix(scenarios: list[Scenario], judged: dict[str, tuple[list[Verdict], str]], verbose: bool) -> int:
    print(ROW.format("scenario", "test", "key", "wanted", "got", ""))
    failed, everything = 0, []
    for scenario in scenarios:
        verdicts, problem = judged[scenario.name]
        wrong = [v for v in verdicts if not v.right]
        failed += bool(wrong or problem)
        everything += verdicts
        for v in verdicts if verbose or wrong else ():
            print(ROW.format(scenario.name, v.test or "", v.place, _cut(v.wanted, 28), _cut(v.got, 28), "ok" if v.right else "DIFFERS"))
        if not wrong and not problem:
            print(ROW.format(scenario.name, "", f"{len(verdicts)} values as wanted", "", "", "ok"))
        if problem:
            print(f"{scenario.name}: {problem.rstrip()}")
    _accuracy(everything)
    return _closing(len(scenarios) - failed, failed)
