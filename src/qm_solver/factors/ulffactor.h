// Orthogonal factorisation of the normals of the active rows, updated as rows come and go.
#pragma once

#include "qm_solver/factors/ulfrows.h"

#include <vector>

#include <memory>

/// Arithmetic of the factorisation.
enum class ULF_PRECISION { Double, LongDouble };

/// Step that adding one row asks for.
struct T_ULF_DIRECTION {
    std::vector<long double> d; // Q' normal
    std::vector<long double> r; // weights of the active normals in it: R r = first part of d
    std::vector<long double> z; // what is left of the normal: normal - N r
    long double zz = 0.0L;      // z * z
};

/// N = Q1 R with Q = [Q1 Q2] orthogonal and R triangular, N the active normals.
/// Method: Goldfarb and Idnani (1983), Mathematical Programming 27, section 4, with the identity
/// as Hessian; a row is added by a Householder reflection and removed by Givens rotations.
class IUlfFactor {
public:
    IUlfFactor() = default;
    IUlfFactor(const IUlfFactor&) = delete;
    IUlfFactor& operator=(const IUlfFactor&) = delete;
    virtual ~IUlfFactor() = default;

    virtual void Clear() = 0;
    /// d, r, z of orient * normal of a row.
    virtual void Direct(const T_ULF_ROWS& rows, std::size_t row, double orient,
                        T_ULF_DIRECTION& to) const = 0;
    /// Appends the normal that `direction` (d and z) belongs to.
    virtual void Append(const T_ULF_DIRECTION& direction) = 0;
    virtual void Remove(std::size_t at) = 0;
    /// Solves z + N r = first, N' z = second. Sizes nVar and number of active normals.
    virtual void Solve(std::span<const long double> first, std::span<const long double> second,
                       std::vector<long double>& z, std::vector<long double>& r) const = 0;
};
std::unique_ptr<IUlfFactor> MakeUlfFactor(std::size_t nVar, ULF_PRECISION precision);
