"""Brinmouth: its streets, houses, parks, piers and names, put into a tile set."""
import math
import random

from . import island, shapes
from .names import named
from .streets import Grid
from .tiles import AREA, LINE, POINT

ALONG = [  # v, name, kind: from the water's edge inland, then what lies south of Quay Road
    (-45, "Fish Quay", "unclassified"), (0, "Quay Road", "primary"), (108, "Ropewalk", "residential"),
    (205, "Lantern Street", "secondary"), (300, "Mill Lane", "residential"), (395, "Tanner Row", "residential"),
    (520, "Station Road", "secondary"), (705, "Orchard Street", "residential"), (815, "Chapel Street", "residential"),
    (930, "Brin Way", "residential"), (1055, "Meadow Road", "tertiary"), (1170, "Barley Lane", "residential"),
    (1295, "Windmill Road", "residential"), (1420, "Top Road", "residential"),
    (-130, "Customs Street", "residential"), (-225, "Anchor Street", "residential"), (-320, "Chandlers Row", "residential"),
    (-420, "Saltings Road", "tertiary"), (-530, "Tide Street", "residential"), (-640, "Gull Road", "residential"),
    (-745, "Coastguard Road", "residential"), (-850, "Signal Lane", "residential")]
ACROSS = [  # u, name, kind: from the west
    (-1500, "Vine Street", "residential"), (-1375, "Quarry Road", "residential"), (-1255, "Thorn Street", "residential"),
    (-1130, "West Road", "tertiary"), (-1010, "Linden Street", "residential"), (-895, "Bakers Row", "residential"),
    (-790, "Friars Way", "residential"), (-680, "School Road", "tertiary"), (-580, "Priory Street", "residential"),
    (-480, "Bell Lane", "residential"), (-385, "Glover Street", "residential"), (-290, "Cooper Street", "residential"),
    (-190, "Church Street", "secondary"), (-105, "Net Loft Lane", "residential"), (-15, "Pilot Street", "residential"),
    (150, "Salt Lane", "residential"), (235, "Sailmaker Lane", "residential"), (365, "Market Street", "secondary"),
    (455, "Fisher Street", "residential"), (540, "Water Lane", "residential"), (725, "Sail Lane", "residential"),
    (815, "Hill Street", "residential"), (910, "Kiln Lane", "residential"), (1015, "Brewery Road", "residential"),
    (1130, "Cannery Street", "residential"), (1250, "East Road", "tertiary"), (1375, "Larch Street", "residential"),
    (1490, "Gorse Street", "residential")]
HALF_WIDTH = {"primary": 10, "secondary": 8.5, "tertiary": 7.5}
BRIDGES = {"Quay Road", "Lantern Street", "Station Road", "Meadow Road"}
OVER_RAIL = {"Market Street", "Church Street", "West Road", "East Road", "Hill Street"}
FIRST_LEVEL = {"primary": 7, "secondary": 9, "tertiary": 10, "unclassified": 12, "residential": 12}
# name, the blocks as their first and last streets, kind
PARKS = [("Lantern Park", "Pilot Street", "Salt Lane", "Lantern Street", "Tanner Row"),
         ("Priory Gardens", "School Road", "Bell Lane", "Tanner Row", "Station Road"),
         ("Kiln Green", "Hill Street", "Kiln Lane", "Ropewalk", "Lantern Street"),
         ("Sail Garden", "Sail Lane", "Hill Street", "Mill Lane", "Tanner Row"),
         ("Signal Park", "Bakers Row", "School Road", "Gull Road", "Coastguard Road"),
         ("Orchard Field", "Church Street", "Pilot Street", "Orchard Street", "Chapel Street")]
SQUARES = [("Fish Market", "Sailmaker Lane", "Market Street", "Quay Road", "Ropewalk"),
           ("Lamp Square", "Cooper Street", "Church Street", "Ropewalk", "Lantern Street")]


class Town:
    def __init__(self, tiles):
        self.tiles = tiles
        self.rng = random.Random(20260516)
        self.grid = Grid((0, -27), 20, 13, self.rng)
        self.coast = island.coast(self.grid.place, self.rng)
        self.river = island.river()
        self.water = shapes.Near(40)
        self.water.add(self.coast + self.coast[:1])
        self.water.add(self.river + self.river[:1])
        self.rail_line = self._rail()
        self.rail = shapes.Near(40)
        self.rail.add(self.rail_line)
        self.roads = shapes.Near(24)
        self.u = {name: u for u, name, _ in ACROSS}
        self.v = {name: v for v, name, _ in ALONG}
        self.streets = []  # (name, kind, line)

    def build(self):
        self.add_water()
        self.add_woods()
        self.plan_grid()
        self.add_country_roads()
        self.add_blocks()
        self.add_villages()
        self.add_streets()
        self.add_rail()
        self.add_piers()
        self.add_labels()

    # Where things are.

    def is_land(self, point):
        return shapes.inside(self.coast, point) and not shapes.inside(self.river, point)

    def is_dry(self, point, margin):
        return self.is_land(point) and self.water.distance(point) >= margin

    def in_town(self, u, v):
        noise = 0.10 * math.sin(u / 260 + 1) + 0.09 * math.sin(v / 210 + u / 700)
        north = math.hypot(u / 1560, (v - 420) / 1060)
        south_west = math.hypot((u + 640) / 700, (v + 350) / 560)
        east = math.hypot((u - 1180) / 420, (v + 250) / 620)
        return min(north, south_west, east) + noise < 1

    def _rail(self):
        place = self.grid.place
        west = [(-5000, -900), (-4000, -620), (-3000, -480), (-2250, -230)]
        town = [place(u, v) for u, v in ((-1500, 590), (-1050, 640), (-600, 640), (-200, 612), (150, 600), (520, 598), (950, 625),
                                         (1400, 690))]
        east = [(1750, 1290), (2400, 1170), (3000, 1110), (3700, 960), (4350, 1150)]
        return shapes.spline(west + town + east, 30)

    # Layers.

    def add_water(self):
        far = 9500
        box = [(-far, -far), (-far, far), (far, far), (far, -far)]
        self.tiles.add("ocean", AREA, [box, self.coast], {})
        self.tiles.add("water_polygons", AREA, [self.river], {"kind": "river"}, 9)
        brook = shapes.spline(island.BROOK, 25)
        self.tiles.add("water_lines", LINE, [brook], {"kind": "stream"}, 12)
        self.water.add(brook)
        middle = shapes.spline(island.RIVER, 40)
        self.tiles.add("water_lines_labels", LINE, [middle], {"kind": "river", **named("River Brin")}, 12)

    def add_woods(self):
        self.tiles.add("land", AREA, [shapes.spline(self.grid_outline(), 60, True)], {"kind": "residential"}, 10)
        for i, (middle, size, name) in enumerate(island.WOODS):
            ring = shapes.spline(island.blob(middle, size, i * 1.7), 40, True)
            if not all(self.is_dry(p, 20) for p in ring):
                ring = [shapes.between(middle, p, 0.72) for p in ring]
            self.tiles.add("land", AREA, [ring], {"kind": "forest"}, 8)
            if name:
                self.tiles.add("land", POINT, [[middle]], {"kind": "forest", **named(name)}, 12)

    def add_country_roads(self):
        """Each of the first ones goes on where a street of the town ends."""
        goes_on = {"North Road": "Market Street", "Coast Road": "Quay Road", "Eastern Road": "Quay Road", "Mill Road": "Meadow Road",
                   "Saltcote Lane": "School Road", "Hagg Lane": "Meadow Road", "Larkfield Road": "East Road"}
        for name, kind, points in island.COUNTRY_ROADS:
            ends = [end for street, _, line in self.streets if street == goes_on.get(name) for end in (line[0], line[-1])]
            start = min(ends, key=lambda end: math.dist(end, points[1])) if ends else points[0]
            line = shapes.spline([start] + points[1:], 30)
            self.streets.append((name, kind, line))
            self.roads.add(line)

    def grid_outline(self):
        """The edge of the town, for its built-up ground."""
        ring = []
        for i in range(56):
            angle, r = 2 * math.pi * i / 56, 2600
            while r > 100:
                u, v = -20 + r * math.cos(angle), 250 + r * math.sin(angle)
                if self.in_town(u, v):
                    break
                r -= 25
            ring.append(self.grid.place(u, v))
        return ring

    def plan_grid(self):
        self.us, self.vs = sorted(ACROSS), sorted(ALONG)
        self.closed = set()  # streets between blocks that are one
        self.taken, merged = set(), set()
        for _, *edges in PARKS + SQUARES:
            cells = self.cells_of(edges)
            self.taken.update(cells)
            self.close(cells)
        for i in range(len(self.us) - 1):
            for j in range(len(self.vs) - 1):
                if self.rng.random() < 0.27:
                    self.merge(i, j, merged)
        self.prune()
        self.add_grid_streets()

    def add_blocks(self):
        done = set(self.taken)
        for i in range(len(self.us) - 1):
            for j in range(len(self.vs) - 1):
                if (i, j) not in done:
                    self.add_block(i, j, done)
        for name, *edges in PARKS:
            self.add_park(name, edges)
        for name, *edges in SQUARES:
            self.add_square(name, edges)

    def cells_of(self, edges):
        west, east, south, north = edges
        us, vs = [u for u, *_ in self.us], [v for v, *_ in self.vs]
        return [(i, j) for i in range(us.index(self.u[west]), us.index(self.u[east]))
                for j in range(vs.index(self.v[south]), vs.index(self.v[north]))]

    def close(self, cells):
        for i, j in cells:
            if (i, j + 1) in cells:
                self.closed.add(("v", i, j + 1))
            if (i + 1, j) in cells:
                self.closed.add(("u", i + 1, j))

    def merge(self, i, j, merged):
        """Leaves out the street between a block and the next: such a grid has grown."""
        if self.rng.random() < 0.55:
            other, street, key = (i + 1, j), self.us[i + 1], ("u", i + 1, j)
        else:
            other, street, key = (i, j + 1), self.vs[j + 1], ("v", i, j + 1)
        inside = other[0] < len(self.us) - 1 and other[1] < len(self.vs) - 1
        if inside and street[2] == "residential" and not {(i, j), other} & (merged | self.taken):
            self.closed.add(key)
            merged.update({(i, j), other})

    def prune(self):
        """Lets no street of houses end in the fields."""
        for _ in range(2):
            ends = {}
            streets = [("v", i, j) for i in range(len(self.us) - 1) for j in range(len(self.vs))]
            streets += [("u", i, j) for i in range(len(self.us)) for j in range(len(self.vs) - 1)]
            open_ones = [street for street in streets if self.is_open(*street)]
            for axis, i, j in open_ones:
                for node in ((i, j), (i + 1, j) if axis == "v" else (i, j + 1)):
                    ends[node] = ends.get(node, 0) + 1
            for axis, i, j in open_ones:
                nodes = (i, j), (i + 1, j) if axis == "v" else (i, j + 1)
                if min(ends[node] for node in nodes) == 1 and (self.vs[j] if axis == "v" else self.us[i])[2] == "residential":
                    self.closed.add((axis, i, j))

    def add_grid_streets(self):
        for j, (_, name, kind) in enumerate(self.vs):
            line = [self.open_street("v", i, j) for i in range(len(self.us) - 1)]
            self.add_street(name, kind, line)
        for i, (_, name, kind) in enumerate(self.us):
            line = [self.open_street("u", i, j) for j in range(len(self.vs) - 1)]
            self.add_street(name, kind, line)

    def is_open(self, axis, i, j):
        """Whether there is a street from one crossing to the next: not where there is no town, nor in a park."""
        u, v = self.us[i][0], self.vs[j][0]
        middle = ((u + self.us[i + 1][0]) / 2, v) if axis == "v" else (u, (v + self.vs[j + 1][0]) / 2)
        if (axis, i, j) in self.closed or not self.in_town(*middle):
            return False
        # Fish Quay runs along the harbour only.
        return axis == "u" or self.vs[j][1] != "Fish Quay" or 60 < middle[0] < 640

    def open_street(self, axis, i, j):
        if not self.is_open(axis, i, j):
            return None
        start = self.us[i][0], self.vs[j][0]
        return self.grid.line(start, (self.us[i + 1][0], start[1]) if axis == "v" else (start[0], self.vs[j + 1][0]))

    def add_street(self, name, kind, sections):
        whole = [[]]
        for section in sections:
            if section is None:
                whole.append([])
            else:
                whole[-1] += section if not whole[-1] else section[1:]
        for line in whole:
            if len(line) < 2:
                continue
            fine = shapes.resampled(line, 4)
            margin = 3 if kind == "unclassified" else 9

            def allowed(point):
                wet = name not in BRIDGES and not self.is_dry(point, margin)
                sea = name in BRIDGES and not shapes.inside(self.coast, point)
                return not wet and not sea and (name in OVER_RAIL or self.rail.distance(point) > 13)

            for piece in shapes.pieces(fine, allowed):
                if shapes.length(piece) > 28:
                    piece = shapes.simplified(piece, 0.25)
                    self.streets.append((name, kind, piece))
                    self.roads.add(piece)

    def add_block(self, i, j, done):
        done.add((i, j))
        i1, j1 = i + 1, j + 1
        if ("u", i1, j) in self.closed:
            i1 += 1
            done.add((i + 1, j))
        elif ("v", i, j1) in self.closed:
            j1 += 1
            done.add((i, j + 1))
        (u0, _, west), (u1, _, east) = self.us[i], self.us[i1]
        (v0, south, south_kind), (v1, _, north) = self.vs[j], self.vs[j1]
        middle = (u0 + u1) / 2, (v0 + v1) / 2
        if not self.in_town(*middle) or not self.is_land(self.grid.place(*middle)):
            return
        edge = [HALF_WIDTH.get(kind, 6.2) for kind in (west, south_kind, east, north)]
        dense = math.hypot(middle[0] - 300, middle[1] - 200) < 780 and middle[1] > -300
        if self.rng.random() < 0.035 and not dense:
            ring = self.grid.area(u0 + 8, v0 + 8, u1 - 8, v1 - 8)
            if all(self.is_dry(p, 6) and self.rail.distance(p) > 12 for p in ring):
                self.tiles.add("land", AREA, [ring], {"kind": self.rng.choice(("park", "allotments", "recreation_ground"))}, 12)
                return
        houses = self.grid.houses(u0 + edge[0], v0 + edge[1], u1 - edge[2], v1 - edge[3],
                                  self.rng.uniform(17, 23) if dense else 20, dense)
        self.add_houses(houses)

    def add_houses(self, houses):
        for ring in houses:
            middle = (sum(p[0] for p in ring) / len(ring), sum(p[1] for p in ring) / len(ring))
            points = ring + [middle]
            if all(self.is_dry(p, 5) and self.rail.distance(p) > 15 and self.roads.distance(p) > 5 for p in points):
                self.tiles.add("buildings", AREA, [ring], {}, 14)

    def add_park(self, name, edges):
        west, east, south, north = edges
        u0, u1, v0, v1 = self.u[west] + 9, self.u[east] - 9, self.v[south] + 10, self.v[north] - 9
        self.tiles.add("land", AREA, [self.grid.area(u0, v0, u1, v1)], {"kind": "park"}, 11)
        centre = (u0 + u1) / 2, (v0 + v1) / 2
        self.tiles.add("land", POINT, [[self.grid.place(*shapes.between(centre, (centre[0], v1), 0.45))]],
                       {"kind": "park", **named(name)}, 12)
        size = min(u1 - u0, v1 - v0) / 2
        ring = [self.grid.place(centre[0] + 1.0 * size * 0.78 * math.cos(a), centre[1] + size * 0.62 * math.sin(a))
                for a in (2 * math.pi * k / 28 for k in range(28))]
        paths = [ring + ring[:1]]
        for corner in ((u0, v0), (u1, v0), (u1, v1), (u0, v1)):
            towards = shapes.between(centre, corner, 0.52)
            bent = shapes.between(towards, corner, 0.5)
            paths.append(shapes.spline([self.grid.place(*towards), self.grid.place(bent[0] + 5, bent[1] - 4),
                                        self.grid.place(*corner)], 12))
        self.tiles.add("streets", LINE, paths, {"kind": "footway"}, 14)
        if size > 40:
            pond = island.blob(self.grid.place(centre[0] + 4, centre[1] - 6), size * 0.27, len(name), 8)
            self.tiles.add("water_polygons", AREA, [shapes.spline(pond, 6, True)], {"kind": "pond"}, 12)

    def add_square(self, name, edges):
        west, east, south, north = edges
        u0, u1, v0, v1 = self.u[west] + 7, self.u[east] - 9, self.v[south] + 11, self.v[north] - 7
        self.tiles.add("street_polygons", AREA, [self.grid.area(u0, v0, u1, v1)], {"kind": "pedestrian"}, 12)
        if name == "Fish Market":
            # The hall, with the place from which the first friend of the demo is seen inside it.
            hall = self.grid.across(273, 145.5)
            shape = [(-27, -17), (29, -17), (29, 4), (20, 4), (20, 19), (-27, 19)]
            self.tiles.add("buildings", AREA, [[self.grid.place(hall[0] + a, hall[1] + b) for a, b in shape]], {}, 13)
            self.tiles.add("pois", POINT, [[self.grid.place(hall[0], hall[1])]],
                           {"amenity": "marketplace", **named(name)}, 14)
            self.add_houses(self.grid.houses(u0, v1 - 19, u1, v1, 13, True))
        else:
            church = [(-16, -6), (10, -6), (10, -12), (17, -12), (17, -6), (24, -3), (24, 5), (17, 8), (17, 13), (10, 13), (10, 8),
                      (-16, 8), (-16, 11), (-26, 11), (-26, -8), (-16, -8)]
            centre = (u0 + u1) / 2, (v0 + v1) / 2
            self.tiles.add("buildings", AREA, [[self.grid.place(centre[0] + a, centre[1] + b) for a, b in church]], {}, 13)

    def add_villages(self):
        for number, (name, where, angle, size) in enumerate(island.VILLAGES):
            rng = random.Random(number + 7)
            grid = Grid(where, angle, 9, rng)
            outline = shapes.spline(island.blob(where, size * 1.02, number * 2.1), 40, True)
            self.tiles.add("land", AREA, [outline], {"kind": "residential"}, 11)
            self.tiles.add("place_labels", POINT, [[where]], {"kind": "village", "population": 300 + size * 3, **named(name)}, 9)
            us = [u for u in range(-size, size + 1, 92 + 9 * (number % 3))]
            vs = [v for v in range(-size, size + 1, 84 + 7 * (number % 4))]
            lanes = ["Church Lane", "Green Lane", "Back Lane", "Chapel Lane", "Pump Lane", "Field Lane", "Well Lane", "Smithy Lane"]

            def within(point):
                return (shapes.inside(outline, point) and self.is_dry(point, 12) and self.rail.distance(point) > 14)

            before = len(self.streets)
            for k, u in enumerate(us[1:-1]):
                self.add_lane(grid.line((u, vs[0]), (u, vs[-1])), lanes[k % 8], within)
            for k, v in enumerate(vs[1:-1]):
                self.add_lane(grid.line((us[0], v), (us[-1], v)), lanes[(k + 4) % 8], within)
            for _, _, line in self.streets[before:]:
                self.roads.add(line)
            for u0, u1 in zip(us, us[1:]):
                for v0, v1 in zip(vs, vs[1:]):
                    if shapes.inside(outline, grid.place((u0 + u1) / 2, (v0 + v1) / 2)) and rng.random() < 0.92:
                        self.add_houses(grid.houses(u0 + 6, v0 + 6, u1 - 6, v1 - 6, 20, False))

    def add_lane(self, line, name, within):
        for piece in shapes.pieces(shapes.resampled(line, 6), within):
            if shapes.length(piece) > 90:
                self.streets.append((name, "residential", shapes.simplified(piece, 0.4)))

    def add_streets(self):
        for name, kind, line in self.streets:
            first = FIRST_LEVEL.get(kind, 12)
            self.tiles.add("streets", LINE, [line], {"kind": kind}, first)
            self.tiles.add("street_labels", LINE, [line], {"kind": kind, **named(name)}, max(12, first))

    def add_rail(self):
        self.tiles.add("streets", LINE, [self.rail_line], {"kind": "rail", "rail": True}, 8)
        for name, where in (("Brinmouth Station", self.grid.place(150, 600)), ("Wrackham Station", (3700, 960)),
                            ("Marlow Sands Station", (-4000, -620))):
            at = min(range(len(self.rail_line)), key=lambda i: math.dist(self.rail_line[i], where))
            near = self.rail_line[max(0, at - 8):at + 9]
            size = 1 if name.startswith("Brinmouth") else 0.5
            middle = len(near) // 2
            track = near[middle - int(6 * size):middle + int(6 * size) + 1]
            offsets = (9, -8) if size == 1 else (8,)
            for offset in offsets:
                side = shapes.beside(track, offset)
                line = [near[middle - int(6 * size) - 1]] + side[1:-1] + [near[middle + int(6 * size) + 1]]
                self.tiles.add("streets", LINE, [shapes.spline(line, 12)], {"kind": "rail", "rail": True, "service": "siding"}, 13)
            hall = shapes.beside(track, -15)[len(track) // 2 - 1:len(track) // 2 + 2]
            self.tiles.add("buildings", AREA, [hall + shapes.beside(hall, -13)[::-1]], {}, 13)
            self.tiles.add("public_transport", POINT, [[shapes.beside(track, -20)[len(track) // 2]]],
                           {"kind": "station", **named(name)}, 13)

    def add_piers(self):
        ferry = [(385, 44), (389, -96), (384, -232), (376, -240), (377, -256), (416, -258), (416, -242), (408, -234), (405, -96),
                 (403, 44)]
        self.tiles.add("pier_polygons", AREA, [ferry], {"kind": "pier"}, 12)
        fish = [(522, 96), (556, 12), (571, 18), (538, 102)]
        self.tiles.add("pier_polygons", AREA, [fish], {"kind": "pier"}, 12)
        mole = shapes.spline([(-140, -490), (-60, -560), (40, -600), (150, -610), (230, -590)], 15)
        self.tiles.add("pier_polygons", AREA, [shapes.beside(mole, 8) + shapes.beside(mole, -8)[::-1]], {"kind": "pier"}, 11)
        east = shapes.spline([(900, -470), (820, -520), (720, -560), (600, -575)], 15)
        self.tiles.add("pier_polygons", AREA, [shapes.beside(east, 7) + shapes.beside(east, -7)[::-1]], {"kind": "pier"}, 11)
        for k in range(5):
            u = 661 + 15 * k
            self.tiles.add("pier_lines", LINE, [[self.grid.place(u, -58), self.grid.place(u + 2, -128)]], {"kind": "pier"}, 13)
        market = self.grid.place(365, -45)
        walk = [market, (394, 44), (397, -96), (396, -240)]
        self.tiles.add("streets", LINE, [walk], {"kind": "pedestrian"}, 13)
        self.tiles.add("street_labels", LINE, [walk], {"kind": "pedestrian", **named("Ferry Pier")}, 13)
        self.piers = [ferry, fish]

    def add_labels(self):
        self.tiles.add("place_labels", POINT, [[self.grid.place(180, 250)]],
                       {"kind": "town", "population": 24000, **named("Brinmouth")}, 5)
        for name, where in (("Old Harbour", (330, 330)), ("Saltings", (-720, -420)), ("Kiln Hill", (980, 260)),
                            ("Priory", (-620, 420)), ("Orchards", (60, 940)), ("Eastcliff", (1200, -300))):
            self.tiles.add("place_labels", POINT, [[self.grid.place(*where)]], {"kind": "suburb", **named(name)}, 11)
        for name, where, first in (("Harbour", (590, -190), 12), ("Brin Bay", (1150, -3100), 9)):
            self.tiles.add("water_polygons_labels", POINT, [[where]], {"kind": "water", **named(name)}, first)
        border = shapes.spline([(-5560, 1250), (-4700, 1500), (-4000, 2000), (-3500, 3000), (-2900, 3700), (-2200, 3700), (-1700, 4500),
                                (-1500, 5400), (-1400, 6120)], 60)
        self.tiles.add("boundaries", LINE, [border], {"admin_level": 4, "maritime": False, "disputed": False}, 8)
        for key, name, u, v in (("amenity", "Harbour Hospital", -980, 560), ("amenity", "Brinmouth College", -560, 830),
                                ("tourism", "Lifeboat Museum", 470, -30), ("amenity", "Town Hall", -235, 252),
                                ("amenity", "Library", 60, 470), ("tourism", "Old Lighthouse", -830, -705)):
            value = {"Harbour Hospital": "hospital", "Brinmouth College": "college", "Lifeboat Museum": "museum",
                     "Town Hall": "townhall", "Library": "library"}.get(name, "attraction")
            self.tiles.add("pois", POINT, [[self.grid.place(u, v)]], {key: value, **named(name)}, 14)
