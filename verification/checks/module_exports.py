#!/usr/bin/env python3
"""Checks what the extension module shows to those who load it, and how large it is without its symbols.

usage: module_exports.py MODULE [--size-limit BYTES]
"""
import argparse
import os
import subprocess
import sys
import tempfile

WANTED = {
    "wifiProfileExtensionEntry": "T",
    "kNetworkName": "R",
    "stringOrNull": "T",
    "numberOrNull": "T",
    "dictionaryOrNull": "T",
    "numberOrNullForDouble": "T",
    "removeNullFromDictionary": "T",
}


def exported(module):
    lines = subprocess.run(["nm", "-D", "--defined-only", module], check=True, capture_output=True, text=True)
    return {fields[-1]: fields[-2] for fields in map(str.split, lines.stdout.splitlines())}


def stripped_size(module):
    with tempfile.TemporaryDirectory() as folder:
        copy = os.path.join(folder, "module.so")
        subprocess.run(["strip", "-o", copy, module], check=True)
        return os.path.getsize(copy)


def main():
    arguments = argparse.ArgumentParser()
    arguments.add_argument("module")
    arguments.add_argument("--size-limit", type=int)
    given = arguments.parse_args()
    faults = []
    found = exported(given.module)
    for name in sorted(WANTED.keys() | found.keys()):
        if found.get(name) != WANTED.get(name):
            faults.append(f"{name}: {found.get(name, 'missing')} where {WANTED.get(name, 'nothing')} is wanted")
    size = stripped_size(given.module)
    if given.size_limit and size >= given.size_limit:
        faults.append(f"{size} bytes without symbols where less than {given.size_limit} are wanted")
    for fault in faults:
        print(fault)
    print(f"{given.module}: {len(found)} names, {size} bytes without symbols, {len(faults)} faults")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
