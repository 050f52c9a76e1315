#include "ulfsample.h"

#include "qm_base/appbase.h"
#include "qm_base/msgfunction.h"
#include "qm_base/testenvmgr.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace {

constexpr const char* kPositive = "IDS_RPS_Constraint___d__cannot_be_satisfied_with_t";
constexpr const char* kNegative = "IDS_RPS_Constraint___d__cannot_be_satisfied_with_t_MSG1";
constexpr const char* kNotSquare = "IDS_RPS_NOT_SOLVED_SIMUL_EQ_METHOD";
constexpr const char* kNoSolution = "IDS_RPS_Unknown_CANNOT_FIND_OPTIMIZED_SOLUTION";
constexpr const char* kViolated = "IDS_RPS_Error_code_9___The_load_factors_are_determ";
constexpr const char* kViolatedNegative = "IDS_RPS_Error_code_9___The_load_factors_are_determ_MSG2";
constexpr const char* kViolatedPositive = "IDS_RPS_Error_code_9___The_load_factors_are_determ_MSG3";
constexpr const char* kObjective = "IDS_RPS_Unknown_object_funtion_type_";

T_OPT_ITEM Unknown(int key, double weight = 1.0)
{
    return {double(key), 0.0, weight, 0.0};
}
T_OPT_ITEM Known(int key, double factor)
{
    return {double(key), factor, 1.0, 0.0};
}

/// Displacement DX of node `id`.
T_OPT_RECORD Displacement(int id, int relation, double value)
{
    return {1, double(id), 1, value, double(relation), 1, 0, 0};
}

std::string TextOf(const char* key, int number)
{
    return zql::lib::MMSGFunction::Format(key, {std::to_string(number)});
}

struct OptDsgn : testing::Test {
    ~OptDsgn() override { CTestEnvMgr::ClearST(); }

    /// A problem whose constraint i has the row rows[i] on unknown cases 1, 2 ...
    struct T_ROW_IN {
        std::vector<double> row;
        int relation;
        double value;
    };
    T_OPT_PROBLEM Problem(const std::vector<T_ROW_IN>& rows, int isign, bool byEquations)
    {
        T_OPT_PROBLEM p;
        p.isign = isign;
        p.solveByEquations = byEquations;
        p.nvar = static_cast<int>(rows.front().row.size());
        for (int i = 1; i <= p.nvar; ++i)
            p.items.push_back(Unknown(i));
        for (const T_ROW_IN& r : rows) {
            const int id = static_cast<int>(p.constraints.size()) + 1;
            m_source.m_table[{1, id, 0, 1}] = r.row;
            p.constraints.push_back(Displacement(id, r.relation, r.value));
        }
        return p;
    }
    int Run(const T_OPT_PROBLEM& p, COptDsgn::Solver solver)
    {
        COptDsgn optimizer(m_source);
        optimizer.SetSolver(std::move(solver));
        return optimizer.Run(p, m_answer);
    }
    /// The run ends with this message, about a number unless 0; without one there are factors.
    void Expect(const char* key, int number, const T_OPT_PROBLEM& p, COptDsgn::Solver solver)
    {
        EXPECT_EQ(*key ? 0 : 1, Run(p, std::move(solver)));
        EXPECT_EQ(key, m_answer.key);
        EXPECT_TRUE(!number || TextOf(key, number) == m_answer.message) << m_answer.message;
    }

    CTableResponse m_source;
    T_HANDED m_handed;
    T_OPT_ANSWER m_answer;
};

} // namespace

TEST(OptRows, FollowTheRuleForEveryKind)
{
    // Cases 1 and 3 unknown, case 2 known with 0.5. Places 5 and 6: 4 6 -2 and 1 8 3.
    const std::vector<T_OPT_ITEM> items{Unknown(1), Known(2, 0.5), Unknown(3)};
    using Q = T_OPT_QUANTITY;
    using V = std::vector<double>;
    const struct {
        const char* label;
        T_OPT_RECORD record;
        Q first, second;
        V row; // by hand
        double rhs;
        int relation;
        V all; // coefficients of every item
    } kCases[] = {
        // clang-format off
        {"displacement", {1, 5, 3, 10, 0, 1, 6}, {1, 5, 0, 3}, {}, {4, -2}, 7, 0, {4, 6, -2}},
        {"truss", {3, 5, 1, -1, 1, 1, 0}, {3, 5, 0, 1}, {}, {4, -2}, -4, 1, {4, 6, -2}},
        {"beam", {4, 5, 2, 6, 10, 1, 1, 6}, {4, 5, 2, 6}, {}, {4, -2}, 7, 1, {4, 6, -2}},
        {"compared", {1, 5, 3, 10, 0, 0, 6}, {1, 5, 0, 3}, {1, 6, 0, 3},
         {3, -5}, 1, 0, {3, -2, -5}},
        {"entries truncated", {1.9, 5.9, 3.9, 10, -0.9, 1.9}, {1, 5, 0, 3}, {},
         {4, -2}, 7, 0, {4, 6, -2}},
        {"unknown kind", {7, 5, 3, 10, 1, 1, 6}, {}, {}, {0, 0}, 0, 0, {0, 0, 0}},
        // clang-format on
    };
    for (const auto& c : kCases) {
        CTableResponse source;
        source.m_table[c.first] = {4, 6, -2};
        source.m_table[c.second] = {1, 8, 3};
        if (c.second.kind == 0) source.m_table.erase(c.second);
        std::vector<T_OPT_ROW> rows;
        std::vector<std::vector<double>> coefficients;
        ASSERT_EQ(1, BuildRows(items, std::span(&c.record, 1), source, rows, coefficients))
            << c.label;
        EXPECT_EQ((T_OPT_ROW{c.row, c.rhs, c.relation}), rows[0]) << c.label;
        EXPECT_EQ(c.all, coefficients[0]) << c.label;
    }
}

TEST_F(OptDsgn, HandsEqualitiesFirstAndEveryInequalityAsAtMost)
{
    T_OPT_PROBLEM p =
        Problem({{{1, 2}, 1, 5}, {{3, 4}, 0, 6}, {{5, 6}, -1, 7}, {{7, 8}, 0, 8}, {{9, 10}, 1, -9}},
                1, false);
    p.items = {Unknown(1, 2), Unknown(2, 3)};
    p.iobj = 3;
    ASSERT_EQ(1, Run(p, Answering(m_handed, {0.25, 0.5})));
    EXPECT_EQ((std::vector<double>{3, 4, 7, 8, -1, -2, 5, 6, -9, -10}), m_handed.matrix);
    EXPECT_EQ((std::vector<double>{6, 8, -5, 7, 9}), m_handed.rhs);
    EXPECT_EQ((std::vector<double>{2, 3}), m_handed.weights);
    EXPECT_EQ((std::vector<double>{0.25, 0.5}), m_answer.factors);
    EXPECT_EQ((std::vector<int>{1, 3, 0, 2, 4}), m_answer.system.order);
    EXPECT_EQ(std::vector<int>({1, 5, 2, 2, 3, 1}),
              std::vector<int>({m_handed.mode, m_handed.ncon, m_handed.nvar, m_handed.neq,
                                m_handed.iobj, m_handed.isign}));
}

TEST_F(OptDsgn, ChoosesEquationsForASquareSystemOfEqualitiesOnly)
{
    const T_ROW_IN eq{{1, 2}, 0, 1}, eq2{{2, 1}, 0, 1}, atMost{{1, 1}, -1, 1};
    const struct {
        const char* label;
        std::vector<T_ROW_IN> rows;
        int off, on; // mode without and with the wish for equations; -1: refused before any call
    } kCases[] = {
        {"square", {eq, eq2}, 0, 0},
        {"too few", {eq}, 1, -1},
        {"inequality", {eq, atMost}, 1, -1},
        {"one more", {eq, eq2, atMost}, 1, -1},
    };
    for (const auto& c : kCases)
        for (const bool on : {false, true}) {
            SCOPED_TRACE(c.label);
            m_handed = {};
            const int mode = on ? c.on : c.off;
            Expect(mode < 0 ? kNotSquare : "", 0, Problem(c.rows, 0, on),
                   Answering(m_handed, {1, 1}));
            EXPECT_EQ(mode, m_handed.mode);
        }
}

TEST_F(OptDsgn, PreChecksTheDiagonalBeforeEquations)
{
    const double tiny = 1e-300;
    const struct {
        const char* label;
        int isign;
        double c, rhs;
        int relation;
        const char* key; // empty: solved
    } kCases[] = {
        // clang-format off
        {"+ equality at 0", 1, 1, 0, 0, kPositive}, {"+ equality above", 1, 1, tiny, 0, ""},
        {"+ at most 0", 1, 1, 0, -1, kPositive}, {"+ at most above", 1, 1, tiny, -1, kNotSquare},
        {"+ at least 0", 1, 1, 0, 1, kNotSquare}, {"+ c<0 at 0", 1, -1, 0, 0, kPositive},
        {"+ c<0 below", 1, -1, -tiny, 0, ""}, {"+ c<0 at least 0", 1, -1, 0, 1, kPositive},
        {"+ c<0 at most 0", 1, -1, 0, -1, kNotSquare}, {"+ c 0", 1, 0, 0, 0, ""},
        {"- equality at 0", -1, 1, 0, 0, kNegative}, {"- equality below", -1, 1, -tiny, 0, ""},
        {"- at least 0", -1, 1, 0, 1, kNegative},
        {"- at least below", -1, 1, -tiny, 1, kNotSquare},
        {"- at most 0", -1, 1, 0, -1, kNotSquare}, {"- c<0 at 0", -1, -1, 0, 0, kNegative},
        {"- c<0 above", -1, -1, tiny, 0, ""}, {"- c<0 at most 0", -1, -1, 0, -1, kNegative},
        {"- c<0 at least 0", -1, -1, 0, 1, kNotSquare}, {"- c 0", -1, 0, 0, 0, ""},
        {"free", 0, 1, 0, 0, ""},
        // clang-format on
    };
    for (const auto& c : kCases) {
        SCOPED_TRACE(c.label);
        Expect(c.key, *c.key && c.key != kNotSquare,
               Problem({{{c.c}, c.relation, c.rhs}}, c.isign, true), Answering(m_handed, {0}));
    }
}

TEST_F(OptDsgn, PreCheckReadsOnlyRowsOfTheDiagonalAndYieldsToTheSwitch)
{
    // Row 1 passes on its diagonal; row 2 fails on its own, (2, 2), whatever stands at (2, 1).
    const std::vector<T_ROW_IN> second{{{1, -1}, 0, 1}, {{5, 1}, 0, -1}};
    EXPECT_EQ(0, Run(Problem(second, 1, true), Answering(m_handed, {1, 1})));
    EXPECT_EQ(TextOf(kPositive, 2), m_answer.message);
    EXPECT_EQ(2, m_answer.constraint);
    EXPECT_EQ(1, Run(Problem(second, 1, false), Answering(m_handed, {1, 1}))); // flag off
    // A second constraint on one unknown is beyond the diagonal.
    EXPECT_EQ(0, Run(Problem({{{1}, 0, 1}, {{1}, 0, -1}}, 1, true), Answering(m_handed, {1})));
    EXPECT_EQ(kNotSquare, m_answer.key);

    for (const auto& [value, result] : {std::pair{"yes", 1}, {"Yes", 0}, {"no", 0}, {"", 0}}) {
        CTestEnvMgr::SetTestEnvST("KTR_ULF_TEST", value);
        EXPECT_EQ(result, Run(Problem(second, 1, true), Answering(m_handed, {1, 1}))) << value;
    }
}

TEST_F(OptDsgn, TurnsTheSolversCodeIntoAMessage)
{
    const struct {
        int code, result;
        const char* key;
    } kCases[] = {
        {-1, 1, kObjective},
        {4, 1, "IDS_RPS_Error_code_4___The_calculation_cannot_begi"},
        {5, 1, "IDS_RPS_Error_code_5___The_equality_constraints_ar"},
        {6, 1, "IDS_RPS_Error_code_6___The_equality_constraints_an"},
        {7, 1, "IDS_RPS_Error_code_7___There_is_no_solution_vector"},
        {8, 1, "IDS_RPS_Error_code_8___Maximum_number_of_object_fu"},
        {10, 1, kNoSolution},
        {5, 0, kNoSolution},
        {0, 0, kNoSolution},
        {0, 1, ""}, // no message, and no check of the sign: the factors are negative
        {11, 1, ""},
    };
    for (const auto& c : kCases) {
        SCOPED_TRACE(c.code);
        Expect(c.key, 0, Problem({{{1, 2}, -1, 5}}, 1, false),
               Answering(m_handed, {-1, -1}, c.code, c.result));
        EXPECT_EQ(*c.key ? 0.0 : -1.0, m_answer.factors[0]);
        EXPECT_EQ(c.result ? c.code : 10, m_answer.code);
    }
}

TEST_F(OptDsgn, JudgesCode9ByTheSolution)
{
    // row 1: x1 + 2 x2 <= 5; row 2: x1 - x2 >= -1, handed negated; row 3: x1 = 0, not looked at
    const std::vector<T_ROW_IN> rows{{{1, 2}, -1, 5}, {{1, -1}, 1, -1}, {{1, 0}, 0, 0}};
    const struct {
        const char* label;
        int isign;
        std::vector<double> x;
        const char* key;
        int number;
    } kCases[] = {
        // clang-format off
        {"at the bound",      1, {1, 2},         "",        0},
        {"first row over",    1, {1.0000001, 2}, kViolated, 0},
        {"second row under",  1, {0, 1.0000001}, kViolated, 0},
        {"second negative",   1, {0, -1e-9},     kViolatedNegative, 2},
        {"first positive",   -1, {1e-9, 0},      kViolatedPositive, 1},
        {"free",              0, {1, -1},        "",        0},
        {"zero has no sign", -1, {0, 0},         "",        0},
        // clang-format on
    };
    for (const auto& c : kCases) {
        SCOPED_TRACE(c.label);
        Expect(c.key, c.number, Problem(rows, c.isign, false), Answering(m_handed, c.x, 9));
    }
    (void)Run(Problem(rows, 1, false), Answering(m_handed, {0, 1.5}, 9));
    EXPECT_EQ(2, m_answer.constraint); // by its place in the problem, not among the rows handed
}

TEST_F(OptDsgn, ExactModeIgnoresTheReturnAndChecksSigns)
{
    const std::vector<T_ROW_IN> rows{{{1, 0}, 0, 1}, {{0, 1}, 0, -1}};
    const struct {
        int isign;
        std::vector<double> x;
        const char* key;
        int number;
    } kCases[] = {
        {0, {1, -1}, "", 0},
        {1, {1, -1}, "IDS_RPS_Load_factor___d__can_be_determined_in_nega", 2},
        {-1, {1, -1}, "IDS_RPS_Load_factor___d__can_be_determined_in_posi", 1},
        {1, {0.0, -0.0}, "", 0},
        {1, {1, -1e-17}, "", 0}, // rounding of a factor that is zero
        {1, {1, -1e-9}, "IDS_RPS_Load_factor___d__can_be_determined_in_nega", 2},
    };
    for (const auto& c : kCases)
        Expect(c.key, c.number, Problem(rows, c.isign, false), Answering(m_handed, c.x, 5, 0));
}

TEST_F(OptDsgn, SurvivesASolverThatThrows)
{
    const T_OPT_PROBLEM p = Problem({{{1, 2}, -1, 5}}, 0, false);
    (void)CAppBase::TakeAssertions_ST();
    Expect(kNoSolution, 0, p, [](auto...) -> int { throw std::runtime_error("gave up"); });
    EXPECT_TRUE(CAppBase::TakeAssertions_ST().empty());
    Expect(kNoSolution, 0, p, [](auto...) -> int { throw 1; });
    EXPECT_EQ(10, m_answer.code);
    ASSERT_EQ(1u, CAppBase::TakeAssertions_ST().size());
}

TEST_F(OptDsgn, RefusesWhatItCannotHandOver)
{
    const auto refused = [&](const T_OPT_PROBLEM& p, const char* key) {
        Expect(key, 0, p, Answering(m_handed, {1, 1}));
        EXPECT_EQ(0, m_handed.calls);
        EXPECT_EQ((std::vector<double>{0, 0}), m_answer.factors);
    };
    const T_OPT_PROBLEM good = Problem({{{1, 2}, -1, 5}}, 0, false);
    T_OPT_PROBLEM p = good;
    for (p.iobj = 0; p.iobj <= 4; p.iobj += 4)
        refused(p, kObjective);
    EXPECT_TRUE(m_source.m_reads.empty()); // before any response is read
    p = good;
    p.items[1] = Known(2, 1.0); // one unknown, two announced
    refused(p, "IDS_QM_ULF_BAD_PROBLEM");
    p = good;
    p.stage = true; // no source of stage responses
    refused(p, "IDS_QM_ULF_BAD_PROBLEM");
    p = good;
    p.constraints[0][1] = 77;
    refused(p, "IDS_QM_ULF_NO_RESPONSE");
    EXPECT_NE(std::string::npos, m_answer.message.find("not in the table"));
}
