"""Vector tiles (Mapbox Vector Tile 2.1) in an MBTiles 1.3 file."""
import gzip
import math
import sqlite3
import struct

from . import shapes

EXTENT = 4096
BUFFER = 96  # steps of the extent that lines and areas reach beyond their tile
POINT, LINE, AREA = 1, 2, 3


def varint(value):
    result = bytearray()
    while value >= 0x80:
        result.append(value & 0x7F | 0x80)
        value >>= 7
    result.append(value)
    return bytes(result)


def field(number, data):
    return varint(number << 3 | 2) + varint(len(data)) + data


def zigzag(value):
    return value << 1 if value >= 0 else -value * 2 - 1


class Layer:
    def __init__(self, name):
        self.name = name
        self.keys, self.values, self.features = {}, {}, []

    def add(self, kind, parts, attributes):
        """`parts` in steps of the tile. Adds nothing when nothing is left of them."""
        commands, x, y = [], 0, 0
        if kind == POINT:
            commands.append(len(parts) << 3 | 1)
            for px, py in parts:
                commands += [zigzag(px - x), zigzag(py - y)]
                x, y = px, py
        else:
            for part in parts:
                points = [p for i, p in enumerate(part) if i == 0 or p != part[i - 1]]
                if kind == AREA and points and points[0] == points[-1]:
                    points.pop()
                if len(points) < (3 if kind == AREA else 2):
                    continue
                for i, (px, py) in enumerate(points):
                    if i == 0:
                        commands.append(1 << 3 | 1)
                    elif i == 1:
                        commands.append(len(points) - 1 << 3 | 2)
                    commands += [zigzag(px - x), zigzag(py - y)]
                    x, y = px, py
                if kind == AREA:
                    commands.append(1 << 3 | 7)
        if not commands:
            return
        tags = []
        for key, value in attributes.items():
            tags += [self.keys.setdefault(key, len(self.keys)),
                     self.values.setdefault((type(value), value), len(self.values))]
        self.features.append(field(2, b"".join(map(varint, tags))) + varint(3 << 3) + varint(kind) +
                             field(4, b"".join(map(varint, commands))))

    def encoded(self):
        data = varint(15 << 3) + varint(2) + field(1, self.name.encode())
        data += b"".join(field(2, feature) for feature in self.features)
        data += b"".join(field(3, key.encode()) for key in self.keys)
        for kind, value in self.values:
            if kind is bool:
                encoded = varint(7 << 3) + varint(int(value))
            elif kind is int:
                encoded = varint(4 << 3) + varint(value)
            elif kind is float:
                encoded = varint(3 << 3 | 1) + struct.pack("<d", value)
            else:
                encoded = field(1, value.encode())
            data += field(4, encoded)
        return data + varint(5 << 3) + varint(EXTENT)


class Tileset:
    """Features by layer, in metres about a place; cut into tiles when written."""

    def __init__(self, latitude, longitude):
        self.latitude, self.longitude = latitude, longitude
        self.features = []

    def add(self, layer, kind, parts, attributes, first=0, last=99):
        """Shown at the levels `first` to `last`. A point is one part; areas: the outer ring, then holes."""
        self.features.append((layer, kind, parts, attributes, first, last))

    def place(self, x, y):
        """Latitude and longitude; the metres are those of a sphere of the Earth's equator, as on Mercator's map."""
        radius = 6378137.0
        latitude = self.latitude + math.degrees(y / radius)
        return latitude, self.longitude + math.degrees(x / (radius * math.cos(math.radians(self.latitude))))

    def world(self, x, y):
        latitude, longitude = self.place(x, y)
        return longitude / 360 + 0.5, 0.5 - math.asinh(math.tan(math.radians(latitude))) / (2 * math.pi)

    def tiles(self, level):
        scale = (1 << level) * EXTENT
        tolerance = 0 if level >= 14 else 3
        layers = {}
        for name, kind, parts, attributes, first, last in self.features:
            if not first <= level <= last:
                continue
            points = [[(x * scale, y * scale) for x, y in (self.world(*p) for p in part)] for part in parts]
            if tolerance and kind != POINT:
                points = [shapes.simplified(part, tolerance) for part in points]
                if kind == AREA and abs(shapes.area(points[0])) < 60:
                    continue
            xs, ys = [x for part in points for x, _ in part], [y for part in points for _, y in part]
            margin = 0 if kind == POINT else BUFFER
            for column in range(int((min(xs) - margin) // EXTENT), int((max(xs) + margin) // EXTENT) + 1):
                for row in range(int((min(ys) - margin) // EXTENT), int((max(ys) + margin) // EXTENT) + 1):
                    self._cut(layers, (column, row), name, kind, points, attributes)
        return {key: b"".join(field(3, layer.encoded()) for _, layer in sorted(found.items()) if layer.features)
                for key, found in sorted(layers.items())}

    @staticmethod
    def _cut(layers, key, name, kind, parts, attributes):
        left, top = key[0] * EXTENT, key[1] * EXTENT
        box = left - BUFFER, top - BUFFER, left + EXTENT + BUFFER, top + EXTENT + BUFFER
        if kind == AREA:
            cut = [shapes.clip_ring(part, box) for part in parts]
            if not cut[0]:
                return
            # The first ring runs clockwise as one sees it, holes the other way; the tile's y points down.
            cut = [ring if (shapes.area(ring) > 0) == (i == 0) else ring[::-1] for i, ring in enumerate(cut) if ring]
            whole = (EXTENT + 2 * BUFFER)**2
            if len(cut) > 1 and abs(shapes.area(cut[0])) - sum(abs(shapes.area(r)) for r in cut[1:]) < whole * 1e-9:
                return  # a hole takes it all
        elif kind == LINE:
            cut = [piece for part in parts for piece in shapes.clip_line(part, box)]
        else:
            cut = parts
        rounded = [[(round(x - left), round(y - top)) for x, y in part] for part in cut]
        found = layers.setdefault(key, {}).setdefault(name, Layer(name))
        found.add(kind, rounded[0] if kind == POINT and rounded else rounded, attributes)

    def write(self, path, levels, metadata):
        """Rows of MBTiles count from the south."""
        path.unlink(missing_ok=True)
        base = sqlite3.connect(path)
        base.execute("PRAGMA page_size = 4096")
        base.execute("CREATE TABLE metadata (name TEXT, value TEXT)")
        base.execute("CREATE TABLE tiles (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_data BLOB)")
        base.executemany("INSERT INTO metadata VALUES (?, ?)", metadata.items())
        count = 0
        for level in levels:
            for (column, row), data in self.tiles(level).items():
                packed = gzip.compress(data, 9, mtime=0)
                base.execute("INSERT INTO tiles VALUES (?, ?, ?, ?)", (level, column, (1 << level) - 1 - row, packed))
                count += 1
        base.execute("CREATE UNIQUE INDEX tile_index ON tiles (zoom_level, tile_column, tile_row)")
        base.commit()
        base.execute("VACUUM")
        base.close()
        return count
