#!/usr/bin/env python3
"""Capacities of cross-sections by strips, independent of the program: python3 section.py > FILE

A region is cut into strips along the neutral axis, ring by ring (a hole counts negative); each strip
has one strain. States of capacity follow the rules as they are printed: EN 1992-1-1 6.1 (edge at eps_cu2
while the neutral axis cuts the section, then turning about eps_c2; a bar at its limit before), ACI 318-19
22.2 (eps_cu at the edge, block over beta1 c). Roots by bisection alone. Compression is positive; a
direction is the angle from +z towards +y of the compressed side. About 1e-7 of the largest force.
"""
import math
import random

STRIPS = 1200  # in each part of a polygon between corners; 4 times as many in a circle
HALVINGS = 55


def stress(law, e, top):
    kind = law["kind"]
    if kind == "steel":
        yield_ = law["f"] / law["E"]
        if abs(e) <= yield_:
            return law["E"] * e
        return math.copysign(law["f"] + law["H"] * (abs(e) - yield_), e)
    if e <= 0.0:
        return 0.0
    if kind == "parabola":
        return law["f"] if e >= law["c"] else law["f"] * (1.0 - (1.0 - e / law["c"]) ** law["n"])
    if kind == "mander":
        x, r = e / law["c"], law["E"] / (law["E"] - law["f"] / law["c"])
        return law["f"] * x * r / (r - 1.0 + x ** r)
    return law["f"] if e >= (1.0 - law["beta"]) * top else 0.0


def seen(p, a):
    """Along the direction, and to its left."""
    return p[0] * math.sin(a) + p[1] * math.cos(a), p[1] * math.sin(a) - p[0] * math.cos(a)


def polygon_strips(ring, a, sign):
    points = [seen(p, a) for p in ring]
    levels = sorted({s for s, _ in points})
    for low, high in zip(levels, levels[1:]):
        step = (high - low) / STRIPS
        for i in range(STRIPS):
            s = low + (i + 0.5) * step
            cuts = sorted(p[1] + (q[1] - p[1]) * (s - p[0]) / (q[0] - p[0])
                          for p, q in zip(points, points[1:] + points[:1]) if (p[0] > s) != (q[0] > s))
            area = sum(v - u for u, v in zip(cuts[::2], cuts[1::2])) * step
            moment = sum(v * v - u * u for u, v in zip(cuts[::2], cuts[1::2])) * step / 2.0
            yield s - step / 2.0, s + step / 2.0, s, sign * area, sign * moment


def circle_strips(circle, a, sign):
    s0, t0 = seen(circle[:2], a)
    r, count = circle[2], 4 * STRIPS
    for i in range(count):
        u, v = math.pi * i / count, math.pi * (i + 1) / count
        area = r * r * ((v - u) - (math.sin(2 * v) - math.sin(2 * u)) / 2.0)
        yield (s0 - r * math.cos(u), s0 - r * math.cos(v), s0 - r * math.cos((u + v) / 2),
               sign * area, sign * area * t0)


class View:
    def __init__(self, section, a):
        self.section, self.a, self.strips = section, a, []
        for law, rings in section["regions"]:
            for i, ring in enumerate(rings):
                cut = circle_strips if isinstance(ring, tuple) else polygon_strips
                self.strips.append((section["laws"][law], list(cut(ring, a, -1.0 if i else 1.0))))
        self.top = max(s[1] for _, strips in self.strips for s in strips)
        self.bottom = min(s[0] for _, strips in self.strips for s in strips)
        self.bars = [(*seen(b, a), b[2], section["laws"][b[3]]) for b in section["bars"]]

    def sums(self, e0, k):
        n = ms = mt = 0.0
        top = e0 + k * self.top
        for law, strips in self.strips:
            edge = ((1.0 - law["beta"]) * top - e0) / k if law["kind"] == "block" and k > 0 else None
            for low, high, s, area, moment in strips:
                if law.get("spalls"):  # the part of the strip that is still there
                    left = min(1.0, max(0.0, ((law["cu"] - e0) / k - low) / (high - low)))
                    f = left * stress(law, min(e0 + k * s, law["cu"]), top)
                elif edge is None:
                    f = stress(law, e0 + k * s, top)
                else:
                    f = law["f"] * min(1.0, max(0.0, (high - edge) / (high - low)))
                n += f * area
                ms += f * area * s
                mt += f * moment
        for s, t, area, law in self.bars:
            e = e0 + k * s
            host = self.strips[self.section.get("host", 0)][0]
            f = area * (stress(law, e, top) - stress(host, e, top))
            n, ms, mt = n + f, ms + f * s, mt + f * t
        c, d = math.cos(self.a), math.sin(self.a)
        return n, c * ms + d * mt, d * ms - c * mt

    def at(self, x):
        """The capacity with the neutral axis at depth x under the edge."""
        law, h = self.strips[0][0], self.top - self.bottom
        if law["kind"] == "block" or x <= h:
            k = law["cu"] / x
        else:
            k = law["c"] / (x - (1.0 - law["c"] / law["cu"]) * h)
        axis = self.top - x
        for s, _, _, steel in self.bars:
            if steel.get("lim") and s < axis:
                k = min(k, steel["lim"] / (axis - s))
        return self.sums(-k * axis, k)

    def capacity(self, n):
        low, high = -8.0, 8.0  # logarithm of x / h
        h = self.top - self.bottom
        for _ in range(HALVINGS):
            mid = (low + high) / 2.0
            low, high = (mid, high) if self.at(h * math.exp(mid))[0] < n else (low, mid)
        return self.at(h * math.exp(low))

    def bent(self, n, k):
        """For a curvature; the axial strain by bisection."""
        low, high = -0.05, 0.05
        for _ in range(HALVINGS):
            mid = (low + high) / 2.0
            low, high = (mid, high) if self.sums(mid, k)[0] < n else (low, mid)
        return self.sums(low, k)


def towards(section, angle, n):
    """Turns the neutral axis until the moment points along the angle."""
    low, high = angle - 0.7, angle + 0.7
    for _ in range(34):
        mid = (low + high) / 2.0
        _, my, mz = View(section, mid).capacity(n)
        ahead = mz * math.cos(angle) - my * math.sin(angle)
        low, high = (low, mid) if ahead > 0.0 else (mid, high)
    return my, mz


def sections():
    rng = random.Random(20261122)
    steel = {"kind": "steel", "f": 450.0, "E": 2e5, "H": 0.0}
    hard = {"kind": "steel", "f": 435.0, "E": 2e5, "H": 850.0, "lim": 0.02}
    c30 = {"kind": "parabola", "f": 30.0, "c": 0.002, "cu": 0.0035, "n": 2.0}
    c70 = {"kind": "parabola", "f": 70.0, "c": 0.002416, "cu": 0.002656, "n": 1.437}
    block = {"kind": "block", "f": 25.5, "cu": 0.003, "beta": 0.82}
    core = {"kind": "mander", "f": 39.0, "c": 0.005, "cu": 0.018, "E": 26000.0}
    cover = {"kind": "mander", "f": 30.0, "c": 0.002, "cu": 0.005, "E": 26000.0, "spalls": True}
    ell = [(-200, -250), (300, -250), (300, 0), (50, 0), (50, 350), (-200, 350)]
    tee = [(-100, -300), (100, -300), (100, 150), (400, 150), (400, 300), (-400, 300), (-400, 150), (-100, 150)]
    angles = [2 * math.pi * (i + rng.uniform(0, 0.6)) / 7 for i in range(7)]
    rough = [(r * math.cos(a), r * math.sin(a)) for a, r in ((a, rng.uniform(240, 380)) for a in angles)]
    outer = [(-300, -200), (300, -200), (300, 200), (-300, 200)]
    inner = [(-150, -90), (150, -90), (150, 90), (-150, 90)]

    def bars(count, places):
        return [(y + rng.uniform(-8, 8), z + rng.uniform(-8, 8), rng.uniform(150, 700), 1)
                for y, z in places][:count]

    around = [(160 * math.cos(k), 160 * math.sin(k)) for k in range(6)]
    hollow = [(-240, -150), (240, -150), (240, 150), (-240, 150), (0, 150), (0, -150)]
    corners = [(-150, -200), (250, -200), (250, -50), (-150, 300), (0, 300)]
    flange = [(-60, -260), (60, -260), (350, 250), (-350, 250), (0, 250)]
    yield {"laws": [c30, steel], "regions": [(0, [ell])], "bars": bars(5, corners)}
    yield {"laws": [c70, steel], "regions": [(0, [ell])], "bars": bars(5, corners)}
    yield {"laws": [c30, hard], "regions": [(0, [tee])], "bars": bars(5, flange)}
    yield {"laws": [c70, hard], "regions": [(0, [outer, inner])], "bars": bars(6, hollow)}
    yield {"laws": [block, steel], "regions": [(0, [tee])], "bars": bars(5, flange)}
    yield {"laws": [c30, steel], "regions": [(0, [rough])], "bars": bars(6, around)}
    yield {"laws": [c70, steel], "regions": [(0, [(10.0, -5.0, 260.0)])], "bars": bars(6, around)}
    yield {"laws": [c30, hard], "regions": [(0, [(0.0, 0.0, 260.0), (20.0, 10.0, 110.0)])], "bars": bars(6, around)}
    yield {"laws": [core, hard, cover], "host": 0, "bars": bars(6, hollow), "bent": True,
           "regions": [(0, [[(-260, -170), (260, -170), (260, 170), (-260, 170)]]),
                       (2, [outer, [(-260, -170), (260, -170), (260, 170), (-260, 170)]])]}


def ring_words(ring):
    if isinstance(ring, tuple):
        y, z, r = ring
        return [(y + r, z, 1.0), (y - r, z, 1.0)]
    return [(y, z, 0.0) for y, z in ring]


def main():
    rng = random.Random(7)
    print("# by tests/oracle/section.py")
    for section in sections():
        print("section")
        for law in section["laws"]:
            kind = ["parabola", "block", "mander", "steel"].index(law["kind"])
            limit = law.get("cu", law.get("lim", 0.0))
            print("law", kind, law["f"], law.get("c", 0.0), limit, law.get("n", 2.0), law.get("beta", 0.0),
                  law.get("E", 0.0), law.get("H", 0.0), int(law.get("spalls", False)))
        for law, rings in section["regions"]:
            print("region", law)
            for ring in rings:
                print("ring", len(ring_words(ring)), *(repr(v) for p in ring_words(ring) for v in p))
        for bar in section["bars"]:
            print("bar", *map(repr, bar))
        for part in (-0.3, 0.15, 0.45, 0.8):
            a = rng.uniform(0, 2 * math.pi)
            view = View(section, a)
            if section.get("bent"):
                k = rng.uniform(2e-5, 6e-5)
                n = max(part, 0.0) * 4e6
                print("bent", repr(a), repr(n), repr(k), *map(repr, view.bent(n, k)[1:]))
                continue
            most = view.at(1e6 * (view.top - view.bottom))[0]
            least = view.at(1e-6 * (view.top - view.bottom))[0]
            n = part * most if part > 0.0 else -part * least
            print("capacity", repr(a), repr(n), *map(repr, view.capacity(n)[1:]))
            if part == 0.45 and section["laws"][0]["kind"] != "block":
                print("towards", repr(a), repr(n), *map(repr, towards(section, a, n)))


main()
