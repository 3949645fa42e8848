#!/usr/bin/env python3
"""Starts a packed file again and again, each time damaged at another place, and judges how it ends.

usage: damage.py PACKED.EXE BUNDLE-AT PAYLOAD-AT COUNT SEED GOOD-TREE WORK-FOLDER

Half of the times the file is cut at a random place, half of the times one random byte behind the starter's image is changed. It
is started with /S and a destination of its own under C:\\d, on the current display and WINEPREFIX. The run is right when it ends within two
minutes, with 1603 and no destination, or with 0 and GOOD-TREE in it (what changed was redundant), and leaves nothing in
the temporary folders; a file whose starter is cut may also be refused by the system. One line is printed for each that
is wrong, then a count of each way to end.
"""

import collections
import filecmp
import os
import random
import shutil
import subprocess
import sys
import time

FAILED = 1603 & 0xFF  # all of an exit code that the host sees
RECORDS = {"Installed.lst", "Uninstall.log", "config.ini"}  # name the destination, which differs


def damaged(content, bundle_at, chance):
    if chance.random() < 0.5:
        at = chance.randrange(1, len(content))
        return "cut", at, content[:at]
    at = chance.randrange(bundle_at, len(content))
    value = content[at] ^ chance.randrange(1, 256)
    return "changed", at, content[:at] + bytes([value]) + content[at + 1:]


def tree(folder):
    return sorted(os.path.relpath(os.path.join(path, name), folder) for path, _, names in os.walk(folder) for name in names)


def same_tree(a, b):
    names = tree(a)
    return names == tree(b) and not filecmp.cmpfiles(a, b, [n for n in names if n not in RECORDS], shallow=False)[1]


def leftovers(prefix):
    folders = [f"{prefix}/drive_c/windows/temp"] + [f"{prefix}/drive_c/users/{user}/Temp" for user in os.listdir(f"{prefix}/drive_c/users")]
    return [name for folder in folders if os.path.isdir(folder) for name in os.listdir(folder)]


def run(program, number):
    command = ["wine", program, "/S", f"/DIR=C:\\d\\{number}"]
    try:
        return subprocess.run(command, timeout=120, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE).returncode
    except subprocess.TimeoutExpired:
        return None


def judge(kind, at, code, destination, places, prefix):
    bundle_at, payload_at, good = places
    part = "image" if at < bundle_at else "bundle" if at < payload_at else "payload"
    left = leftovers(prefix)
    if left:
        return part, f"leaves {left}"
    if code == FAILED:
        return part, None if not os.path.exists(destination) else "1603 with a destination"
    if code == 0 and kind == "changed" and part == "payload":
        return part, None if same_tree(good, destination) else "0 with another tree"
    if part == "image" and code is not None and not os.path.exists(destination):
        return part, None  # what is no whole program is refused by the system, or ended by it
    return part, f"ends with {code}"


def main(packed, bundle_at, payload_at, count, seed, good, work):
    prefix = os.environ["WINEPREFIX"]
    with open(packed, "rb") as file:
        content = file.read()
    chance = random.Random(int(seed))
    program = os.path.join(work, "damaged.exe")
    ends, wrong, started = collections.Counter(), 0, time.time()
    for number in range(int(count)):
        kind, at, changed = damaged(content, int(bundle_at), chance)
        with open(program, "wb") as file:
            file.write(changed)
        code = run(program, number)
        destination = f"{prefix}/drive_c/d/{number}"
        part, fault = judge(kind, at, code, destination, (int(bundle_at), int(payload_at), good), prefix)
        ends[f"{kind} in the {part}: {1603 if code == FAILED else code}"] += 1
        if fault:
            wrong += 1
            print(f"WRONG {kind} at {at} ({part}): {fault}", flush=True)
        shutil.rmtree(f"{prefix}/drive_c/d", ignore_errors=True)
    for end, times in sorted(ends.items()):
        print(f"{times:5} {end}")
    print(f"{count} starts in {time.time() - started:.0f} s, {wrong} wrong")
    sys.exit(wrong != 0)


main(*sys.argv[1:])
