// Solver of unknown load factors.
#pragma once

#include <span>

/// Finds the factors that meet the constraints, by optimisation or from simultaneous equations.
/// Method: dual active-set method of Goldfarb and Idnani (1983) on rows scaled to unit length, and
/// on unknowns scaled to what the rows feel of them where that spreads, in double and, where that
/// certifies nothing, in long double;
/// linear objectives through a small quadratic term, accepted with a certificate of optimality
/// computed from the original rows, else by the simplex method (Clp); equations by QR with column
/// pivoting. Tolerances, zero weights and the codes: ulfproblem.h.
/// Units: those of the caller; rows and unknowns may differ in unit.
/// State: none.
class CRps_UnknownLoadFactorManager {
public:
    /// mode 1: smallest objective subject to the first neq rows * x = rhs and the others
    /// * x <= rhs. iobj 1: sum of |w x|; 2: sum of (w x)^2; 3: the largest |w x|. isign 1: no
    /// factor negative; -1: none positive; 0: free. Where the optimum is not unique the answer is
    /// the one with the smallest sum of (w x)^2, whatever the order of the rows.
    /// mode 0: all rows are equations; neq does not matter. Singular and consistent: the optimum of
    /// iobj under isign, where there is one, else the smallest sum of (w x)^2; else they do not
    /// matter. Contradictory: least squares, code 5.
    /// coefficients: ncon x nvar, row after row; rhs: ncon; factors and weights: nvar.
    /// Returns 1 when `error` is the answer: 0 and 9 with factors, -1 and 4 to 8 without (zeros;
    /// the least-squares factors for code 5 of mode 0). Returns 0, error 10 and zeros, when no
    /// answer could be certified.
    [[nodiscard]] int Calc_UnknownLoadFactor(int mode, int ncon, int nvar, int neq,
                                             std::span<const double> coefficients,
                                             std::span<const double> rhs, std::span<double> factors,
                                             std::span<const double> weights, int iobj, int isign,
                                             int& error);
};
