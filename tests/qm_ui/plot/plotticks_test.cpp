#include "qm_ui/plot/plotticks.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

// clang-format off
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

} // namespace
