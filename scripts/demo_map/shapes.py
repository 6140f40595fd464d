"""Plane geometry for the demo map: points are (x, y) in metres, east and north."""
import math


def between(a, b, t):
    return a[0] + (b[0] - a[0]) * t, a[1] + (b[1] - a[1]) * t


def length(line):
    return sum(math.dist(a, b) for a, b in zip(line, line[1:]))


def resampled(line, step):
    """The same line with a point at least every `step` metres."""
    result = [line[0]]
    for a, b in zip(line, line[1:]):
        parts = max(1, math.ceil(math.dist(a, b) / step))
        result += [between(a, b, i / parts) for i in range(1, parts + 1)]
    return result


def spline(points, step=25, closed=False):
    """A smooth line through the points (Catmull and Rom's), a point about every `step` metres."""
    count = len(points)
    result = []
    for i in range(count if closed else count - 1):
        if closed:
            p0, p1, p2, p3 = (points[(i + k) % count] for k in (-1, 0, 1, 2))
        else:
            p0, p1, p2, p3 = (points[max(0, min(count - 1, i + k))] for k in (-1, 0, 1, 2))
        parts = max(1, round(math.dist(p1, p2) / step))
        for part in range(parts):
            t = part / parts
            result.append(tuple(
                0.5 * (2 * b + (c - a) * t + (2 * a - 5 * b + 4 * c - d) * t * t + (3 * b - a - 3 * c + d) * t**3)
                for a, b, c, d in zip(p0, p1, p2, p3)))
    return result if closed else result + [points[-1]]


def beside(line, distance):
    """The line moved to its left by a distance, or by one that `distance` gives for a share of the way."""
    result = []
    for i, (x, y) in enumerate(line):
        ax, ay = line[max(0, i - 1)]
        bx, by = line[min(len(line) - 1, i + 1)]
        size = math.hypot(bx - ax, by - ay) or 1
        d = distance(i / (len(line) - 1)) if callable(distance) else distance
        result.append((x - (by - ay) / size * d, y + (bx - ax) / size * d))
    return result


def inside(polygon, point):
    x, y = point
    result = False
    ax, ay = polygon[-1]
    for bx, by in polygon:
        if (ay > y) != (by > y) and x < (bx - ax) * (y - ay) / (by - ay) + ax:
            result = not result
        ax, ay = bx, by
    return result


def area(ring):
    return sum(a[0] * b[1] - b[0] * a[1] for a, b in zip(ring, ring[1:] + ring[:1])) / 2


def simplified(line, tolerance):
    """Douglas and Peucker's choice of points."""
    if len(line) < 3:
        return line
    keep = [False] * len(line)
    keep[0] = keep[-1] = True
    stack = [(0, len(line) - 1)]
    while stack:
        first, last = stack.pop()
        (ax, ay), (bx, by) = line[first], line[last]
        size = math.hypot(bx - ax, by - ay)
        worst, at = tolerance, None
        for i in range(first + 1, last):
            x, y = line[i]
            away = abs((bx - ax) * (ay - y) - (ax - x) * (by - ay)) / size if size else math.hypot(x - ax, y - ay)
            if away > worst:
                worst, at = away, i
        if at is not None:
            keep[at] = True
            stack += [(first, at), (at, last)]
    return [point for point, kept in zip(line, keep) if kept]


def clip_ring(ring, box):
    """Sutherland and Hodgman's clipping against left, bottom, right, top."""
    left, bottom, right, top = box
    for axis, limit, sign in ((0, left, 1), (0, right, -1), (1, bottom, 1), (1, top, -1)):
        if not ring:
            return ring
        result = []
        before = ring[-1]
        for here in ring:
            inner, was = (here[axis] - limit) * sign, (before[axis] - limit) * sign
            if (inner >= 0) != (was >= 0):
                result.append(between(before, here, was / (was - inner)))
            if inner >= 0:
                result.append(here)
            before = here
        ring = result
    return ring


def clip_line(line, box):
    """The parts of a line in a box."""
    left, bottom, right, top = box
    parts, part = [], []
    for a, b in zip(line, line[1:]):
        start, end = 0.0, 1.0
        dx, dy = b[0] - a[0], b[1] - a[1]
        for p, q in ((-dx, a[0] - left), (dx, right - a[0]), (-dy, a[1] - bottom), (dy, top - a[1])):
            if p < 0:
                start = max(start, q / p)
            elif p > 0:
                end = min(end, q / p)
            elif q < 0:
                end = -1.0
        if start > end:
            if part:
                parts.append(part)
            part = []
            continue
        if not part or start > 0:
            if part:
                parts.append(part)
            part = [between(a, b, start)]
        part.append(between(a, b, end))
        if end < 1:
            parts.append(part)
            part = []
    if part:
        parts.append(part)
    return [p for p in parts if len(p) > 1]


def pieces(line, allowed):
    """The parts of a line whose points are allowed."""
    result, part = [], []
    for point in line:
        if allowed(point):
            part.append(point)
        else:
            if len(part) > 1:
                result.append(part)
            part = []
    if len(part) > 1:
        result.append(part)
    return result


def cross(a, b, c, d):
    """Whether the segments ab and cd cross."""
    def side(p, q, r):
        return (q[0] - p[0]) * (r[1] - p[1]) - (q[1] - p[1]) * (r[0] - p[0])

    return side(a, b, c) * side(a, b, d) < 0 and side(c, d, a) * side(c, d, b) < 0


class Near:
    """How far a place is from lines, if nearer than `reach`."""

    def __init__(self, reach):
        self.reach = reach
        self.cells = {}

    def add(self, line):
        for a, b in zip(line, line[1:]):
            for x in range(self._cell(min(a[0], b[0]) - self.reach), self._cell(max(a[0], b[0]) + self.reach) + 1):
                for y in range(self._cell(min(a[1], b[1]) - self.reach), self._cell(max(a[1], b[1]) + self.reach) + 1):
                    self.cells.setdefault((x, y), []).append((a, b))

    def _cell(self, value):
        return math.floor(value / 60)

    def distance(self, point):
        x, y = point
        best = self.reach
        for (ax, ay), (bx, by) in self.cells.get((self._cell(x), self._cell(y)), ()):
            dx, dy = bx - ax, by - ay
            size = dx * dx + dy * dy
            t = max(0, min(1, ((x - ax) * dx + (y - ay) * dy) / size)) if size else 0
            best = min(best, math.hypot(x - ax - t * dx, y - ay - t * dy))
        return best
