#!/usr/bin/env python3
"""Makes packed files by the book of docs/formats.md, independently of the orbit tool: starter, bundle, payload.

usage: make_packed.py BOOTSTRAP.EXE SETUP.EXE SCRIPT PROGRAMS-FOLDER OUTPUT.EXE [NAME=FILE...]

Carries Plumo's three programs, which the wizard's last page needs, and two texts; NAME=FILE puts another file into the
bundle. A SETUP, SCRIPT or PROGRAMS-FOLDER of - leaves that out. Prints where bundle and payload begin, and the size.
"""

import struct
import sys
import zlib

from make_sfx import entry, product_archive, stamped


def content(path):
    with open(path, "rb") as file:
        return file.read()


def end_of_image(image):
    """The highest end of a section's raw data."""
    headers = struct.unpack_from("<I", image, 0x3C)[0]
    sections, optional = struct.unpack_from("<H", image, headers + 6)[0], struct.unpack_from("<H", image, headers + 20)[0]
    rows = [struct.unpack_from("<II", image, headers + 24 + optional + 40 * i + 16) for i in range(sections)]
    return max(size + at for size, at in rows if size)


def main(bootstrap, setup, script, programs, output, *others):
    image = content(bootstrap)
    image = image[:end_of_image(image)]
    bundle = []
    if setup != "-":
        bundle.append(entry("setup.exe", content(setup)))
    if script != "-":
        bundle.append(entry("wizard.txt", content(script)))
    bundle += [entry(name, content(path)) for name, path in (other.split("=", 1) for other in others)]
    front = image + (product_archive(bundle) if bundle else b"")
    files = [entry("good.txt", b"good\r\n"), entry("Dir/Sub\\plain.bin", b"no gzip header", plain=True)]
    if programs != "-":
        files += [entry(name, content(f"{programs}/{name}")) for name in ("Plumo.exe", "UnInstall.exe", "UnInstall01.exe")]
    packed = stamped(front, zlib.compress(product_archive(files), 9))
    with open(output, "wb") as file:
        file.write(packed)
    print(len(image), len(front), len(packed))


main(*sys.argv[1:])
