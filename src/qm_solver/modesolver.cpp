#include "qm_solver/modesolver.h"

#include "qm_base/finite.h"
#include "qm_solver/checks/movement.h"
#include "qm_solver/frame/eigensolver.h"
#include "qm_solver/model/framemass.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include <Eigen/Dense>

namespace solver {

namespace {

using Eigen::Index;
using Eigen::MatrixXd;
using Eigen::VectorXd;

constexpr double kEqual = 1.0e-8;  // relative difference of eigenvalues that are one
constexpr double kAsleep = 1.0e-6; // participation over the direction's largest that is none

/// Translation of a point under the rigid-body motion d about the origin.
T_VEC3 RigidMotion(std::size_t d, const T_VEC3& p)
{
    switch (d) {
    case 3:
        return {0.0, -p[2], p[1]};
    case 4:
        return {p[2], 0.0, -p[0]};
    case 5:
        return {-p[1], p[0], 0.0};
    default:
        T_VEC3 unit{};
        unit[d] = 1.0;
        return unit;
    }
}

/// T' M r for the six motions r; columns.
MatrixXd Excitation(const T_FRAME& frame, const CFrameDofs& dofs, std::span<const T_VEC3> mass)
{
    MatrixXd out = MatrixXd::Zero(static_cast<Index>(dofs.EquationCount()), 6);
    std::vector<double> full(dofs.FullCount());
    for (std::size_t d = 0; d < 6; ++d) {
        std::fill(full.begin(), full.end(), 0.0);
        for (std::size_t n = 0; n < mass.size(); ++n) {
            const T_VEC3 r = RigidMotion(d, frame.nodes[n].xyz);
            for (std::size_t i = 0; i < 3; ++i)
                full[6 * n + i] = mass[n][i] * r[i];
        }
        dofs.Reduce(full, {out.col(static_cast<Index>(d)).data(), dofs.EquationCount()});
    }
    return out;
}

/// The mass that can move in each direction: the largest sum of effective masses there is.
T_VEC6 Totals(const CMassRoot& root, const MatrixXd& excitation)
{
    T_VEC6 total{};
    for (std::size_t d = 0; d < 6; ++d) {
        const auto column = excitation.col(static_cast<Index>(d));
        for (double c : root.Coordinates({column.data(), static_cast<std::size_t>(column.size())}))
            total[d] += c * c;
    }
    return total;
}

/// Turns shapes of one frequency among themselves: each direction in its turn goes to one shape.
void AlignEqual(Eigen::Ref<MatrixXd> shapes, const MatrixXd& excitation, const T_VEC6& total)
{
    Index done = 0;
    for (Index d = 0; d < 6 && done + 1 < shapes.cols(); ++d) {
        auto rest = shapes.rightCols(shapes.cols() - done);
        const VectorXd part = rest.transpose() * excitation.col(d);
        if (part.norm() <= kAsleep * std::sqrt(total[static_cast<std::size_t>(d)])) continue;
        const Eigen::HouseholderQR<MatrixXd> turn(part); // its first column lies along `part`
        rest = (rest * turn.householderQ()).eval();
        ++done;
    }
}

T_MODE Mode(double lambda, const VectorXd& x, const CFrameDofs& dofs, const MatrixXd& excitation,
            const T_VEC6& total)
{
    std::vector<double> full(dofs.FullCount());
    dofs.Expand({x.data(), static_cast<std::size_t>(x.size())}, full);
    const double sign = full[LargestMovement(full)] < 0.0 ? -1.0 : 1.0;
    T_MODE mode;
    mode.omega2 = lambda;
    mode.period = 2.0 * std::numbers::pi / std::sqrt(lambda);
    mode.shape.resize(full.size() / 6);
    for (std::size_t i = 0; i < full.size(); ++i)
        mode.shape[i / 6][i % 6] = sign * full[i];
    for (std::size_t d = 0; d < 6; ++d) {
        const double l = sign * x.dot(excitation.col(static_cast<Index>(d)));
        mode.participation[d] = l;
        mode.massPercent[d] = total[d] > 0.0 ? 100.0 * l * l / total[d] : 0.0;
    }
    return mode;
}

} // namespace

int SolveModes(const T_FRAME& frame, const CFrameDofs& dofs, const T_SYMMETRIC_MATRIX& stiffness,
               CSparseFactor& factor, std::size_t count, std::vector<T_MODE>& out,
               T_SOLVER_ERROR& error, const ProgressFn& progress)
{
    out.clear();
    const std::vector<T_VEC3> mass = LumpedMass(frame);
    const CMassRoot root(ReducedMass(dofs, mass));
    T_EIGENPAIRS pairs;
    if (!SolveEigen({stiffness, dofs.Blocks(), factor, root}, count, pairs, error, progress))
        return 0;
    const MatrixXd excitation = Excitation(frame, dofs, mass);
    const T_VEC6 total = Totals(root, excitation);
    const auto n = static_cast<Index>(dofs.EquationCount());
    const std::size_t found = pairs.lambda.size();
    Eigen::Map<MatrixXd> shapes(pairs.shape.data(), n, static_cast<Index>(found));
    for (std::size_t first = 0, next = 0; first < found; first = next) {
        for (next = first + 1; next < found; ++next)
            if (pairs.lambda[next] > pairs.lambda[first] * (1.0 + kEqual)) break;
        AlignEqual(shapes.middleCols(static_cast<Index>(first), static_cast<Index>(next - first)),
                   excitation, total);
    }
    for (std::size_t i = 0; i < found; ++i)
        out.push_back(
            Mode(pairs.lambda[i], shapes.col(static_cast<Index>(i)), dofs, excitation, total));
    if (IsFinite(out)) return 1;
    out.clear();
    error.fault = SOLVER_FAULT::Failed;
    error.reason = "IDS_QM_ENGINE_OVERFLOW";
    return 0;
}

} // namespace solver
