#!/usr/bin/env python3
"""Draws what the gallery shows: pictures, an icon, a mouse cursor, a clip and a sound.

usage: make_pictures.py [FOLDER [FILE...]]     (default: all of them, into the folder pict beside this script)

Plain Python, no packages. The same input always gives the same bytes: run it again after a change and commit the files.
"""

import math
import struct
import sys
from pathlib import Path

GROUND = (204, 204, 204)  # left out when a picture is drawn
PAPER, INK, BLUE, GOLD, RED, GREEN = (255, 255, 255), (70, 80, 95), (52, 108, 176), (240, 190, 70), (200, 60, 60), (70, 150, 80)


class Canvas:
    """Shapes with hard edges: what is left out has one colour and no soft rim."""

    def __init__(self, width, height, ground=GROUND):
        self.width, self.height = width, height
        self.pixels = [[ground] * width for _ in range(height)]

    def paint(self, inside, colour):
        for y in range(self.height):
            for x in range(self.width):
                if inside(x + 0.5, y + 0.5):
                    self.pixels[y][x] = colour(y / self.height) if callable(colour) else colour
        return self

    def box(self, left, top, right, bottom, colour):
        return self.paint(lambda x, y: left <= x < right and top <= y < bottom, colour)

    def disc(self, cx, cy, radius, colour):
        return self.paint(lambda x, y: math.hypot(x - cx, y - cy) <= radius, colour)

    def polygon(self, points, colour):
        def inside(x, y):
            hits = False
            for (x1, y1), (x2, y2) in zip(points, points[1:] + points[:1]):
                if (y1 > y) != (y2 > y) and x < (x2 - x1) * (y - y1) / (y2 - y1) + x1:
                    hits = not hits
            return hits

        return self.paint(inside, colour)

    def rows(self, stride):
        for row in reversed(self.pixels):
            line = b"".join(bytes((b, g, r)) for r, g, b in row)
            yield line + bytes(stride - len(line))

    def dib(self, height=None):
        stride = (self.width * 3 + 3) // 4 * 4
        data = b"".join(self.rows(stride))
        return struct.pack("<IiiHHIIiiII", 40, self.width, height or self.height, 1, 24, 0, len(data), 3780, 3780, 0, 0), data

    def bmp(self):
        header, data = self.dib()
        return struct.pack("<2sIHHI", b"BM", 54 + len(data), 0, 0, 54) + header + data


def fade(top, bottom):
    return lambda t: tuple(round(a + (b - a) * t) for a, b in zip(top, bottom))


def sheet(canvas, s):
    return canvas.box(3 * s, s, 13 * s, 15 * s, INK).box(4 * s, 2 * s, 12 * s, 14 * s, PAPER)


def new_file(c, s):
    sheet(c, s)
    for y in (4, 7, 10):
        c.box(6 * s, y * s, 10 * s, (y + 1) * s, BLUE)
    return c


def folder(c, s):
    c.box(s, 3 * s, 7 * s, 5 * s, INK).box(s, 4 * s, 15 * s, 14 * s, INK)
    return c.box(2 * s, 6 * s, 14 * s, 13 * s, fade((250, 215, 120), GOLD))


def disk(c, s):
    c.box(2 * s, 2 * s, 14 * s, 14 * s, INK).box(3 * s, 3 * s, 13 * s, 13 * s, BLUE)
    return c.box(5 * s, 3 * s, 11 * s, 7 * s, PAPER).box(4 * s, 9 * s, 12 * s, 13 * s, (225, 230, 236))


def gear(c, s):
    for i in range(8):
        a = i * math.pi / 4
        c.disc(8 * s + 5.6 * s * math.cos(a), 8 * s + 5.6 * s * math.sin(a), 1.7 * s, INK)
    return c.disc(8 * s, 8 * s, 5.2 * s, INK).disc(8 * s, 8 * s, 2.2 * s, GROUND)


def star(c, s):
    points = [(8 * s + r * s * math.sin(i * math.pi / 5), 8.4 * s - r * s * math.cos(i * math.pi / 5))
              for i in range(10) for r in [7.4 if i % 2 == 0 else 3]]
    return c.polygon(points, fade((255, 220, 110), (225, 150, 40)))


def mark(c, s, colour):
    return c.disc(8 * s, 8 * s, 6.4 * s, INK).disc(8 * s, 8 * s, 5.6 * s, colour)


def flag(c, s, stripes):
    c.box(s, 3 * s, 15 * s, 13 * s, INK)
    for i, colour in enumerate(stripes):
        c.box(2 * s, (4 + 8 * i / len(stripes)) * s, 14 * s, (4 + 8 * (i + 1) / len(stripes)) * s, colour)
    return c


def crate(c, s):
    """A box seen from a corner; 16 units wide."""
    c.polygon([(8 * s, s), (15 * s, 4.5 * s), (8 * s, 8 * s), (s, 4.5 * s)], (250, 215, 130))
    c.polygon([(s, 4.5 * s), (8 * s, 8 * s), (8 * s, 15.4 * s), (s, 11.9 * s)], fade((215, 155, 60), (185, 125, 40)))
    c.polygon([(15 * s, 4.5 * s), (8 * s, 8 * s), (8 * s, 15.4 * s), (15 * s, 11.9 * s)], fade((185, 125, 40), (150, 95, 30)))
    return c.polygon([(4.5 * s, 2.8 * s), (11.5 * s, 6.2 * s), (11.5 * s, 9 * s), (10 * s, 9.7 * s), (10 * s, 7 * s), (3 * s, 3.5 * s)], (238, 240, 244))


SMALL = {
    "file": new_file, "folder": folder, "disk": disk, "gear": gear, "star": star, "box": crate,
    "red": lambda c, s: mark(c, s, RED), "green": lambda c, s: mark(c, s, GREEN), "blue": lambda c, s: mark(c, s, BLUE),
    "croatia": lambda c, s: flag(c, s, [RED, PAPER, BLUE]), "germany": lambda c, s: flag(c, s, [(40, 40, 40), RED, GOLD]),
    "austria": lambda c, s: flag(c, s, [RED, PAPER, RED]),
}


def icon_image(draw, size):
    """A 32-bit picture as icons hold it: twice as high, with an alpha channel and an empty mask."""
    canvas = draw(Canvas(size, size), size / 16)
    data = b"".join(bytes((p[2], p[1], p[0], 0 if p == GROUND else 255)) for row in reversed(canvas.pixels) for p in row)
    mask = bytes((size + 31) // 32 * 4 * size)
    return struct.pack("<IiiHHIIiiII", 40, size, size * 2, 1, 32, 0, len(data) + len(mask), 0, 0, 0, 0) + data + mask


def icon(draw, sizes, kind=1, spot=(0, 0)):
    images = [icon_image(draw, size) for size in sizes]
    head, at = struct.pack("<HHH", 0, kind, len(sizes)), 6 + 16 * len(sizes)
    for size, image in zip(sizes, images):
        planes, bits = spot if kind == 2 else (1, 32)
        head += struct.pack("<BBBBHHII", size, size, 0, 0, planes, bits, len(image), at)
        at += len(image)
    return head + b"".join(images)


def arrow(c, s):
    points = [(0, 0), (0, 11), (2.6, 8.6), (4.4, 13), (6.4, 12.2), (4.6, 7.8), (8, 7.8)]
    return c.polygon([(x * s, y * s) for x, y in points], BLUE)


def chunk(name, data):
    return name + struct.pack("<I", len(data)) + data + bytes(len(data) % 2)


def clip(frames, per_second):
    header, first = frames[0].dib()
    size = len(first)
    main = struct.pack("<14I", 1000000 // per_second, size * per_second, 0, 0x10, len(frames), 0, 1, size,
                       frames[0].width, frames[0].height, 0, 0, 0, 0)
    stream = struct.pack("<4s4sIHHIIIIIIIIhhhh", b"vids", b"DIB ", 0, 0, 0, 0, 1, per_second, 0, len(frames), size, 0, 0,
                         0, 0, frames[0].width, frames[0].height)
    movie, index = b"movi", b""
    for frame in frames:
        index += struct.pack("<4sIII", b"00db", 0x10, len(movie), size)
        movie += chunk(b"00db", frame.dib()[1])
    headers = b"hdrl" + chunk(b"avih", main) + chunk(b"LIST", b"strl" + chunk(b"strh", stream) + chunk(b"strf", header))
    return chunk(b"RIFF", b"AVI " + chunk(b"LIST", headers) + chunk(b"LIST", movie) + chunk(b"idx1", index))


def copying(step, steps):
    """A sheet flies from one folder to another."""
    c = Canvas(80, 32)
    for x in (0, 60):
        for y, row in enumerate(folder(Canvas(20, 20), 20 / 16).pixels):
            c.pixels[y + 11][x:x + 20] = row
    t = step / (steps - 1)
    left, top = round(4 + 60 * t), round(12 - 11 * math.sin(math.pi * t))
    return c.box(left, top, left + 11, top + 13, INK).box(left + 1, top + 1, left + 10, top + 12, PAPER).box(
        left + 3, top + 4, left + 8, top + 5, BLUE).box(left + 3, top + 7, left + 8, top + 8, BLUE)


def chime():
    rate, seconds = 8000, 0.5
    data = bytes(
        round(128 + 60 * math.exp(-6 * i / rate) * (math.sin(2 * math.pi * 660 * i / rate) + math.sin(2 * math.pi * 990 * i / rate)) / 2)
        for i in range(int(rate * seconds)))
    return chunk(b"RIFF", b"WAVE" + chunk(b"fmt ", struct.pack("<HHIIHH", 1, 1, rate, rate, 1, 8)) + chunk(b"data", data))


def main():
    folder_path = Path(sys.argv[1]) if len(sys.argv) > 1 else Path(__file__).parent / "pict"
    files = {name + ".bmp": draw(Canvas(16, 16), 1).bmp() for name, draw in SMALL.items()}
    for name in ("box", "gear", "folder", "star"):
        files[name + "32.bmp"] = SMALL[name](Canvas(32, 32), 2).bmp()
    files["logo.bmp"] = crate(Canvas(96, 96), 6).bmp()
    files["side.bmp"] = Canvas(4, 300).paint(lambda x, y: True, fade((28, 58, 104), (122, 164, 212))).bmp()
    files["gallery.ico"] = icon(crate, (32, 16))
    files["pointer.cur"] = icon(arrow, (32,), 2)
    files["copy.avi"] = clip([copying(i, 12) for i in range(12)], 10)
    files["chime.wav"] = chime()
    for name in sys.argv[2:] or files:
        (folder_path / name).write_bytes(files[name])


main()
