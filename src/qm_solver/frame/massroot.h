// Square root of a lumped mass matrix on the unknowns, and the matrix itself.
#pragma once

#include "qm_solver/frame/framedofs.h"
#include "qm_solver/sparse/sparsefactor.h"

#include <span>
#include <vector>

namespace solver {

/// T' M T: masses by node and direction carried over to the unknowns. Diagonal but where
/// diaphragms tie nodes. Unknowns without mass have no entry.
T_SYMMETRIC_MATRIX ReducedMass(const CFrameDofs& dofs, std::span<const T_VEC3> mass);

/// M = L L', L of full column rank, for a positive semidefinite M that falls into small clusters of
/// unknowns (spectral decomposition of each, scaled to a unit diagonal).
class CMassRoot {
public:
    explicit CMassRoot(T_SYMMETRIC_MATRIX mass);
    const T_SYMMETRIC_MATRIX& Mass() const { return m_mass; }
    /// Number of columns of L: the degrees of freedom with mass, and the number of modes.
    std::size_t Rank() const { return m_start.size() - 1; }
    /// q = L y.
    void Apply(std::span<const double> y, std::span<double> q) const;
    /// y = L' q.
    void ApplyTransposed(std::span<const double> q, std::span<double> y) const;
    /// The y with g = L y, for a g in the range of M.
    std::vector<double> Coordinates(std::span<const double> g) const;

private:
    struct T_ENTRY {
        std::size_t equation;
        double value;   // of L
        double inverse; // of the left inverse of L, transposed
    };
    void AddCluster(std::span<const std::size_t> equations, std::span<const double> dense);
    T_SYMMETRIC_MATRIX m_mass;
    std::vector<std::size_t> m_start{0};
    std::vector<T_ENTRY> m_entries; // column after column
};

} // namespace solver
