// Orthogonal factorisation of the normals of the active rows, updated as rows come and go.
#pragma once

#include "qm_solver/factors/ulfrows.h"

#include <vector>

/// Step that adding one row asks for.
struct T_ULF_DIRECTION {
    std::vector<double> d; // Q' normal
    std::vector<double> r; // weights of the active normals in it: R r = first part of d
    std::vector<double> z; // what is left of the normal: normal - N r
    double zz = 0.0;       // z * z
};

/// N = Q1 R with Q = [Q1 Q2] orthogonal and R triangular, N the active normals.
/// Method: Goldfarb and Idnani (1983), Mathematical Programming 27, section 4, with the identity
/// as Hessian; a row is added by a Householder reflection and removed by Givens rotations.
class CUlfFactor {
public:
    explicit CUlfFactor(std::size_t nVar);

    void Clear();
    /// d, r, z of orient * normal of a row.
    void Direct(const T_ULF_ROWS& rows, std::size_t row, double orient, T_ULF_DIRECTION& to) const;
    /// Appends the normal that `direction` (d and z) belongs to.
    void Append(const T_ULF_DIRECTION& direction);
    void Remove(std::size_t at);
    /// Solves z + N r = first, N' z = second. Sizes nVar and Count().
    void Solve(std::span<const double> first, std::span<const double> second,
               std::vector<double>& z, std::vector<double>& r) const;

private:
    std::size_t m_nVar, m_count = 0;
    std::vector<double> m_q; // nVar x nVar, column after column
    std::vector<double> m_r; // likewise, upper triangle
};
