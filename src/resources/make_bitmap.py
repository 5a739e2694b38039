#!/usr/bin/env python3
"""Turns a text picture (see object_picture.txt) into a .bmp file.

The file is an 8-bit bitmap with a full 256-colour palette: a 14-byte file
header, a 40-byte info header, 1024 bytes of palette and one byte per pixel.
The resource compiler drops the file header, so the library's bitmap resource
is the packed bitmap that follows it.

usage: make_bitmap.py PICTURE.txt OUTPUT.bmp
"""
import struct
import sys

PALETTE_SIZE = 256


def fail(path, line, message):
    sys.exit(f"{path}:{line}: {message}")


def read_picture(path):
    legend, rows, section = {}, [], None
    with open(path, encoding="ascii") as text:
        for number, raw in enumerate(text, 1):
            line = raw.rstrip("\n")
            if not line or line.startswith(";"):
                continue
            if line in ("[legend]", "[picture]"):
                section = line
            elif section == "[legend]":
                fields = line.split()
                if len(line) < 2 or line[1] != " " or len(fields) < 4:
                    fail(path, number, "a legend line is: CHARACTER RED GREEN BLUE [description]")
                try:
                    rgb = tuple(int(v) for v in fields[1:4])
                except ValueError:
                    fail(path, number, "colour components must be whole numbers")
                if any(c < 0 or c > 255 for c in rgb):
                    fail(path, number, "colour components must be 0 to 255")
                if line[0] in legend:
                    fail(path, number, f"'{line[0]}' has a colour already")
                legend[line[0]] = (len(legend), rgb)
            elif section == "[picture]":
                for column, character in enumerate(line):
                    if character not in legend:
                        fail(path, number, f"column {column + 1}: '{character}' has no colour in the legend")
                rows.append((number, line))
            else:
                fail(path, number, "text before [legend]")
    if not rows:
        fail(path, 0, "no [picture] rows")
    width = len(rows[0][1])
    for number, row in rows:
        if len(row) != width:
            fail(path, number, f"row is {len(row)} pixels wide, the first row is {width}")
    if len(legend) > PALETTE_SIZE:
        fail(path, 0, f"more than {PALETTE_SIZE} colours")
    return legend, [row for _, row in rows]


def bitmap_bytes(legend, rows):
    width, height = len(rows[0]), len(rows)
    stride = (width + 3) & ~3
    palette = bytearray(4 * PALETTE_SIZE)
    for index, (red, green, blue) in legend.values():
        palette[4 * index:4 * index + 4] = bytes((blue, green, red, 0))
    pixels = bytearray()
    for row in reversed(rows):  # bottom row first
        pixels += bytes(legend[c][0] for c in row) + bytes(stride - width)
    info = struct.pack("<IiiHHIIiiII", 40, width, height, 1, 8, 0, len(pixels), 2835, 2835, 0, 0)
    offset = 14 + len(info) + len(palette)
    header = struct.pack("<2sIHHI", b"BM", offset + len(pixels), 0, 0, offset)
    return header + info + palette + pixels


def main():
    if len(sys.argv) != 3:
        sys.exit(__doc__.strip().splitlines()[-1])
    legend, rows = read_picture(sys.argv[1])
    with open(sys.argv[2], "wb") as out:
        out.write(bitmap_bytes(legend, rows))


if __name__ == "__main__":
    main()
