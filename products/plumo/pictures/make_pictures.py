#!/usr/bin/env python3
"""Draws the pictures of the Plumo setup program: plumo.bmp (the wizard's side picture) and plumo.ico.

usage: make_pictures.py [FOLDER]     (default: the folder of this script)

Plain Python, no packages. Every shape is a signed distance function, so edges are smooth without supersampling. The
same input always gives the same bytes: run it again after a change and commit the two files.
"""

import math
import random
import struct
import sys
from pathlib import Path

WIDTH, HEIGHT = 160, 440
GROUND = (204, 204, 204)  # what the wizard leaves out when it draws the picture
PAGE = (227, 241, 228)  # the pages' background: soft edges of the picture fade into it
SKY = [(0.0, (13, 17, 46)), (0.45, (33, 40, 98)), (0.75, (77, 66, 140)), (1.0, (160, 108, 158))]
PLANET, RADIUS = (86.0, 152.0), 41.0
RING_TILT = math.radians(-22)


def mix(a, b, t):
    return tuple(p + (q - p) * t for p, q in zip(a, b))


def clamp(value, low=0.0, high=1.0):
    return max(low, min(high, value))


def coverage(distance):
    """How much of a pixel lies inside a shape whose edge is this far away (negative: inside)."""
    return clamp(0.5 - distance)


def gradient(stops, t):
    for (t0, a), (t1, b) in zip(stops, stops[1:]):
        if t <= t1:
            return mix(a, b, clamp((t - t0) / (t1 - t0)))
    return stops[-1][1]


def segment(x, y, ax, ay, bx, by):
    """Distance to the line from a to b."""
    dx, dy = bx - ax, by - ay
    t = clamp(((x - ax) * dx + (y - ay) * dy) / (dx * dx + dy * dy))
    return math.hypot(x - ax - t * dx, y - ay - t * dy)


def stadium(x, y, cx, cy, half, radius):
    """Distance to the outline of a rounded bar: two half circles of this radius, `half` above and below the centre."""
    return abs(math.hypot(x - cx, max(abs(y - cy) - half, 0.0)) - radius)


# One function for each letter, in a box 18 wide and 26 high; the distance to its strokes.
LETTERS = {
    "P": lambda x, y: min(segment(x, y, 1, 0, 1, 26), segment(x, y, 1, 0, 9, 0), segment(x, y, 1, 14, 9, 14),
                          abs(math.hypot(x - 9, y - 7) - 7) if x >= 9 else 99),
    "L": lambda x, y: min(segment(x, y, 2, 0, 2, 26), segment(x, y, 2, 26, 15, 26)),
    "U": lambda x, y: min(segment(x, y, 1, 0, 1, 18), segment(x, y, 17, 0, 17, 18),
                          abs(math.hypot(x - 9, y - 18) - 8) if y >= 18 else 99),
    "M": lambda x, y: min(segment(x, y, 0, 26, 0, 0), segment(x, y, 0, 0, 9, 15), segment(x, y, 9, 15, 18, 0),
                          segment(x, y, 18, 0, 18, 26)),
    "O": lambda x, y: stadium(x, y, 9, 13, 5, 8),
}


def word_distance(x, y, top):
    places = {"P": 17, "L": 43, "U": 65, "M": 92, "O": 119}  # set by eye: an L leaves more room behind it than a U
    return min(LETTERS[letter](x - left, y - top) for letter, left in places.items())


def ring_coordinates(x, y, centre, flat):
    """The pixel in the ring's own plane: distance from the centre, and its depth (positive: before the planet)."""
    dx, dy = x - centre[0], y - centre[1]
    u = dx * math.cos(RING_TILT) + dy * math.sin(RING_TILT)
    v = -dx * math.sin(RING_TILT) + dy * math.cos(RING_TILT)
    return math.hypot(u, v / flat), v


def planet_colour(x, y, centre, radius):
    """A lit ball with soft bands, light from the upper left."""
    u, v = (x - centre[0]) / radius, (y - centre[1]) / radius
    z = math.sqrt(max(0.0, 1 - u * u - v * v))
    across = -u * math.sin(RING_TILT) + v * math.cos(RING_TILT)
    band = 0.5 + 0.5 * math.sin(across * 9 + 0.6 * math.sin(across * 23))
    light = clamp(0.12 + 0.95 * (-0.55 * u - 0.5 * v + 0.67 * z))
    return mix((38, 24, 66), mix((238, 172, 110), (250, 212, 160), band), light)


BANDS = [(1.32, 1.60, (214, 196, 226), 0.85), (1.66, 1.84, (160, 150, 206), 0.6)]  # in planet radii, colour, strength
ICON_BANDS = [(1.28, 1.60, (104, 92, 176), 1.0)]  # darker, to be seen on a light desktop


def draw_ring(colour, x, y, centre, radius, front, bands=BANDS):
    distance, depth = ring_coordinates(x, y, centre, 0.27)
    if (depth > 0) != front:
        return colour, 0.0
    slope = 0.45 + 0.55 * abs(x - centre[0]) / (2 * radius)  # the ring is thin where we see it edge on
    ring, alpha = colour, 0.0
    for inner, outer, tint, strength in bands:
        middle, half = (inner + outer) / 2 * radius, (outer - inner) / 2 * radius
        cover = coverage((abs(distance - middle) - half) * slope) * strength
        ring, alpha = mix(ring, tint, cover), max(alpha, cover)
    return ring, alpha


def stars(count):
    rng = random.Random(434)
    return [(rng.uniform(2, 150), rng.uniform(4, 280), rng.uniform(0.35, 1.0)) for _ in range(count)]


def star_light(x, y, field):
    return sum(bright * math.exp(-((x - sx) ** 2 + (y - sy) ** 2) * (3.2 - 1.8 * bright)) for sx, sy, bright in field
               if abs(x - sx) < 3 and abs(y - sy) < 3)


def sky_pixel(x, y, field):
    colour = gradient(SKY, y / HEIGHT)
    colour = mix(colour, (255, 250, 235), clamp(star_light(x, y, field)))
    around = math.hypot(x - PLANET[0], y - PLANET[1])
    for radius in (94.0, 128.0, 170.0):
        colour = mix(colour, (170, 180, 235), 0.20 * coverage(abs(around - radius) - 0.4))
    for angle, radius, size in ((-58, 94.0, 4.5), (118, 128.0, 3.0)):  # two moons on their orbits
        mx, my = PLANET[0] + radius * math.cos(math.radians(angle)), PLANET[1] + radius * math.sin(math.radians(angle))
        lit = mix((150, 160, 205), (240, 240, 250), clamp(0.5 - (x - mx + y - my) / (2.2 * size)))
        colour = mix(colour, lit, coverage(math.hypot(x - mx, y - my) - size))
    return colour


def ground_pixel(colour, x, y):
    """The limb of a near world along the bottom, and the product's name above it."""
    limb = math.hypot(x - 40, y - 760) - 392
    colour = mix(colour, (255, 214, 190), 0.55 * math.exp(-max(limb, 0.0) / 9))
    colour = mix(colour, mix((58, 34, 92), (20, 16, 50), clamp(-limb / 60)), coverage(limb))
    return mix(colour, (255, 255, 255), coverage(word_distance(x, y, 290.0) - 1.15))


def picture_pixel(x, y, field):
    """The pixel's colour, or None where the page shows through."""
    panel = coverage((x - (151 - 14 * ((y - PLANET[1]) / 290) ** 2)))
    colour = ground_pixel(sky_pixel(x, y, field), x, y)
    colour, back = draw_ring(colour, x, y, PLANET, RADIUS, False)
    ball = coverage(math.hypot(x - PLANET[0], y - PLANET[1]) - RADIUS)
    colour = mix(colour, planet_colour(x, y, PLANET, RADIUS), ball)
    colour, front = draw_ring(colour, x, y, PLANET, RADIUS, True)
    shown = max(panel, back, front)
    return None if shown < 0.02 else mix(PAGE, colour, shown)


def palette_of(colours, size):
    """Median cut: boxes of colours, always the widest halved at its median."""
    boxes = [sorted(set(colours))]
    def width(box):
        return max(max(c[i] for c in box) - min(c[i] for c in box) for i in range(3)) * len(box) ** 0.25
    while len(boxes) < size:
        box = max(boxes, key=lambda b: width(b) if len(b) > 1 else -1)
        axis = max(range(3), key=lambda i: max(c[i] for c in box) - min(c[i] for c in box))
        box.sort(key=lambda c: c[axis])
        boxes.remove(box)
        boxes += [box[:len(box) // 2], box[len(box) // 2:]]
    return [tuple(round(sum(c[i] for c in box) / len(box)) for i in range(3)) for box in boxes]


def indexed(pixels):
    """Palette and one index for each pixel; index 0 is the ground. A little noise hides the steps of the gradient."""
    rng = random.Random(160)
    rounded = [None if p is None else tuple(int(clamp(c + rng.uniform(-1.5, 1.5), 0, 255)) for c in p) for p in pixels]
    palette = palette_of([p for p in rounded if p], 255)
    palette = [c if c != GROUND else (205, 204, 204) for c in palette]
    nearest = {}
    def index(p):
        if p not in nearest:
            nearest[p] = 1 + min(range(255), key=lambda i: sum((a - b) ** 2 for a, b in zip(p, palette[i])))
        return nearest[p]
    return [GROUND] + palette, [0 if p is None else index(p) for p in rounded]


def write_bitmap(path):
    field = stars(85)
    pixels = [picture_pixel(x + 0.5, y + 0.5, field) for y in range(HEIGHT) for x in range(WIDTH)]
    palette, indices = indexed(pixels)
    table = b"".join(bytes((b, g, r, 0)) for r, g, b in palette)
    rows = b"".join(bytes(indices[y * WIDTH:(y + 1) * WIDTH]) for y in reversed(range(HEIGHT)))
    offset = 14 + 40 + len(table)
    header = struct.pack("<2sIHHI", b"BM", offset + len(rows), 0, 0, offset)
    info = struct.pack("<IiiHHIIiiII", 40, WIDTH, HEIGHT, 1, 8, 0, len(rows), 3780, 3780, 256, 0)
    path.write_bytes(header + info + table + rows)


def icon_pixel(x, y, size):
    centre, radius = (size / 2, size / 2), size * 0.31
    colour, back = draw_ring(ICON_BANDS[0][2], x, y, centre, radius, False, ICON_BANDS)
    ball = coverage(math.hypot(x - centre[0], y - centre[1]) - radius)
    colour = mix(colour, planet_colour(x, y, centre, radius), ball)
    colour, front = draw_ring(colour, x, y, centre, radius, True, ICON_BANDS)
    return colour, max(ball, back, front)


def icon_image(size):
    rows, mask = b"", b""
    for y in reversed(range(size)):
        pixels = [icon_pixel(x + 0.5, y + 0.5, size) for x in range(size)]
        rows += b"".join(bytes((int(b), int(g), int(r), int(255 * a))) for (r, g, b), a in pixels)
        bits = sum(1 << (size - 1 - x) for x, (_, a) in enumerate(pixels) if a < 0.5)
        stride = (size + 31) // 32 * 4
        mask += (bits << (stride * 8 - size)).to_bytes(stride, "big")
    return struct.pack("<IiiHHIIiiII", 40, size, 2 * size, 1, 32, 0, len(rows) + len(mask), 0, 0, 0, 0) + rows + mask


def write_icon(path, sizes=(16, 32, 48)):
    images = [icon_image(size) for size in sizes]
    offset = 6 + 16 * len(images)
    directory = struct.pack("<HHH", 0, 1, len(images))
    for size, image in zip(sizes, images):
        directory += struct.pack("<BBBBHHII", size, size, 0, 0, 1, 32, len(image), offset)
        offset += len(image)
    path.write_bytes(directory + b"".join(images))


def main():
    folder = Path(sys.argv[1]) if len(sys.argv) > 1 else Path(__file__).resolve().parent
    write_bitmap(folder / "plumo.bmp")
    write_icon(folder / "plumo.ico")


main()
