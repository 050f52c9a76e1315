#include "qm_ui/plot/plotlayout.h"

#include "numbers.h"
#include "plotmeasure.h"

#include <gtest/gtest.h>

#include <string>

namespace {

T_PLOT Curve()
{
    T_PLOT plot;
    plot.title = "Capacity";
    plot.series.push_back({"Base shear", {0, 1, 2, 3, 4}, {0, 6, 8, 9, 9.5}});
    return plot;
}

// Label boxes and the legend: inside the frame, and clear of each other.
void ExpectApart(const T_PLOT_LAYOUT& layout)
{
    std::vector<T_PLOT_BOX> boxes;
    for (const T_PLOT_LABEL_PLACE& l : layout.labels)
        boxes.push_back(l.place.box);
    if (layout.legend) boxes.push_back(layout.legend->box);
    for (std::size_t i = 0; i < boxes.size(); ++i) {
        EXPECT_TRUE(layout.area.Holds(boxes[i])) << i;
        for (std::size_t k = 0; k < i; ++k)
            EXPECT_FALSE(boxes[i].Meets(boxes[k])) << i << " and " << k;
    }
}

TEST(PlotLayout, TwentyCloseLabelsStandApart)
{
    T_PLOT plot = Curve();
    for (int i = 0; i < 20; ++i)
        plot.labels.push_back({2.0 + 0.01 * i, 8.0 + 0.005 * i, "hinge " + std::to_string(i + 1)});
    const T_PLOT_LAYOUT layout = LayoutOf(plot);
    EXPECT_EQ(20u, layout.labels.size());
    ASSERT_TRUE(layout.legend);
    ExpectApart(layout);
    int leaders = 0;
    for (const T_PLOT_LABEL_PLACE& l : layout.labels) {
        const T_PLOT_PX near = l.place.box.Nearest(l.place.anchor);
        EXPECT_TRUE(l.place.leaderEnd || PlotDistance(near, l.place.anchor) < 20.0);
        leaders += l.place.leaderEnd ? 1 : 0;
    }
    EXPECT_GT(leaders, 0);
}

TEST(PlotLayout, RadialLinePassesThroughTheOriginWithItsSlope)
{
    T_PLOT plot = Curve();
    plot.x.range = T_PLOT_RANGE{0, 4};
    plot.y.range = T_PLOT_RANGE{0, 10};
    plot.guides.push_back({PLOT_GUIDE::Radial, 5.0, "", {}, {}});
    const T_PLOT_LAYOUT layout = LayoutOf(plot);
    ASSERT_EQ(1u, layout.guides.size());
    const PLOT_RUN& run = layout.guides[0].lines.at(0);
    EXPECT_NEAR(layout.x.ToPixel(0.0), run.front().x, 1e-9);
    EXPECT_NEAR(layout.y.ToPixel(0.0), run.front().y, 1e-9);
    EXPECT_NEAR(layout.x.ToPixel(2.0), run.back().x, 1e-9); // y = 5 x leaves at y = 10
    EXPECT_NEAR(layout.y.ToPixel(10.0), run.back().y, 1e-9);
}

TEST(PlotLayout, LegendHidesNothingWhenACornerIsFree)
{
    T_PLOT plot; // takes the top right corner, where the legend would go otherwise
    plot.series.push_back({"rising", {0, 1, 2, 3}, {0.5, 9, 9.5, 10}});
    const T_PLOT_LAYOUT layout = LayoutOf(plot);
    ASSERT_TRUE(layout.legend);
    for (PLOT_RUN run : layout.curves[0].lines)
        for (std::size_t i = 1; i < run.size(); ++i)
            EXPECT_FALSE(ClipSegment(layout.legend->box, run[i - 1], run[i]));
}

TEST(PlotLayout, PointsThatAreNotFiniteLeaveAGap)
{
    T_PLOT plot;
    plot.series.push_back({"s", {0, 1, 2, 3, kNan, 5, 6}, {1, 2, kNan, 3, 4, 5, 6, 7, 8}});
    const T_PLOT_LAYOUT layout = LayoutOf(plot);
    EXPECT_TRUE(layout.hasData);
    std::vector<std::size_t> points;
    for (const PLOT_RUN& run : layout.curves[0].lines)
        points.push_back(run.size());
    EXPECT_EQ((std::vector<std::size_t>{2, 1, 2}), points);
}

TEST(PlotLayout, CurvesNeverLeaveTheFrame)
{
    T_PLOT plot = Curve();
    plot.series.push_back({"wild", {1.8, 2.2, 2.4}, {-1e12, 1e12, -1e140}});
    T_PLOT_VIEW view;
    view.x = T_PLOT_RANGE{1.5, 2.5};
    view.y = T_PLOT_RANGE{7, 8.2};
    const T_PLOT_LAYOUT layout = LayoutOf(plot, view);
    for (const T_PLOT_CURVE& c : layout.curves)
        for (const PLOT_RUN& run : c.lines)
            for (const T_PLOT_PX& p : run)
                EXPECT_TRUE(layout.area.Holds(p)) << p.x << " " << p.y;
    EXPECT_EQ(3u, layout.curves[0].lines.at(0).size()); // (1.5, 7), (2, 8), (2.2, 8.2)
    EXPECT_EQ(2u, layout.curves[1].lines.size());       // up at x = 2 and down at x = 2.2
}

TEST(PlotLayout, TextsStayOnThePageAndTickLabelsApart)
{
    T_PLOT plot = Curve();
    plot.x.range = T_PLOT_RANGE{1000.0001, 1000.00019}; // long labels
    plot.notes = {"one", "two", "three"};
    const T_PLOT_LAYOUT layout = LayoutOf(plot);
    ASSERT_GE(layout.xTicks.major.size(), 2u);
    for (std::size_t i = 0; i < layout.texts.size(); ++i) {
        EXPECT_TRUE(T_PLOT_BOX(0, 0, 960, 640).Holds(layout.texts[i].box)) << layout.texts[i].text;
        for (std::size_t k = 0; k < i; ++k)
            EXPECT_FALSE(layout.texts[i].box.Meets(layout.texts[k].box))
                << layout.texts[i].text << " on " << layout.texts[k].text;
    }
}

} // namespace
