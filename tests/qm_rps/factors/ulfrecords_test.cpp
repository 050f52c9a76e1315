#include "ulfsample.h"

#include "qm_rps/factors/ulfinfluencecache.h"
#include "qm_rps/factors/ulfresult.h"
#include "qm_rps/factors/ulftexts.h"

#include <gtest/gtest.h>

namespace {

T_ULFC_D Constraint(ULFC_TYPE type)
{
    T_ULFC_D c;
    c.name = "C";
    c.type = type;
    c.id = 7;
    c.position = 3;
    c.component = 4;
    c.value = 2.5;
    c.otherId = 9;
    return c;
}

T_ULFC_D Bounded(std::optional<double> upper, std::optional<double> lower)
{
    T_ULFC_D c = Constraint(ULFC_TYPE::Displacement);
    c.inequality = true;
    c.compareWithValue = false; // has no meaning here
    c.upper = upper;
    c.lower = lower;
    return c;
}

} // namespace

TEST(UlfRecords, FollowTheTypeAndTheBounds)
{
    T_ULFC_D compared = Constraint(ULFC_TYPE::Beam);
    compared.compareWithValue = false;
    using R = std::vector<T_OPT_RECORD>;
    const struct {
        const char* label;
        T_ULFC_D constraint;
        R records;
    } kCases[] = {
        {"displacement", Constraint(ULFC_TYPE::Displacement), R{{1, 7, 5, 2.5, 0, 1, 9, 0}}},
        {"truss", Constraint(ULFC_TYPE::Truss), R{{3, 7, 5, 2.5, 0, 1, 9, 0}}},
        {"beam", Constraint(ULFC_TYPE::Beam), R{{4, 7, 4, 5, 2.5, 0, 1, 9}}},
        {"compared", compared, R{{4, 7, 4, 5, 2.5, 0, 0, 9}}},
        {"upper", Bounded(3, {}), R{{1, 7, 5, 3, -1, 1, 9, 0}}},
        {"lower", Bounded({}, -3), R{{1, 7, 5, -3, 1, 1, 9, 0}}},
        {"both", Bounded(3, -3), R{{1, 7, 5, 3, -1, 1, 9, 0}, {1, 7, 5, -3, 1, 1, 9, 0}}},
    };
    for (const auto& c : kCases)
        EXPECT_EQ(c.records, UlfConstraintRecords(c.constraint)) << c.label;
}

TEST(UlfRecords, CountBothBoundsAndLeaveOutCasesWithoutEffect)
{
    T_ULFI_D item;
    item.objective = 2;
    item.sign = 0;
    item.solveByEquations = true;
    const std::vector<T_ULF_CASE> cases{
        {1, "G", 1.0}, {2, "S1", 1.0, true, 2.0}, {3, "Q", 0.0}, {4, "S2", 1.0, true}};
    const std::vector<T_ULFC_D> constraints{Bounded(3, -3), Bounded(1, {})};
    const T_ULF_FORMED f = FormUlfProblem(item, cases, constraints);
    EXPECT_EQ((std::vector<T_OPT_ITEM>{{1, 1, 1, 0}, {2, 0, 2, 0}, {4, 0, 1, 0}}), f.problem.items);
    EXPECT_EQ(2, f.problem.nvar);
    EXPECT_EQ((std::vector<std::size_t>{0, 0, 1}), f.owner);
    EXPECT_EQ((std::vector<std::size_t>{1, 3}), f.unknowns);
    EXPECT_EQ(3, f.problem.iobj);
    EXPECT_EQ(-1, f.problem.isign);
    EXPECT_TRUE(f.problem.solveByEquations);
}

TEST(UlfCache, ReadsEachQuantityOfEachCaseOnceUntilTheRevisionChanges)
{
    CTableResponse source;
    source.m_table = {{{1, 1, 0, 1}, {1, 2, 3}}, {{1, 2, 0, 1}, {4, 5, 6}}};
    std::uint64_t revision = 5;
    CUlfInfluenceCache cache(source, [&] { return revision; });
    const auto read = [&](std::vector<T_OPT_ITEM> items, std::vector<T_OPT_QUANTITY> what) {
        std::vector<double> out(items.size() * what.size());
        EXPECT_EQ(1, cache.Read(items, what, out));
        return out;
    };
    const T_OPT_QUANTITY at1{1, 1, 0, 1}, at2{1, 2, 0, 1};
    EXPECT_EQ((std::vector<double>{1, 2, 1, 2}), read({{1}, {2}}, {at1, at1})); // both bounds
    source.m_table[at1] = {7, 8, 9};
    EXPECT_EQ((std::vector<double>{6, 5, 9, 2}), read({{3}, {2}}, {at2, at1})); // 2 as read before
    ++revision;
    EXPECT_EQ((std::vector<double>{8}), read({{2}}, {at1}));
}

TEST(UlfResult, TellsResidualsAndActiveBounds)
{
    // Two cases with factors 2 and -1; value = 2 a - b.
    T_ULF_RESULT r;
    r.cases = {{1, "A", 2, true, 3.0}, {2, "B", -1}};
    r.factors = {2, -1};
    const struct {
        const char* label;
        T_ULFC_D constraint;
        std::vector<double> influence;
        double value, residual;
        bool active, met;
    } kCases[] = {
        {"inside", Bounded(5, -5), {1, 1}, 1, 0, false, true},
        {"upper", Bounded(1, -5), {1, 1}, 1, 0, true, true},
        {"lower", Bounded({}, 1), {1, 1}, 1, 0, true, true},
        {"over", Bounded(0.5, {}), {1, 1}, 1, 0.5, true, false},
        {"under", Bounded(5, 4), {1, 1}, 1, -3, true, false},
        {"equality met", Constraint(ULFC_TYPE::Reaction), {1, -0.5}, 2.5, 0, true, true},
        {"missed by 0.9e-6 of 3", Bounded(1 - 2.7e-6, {}), {1, 1}, 1, 2.7e-6, true, true},
        {"missed by 1.1e-6 of 3", Bounded(1 - 3.3e-6, {}), {1, 1}, 1, 3.3e-6, true, false},
        {"near, not at", Bounded(1 + 4e-8, {}), {1, 1}, 1, 0, false, true},
    };
    for (const auto& c : kCases) {
        r.constraints = {UlfResultConstraint(c.constraint)};
        r.influence = {c.influence};
        const T_ULF_RESULT_ROW row = UlfResultRows(r).at(0);
        EXPECT_DOUBLE_EQ(c.value, row.value) << c.label;
        EXPECT_NEAR(c.residual, row.residual, 1e-14) << c.label;
        EXPECT_EQ(c.active, row.active) << c.label;
        EXPECT_EQ(c.met, row.met) << c.label;
    }
    EXPECT_EQ(6.0, UlfObjective(r)); // known cases do not count
    r.cases[1].unknown = true;
    for (const auto& [objective, value] : {std::pair{0, 7.0}, {1, 37.0}, {2, 6.0}}) {
        r.item.objective = objective;
        EXPECT_EQ(value, UlfObjective(r));
    }
}

TEST(UlfTexts, DescribeEveryKindOfConstraint)
{
    T_ULFC_D beam = Constraint(ULFC_TYPE::Beam), node = Constraint(ULFC_TYPE::Reaction);
    EXPECT_EQ("MY of node 7 =      2.5000", UlfDescription(node));
    node.compareWithValue = beam.compareWithValue = false;
    EXPECT_EQ("MY of node 7 = that of node 9", UlfDescription(node));
    EXPECT_EQ("Moment y of beam 7 at 3/4 = that of element 9", UlfDescription(beam));
    EXPECT_EQ("RY of node 7 <=      3.0000 >=     -3.0000", UlfDescription(Bounded(3, -3)));
    EXPECT_EQ("Axial force of truss 7 =      2.5000", UlfDescription(Constraint(ULFC_TYPE::Truss)));
}
