#!/usr/bin/env python3
"""Writes floor-tiles.bmp: a 32 x 32, 24-bit BMP of four square tiles with light joints.

The modeller applies textures in blend mode, so dark texels show the floor's own colour and
light ones darken it: the tiles come out in the material colour with dark joints.
"""
import struct
import sys

SIZE = 32
TILE = 16
JOINT = 1


def texel(x, y):
    if x % TILE < JOINT or y % TILE < JOINT:
        return (200, 200, 200)  # joint
    shade = 40 + 12 * (((x // TILE) + (y // TILE)) % 2)  # neighbouring tiles differ a little
    return (shade, shade, shade)


def bmp(width, height, pixel):
    row_bytes = (width * 3 + 3) // 4 * 4
    rows = b""
    for y in range(height):  # bottom row first
        row = b"".join(bytes(reversed(pixel(x, y))) for x in range(width))  # blue, green, red
        rows += row + b"\0" * (row_bytes - len(row))
    header = struct.pack("<2sIHHI", b"BM", 54 + len(rows), 0, 0, 54)
    info = struct.pack("<IiiHHIIiiII", 40, width, height, 1, 24, 0, len(rows), 2835, 2835, 0, 0)
    return header + info + rows


if __name__ == "__main__":
    out = sys.argv[1] if len(sys.argv) > 1 else "floor-tiles.bmp"
    with open(out, "wb") as f:
        f.write(bmp(SIZE, SIZE, texel))
