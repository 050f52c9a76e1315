#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "twotrusses.h"

#include <gtest/gtest.h>

TEST(StageProblem, MovesKnownRowsAndReadsConstraintsAtTheirPlace)
{
    T_ULSI_D item;
    item.rows = {{1, 1, 5, false, 0.5, 9, false, 0},
                 {2, kStageLastStep, 6, true, 3, 2, true, 2},
                 {2, 1, 8, false, 0.0, 1, false, 1}}; // known with 0: no part in it
    T_ULFC_D c;
    c.id = 4, c.inequality = true, c.upper = 2.0, c.lower = -1.0;
    c.stage = 3, c.step = 2;
    const T_ULF_STAGE_FORMED f = FormUlfStageProblem(item, {&c, 1});
    EXPECT_EQ((std::vector<T_OPT_ITEM>{{1001, 0.5, 1, 0}, {2000, 0, 2, 2}}), f.problem.items);
    EXPECT_EQ((std::vector<int>{5, 6}), f.loads);
    EXPECT_EQ(1, f.problem.nvar);
    EXPECT_TRUE(f.problem.stage);
    EXPECT_EQ((std::vector<T_OPT_RECORD>{{1, 4, 1, 2, -1, 1, 0, 0, 3002},
                                         {1, 4, 1, -1, 1, 1, 0, 0, 3002}}),
              f.problem.constraints);
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
    T_ULSI_ROW row{1, 2, 7, true, 1, 1, true, kLoadGroupRest};
    EXPECT_EQ((std::vector<int>{7}), LoadsScaledBy(model, row));
    row.loadGroup = kLoadGroupDead;
    EXPECT_EQ((std::vector<int>{1, 2}), LoadsScaledBy(model, row));
    row.pretension = false;
    EXPECT_TRUE(LoadsScaledBy(model, row).empty());
}
