#include "qm_solver/ulfdiagnosis.h"

#include "numbers.h"
#include "ulfplanted.h"

#include "qm_solver/ulfsolver.h"

#include <gtest/gtest.h>

namespace {

using T_VECTOR = std::vector<double>;

constexpr int kSeeds = 12;

/// Forces of two cables (kN) that shall lift a node by 10 mm and keep two moments within bounds.
struct T_TUNING {
    T_VECTOR rows{2e-3, 1e-3, 50.0, -20.0, -1.0, 0.0};
    T_VECTOR rhs{0.01, 130.0, -3.5}; // so that 3.5 <= x1 <= 3.667
    T_VECTOR weights{1.0, 1.0};
    T_ULF_PROBLEM Problem(int objective) const { return {2, 1, rows, rhs, weights, objective, 0}; }
};

double Objective(const T_ULF_PROBLEM& p)
{
    const T_ULF_ANSWER a = SolveUlf(p);
    EXPECT_EQ(0, a.code);
    return a.certificate.objective;
}

/// The rows of a set alone, with or without the sign restriction.
bool HasSolution(const T_ULF_PROBLEM& p, const std::vector<int>& rows, bool sign)
{
    T_VECTOR matrix, rhs;
    int nEq = 0;
    for (int i : rows) {
        const auto row = p.Row(static_cast<std::size_t>(i));
        matrix.insert(matrix.end(), row.begin(), row.end());
        rhs.push_back(p.rhs[static_cast<std::size_t>(i)]);
        nEq += i < p.nEq ? 1 : 0;
    }
    const T_ULF_PROBLEM part{p.nVar, nEq, matrix, rhs, p.weights, 1, sign ? p.sign : 0};
    const int code = SolveUlf(part).code;
    EXPECT_TRUE(code == 0 || (code >= 5 && code <= 7)) << code;
    return code == 0;
}

} // namespace

TEST(UlfDiagnosis, AMultiplierIsWhatAUnitOfRelaxationBuys)
{
    const double step = 1e-4; // relative change of a limit; objectives are at most quadratic in it
    for (const int objective : {1, 2, 3}) {
        const T_TUNING tuning;
        T_ULF_EXPLANATION e;
        ASSERT_EQ(1, CUlfDiagnosis().Explain(tuning.Problem(objective), e));
        double multiplier[3] = {0.0, 0.0, 0.0};
        for (const T_ULF_HELD& held : e.rows)
            multiplier[held.index] = held.multiplier;
        for (std::size_t i = 0; i < 3; ++i) {
            T_TUNING up = tuning, down = tuning;
            const double change = step * std::fabs(tuning.rhs[i]);
            up.rhs[i] += change;
            down.rhs[i] -= change;
            const double slope =
                (Objective(up.Problem(objective)) - Objective(down.Problem(objective))) /
                (2.0 * change);
            EXPECT_NEAR(slope, multiplier[i], 1e-6 * (1.0 + std::fabs(slope)))
                << "objective " << objective << " row " << i;
        }
    }
}

TEST(UlfDiagnosis, AnAnswerWorkedByHandIsExplained)
{
    // x1 + x2 = 1 and x2 = 2 under x >= 0 would need x1 = -1; with x1 >= 0 and x2 <= 2:
    // smallest square sum of x1 + 2 x2 >= 4, x >= 0, x1 <= 0.5: x = (0.5, 1.75), d/d b = 2 x2 / 2.
    const T_VECTOR rows{-1, -2, 1, 0}, rhs{-4, 0.5}, weights{1, 1};
    T_ULF_EXPLANATION e;
    ASSERT_EQ(1, CUlfDiagnosis().Explain({2, 0, rows, rhs, weights, 2, 1}, e));
    EXPECT_NEAR(0.5, e.factors[0], 1e-14);
    EXPECT_NEAR(1.75, e.factors[1], 1e-14);
    EXPECT_NEAR(3.3125, e.objective, 1e-13);
    ASSERT_EQ(2u, e.rows.size());
    EXPECT_NEAR(-1.75, e.rows[0].multiplier, 1e-13);
    EXPECT_NEAR(2 * 0.5 - 1.75, e.rows[1].multiplier, 1e-13);
    EXPECT_TRUE(e.signs.empty());

    // x1 - x2 = 1 with weights 1 and 0.1 wants x2 < 0: held at zero, each unit costs 2 x1.
    const T_VECTOR row{1, -1}, one{1}, light{1, 0.1};
    ASSERT_EQ(1, CUlfDiagnosis().Explain({2, 1, row, one, light, 2, 1}, e));
    EXPECT_NEAR(1.0, e.factors[0], 1e-14);
    ASSERT_EQ(1u, e.signs.size());
    EXPECT_EQ(1, e.signs[0].index);
    EXPECT_NEAR(2.0, e.signs[0].multiplier, 1e-13);
}

// Smallest x^2 with x >= 1 twice: the objective is b^2, and only both bounds together let it fall.
TEST(UlfDiagnosis, ABoundThatStandsTwiceCostsToOneSideAlone)
{
    const T_VECTOR rows{-1, -1}, rhs{-1, -1}, weights{1};
    for (const int objective : {1, 2, 3}) {
        T_ULF_EXPLANATION e;
        ASSERT_EQ(1, CUlfDiagnosis().Explain({1, 0, rows, rhs, weights, objective, 0}, e));
        ASSERT_EQ(2u, e.rows.size());
        for (const T_ULF_HELD& held : e.rows) {
            EXPECT_NEAR(0.0, held.raised.value(), 1e-12) << objective;
            EXPECT_NEAR(objective == 2 ? 2.0 : 1.0, held.lowered.value(), 1e-6) << objective;
        }
    }
    // An equality that stands twice can't be moved alone; one that stands once goes both ways.
    T_ULF_EXPLANATION e;
    ASSERT_EQ(1, CUlfDiagnosis().Explain({1, 2, rows, rhs, weights, 2, 0}, e));
    EXPECT_FALSE(e.rows.at(0).raised || e.rows.at(1).lowered);
    ASSERT_EQ(1,
              CUlfDiagnosis().Explain({1, 1, {rows.data(), 1}, {rhs.data(), 1}, weights, 2, 0}, e));
    EXPECT_NEAR(-2.0, e.rows.at(0).raised.value(), 1e-12);
    EXPECT_NEAR(2.0, e.rows.at(0).lowered.value(), 1e-12);
}

// x1 + x2 = 0, x1 + (1 + d) x2 = 1, x1 + (1 + 2 d) x2 = 0 contradict each other for any d above 0.
TEST(UlfDiagnosis, NearlyParallelRowsAreNotCalledSolvable)
{
    for (const double d : {1e-4, 1e-6, 1e-8, 1e-10}) {
        const T_VECTOR rows{1, 1, 1, 1 + d, 1, 1 + 2 * d}, rhs{0, 1, 0}, weights{1, 1};
        const ULF_CONFLICT state =
            CUlfDiagnosis().Conflict({2, 3, rows, rhs, weights, 2, 0}, {}).state;
        EXPECT_EQ(d > 1e-7 ? ULF_CONFLICT::Found : ULF_CONFLICT::NotProved, state) << d;
    }
}

TEST(UlfDiagnosis, TheMatrixIsRankedWithoutRegardToUnits)
{
    // unit rows (1, 0, 0), (0.6, 0.8, 0) times units; singular values^2 = 1 +- 0.6
    const T_VECTOR rows{1e9, 0, 0, 6e-9, 8e-9, 0, 3, 4, 0}, rhs{1, 1, 1}, weights{1, 1, 1};
    T_ULF_MATRIX m;
    ASSERT_EQ(1,
              CUlfDiagnosis().Examine({3, 0, {rows.data(), 6}, {rhs.data(), 2}, weights, 2, 0}, m));
    EXPECT_EQ(2, m.rank);
    EXPECT_NEAR(2.0, m.condition, 1e-14);
    EXPECT_EQ(std::vector<int>{2}, m.unfelt);
    ASSERT_EQ(1, CUlfDiagnosis().Examine({3, 0, rows, rhs, weights, 2, 0}, m));
    EXPECT_EQ(2, m.rank) << "the third row repeats the second";
    const T_VECTOR zeros(3, 0.0);
    ASSERT_EQ(1, CUlfDiagnosis().Examine({3, 0, zeros, {rhs.data(), 1}, weights, 2, 0}, m));
    EXPECT_EQ(0, m.rank);
    EXPECT_EQ(0.0, m.condition);
    EXPECT_EQ((std::vector<int>{0, 1, 2}), m.unfelt);
}

TEST(UlfDiagnosis, TheCompromiseSharesTheViolation)
{
    struct T_CASE {
        const char* label;
        int nEq, sign;
        T_VECTOR rows, rhs, x, violation;
        double sum;
    };
    // clang-format off
    const T_CASE cases[] = { // two unknowns, weight 1
        {"two equalities",     2, 0, {1, 0, 1, 0},  {1, 2},  {1.5, 0}, {0.5, -0.5}, 0.5},
        {"units do not weigh", 2, 0, {1, 0, 1e6, 0}, {1, 2e6}, {1.5, 0}, {0.5, -5e5}, 0.5},
        {"bounds cross",       0, 0, {1, 0, -1, 0}, {1, -2}, {1.5, 0}, {0.5, 0.5},  0.5},
        {"third row is kept",  0, 0, {1, 0, -1, 0, 0, -1}, {1, -2, -3}, {1.5, 3},
         {0.5, 0.5, 0}, 0.5},
        {"sign is never broken", 1, 1, {1, 0},      {-2},    {0, 0},   {2},         4.0},
        {"sign, other unknown", 1, -1, {3, -4},     {-8},    {-8.0 / 3, 0}, {0},    0.0},
        {"already met",        1, 0, {1, 1},        {2},     {1, 1},   {0},         0.0},
    };
    // clang-format on
    const T_VECTOR weights{1, 1};
    for (const T_CASE& c : cases) {
        T_ULF_COMPROMISE out;
        ASSERT_EQ(1, CUlfDiagnosis().Compromise({2, c.nEq, c.rows, c.rhs, weights, 1, c.sign}, out))
            << c.label;
        for (std::size_t j = 0; j < 2; ++j)
            EXPECT_NEAR(c.x[j], out.factors[j], 1e-12) << c.label;
        for (std::size_t i = 0; i < c.rhs.size(); ++i)
            EXPECT_NEAR(c.violation[i], out.violation[i], 1e-12 * (1.0 + std::fabs(c.rhs[i])))
                << c.label;
        EXPECT_NEAR(c.sum, out.sumOfSquares, 1e-12) << c.label;
    }
}

TEST(UlfDiagnosis, NoSmallChangeOfTheCompromiseViolatesLess)
{
    for (const PLANT kind : {PLANT::NoEqualities, PLANT::NoRows, PLANT::WrongSign})
        for (int seed = 0; seed < kSeeds; ++seed) {
            CUlfPlanter planter(static_cast<std::uint64_t>(seed));
            const int sign = kind == PLANT::WrongSign ? 1 - 2 * (seed % 2) : seed % 3 - 1;
            const T_PLANTED p = planter.Plant(kind, 2, sign, 3 + seed, 20 + seed);
            T_ULF_COMPROMISE c;
            ASSERT_EQ(1, CUlfDiagnosis().Compromise(p.Problem(), c));
            EXPECT_GT(c.sumOfSquares, 0.0);
            const T_ULF_SCALED s = ScaleUlf(p.Problem());
            double largest = 0.0;
            for (std::size_t j = 0; j < s.nVar; ++j)
                largest = std::max(largest, p.weights[j] * std::fabs(c.factors[j]));
            for (std::size_t j = 0; j < s.nVar; ++j) { // gradient of half the sum, unknowns w x
                long double slope = 0.0L, size = 0.0L;
                for (std::size_t i = 0; i < s.nCon; ++i) {
                    const long double v = c.violation[i] / s.rowNorm[i];
                    slope += v * s.rows[i * s.nVar + j];
                    size = std::max(size, std::fabs(v));
                }
                const bool isAtSign =
                    sign != 0 && p.weights[j] * std::fabs(c.factors[j]) <= 1e-12 * largest;
                EXPECT_LE(isAtSign ? -sign * slope : std::fabs(slope), 1e-9L * size)
                    << "seed " << seed << " unknown " << j;
                EXPECT_GE(sign * c.factors[j], 0.0);
            }
        }
}

TEST(UlfDiagnosis, AContradictionIsMinimal)
{
    for (const PLANT kind : {PLANT::NoEqualities, PLANT::NoRows, PLANT::WrongSign})
        for (int seed = 0; seed < kSeeds; ++seed) {
            CUlfPlanter planter(static_cast<std::uint64_t>(seed));
            const int sign = kind == PLANT::WrongSign ? 1 - 2 * (seed % 2) : seed % 3 - 1;
            const T_PLANTED p = planter.Plant(kind, 2, sign, 3 + seed, 20 + seed);
            const T_ULF_CONFLICT c = CUlfDiagnosis().Conflict(p.Problem(), {});
            ASSERT_EQ(ULF_CONFLICT::Found, c.state);
            EXPECT_TRUE(std::is_sorted(c.rows.begin(), c.rows.end()));
            EXPECT_FALSE(HasSolution(p.Problem(), c.rows, c.sign)) << "seed " << seed;
            EXPECT_EQ(kind == PLANT::WrongSign, c.sign) << "seed " << seed;
            if (c.sign) {
                EXPECT_TRUE(HasSolution(p.Problem(), c.rows, false)) << "seed " << seed;
            }
            for (std::size_t i = 0; i < c.rows.size(); ++i) {
                std::vector<int> rest = c.rows;
                rest.erase(rest.begin() + static_cast<std::ptrdiff_t>(i));
                EXPECT_TRUE(HasSolution(p.Problem(), rest, c.sign)) << "seed " << seed;
            }
        }
}

TEST(UlfDiagnosis, TheSearchReportsAndCanBeCancelled)
{
    CUlfPlanter planter(1);
    const T_PLANTED p = planter.Plant(PLANT::NoRows, 2, 0, 8, 30);
    int last = -1;
    const auto count = [&](int tried, int members) {
        EXPECT_EQ(last + 1, tried);
        EXPECT_LT(tried, members);
        last = tried;
        return true;
    };
    EXPECT_EQ(ULF_CONFLICT::Found, CUlfDiagnosis().Conflict(p.Problem(), count).state);
    EXPECT_GT(last, 0);
    const T_ULF_CONFLICT c =
        CUlfDiagnosis().Conflict(p.Problem(), [](int tried, int) { return tried < 1; });
    EXPECT_EQ(ULF_CONFLICT::Cancelled, c.state);
    EXPECT_TRUE(c.rows.empty());
}

TEST(UlfDiagnosis, BadInputAndSolvableProblemsAreToldApart)
{
    const T_TUNING good;
    EXPECT_EQ(ULF_CONFLICT::Solvable, CUlfDiagnosis().Conflict(good.Problem(2), {}).state);
    T_TUNING bad;
    bad.rhs[1] = kNan;
    T_ULF_EXPLANATION e;
    T_ULF_MATRIX m;
    T_ULF_COMPROMISE c;
    EXPECT_EQ(0, CUlfDiagnosis().Explain(bad.Problem(2), e));
    EXPECT_EQ(0, CUlfDiagnosis().Examine(bad.Problem(2), m));
    EXPECT_EQ(0, CUlfDiagnosis().Compromise(bad.Problem(2), c));
    EXPECT_EQ(ULF_CONFLICT::BadInput, CUlfDiagnosis().Conflict(bad.Problem(2), {}).state);
}
