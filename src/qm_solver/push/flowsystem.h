// The small system of a push: the active flows and the load factor, bordered by the control.
#pragma once

#include <cstddef>
#include <span>
#include <vector>

namespace solver {

/// Unknown 0 is the load factor, unknown k the flow that was added k-th; equation 0 is the control,
/// equation k the yield condition of flow k. The inverse is kept and changed by one row at a time
/// (bordering; Sherman and Morrison), so that an event costs the square of the number of flows; it
/// is made anew where digits were lost. The matrix need not be symmetric.
class CFlowSystem {
public:
    /// No flow: control * load factor = right side.
    void Reset(double control);
    std::size_t Size() const { return m_size; }

    /// row: the new condition over the unknowns so far; column: the new flow in the equations so
    /// far, the control first; both have Size() entries.
    void Add(std::span<const double> row, std::span<const double> column, double diagonal);
    void Remove(std::size_t k);
    void AddToDiagonal(std::size_t k, double by);
    /// Another entry (equation, unknown).
    void SetControl(std::span<const double> row);
    /// Values in place of those of equation k.
    void SetEquation(std::size_t k, std::span<const double> row);

    /// Solution for the right side 1, 0, 0 ...: the direction of the path. As Solve, but compared
    /// with the matrix only now and then.
    [[nodiscard]] int Direction(std::vector<double>& x);
    /// Solves for a right side, refined with the matrix. 1 done; 0 the matrix is singular to
    /// rounding.
    [[nodiscard]] int Solve(std::span<const double> right, std::vector<double>& x);

private:
    double& At(std::size_t i, std::size_t j) { return m_matrix[j * m_room + i]; }
    void Grow();
    int Invert();

    std::size_t m_size = 0, m_room = 0;
    std::vector<double> m_matrix, m_inverse; // by columns, m_room apart
    bool m_known = false;                    // the inverse is that of the matrix
    std::size_t m_changes = 0;               // since it was made anew
};

} // namespace solver
