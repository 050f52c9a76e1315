// Unit loads of any size: columns from 1e-8 to 1e8, against answers that were planted.
#include "ulfplanted.h"

#include "qm_solver/ulfdiagnosis.h"
#include "qm_solver/ulfexact.h"
#include "qm_solver/ulfsolver.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <gtest/gtest.h>

namespace {

using LONG_MATRIX = Eigen::Matrix<long double, Eigen::Dynamic, Eigen::Dynamic>;
using LONG_VECTOR = Eigen::Matrix<long double, Eigen::Dynamic, 1>;

constexpr int kDraws = 25;

/// Sizes of the columns: powers of two, so that scaling is exact.
std::vector<double> Sizes(CUlfPlanter& random, std::size_t n)
{
    std::vector<double> sizes;
    for (std::size_t j = 0; j < n; ++j)
        sizes.push_back(std::exp2(std::round(random.Uniform(-26.6, 26.6)))); // 1e-8 to 1e8
    return sizes;
}

/// A vertex: n active rows of a well-conditioned matrix times the sizes hold z / sizes; each active
/// inequality is turned so that its multiplier has the right sign. Then as many idle rows.
T_PLANTED Vertex(std::uint64_t seed, int objective, int nVar)
{
    CUlfPlanter random(seed);
    const auto n = static_cast<Eigen::Index>(nVar);
    const std::vector<double> size = Sizes(random, static_cast<std::size_t>(nVar));
    LONG_MATRIX b = 2.0L * LONG_MATRIX::Identity(n, n);
    T_PLANTED p;
    p.nVar = nVar;
    p.nEq = nVar / 3;
    p.objective = objective;
    LONG_VECTOR z(n), gradient = LONG_VECTOR::Zero(n);
    Eigen::Index largest = 0;
    for (Eigen::Index j = 0; j < n; ++j) {
        const auto at = static_cast<std::size_t>(j);
        for (Eigen::Index i = 0; i < n; ++i)
            b(i, j) += random.Uniform(-1.0, 1.0) / std::sqrt(nVar);
        z(j) = random.Uniform(0.2, 1.0) * (random.Below(2) ? 1.0 : -1.0);
        p.weights.push_back(1.0);
        p.x.push_back(static_cast<double>(z(j)) / size[at]);
        gradient(j) = objective == 2 ? 2.0L * p.x[at] : (p.x[at] > 0.0 ? 1.0L : -1.0L);
        if (std::fabs(p.x[at]) > std::fabs(p.x[static_cast<std::size_t>(largest)])) largest = j;
    }
    for (Eigen::Index j = 0; j < n; ++j) { // of the unknowns z
        if (objective == 3 && j != largest) gradient(j) = 0.0L;
        gradient(j) /= size[static_cast<std::size_t>(j)];
    }
    const LONG_VECTOR multiplier = b.transpose().fullPivLu().solve(-gradient);
    for (Eigen::Index i = 0; i < 2 * n; ++i) {
        const bool active = i < n, equal = i < p.nEq;
        const double turn = active && !equal && multiplier(i) < 0.0L ? -1.0 : 1.0;
        long double rhs = active ? 0.0L : random.Uniform(0.5, 2.0);
        for (Eigen::Index j = 0; j < n; ++j) {
            const double e = turn * (active ? static_cast<double>(b(i, j)) : random.Uniform(-1, 1));
            const auto at = static_cast<std::size_t>(j);
            p.rows.push_back(e * size[at]);
            rhs += static_cast<long double>(p.rows.back()) * p.x[at];
        }
        p.rhs.push_back(static_cast<double>(rhs));
    }
    return p;
}

/// Largest difference in what the rows feel, relative to the largest part of any unknown.
double Apart(const T_PLANTED& p, const std::vector<double>& x)
{
    double most = 0.0, size = 0.0;
    for (std::size_t j = 0; j < x.size(); ++j) {
        double column = 0.0;
        for (std::size_t i = 0; i < p.rhs.size(); ++i)
            column = std::max(column, std::fabs(p.Problem().Row(i)[j]));
        most = std::max(most, column * std::fabs(x[j] - p.x[j]));
        size = std::max(size, column * std::fabs(p.x[j]));
    }
    return most / size;
}

/// Whether the rows of a conflict contradict each other in this problem.
bool Contradict(const T_PLANTED& p, const T_ULF_CONFLICT& conflict)
{
    T_PLANTED part = p;
    part.rows.clear();
    part.rhs.clear();
    part.nEq = 0;
    if (!conflict.sign) part.sign = 0;
    for (const int i : conflict.rows) {
        const auto row = p.Problem().Row(static_cast<std::size_t>(i));
        part.rows.insert(part.rows.end(), row.begin(), row.end());
        part.rhs.push_back(p.rhs[static_cast<std::size_t>(i)]);
        part.nEq += i < p.nEq ? 1 : 0;
    }
    return MeetUlf(part.Problem()).code != ULF_SOLVED;
}

} // namespace

TEST(UlfColumns, APlantedVertexIsFoundWhateverTheSizeOfTheUnitLoads)
{
    for (int objective = 1; objective <= 3; ++objective)
        for (const int n : {2, 3, 5, 9})
            for (int draw = 0; draw < kDraws; ++draw) {
                const auto seed = static_cast<std::uint64_t>(100 * n + draw);
                const T_PLANTED p = Vertex(seed, objective, n);
                const T_ULF_ANSWER a = SolveUlf(p.Problem());
                EXPECT_EQ(0, a.code) << objective << " seed " << seed;
                if (a.code == 0) {
                    EXPECT_LE(Apart(p, a.x), 1e-9) << objective << " seed " << seed;
                }
                T_ULF_EXACT exact; // the active rows as equations
                const auto size = static_cast<std::size_t>(n);
                const T_ULF_PROBLEM square{
                    n, 0, {p.rows.data(), size * size}, {p.rhs.data(), size}, p.weights, 1, 0};
                ASSERT_EQ(1, SolveUlfExact(square, exact));
                EXPECT_TRUE(exact.unmet.empty());
                EXPECT_LE(Apart(p, exact.x), 1e-9) << " seed " << seed;
                T_ULF_MATRIX m;
                ASSERT_EQ(1, CUlfDiagnosis().Examine(square, m));
                EXPECT_EQ(n, m.rank);
                EXPECT_LT(m.condition, 1e3) << "sizes are no poor condition";
            }
}

TEST(UlfColumns, AContradictionStaysOneAndNoOtherComes)
{
    for (const PLANT kind : {PLANT::NoEqualities, PLANT::NoRows, PLANT::Plain, PLANT::Degenerate})
        for (int draw = 0; draw < kDraws; ++draw) {
            CUlfPlanter planter(static_cast<std::uint64_t>(draw));
            const T_PLANTED plain = planter.Plant(kind, 2, draw % 3 - 1, 3 + draw % 7, 20);
            T_PLANTED p = plain;
            const std::vector<double> size = Sizes(planter, p.weights.size());
            for (std::size_t k = 0; k < p.rows.size(); ++k)
                p.rows[k] *= size[k % size.size()];
            const T_ULF_CONFLICT before = CUlfDiagnosis().Conflict(plain.Problem(), {});
            const T_ULF_CONFLICT after = CUlfDiagnosis().Conflict(p.Problem(), {});
            EXPECT_EQ(before.state, after.state) << draw;
            EXPECT_EQ(after.rows.empty(), !Contradict(plain, after)) << draw;
            const bool none = kind == PLANT::NoEqualities || kind == PLANT::NoRows;
            for (int objective = 1; objective <= 3; ++objective) {
                p.objective = objective;
                EXPECT_EQ(none, SolveUlf(p.Problem()).code != 0) << draw << ' ' << objective;
            }
        }
}
