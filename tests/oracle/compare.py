#!/usr/bin/env python3
"""Compare two arrays of result objects: python3 compare.py a.json b.json [reltol]

Statuses, texts, flags and steps must be equal, numbers agree to reltol (default 1e-9) of the
larger, null goes with null. Trials are compared where both files give them and a point was
found. A limit state without any value equals a missing one. Outcome texts, messages and keys
that the methods do not define (traces, lists of points) are left alone. Where a result carries
"by_rounding": true its status and point are not compared. Exit code 1 on any
difference.
"""
import json
import sys

POINT = ["Sd", "Sa", "D", "V", "T_eff", "damping"]
TARGET = ["T_star", "Tc", "Se", "ay", "dy", "Fy", "m_star", "det", "dt", "qu"]
STATE = ["demand", "demand_step", "capacity", "capacity_step", "remark"]
FACTOR = ["gamma", "alpha", "mass", "gravity", "eigen_based"]
TINY = 1e-300


class Compare:
    def __init__(self, reltol):
        self.reltol = reltol
        self.count = 0

    def report(self, name, key, a, b):
        self.count += 1
        note = ""
        if self.number(a) and self.number(b):
            note = "  (relative %.3g)" % (abs(a - b) / max(abs(a), abs(b), TINY))
        print("%s: %s: %s | %s%s" % (name, key, json.dumps(a), json.dumps(b), note))

    @staticmethod
    def number(x):
        return isinstance(x, (int, float)) and not isinstance(x, bool)

    def value(self, name, key, a, b):
        if self.number(a) and self.number(b):
            if key.endswith("step") or key == "trials":
                same = a == b
            else:
                same = abs(a - b) <= self.reltol * max(abs(a), abs(b))
        else:
            same = type(a) is type(b) and a == b
        if not same:
            self.report(name, key, a, b)

    def record(self, name, path, keys, a, b):
        if a is None and b is None:
            return
        if not isinstance(a, dict) or not isinstance(b, dict):
            self.report(name, path, a, b)
            return
        for k in keys:
            self.value(name, path + "." + k, a.get(k), b.get(k))

    def array(self, name, path, a, b):
        if not isinstance(a, list) or not isinstance(b, list) or len(a) != len(b):
            self.report(name, path, a, b)
            return
        for i, (x, y) in enumerate(zip(a, b)):
            self.value(name, "%s[%d]" % (path, i), x, y)

    def states(self, name, path, keys, label, a, b):
        """Lists of limit states, matched by their name."""
        def table(rows):
            return {r.get(label): r for r in rows or [] if r is not None
                    and any(r.get(k) is not None for k in keys)}
        ta, tb = table(a), table(b)
        for s in list(ta) + [s for s in tb if s not in ta]:
            self.record(name, "%s[%s]" % (path, s), keys, ta.get(s), tb.get(s))

    def result(self, a, b):
        name = a.get("name")
        for k in ("name", "push", "method"):
            self.value(name, k, a.get(k), b.get(k))
        if not (by_rounding(a) or by_rounding(b)):
            self.value(name, "status", a.get("status"), b.get("status"))
        if a.get("method") in ("ATC-40", "FEMA440"):
            self.value(name, "procedure", a.get("procedure"), b.get("procedure"))
        self.record(name, "factors", FACTOR, a.get("factors"), b.get("factors"))
        ca, cb = a.get("capacity") or {}, b.get("capacity") or {}
        for k in ("Sd", "Sa"):
            self.array(name, "capacity." + k, ca.get(k), cb.get(k))
        if by_rounding(a) or by_rounding(b):
            return
        self.record(name, "performance_point", POINT, a.get("performance_point"),
                    b.get("performance_point"))
        if a.get("performance_point") and b.get("performance_point"):
            self.record(name, "first_slope_change", ["Sd", "Sa"], a.get("first_slope_change"),
                        b.get("first_slope_change"))
            periods = [[v for p in r.get("periods_by_ductility") or []
                        for v in (p["mu"], p["T_eff"])] for r in (a, b)]
            self.array(name, "periods_by_ductility", *periods)
        if str(a.get("method")).startswith("NTC"):
            self.states(name, "target", [k for k in TARGET], "limit_state", self.reached(a),
                        self.reached(b))
        else:
            self.record(name, "target", TARGET, a.get("target"), b.get("target"))
        self.states(name, "limit_states", STATE, "name", a.get("limit_states"),
                    b.get("limit_states"))
        if "trials" in a and "trials" in b and a.get("status") != "not found":
            self.value(name, "trials", a["trials"], b["trials"])

    @staticmethod
    def reached(r):
        """The limit states that have a target displacement."""
        return [t for t in r.get("target") or [] if t and t.get("dt") is not None]


def by_rounding(r):
    """Elastic answers of ATC-40 procedure B that hang on the last bits."""
    return bool(r.get("by_rounding"))


def main():
    if len(sys.argv) not in (3, 4):
        sys.exit("usage: compare.py a.json b.json [reltol]")
    with open(sys.argv[1], encoding="utf-8") as f:
        a = json.load(f)
    with open(sys.argv[2], encoding="utf-8") as f:
        b = json.load(f)
    c = Compare(float(sys.argv[3]) if len(sys.argv) == 4 else 1e-9)
    if len(a) != len(b):
        c.report("all", "number of results", len(a), len(b))
    for x, y in zip(a, b):
        c.result(x, y)
    sys.exit(1 if c.count else 0)


if __name__ == "__main__":
    main()
