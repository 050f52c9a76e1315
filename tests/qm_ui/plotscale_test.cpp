#include "qm_ui/plotscale.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace {

constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

TEST(PlotScale, MapsEndsAndMiddle)
{
    const CPlotScale linear({10.0, 30.0}, false, 100.0, 500.0);
    EXPECT_DOUBLE_EQ(100.0, linear.ToPixel(10.0));
    EXPECT_DOUBLE_EQ(300.0, linear.ToPixel(20.0));
    EXPECT_DOUBLE_EQ(500.0, linear.ToPixel(30.0));
    const CPlotScale log({0.01, 100.0}, true, 500.0, 100.0); // upside down, as on a screen
    EXPECT_NEAR(500.0, log.ToPixel(0.01), 1e-9);
    EXPECT_NEAR(300.0, log.ToPixel(1.0), 1e-9);
    EXPECT_NEAR(200.0, log.ToPixel(10.0), 1e-9);
}

TEST(PlotScale, PixelsComeBackAsTheirValues)
{
    for (const bool log : {false, true}) {
        const CPlotScale scale({0.02, 350.0}, log, 640.0, 12.0);
        for (double px = -100.0; px <= 800.0; px += 37.0)
            EXPECT_NEAR(px, scale.ToPixel(scale.ToValue(px)), log && px > 640.0 ? 1e-6 : 1e-8)
                << log;
        for (const double v : {0.02, 0.5, 7.0, 349.0})
            EXPECT_NEAR(v, scale.ToValue(scale.ToPixel(v)), 1e-10 * 350.0) << log;
    }
}

TEST(PlotScale, ShowsOnlyValuesWithAPlaceOnTheAxis)
{
    EXPECT_TRUE(CPlotScale::CanShow(-1.0, false));
    EXPECT_TRUE(CPlotScale::CanShow(0.0, false));
    EXPECT_FALSE(CPlotScale::CanShow(0.0, true));
    EXPECT_FALSE(CPlotScale::CanShow(-1.0, true));
    for (const bool log : {false, true}) {
        EXPECT_FALSE(CPlotScale::CanShow(kNan, log));
        EXPECT_FALSE(CPlotScale::CanShow(kInf, log));
        EXPECT_FALSE(CPlotScale::CanShow(1e300, log));
    }
    EXPECT_FALSE(CPlotScale::IsUsable({2.0, 1.0}, false));
    EXPECT_FALSE(CPlotScale::IsUsable({1.0, 1.0 + 1e-14}, false));
    EXPECT_FALSE(CPlotScale::IsUsable({0.0, 1.0}, true));
}

TEST(PlotScale, ZoomKeepsTheValueAtItsPixel)
{
    const CPlotScale linear({0.0, 10.0}, false, 0.0, 1000.0);
    const T_PLOT_RANGE r = linear.RangeWithValueAt(4.0, 400.0, 0.5);
    EXPECT_DOUBLE_EQ(2.0, r.lo); // 4 - 0.4 * 5
    EXPECT_DOUBLE_EQ(7.0, r.hi); // 4 + 0.6 * 5
    const CPlotScale log({1.0, 1e4}, true, 0.0, 400.0);
    const T_PLOT_RANGE q = log.RangeWithValueAt(100.0, 200.0, 0.5);
    EXPECT_NEAR(10.0, q.lo, 1e-9);
    EXPECT_NEAR(1000.0, q.hi, 1e-7);
}

TEST(PlotScale, ZoomStopsBeforeDoublesRunOut)
{
    CPlotScale scale({0.0, 10.0}, false, 0.0, 1000.0);
    for (int i = 0; i < 200; ++i)
        scale = CPlotScale(scale.RangeWithValueAt(4.0, 400.0, 0.5), false, 0.0, 1000.0);
    EXPECT_TRUE(CPlotScale::IsUsable(scale.Range(), false));
    EXPECT_LT(scale.Range().hi - scale.Range().lo, 1e-8);
}

struct T_RANGE_CASE {
    const char* name;
    std::vector<double> values;
    bool log;
    T_PLOT_RANGE expected;
};
// clang-format off
const T_RANGE_CASE kRanges[] = {  // air of 4 % of the span, then up to half a step, by hand
    {"from zero",     {0.0, 0.9},          false, {0.0, 0.95}},   // step 0.1; 0.936
    {"near zero",     {0.2, 0.9},          false, {0.0, 0.95}},   // span 0.7, step 0.1; 0.936
    {"far from zero", {100.0, 110.0},      false, {99.5, 110.5}}, // step 1; 99.6 and 110.4
    {"both signs",    {-1.0, 1.0},         false, {-1.1, 1.1}},   // step 0.2; 1.08
    {"bad ignored",   {kNan, 0.0, kInf, 0.9}, false, {0.0, 0.95}},
    {"nothing",       {kNan},              false, {0.0, 1.0}},
    {"log",           {0.03, 70.0},        true,  {0.02, 100.0}},
    {"log at round",  {0.01, 10.0},        true,  {0.01, 10.0}},
    {"log one value", {2.0},               true,  {1.0, 4.0}},
    {"log nothing",   {-1.0, 0.0},         true,  {1.0, 10.0}},
};
// clang-format on

TEST(PlotScale, AutoRangeIsRoundAndHoldsTheData)
{
    for (const T_RANGE_CASE& c : kRanges) {
        const T_PLOT_RANGE r = AutoPlotRange(c.values, c.log);
        EXPECT_NEAR(c.expected.lo, r.lo, 1e-9) << c.name;
        EXPECT_NEAR(c.expected.hi, r.hi, 1e-9) << c.name;
    }
}

TEST(PlotScale, AutoRangeOfEqualValuesIsNotEmpty)
{
    for (const double v : {0.0, 5.0, -5.0, 1e-20, 1e20}) {
        const T_PLOT_RANGE r = AutoPlotRange({v, v}, false);
        EXPECT_LE(r.lo, v);
        EXPECT_GE(r.hi, v);
        EXPECT_TRUE(CPlotScale::IsUsable(r, false)) << v;
    }
}

} // namespace
