#include "qm_ui/plot/plotgeometry.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <map>

namespace {

// Lowest and highest y in each pixel column, worked out apart from the code under test.
std::map<double, std::pair<double, double>> Extremes(const PLOT_RUN& run)
{
    std::map<double, std::pair<double, double>> out;
    for (const T_PLOT_PX& p : run) {
        const auto [it, isNew] = out.try_emplace(std::floor(p.x), p.y, p.y);
        it->second.first = std::min(it->second.first, p.y);
        it->second.second = std::max(it->second.second, p.y);
    }
    return out;
}

PLOT_RUN Noise(int count, double width)
{
    PLOT_RUN run;
    for (int i = 0; i < count; ++i)
        run.push_back({width * i / count, 100.0 + 20.0 * std::sin(0.37 * i)});
    return run;
}

TEST(PlotGeometry, DecimationKeepsASpikeAndStaysBounded)
{
    PLOT_RUN run = Noise(100000, 800.0);
    run[61234].y = -5000.0;
    const PLOT_RUN thin = DecimateRun(run, 1.0);
    EXPECT_LE(thin.size(), 4u * 800u);
    EXPECT_EQ(1, std::count(thin.begin(), thin.end(), run[61234]));
    EXPECT_EQ(Extremes(run), Extremes(thin));
    EXPECT_EQ(run.front(), thin.front());
    EXPECT_EQ(run.back(), thin.back());
    EXPECT_TRUE(std::is_sorted(thin.begin(), thin.end(),
                               [](const T_PLOT_PX& a, const T_PLOT_PX& b) { return a.x < b.x; }));
}

TEST(PlotGeometry, ClipCutsAtTheEdges)
{
    const T_PLOT_BOX box{0, 0, 10, 10};
    T_PLOT_PX a{-5, 5};
    T_PLOT_PX b{15, 5};
    ASSERT_TRUE(ClipSegment(box, a, b));
    EXPECT_EQ((T_PLOT_PX{0, 5}), a);
    EXPECT_EQ((T_PLOT_PX{10, 5}), b);
    a = {-4, 8}; // slope 1: enters at (0, 12), so it misses
    b = {8, 20};
    EXPECT_FALSE(ClipSegment(box, a, b));
    EXPECT_EQ((T_PLOT_PX{-4, 8}), a);
    a = {5, 20}; // parallel to an edge, outside
    b = {6, 20};
    EXPECT_FALSE(ClipSegment(box, a, b));
}

TEST(PlotGeometry, ClippedRunComesBackInParts)
{
    const T_PLOT_BOX box{0, 0, 10, 10};
    const PLOT_RUN run{{1, 5}, {3, 15}, {5, 5}, {6, 6}, {30, 6}};
    const std::vector<PLOT_RUN> parts = ClipRun(box, run);
    ASSERT_EQ(2u, parts.size());
    EXPECT_EQ((PLOT_RUN{{1, 5}, {2, 10}}), parts[0]);
    EXPECT_EQ((PLOT_RUN{{4, 10}, {5, 5}, {6, 6}, {10, 6}}), parts[1]);
}

} // namespace
