// Problems with answers known by hand, and input that is refused.
#include "numbers.h"

#include "qm_db/rps_unknownloadfactormanager.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using T_VECTOR = std::vector<double>;

struct T_CASE {
    const char* label;
    int neq;
    T_VECTOR rows, rhs, weights;
    int iobj, isign, error;
    T_VECTOR x; // empty: none
};

// clang-format off
const T_CASE kByHand[] = {
    // label                  neq rows         rhs     weights obj sign err x
    {"square shares",         1, {1, 1},       {2},    {1, 1}, 2, 0, 0, {1, 1}},
    {"square by weight",      1, {1, 1},       {2},    {1, 2}, 2, 0, 0, {1.6, 0.4}},
    {"sum takes the cheap one", 1, {1, 1},     {2},    {1, 2}, 1, 0, 0, {2, 0}},
    {"sum, tie: shortest",    1, {1, 1},       {2},    {1, 1}, 1, 0, 0, {1, 1}},
    {"largest levels out",    1, {1, 1},       {2},    {1, 2}, 3, 0, 0, {4.0 / 3, 2.0 / 3}},
    {"inequality pulls",      1, {1, 1, -1, 0}, {1, -3}, {1, 1}, 2, 0, 0, {3, -2}},
    {"sum over an inequality", 0, {-1, -2},    {-4},   {1, 1}, 1, 0, 0, {0, 2}},
    {"all negative",          1, {1, 1},       {-2},   {1, 1}, 2, -1, 0, {-1, -1}},
    {"sign decides",          1, {1, -1, -1, 0}, {1, -1}, {1, 1}, 2, 1, 0, {1, 0}},
    {"loose bound of 1e30",   1, {1, 0, 1, 1}, {3, 1e30}, {1, 1}, 2, 0, 0, {3, 0}},
    {"rows that say nothing", 1, {0, 0, 0, 0}, {0, 1}, {1, 1}, 2, 0, 0, {0, 0}},
    {"repeated equality",     2, {1, 1, 2, 2}, {2, 4}, {1, 1}, 3, 1, 0, {1, 1}},
    {"equality by inequalities", 0, {1, 1, -1, -1}, {2, -2}, {1, 1}, 1, 0, 0, {1, 1}},
    {"free unknown, square",  1, {1, 1},       {2},    {1, 0}, 2, 0, 0, {0, 2}},
    {"free unknown, largest", 1, {1, 1},       {2},    {1, 0}, 3, 0, 0, {0, 2}},
    {"no rows",               0, {},           {},     {1, 1}, 1, 0, 0, {0, 0}},
    {"overflowing unit mix",  1, {1e200, 1e-200}, {1e200}, {1e-150, 1e150}, 2, 0, 0, {1, 0}},
    {"equalities contradict", 2, {1, 1, 1, 1}, {1, 2}, {1, 1}, 2, 0, 5, {}},
    {"zero row, not zero",    1, {0, 0},       {1},    {1, 1}, 3, 0, 5, {}},
    {"zero row, below zero",  0, {0, 0},       {-1},   {1, 1}, 1, 0, 6, {}},
    {"bounds cross",          0, {1, 0, -1, 0}, {1, -2}, {1, 1}, 1, 0, 6, {}},
    {"equality against bound", 1, {1, 1, 1, 1}, {2, 1}, {1, 1}, 3, 0, 6, {}},
    {"other sign only",       1, {1, 1},       {-2},   {1, 1}, 2, 1, 7, {}},
    {"met within 1e-9",       2, {1, 1, 1, 1}, {1, 1 + 2e-9}, {1, 1}, 2, 0, 9, {0.5, 0.5}},
    {"objective 0",           1, {1, 1},       {2},    {1, 1}, 0, 0, -1, {}},
    {"NaN in a row",          1, {1, kNan},    {2},    {1, 1}, 2, 0, 4, {}},
    {"infinite right-hand side", 0, {1, 1},    {kInf}, {1, 1}, 2, 0, 4, {}},
    {"NaN weight",            1, {1, 1},       {2},    {1, kNan}, 2, 0, 4, {}},
    {"negative weight",       1, {1, 1},       {2},    {1, -1}, 2, 0, 4, {}},
    {"sign 2",                1, {1, 1},       {2},    {1, 1}, 2, 2, 4, {}},
    {"more equalities than rows", 2, {1, 1},   {2},    {1, 1}, 2, 0, 4, {}},
    {"matrix too short",      1, {1},          {2},    {1, 1}, 2, 0, 4, {}},
    {"no unknowns",           0, {},           {},     {},     2, 0, 4, {}},
};
// clang-format on

/// Factors after a call; they start as 7 to show that every path writes them.
T_VECTOR Solve(CRps_UnknownLoadFactorManager& manager, int mode, const T_CASE& c, int& done,
               int& error)
{
    T_VECTOR x(c.weights.size(), 7.0);
    done = manager.Calc_UnknownLoadFactor(mode, static_cast<int>(c.rhs.size()),
                                          static_cast<int>(x.size()), c.neq, c.rows, c.rhs, x,
                                          c.weights, c.iobj, c.isign, error);
    return x;
}

struct T_SYSTEM {
    const char* label;
    int n, error;
    T_VECTOR rows, rhs, weights, x;
};

// clang-format off
const T_SYSTEM kSystems[] = {
    {"regular",                2, 0, {2, 1, 1, 3},          {5, 10},    {1, 1}, {1, 3}},
    {"mixed units",            2, 0, {2e9, 1e-9, 1e9, 3e-9}, {5e0, 1e1}, {1, 1}, {1e-9, 3e9}},
    {"weights do not matter",  2, 0, {2, 1, 1, 3},          {5, 10},    {1e-6, 0}, {1, 3}},
    {"singular: shortest",     2, 0, {1, 1, 2, 2},          {2, 4},     {1, 1}, {1, 1}},
    {"singular, by weight",    2, 0, {1, 1, 2, 2},          {2, 4},     {1, 2}, {1.6, 0.4}},
    {"singular, scaled rows",  2, 0, {1e-9, 1e-9, 2e6, 2e6}, {2e-9, 4e6}, {1, 1}, {1, 1}},
    {"all zero",               2, 0, {0, 0, 0, 0},          {0, 0},     {1, 1}, {0, 0}},
    {"contradictory: between", 2, 5, {1, 0, 1, 0},          {1, 2},     {1, 1}, {1.5, 0}},
    {"rows weigh alike",       2, 5, {1, 0, 1e6, 0},        {1, 2e6},   {1, 1}, {1.5, 0}},
    {"zero row, not zero",     2, 5, {1, 1, 0, 0},          {2, 3},     {1, 1}, {1, 1}},
    {"met to 1e-7 is met",     2, 0, {1, 0, 1, 0},          {1, 1 + 2e-7}, {1, 1}, {1 + 1e-7, 0}},
    {"large beside small",     3, 5, {1,0,0, 1,0,0, 0,0,1}, {1, 1.0001, 1e7}, {1, 1, 1},
     {1.00005, 0, 1e7}},
    {"not a number",           2, 4, {1, kNan, 1, 0},       {1, 2},     {1, 1}, {0, 0}},
};
// clang-format on

} // namespace

TEST(UnknownLoadFactor, HandSolvedProblemsComeOutAndBadOnesAreRefused)
{
    for (const T_CASE& c : kByHand) {
        CRps_UnknownLoadFactorManager manager;
        int done = 0, error = 77;
        const T_VECTOR x = Solve(manager, 1, c, done, error);
        EXPECT_EQ(1, done) << c.label;
        EXPECT_EQ(c.error, error) << c.label;
        for (std::size_t j = 0; j < x.size(); ++j)
            EXPECT_NEAR(c.x.empty() ? 0.0 : c.x[j], x[j], c.error == 9 ? 2e-9 : 3e-12) << c.label;
    }
}

// x1 + 0.001 x2 = 1: the free unknown does it all, however much of it that takes.
TEST(UnknownLoadFactor, AZeroWeightIsFreeInEveryObjective)
{
    for (int objective = 1; objective <= 3; ++objective)
        for (const double small : {1e-3, 1e-6, 1.0, 1e3}) {
            const T_CASE c{"", 1, {1, small}, {1}, {1, 0}, objective, 0, 0, {}};
            CRps_UnknownLoadFactorManager manager;
            int done = 0, error = 77;
            const T_VECTOR x = Solve(manager, 1, c, done, error);
            EXPECT_EQ(0, error) << objective << ' ' << small;
            EXPECT_NEAR(0.0, x[0], 1e-9) << objective << ' ' << small;
            EXPECT_NEAR(1.0, small * x[1], 1e-9) << objective << ' ' << small;
        }
    // Two free ones share what is left: the shortest.
    const T_CASE two{"", 1, {1, 1, 1}, {2}, {1, 0, 0}, 2, 0, 0, {}};
    CRps_UnknownLoadFactorManager manager;
    int done = 0, error = 77;
    const T_VECTOR x = Solve(manager, 1, two, done, error);
    EXPECT_EQ(0, error);
    for (std::size_t j = 0; j < 3; ++j)
        EXPECT_NEAR(j == 0 ? 0.0 : 1.0, x[j], 1e-12);
}

TEST(UnknownLoadFactor, EquationsThatRepeatEachOtherLeaveTheChoiceToTheObjective)
{
    const T_VECTOR rows{1, 1, 2, 2}, rhs{2, 4}, weights{1, 2};
    const T_VECTOR answers[] = {{2, 0}, {1.6, 0.4}, {4.0 / 3, 2.0 / 3}}; // as in kByHand
    for (int objective = 1; objective <= 3; ++objective) {
        T_VECTOR x(2, 7.0);
        int error = 77;
        EXPECT_EQ(1, CRps_UnknownLoadFactorManager().Calc_UnknownLoadFactor(
                         0, 2, 2, 2, rows, rhs, x, weights, objective, 1, error));
        for (std::size_t j = 0; j < 2; ++j)
            EXPECT_NEAR(answers[objective - 1][j], x[j], 1e-12) << objective;
    }
}

TEST(UnknownLoadFactor, AWrongModeIsRefused)
{
    CRps_UnknownLoadFactorManager manager;
    int done = 0, error = 77;
    EXPECT_EQ(T_VECTOR(2, 0.0), Solve(manager, 2, kByHand[0], done, error));
    EXPECT_EQ(1, done);
    EXPECT_EQ(4, error);
}

TEST(UnknownLoadFactor, EquationsGiveTheirSolutionTheShortestOrTheLeastSquares)
{
    for (const T_SYSTEM& s : kSystems) {
        CRps_UnknownLoadFactorManager manager;
        int error = 77;
        T_VECTOR x(s.x.size(), 7.0);
        EXPECT_EQ(1, manager.Calc_UnknownLoadFactor(0, static_cast<int>(s.rhs.size()), s.n, 0,
                                                    s.rows, s.rhs, x, s.weights, 2, 0, error))
            << s.label;
        EXPECT_EQ(s.error, error) << s.label;
        for (std::size_t j = 0; j < x.size(); ++j)
            EXPECT_NEAR(s.x[j], x[j], 1e-14 * (std::fabs(s.x[j]) + (s.x[j] > 0.0 ? 0.0 : 10.0)))
                << s.label;
    }
}
