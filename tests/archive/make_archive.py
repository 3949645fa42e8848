#!/usr/bin/env python3
"""Makes a product archive from docs/formats.md alone: make_archive.py FOLDER ARCHIVE"""
import gzip, os, struct, sys

folder, target = sys.argv[1:]
body = b""
for place, _, names in os.walk(folder):
    for name in names:
        path = os.path.join(place, name)
        content = open(path, "rb").read()
        high = int((os.path.getmtime(path) + 11644473600) * 10_000_000) >> 32
        data = gzip.compress(content) if content else b""
        attributes = 0x20 if os.stat(path).st_mode & 0o200 else 0x21
        stored = os.path.relpath(path, folder).encode("cp1250")
        body += struct.pack("<I", len(stored)) + stored
        body += struct.pack("<6I", high, high, high, attributes, len(content), len(data)) + data
body += struct.pack("<I", 0)
first = struct.pack("<I", 0)
with open(target, "wb") as archive:
    archive.write(body + struct.pack("<I", -sum(body + first) & 0xFFFFFFFF) + first)
