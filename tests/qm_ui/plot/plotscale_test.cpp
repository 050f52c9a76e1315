#include "qm_ui/plot/plotscale.h"

#include "numbers.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

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

struct T_RANGE_CASE {
    const char* name;
    std::vector<double> values;
    bool log;
    T_PLOT_RANGE expected;
};
// clang-format off
const T_RANGE_CASE kRanges[] = {  // air of 4 % of the span, then up to half a step, by hand
    {"from zero",     {0.0, 0.9},          false, {0.0, 0.95}},   // step 0.1; 0.936
    {"far from zero", {100.0, 110.0},      false, {99.5, 110.5}}, // step 1; 99.6 and 110.4
    {"both signs",    {-1.0, 1.0},         false, {-1.1, 1.1}},   // step 0.2; 1.08
    {"bad ignored",   {kNan, 0.0, kInf, 0.9}, false, {0.0, 0.95}},
    {"nothing",       {kNan},              false, {0.0, 1.0}},
    {"log",           {0.03, 70.0},        true,  {0.02, 100.0}},
    {"log one value", {2.0},               true,  {1.0, 4.0}},
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

} // namespace
