// The picture of one hinge: its law by hand, the path, the place.
#include "qm_ui/push/hingelawplot.h"

#include <gtest/gtest.h>

namespace {

using POINTS = std::vector<solver::T_BACKBONE_POINT>;

POINTS Backbone(double gap, bool isFree, double factor, double upTo)
{
    solver::T_HINGE_SIDE side;
    side.points = {{0.0, 10.0}, {0.02, 12.0}, {0.03, 2.0}};
    side.gap = gap;
    side.free = isFree;
    return BackboneUpTo(side, factor, upTo);
}

/// A beam end with two steps: at 5 of 10 kN m, and flowed by 0.01 to 11.
T_PUSH_RUN OneHinge()
{
    T_PUSH_RUN run;
    run.loadFactor = {1.0, 2.0};
    run.displacement = run.baseReaction = {0.0, 0.0};
    T_PUSH_HINGE_SERIES& hinge = run.hinges.emplace_back();
    hinge.place.element = 7;
    hinge.place.end = "J";
    hinge.law.positive.points = {{0.0, 10e3}, {0.02, 12e3}};
    hinge.law.positive.marks = {0.005, 0.01, 0.015};
    hinge.law.negative.points = {{0.0, 6e3}};
    hinge.law.byAxial = {{-100e3, 20e3, 12e3}, {100e3, 0.0, 0.0}};
    hinge.deformation = {0.0, 0.01};
    hinge.force = {5e3, 11e3};
    hinge.state = {PUSH_STATE::Elastic, PUSH_STATE::LStoCP};
    run.data.hinges = {{7, 1.0, 4}};
    run.data.states = {{{0.0, 5e3, 0.0, 0}}, {{0.01, 11e3, -50e3, 1}}};
    return run;
}

} // namespace

TEST(HingeLawPlot, ABackboneGoesFromTheOriginThroughItsVerticesAndThenStays)
{
    const auto same = [](const POINTS& a, const POINTS& b) {
        ASSERT_EQ(a.size(), b.size());
        for (std::size_t i = 0; i < a.size(); ++i) {
            EXPECT_NEAR(a[i].deformation, b[i].deformation, 1e-12) << i;
            EXPECT_NEAR(a[i].force, b[i].force, 1e-12) << i;
        }
    };
    same({{0, 0}, {0, 10}, {0.02, 12}, {0.03, 2}, {0.05, 2}}, Backbone(0, false, 1.0, 0.05));
    // Cut in the middle of the second part, at half the way from 10 to 12; doubled.
    same({{0, 0}, {0, 20}, {0.01, 22}}, Backbone(0, false, 2.0, 0.01));
    same({{0, 0}, {0.1, 0}, {0.1, 10}, {0.12, 12}, {0.13, 2}}, Backbone(0.1, false, 1.0, 0.13));
    same({{0, 0}, {0.05, 0}}, Backbone(0.1, true, 1.0, 0.05)); // never bears
}

TEST(HingeLawPlot, StrengthsFollowTheAxialForceStraightAndStayBeyondTheTable)
{
    const T_PUSH_RUN run = OneHinge();
    const solver::T_HINGE_LAW& law = run.hinges[0].law;
    // 20 kN m at -100 kN, 0 at 100 kN: at 0 the 10 of the law; at -50 kN 15.
    EXPECT_NEAR(1.0, StrengthFactor(law, true, 0.0), 1e-12);
    EXPECT_NEAR(1.5, StrengthFactor(law, true, -50e3), 1e-12);
    EXPECT_NEAR(2.0, StrengthFactor(law, false, -500e3), 1e-12);
    EXPECT_NEAR(0.0, StrengthFactor(law, true, 500e3), 1e-12);
    EXPECT_EQ(1.0, StrengthFactor({}, true, -50e3));
}

TEST(HingeLawPlot, ThePathEndsAtTheStepInCurrentUnitsWithItsState)
{
    const T_PUSH_RUN run = OneHinge();
    const T_UNITS units{FORCE_UNIT::kN, LENGTH_UNIT::m};
    const T_PLOT plot = HingeLawPlot(run, 0, 2, units);
    ASSERT_EQ(3U, plot.series.size());
    EXPECT_NEAR(15.0, plot.series[0].y[1], 1e-9); // yield at the axial force of the step
    EXPECT_NEAR(-9.0, plot.series[1].y[1], 1e-9);
    EXPECT_EQ((std::vector<double>{0.0, 0.01}), plot.series[2].x);
    EXPECT_NEAR(11.0, plot.series[2].y.back(), 1e-9);
    ASSERT_EQ(1U, plot.labels.size());
    EXPECT_EQ("LS-CP", plot.labels[0].text);
    ASSERT_EQ(3U, plot.guides.size());
    EXPECT_EQ("LS", plot.guides[1].label);
    EXPECT_NE(std::string::npos, plot.y.title.find("kN m"));
    EXPECT_EQ(1U, HingeLawPlot(run, 0, 1, units).series[2].x.size());
    EXPECT_TRUE(HingeLawPlot(run, 1, 1, units).series.empty()); // there is no such hinge
}
