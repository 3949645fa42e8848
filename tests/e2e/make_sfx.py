#!/usr/bin/env python3
"""Makes setup programs by the book of docs/formats.md, sound or damaged, independently of the orbit tool.

usage: make_sfx.py SETUP.EXE PROGRAMS-FOLDER OUTPUT.EXE KIND [ENTRY-NAME...]

Carries Plumo's three programs, which the wizard's last page needs, two texts, and an entry of each given name.
KIND: good or corrupted.
"""

import gzip
import random
import struct
import sys
import zlib


def entry(name, content, plain=False):
    data = content if plain else gzip.compress(content, 9, mtime=0)
    encoded = name.encode("cp1250")
    times = (0x01DB0000, 0x01DB0001, 0x01C43B00)
    return struct.pack("<I", len(encoded)) + encoded + struct.pack("<6I", *times, 0x20, len(content), len(data)) + data


def product_archive(entries):
    lead = b"anything may stand before the first entry"
    body = lead + b"".join(entries) + struct.pack("<I", 0)
    first = struct.pack("<I", len(lead))
    return body + struct.pack("<I", -(sum(body) + sum(first)) & 0xFFFFFFFF) + first


def stamped(setup, payload):
    stamp = struct.pack("<4s12xIII", b"rSFX", len(setup), len(payload), 0)
    return setup[:28] + stamp + setup[56:] + payload


def main(setup_path, programs, output, kind, *names):
    with open(setup_path, "rb") as file:
        setup = file.read()
    entries = [entry("good.txt", b"good\r\n"), entry("Dir/Sub\\plain.bin", b"no gzip header", plain=True)]
    for name in ("Plumo.exe", "UnInstall.exe", "UnInstall01.exe"):
        with open(f"{programs}/{name}", "rb") as file:
            entries.append(entry(name, file.read()))
    entries += [entry(name, b"evil") for name in names]
    if kind == "corrupted":
        entries.append(entry("noise.bin", random.Random(7).randbytes(200000)))
    payload = zlib.compress(product_archive(entries), 9)
    middle = len(payload) // 2
    if kind == "corrupted":
        payload = payload[:middle] + bytes(b ^ 0x5A for b in payload[middle:middle + 64]) + payload[middle + 64:]
    with open(output, "wb") as file:
        file.write(stamped(setup, payload))


if __name__ == "__main__":
    main(*sys.argv[1:])
