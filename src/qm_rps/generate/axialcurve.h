// Axial force and moment of a concrete section as the eleven points of a hinge type.
#pragma once

#include "qm_rps/generate/rchinge.h"

#include <optional>

/// The section of `ends` (about y, z or both; one member) from pure compression to pure tension, by
/// the signs of an analysis. Among the points: both ends, no axial force, the largest moment about
/// the first axis, and the two given forces (compression positive) where they are within; the rest
/// halves the widest gaps. Empty: a moment at some point is below 0, so that the curve has no shape
/// that a type can hold, or the section can't be calculated.
std::optional<T_PMM_TABLE> AxialCurve(const std::vector<T_RC_END>& ends,
                                      const T_ENDS<double>& forces);
