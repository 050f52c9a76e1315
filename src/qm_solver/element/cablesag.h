// Equivalent modulus of a cable that sags.
#pragma once

#include "qm_solver/framemodel.h"

namespace solver {

/// Factor on E of a truss under this tension: 1 / (1 + (w a)^2 E A / (12 N^3)), w its weight per
/// length, a its length in plan, Z vertical (Ernst, Der Bauingenieur 40, 1965). At least 1e-3,
/// which also stands for no tension; 1 for a cable that is vertical or without weight.
double SagFactor(const T_FRAME& frame, const T_ELEMENT& element, double tension);

} // namespace solver
