#!/usr/bin/env python3
"""Dismantles the bridge of stagedbridge.py from its finished shape: which tensions, and which places
at which pieces are set, lead there? Plane frame in X, Z with its own stiffness method; standard
library only; written without reading the engine.

    python3 backward.py [--second-order] -o case.json

The finished bridge under dead load and SDL is chosen freely: all nodes at their design places, the
stays with the forces of CHOSEN. Stages are then taken away, last first. From one state to the one
before, the elements that stay keep their forces but for K_e (u_before - u), so that
    sum K_e (u_before - u) + f_e + K_G(N) u_before = P_before,
without anything of how the elements were born. Supports must come without force: that settles the
reaction of abutment 13 and the two forces of the locking link. An element that goes tells the rest:
a stay's initial tension, and where the new nodes of a beam stood at its birth. The births become
the coordinates of the case file (so that each is a displacement of 0), all places are measured
from there, and the whole is repeated until nothing changes. Second order as in the program:
displacements from the coordinates of the case file, K_G of each element's mean axial force on the
whole of them, Ernst's modulus over the stretch since birth.

Beside the case file, FILE.target.json has the displacements that the forward assembly must end with
(design place minus birth), the chosen stay forces, and every axial force at the end of each stage.
"""
import argparse
import json
import math
from pathlib import Path

import stagedbridge as bridge

DEAD_AND_SDL = 125.0  # kN/m, for the choice of the stay forces alone
# Length of deck that each stay carries.
SHARE = {102: 10, 103: 10, 104: 15, 105: 15, 106: 10, 107: 15, 108: 15}
# Nodes born with the stages, in an order in which each hangs on what stands: node, by which elements.
BIRTHS = {"pylon": [(60, [21]), (61, [31]), (52, [22]), (53, [23]), (54, [24]), (55, [25])],
          "deck 5 6": [(6, [30, 40]), (5, [5]), (7, [6])],
          "deck 4 7": [(4, [4]), (8, [7])], "deck 3 8": [(3, [3]), (9, [8])],
          "deck 2 9": [(2, [2]), (10, [9])], "deck 1 10": [(1, [1]), (11, [10])],
          "deck 11": [(12, [11])], "closure": [(13, [12])]}
HELD = {51: (0, 1, 2), 1: (0, 1), 13: (1,)}  # x, z, turn
SDL = 35.0


def solve(matrix, right):
    """Symmetric, by elimination without pivoting; rows of the band only."""
    n = len(right)
    a = [row[:] for row in matrix]
    x = right[:]
    for k in range(n):
        pivot, row = a[k][k], a[k]
        for i in range(k + 1, n):
            if row[i] != 0.0:
                f = row[i] / pivot
                other = a[i]
                for j in range(i, n):
                    other[j] -= f * row[j]
                x[i] -= f * x[k]
    for k in reversed(range(n)):
        row = a[k]
        x[k] = (x[k] - sum(row[j] * x[j] for j in range(k + 1, n) if row[j] != 0.0)) / row[k]
    return x


def times(matrix, vector):
    return [sum(m * v for m, v in zip(row, vector)) for row in matrix]


def turned(local, c, s):
    """R^T local R for two nodes of x, z, turn; local x along (c, s), turn from x to z."""
    r = [[0.0] * 6 for _ in range(6)]
    for o in (0, 3):
        r[o][o], r[o][o + 1], r[o + 1][o], r[o + 1][o + 1], r[o + 2][o + 2] = c, s, -s, c, 1.0
    lr = [[sum(local[i][k] * r[k][j] for k in range(6)) for j in range(6)] for i in range(6)]
    return [[sum(r[k][i] * lr[k][j] for k in range(6)) for j in range(6)] for i in range(6)]


class Element:
    def __init__(self, record, materials, sections):
        self.id, self.kind, (self.i, self.j) = record["id"], record["kind"], record["nodes"]
        if self.kind == "link":
            self.k = record["stiffness"]
            return
        m, s = materials[record["material"]], sections[record["section"]]
        self.E, self.A, self.I = m["E"], s["A"], s.get("Iy", 0.0)
        self.w = m["density"] * self.A * bridge.GRAVITY

    def place(self, xz):
        (xi, zi), (xj, zj) = xz[self.i], xz[self.j]
        self.L = math.hypot(xj - xi, zj - zi)
        if self.kind != "link":
            self.c, self.s = (xj - xi) / self.L, (zj - zi) / self.L

    def sag(self, n):
        return 1.0 / (1.0 + (self.w * self.L * self.c) ** 2 * self.E * self.A / (12.0 * n ** 3))

    def stiffness(self, factor=1.0):
        k = [[0.0] * 6 for _ in range(6)]
        if self.kind == "link":
            for d, value in ((0, self.k[0]), (1, self.k[2]), (2, self.k[4])):
                k[d][d] = k[d + 3][d + 3] = value
                k[d][d + 3] = k[d + 3][d] = -value
            return k
        a = factor * self.E * self.A / self.L
        k[0][0] = k[3][3] = a
        k[0][3] = k[3][0] = -a
        if self.kind == "beam":
            self._bend(k, 12.0, 6.0, 4.0, 2.0, self.E * self.I / self.L ** 3)
        return turned(k, self.c, self.s)

    def geometric(self, n):
        k = [[0.0] * 6 for _ in range(6)]
        if self.kind == "beam":
            self._bend(k, 1.2, 0.1, 2.0 / 15.0, -1.0 / 30.0, n / self.L)
        elif self.kind == "truss":
            k[1][1] = k[4][4] = n / self.L
            k[1][4] = k[4][1] = -n / self.L
        return turned(k, self.c, self.s) if self.kind != "link" else k

    def _bend(self, k, across, mixed, near, far, f):
        L = self.L
        rows = [[across, mixed * L, -across, mixed * L],
                [mixed * L, near * L * L, -mixed * L, far * L * L],
                [-across, -mixed * L, across, -mixed * L],
                [mixed * L, far * L * L, -mixed * L, near * L * L]]
        for i, p in enumerate((1, 2, 4, 5)):
            for j, q in enumerate((1, 2, 4, 5)):
                k[p][q] = f * rows[i][j]

    def weight(self):
        """Nodal forces of the own weight."""
        if self.kind == "link":
            return [0.0] * 6
        half = -0.5 * self.w * self.L
        turn = half * self.L * self.c / 6.0 if self.kind == "beam" else 0.0
        return [0.0, half, turn, 0.0, half, -turn]

    def tension(self, f):
        """Axial force from elastic end forces."""
        return 0.0 if self.kind == "link" else f[3] * self.c + f[4] * self.s


class Dismantling:
    def __init__(self, second):
        self.case = bridge.structure()
        self.second = second
        by_name = lambda key: {r["name"]: r for r in self.case[key]}
        materials, sections = by_name("materials"), by_name("sections")
        self.elements = {r["id"]: Element(r, materials, sections) for r in self.case["elements"]}
        self.design = {n["id"]: (n["xyz"][0], n["xyz"][2]) for n in self.case["nodes"]}
        self.at = {n: i for i, n in enumerate(self.design)}
        self.lift = {n: [0.0, 0.0, 0.0] for n in self.design}  # birth less design place; turn
        self.tension = {}
        self.free = [0.0, 0.0, 0.0]  # reaction of 13, force and moment of the link
        self.states = self._states()
        self.axial = [dict() for _ in self.states]
        self._place()
        self.chosen = self._choose()

    @staticmethod
    def _states():
        """Elements, supports and SDL at the end of each stage, the empty site first."""
        states, active, held = [("site", frozenset(), frozenset(), False)], set(), set()
        for name, come, supports, gone, _ in bridge.STAGES:
            active = (active | set(come)) - set(gone)
            held = held | set(supports)
            states.append((name, frozenset(active), frozenset(held), False))
        states.append(("finished", frozenset(active), frozenset(held), True))
        return states

    def _place(self):
        self.xz = {n: (x + self.lift[n][0], z + self.lift[n][1]) for n, (x, z) in self.design.items()}
        for e in self.elements.values():
            e.place(self.xz)

    def _choose(self):
        """Stay forces that carry their share of the deck and leave the pylon's foot upright."""
        n = {s: DEAD_AND_SDL * share / self.elements[s].s for s, share in SHARE.items()}
        foot = self.design[51][1]
        pull = lambda s: -self.elements[s].c * (self.design[self.elements[s].j][1] - foot)
        n[101] = -sum(n[s] * pull(s) for s in n) / pull(101)
        return n

    def dofs(self, e):
        i, j = 3 * self.at[e.i], 3 * self.at[e.j]
        return [i, i + 1, i + 2, j, j + 1, j + 2]

    def loads(self, state):
        _, active, _, sdl = state
        p = [0.0] * (3 * len(self.at))
        for i in active:
            e = self.elements[i]
            for d, w in zip(self.dofs(e), e.weight()):
                p[d] += w
        for n in range(1, 14) if sdl else ():
            p[3 * self.at[n] + 1] -= SDL * (5.0 if n in (1, 13) else 10.0)
        return p

    def end_u(self):
        u = [0.0] * (3 * len(self.at))
        for n, i in self.at.items():
            u[3 * i], u[3 * i + 1], u[3 * i + 2] = -self.lift[n][0], -self.lift[n][1], self.lift[n][2]
        return u

    def assemble(self, k, inner, e, matrix, f):
        d = self.dofs(e)
        for a in range(6):
            inner[d[a]] += f[a]
            for b in range(6):
                k[d[a]][d[b]] += matrix[a][b]

    def unknowns(self, k, held):
        fixed = {3 * self.at[n] + d for n in held for d in HELD[n]}
        return [i for i in range(len(k)) if i not in fixed and k[i][i] > 0.0]

    def balance(self, k, rest, held):
        """Solves k x = rest with the held directions at 0."""
        own = self.unknowns(k, held)
        x = [0.0] * len(k)
        for i, v in zip(own, solve([[k[i][j] for j in own] for i in own], [rest[i] for i in own])):
            x[i] = v
        return x

    def finished(self, reaction):
        """Element forces of the finished bridge: statically determinate once these are chosen."""
        state, u = self.states[-1], self.end_u()
        size = len(u)
        k, inner = [[0.0] * size for _ in range(size)], [0.0] * size
        for i in state[1]:
            e = self.elements[i]
            d = self.dofs(e)
            if self.second:
                bent = times(e.geometric(self.axial[-1].get(i, 0.0)), [u[a] for a in d])
                for a, value in zip(d, bent):
                    inner[a] += value
            if i in self.chosen:
                n = self.chosen[i]
                pull = [-n * e.c, -n * e.s, 0.0, n * e.c, n * e.s, 0.0]
                for a, value in zip(d, pull):
                    inner[a] += value
            else:
                self.assemble(k, inner, e, e.stiffness(), [0.0] * 6)
        rest = [p - f for p, f in zip(self.loads(state), inner)]
        rest[3 * self.at[13] + 1] += reaction
        x = self.balance(k, rest, {51, 1})
        forces = {}
        for i in state[1]:
            e = self.elements[i]
            if i in self.chosen:
                n = self.chosen[i]
                forces[i] = [-n * e.c, -n * e.s, 0.0, n * e.c, n * e.s, 0.0]
            else:
                forces[i] = times(e.stiffness(), [x[a] for a in self.dofs(e)])
        return u, forces

    def reaction(self, state, u, forces, axial, node, direction):
        at = 3 * self.at[node] + direction
        r = -self.loads(state)[at]
        for i in state[1]:
            e, d = self.elements[i], self.dofs(self.elements[i])
            if at in d:
                f = forces[i]
                if self.second:
                    bent = times(e.geometric(axial.get(i, 0.0)), [u[a] for a in d])
                    f = [a + b for a, b in zip(f, bent)]
                r += f[d.index(at)]
        return r

    def back(self, index, u, forces):
        """From the state to the one before it: its displacements and element forces."""
        before, size = self.states[index - 1], len(u)
        k, inner, matrices = [[0.0] * size for _ in range(size)], [0.0] * size, {}
        base = {}
        for i in before[1]:
            e, d = self.elements[i], self.dofs(self.elements[i])
            f = forces[i]
            factor = 1.0
            if self.second and i in self.tension:
                now, then = e.tension(f), self.axial[index - 1].get(i, e.tension(f))
                factor = e.sag(then)
                n = self.tension[i] + (now - self.tension[i]) * factor / e.sag(now)
                f = [-n * e.c, -n * e.s, 0.0, n * e.c, n * e.s, 0.0]
            base[i], matrices[i] = f, e.stiffness(factor)
            self.assemble(k, inner, e, matrices[i], f)
            if self.second:
                g = e.geometric(self.axial[index - 1].get(i, e.tension(f)))
                self.assemble(k, inner, e, g, times(g, [u[a] for a in d]))
        rest = [p - f for p, f in zip(self.loads(before), inner)]
        du = self.balance(k, rest, before[2])
        after = {i: [a + b for a, b in zip(base[i], times(matrices[i], [du[a] for a in self.dofs(
            self.elements[i])]))] for i in before[1]}
        return [a + b for a, b in zip(u, du)], after

    def run(self, free):
        """All states backwards. What the supports carry when they come, and all states."""
        u, forces = self.finished(free[0])
        trail, left = [(u, forces)], {}
        for index in range(len(self.states) - 1, 0, -1):
            state, before = self.states[index], self.states[index - 1]
            axial = {i: self.elements[i].tension(f) for i, f in forces.items()}
            for n in state[2] - before[2] - {51}:
                for d in HELD[n]:
                    left[n, d] = self.reaction(state, u, forces, axial, n, d)
            if bridge.LINK in before[1] - state[1]:
                x, turn = free[1:]
                forces = dict(forces)
                forces[bridge.LINK] = [-x, 0.0, -turn, x, 0.0, turn]
            if index == 1:
                break
            u, forces = self.back(index, u, forces)
            trail.append((u, forces))
        trail.append(([0.0] * len(u), {}))
        return [left[13, 1], left[1, 0], left[1, 1]], trail[::-1]

    def settle(self):
        """Free forces for which the supports come without force: linear, so one step of Newton."""
        base, _ = self.run(self.free)
        columns = []
        for i in range(3):
            moved = self.free[:]
            moved[i] += 1000.0
            columns.append([(a - b) / 1000.0 for a, b in zip(self.run(moved)[0], base)])
        # 3 x 3 by Cramer's rule; columns[i] is the change with free force i.
        det = lambda a, b, c: (a[0] * (b[1] * c[2] - b[2] * c[1]) - b[0] * (a[1] * c[2] - a[2] * c[1])
                               + c[0] * (a[1] * b[2] - a[2] * b[1]))
        whole = det(*columns)
        for i in range(3):
            swapped = columns[:]
            swapped[i] = base
            self.free[i] -= det(*swapped) / whole

    def births(self, trail):
        """Moves the births to where they must be; the largest change of a place or tension."""
        change = 0.0
        for index in range(1, len(self.states)):
            state, before = self.states[index], self.states[index - 1]
            (u, forces), (old, _) = trail[index], trail[index - 1]
            self.axial[index] = {i: self.elements[i].tension(f) for i, f in forces.items()}
            grown = {n: [u[3 * a + d] - old[3 * a + d] for d in range(3)]
                     for n, a in self.at.items()}
            for i in state[1] - before[1]:
                e = self.elements[i]
                if i not in self.chosen:
                    continue
                stretch = (grown[e.j][0] - grown[e.i][0]) * e.c + (grown[e.j][1] - grown[e.i][1]) * e.s
                n = e.tension(forces[i])
                factor = e.sag(n) if self.second else 1.0
                new = n - factor * e.E * e.A / e.L * stretch
                change = max(change, abs(new - self.tension.get(i, 0.0)) / 1e4)
                self.tension[i] = new
            for node, by in BIRTHS.get(state[0], []):
                k, rest = [[0.0] * 3 for _ in range(3)], [0.0] * 3
                for i in by:
                    e = self.elements[i]
                    m, o = e.stiffness(), 3 if e.j == node else 0
                    other = grown[e.i if o else e.j]
                    for a in range(3):
                        rest[a] += forces[i][o + a] - sum(m[o + a][3 - o + b] * other[b] for b in range(3))
                        for b in range(3):
                            k[a][b] += m[o + a][o + b]
                grown[node] = solve(k, rest)
                at = [u[3 * self.at[node] + d] - grown[node][d] for d in range(3)]
                change = max(change, *map(abs, at))
                lift = self.lift[node]
                lift[0], lift[1], lift[2] = lift[0] + at[0], lift[1] + at[1], lift[2] - at[2]
        self._place()
        return change

    def converge(self):
        for iteration in range(200):
            self.settle()
            left, trail = self.run(self.free)
            change = self.births(trail)
            print(f"{iteration:3d}  change {change:.3e}  forces at supports {max(map(abs, left)):.1e}",
                  flush=True)
            if change < 1e-13:
                break
        return trail

    def write(self, path, trail):
        case = dict(self.case)
        order = "second" if self.second else "first"
        case["title"] = f"forward assembly of the cable-stayed bridge, {order} order"
        case["nodes"] = [dict(n, xyz=[self.xz[n["id"]][0], 0, self.xz[n["id"]][1]])
                         for n in case["nodes"]]
        case["stage_control"] = {"geometric_stiffness": self.second, "cable_sag": self.second}
        case["load_cases"] = [
            {"name": "DEAD", "load_group": 0, "self_weight": [0, 0, -1]},
            {"name": "SDL", "load_group": 0,
             "nodal": [{"node": n, "load": [0, 0, -SDL * (5 if n in (1, 13) else 10), 0, 0, 0]}
                       for n in range(1, 14)]},
            *({"name": f"T{s}", "pretension": [{"element": s, "force": self.tension[s]}]}
              for s in bridge.STAYS)]
        case["stages"] = [
            bridge.stage(name, come, supports, gone, (["DEAD"] if name == "pylon" else []) +
                         [f"T{s}" for s in bridge.STAYS if s in come], [])
            for name, come, supports, gone, _ in bridge.STAGES]
        case["stages"].append(bridge.stage("finished", [], [], [], ["SDL"], []))
        path.write_text(bridge.text(case))
        u = trail[-1][0]
        target = {"displacement": {str(n): [u[3 * i], u[3 * i + 1]] for n, i in self.at.items()},
                  "stay": {str(s): self.chosen[s] for s in bridge.STAYS},
                  "axial": [{"stage": state[0], "force": {str(i): v for i, v in axial.items()}}
                            for state, axial in zip(self.states[1:], self.axial[1:])]}
        path.with_suffix(".target.json").write_text(json.dumps(target, indent=1) + "\n")


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--second-order", action="store_true")
    parser.add_argument("-o", type=Path, required=True)
    options = parser.parse_args()
    work = Dismantling(options.second_order)
    work.write(options.o, work.converge())


if __name__ == "__main__":
    main()
