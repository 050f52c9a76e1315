#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulfstageresponse.h"
#include "qm_rps/optdsgn.h"
#include "twotrusses.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace {

/// Answers stage load (100 sum of all, 200 dead, 300 erection, else the load case), plus stage and
/// step, and tells what was selected.
class CNumberResults : public IUlfStageResults {
public:
    int m_selections = 0;
    bool m_fail = false;
    int SelectSum(const std::string& name, int stage, int step) override
    {
        m_value = name == "Sum of the stage loads"        ? 100
                  : name == "Dead load of the stages"     ? 200
                  : name == "Erection load of the stages" ? 300
                                                          : -1;
        return Select(stage, step);
    }
    int SelectCase(int loadCase, int stage, int step) override
    {
        m_value = loadCase;
        return Select(stage, step);
    }
    int ReadOne(const T_OPT_QUANTITY& what, double& out) override
    {
        out = m_value + 1000 * what.component;
        return m_fail ? 0 : 1;
    }
    std::string Error() const override { return "no results"; }

private:
    int Select(int stage, int step)
    {
        ++m_selections;
        m_value += stage * 10 + (step == kStageLastStep ? 0.5 : step);
        return 1;
    }
    double m_value = 0.0;
};

std::vector<double> Column(CUlfStageResponse& source, int group, int at)
{
    source.m_loads = {7};
    const T_OPT_ITEM item{double(UlfStageNumber(3, 2)), 0, 1, double(group)};
    const T_OPT_QUANTITY what{1, 5, 0, 1, at};
    std::vector<double> out(1);
    EXPECT_EQ(1, source.Read({&item, 1}, {&what, 1}, out));
    return out;
}

} // namespace

TEST(StageResponse, ReadsTheStageLoadOfTheLoadGroup)
{
    CNumberResults results;
    CUlfStageResponse source(results);
    // Component 1 gives 1000; stage 3 and step 2 give 32.
    EXPECT_EQ(1232, Column(source, 0, 0)[0]);
    EXPECT_EQ(1232, Column(source, 1, 0)[0]); // the dead load, not the erection load
    EXPECT_EQ(1039, Column(source, 2, 0)[0]); // its own load, key 7
    source.m_sumStageLoads = true;
    EXPECT_EQ(1132, Column(source, 0, 0)[0]);
    EXPECT_EQ(1132, Column(source, 1, 0)[0]);
    EXPECT_EQ(1039, Column(source, 2, 0)[0]);
    results.m_selections = 0;
    EXPECT_EQ(0, Column(source, 3, 0)[0]);
    EXPECT_EQ(0, Column(source, -1, 0)[0]);
    EXPECT_EQ(0, results.m_selections);
}

TEST(StageResponse, ReadsAConstraintAtItsOwnStageAndStep)
{
    CNumberResults results;
    CUlfStageResponse source(results);
    EXPECT_EQ(1251, Column(source, 0, UlfStageNumber(5, 1))[0]);
    EXPECT_EQ(1250.5, Column(source, 0, UlfStageNumber(5, kStageLastStep))[0]);
}

TEST(StageResponse, SelectsEachStageLoadAndPlaceOnce)
{
    CNumberResults results;
    CUlfStageResponse source(results);
    source.m_loads = {7, 8};
    const T_OPT_ITEM items[] = {{1001, 0, 1, 2}, {2000, 0, 1, 2}};
    const T_OPT_QUANTITY what[] = {{1, 5, 0, 1}, {1, 5, 0, 2, 4001}, {1, 6, 0, 3}};
    std::vector<double> out(6);
    ASSERT_EQ(1, source.Read(items, what, out));
    EXPECT_EQ((std::vector<double>{1018, 1028.5, 2048, 2049, 3018, 3028.5}), out);
    EXPECT_EQ(4, results.m_selections);
    results.m_fail = true;
    EXPECT_EQ(0, source.Read(items, what, out));
    EXPECT_EQ("no results", source.Error());
}

TEST(StageResponse, NumbersStagesAndStepsBothWays)
{
    for (const int step : {1, 2, 999, kStageLastStep}) {
        const int number = UlfStageNumber(12, step);
        EXPECT_EQ(12, StageOfUlfNumber(number));
        EXPECT_EQ(step, StepOfUlfNumber(number));
    }
    EXPECT_EQ(12000, UlfStageNumber(12, kStageLastStep));
}

TEST(StageProblem, MovesKnownRowsAndReadsConstraintsAtTheirPlace)
{
    T_ULSI_D item;
    item.rows = {{1, 1, 5, false, 0.5, 9, false, 0},
                 {2, kStageLastStep, 6, true, 3, 2, true, 2},
                 {2, 1, 8, false, 0.0, 1, false, 1}}; // known with 0: no part in it
    T_ULFC_D c;
    c.id = 4;
    c.inequality = true;
    c.upper = 2.0;
    c.lower = -1.0;
    c.stage = 3;
    c.step = 2;
    const T_ULF_STAGE_FORMED f = FormUlfStageProblem(item, {&c, 1});
    ASSERT_EQ(2U, f.problem.items.size());
    EXPECT_EQ((T_OPT_ITEM{1001, 0.5, 1, 0}), f.problem.items[0]);
    EXPECT_EQ((T_OPT_ITEM{2000, 0, 2, 2}), f.problem.items[1]);
    EXPECT_EQ((std::vector<int>{5, 6}), f.loads);
    EXPECT_EQ(1, f.problem.nvar);
    EXPECT_TRUE(f.problem.stage);
    ASSERT_EQ(2U, f.problem.constraints.size());
    EXPECT_EQ((T_OPT_RECORD{1, 4, 1, 2, -1, 1, 0, 0, 3002}), f.problem.constraints[0]);
    EXPECT_EQ((T_OPT_RECORD{1, 4, 1, -1, 1, 1, 0, 0, 3002}), f.problem.constraints[1]);
}

TEST(StageProblem, ScalesItsOwnLoadOrAllThatActAtItsStep)
{
    T_MODEL model = two::Content().model;
    model.stages[1].steps = 3;
    model.stages[1].activate.loads = {{1, 1}, {2, 2}, {3, kStageLastStep}};
    model.stages[1].deactivate.loads = {{1, 3}};
    EXPECT_EQ((std::vector<int>{1}), LoadsActingAt(model, 1, 1));
    EXPECT_EQ((std::vector<int>{1, 2}), LoadsActingAt(model, 1, 2));
    EXPECT_EQ((std::vector<int>{2, 3}), LoadsActingAt(model, 1, kStageLastStep));
    EXPECT_EQ((std::vector<int>{}), LoadsActingAt(model, 1, 4));
    T_ULSI_ROW row{1, 2, 7, true, 1, 1, true, kLoadGroupRest};
    EXPECT_EQ((std::vector<int>{7}), LoadsScaledBy(model, row));
    row.loadGroup = kLoadGroupDead;
    EXPECT_EQ((std::vector<int>{1, 2}), LoadsScaledBy(model, row));
    row.pretension = false;
    EXPECT_TRUE(LoadsScaledBy(model, row).empty());
}
