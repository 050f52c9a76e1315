#include "qm_solver/frame/eigensolver.h"

#include "qm_solver/sparse/symmetricproduct.h"

#include <algorithm>
#include <cmath>
#include <exception>
#include <new>

#include <Eigen/Dense>
#include <Spectra/SymEigsSolver.h>

namespace solver {

namespace {

using Eigen::Index;
using Eigen::MatrixXd;
using Eigen::VectorXd;

constexpr std::size_t kDenseRank = 300; // up to here the dense way is the quicker one
constexpr std::size_t kDenseShare = 3;  // and where more than one in three pairs is wanted
constexpr std::size_t kGuard = 4;       // pairs beyond those wanted: room for the counting shift
constexpr std::size_t kColumns = 64;    // right-hand sides solved together
constexpr int kMaxRestarts = 500;
constexpr int kMaxRounds = 12; // of looking for pairs that were missed
constexpr double kTolerance = 1.0e-11;
constexpr double kGap = 1.0e-5; // relative gap of eigenvalues in which a shift counts reliably

/// A fault on its way out of the iteration; caught in this file.
struct T_STOP : std::exception {
    T_SOLVER_ERROR error;
    T_STOP(SOLVER_FAULT fault, T_SOLVER_REASON reason)
    {
        error.fault = fault;
        error.reason = std::move(reason);
    }
    const char* what() const noexcept override { return error.reason.key.c_str(); }
};

std::size_t Count(Index i)
{
    return static_cast<std::size_t>(i);
}

std::span<const double> Values(const MatrixXd& m)
{
    return {m.data(), Count(m.size())};
}

/// Eigenvalues 1 / lambda, descending, with their orthonormal vectors.
struct T_SPECTRUM {
    VectorXd theta;
    MatrixXd y;
};

/// y -> L' K^-1 L y, known pairs deflated; what the Lanczos iteration asks for.
class CInverse {
public:
    using Scalar = double;
    CInverse(const T_EIGEN_PROBLEM& problem, std::size_t total, const ProgressFn& progress)
        : m_problem(problem), m_progress(progress), m_total(total)
    {
    }
    Index rows() const { return static_cast<Index>(m_problem.root.Rank()); }
    Index cols() const { return rows(); }
    void Deflate(const T_SPECTRUM& known) { m_known = &known; }

    /// K^-1 L Y, in blocks.
    MatrixXd Shapes(const MatrixXd& y) const
    {
        const std::size_t n = m_problem.stiffness.Size();
        MatrixXd q(static_cast<Index>(n), y.cols());
        for (Index first = 0; first < y.cols(); first += kColumns) {
            const Index width = std::min<Index>(kColumns, y.cols() - first);
            const std::span<double> side(q.col(first).data(), n * Count(width));
            for (Index c = 0; c < width; ++c)
                m_problem.root.Apply({y.col(first + c).data(), Count(y.rows())},
                                     side.subspan(n * Count(c), n));
            T_SOLVER_REASON reason;
            if (!m_problem.factor.Solve(side, Count(width), reason))
                throw T_STOP(SOLVER_FAULT::Failed, reason);
            Report(Count(width));
        }
        return q;
    }
    MatrixXd Apply(const MatrixXd& y) const
    {
        const MatrixXd q = Shapes(y);
        MatrixXd out(y.rows(), y.cols());
        for (Index c = 0; c < y.cols(); ++c)
            m_problem.root.ApplyTransposed({q.col(c).data(), Count(q.rows())},
                                           {out.col(c).data(), Count(out.rows())});
        return out;
    }
    void perform_op(const double* in, double* out) const
    {
        const Eigen::Map<const VectorXd> y(in, rows());
        Eigen::Map<VectorXd> result(out, rows());
        result = Apply(y);
        if (!m_known) return;
        result -= m_known->y * (m_known->theta.asDiagonal() * (m_known->y.transpose() * y));
    }

private:
    void Report(std::size_t solved) const
    {
        m_done = std::min(m_done + solved, m_total);
        if (m_progress && !m_progress(m_done, m_total))
            throw T_STOP(SOLVER_FAULT::Cancelled, "IDS_QM_ENGINE_CANCELLED");
    }
    const T_EIGEN_PROBLEM& m_problem;
    const ProgressFn& m_progress;
    const T_SPECTRUM* m_known = nullptr;
    std::size_t m_total;
    mutable std::size_t m_done = 0;
};

T_SPECTRUM DenseSpectrum(const CInverse& inverse, std::size_t count)
{
    const Index rank = inverse.rows();
    const MatrixXd a = inverse.Apply(MatrixXd::Identity(rank, rank));
    const Eigen::SelfAdjointEigenSolver<MatrixXd> eigen((a + a.transpose()) / 2.0);
    const auto wanted = static_cast<Index>(count);
    return {eigen.eigenvalues().tail(wanted).reverse(),
            eigen.eigenvectors().rightCols(wanted).rowwise().reverse()};
}

/// A fixed sequence: the same start in every run. Numerical Recipes' quick generator.
VectorXd StartVector(Index size, unsigned seed)
{
    VectorXd v(size);
    for (double& x : v) {
        seed = 1664525u * seed + 1013904223u;
        x = 0.5 + static_cast<double>(seed >> 16) / 65536.0 * (seed & 1u ? 1.0 : -1.0);
    }
    return v;
}

T_SPECTRUM Lanczos(CInverse& inverse, std::size_t wanted, unsigned seed)
{
    const Index rank = inverse.rows();
    const Index pairs = std::min(static_cast<Index>(wanted), rank - 1);
    const Index space = std::min(rank, std::max<Index>(2 * pairs + 1, pairs + 20));
    Spectra::SymEigsSolver<CInverse> lanczos(inverse, pairs, space);
    lanczos.init(StartVector(rank, seed).data());
    lanczos.compute(Spectra::SortRule::LargestAlge, kMaxRestarts, kTolerance,
                    Spectra::SortRule::LargestAlge);
    if (lanczos.info() != Spectra::CompInfo::Successful)
        throw T_STOP(SOLVER_FAULT::NotConverged, "IDS_QM_ENGINE_MODES_DIVERGE");
    return {lanczos.eigenvalues(), lanczos.eigenvectors()};
}

/// Adds pairs and brings the vectors back to order and orthogonality.
void Merge(T_SPECTRUM& known, const T_SPECTRUM& more)
{
    const Index had = known.theta.size(), all = had + more.theta.size();
    MatrixXd y(known.y.rows(), all);
    y << known.y, more.y;
    VectorXd theta(all);
    theta << known.theta, more.theta;
    for (Index c = had; c < all; ++c) {
        y.col(c) -= y.leftCols(c) * (y.leftCols(c).transpose() * y.col(c));
        y.col(c).normalize();
    }
    std::vector<Index> order(Count(all));
    for (std::size_t i = 0; i < order.size(); ++i)
        order[i] = static_cast<Index>(i);
    std::stable_sort(order.begin(), order.end(),
                     [&](Index a, Index b) { return theta(a) > theta(b); });
    known.theta.resize(all);
    known.y.resize(y.rows(), all);
    for (Index c = 0; c < all; ++c) {
        known.theta(c) = theta(order[Count(c)]);
        known.y.col(c) = y.col(order[Count(c)]);
    }
}

/// A shift and the number of known eigenvalues below it.
struct T_CUT {
    double sigma;
    std::size_t below;
};

/// The shift in the widest gap past the wanted pairs; where those are all equal, in the last gap
/// before them: what lies in the equal ones is wanted or one of many.
T_CUT Cut(const VectorXd& theta, std::size_t count)
{
    const auto gap = [&](Index j) { return theta(j - 1) / theta(j); }; // between j below and above
    const auto cut = [&](Index j) {
        return T_CUT{1.0 / std::sqrt(theta(j - 1) * theta(j)), Count(j)};
    };
    Index best = static_cast<Index>(count);
    for (Index j = best + 1; j < theta.size(); ++j)
        if (gap(j) > gap(best)) best = j;
    for (; best > 0; --best)
        if (gap(best) > 1.0 + kGap) return cut(best);
    return {0.999 / theta(0), 0};
}

/// K - sigma M over the pattern of both.
T_SYMMETRIC_MATRIX Shifted(const T_SYMMETRIC_MATRIX& k, const T_SYMMETRIC_MATRIX& m, double sigma)
{
    T_SYMMETRIC_MATRIX out;
    out.rowStart.push_back(0);
    for (std::size_t i = 0; i < k.Size(); ++i) {
        auto a = static_cast<std::size_t>(k.rowStart[i]),
             b = static_cast<std::size_t>(m.rowStart[i]);
        const auto aEnd = static_cast<std::size_t>(k.rowStart[i + 1]),
                   bEnd = static_cast<std::size_t>(m.rowStart[i + 1]);
        while (a < aEnd || b < bEnd) {
            const bool fromK = b == bEnd || (a < aEnd && k.column[a] <= m.column[b]);
            const bool fromM = a == aEnd || (b < bEnd && m.column[b] <= k.column[a]);
            out.column.push_back(fromK ? k.column[a] : m.column[b]);
            out.value.push_back((fromK ? k.value[a++] : 0.0) -
                                (fromM ? sigma * m.value[b++] : 0.0));
        }
        out.rowStart.push_back(static_cast<int>(out.column.size()));
    }
    return out;
}

std::size_t CountBelow(const T_EIGEN_PROBLEM& problem, double sigma)
{
    const T_SYMMETRIC_MATRIX shifted = Shifted(problem.stiffness, problem.root.Mass(), sigma);
    CSparseFactor factor;
    T_SOLVER_REASON reason;
    if (!factor.Analyse(shifted, problem.block, reason) || !factor.Factor(shifted, reason))
        throw T_STOP(SOLVER_FAULT::Failed, reason);
    return factor.Info().negativePivots;
}

T_SPECTRUM LanczosSpectrum(const T_EIGEN_PROBLEM& problem, CInverse& inverse, std::size_t count)
{
    T_SPECTRUM known = Lanczos(inverse, count + kGuard, 1);
    for (int round = 0; round < kMaxRounds; ++round) {
        const T_CUT cut = Cut(known.theta, count);
        const std::size_t below = CountBelow(problem, cut.sigma);
        if (below == cut.below) return known;
        if (below < cut.below) break; // the shift counts less than was found: no proof to be had
        inverse.Deflate(known);
        Merge(known, Lanczos(inverse, below - cut.below + 1, 2 + static_cast<unsigned>(round)));
    }
    throw T_STOP(SOLVER_FAULT::NotConverged, "IDS_QM_ENGINE_MODES_MISSED");
}

/// Shapes x = K^-1 L y of unit modal mass, and their Rayleigh quotients.
void Write(const CInverse& inverse, const CMassRoot& root, const MatrixXd& y, T_EIGENPAIRS& out)
{
    MatrixXd x = inverse.Shapes(y);
    VectorXd image(y.rows());
    for (Index c = 0; c < x.cols(); ++c) {
        root.ApplyTransposed({x.col(c).data(), Count(x.rows())},
                             {image.data(), Count(image.size())});
        x.col(c) /= image.norm();
        out.lambda.push_back(y.col(c).dot(image) / image.squaredNorm());
    }
    const std::span<const double> shapes = Values(x);
    out.shape.assign(shapes.begin(), shapes.end());
}

void Solve(const T_EIGEN_PROBLEM& problem, std::size_t count, T_EIGENPAIRS& out,
           const ProgressFn& progress)
{
    const std::size_t rank = problem.root.Rank();
    if (rank == 0) throw T_STOP(SOLVER_FAULT::NoMass, "IDS_QM_ENGINE_NO_MASS");
    count = std::min(count, rank);
    if (count == 0) return;
    const bool dense = rank <= kDenseRank || kDenseShare * (count + kGuard) > rank;
    CInverse inverse(problem, dense ? rank + count : 6 * (count + kGuard) + 60, progress);
    const T_SPECTRUM spectrum =
        dense ? DenseSpectrum(inverse, count) : LanczosSpectrum(problem, inverse, count);
    Write(inverse, problem.root, spectrum.y.leftCols(static_cast<Index>(count)), out);
}

} // namespace

int SolveEigen(const T_EIGEN_PROBLEM& problem, std::size_t count, T_EIGENPAIRS& out,
               T_SOLVER_ERROR& error, const ProgressFn& progress)
{
    out = {};
    T_EIGENPAIRS pairs;
    try {
        Solve(problem, count, pairs, progress);
    } catch (const T_STOP& stop) {
        error = stop.error;
        return 0;
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception& fault) { // the iteration's own complaint
        error = T_STOP(SOLVER_FAULT::Failed, fault.what()).error;
        return 0;
    }
    out = std::move(pairs);
    return 1;
}

} // namespace solver
