// Load cases of the engine: sums, turned ones, what they weigh in a direction.
#pragma once

#include "qm_solver/framemodel.h"

#include <vector>

/// Adds `from` times a factor.
void AddLoads(solver::T_LOAD_CASE& to, const solver::T_LOAD_CASE& from, double factor);

/// The loads turned about Z, counter-clockwise seen from above: what is vertical stays. Loads along
/// the axes of beams become global ones. Settlements, temperatures and pretensions are no lateral
/// loads and stay.
solver::T_LOAD_CASE TurnedAboutZ(const solver::T_LOAD_CASE& loads, const solver::T_FRAME& frame,
                                 double degrees);

/// Forces by node, global X, Y, Z: those at nodes, the resultants of loads on beams at their two
/// nodes by the lever rule, the weight of elements at either node by halves.
std::vector<solver::T_VEC3> NodeForces(const solver::T_LOAD_CASE& loads,
                                       const solver::T_FRAME& frame);

/// Translational mass by node as the engine has it: that of the nodes and half of each beam's and
/// truss's at either node; none in restrained directions.
std::vector<solver::T_VEC3> NodeMasses(const solver::T_FRAME& frame);

/// Any load is there: a force, a moment, a settlement, a strain.
bool HasLoad(const solver::T_LOAD_CASE& loads, const solver::T_FRAME& frame);
