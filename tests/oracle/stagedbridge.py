#!/usr/bin/env python3
"""Makes examples/cable-stayed-bridge-staged/case.json from examples/cable-stayed-bridge/case.json:
the same structure, built as a free cantilever in stages. Standard library only.

    python3 stagedbridge.py [-o case.json]
"""
import argparse
import json
from pathlib import Path

EXAMPLES = Path(__file__).resolve().parents[2] / "examples"
GRAVITY = 9.80665
DECK_LOAD = 90.0  # kN/m, steel and slab
STAYS = range(101, 109)
LINK = 40  # locks deck and pylon while the deck is a cantilever
START = {101: 5000, 102: 2500, 103: 2000, 104: 2000, 105: 2000, 106: 2000, 107: 2500, 108: 5000}

# Name, elements that come, supports that come, elements that go, tip nodes of the travellers.
STAGES = [
    ("pylon", [21, 22, 23, 24, 25, 31], [51], [], None),
    ("deck 5 6", [5, 6, 30, LINK], [], [], (5, 7)),
    ("deck 4 7", [4, 7], [], [], (4, 8)),
    ("stays 104 105", [104, 105], [], [], (4, 8)),
    ("deck 3 8", [3, 8], [], [], (3, 9)),
    ("stays 103 106", [103, 106], [], [], (3, 9)),
    ("deck 2 9", [2, 9], [], [], (2, 10)),
    ("stays 102 107", [102, 107], [], [], (2, 10)),
    ("deck 1 10", [1, 10], [], [], (11,)),
    ("abutment 1", [], [1], [], (11,)),
    ("stay 101", [101], [], [], (11,)),
    ("deck 11", [11], [], [], (12,)),
    ("stay 108", [108], [], [], (12,)),
    ("closure", [12], [], [], None),
    ("abutment 13", [], [13], [], None),
    ("link released", [], [], [LINK], None),
]


def structure():
    """Nodes, materials, sections and elements of the bridge with masses and the locking link."""
    case = json.loads((EXAMPLES / "cable-stayed-bridge/case.json").read_text())
    deck = next(s for s in case["sections"] if s["name"] == "deck")
    steel, concrete, strand = case["materials"]
    steel["density"], concrete["density"], strand["density"] = 7.85, 2.5, 7.85
    case["materials"].append(dict(steel, name="deck steel and slab",
                                  density=round(DECK_LOAD / (deck["A"] * GRAVITY), 6)))
    for element in case["elements"]:
        if element["section"] == "deck":
            element["material"] = "deck steel and slab"
    case["elements"].append({"id": LINK, "kind": "link", "nodes": [60, 6],
                             "stiffness": [1e7, 0, 0, 0, 1e8, 0]})
    return {key: case[key]
            for key in ("format", "title", "units", "plane", "nodes", "materials", "sections",
                        "elements")}


def stage(name, elements, supports, gone, loads, gone_loads):
    part = lambda **lists: {key: value for key, value in lists.items() if value}
    named = lambda cases: [{"case": c} for c in cases]
    record = {"name": name, "duration": 7,
              "activate": part(elements=elements, supports=supports, loads=named(loads)),
              "deactivate": part(elements=gone, loads=named(gone_loads))}
    return {key: value for key, value in record.items() if value}


def travellers():
    """Load cases of the travellers at each place, 250 kN each."""
    tips = list(dict.fromkeys(s[4] for s in STAGES if s[4]))
    return {tip: {"name": "TRAVELLER " + " ".join(map(str, tip)), "load_group": 1,
                  "nodal": [{"node": n, "load": [0, 0, -250, 0, 0, 0]} for n in tip]}
            for tip in tips}


def example():
    case = structure()
    case["title"] = "asymmetric cable-stayed bridge built as a free cantilever, 17 stages"
    case["stage_control"] = {"geometric_stiffness": True, "cable_sag": True}
    crane = travellers()
    case["load_cases"] = [
        {"name": "DEAD", "load_group": 0, "self_weight": [0, 0, -1]},
        {"name": "SDL", "load_group": 0,
         "beam": [{"element": e, "axes": "global", "direction": "z", "type": "distributed",
                   "w": [-35, -35]} for e in range(1, 13)]},
        *crane.values(),
        *({"name": f"T{s}", "pretension": [{"element": s, "force": START[s]}]} for s in STAYS)]
    case["stages"], before, where = [], None, {}
    for name, elements, supports, gone, tip in STAGES:
        tensioned = [s for s in STAYS if s in elements]
        where.update({s: name for s in tensioned})
        moved = tip != before
        case["stages"].append(stage(
            name, elements, supports, gone,
            (["DEAD"] if name == "pylon" else []) + ([crane[tip]["name"]] if moved and tip else [])
            + [f"T{s}" for s in tensioned], [crane[before]["name"]] if moved and before else []))
        before = tip
    case["stages"].append({"name": "finished", "duration": 30, "steps": 2,
                           "activate": {"loads": [{"case": "SDL", "step": "last"}]}})
    level = [(f"level {n}", n, "DZ") for n in (2, 3, 4, 8, 9, 10, 12)]
    case["ulf_constraints"] = [
        {"name": name, "type": "displacement", "id": node, "component": component,
         "stage": "finished", "equal": 0} for name, node, component in
        level + [("pylon upright", 55, "DX")]]
    case["ulf_stage_items"] = [{
        "name": "STAYS", "objective": "square",
        "unknown": [{"stage": where[s], "case": f"T{s}", "pretension": True, "load_group": 2}
                    for s in STAYS],
        "known": [{"stage": "finished", "step": "last", "case": "DEAD", "load_group": 0},
                  *({"stage": "finished", "step": "last", "case": c["name"], "load_group": 2}
                    for c in crane.values())],
        "constraints": [c["name"] for c in case["ulf_constraints"]]}]
    return case


def text(case):
    """One line for each record, so that a diff shows what changed."""
    out = []
    for key, value in case.items():
        if isinstance(value, list):
            rows = ",\n  ".join(json.dumps(v) for v in value)
            out.append(f" {json.dumps(key)}: [\n  {rows}]")
        else:
            out.append(f" {json.dumps(key)}: {json.dumps(value)}")
    return "{\n" + ",\n".join(out) + "\n}\n"


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("-o", default=EXAMPLES / "cable-stayed-bridge-staged/case.json", type=Path)
    path = parser.parse_args().o
    path.parent.mkdir(exist_ok=True)
    path.write_text(text(example()))


if __name__ == "__main__":
    main()
