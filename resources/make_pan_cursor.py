#!/usr/bin/env python3
"""Writes pan.cur: the library's pan cursor, a 32 x 32 monochrome four-headed
arrow with its hot spot at the centre (16, 16).

The arrow is black with a one-pixel white outline; everything else is
transparent. Run it from this folder when the shape changes and commit the
result: the build compiles pan.cur as it is.

    python3 make_pan_cursor.py [output]
"""
import struct
import sys

SIZE = 32
HOT_X, HOT_Y = 16, 16
CENTRE = 16
SHAFT_HALF = 1   # shafts are 3 pixels wide
HEAD_LENGTH = 6  # rows of each arrowhead, apex included
TIP = 1          # distance of each apex from the cursor's edge


def arrow_pixels():
    """The set of (x, y) pixels of the arrow, y downwards."""
    shape = set()
    far = SIZE - 1 - TIP
    # Shafts, between the arrowheads.
    for t in range(TIP + HEAD_LENGTH, far - HEAD_LENGTH + 1):
        for w in range(-SHAFT_HALF, SHAFT_HALF + 1):
            shape.add((CENTRE + w, t))  # vertical
            shape.add((t, CENTRE + w))  # horizontal
    # Arrowheads: row k from the apex is 2k + 1 pixels wide.
    for k in range(HEAD_LENGTH):
        for w in range(-k, k + 1):
            shape.add((CENTRE + w, TIP + k))  # up
            shape.add((CENTRE + w, far - k))  # down
            shape.add((TIP + k, CENTRE + w))  # left
            shape.add((far - k, CENTRE + w))  # right
    return shape


def outline(shape):
    ring = set()
    for (x, y) in shape:
        for (dx, dy) in ((-1, 0), (1, 0), (0, -1), (0, 1)):
            p = (x + dx, y + dy)
            if p not in shape and 0 <= p[0] < SIZE and 0 <= p[1] < SIZE:
                ring.add(p)
    return ring


def mask_rows(is_set):
    """1-bit rows, bottom row first, 4 bytes each, leftmost pixel in bit 7."""
    data = bytearray()
    for y in range(SIZE - 1, -1, -1):
        row = 0
        for x in range(SIZE):
            if is_set(x, y):
                row |= 1 << (SIZE - 1 - x)
        data += struct.pack(">I", row)
    return bytes(data)


def cursor_file():
    shape = arrow_pixels()
    ring = outline(shape)
    # XOR 1 with AND 0 is white, XOR 0 with AND 0 black, XOR 0 with AND 1
    # leaves the screen as it is.
    xor_mask = mask_rows(lambda x, y: (x, y) in ring)
    and_mask = mask_rows(lambda x, y: (x, y) not in shape and (x, y) not in ring)
    header = struct.pack("<IiiHHIIiiII", 40, SIZE, 2 * SIZE, 1, 1, 0, len(xor_mask) + len(and_mask), 0, 0, 2, 0)
    colours = struct.pack("<4B4B", 0, 0, 0, 0, 255, 255, 255, 0)
    image = header + colours + xor_mask + and_mask
    directory = struct.pack("<HHH", 0, 2, 1)
    entry = struct.pack("<BBBBHHII", SIZE, SIZE, 2, 0, HOT_X, HOT_Y, len(image), 6 + 16)
    return directory + entry + image


if __name__ == "__main__":
    path = sys.argv[1] if len(sys.argv) > 1 else "pan.cur"
    with open(path, "wb") as out:
        out.write(cursor_file())
