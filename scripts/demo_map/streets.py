"""Streets and houses: a grid that has grown, not one that was ruled."""
import math

from . import shapes


class Grid:
    """Streets along u and across v, bent: `place` takes (u, v) to metres. A town grows along such lines."""

    def __init__(self, origin, angle, bend, rng):
        self.origin, self.bend, self.rng = origin, bend, rng
        self.cos, self.sin = math.cos(math.radians(angle)), math.sin(math.radians(angle))

    def place(self, u, v):
        b = self.bend
        # Little by the harbour, more further out.
        far = b * (0.55 + min(2.2, math.hypot(u - 250, v) / 600))
        bu = u + far * (1.0 * math.sin(v / 230 + u / 900 + 0.4) + 0.35 * math.sin(v / 97 + 2.0))
        bv = v + far * (1.1 * math.sin(u / 350 + 0.9) + 0.3 * math.sin(u / 141 + v / 400 + 1.2))
        return (self.origin[0] + bu * self.cos - bv * self.sin, self.origin[1] + bu * self.sin + bv * self.cos)

    def across(self, x, y):
        """(u, v) of a place."""
        u = v = 0.0
        for _ in range(40):
            px, py = self.place(u, v)
            dx, dy = x - px, y - py
            u, v = u + 0.8 * (dx * self.cos + dy * self.sin), v + 0.8 * (dy * self.cos - dx * self.sin)
        return u, v

    def line(self, a, b, step=20):
        count = max(1, round(math.dist(a, b) / step))
        return [self.place(*shapes.between(a, b, i / count)) for i in range(count + 1)]

    def ring(self, u0, v0, u1, v1):
        return [self.place(u, v) for u, v in ((u0, v0), (u1, v0), (u1, v1), (u0, v1))]

    def area(self, u0, v0, u1, v1, step=20):
        corners = [(u0, v0), (u1, v0), (u1, v1), (u0, v1), (u0, v0)]
        return [p for a, b in zip(corners, corners[1:]) for p in self.line(a, b, step)[:-1]]

    def houses(self, u0, v0, u1, v1, depth, dense):
        """Houses round a block whose edges are the edges of its streets: rows with yards behind them."""
        rng = self.rng
        width, height = u1 - u0, v1 - v0
        if width < 12 or height < 12:
            return
        depth = min(depth, height / 2 - 1.5, width / 2 - 1.5)
        rows = [(u0, u1, lambda s, t: (s, v0 + t)), (u0, u1, lambda s, t: (s, v1 - t))]
        if height > 2 * depth + 14:
            rows += [(v0 + depth + 2, v1 - depth - 2, lambda s, t: (u0 + t, s)),
                     (v0 + depth + 2, v1 - depth - 2, lambda s, t: (u1 - t, s))]
        for start, end, where in rows:
            at, left = start, rng.randint(2, 6)
            while at < end - 5:
                size = rng.uniform(6.5, 15) if dense else rng.uniform(8, 13)
                size = min(size, end - at)
                front = rng.choice((0, 0, 0, 1.2)) if dense else rng.uniform(3, 6)
                back = depth * rng.uniform(0.72, 1.0) if dense else front + rng.uniform(7, 10)
                if size > 4.5 and back < depth + 8 and rng.random() > (0.04 if dense else 0.16):
                    yield self.house(where, at, at + size, front, back, dense)
                at += size
                left -= 1
                if not dense:
                    at += rng.uniform(4, 11)
                elif left == 0:
                    at, left = at + rng.uniform(2.5, 6), rng.randint(2, 6)
        if dense and width > 2 * depth + 16 and height > 2 * depth + 16:
            low, high = v0 + depth + 4, v1 - depth - 4
            rows = max(1, int((high - low) / 17))
            for row in range(rows):
                yield from self.yards(u0 + depth + 4, low + (high - low) * row / rows, u1 - depth - 4,
                                      low + (high - low) * (row + 1) / rows - 3)

    def house(self, where, start, end, front, back, dense):
        """A rectangle, or one with a wing taken out."""
        corners = [(start, front), (end, front), (end, back), (start, back)]
        if dense and back - front > 8 and end - start > 8 and self.rng.random() < 0.45:
            notch, deep = (end - start) * self.rng.uniform(0.35, 0.55), (back - front) * self.rng.uniform(0.25, 0.45)
            corners = [(start, front), (end, front), (end, back - deep), (start + notch, back - deep), (start + notch, back),
                       (start, back)]
        return [self.place(*where(s, t)) for s, t in corners]

    def yards(self, u0, v0, u1, v1):
        """Workshops in the yards."""
        u = u0
        while u < u1 - 8:
            size = self.rng.uniform(7, 16)
            if u + size <= u1 and self.rng.random() < 0.6:
                low = v0 + self.rng.uniform(0, max(0.0, (v1 - v0) - 10) * 0.6)
                high = min(v1, low + self.rng.uniform(6, 13))
                if high - low > 4.5:
                    yield self.ring(u, low, u + size, high)
            u += size + self.rng.uniform(3, 9)
