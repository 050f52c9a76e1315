#include "qm_solver/checks/mechanism.h"

#include "qm_solver/checks/movement.h"
#include "qm_solver/sparse/symmetricproduct.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr std::size_t kMaxCandidates = 64; // one block of right-hand sides
constexpr int kInverseSteps = 2;           // each parts the softest shape by its stiffness ratio

/// Energy over that of the displacements apart below which nothing is strained. Towers on a storey
/// of hinged columns had 4e-28 to 2e-26, stable models 5e-9 and more; a contrast of 1e14 leaves
/// about 1e-16.
constexpr double kStrainless = 1.0e-20;

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
                T_SOLVER_REASON& reason)
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
                 T_SOLVER_REASON& reason)
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

/// Strain energy over what the same displacements would store if each worked alone. A rigid-body
/// motion of doubles has 1e-32 at best; solving for it costs some of that.
bool StrainsNothing(const T_FRAME& frame, std::span<const T_AXIAL> axial,
                    std::span<const double> full)
{
    double energy = 0.0, apart = 0.0;
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const T_ELEMENT& element = frame.elements[e];
        const T_AXIAL own = axial.empty() ? T_AXIAL{} : axial[e];
        T_VEC12 u{};
        T_MATRIX12 stiffness;
        ElementStiffness(frame, element, own, stiffness);
        for (std::size_t i = 0; i < ElementSize(element); ++i) {
            u[i] = full[ElementIndex(element, i)];
            apart += stiffness[i][i] * u[i] * u[i];
        }
        energy += StrainEnergy(frame, element, own, u);
    }
    return std::fabs(energy) <= kStrainless * std::fabs(apart);
}

int Fail(T_SOLVER_ERROR& error, T_SOLVER_REASON reason)
{
    error = {};
    error.fault = SOLVER_FAULT::Failed;
    error.reason = std::move(reason);
    return 0;
}

} // namespace

int FindMechanism(const T_SYMMETRIC_MATRIX& k, CSparseFactor& factor,
                  const StrainlessFn& strainless, std::optional<std::vector<double>>& out,
                  T_SOLVER_REASON& reason)
{
    out.reset();
    const std::size_t n = k.Size();
    if (n == 0) return 1;
    std::vector<double> columns, softest;
    if (!NullVectors(k, factor, columns, reason)) return 0;
    for (std::size_t first = 0; first < columns.size(); first += n) {
        const auto v = std::span(columns).subspan(first, n);
        if (!strainless(v)) continue;
        out.emplace(v.begin(), v.end());
        return 1;
    }
    if (!columns.empty()) return 1; // that factor is not the matrix's own: it is blocked at pivots
    if (!SoftestShape(k, factor, softest, reason)) return 0;
    if (strainless(softest)) out = std::move(softest);
    return 1;
}

int FactorStable(const T_FRAME& frame, const CFrameDofs& dofs, const T_SYMMETRIC_MATRIX& k,
                 CSparseFactor& factor, T_SOLVER_ERROR& error, std::span<const T_AXIAL> axial)
{
    T_SOLVER_REASON reason;
    std::optional<std::vector<double>> shape;
    std::vector<double> full(dofs.FullCount());
    const auto strainless = [&](std::span<const double> v) {
        dofs.Expand(v, full);
        return StrainsNothing(frame, axial, full);
    };
    if (!factor.Factor(k, reason)) return Fail(error, reason);
    if (!FindMechanism(k, factor, strainless, shape, reason)) return Fail(error, reason);
    if (!shape && !factor.Info().nullPivots.empty()) { // a false alarm of the pivots
        if (!factor.Factor(k, reason, PIVOTS::AsTheyAre)) return Fail(error, reason);
        if (!FindMechanism(k, factor, strainless, shape, reason)) return Fail(error, reason);
    }
    if (!shape) return 1;
    dofs.Expand(*shape, full);
    const std::size_t at = LargestMovement(full);
    error = {};
    error.fault = SOLVER_FAULT::Mechanism;
    error.node = static_cast<long>(at / 6);
    error.direction = static_cast<int>(at % 6);
    error.reason = {"IDS_QM_ENGINE_NODE_FREE", {kMotionKeys[at % 6]}};
    return 0;
}

} // namespace solver
