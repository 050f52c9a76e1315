// Factorisation of a sparse symmetric matrix: the one class that hands matrices to the sparse
// direct solver (MUMPS with a METIS ordering).
#pragma once

#include "qm_solver/solverreason.h"
#include "qm_solver/sparse/symmetricmatrix.h"

#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace solver {

/// Figures of the last factorisation.
struct T_FACTOR_INFO {
    double factorBytes = 0.0;            // memory of the factor
    double peakBytes = 0.0;              // memory that the factorisation needed
    std::size_t negativePivots = 0;      // negative eigenvalues (Sylvester's law of inertia)
    std::vector<std::size_t> nullPivots; // equations whose pivot vanished, ascending
};

enum class PIVOTS {
    Watch,     // vanishing pivots are listed and their unknowns blocked
    AsTheyAre, // used however small they are: for a matrix known to be regular
};

/// Memory that several factors use in turn. A factorisation overwrites the one before it in the
/// same space; only the last one can solve.
class CFactorSpace {
public:
    CFactorSpace();
    ~CFactorSpace();

private:
    friend class CSparseFactor;
    struct T_SPACE;
    std::unique_ptr<T_SPACE> m_space;
};

class CSparseFactor {
public:
    CSparseFactor();
    ~CSparseFactor();
    CSparseFactor(CSparseFactor&&) noexcept;
    CSparseFactor& operator=(CSparseFactor&&) noexcept;

    /// Symbolic phase for a pattern. block[i]: the block (node) that equation i belongs to, blocks
    /// counting from 0 in the order of equations; the ordering works on the graph of the blocks.
    /// space: where the factors go; empty: memory of their own.
    /// 1 done; 0 `reason` filled.
    [[nodiscard]] int Analyse(const T_SYMMETRIC_MATRIX& matrix, std::span<const int> block,
                              T_SOLVER_REASON& reason, std::shared_ptr<CFactorSpace> space = {});
    /// Numeric phase; the pattern is that of Analyse. Watched pivots that vanish are no failure:
    /// they are listed in Info. 1 done; 0 `reason` filled.
    [[nodiscard]] int Factor(const T_SYMMETRIC_MATRIX& matrix, T_SOLVER_REASON& reason,
                             PIVOTS pivots = PIVOTS::Watch);
    /// Solves for `count` right-hand sides, column after column, in place; blocks of up to 64.
    /// The unknown of a vanished pivot is set to 0. 1 done; 0 `reason` filled, rhs undefined.
    [[nodiscard]] int Solve(std::span<double> rhs, std::size_t count, T_SOLVER_REASON& reason);
    const T_FACTOR_INFO& Info() const;

private:
    struct T_STATE;
    std::unique_ptr<T_STATE> m_state;
};

} // namespace solver
