#include "qm_solver/frame/eigensolver.h"

#include "densematrix.h"

#include <gtest/gtest.h>

#include <Eigen/Eigenvalues>

namespace {

using namespace solver;
using Eigen::Index;
using Eigen::MatrixXd;
using Eigen::VectorXd;

/// Pairs of a problem given dense; every unknown a block of its own.
T_EIGENPAIRS Pairs(const MatrixXd& k, const MatrixXd& m, std::size_t count)
{
    const T_SYMMETRIC_MATRIX stiffness = sample::Upper(k);
    const std::vector<int> block = sample::Blocks(k.rows(), 1);
    const CMassRoot root(sample::Upper(m));
    CSparseFactor factor;
    T_SOLVER_REASON reason;
    T_EIGENPAIRS pairs;
    T_SOLVER_ERROR error;
    EXPECT_EQ(1, factor.Analyse(stiffness, block, reason)) << reason.Text();
    EXPECT_EQ(1, factor.Factor(stiffness, reason)) << reason.Text();
    EXPECT_EQ(1, SolveEigen({stiffness, block, factor, root}, count, pairs, error))
        << error.reason.Text();
    return pairs;
}

/// A mass matrix with unknowns of no mass, single masses and full clusters, some of those singular.
MatrixXd ClusteredMass(Index n)
{
    MatrixXd m = MatrixXd::Zero(n, n);
    for (Index i = 0; i + 6 <= n; i += 6) {
        m(i, i) = 1.0 + 0.01 * static_cast<double>(i);
        const MatrixXd arms = MatrixXd::Random(3, i % 4 == 0 ? 2 : 3); // two or three points' worth
        m.block(i + 1, i + 1, 3, 3) = arms * arms.transpose();
    }
    return m;
}

struct T_CASE {
    Index n;
    std::size_t count;
};

TEST(EigenSolver, AgreesWithADenseSolverOnASingularMass)
{
    for (const T_CASE& c : {T_CASE{60, 100}, T_CASE{60, 7}, T_CASE{420, 20}}) { // last: Lanczos
        SCOPED_TRACE(c.n);
        const MatrixXd k = sample::RandomMatrix(c.n, 60.0, 11), m = ClusteredMass(c.n);
        const T_EIGENPAIRS pairs = Pairs(k, m, c.count);
        // The pencil turned round, M x = theta K x, has a definite right side.
        const VectorXd theta =
            Eigen::GeneralizedSelfAdjointEigenSolver<MatrixXd>(m, k).eigenvalues().reverse();
        const auto rank = (theta.array() > 1e-12 * theta(0)).count();
        ASSERT_EQ(std::min(c.count, static_cast<std::size_t>(rank)), pairs.lambda.size());
        const auto found = static_cast<Index>(pairs.lambda.size());
        const Eigen::Map<const MatrixXd> x(pairs.shape.data(), c.n, found);
        const Eigen::Map<const VectorXd> lambda(pairs.lambda.data(), found);
        for (Index i = 0; i < found; ++i)
            EXPECT_NEAR(1.0 / theta(i), lambda(i), 1e-9 / theta(i));
        EXPECT_LT((x.transpose() * m * x - MatrixXd::Identity(found, found)).norm(), 1e-7);
        const MatrixXd energy = x.transpose() * k * x;
        EXPECT_LT((energy - MatrixXd(lambda.asDiagonal())).norm(), 1e-7 * energy.norm());
        EXPECT_LT((k * x - m * x * lambda.asDiagonal()).norm(), 1e-6 * (k * x).norm());
    }
}

TEST(EigenSolver, FindsEveryOneOfManyEqualEigenvalues)
{
    // Oscillators side by side: five of 1, five of 2, the rest 4. A Krylov space from one vector
    // sees each value once.
    VectorXd k = VectorXd::Constant(400, 4.0);
    for (Index i = 0; i < 5; ++i) {
        k(37 * i + 3) = 1.0;
        k(41 * i + 7) = 2.0;
    }
    for (std::size_t count : {3u, 5u, 8u, 12u}) {
        SCOPED_TRACE(count);
        const T_EIGENPAIRS pairs =
            Pairs(MatrixXd(k.asDiagonal()), MatrixXd::Identity(400, 400), count);
        ASSERT_EQ(count, pairs.lambda.size());
        for (std::size_t i = 0; i < count; ++i)
            EXPECT_NEAR(i < 5 ? 1.0 : i < 10 ? 2.0 : 4.0, pairs.lambda[i], 1e-10) << i;
        const auto found = static_cast<Index>(count);
        const Eigen::Map<const MatrixXd> x(pairs.shape.data(), 400, found);
        EXPECT_LT((x.transpose() * x - MatrixXd::Identity(found, found)).norm(), 1e-9);
    }
}

} // namespace
