#!/usr/bin/env python3
"""Draws the launcher icons (96x96 PNG): the companions' into this folder, the memo app's into res/icon/."""
import math
import os
import struct
import zlib

SIZE = 96
SS = 4  # samples per pixel side


def png(path, pixels):
    raw = b"".join(b"\0" + bytes(row) for row in pixels)

    def chunk(kind, data):
        return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data) & 0xFFFFFFFF)

    with open(path, "wb") as f:
        f.write(b"\x89PNG\r\n\x1a\n")
        f.write(chunk(b"IHDR", struct.pack(">IIBBBBB", SIZE, SIZE, 8, 6, 0, 0, 0)))
        f.write(chunk(b"IDAT", zlib.compress(raw, 9)))
        f.write(chunk(b"IEND", b""))


def rrect(x0, y0, x1, y1, r):
    def inside(x, y):
        cx = min(max(x, x0 + r), x1 - r)
        cy = min(max(y, y0 + r), y1 - r)
        return x0 <= x <= x1 and y0 <= y <= y1 and (x - cx) ** 2 + (y - cy) ** 2 <= r * r
    return inside


def circle(cx, cy, r):
    return lambda x, y: (x - cx) ** 2 + (y - cy) ** 2 <= r * r


def ring(cx, cy, r, w):
    return lambda x, y: (r - w) ** 2 <= (x - cx) ** 2 + (y - cy) ** 2 <= r * r


def poly(points):
    def inside(x, y):
        n, hit = len(points), False
        for i in range(n):
            (ax, ay), (bx, by) = points[i], points[(i + 1) % n]
            if (ay > y) != (by > y) and x < ax + (y - ay) * (bx - ax) / (by - ay):
                hit = not hit
        return hit
    return inside


def line(ax, ay, bx, by, w):
    def inside(x, y):
        dx, dy = bx - ax, by - ay
        t = max(0, min(1, ((x - ax) * dx + (y - ay) * dy) / (dx * dx + dy * dy)))
        return (x - ax - t * dx) ** 2 + (y - ay - t * dy) ** 2 <= (w / 2) ** 2
    return inside


def draw(name, background, shapes):
    """shapes: list of (inside(x, y), (r, g, b)) painted in order over the rounded background."""
    layers = [(rrect(4, 4, 92, 92, 18), background)] + shapes
    pixels = []
    for py in range(SIZE):
        row = []
        for px in range(SIZE):
            acc = [0.0, 0.0, 0.0, 0.0]
            for sy in range(SS):
                for sx in range(SS):
                    x, y = px + (sx + 0.5) / SS, py + (sy + 0.5) / SS
                    colour = None
                    for inside, c in layers:
                        if inside(x, y):
                            colour = c
                    if colour:
                        acc[0] += colour[0]
                        acc[1] += colour[1]
                        acc[2] += colour[2]
                        acc[3] += 1
            n = acc[3]
            row += [int(acc[0] / n), int(acc[1] / n), int(acc[2] / n), int(255 * n / SS / SS)] if n else [0, 0, 0, 0]
        pixels.append(row)
    here = os.path.dirname(os.path.abspath(__file__))
    folder = os.path.join(here, "..", "..", "res", "icon") if name == "memo" else here
    png(os.path.join(folder, name + ".png"), pixels)


WHITE = (255, 255, 255)

draw("gallery", (52, 152, 219), [
    (rrect(20, 24, 76, 72, 6), WHITE),
    (poly([(24, 68), (42, 44), (56, 62), (62, 54), (72, 68)]), (39, 174, 96)),
    (circle(62, 36, 6), (241, 196, 15)),
])
draw("camera", (52, 73, 94), [
    (rrect(16, 30, 80, 74, 8), WHITE),
    (rrect(36, 22, 60, 34, 4), WHITE),
    (circle(48, 52, 15), (52, 73, 94)),
    (circle(48, 52, 10), (149, 165, 166)),
    (circle(70, 38, 3), (231, 76, 60)),
])
draw("image-viewer", (142, 68, 173), [
    (ring(42, 42, 20, 6), WHITE),
    (line(56, 56, 76, 76, 10), WHITE),
    (line(34, 42, 50, 42, 4), WHITE),
    (line(42, 34, 42, 50, 4), WHITE),
])
draw("share-clipboard", (22, 160, 133), [
    (rrect(24, 20, 72, 80, 6), WHITE),
    (rrect(38, 14, 58, 26, 4), (44, 62, 80)),
    (line(32, 42, 64, 42, 4), (22, 160, 133)),
    (line(32, 54, 64, 54, 4), (22, 160, 133)),
    (line(32, 66, 54, 66, 4), (22, 160, 133)),
])
draw("share-save", (230, 126, 34), [
    (poly([(18, 30), (40, 30), (46, 36), (78, 36), (78, 74), (18, 74)]), WHITE),
    (poly([(48, 44), (48, 58), (40, 58), (52, 70), (64, 58), (56, 58), (56, 44)]), (230, 126, 34)),
])
draw("share-email", (192, 57, 43), [
    (rrect(16, 28, 80, 70, 4), WHITE),
    (line(18, 30, 48, 52, 5), (192, 57, 43)),
    (line(48, 52, 78, 30, 5), (192, 57, 43)),
])
draw("storage-settings", (39, 174, 96), [
    (rrect(20, 20, 76, 40, 5), WHITE),
    (rrect(20, 46, 76, 66, 5), WHITE),
    (circle(66, 30, 3), (39, 174, 96)),
    (circle(66, 56, 3), (39, 174, 96)),
    (rrect(20, 72, 76, 78, 3), WHITE),
    (rrect(20, 72, 52, 78, 3), (241, 196, 15)),
])
draw("veltronaccount", (41, 128, 185), [
    (circle(48, 34, 14), WHITE),
    (poly([(22, 78), (26, 60), (36, 52), (60, 52), (70, 60), (74, 78)]), WHITE),
    (rrect(56, 58, 82, 80, 4), (241, 196, 15)),
    (ring(69, 56, 7, 4), (241, 196, 15)),
    (circle(69, 68, 3), (41, 128, 185)),
])
draw("memo-popup", (214, 69, 65), [
    (rrect(42, 18, 54, 58, 6), WHITE),
    (circle(48, 72, 7), WHITE),
])
draw("memo", (241, 196, 15), [
    (poly([(22, 16), (62, 16), (74, 28), (74, 80), (22, 80)]), WHITE),
    (poly([(62, 16), (74, 28), (62, 28)]), (214, 170, 10)),
    (line(32, 40, 64, 40, 4), (127, 140, 141)),
    (line(32, 52, 64, 52, 4), (127, 140, 141)),
    (line(32, 64, 52, 64, 4), (127, 140, 141)),
])
