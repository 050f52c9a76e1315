#!/usr/bin/env python3
"""Write a random but realistic case file: python3 randomcase.py SEED out.json

The same seed gives the same file. The building (1 to 5 storeys), its modes, five spectra,
one or two pushes and about twelve evaluations are drawn; lengths and forces are chosen in
metres and newtons and written in a random unit system.
"""
import json
import math
import random
import sys

FORCE = {"N": 1.0, "kN": 1e3, "MN": 1e6, "kgf": 9.80665, "tonf": 9806.65,
         "lbf": 4.4482216152605, "kips": 4448.2216152605}
LENGTH = {"mm": 1e-3, "cm": 1e-2, "m": 1.0, "in": 0.0254, "ft": 0.3048}
UNITS = [("kN", "m"), ("N", "mm"), ("kN", "mm"), ("kgf", "cm"), ("tonf", "m"), ("MN", "m"),
         ("kips", "in"), ("kips", "ft"), ("lbf", "in"), ("lbf", "ft"), ("kN", "cm"), ("N", "m")]
G = 9.80665
CURVES = ["elastic", "bilinear", "hardening", "softening", "plateau", "dip", "smooth"]


def num(x):
    return float("%.10g" % x)


class Maker:
    def __init__(self, seed):
        self.r = random.Random(seed)
        self.seed = seed
        self.fname, self.lname = self.r.choice(UNITS)
        self.F, self.L = FORCE[self.fname], LENGTH[self.lname]
        self.hard = math.exp(self.r.gauss(0.0, 0.5))  # one seismic intensity for all spectra

    def building(self):
        r = self.r
        self.n = r.randint(1, 5)
        self.heights = [r.uniform(2.6, 4.6) for _ in range(self.n)]
        wide = r.random() < 0.35
        listed = self.listed = r.random() < 0.85
        to_mass = self.L / self.F  # kg to force * s2 / length
        base_mass = r.random() < 0.4
        self.nodes, self.storeys, self.floor = [], [], []

        def add(x, z, mass, restraint):
            m = [num(mass * to_mass)] * 3
            if r.random() < 0.2:
                m[r.choice([1, 2])] = num(mass * to_mass * r.uniform(0.5, 1.5))
            self.nodes.append({"id": len(self.nodes) * 3 + 1, "restraint": restraint,
                               "xyz": [num(x / self.L), 0.0, num(z / self.L)], "mass": m})
            return self.nodes[-1]["id"]

        for x in ([0.0, 6.0] if wide else [0.0]):
            add(x, 0.0, 2e4 if base_mass else 0.0, [1, 1, 1, 1, 1, 1])
        z = 0.0
        for i, h in enumerate(self.heights):
            z += h
            ids = []
            for x in ([0.0, 6.0] if wide else [0.0]):
                out_of_plane = [0, 1, 0, 1, 0, 1] if r.random() < 0.2 else [0] * 6
                ids.append(add(x, z, r.uniform(3e4, 3e5), out_of_plane))
            self.floor.append(ids)
            self.storeys.append({"name": "%dF" % (i + 1), "height": num(h / self.L),
                                 "nodes": ids})
        self.total_height = z
        self.skewed = wide and r.random() < 0.5  # nodes of a storey move unequally
        if not listed:
            self.storeys = []
        self.by_id = {n["id"]: n for n in self.nodes}

    def free_mass(self, i, d):
        n = self.by_id[i]
        return 0.0 if n["restraint"][d] else n["mass"][d]

    def profile(self, kind):
        n = self.n
        if kind == 2:
            return [math.sin(1.5 * math.pi * (i + 1) / n) if n > 1 else 1.0 for i in range(n)]
        e = self.r.uniform(0.7, 1.6)
        return [((i + 1) / n) ** e for i in range(n)]

    def mode(self, d, prof, period, given):
        scale = self.r.choice([1.0, 1.0, -1.0, self.r.uniform(0.01, 5.0)])
        shape, gen, lever = {}, 0.0, [0.0] * 6
        for i, ids in enumerate(self.floor):
            for j, node in enumerate(ids):
                v = [0.0] * 6
                v[d] = num(prof[i] * scale * (1.0 + 0.05 * j * self.skewed))
                if self.by_id[node]["restraint"][d]:
                    v[d] = 0.0
                shape[str(node)] = v
                gen += self.free_mass(node, d) * v[d] ** 2
                lever[d] += self.free_mass(node, d) * v[d]
        out = {"period": num(period), "shape": shape}
        if given:
            all_mass = sum(self.free_mass(k, d) for ids in self.floor for k in ids)
            p, q = [0.0] * 6, [0.0] * 6
            if gen > 0.0:
                p[d] = num(lever[d] / gen)
                q[d] = num(100.0 * lever[d] ** 2 / (gen * all_mass))
            out["participation"], out["mass_percent"] = p, q
        return out

    def modes(self):
        r = self.r
        self.dir = r.choice([0, 0, 0, 1])
        if self.dir == 1:  # free everything in the push direction
            for n in self.nodes[len(self.floor[0]):]:
                n["restraint"] = [0] * 6
        given = r.random() < 0.6
        self.T1 = min(2.5, max(0.08, 0.12 * self.n * math.exp(r.gauss(0.0, 0.5))))
        self.phi = self.profile(1)
        main = self.mode(self.dir, self.phi, self.T1, given)
        other = self.mode(1 - self.dir, self.profile(1), self.T1 * 0.9, given)
        out = [main, other]
        if self.n > 1:
            out.append(self.mode(self.dir, self.profile(2), self.T1 / 3.0, given))
        if r.random() < 0.5:
            out[0], out[1] = out[1], out[0]
        self.main_mode = out.index(main) + 1
        return out

    # ---- capacity: y/ay against x/dy

    def backbone(self, kind):
        r = self.r
        a = r.uniform(0.0, 0.15)
        if kind == "elastic":
            return [(0, 0), (1, 1)]
        if kind == "bilinear":
            m = r.uniform(2, 12)
            return [(0, 0), (1, 1), (m, 1 + a * (m - 1))]
        if kind == "hardening":
            m = r.uniform(3, 10)
            return [(0, 0), (0.7, 0.7), (1.2, 1), (2.2, 1.2), (m, 1.25 + a * (m - 2.2))]
        if kind == "softening":
            m, e = r.uniform(1.5, 4), r.uniform(4.5, 10)
            return [(0, 0), (1, 1), (m, 1 + a * (m - 1)), (e, r.uniform(0.2, 0.95))]
        if kind == "plateau":
            m = r.uniform(2, 8)
            return [(0, 0), (0.6, 0.7), (1, 1), (m, 1)] + ([(m + 2, 0.7)] if r.random() < 0.4 else [])
        if kind == "dip":
            m = r.uniform(1.3, 3)
            return [(0, 0), (1, 1), (m, 1.1), (m + 0.15, 1.03), (m + 3, 1.3)]
        return [(x / 10.0, math.tanh(x / 10.0) * (1 + 0.02 * x / 10.0))
                for x in range(0, 10 * r.randint(2, 9) + 1)]

    def steps(self, kind):
        r = self.r
        bone = self.backbone(kind)
        n = r.choice([1, 2, 3, 5, 8, 15, 25, 40, 70, 110]) if r.random() < 0.5 else r.randint(10, 60)
        top = bone[-1][0]
        first = min(r.uniform(0.2, 1.0), bone[1][0]) if kind != "smooth" else 0.1
        xs = set()
        if n == 1:
            xs = {top if kind == "elastic" else first}
        else:
            xs = {first + (top - first) * i / (n - 1) for i in range(n)}
            if r.random() < 0.5:
                xs |= {p[0] for p in bone if p[0] > first}
            if r.random() < 0.3:
                xs = {x * (1 + 0.2 / n * r.uniform(-1, 1)) for x in xs}
        xs = sorted(x for x in xs if x > 0)
        ys = []
        for x in xs:
            i = 0
            while i < len(bone) - 2 and x > bone[i + 1][0]:
                i += 1
            (x1, y1), (x2, y2) = bone[i], bone[i + 1]
            ys.append(y1 + (y2 - y1) * (x - x1) / (x2 - x1))
        if kind == "elastic" and not self.exact:
            ys = [y * (1 - 0.04 * x / xs[-1]) for x, y in zip(xs, ys)]
        if self.fold and len(xs) > 5:
            k = r.randint(3, len(xs) - 1)
            xs[k] = xs[k - 1] - 0.3 * (xs[k - 1] - xs[k - 2])
        return xs, ys

    def push(self, name):
        r = self.r
        kind = r.choice(CURVES)
        self.exact = kind == "elastic" and r.random() < 0.5
        self.fold = r.random() < 0.03
        xs, ys = self.steps(kind)
        d = self.dir
        floors = range(self.n)
        mass = [sum(self.free_mass(k, d) for k in self.floor[i]) * self.F / self.L for i in floors]
        s1 = sum(mass[i] * self.phi[i] for i in floors)
        s2 = sum(mass[i] * self.phi[i] ** 2 for i in floors)
        gamma, mstar = s1 / s2, s1
        demand = 0.6 * self.hard * min(1.0, 0.5 / self.T1)  # elastic, roughly, in g
        ay = demand / min(5.0, max(0.4, 1.5 * math.exp(r.gauss(0.0, 0.6)))) * G
        dy = ay * (self.T1 / (2 * math.pi)) ** 2
        # On a straight curve the secant rules meet a square root of zero: use the other rule.
        self.exact = self.exact or max(abs(y / x * xs[0] / ys[0] - 1) for x, y in zip(xs, ys)) < 1e-6
        sign = r.choice([1, 1, -1])
        roof = [sign * gamma * dy * x / self.L for x in xs]
        shear = [sign * gamma * mstar * ay * y / self.F for y in ys]
        table = {}
        for i, ids in enumerate(self.floor):
            tilt = r.uniform(-0.3, 0.3) * (i + 1) / self.n * (1 - (i + 1) / self.n)
            for j, node in enumerate(ids):
                skew = 1 + r.uniform(-0.08, 0.08) if self.skewed and j else 1.0
                table[str(node)] = [num(u * skew * (self.phi[i] + tilt * x / (1 + x)))
                                    for u, x in zip(roof, xs)]
        storey = self.n - 1 if r.random() < 0.8 else r.randrange(self.n)
        control = self.floor[storey][0]
        pattern = {"kind": r.choice(["static", "acceleration", "mode", "mode x story mass"])}
        if pattern["kind"].startswith("mode"):
            pattern["modes"] = [self.main_mode]
        option = 1 if self.exact or r.random() < 0.8 else 2
        return {"name": name, "control_node": control, "control_option": option,
                "direction": ["DX", "DY"][d], "pattern": pattern,
                "steps": {"load_factor": [num((i + 1) / len(xs)) for i in range(len(xs))],
                          "base_reaction": [num(v) for v in shear], "displacement": table}}, \
            (kind, self.exact, self.fold)

    # ---- spectra

    def spectra(self):
        r, hard = self.r, self.hard

        def states(p):
            ag, f0, tc = 0.18 * hard, r.uniform(2.3, 2.7), r.uniform(0.25, 0.45)
            rows = {"SLO": (0.25, 0.85), "SLD": (0.35, 0.9), "SLV": (1.0, 1.0), "SLC": (1.3, 1.05)}
            return {k: {"ag": num(ag * a), "F0": num(f0 * (0.97 + 0.03 * b)), "TC*": num(tc * b)}
                    for k, (a, b) in rows.items() if k == "SLV" or r.random() < p}

        atc = {"name": "ATC", "kind": "atc40", "Ca": num(0.25 * hard),
               "Cv": num(0.25 * hard * r.uniform(0.6, 1.8))}
        if r.random() < 0.5:
            atc["floors"] = r.random() < 0.5
        ec8 = {"name": "EC8", "kind": "ec8-2004", "type": r.choice([1, 2]),
               "soil": r.choice("ABCDE"), "ag": num(0.2 * hard)}
        if r.random() < 0.5:
            ec8["damping"] = r.choice([2, 3, 5, 10, 40])
        if r.random() < 0.25:
            ec8.update({"S": 1.25, "TB": 0.12, "TC": num(r.uniform(0.3, 0.9)), "TD": 2.5})
        ec94 = {"name": "EC94", "kind": "ec8-1994", "soil": r.choice("ABC"), "ag": num(0.2 * hard)}
        if r.random() < 0.5:
            ec94["damping"] = r.choice([2, 5, 7, 20])
        ntc = {"name": "NTC", "kind": "ntc", "soil": r.choice("ABCDE"),
               "topography": r.choice(["T1", "T2", "T3", "T4"]), "limit_states": states(1.0)}
        if r.random() < 0.4:
            ntc["damping"] = r.choice([2, 5, 8])
        part = dict(ntc, name="NTCpart", limit_states=states(0.5))
        return [atc, ec8, ec94, ntc, part, self.user(hard)]

    def user(self, hard):
        r = self.r
        tb, tc, top = r.uniform(0.05, 0.2), r.uniform(0.3, 0.9), 0.6 * hard
        n = r.choice([4, 8, 20, 60])
        end = r.choice([3.0, 4.0, 6.0])
        ts = sorted({0.0, tb, tc} | {end * ((i + 1) / n) ** 1.5 for i in range(n)})
        if r.random() < 0.3:
            ts = [t for t in ts if t > 0.0]
        sa = []
        for t in ts:
            a = top * (0.4 + 0.6 * t / tb) if t < tb else top if t <= tc else top * tc / t
            sa.append(num(a * (1.0 if self.r.random() < 0.6 else self.r.uniform(0.92, 1.0))))
        out = {"name": "USR", "kind": "user", "T": [num(t) for t in ts], "Sa": sa}
        if r.random() < 0.3:
            out["gravity"] = num(9.81 / self.L)
        return out

    # ---- evaluations

    def evaluation(self, k, push, about, method, proc):
        r = self.r
        kind, exact, fold = about
        ev = {"name": "%02d %s%s %s" % (k, method, " " + proc if proc else "", kind),
              "push": push["name"], "method": method,
              "spectrum": r.choice(["ATC", "EC8", "EC94", "NTC", "USR"])}
        if method.startswith("NTC"):
            ev["spectrum"] = r.choice(["NTC", "NTC", "NTC", "NTCpart", "NTCpart", "EC8", "USR"])
        if r.random() < 0.7:
            ev["eigen_factors"] = r.random() < 0.5
        if proc:
            ev["procedure"] = proc
            if r.random() < 0.85:
                ev["behavior"] = r.randint(0, 3)
            if r.random() < 0.5:
                ev["elastic_damping"] = r.choice([2, 3, 5, 7, 10])
            if ev.get("behavior") == 3 and method == "ATC-40":
                b1 = num(r.uniform(2, 20))
                ev["user_damping"] = [b1, num(r.uniform(0.5, 1.1)),
                                      num(b1 + r.choice([0, r.uniform(1, 30)])),
                                      num(r.uniform(0.2, 0.9))]
            if method == "FEMA440" and r.random() < 0.3:
                ev["alpha_in_percent"] = True
            return ev
        if r.random() < 0.6:
            ev["drift_kind"] = r.choice([1, 2])
        if r.random() < (0.6 if method == "EC8/OPCM" else 0.2):
            ev["masonry"] = True
        if not self.storeys and method == "EC8/OPCM":
            ev["masonry"] = False
        if exact or r.random() < 0.5:
            b = {"rule": "ec8" if exact else r.choice(["ec8", "ntc", "masonry"])}
            if b["rule"] != "ec8":
                if r.random() < 0.6:
                    b["secant"] = num(r.uniform(0.4, 0.9))
                if r.random() < 0.6:
                    b["drop"] = num(r.uniform(0.5, 0.97))
            elif method == "EC8/OPCM" and r.random() < 0.6:
                b["iterate"] = True
            if not exact and r.random() < 0.25:
                b["strength"] = "peak"
            ev["bilinear"] = b
        return ev

    def case(self):
        r = self.r
        self.building()
        modes = self.modes()
        doc = {"format": "qm-rps case 1", "title": "random case %d" % self.seed,
               "units": {"force": self.fname, "length": self.lname}}
        if r.random() < 0.3:
            doc["gravity"] = num(r.choice([9.81, 9.80665, 9.8]) / self.L)
        doc["nodes"] = self.nodes
        if self.storeys:
            doc["storeys"] = self.storeys
        doc["modes"] = modes if r.random() < 0.98 else []
        doc["spectra"] = self.spectra()
        if not doc["modes"]:
            doc["title"] += ", no modes"
        pushes = [self.push("P%d" % (i + 1)) for i in range(r.choice([1, 2, 2, 3]))]
        if any(about[2] for _, about in pushes):
            doc["title"] += ", a curve that turns back"
        if not doc["modes"]:  # a mode pattern needs its mode
            for p, _ in pushes:
                p["pattern"] = {"kind": "static"}
        doc["pushover"] = [p for p, _ in pushes]
        want = [("ATC-40", "A"), ("ATC-40", "B"), ("FEMA440", "A"), ("FEMA440", "B"),
                ("FEMA440", "C"), ("EC8/OPCM", ""), ("NTC2008", ""), ("NTC2018", "")]
        want += [r.choice(want) for _ in range(4)] + [("EC8/OPCM", "")]
        if not self.storeys:  # drifts need storeys
            want = [w for w in want if not w[0].startswith("NTC")]
        doc["evaluations"] = []
        for k, (method, proc) in enumerate(want):
            p, about = r.choice(pushes)
            doc["evaluations"].append(self.evaluation(k + 1, p, about, method, proc))
        return doc


def main():
    if len(sys.argv) != 3:
        sys.exit("usage: randomcase.py SEED out.json")
    doc = Maker(int(sys.argv[1])).case()
    with open(sys.argv[2], "w", encoding="utf-8") as f:
        json.dump(doc, f, indent=1, allow_nan=False)
        f.write("\n")


if __name__ == "__main__":
    main()
