// Storeys of a push: the nodes whose drifts are watched, displacements, drifts and shears.
#pragma once

#include "qm_db/analysisframe.h"
#include "qm_solver/pushresult.h"

#include <string>
#include <vector>

struct T_PUSH_STOREY {
    std::string name;
    double elevation = 0.0, height = 0.0; // m
    std::vector<std::size_t> nodes;       // of the engine
    std::vector<double> weights;          // of these nodes in the mean, sum 1
};

/// The storeys of a model, bottom to top; those without nodes or height are left out. Means are
/// weighted by the mass in the direction of the push, without mass all nodes count alike. The
/// vertical axis is Z, of a plane XY model Y.
std::vector<T_PUSH_STOREY> StoreysOf(const T_MODEL& model, const CAnalysisModel& frame,
                                     std::size_t direction);

/// Each node of a storey with the one below it (the nearest in plan within 1 % of the height; where
/// a storey has none such, the nearest); of the lowest storey with the ground, which is at rest.
std::vector<solver::T_PUSH_DRIFT> DriftsOf(const T_MODEL& model, const CAnalysisModel& frame,
                                           const std::vector<T_PUSH_STOREY>& storeys);

/// Mean displacement of a storey along a direction.
double DisplacementOf(const T_PUSH_STOREY& storey, const std::vector<solver::T_VEC6>& nodes,
                      const solver::T_VEC3& direction);
/// Sum of forces by node along a direction at the storey's level and above.
double ShearOf(const T_PUSH_STOREY& storey, const std::vector<solver::T_VEC3>& forces,
               const solver::T_FRAME& frame, std::size_t vertical, const solver::T_VEC3& direction);
/// 2; 1 of a plane XY model.
std::size_t VerticalAxis(const T_MODEL& model);
