"""Files with maps for tests: all of one colour, so that a picture shows where they are drawn."""

import math
import sqlite3
import struct
import zlib

# East of Berlin, where no map that comes along has streets.
PLACE = (52.42, 13.95)
MAGENTA = b"\xff\x00\xff"


def png(color, side=256):
    def chunk(kind, data):
        return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data))
    rows = (b"\x00" + color * side) * side
    return (b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", struct.pack(">IIBBBBB", side, side, 8, 2, 0, 0, 0))
            + chunk(b"IDAT", zlib.compress(rows)) + chunk(b"IEND", b""))


def write_region(path):
    """A file with pictures around the place."""
    with sqlite3.connect(path) as database:
        database.execute("CREATE TABLE metadata (name TEXT, value TEXT)")
        database.execute("CREATE TABLE tiles (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_data BLOB)")
        database.execute("CREATE UNIQUE INDEX tile_index ON tiles (zoom_level, tile_column, tile_row)")
        database.executemany("INSERT INTO metadata VALUES (?, ?)", [("format", "png"), ("minzoom", "9"), ("maxzoom", "14"),
                                                                      ("bounds", "13.45,52.22,14.45,52.62")])
        for level in range(9, 15):
            count = 2 ** level
            x = int((PLACE[1] / 360 + 0.5) * count)
            y = int((0.5 - math.asinh(math.tan(math.radians(PLACE[0]))) / math.tau) * count)
            database.executemany("INSERT INTO tiles VALUES (?, ?, ?, ?)", [
                (level, x + dx, count - 1 - y - dy, png(MAGENTA)) for dx in range(-3, 4) for dy in range(-3, 4)])
    database.close()
    return path
