// Whether a solution balances its loads.
#pragma once

#include "qm_solver/frame/framedofs.h"
#include "qm_solver/sparse/sparsefactor.h"

#include <span>

namespace solver {

inline constexpr const char* kOutOfBalance = "IDS_QM_ENGINE_OUT_OF_BALANCE";

/// Forces out of balance are at most 1e-5 of the largest load of the column, moments taken over
/// `extent`: stiffness contrasts of 1e10 stay below, a motion that escaped the factorisation does
/// not.
bool InBalance(const T_SYMMETRIC_MATRIX& k, const CFrameDofs& dofs, double extent,
               std::span<const double> loads, std::span<const double> x);

} // namespace solver
