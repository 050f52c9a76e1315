// Curves of capacities over axial forces and over directions.
#pragma once

#include "qm_solver/section/ultimatestates.h"

namespace solver {

/// So many points from compression to tension, the extremes among them (kFewestPoints at least).
/// Empty where a point is not found.
T_AXIAL_CURVE CurveOf(CUltimateStates& states, std::size_t points);

/// The capacity with My / Mz = cos / sin of the direction. Turns the states. NoSuchMoment,
/// AxialBeyond, NotConverged: error filled, nothing returned.
std::optional<T_CAPACITY> TowardsMoment(CUltimateStates& states, double direction, double axial,
                                        T_SECTION_ERROR& error);

} // namespace solver
