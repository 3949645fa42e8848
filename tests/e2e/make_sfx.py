#!/usr/bin/env python3
"""Makes setup programs by the book of docs/formats.md, sound or damaged, independently of the orbit tool.

usage: make_sfx.py SETUP.EXE PROGRAMS-FOLDER OUTPUT.EXE KIND [ENTRY-NAME...]

Carries Plumo's three programs, which the wizard's last page needs, two texts, and an entry of each given name.
KIND: good, big (one entry of 3 MB of zeros), wrong-check, truncated, corrupted, past-end.
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


def product_archive(entries, wrong_check=False):
    lead = b"anything may stand before the first entry"
    body = lead + b"".join(entries) + struct.pack("<I", 0)
    first = struct.pack("<I", len(lead))
    check = -(sum(body) + sum(first)) & 0xFFFFFFFF
    return body + struct.pack("<I", check ^ (1 if wrong_check else 0)) + first


def stamped(setup, payload, offset=None):
    stamp = struct.pack("<4s12xIII", b"rSFX", len(setup) if offset is None else offset, len(payload), 0)
    return setup[:28] + stamp + setup[56:] + payload


def main(setup_path, programs, output, kind, *names):
    with open(setup_path, "rb") as file:
        setup = file.read()
    noise = random.Random(7).randbytes(200000)
    entries = [entry("good.txt", b"good\r\n"), entry("Dir/Sub\\plain.bin", b"no gzip header", plain=True)]
    for name in ("Plumo.exe", "UnInstall.exe", "UnInstall01.exe"):
        with open(f"{programs}/{name}", "rb") as file:
            entries.append(entry(name, file.read()))
    entries += [entry(name, b"evil") for name in names]
    if kind == "big":
        entries.append(entry("big.bin", bytes(3 << 20)))
    if kind in ("truncated", "corrupted"):
        entries.append(entry("noise.bin", noise))
    payload = zlib.compress(product_archive(entries, kind == "wrong-check"), 9)
    middle = len(payload) // 2
    if kind == "truncated":
        payload = payload[:middle]
    if kind == "corrupted":
        payload = payload[:middle] + bytes(b ^ 0x5A for b in payload[middle:middle + 64]) + payload[middle + 64:]
    with open(output, "wb") as file:
        file.write(stamped(setup, payload, len(setup) + len(payload) + 4096 if kind == "past-end" else None))


if __name__ == "__main__":
    main(*sys.argv[1:])
