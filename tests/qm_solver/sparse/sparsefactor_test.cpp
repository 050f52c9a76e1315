#include "qm_solver/sparse/sparsefactor.h"

#include "densematrix.h"
#include "numbers.h"

#include <gtest/gtest.h>

#include <numeric>
#include <thread>

namespace {

using solver::CSparseFactor;
using solver::T_SOLVER_REASON;
using solver::T_SYMMETRIC_MATRIX;
using namespace sample;

Eigen::MatrixXd Solve(CSparseFactor& factor, Eigen::MatrixXd rhs)
{
    T_SOLVER_REASON reason;
    const std::span<double> data(rhs.data(), static_cast<std::size_t>(rhs.size()));
    EXPECT_EQ(1, factor.Solve(data, static_cast<std::size_t>(rhs.cols()), reason)) << reason.Text();
    return rhs;
}

void Prepare(CSparseFactor& factor, const Eigen::MatrixXd& k, int blockSize = 6)
{
    T_SOLVER_REASON reason;
    const T_SYMMETRIC_MATRIX m = Upper(k);
    ASSERT_EQ(1, factor.Analyse(m, Blocks(k.rows(), blockSize), reason)) << reason.Text();
    ASSERT_EQ(1, factor.Factor(m, reason)) << reason.Text();
}

/// Springs in a chain, node 0 to the ground when `held`.
Eigen::MatrixXd Chain(const std::vector<double>& spring, bool held)
{
    const auto n = static_cast<Eigen::Index>(spring.size());
    Eigen::MatrixXd k = Eigen::MatrixXd::Zero(n, n);
    if (held) k(0, 0) = spring[0];
    for (Eigen::Index i = 1; i < n; ++i) {
        const double s = spring[static_cast<std::size_t>(i)];
        k(i, i) += s;
        k(i - 1, i - 1) += s;
        k(i, i - 1) = k(i - 1, i) = k(i, i - 1) - s;
    }
    return k;
}

struct T_RANDOM_CASE {
    const char* label;
    Eigen::Index n;
    double shift;
    int block;
};

TEST(SparseFactor, AgreesWithADenseSolverAndItsInertia)
{
    const T_RANDOM_CASE cases[] = {{"one equation", 1, 5.0, 6},
                                   {"one block", 6, 9.0, 6},
                                   {"definite", 307, 40.0, 6},
                                   {"definite, blocks of one", 100, 40.0, 1},
                                   {"indefinite", 307, 0.3, 6},
                                   {"negative", 120, -40.0, 3},
                                   {"indefinite, odd blocks", 205, 2.0, 7}};
    for (const T_RANDOM_CASE& c : cases) {
        SCOPED_TRACE(c.label);
        const Eigen::MatrixXd a = RandomMatrix(c.n, c.shift, 7);
        CSparseFactor factor;
        Prepare(factor, a, c.block);
        const Eigen::MatrixXd b = Eigen::MatrixXd::Random(c.n, 3);
        const Eigen::MatrixXd x = a.fullPivLu().solve(b);
        EXPECT_LT((Solve(factor, b) - x).norm(), 1e-9 * x.norm());
        const Eigen::VectorXd values =
            Eigen::SelfAdjointEigenSolver<Eigen::MatrixXd>(a).eigenvalues();
        EXPECT_EQ(static_cast<std::size_t>((values.array() < 0.0).count()),
                  factor.Info().negativePivots);
        EXPECT_TRUE(factor.Info().nullPivots.empty());
        EXPECT_GE(factor.Info().factorBytes, 8.0 * static_cast<double>(c.n)); // the diagonal alone
        EXPECT_GE(factor.Info().peakBytes, factor.Info().factorBytes);
    }
}

TEST(SparseFactor, SolvesManySidesInBlocksAsItSolvesOne)
{
    const Eigen::MatrixXd a = RandomMatrix(90, 40.0, 3);
    CSparseFactor factor;
    Prepare(factor, a);
    const Eigen::MatrixXd b = Eigen::MatrixXd::Random(90, 200); // three full blocks and a rest
    const Eigen::MatrixXd x = Solve(factor, b);
    EXPECT_LT((a * x - b).norm(), 1e-11 * b.norm());
    EXPECT_LT((Solve(factor, b.col(150)) - x.col(150)).norm(), 1e-13 * x.col(150).norm());
}

TEST(SparseFactor, FactorsOtherValuesAfterOneAnalysis)
{
    const Eigen::MatrixXd a = RandomMatrix(80, 40.0, 4);
    CSparseFactor factor;
    Prepare(factor, a);
    for (double scale : {-2.0, 1.0e-9, 3.0e12}) {
        T_SOLVER_REASON reason;
        ASSERT_EQ(1, factor.Factor(Upper(scale * a), reason)) << reason.Text();
        const Eigen::VectorXd b = Eigen::VectorXd::LinSpaced(80, 1.0, 2.0);
        EXPECT_LT((scale * a * Solve(factor, b) - b).norm(), 1e-10);
        EXPECT_EQ(scale < 0.0 ? 80u : 0u, factor.Info().negativePivots);
    }
}

TEST(SparseFactor, NamesTheEquationsOfALooseNodeAndOfAFreeChain)
{
    Eigen::MatrixXd k = Eigen::MatrixXd::Zero(30, 30);
    k.topLeftCorner(18, 18) = RandomMatrix(18, 40.0, 5);
    k.bottomRightCorner(6, 6) = RandomMatrix(6, 40.0, 6);
    CSparseFactor factor;
    Prepare(factor, k); // equations 18 to 23 have no stiffness
    EXPECT_EQ((std::vector<std::size_t>{18, 19, 20, 21, 22, 23}), factor.Info().nullPivots);

    CSparseFactor chain;
    Prepare(chain, Chain(std::vector<double>(50, 3.0e7), false), 1);
    EXPECT_EQ(1u, chain.Info().nullPivots.size());
    ASSERT_EQ(1, [&] {
        T_SOLVER_REASON reason;
        return chain.Factor(Upper(Chain(std::vector<double>(50, 3.0e7), true)), reason);
    }());
    EXPECT_TRUE(chain.Info().nullPivots.empty());
}

TEST(SparseFactor, HasNothingToDoForNoEquations)
{
    CSparseFactor factor;
    T_SOLVER_REASON reason;
    EXPECT_EQ(1, factor.Analyse({}, {}, reason));
    EXPECT_EQ(1, factor.Factor({}, reason));
    EXPECT_EQ(1, factor.Solve({}, 0, reason));
}

TEST(SparseFactor, RefusesWhatIsOutOfPlaceWithAReason)
{
    CSparseFactor factor;
    T_SOLVER_REASON reason;
    const Eigen::MatrixXd a = RandomMatrix(12, 40.0, 9);
    T_SYMMETRIC_MATRIX m = Upper(a);
    EXPECT_EQ(0, factor.Factor(m, reason)); // not analysed
    EXPECT_FALSE(reason.empty());
    EXPECT_EQ(0, factor.Analyse(m, Blocks(11, 6), reason));
    std::vector<int> gap = Blocks(12, 6);
    gap.back() = 5;
    EXPECT_EQ(0, factor.Analyse(m, gap, reason));
    T_SYMMETRIC_MATRIX lower = m;
    std::swap(lower.column[0], lower.column[1]);
    EXPECT_EQ(0, factor.Analyse(lower, Blocks(12, 6), reason));
    ASSERT_EQ(1, factor.Analyse(m, Blocks(12, 6), reason));
    std::vector<double> rhs(12, 1.0);
    EXPECT_EQ(0, factor.Solve(rhs, 1, reason)); // not factorised
    ASSERT_EQ(1, factor.Factor(m, reason));
    EXPECT_EQ(0, factor.Solve(rhs, 2, reason));
    EXPECT_EQ(1, factor.Solve(rhs, 1, reason));
    m.value[3] = kNan;
    EXPECT_EQ(0, factor.Factor(m, reason));
    EXPECT_EQ(0, factor.Solve(rhs, 1, reason)); // the old factor is not used by mistake
    EXPECT_EQ(0, factor.Factor(Upper(RandomMatrix(18, 40.0, 9)), reason));
}

TEST(SparseFactor, ServesTwoThreadsWithTwoInstances)
{
    const auto work = [](unsigned seed, double& worst) {
        for (unsigned round = 0; round < 20; ++round) {
            const Eigen::MatrixXd a = RandomMatrix(120, 40.0, seed + round);
            CSparseFactor factor;
            Prepare(factor, a);
            const Eigen::VectorXd b = Eigen::VectorXd::Ones(120);
            worst = std::max(worst, (a * Solve(factor, b) - b).norm());
        }
    };
    double first = 0.0, second = 0.0;
    std::thread one(work, 100u, std::ref(first)), two(work, 200u, std::ref(second));
    one.join();
    two.join();
    EXPECT_LT(std::max(first, second), 1e-10);
}

} // namespace
