"""Where land and water are on the Isle of Brin, and what stands in the country: shores, river, woods, roads between villages.

Metres east and north of the place where the demo's user stands."""
import math

from . import shapes

# The island's shore, from the harbour's mouth round by the west, the north and the east.
COAST = [
    # The west side of the harbour and the bay.
    (-44, -112), (-96, -160), (-128, -240), (-150, -360), (-128, -500), (-150, -640), (-230, -800), (-262, -980), (-190, -1180),
    (-160, -1420), (-20, -1700), (120, -2050), (140, -2500), (60, -3000), (190, -3500), (150, -4000), (-60, -4500),
    (-260, -4950), (-520, -5350), (-900, -5600),
    # The south-west.
    (-1500, -5560), (-2050, -5250), (-2500, -4900), (-2950, -4750), (-3350, -4350), (-3900, -3950), (-4250, -3350), (-4900, -2950),
    (-5300, -2300), (-5280, -1600), (-5550, -900), (-5450, -200), (-5000, 300), (-5150, 900), (-5600, 1500), (-5700, 2300),
    (-5350, 3000),
    # The north.
    (-4800, 3500), (-4250, 3750), (-3900, 4400), (-3350, 4950), (-2700, 5250), (-2300, 5800), (-1600, 6150), (-900, 6050),
    (-200, 5800), (450, 5950), (1200, 6050), (1900, 5750), (2350, 5250), (3050, 5200), (3750, 5250), (4350, 4800), (4500, 4150),
    # The east.
    (4950, 3500), (5300, 2800), (5150, 2100), (5350, 1400), (5150, 700), (4700, 150), (4850, -500), (5100, -1200), (5000, -1900),
    (5150, -2600), (4850, -3300), (4350, -3800), (3700, -4050), (3200, -4500), (2700, -4650),
    # The east side of the bay.
    (2350, -4300), (2300, -3700), (2050, -3100), (1850, -2500), (1500, -2050), (1350, -1600), (1120, -1150), (1040, -800),
    (930, -560), (880, -330), (890, -120), (862, 20), (800, 130),
]
# The quays between them, from the east to the west, along and across the town's streets: straight edges.
QUAYS = [(800, -95), (736, -92), (730, -62), (655, -60), (640, -78), (560, -76), (455, -74), (450, -90), (402, -90), (396, -72),
         (300, -72), (296, -92), (240, -92), (236, -70), (120, -70), (60, -74), (24, -66), (-8, -86)]

RIVER = [(585, 60), (575, 150), (548, 240), (562, 330), (520, 420), (500, 520), (530, 640), (590, 760), (585, 900), (520, 1040),
         (540, 1200), (640, 1360), (650, 1560), (560, 1760), (580, 1980), (720, 2200), (740, 2480), (640, 2760), (700, 3050),
         (860, 3350), (840, 3700), (700, 4000), (720, 4300)]
BROOK = [(560, 1760), (380, 1860), (160, 1900), (-120, 2060), (-420, 2080), (-760, 2260), (-1100, 2620), (-1500, 2860)]

WOODS = [  # middle, size, name
    ((-2300, 1250), 620, "Hagg Wood"), ((2200, 3700), 780, "Beacon Wood"), ((-3300, -1700), 700, "Marl Wood"),
    ((3500, -900), 520, "Larkfield Wood"), ((-1250, 4300), 560, "Nine Oaks"), ((-900, -3300), 430, "Smuggler’s Copse"),
    ((3300, 1600), 420, None), ((-4300, 1900), 380, None), ((3600, -2700), 460, None), ((1150, 4950), 340, None),
    ((-2500, -3500), 300, None), ((-3000, 3300), 330, None), ((1850, 900), 260, None), ((-1900, -700), 280, None),
]

# name, kind, and the places it leads through
COUNTRY_ROADS = [
    ("North Road", "primary", [(225, 1480), (150, 1900), (60, 2400), (100, 3000), (-120, 3600), (-80, 4300), (-300, 5100)]),
    ("Coast Road", "primary", [(-1530, -560), (-2100, -820), (-2800, -1000), (-3500, -800), (-4300, -1000), (-4700, -1500)]),
    ("Eastern Road", "primary", [(1560, 520), (2100, 560), (2700, 480), (3350, 700), (4000, 560), (4550, 800)]),
    ("Saltcote Lane", "tertiary", [(-420, -1050), (-480, -1500), (-420, -2050), (-620, -2700), (-500, -3300), (-700, -3900),
                                   (-900, -4500), (-1050, -5050)]),
    ("Northcombe Road", "secondary", [(-300, 5100), (-1000, 5300), (-1700, 5150), (-2200, 4500), (-2800, 4100), (-3400, 3600),
                                      (-4000, 2900), (-4500, 2400)]),
    ("Hagg Lane", "tertiary", [(-1500, 640), (-2050, 700), (-2600, 600), (-3250, 900), (-3900, 1300), (-4500, 2400)]),
    ("Beacon Road", "secondary", [(-80, 4300), (600, 4600), (1400, 4500), (2000, 4650), (2800, 4400), (3500, 4100), (3900, 3300),
                                  (4300, 2500), (4250, 1700), (4000, 560)]),
    ("Upper Brin Road", "tertiary", [(150, 1900), (-400, 1950), (-800, 2010), (-1199, 2060), (-1700, 2200), (-2400, 2450),
                                     (-3100, 2500), (-3700, 2400), (-4500, 2400)]),
    ("Larkfield Road", "secondary", [(1340, -470), (1800, -700), (2300, -900), (2600, -1500), (2750, -2200), (3000, -2900),
                                     (3300, -3500)]),
    ("Wrackham Lane", "tertiary", [(2600, -1500), (3300, -1700), (4000, -1500), (4400, -900), (4200, -300), (4000, 560)]),
    ("Marl Lane", "tertiary", [(-2800, -1000), (-2700, -1700), (-2450, -2400), (-2700, -3100), (-2300, -3900), (-1700, -4500),
                               (-1050, -5050)]),
    ("Mill Road", "tertiary", [(700, 1500), (1000, 1900), (1500, 2200), (2100, 2500), (2700, 2450), (3400, 2700), (4300, 2500)]),
    ("Ridge Lane", "unclassified", [(-3700, 2400), (-3300, 1700), (-3250, 900)]),
    ("Cliff Lane", "unclassified", [(-3500, -800), (-3700, -1500), (-3550, -2300), (-3900, -2900)]),
    ("Down Lane", "unclassified", [(2100, 2500), (2400, 1900), (2300, 1200), (2100, 560)]),
]

VILLAGES = [  # name, where, angle, half size; its names in other languages come from main
    ("Upper Brin", (-1215, 2095), 12, 330), ("Northcombe", (-300, 5080), -20, 300), ("Saltcote", (-1000, -5000), 35, 260),
    ("Larkfield", (2720, -2180), -8, 320), ("Wrackham", (4000, 590), 15, 330), ("Hagg Cross", (-4420, 2420), 28, 270),
    ("Beaconsworth", (2780, 4400), -14, 280), ("Marlow Sands", (-4680, -1480), 40, 280), ("Kiln Green", (2150, 2520), 5, 220),
    ("Ashmere", (-3380, 880), -10, 190),
]

RAIL = [  # a ring round the island through the town's station
    (-5000, -900), (-4000, -560), (-3000, -330), (-2300, 60), (-1700, 330), (-1100, 500), (-520, 600), (-60, 672), (300, 728),
    (640, 800), (1100, 930), (1700, 1010), (2400, 930), (3000, 1000), (3700, 900), (4400, 1150)]
STATIONS = [("Brinmouth", (-60, 672)), ("Wrackham", (3700, 900)), ("Marlow Sands", (-4000, -560))]


def blob(middle, size, seed, step=40):
    """A round shape that is not too round."""
    count = max(12, round(2 * math.pi * size / step))
    result = []
    for i in range(count):
        angle = 2 * math.pi * i / count
        r = size * (1 + 0.20 * math.sin(2 * angle + seed) + 0.13 * math.sin(3 * angle + 2.3 * seed) +
                    0.06 * math.sin(7 * angle + 5.1 * seed))
        result.append((middle[0] + r * math.cos(angle), middle[1] + r * math.sin(angle)))
    return result


def coast(place, rng):
    """The shore as a ring, clockwise from the harbour's west corner; rough where no quay holds it. `place` takes what is along
    and across the streets to metres."""
    line = shapes.spline(COAST, 240)
    for _ in range(3):
        rough = [line[0]]
        for a, b in zip(line, line[1:]):
            size = math.dist(a, b)
            # Smooth by the town, rugged further out.
            far = min(1.0, max(0.06, (math.hypot(a[0] - 400, a[1]) - 500) / 1500))
            shift = rng.uniform(-0.17, 0.17) * size * far
            x, y = shapes.between(a, b, rng.uniform(0.42, 0.58))
            rough += [(x - (b[1] - a[1]) / size * shift, y + (b[0] - a[0]) / size * shift), b]
        line = rough
    return line + [place(u, v) for u, v in QUAYS]


def river():
    """The river's banks as a ring: 30 m wide in town, a brook at its source."""
    line = shapes.spline(RIVER, 24)

    def half(share):
        return 17 * (1 - share)**0.7 + 2.5 + 2.0 * math.sin(share * 60) * (1 - share)

    return shapes.beside(line, half) + shapes.beside(line, lambda share: -half(share))[::-1]
