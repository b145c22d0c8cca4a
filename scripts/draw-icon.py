#!/usr/bin/env python3
"""Draws Varnel's 32 x 32 icon (app/Varnel-icon.png): a little two-pane
window, folder tree on the left and file rows on the right, with a yellow
folder in front. Run it again after changing the drawing."""
import struct
import sys
import zlib

SIZE = 32
CLEAR = (0, 0, 0, 0)
pixels = [[CLEAR] * SIZE for _ in range(SIZE)]


def fill(left, top, right, bottom, color):
    for y in range(top, bottom + 1):
        for x in range(left, right + 1):
            pixels[y][x] = color


def frame(left, top, right, bottom, color):
    fill(left, top, right, top, color)
    fill(left, bottom, right, bottom, color)
    fill(left, top, left, bottom, color)
    fill(right, top, right, bottom, color)


BLACK = (0, 0, 0, 255)
GREY = (205, 205, 205, 255)
DARK = (120, 120, 120, 255)
WHITE = (255, 255, 255, 255)
TAB = (255, 203, 0, 255)
GREEN = (0, 120, 80, 255)
BLUE = (0, 0, 255, 255)
RED = (255, 0, 0, 255)
FOLDER = (255, 216, 96, 255)
FOLDER_DARK = (200, 150, 30, 255)

# The window: yellow title tab, grey body, two white panes.
fill(1, 1, 17, 5, TAB)
frame(1, 1, 17, 5, BLACK)
fill(1, 5, 29, 27, GREY)
frame(1, 5, 29, 27, BLACK)
fill(3, 7, 11, 25, WHITE)
frame(3, 7, 11, 25, GREEN)
fill(13, 7, 27, 25, WHITE)
frame(13, 7, 27, 25, DARK)

# The tree: boxes and indented rows.
for row, indent in ((9, 0), (13, 2), (17, 2), (21, 0)):
    fill(5 + indent, row, 6 + indent, row + 1, DARK)
    fill(8 + indent, row, 10, row + 1, BLUE if indent == 0 else RED)

# The file list: rows of names and sizes.
for row in range(9, 24, 3):
    fill(15, row, 21, row, BLACK)
    fill(23, row, 25, row, DARK)

# A folder in front, at the lower right.
fill(17, 19, 22, 21, FOLDER_DARK)
fill(17, 21, 30, 30, FOLDER)
frame(17, 21, 30, 30, BLACK)
fill(17, 19, 22, 19, BLACK)
fill(17, 19, 17, 21, BLACK)
fill(22, 19, 23, 20, BLACK)
fill(18, 22, 29, 22, (255, 240, 170, 255))


def chunk(kind, data):
    body = kind + data
    return struct.pack(">I", len(data)) + body + struct.pack(">I", zlib.crc32(body))


raw = b"".join(b"\0" + b"".join(bytes(p) for p in line) for line in pixels)
png = (b"\x89PNG\r\n\x1a\n"
       + chunk(b"IHDR", struct.pack(">IIBBBBB", SIZE, SIZE, 8, 6, 0, 0, 0))
       + chunk(b"IDAT", zlib.compress(raw, 9))
       + chunk(b"IEND", b""))
out = sys.argv[1] if len(sys.argv) > 1 else "app/Varnel-icon.png"
with open(out, "wb") as f:
    f.write(png)
