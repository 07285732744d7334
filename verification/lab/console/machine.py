"""The lab's machine with a screen and a keyboard: commands, keys and pictures from outside."""

import json
import socket
import subprocess
import tempfile
import time
from pathlib import Path

from PIL import Image, ImageChops

HERE = Path(__file__).resolve().parent
# What a person types, as the keys of a keyboard of the United States.
PLAIN = {" ": "spc", "\n": "ret", "-": "minus", "=": "equal", ".": "dot", "/": "slash", ";": "semicolon", ",": "comma"}
SHIFTED = {"_": "minus", "$": "4", "(": "9", ")": "0", ">": "dot", "*": "8", '"': "apostrophe", "?": "slash", "&": "7", "|": "backslash"}
PATIENCE = 60.0


class Failure(Exception):
    """Something did not come true; the text says what."""


def _connected(path: Path, running: subprocess.Popen) -> socket.socket:
    end = time.monotonic() + PATIENCE
    while time.monotonic() < end and running.poll() is None:
        connection = socket.socket(socket.AF_UNIX)
        try:
            connection.connect(str(path))
            return connection
        except OSError:
            connection.close()
            time.sleep(0.1)
    raise Failure("the machine did not start")


def keys_of(text: str) -> list[list[str]]:
    """The keys to press for each letter."""
    def keys(letter: str) -> list[str]:
        if letter in SHIFTED:
            return ["shift", SHIFTED[letter]]
        return ["shift", letter.lower()] if letter.isupper() else [PLAIN.get(letter, letter)]
    return [keys(letter) for letter in text]


def is_like(shown: Image.Image, wanted: Image.Image, tolerance: int) -> bool:
    if shown.size != wanted.size:
        return False
    return all(most <= tolerance for _, most in ImageChops.difference(shown, wanted).getextrema())


def difference(shown: Image.Image, wanted: Image.Image) -> str:
    if shown.size != wanted.size:
        return f"but one of {shown.size[0]}x{shown.size[1]}"
    return f"different within {ImageChops.difference(shown, wanted).getbbox()}"


class Machine:
    """One start of the machine with a screen of that size; `graphics` is a device of qemu and the kernel's module for it."""

    def __init__(self, width: int, height: int, folder: Path, graphics: str = "bochs", devices: str = "udev"):
        self._folder = folder
        folder.mkdir(parents=True, exist_ok=True)
        self._temporary = tempfile.TemporaryDirectory(prefix="wifi-console-")
        sockets = Path(self._temporary.name)
        adapter = {"bochs": f"bochs-display,xres={width},yres={height},vgamem=64M",
                   "virtio_gpu": f"virtio-gpu-pci,xres={width},yres={height}"}[graphics]
        self._running = subprocess.Popen(
            [HERE.parent / "run-in-lab", "-b", "qemu", "-r", "0", "-t", "900", "-w", folder, "-k", folder / "kernel.log",
             "-q", f"-device {adapter} -qmp unix:{sockets}/monitor,server=on,wait=off"
             f" -chardev socket,id=talk,path={sockets}/talk,server=on,wait=off -device virtserialport,chardev=talk",
             HERE / "inside", graphics, devices], stdin=subprocess.DEVNULL)
        self._monitor = _connected(sockets / "monitor", self._running).makefile("rw", encoding="utf-8")
        self._talk = _connected(sockets / "talk", self._running).makefile("rwb", buffering=0)
        self._monitor.readline()
        self._ask("qmp_capabilities")
        self._answer()

    def __enter__(self) -> "Machine":
        return self

    def __exit__(self, *_: object) -> None:
        try:
            self._talk.write(b"end\n")
            self._running.wait(PATIENCE)
        except (OSError, subprocess.TimeoutExpired):
            self._running.terminate()
            self._running.wait()
        self._temporary.cleanup()

    def _ask(self, command: str, **arguments: object) -> object:
        self._monitor.write(json.dumps({"execute": command, "arguments": arguments}) + "\n")
        self._monitor.flush()
        while True:
            answer = json.loads(self._monitor.readline() or '{"error": "the machine is gone"}')
            if "error" in answer:
                raise Failure(f"{command}: {answer['error']}")
            if "return" in answer:
                return answer["return"]

    def _answer(self) -> tuple[str, int]:
        lines = []
        while True:
            line = self._talk.readline()
            if not line:
                raise Failure("the machine is gone")
            if line.startswith(b"\037"):
                return b"".join(lines).decode(errors="replace").removesuffix("\n"), int(line[1:])
            lines.append(line)

    def is_true(self, command: str) -> bool:
        return self.try_to_run(command)[1] == 0

    def run(self, command: str) -> str:
        """What the command (one line of bash) prints in the machine; it must succeed."""
        output, status = self.try_to_run(command)
        if status != 0:
            raise Failure(f"{command}: status {status}: {output}")
        return output

    def try_to_run(self, command: str) -> tuple[str, int]:
        self._talk.write(command.encode() + b"\n")
        return self._answer()

    def until(self, command: str, what: str) -> None:
        """Waits until the command succeeds in the machine."""
        end = time.monotonic() + PATIENCE
        while not self.is_true(command):
            if time.monotonic() >= end:
                raise Failure(f"never happened: {what}")
            time.sleep(0.2)

    def press(self, *keys: str) -> None:
        """Keys of the machine's keyboard by qemu's names, one after another."""
        for key in keys:
            self._ask("send-key", keys=[{"type": "qcode", "data": name} for name in key.split("+")], **{"hold-time": 20})
            time.sleep(0.06)

    def type(self, text: str) -> None:
        self.press(*("+".join(keys) for keys in keys_of(text)))

    def picture(self, name: str) -> Image.Image:
        """What the screen shows, kept as NAME.png."""
        file = self._folder / f"{name}.png"
        self._ask("screendump", filename=str(file), format="png")
        with Image.open(file) as image:
            return image.convert("RGB")

    def until_shown(self, name: str, wanted: Image.Image, tolerance: int = 0) -> None:
        """Waits until the screen shows this picture; each colour's part may differ by the tolerance."""
        end = time.monotonic() + PATIENCE
        while not is_like(shown := self.picture(name), wanted, tolerance):
            if time.monotonic() >= end:
                raise Failure(f"{name}: not the picture that was wanted, {difference(shown, wanted)}")
            time.sleep(0.3)
