#include "ulfsample.h"

#include "qm_rps/factors/ulfexplain.h"

#include <gtest/gtest.h>

namespace {

using LIMIT = T_ULF_HOLD::LIMIT;
constexpr T_UNITS kUnits{FORCE_UNIT::kN, LENGTH_UNIT::m};

/// A constraint on the displacement DX of a node, with the responses of the cases.
struct T_IN {
    const char* name;
    std::optional<double> upper, lower; // both equal: an equality
    std::vector<double> responses;
};

/// Cases S1, S2 ... unknown with weight 1, but the last one, G, known with factor 1; square
/// objective. Solved by the real solver.
T_ULF_RUN Solve(const std::vector<T_IN>& constraints, int sign = 1)
{
    CTableResponse source;
    T_ULF_RUN run;
    run.item.name = "T";
    run.item.objective = 1;
    run.item.sign = sign;
    const int count = static_cast<int>(constraints.front().responses.size());
    for (int i = 1; i < count; ++i)
        run.cases.push_back({i, "S" + std::to_string(i), 1.0, true, 1.0});
    run.cases.push_back({count, "G", 1.0});
    for (const T_IN& in : constraints) {
        T_ULFC_D c;
        c.name = in.name;
        c.id = static_cast<int>(run.constraints.size()) + 1;
        c.inequality = in.upper != in.lower;
        c.value = in.upper.value_or(0.0);
        c.upper = in.upper;
        c.lower = in.lower;
        source.m_table[{1, c.id, 0, 1}] = in.responses;
        run.constraints.push_back(c);
    }
    run.formed = FormUlfProblem(run.item, run.cases, run.constraints);
    COptDsgn optimizer(source);
    (void)optimizer.Run(run.formed.problem, run.answer);
    EXPECT_EQ(1, ReadUlfInfluence(run.cases, run.constraints, source, run.influence));
    return run;
}

T_ULF_EXPLAINED Explained(const T_ULF_RUN& run)
{
    T_ULF_EXPLAINED e;
    EXPECT_EQ(1, ExplainUlf(run, kUnits, e));
    return e;
}

bool Says(const T_ULF_EXPLAINED& e, const std::string& part)
{
    for (const std::string& line : e.lines)
        if (line.find(part) != std::string::npos) return true;
    return false;
}

} // namespace

TEST(UlfExplain, GivesWhatRelaxingALimitBuys)
{
    // v = 4 x - 10, objective x^2: its change with a limit is 2 x / 4.
    const struct {
        std::optional<double> upper, lower;
        LIMIT limit;
        double value, objective, multiplier;
        const char* words;
    } kCases[] = {
        {{},
         -2,
         LIMIT::Lower,
         -2,
         4,
         1,
         "At first, raising the limit by 1 % (0.02 m) changes the objective by +0.02, lowering it "
         "by "
         "-0.02."},
        {-14,
         {},
         LIMIT::Upper,
         -14,
         1,
         -0.5,
         "C (<= -14 m) holds the solution. At first, raising the"},
        {50, -2, LIMIT::Lower, -2, 4, 1, "C (>= -2 m)"},
        {6, 6, LIMIT::Target, 6, 16, 2,
         "(0.06 m) changes the objective by +0.12, lowering it by -0.12."},
    };
    for (const auto& c : kCases) {
        SCOPED_TRACE(c.words);
        const T_ULF_EXPLAINED e = Explained(Solve({{"C", c.upper, c.lower, {4, -10}}}));
        EXPECT_TRUE(e.solved && !e.compromise);
        EXPECT_NEAR(c.objective, e.objective, 1e-10);
        ASSERT_EQ(1u, e.held.size());
        EXPECT_EQ(c.limit, e.held[0].limit);
        EXPECT_EQ(c.value, e.held[0].value);
        EXPECT_NEAR(c.multiplier, e.held[0].multiplier, 1e-9);
        EXPECT_TRUE(Says(e, c.words)) << e.lines.at(1);
    }
}

TEST(UlfExplain, NamesTheFactorThatTheSignRestrictionHolds)
{
    // least x^2 + y^2 with x - 2 y >= 3 and no factor negative: x = 3, y = 0. Free, y would be
    // negative; Lagrange: 2 x = l = 6, m = 2 l = 12.
    const T_ULF_EXPLAINED e = Explained(Solve({{"C", {}, 3, {1, -2, 0}}}, 2));
    ASSERT_EQ(2u, e.held.size());
    EXPECT_NEAR(6, e.held[0].multiplier, 1e-9);
    EXPECT_EQ("S2", e.held[1].name);
    EXPECT_EQ(LIMIT::Sign, e.held[1].limit);
    EXPECT_NEAR(-12, e.held[1].multiplier, 1e-9);
    EXPECT_TRUE(Says(
        e, "factor of S2 at 0. One unit of the other sign would change the objective by -12."));
}

TEST(UlfExplain, NamesTheSmallestSetThatContradictsItself)
{
    const T_ULF_RUN run = Solve(
        {{"roof", 1, {}, {1, 0, 0}}, {"side", 9, -9, {0, 1, 0}}, {"floor", {}, 2, {1, 0, 0}}});
    ASSERT_FALSE(run.answer.message.empty());
    const T_ULF_EXPLAINED e = Explained(run);
    EXPECT_FALSE(e.solved);
    EXPECT_TRUE(e.contradicts);
    EXPECT_FALSE(e.conflictWithSign);
    EXPECT_EQ(
        (std::vector<T_ULF_CLASH>{{"roof", LIMIT::Upper, 1, "m"}, {"floor", LIMIT::Lower, 2, "m"}}),
        e.conflict);
    EXPECT_TRUE(Says(e, "roof (<= 1 m), floor (>= 2 m)"));
    // Half way between them.
    ASSERT_TRUE(e.compromise);
    EXPECT_NEAR(1.5, e.compromise->factors[0], 1e-9);
    EXPECT_TRUE(Says(e, "roof +0.5 m, floor -0.5 m"));
    EXPECT_EQ((std::vector<double>{0, 0}), run.answer.factors); // never taken silently
}

TEST(UlfExplain, CountsTheSignRestrictionAmongTheContradicting)
{
    const T_ULF_EXPLAINED e =
        Explained(Solve({{"C", -1, {}, {1, 1, 0}}, {"D", 5, {}, {1, 0, 0}}}, 2));
    EXPECT_TRUE(e.contradicts && e.conflictWithSign);
    EXPECT_EQ(1u, e.conflict.size());
    EXPECT_TRUE(Says(e, "C (<= -1 m), the sign restriction"));
}

TEST(UlfExplain, ExplainsEquationsThatContradictThoughFactorsWereGiven)
{
    const T_ULF_RUN run = Solve({{"A", 1, 1, {1, 1, 0}}, {"B", 2, 2, {1, 1, 0}}});
    ASSERT_TRUE(run.answer.exact && run.answer.message.empty());
    const T_ULF_EXPLAINED e = Explained(run);
    EXPECT_FALSE(e.solved);
    EXPECT_TRUE(e.contradicts);
    EXPECT_EQ(2u, e.conflict.size());
    EXPECT_EQ(1, e.rank);
}

TEST(UlfExplain, TellsRankAndUnknownsThatNothingFeels)
{
    // Columns S1, S2, S3; S3 is felt by none. Rows (3, 4) and (4, -3) of unit length are
    // perpendicular: condition 1.
    const T_ULF_EXPLAINED e =
        Explained(Solve({{"A", 5, {}, {3, 4, 0, 9}}, {"B", 5, {}, {4, -3, 0, 9}}}));
    EXPECT_EQ(3, e.unknowns);
    EXPECT_EQ(2, e.rows);
    EXPECT_EQ(2, e.rank);
    EXPECT_NEAR(1, e.condition, 1e-12);
    EXPECT_EQ(std::vector<std::string>{"S3"}, e.unfelt);
    EXPECT_TRUE(Says(e, "No constraint feels load case S3"));
    // G alone at 9 leaves no room below 5, so a limit is held; far from any limit none is.
    EXPECT_TRUE(Says(Explained(Solve({{"A", 5, {}, {3, 4, 0}}})), "No limit holds the solution"));
}

TEST(UlfExplain, SaysWhenARunFailedThoughNothingContradicts)
{
    T_ULF_RUN run = Solve({{"C", {}, -2, {4, -10}}});
    run.answer.message = "refused";
    const T_ULF_EXPLAINED e = Explained(run);
    EXPECT_FALSE(e.solved || e.contradicts);
    EXPECT_EQ("refused", e.lines[0]);
    EXPECT_TRUE(Says(e, "do not contradict each other"));
    EXPECT_FALSE(e.compromise);
    T_ULF_EXPLAINED untouched;
    untouched.rank = 7;
    EXPECT_EQ(0, ExplainUlf({}, kUnits, untouched));
    EXPECT_EQ(7, untouched.rank);
}
