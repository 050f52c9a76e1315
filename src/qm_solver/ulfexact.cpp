#include "qm_solver/ulfexact.h"

#include "qm_solver/factors/ulfscaling.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <algorithm>
#include <cmath>

namespace {

using Eigen::Index;
using T_LONG_VECTOR = Eigen::Matrix<long double, Eigen::Dynamic, 1>;
using T_LONG_MATRIX = Eigen::Matrix<long double, Eigen::Dynamic, Eigen::Dynamic>;
using T_QR = Eigen::ColPivHouseholderQR<Eigen::MatrixXd>;

constexpr int kSweeps = 6; // of the equilibration
constexpr int kRefinements = 8;
constexpr long double kRoundingTol = 1e-13L; // of a row against the size of the solution

/// Equations D A C u = D b with x = C u.
struct T_EQUATIONS {
    T_LONG_MATRIX a; // as given
    T_LONG_VECTOR b, rowFactor, colFactor;

    Eigen::MatrixXd Scaled() const
    {
        return (rowFactor.asDiagonal() * a * colFactor.asDiagonal()).cast<double>();
    }
    /// Scaled residual D (b - A C u).
    T_LONG_VECTOR Residual(const T_LONG_VECTOR& u) const
    {
        return rowFactor.cwiseProduct(b - a * colFactor.cwiseProduct(u));
    }
};

long double PowerOfTwo(long double size)
{
    return size > 0.0L ? std::exp2(-std::round(std::log2(size))) : 1.0L;
}

T_EQUATIONS Equations(const T_ULF_PROBLEM& p)
{
    const auto m = static_cast<Index>(p.Rows());
    const Index n = p.nVar;
    T_EQUATIONS e{T_LONG_MATRIX(m, n), T_LONG_VECTOR(m), T_LONG_VECTOR::Ones(m),
                  T_LONG_VECTOR::Ones(n)};
    for (Index i = 0; i < m; ++i) {
        e.b(i) = p.rhs[static_cast<std::size_t>(i)];
        for (Index j = 0; j < n; ++j)
            e.a(i, j) = p.Row(static_cast<std::size_t>(i))[static_cast<std::size_t>(j)];
    }
    for (int sweep = 0; sweep < kSweeps; ++sweep) {
        for (Index i = 0; i < m; ++i)
            e.rowFactor(i) = PowerOfTwo(
                e.a.row(i).transpose().cwiseProduct(e.colFactor).lpNorm<Eigen::Infinity>());
        for (Index j = 0; j < n; ++j)
            e.colFactor(j) =
                PowerOfTwo(e.a.col(j).cwiseProduct(e.rowFactor).lpNorm<Eigen::Infinity>());
    }
    return e;
}

/// Least squares with zero for the unknowns without a pivot, refined in long double.
T_LONG_VECTOR SolveBasic(const T_EQUATIONS& e, const T_QR& qr)
{
    T_LONG_VECTOR u = T_LONG_VECTOR::Zero(e.a.cols());
    for (int pass = 0; pass < kRefinements; ++pass) {
        const T_LONG_VECTOR rest = e.Residual(u);
        const long double size = rest.size() ? rest.lpNorm<Eigen::Infinity>() : 0.0L;
        if (!(size > 0.0L)) break;
        const Eigen::VectorXd unit = (rest / size).cast<double>();
        u += size * qr.solve(unit).cast<long double>();
    }
    return u;
}

/// Moves u along the directions that no equation feels to the smallest |weights * C u|.
void Shorten(const T_EQUATIONS& e, const T_QR& qr, const T_LONG_VECTOR& weights, T_LONG_VECTOR& u)
{
    const Index n = e.a.cols(), rank = qr.rank();
    const auto r = qr.matrixR().topRows(rank);
    Eigen::MatrixXd loose = Eigen::MatrixXd::Identity(n, n).rightCols(n - rank);
    loose.topRows(rank) = -r.leftCols(rank).triangularView<Eigen::Upper>().solve(
        Eigen::MatrixXd(r.rightCols(n - rank)));
    loose = qr.colsPermutation() * loose;
    const T_LONG_VECTOR w = weights.cwiseProduct(e.colFactor);
    const T_LONG_MATRIX wide = w.asDiagonal() * loose.cast<long double>();
    const Eigen::ColPivHouseholderQR<T_LONG_MATRIX> shortest(wide);
    u -= loose.cast<long double>() * shortest.solve(w.cwiseProduct(u));
}

/// Rows that x misses. The size of the solution is taken in unknowns that the rows feel alike.
std::vector<int> Unmet(const T_EQUATIONS& e, const T_LONG_VECTOR& x)
{
    const T_LONG_VECTOR weights = e.colFactor.cwiseInverse();
    std::vector<int> rows;
    const long double size = weights.cwiseProduct(x).norm();
    for (Index i = 0; i < e.a.rows(); ++i) {
        const T_LONG_VECTOR terms = e.a.row(i).transpose().cwiseProduct(x);
        const long double miss = std::fabs(terms.sum() - e.b(i));
        const long double own = std::max(std::fabs(e.b(i)), terms.cwiseAbs().sum());
        const long double length = e.a.row(i).transpose().cwiseQuotient(weights).norm();
        if (miss > std::max(kUlfUnmetTol * own, kRoundingTol * length * size))
            rows.push_back(static_cast<int>(i));
    }
    return rows;
}

} // namespace

int SolveUlfExact(const T_ULF_PROBLEM& problem, T_ULF_EXACT& out)
{
    T_EQUATIONS e = Equations(problem);
    const std::vector<long double> w = UlfWeights(problem.weights);
    const T_LONG_VECTOR weights = Eigen::Map<const T_LONG_VECTOR>(w.data(), problem.nVar);
    T_QR qr;
    qr.setThreshold(kUlfRankTol);
    qr.compute(e.Scaled());
    const int rank = static_cast<int>(qr.rank());
    T_LONG_VECTOR u;
    if (rank == problem.nVar && e.a.rows() == e.a.cols()) {
        u = SolveBasic(e, qr);
    } else {
        for (Index i = 0; i < e.a.rows(); ++i) { // rows that contradict each other weigh alike
            const long double length = e.a.row(i).transpose().cwiseQuotient(weights).norm();
            e.rowFactor(i) = length > 0.0L ? 1.0L / length : 1.0L;
        }
        qr.compute(e.Scaled());
        u = SolveBasic(e, qr);
        if (qr.rank() < problem.nVar) Shorten(e, qr, weights, u);
    }
    const T_LONG_VECTOR x = e.colFactor.cwiseProduct(u);
    T_ULF_EXACT solved{std::vector<double>(w.size()), rank, {}};
    for (std::size_t j = 0; j < w.size(); ++j) {
        solved.x[j] = static_cast<double>(x(static_cast<Index>(j)));
        if (!std::isfinite(solved.x[j])) return 0;
    }
    solved.unmet = Unmet(e, x);
    out = std::move(solved);
    return 1;
}
