// The two trusses in a line of tests/qm_rps/ulf/twotrusses.h as a case file: with a tension of T in
// the left one and the force 4, node 2 moves by u = (4 - T) / 20.
#pragma once

#include <string>

/// Items, by hand: "STAY" u = 0, so T = 4; "LEAST" u <= 0.1 with a positive factor, so T = 2;
/// "SIGN" u = 0 with a negative factor: none; "FADE" u = 0.1 from all loads: 2 / (4 - T), so that T
/// fades as 2 / (1 + 2^k) and the factor goes to 1/2; "WILD" u = 0.2 from all loads: 4 / (4 - T),
/// which runs away from T = 1: 4/3, 1.5, 2.
inline const std::string kStageCase = R"({
 "format": "qm-rps case 1", "title": "Two trusses", "units": {"force": "N", "length": "m"},
 "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
           {"id": 2, "xyz": [1, 0, 0], "restraint": [0, 1, 1, 1, 1, 1]},
           {"id": 3, "xyz": [2, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]}],
 "materials": [{"name": "M", "E": 10}],
 "sections": [{"name": "S", "A": 1}],
 "elements": [{"id": 1, "kind": "truss", "nodes": [1, 2], "material": "M", "section": "S"},
              {"id": 2, "kind": "truss", "nodes": [2, 3], "material": "M", "section": "S"}],
 "load_cases": [{"name": "G", "nodal": [{"node": 2, "load": [4, 0, 0, 0, 0, 0]}], "load_group": 0},
                {"name": "T", "pretension": [{"element": 1, "force": 1}]}],
 "stages": [{"name": "S1", "activate": {"elements": [1, 2], "supports": [1, 2, 3],
             "loads": [{"case": "G"}, {"case": "T"}]}}],
 "ulf_constraints": [
  {"name": "HOLD", "type": "displacement", "id": 2, "component": "DX", "equal": 0, "stage": "S1"},
  {"name": "MOST", "type": "displacement", "id": 2, "component": "DX", "upper": 0.1},
  {"name": "U01", "type": "displacement", "id": 2, "component": "DX", "equal": 0.1},
  {"name": "U02", "type": "displacement", "id": 2, "component": "DX", "equal": 0.2}],
 "ulf_stage_items": [
  {"name": "STAY", "objective": "linear", "constraints": ["HOLD"],
   "unknown": [{"stage": "S1", "case": "T", "pretension": true}],
   "known": [{"stage": "S1", "case": "G", "load_group": 0}]},
  {"name": "LEAST", "objective": "square", "sign": "positive", "constraints": ["MOST"],
   "unknown": [{"stage": "S1", "case": "T", "pretension": true}],
   "known": [{"stage": "S1", "case": "G", "load_group": 1}]},
  {"name": "SIGN", "objective": "linear", "sign": "negative", "constraints": ["HOLD"],
   "unknown": [{"stage": "S1", "case": "T", "pretension": true}],
   "known": [{"stage": "S1", "case": "G", "load_group": 0}]},
  {"name": "FADE", "objective": "linear", "constraints": ["U01"], "sum_stage_loads": true,
   "unknown": [{"stage": "S1", "case": "T", "pretension": true, "load_group": 0}]},
  {"name": "WILD", "objective": "linear", "constraints": ["U02"], "sum_stage_loads": true,
   "unknown": [{"stage": "S1", "case": "T", "pretension": true, "load_group": 0}]}]
})";
