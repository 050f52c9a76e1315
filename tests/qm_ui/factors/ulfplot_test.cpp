// The picture of constraint values against their bounds.
#include "numbers.h"
#include "plotmeasure.h"
#include "qm_ui/factors/ulfplot.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

TEST(UlfPosition, IsOneOnTheUpperAndMinusOneOnTheLowerBound)
{
    const struct {
        const char* label;
        double value, upper, lower, position; // not a number: no bound
    } kRows[] = {
        {"on upper", 0.01, 0.01, -0.03, 1.0},
        {"on lower", -0.03, 0.01, -0.03, -1.0},
        {"middle", -0.01, 0.01, -0.03, 0.0},
        {"beyond", 0.02, 0.01, -0.03, 1.5},
        {"upper alone", 500.0, 2000.0, kNan, 0.25},
        {"upper below zero", -300.0, -200.0, kNan, 0.5},
        {"upper below zero, missed", -100.0, -200.0, kNan, 1.5},
        {"lower alone", -450.0, kNan, -900.0, -0.5},
        {"on a bound of zero", 0.0, 0.0, kNan, 1.0},
        {"past a bound of zero", 5.0, 0.0, kNan, 2.0},
        {"equality met", 7.0, 7.0, 7.0, 0.0},
        {"equality missed", 7.7, 7.0, 7.0, 0.7 / 7.7},
        {"equality with zero met", 0.0, 0.0, 0.0, 0.0},
    };
    for (const auto& row : kRows) {
        T_ULF_BAR bar;
        bar.value = row.value;
        if (row.upper == row.upper) bar.upper = row.upper;
        if (row.lower == row.lower) bar.lower = row.lower;
        EXPECT_NEAR(row.position, UlfPosition(bar), 1e-14) << row.label;
    }
}

TEST(UlfPlot, HasARowForEachConstraintThatNothingCovers)
{
    for (const std::size_t count : {std::size_t{1}, std::size_t{8}, std::size_t{60}}) {
        T_ULF_PICTURE picture;
        for (std::size_t i = 0; i < count; ++i) {
            T_ULF_BAR bar{"C" + std::to_string(i), "kN", static_cast<double>(i), 40.0, -40.0};
            bar.violated = i > 40;
            bar.active = i == 40;
            picture.bars.push_back(bar);
        }
        const T_PLOT plot = UlfPlot(picture);
        const T_PLOT_LAYOUT out = LayoutOf(plot, {}, {0, 0, 960, plot.pageHeight});
        ASSERT_EQ(count, out.yTicks.major.size());
        ASSERT_TRUE(out.legend);
        double lowest = 0.0;
        for (const T_PLOT_TICK& tick : out.yTicks.major) {
            const double y = out.y.ToPixel(tick.value);
            EXPECT_TRUE(lowest == 0.0 || std::fabs(y - lowest) >= 1.3 * CPlotLayout::kTextPx);
            lowest = y;
            EXPECT_GT(y, out.legend->box.Bottom()) << tick.label;
        }
        std::size_t texts = 0;
        for (const T_PLOT_TEXT& text : out.texts) {
            const bool across = text.text.find(" kN, -40 to 40") != std::string::npos;
            texts += across;
            EXPECT_TRUE(!across || text.box.x >= out.area.Right());
            EXPECT_LE(text.box.Right(), 960.0) << text.text;
        }
        EXPECT_EQ(count, texts);
    }
}

} // namespace
