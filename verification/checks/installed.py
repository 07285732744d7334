#!/usr/bin/env python3
"""Installs into a folder of its own and checks that each file is in its place and that the installed program runs from
there, knowing the module, the service and the demo recordings beside it.

usage: installed.py BUILD CMAKE
"""
import os
import pathlib
import subprocess
import sys
import tempfile

WANTED = {
    "bin/wifi-profile",
    "lib/wifi-profile/libwifi-profile-platform.so",
    "lib/wifi-profile/wifi-profile",
    "lib/wifi-profile/wifi-profile-extension.so",
    "lib/wifi-profile/wifi-profile-screen-terminal.so",
    "lib/wifi-profile/wifi-profile-service",
    "lib/wifi-profile/wifi-profile-unicode.so",
    "share/man/man1/wifi-profile.1",
    "share/wifi-profile/recordings/home.json",
    "share/wifi-profile/recordings/selected.json",
    "share/wifi-profile/recordings/troubled.json",
    "share/wifi-profile/result.schema.json",
    "share/wifi-profile/vendors.json",
}

# Only where the build has the television screen.
TELEVISION = "wifi-profile-screen-tv.so"


def install(build, cmake, folder):
    subprocess.run([cmake, "--install", build, "--prefix", "/usr", "--strip"], check=True, stdout=subprocess.DEVNULL,
                   env={**os.environ, "DESTDIR": folder})
    root = pathlib.Path(folder, "usr")
    return root, {path.relative_to(root).as_posix() for path in root.rglob("*") if path.is_symlink() or path.is_file()}


def output_of(program, *arguments):
    ended = subprocess.run([program, *arguments], cwd="/", capture_output=True, text=True, check=False)
    return ended.stdout if ended.returncode == 0 else f"status {ended.returncode}: {ended.stderr}"


def main():
    build, cmake = sys.argv[1:]
    faults = []
    if os.path.exists(f"{build}/{TELEVISION}"):
        WANTED.add(f"lib/wifi-profile/{TELEVISION}")
    with tempfile.TemporaryDirectory() as folder:
        root, found = install(build, cmake, folder)
        faults += [f"missing: {name}" for name in sorted(WANTED - found)]
        faults += [f"not expected: {name}" for name in sorted(found - WANTED)]
        for arguments in (["run", "--demo", "troubled"], ["run", "--show-endpoints"], ["tests"]):
            here, there = output_of(f"{build}/wifi-profile", *arguments), output_of(root / "bin/wifi-profile", *arguments)
            if here != there or here.startswith("status"):
                faults.append(f"{' '.join(arguments)}: gives where it is installed\n{there}\nand where it is built\n{here}")
    for fault in faults:
        print(fault)
    print(f"{len(WANTED)} files, {len(faults)} faults")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
