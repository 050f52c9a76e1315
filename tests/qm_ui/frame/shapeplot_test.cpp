// Deformed shapes: the cubic of a member, the view, the scale.
#include "plotmeasure.h"
#include "qm_ui/frame/shapeplot.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

T_SHAPE Beam(std::array<double, 6> di, std::array<double, 6> dj)
{
    T_SHAPE s;
    s.lengthUnit = "m";
    s.nodes = {{1, {0, 0, 0}, true}, {2, {8, 0, 0}, false}};
    s.members.push_back({0, 1});
    s.states.push_back({"loaded", {di, dj}});
    return s;
}

/// Points of the only member with displacements as they are.
std::vector<std::array<double, 3>> Points(const T_SHAPE& s)
{
    return MemberShape(s, s.members[0], &s.states[0], 1.0, 5);
}

TEST(MemberShape, FollowsTheExactCubicOfACantilever)
{
    // Tip load: w(x) = P x^2 (3 L - x) / (6 EI), slope P L^2 / (2 EI); dw/dx = -RY. P / EI = 1e-3.
    const double L = 8.0, tip = 1e-3 * L * L * L / 3.0, slope = 1e-3 * L * L / 2.0;
    const auto points = Points(Beam({}, {0, 0, tip, 0, -slope, 0}));
    for (std::size_t n = 0; n < points.size(); ++n) {
        const double x = L * static_cast<double>(n) / 4.0;
        EXPECT_NEAR(x, points[n][0], 1e-14);
        EXPECT_NEAR(1e-3 * x * x * (3.0 * L - x) / 6.0, points[n][2], 1e-14) << x;
    }
    const auto sideways = Points(Beam({}, {0, tip, 0, 0, 0, slope})); // dv/dx = +RZ
    EXPECT_NEAR(1e-3 * 16.0 * 20.0 / 6.0, sideways[2][1], 1e-14);
}

TEST(MemberShape, APinnedEndTakesTheTurnThatNeedsNoMoment)
{
    // Propped: end I turns by t, end J pinned and held. Moment-free at J: w(x) with w'' = 0 there.
    T_SHAPE s = Beam({0, 0, 0, 0, -0.03, 0}, {0, 0, 0, 0, 0.5, 0});
    s.members[0].pinJ = true;
    const auto p = Points(s); // w = t x (1 - x/L) (2 - x/L) / 2
    EXPECT_NEAR(0.03 * 4.0 * 0.5 * 1.5 / 2.0, p[2][2], 1e-14);
    s.members[0].pinI = true;
    EXPECT_NEAR(0.0, Points(s)[2][2], 1e-14) << "a straight line";
    s.members[0] = {0, 1, false};
    EXPECT_NEAR(0.0, Points(s)[2][2], 1e-14) << "a truss is straight";
}

TEST(MemberShape, ARigidOffsetTurnsWithItsNode)
{
    T_SHAPE s = Beam({0, 0, 0, 0, 0.01, 0}, {});
    s.members[0].offsetI = {0, 0, 0.5};
    const auto p = Points(s);
    EXPECT_NEAR(0.01 * 0.5, p[0][0], 1e-15) << "theta cross offset";
    EXPECT_NEAR(0.5, p[0][2], 1e-15);
    EXPECT_TRUE(MemberShape(s, {0, 7}, nullptr, 0.0, 3).empty()) << "no such node";
}

TEST(ShapePlot, APlaneFrameIsDrawnInItsPlane)
{
    const auto titles = [](const T_SHAPE& s) {
        const T_PLOT plot = ShapePlot(s);
        return plot.x.title + "|" + plot.y.title;
    };
    T_SHAPE s = Beam({}, {0, 0, 0.1, 0, 0, 0});
    EXPECT_EQ("X (m)|Z (m)", titles(s));
    s.states[0].displacement[1] = {0, 0.1, 0, 0, 0, 0};
    EXPECT_EQ("X (m)|Y (m)", titles(s)) << "it moves in that plane";
    s.nodes[1].xyz = {0, 8, 3};
    EXPECT_EQ("Y (m)|Z (m)", titles(s));
    s.states[0].displacement[1] = {0.1, 0.1, 0, 0, 0, 0};
    EXPECT_EQ("Isometric projection; lengths in m|", titles(s)) << "it leaves the plane";
}

TEST(ShapePlot, OneRoundScaleForAllStatesStandsInTheLegend)
{
    T_SHAPE s = Beam({}, {0, 0, 0.003, 0, 0, 0});
    s.states.push_back({"tuned", {{}, {0, 0, -0.001, 0, 0, 0}}});
    const T_PLOT plot = ShapePlot(s); // a tenth of 8 m over 3 mm is 267: 200
    ASSERT_LE(3U, plot.series.size());
    EXPECT_EQ("loaded, displacements \u00d7 200", plot.series[1].name);
    EXPECT_EQ("tuned, displacements \u00d7 200", plot.series[2].name);
    EXPECT_NEAR(0.6, plot.series[1].y[plot.series[1].y.size() - 2], 1e-12);
    EXPECT_EQ("loaded: largest displacement 0.003 m at node 2", plot.notes[0]);
    s.states[0].displacement.pop_back();
    EXPECT_EQ("tuned, displacements \u00d7 500", ShapePlot(s).series[1].name)
        << "a state that does not fit is left out";
}

TEST(ShapePlot, ScalesAreEqualInBothDirections)
{
    T_SHAPE s = Beam({}, {0, 0, 0.1, 0, 0, 0});
    for (const double height : {0.1, 8.0, 300.0}) {
        s.nodes[1].xyz[2] = height;
        const T_PLOT plot = ShapePlot(s);
        const T_PLOT_LAYOUT out = LayoutOf(plot);
        const double right = out.x.ToPixel(1.0) - out.x.ToPixel(0.0);
        const double up = out.y.ToPixel(0.0) - out.y.ToPixel(1.0);
        EXPECT_NEAR(right, up, 1e-9 * right) << height;
        for (const T_PLOT_SERIES& line : plot.series) {
            for (std::size_t i = 0; i < line.x.size(); ++i) {
                const T_PLOT_PX at{out.x.ToPixel(line.x[i]), out.y.ToPixel(line.y[i])};
                EXPECT_TRUE(!std::isfinite(line.x[i]) || out.area.Holds(at)) << height;
            }
        }
    }
}

} // namespace
