"""Writes the hills that every program of the comparison draws, as a binary PLY file.

usage: hills.py SIZE FILE
"""

import array
import math
import struct
import sys

# Triangles by name of the size; the mesh has two a cell.
CELLS = {"10k": 71, "100k": 224, "1M": 708, "5M": 1582}


def heights(cells):
    """The coordinates of (cells + 1) squared points over a square of 100 by 100."""
    places = [100.0 * i / cells - 50.0 for i in range(cells + 1)]
    points = array.array("f")
    for y in places:
        cosine = math.cos(0.17 * y)
        for x in places:
            z = 4.0 * math.sin(0.2 * x) * cosine + math.sin(0.9 * x + 0.7 * y)
            points.extend((x, y, z))
    return points


def triangles(cells):
    """Each as the byte 3 and three indices of points, anticlockwise seen from above."""
    pack = struct.Struct("<B3iB3i").pack
    side = cells + 1
    faces = bytearray()
    for j in range(cells):
        for a in range(j * side, j * side + cells):
            faces += pack(3, a, a + 1, a + side + 1, 3, a, a + side + 1, a + side)
    return faces


def write(path, cells):
    points = heights(cells)
    if sys.byteorder == "big":
        points.byteswap()
    header = (
        "ply\nformat binary_little_endian 1.0\n"
        f"element vertex {(cells + 1) ** 2}\n"
        "property float x\nproperty float y\nproperty float z\n"
        f"element face {2 * cells * cells}\n"
        "property list uchar int vertex_indices\nend_header\n"
    )
    with open(path, "wb") as file:
        file.write(header.encode("ascii"))
        file.write(points.tobytes())
        file.write(triangles(cells))


if __name__ == "__main__":
    write(sys.argv[2], CELLS[sys.argv[1]])
