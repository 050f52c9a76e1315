#include "qm_solver/mechanism.h"

#include "qm_solver/directionname.h"
#include "qm_solver/symmetricproduct.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace solver {

namespace {

constexpr std::size_t kMaxCandidates = 64; // one block of right-hand sides
constexpr int kInverseSteps = 2;           // each parts the softest shape by its stiffness ratio
/// A rotation is named only where translations are this small beside it: they scale with length.
constexpr double kPureRotation = 1.0e-8;

/// Energy of v within the rounding of the matrix.
bool MovesFreely(const T_SYMMETRIC_MATRIX& k, std::span<const double> v)
{
    std::vector<long double> force(v.size(), 0.0L), size(v.size(), 0.0L);
    AddProduct<long double>(k, v, force);
    ForEachEntry(k, [&](std::size_t i, std::size_t j, double value) {
        size[i] += std::fabs(static_cast<long double>(value) * v[j]);
        if (j != i) size[j] += std::fabs(static_cast<long double>(value) * v[i]);
    });
    long double energy = 0.0L, noise = 0.0L;
    for (std::size_t i = 0; i < v.size(); ++i) {
        energy += force[i] * v[i];
        noise += size[i] * v[i] * size[i] * v[i];
    }
    return std::fabs(energy) <= std::numeric_limits<double>::epsilon() * std::sqrt(noise);
}

void Normalise(std::span<double> v)
{
    double largest = 0.0;
    for (double x : v)
        largest = std::max(largest, std::fabs(x));
    for (double& x : v)
        if (largest > 0.0) x /= largest;
}

/// Null vectors, column after column: with v = 1 at the vanished pivot p the rest follows from the
/// column p of the matrix; the other vanished unknowns are 0.
int NullVectors(const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor, std::vector<double>& columns,
                std::string& reason)
{
    std::vector<std::size_t> pivots = factor.Info().nullPivots;
    pivots.resize(std::min(pivots.size(), kMaxCandidates));
    const std::size_t n = k.Size();
    columns.assign(n * pivots.size(), 0.0);
    for (std::size_t c = 0; c < pivots.size(); ++c) {
        std::vector<double> unit(n, 0.0);
        unit[pivots[c]] = -1.0;
        AddProduct<double>(k, unit, std::span(columns).subspan(c * n, n));
    }
    if (!factor.Solve(columns, pivots.size(), reason)) return 0;
    for (std::size_t c = 0; c < pivots.size(); ++c)
        columns[c * n + pivots[c]] = 1.0;
    return 1;
}

/// Inverse iteration from forces of changing sign, in proportion to the stiffness at hand.
int SoftestShape(const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor, std::vector<double>& v,
                 std::string& reason)
{
    std::vector<double> diagonal(k.Size(), 0.0);
    ForEachEntry(k, [&](std::size_t i, std::size_t j, double value) {
        if (i == j) diagonal[i] = std::fabs(value);
    });
    v.resize(k.Size());
    unsigned state = 12345; // a fixed sequence, Numerical Recipes' quick generator
    for (std::size_t i = 0; i < v.size(); ++i) {
        state = 1664525u * state + 1013904223u;
        v[i] = (state >> 31 ? 1.0 : -1.0) * std::sqrt(diagonal[i]);
    }
    for (int step = 0; step < kInverseSteps; ++step) {
        if (step > 0)
            for (std::size_t i = 0; i < v.size(); ++i)
                v[i] *= diagonal[i];
        if (!factor.Solve(v, 1, reason)) return 0;
        Normalise(v);
    }
    return 1;
}

/// Full index of the largest translation, or of the largest rotation if there is no translation.
std::size_t LargestMovement(std::span<const double> full)
{
    std::array<std::size_t, 2> at{0, 3};
    for (std::size_t i = 0; i < full.size(); ++i) {
        std::size_t& best = at[i % 6 < 3 ? 0 : 1];
        if (std::fabs(full[i]) > std::fabs(full[best]) * (1.0 + kPureRotation)) best = i;
    }
    return std::fabs(full[at[0]]) > kPureRotation * std::fabs(full[at[1]]) ? at[0] : at[1];
}

int Fail(T_SOLVER_ERROR& error, std::string reason)
{
    error = {};
    error.fault = SOLVER_FAULT::Failed;
    error.reason = std::move(reason);
    return 0;
}

} // namespace

int FindMechanism(const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor,
                  std::optional<std::vector<double>>& out, std::string& reason)
{
    out.reset();
    const std::size_t n = k.Size();
    if (n == 0) return 1;
    std::vector<double> columns, softest;
    if (!NullVectors(k, factor, columns, reason)) return 0;
    for (std::size_t first = 0; first < columns.size(); first += n) {
        const auto v = std::span(columns).subspan(first, n);
        if (!MovesFreely(k, v)) continue;
        out.emplace(v.begin(), v.end());
        return 1;
    }
    if (!columns.empty()) return 1; // that factor is not the matrix's own: it is blocked at pivots
    if (!SoftestShape(k, factor, softest, reason)) return 0;
    if (MovesFreely(k, softest)) out = std::move(softest);
    return 1;
}

int FactorStable(const T_SYMMETRIC_MATRIX& k, const CFrameDofs& dofs, CSparseFactor& factor,
                 T_SOLVER_ERROR& error)
{
    std::string reason;
    std::optional<std::vector<double>> shape;
    if (!factor.Factor(k, reason)) return Fail(error, reason);
    if (!FindMechanism(k, factor, shape, reason)) return Fail(error, reason);
    if (!shape && !factor.Info().nullPivots.empty()) { // a false alarm of the pivots
        if (!factor.Factor(k, reason, PIVOTS::AsTheyAre)) return Fail(error, reason);
        if (!FindMechanism(k, factor, shape, reason)) return Fail(error, reason);
    }
    if (!shape) return 1;
    std::vector<double> full(dofs.FullCount());
    dofs.Expand(*shape, full);
    const std::size_t at = LargestMovement(full);
    error = {};
    error.fault = SOLVER_FAULT::Mechanism;
    error.node = static_cast<long>(at / 6);
    error.direction = static_cast<int>(at % 6);
    error.reason = std::string("the node is free to ") + kMotionName[at % 6] +
                   ": nothing resists this movement";
    return 0;
}

} // namespace solver
