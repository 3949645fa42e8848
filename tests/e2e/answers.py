"""See answers.sh. Arguments: the repository, the working folder, two prefixes in it. Tells in what they differ.

Compared are the content of every file, its time when it is one of the product's, every folder, and the registry. The
desktop and the keys in which Wine counts what it has started are not: only one of the two had windows.
"""
import os
import re
import struct
import sys
import time

from prefix import Prefix

ROOT, WORK, ONE, TWO = sys.argv[1:5]
NOISE = re.compile(r"/(Temp|temp)/|\.reg$")
REGISTRY_NOISE = re.compile(r"Explorer\\\\Desktops|\\\\Wine\\\\|CurrentVersion\\\\Explorer\\\\(Shell|User)|VolatileEnvironment|"
                            r"Volatile Environment|Control\\\\Video|SessionInfo|DeviceClasses|MMDevices|\\\\Enum\\\\", re.IGNORECASE)


# A shortcut tells the times of the folders on its way, which were made just now, in the old form of two numbers.
TODAY = time.gmtime()
TODAY = struct.pack("<H", TODAY.tm_year - 1980 << 9 | TODAY.tm_mon << 5 | TODAY.tm_mday)
MADE_JUST_NOW = re.compile(re.escape(TODAY) + b"..", re.DOTALL)


def content(prefix):
    found = {}
    for name, what in prefix.state().items():
        if not name.startswith("/"):
            if not REGISTRY_NOISE.search(name):
                found[re.sub(r"^.*\.user", "user", name)] = what
        elif not NOISE.search(name) and isinstance(what, tuple):
            with open(prefix.path + name, "rb") as file:
                found[name] = file.read() if not name.endswith(".lnk") else MADE_JUST_NOW.sub(b"", file.read())
            if what[1] < 1.79e18:  # written by the product's maker, not just now
                found[name + " (time)"] = what[1]
        elif not NOISE.search(name):
            found[name] = "folder or link"
    return found


def main():
    one, two = [content(Prefix(ROOT, WORK, name)) for name in (ONE, TWO)]
    lines = [f"only in {ONE}: {name}" for name in sorted(one.keys() - two.keys())]
    lines += [f"only in {TWO}: {name}" for name in sorted(two.keys() - one.keys())]
    lines += [f"not the same: {name}: {str(one[name])[:300]} / {str(two[name])[:300]}"
              for name in sorted(one.keys() & two.keys()) if one[name] != two[name]]
    print(*lines[:40] or [f"the same {len(one)} things"], sep="\n")
    return 1 if lines else 0


sys.exit(main())
