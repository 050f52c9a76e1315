// Axial force and moment as the eleven points of a hinge type.
#pragma once

#include "qm_rps/generate/rchinge.h"

#include <initializer_list>
#include <optional>

/// The concrete section of `ends` (about y, z or both; one member) from pure compression to pure
/// tension, by the signs of an analysis. Among the points: both ends, no axial force, the largest
/// moment about the first axis, and the two given forces (compression positive) where they are
/// within; the rest halves the widest gaps. Empty: a moment at some point is below 0, so that the
/// curve has no shape that a type can hold, or the section can't be calculated.
std::optional<T_PMM_TABLE> AxialCurve(const std::vector<T_MEMBER_END>& ends,
                                      const T_ENDS<double>& forces);

/// Axial forces of points, falling from pure compression to pure tension: the fixed ones that are
/// within, each once, then halves of the widest gaps until there are `count`.
std::vector<double> AxialForces(double compression, double tension,
                                std::initializer_list<double> fixed, std::size_t count);
/// The curves of one axis for the other, which has no hinge.
void UseForBoth(T_PMM_TABLE& table, bool aboutY);
