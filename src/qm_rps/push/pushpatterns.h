// The loads of a pushover load case, as the engine takes them at the load factor 1.
#pragma once

#include "qm_rps/push/pushstoreys.h"

#include <functional>
#include <string>

/// Shape of a mode by node of the engine, scaled to 1 at the control node in the direction of
/// control; empty: `error` says why. For modes that the model does not hold.
using MODE_SHAPE_FN = std::function<std::vector<solver::T_VEC6>(int mode, std::string& error)>;

/// The rows of the case, which add up. Static load case: its loads times the factor. Uniform
/// acceleration: mass times factor in that direction (1: a unit acceleration). Mode: forces as the
/// translations of the shape times the factor; mode x story mass: mass times shape. A shape stands
/// as the model holds it; one that it does not hold is scaled to 1 at the control node.
///
/// Eccentricity: the lateral force of each storey acts at this fraction of the storey's extent
/// normal to the push, towards +Y for a push along X and towards +X for one along Y. Its torque is
/// spread as forces that grow with the distance from the centre of mass (mass times distance, as of
/// a rotation), which is exact for a rigid diaphragm; nodes at one point take it as a moment.
///
/// 1 done; 0 `error` says why: no rows, no force in a row, rows that cancel, no mass, no such mode
/// or load case, an eccentricity without storeys or without an extent. `out` is then unchanged.
[[nodiscard]] int BuildPattern(const T_MODEL& model, const CAnalysisModel& frame,
                               const T_POLC_D& record, const MODE_SHAPE_FN& modeShape,
                               solver::T_LOAD_CASE& out, std::string& error);

/// Whether some force of the loads has a part along a global direction (0 to 5) that is more than
/// rounding. Loads that move by strains or moments alone, and rotations, are not judged: true.
bool PushesAlong(const solver::T_LOAD_CASE& loads, const CAnalysisModel& frame,
                 std::size_t direction);

/// Static load cases times their factors. 1 done; 0 `error` names one that is not there.
[[nodiscard]] int BuildInitialLoads(const CAnalysisModel& frame,
                                    const std::vector<T_PUSH_INITIAL_LOAD>& loads,
                                    solver::T_LOAD_CASE& out, std::string& error);
