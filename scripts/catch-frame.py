#!/usr/bin/env python3
"""Catches a page that is on the screen for a moment only.

usage: catch-frame.py FRAME-BUFFER WIDTH HEIGHT OUTPUT.xwd

Watches an Xvfb frame buffer file until it is ended (SIGTERM) and keeps, of the frames in which the pages' background
colour fills a whole page of this size, the one that shows most. Exits with 1 when there was none.
"""

import signal
import struct
import sys
import time
import zlib

GREEN = bytes((228, 241, 227))  # the pages' background, as the frame buffer holds it
SCREEN_WIDTH = 1024
FRAME = (6, 25)  # what borders and caption take of a page's width and height


def extent(frame, start, stride):
    """Width and height of the area between the first and the last row with the colour."""
    first, last = frame.find(GREEN, start), frame.rfind(GREEN)
    if first < 0:
        return 0, 0
    top, bottom = (first - start) // stride, (last - start) // stride
    row = start + stride * bottom  # the page's last row: nothing but background
    left, right = frame.find(GREEN, row, row + stride), frame.rfind(GREEN, row, row + stride)
    return (right - left) // 4 + 1, bottom - top + 1


def watch(path, width, height, output):
    ended = []
    signal.signal(signal.SIGTERM, lambda *_: ended.append(True))
    caught, seen = [], None
    while not ended:
        with open(path, "rb") as file:
            frame = file.read()
        if frame != seen:
            seen = frame
            header, colours = struct.unpack(">I", frame[:4])[0], struct.unpack(">I", frame[76:80])[0]
            found = extent(frame, header + 12 * colours, SCREEN_WIDTH * 4)
            if abs(found[0] - (width - FRAME[0])) <= 2 and abs(found[1] - (height - FRAME[1])) <= 2:
                caught.append(frame)
        time.sleep(0.001)
    if not caught:
        return 1
    # A window just being made or unmade lacks its caption or texts: the fullest frame compresses worst.
    with open(output, "wb") as file:
        file.write(max(caught[-30:], key=lambda frame: len(zlib.compress(frame, 1))))
    return 0


sys.exit(watch(sys.argv[1], int(sys.argv[2]), int(sys.argv[3]), sys.argv[4]))
