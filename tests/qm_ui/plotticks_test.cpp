#include "qm_ui/plotticks.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace {

struct T_STEP_CASE {
    const char* name;
    double span;
    int maxCount;
    int mantissa;
    int exponent10;
};
// clang-format off
const T_STEP_CASE kSteps[] = {  // smallest 1-2-5 number not below span / maxCount, by hand
    {"one",              10.0,    10, 1,   0},
    {"just over one",    10.01,   10, 2,   0},
    {"0.14 to 0.2",       1.4,    10, 2,  -1},
    {"0.25 to 0.5",       1.0,     4, 5,  -1},
    {"0.6 to 1",          3.0,     5, 1,   0},
    {"five",             50.0,    10, 5,   0},
    {"large",          4.4e6,     11, 5,   5},
    {"small",          3e-7,       3, 1,  -7},
    {"no count",          1.0,     0, 1,   0},
};

struct T_TICK_CASE {
    const char* name;
    T_PLOT_RANGE range;
    bool log;
    int maxCount;
    std::vector<double> values;
    std::vector<std::string> labels;
    int exponent10;
};
const T_TICK_CASE kTicks[] = {
    {"tenths",     {0.0, 0.5},      false,  5, {0, 0.1, 0.2, 0.3, 0.4, 0.5},
                                               {"0", "0.1", "0.2", "0.3", "0.4", "0.5"}, 0},
    {"across zero", {-1.0, 1.0},    false,  4, {-1, -0.5, 0, 0.5, 1},
                                               {"-1.0", "-0.5", "0", "0.5", "1.0"}, 0},
    {"inner only", {0.7, 3.2},      false,  3, {1, 2, 3}, {"1", "2", "3"}, 0},
    {"million",    {0.0, 3e6},      false,  3, {0, 1e6, 2e6, 3e6}, {"0", "1", "2", "3"}, 6},
    {"thousandth", {0.0, 1.5e-3},   false,  3, {0, 5e-4, 1e-3, 1.5e-3},
                                               {"0", "0.5", "1.0", "1.5"}, -3},
    {"below 1e5",  {0.0, 40000.0},  false,  2, {0, 20000, 40000}, {"0", "20000", "40000"}, 0},
    {"decades",    {0.01, 100.0},   true,   6, {0.01, 0.1, 1, 10, 100},
                                               {"0.01", "0.1", "1", "10", "100"}, 0},
    {"1-2-5",      {0.5, 20.0},     true,  10, {0.5, 1, 2, 5, 10, 20},
                                               {"0.5", "1", "2", "5", "10", "20"}, 0},
    {"every other decade", {1.0, 1e6}, true, 3, {1, 100, 1e4, 1e6},
                                               {"1", "100", "10000", "10\u2076"}, 0},
    {"narrow log", {2.0, 4.0},      true,   4, {2, 2.5, 3, 3.5, 4},
                                               {"2.0", "2.5", "3.0", "3.5", "4.0"}, 0},
};
// clang-format on

TEST(PlotTicks, StepIsTheSmallestRoundOneThatFits)
{
    for (const T_STEP_CASE& c : kSteps) {
        const T_PLOT_STEP step = NicePlotStep(c.span, c.maxCount);
        EXPECT_EQ(c.mantissa, step.mantissa) << c.name;
        EXPECT_EQ(c.exponent10, step.exponent10) << c.name;
    }
}

TEST(PlotTicks, StandAtRoundValuesWithCleanLabels)
{
    for (const T_TICK_CASE& c : kTicks) {
        const T_PLOT_TICKS ticks = MakePlotTicks(c.range, c.log, c.maxCount);
        ASSERT_EQ(c.values.size(), ticks.major.size()) << c.name;
        for (std::size_t i = 0; i < c.values.size(); ++i) {
            EXPECT_DOUBLE_EQ(c.values[i], ticks.major[i].value) << c.name;
            EXPECT_EQ(c.labels[i], ticks.major[i].label) << c.name;
        }
        EXPECT_EQ(c.exponent10, ticks.exponent10) << c.name;
    }
}

TEST(PlotTicks, MultiplesCarryNoRoundingNoise)
{
    EXPECT_EQ(0.3, (T_PLOT_STEP{1, -1}.Value(3))); // 3 * 0.1 would be 0.30000000000000004
    EXPECT_EQ(6e-5, (T_PLOT_STEP{2, -5}.Value(3)));
}

TEST(PlotTicks, LogMinorTicksAreTwoToNine)
{
    const T_PLOT_TICKS ticks = MakePlotTicks({1.0, 100.0}, true, 3);
    const std::vector<double> expected{2, 3, 4, 5, 6, 7, 8, 9, 20, 30, 40, 50, 60, 70, 80, 90};
    ASSERT_EQ(expected.size(), ticks.minor.size());
    for (std::size_t i = 0; i < expected.size(); ++i)
        EXPECT_DOUBLE_EQ(expected[i], ticks.minor[i]);
}

TEST(PlotTicks, LinearMinorTicksDivideTheStep)
{
    const T_PLOT_TICKS ticks = MakePlotTicks({0.0, 4.0}, false, 2); // steps of 2, in quarters
    const std::vector<double> expected{0.5, 1.0, 1.5, 2.5, 3.0, 3.5};
    EXPECT_EQ(expected, ticks.minor);
}

TEST(PlotTicks, NumberTextIsShort)
{
    EXPECT_EQ("0.1", PlotNumberText(0.10000000001, 6));
    EXPECT_EQ("1234.57", PlotNumberText(1234.567, 6));
    EXPECT_EQ("10\u207b\u00b9\u00b2", PowerOfTenText(-12));
}

} // namespace
