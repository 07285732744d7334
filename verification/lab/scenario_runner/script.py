"""Turns a scenario into the bash script that sets it up inside the lab's machine and runs the program there."""

import shlex

from .description import Scenario


def _here_document(lines: list[str]) -> str:
    return "<<'LINES'\n" + "\n".join(lines) + "\nLINES\n"


def _ap(scenario: Scenario, arguments: list[str], lines: list[str]) -> str:
    device = arguments[0]
    address = arguments[1] if len(arguments) > 1 else "-"
    text = f"ap {device} {address} {_here_document(lines)}"
    return text if address == "-" or _says_what_lies_beyond(scenario, device) else text + f"internet {device}\n"


def _says_what_lies_beyond(scenario: Scenario, device: str) -> bool:
    """Whether the set-up calls `internet` or `no_internet` itself."""
    steps = (line.split() for _, _, lines in scenario.steps for line in lines)
    return any(words[:2] in (["internet", device], ["no_internet", device]) for words in steps)


def _station(scenario: Scenario, arguments: list[str], lines: list[str]) -> str:
    device = arguments[0]
    text = f"sta {device} " + _here_document(["network={", *lines, "}"])
    text += f"sta_up {device} 30 || {{ echo '{device} did not join:'; tail -n 5 /run/lab/{device}/wpa.log; false; }}\n"
    if scenario.headers.get("address", "dhcp") == "dhcp":
        text += f"dhcp {device} || {{ echo '{device} got no address'; false; }}\n"
    return text


def set_up(scenario: Scenario) -> str:
    """The set-up alone: stops with a message at the first step that fails."""
    text = '. "$LAB_DIR/lib.sh"\n'
    text += "trap 'echo \"set-up failed at: $BASH_COMMAND\"; exit 99' ERR\nset -E\n"
    text += f"fresh_radios {scenario.radios()} {scenario.headers.get('hwsim', '')}\n"
    text += f"country {scenario.headers.get('country', 'US')}\n" if scenario.radios() else ""
    for kind, arguments, lines in scenario.steps:
        if kind == "ap":
            text += _ap(scenario, arguments, lines)
        elif kind == "station":
            text += _station(scenario, arguments, lines)
        else:
            text += "\n".join(lines) + "\n"
    return text + "trap - ERR\n"


def run(scenario: Scenario, program: str, out: str) -> str:
    """Runs the program as the scenario's user; leaves result, log and exit status beside `out`."""
    screen = "terminal" if scenario.during else "none"
    command = [program, "run", "--screen", screen, *scenario.arguments]
    if "environment" in scenario.headers:
        command = ["env", scenario.headers["environment"], *command]
    user = scenario.headers.get("user")
    if user:
        command = ["setpriv", f"--reuid={user}", "--regid=nogroup", "--clear-groups", "env", "HOME=/tmp", *command]
    line = f"timeout --foreground 120 {shlex.join(command)} > {out}.json 2> {out}.log\necho $? > {out}.exit\n"
    return _watched(line, scenario.during, out) if scenario.during else line


def _watched(line: str, steps: list[str], out: str) -> str:
    """The line in a terminal, while the steps press keys, change what is on the air and say what must be seen."""
    return (
        '. "$LAB_DIR/screen.sh"\n'
        "trap 'echo \"stopped at: $BASH_COMMAND\"; picture; exit 99' ERR\nset -E\n"
        f"on_a_terminal {_here_document([line])}" + "\n".join(steps) + "\n"
        f"wait_for 150 test -s {out}.exit\n"
    )


def check_air(out: str) -> str:
    """What iw sees of the set-up: beacons first, since a probe response has no DTIM period and names a hidden network."""
    return (
        "scan wlan0 flush passive > /dev/null; scan wlan0 passive > /dev/null\n"
        f"{{ iw dev wlan0 scan dump -b; iw dev wlan0 link; iw reg get; ip -br addr show dev wlan0; }} > {out}.air 2>&1\n"
        f"echo 0 > {out}.exit\n"
    )


def instead(command: str, out: str) -> str:
    return f"SCENARIO_OUT={shlex.quote(out)}; export SCENARIO_OUT\n{command}\necho $? > {out}.exit\n"
