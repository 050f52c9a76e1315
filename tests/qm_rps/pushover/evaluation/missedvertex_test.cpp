#include "qm_rps/pushover/evaluation/missedvertex.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

/// A bar that yields at 100 N and 0.01 m and is pushed to 0.04 m, from 5 N and 0.003 m of its
/// initial loads, stored at these displacements.
T_RUN_DATA Bar(const std::vector<double>& stored)
{
    T_RUN_DATA run;
    run.head.control = {1.0};
    run.head.startReaction = 5.0;
    run.nodes = {7};
    run.start = {{0.003}};
    for (const double d : stored) {
        T_RUN_STEP step;
        step.displacement = 0.003 + d;
        step.baseReaction = 5.0 + std::min(d / 0.01, 1.0) * 100.0;
        run.steps.push_back(step);
        run.displacement.push_back({{0.003 + d}});
        run.states.emplace_back();
    }
    T_RUN_EVENT initial, yield, back; // the last one while strength drops
    initial.stage = -1, initial.baseReaction = 80.0;
    yield.displacement = 0.013, yield.baseReaction = 105.0;
    back.displacement = 0.010, back.baseReaction = 20.0;
    run.events = {initial, yield, back};
    return run;
}

} // namespace

// Steps at half and all of the displacement: the vertex (1/4, 1) lies aside of the line from the
// start to (1/2, 1) by (1/4) / sqrt(1/4 + 1).
TEST(MissedVertex, IsToldFromTheLineThroughTheSteps)
{
    T_MISSED_VERTEX found;
    ASSERT_EQ(1, FindMissedVertex(*MakePushRun(Bar({0.02, 0.04})), 7, found));
    EXPECT_NEAR(std::sqrt(0.05), found.share, 1e-14);
    EXPECT_NEAR(0.01, found.displacement, 1e-17);
    EXPECT_NEAR(100.0, found.baseReaction, 1e-12);
    EXPECT_EQ(2u, found.steps);
    ASSERT_EQ(1, FindMissedVertex(*MakePushRun(Bar({0.005, 0.01, 0.04})), 7, found));
    EXPECT_NEAR(0.0, found.share, 1e-14);
    EXPECT_EQ(0, FindMissedVertex(*MakePushRun(Bar({})), 7, found));
}
