// Bars laid by a rule; places by hand.
#include "qm_rps/section/barlayout.h"

#include <gtest/gtest.h>

#include <numbers>

namespace {

using P = BAR_PLACE;

T_SECT_D Rectangle(double height, double width)
{
    T_SECT_D s;
    s.shape = SECT_SHAPE::Rectangle;
    s.size = {height, width};
    s.detailing = T_SECT_DETAIL{};
    s.detailing->cover = 0.03;
    s.detailing->stirrupDiameter = 0.008;
    return s;
}

T_SECT_D Circle(double diameter)
{
    T_SECT_D s = Rectangle(diameter, 0.0);
    s.shape = SECT_SHAPE::Circle;
    return s;
}

} // namespace

// From the edge 30 mm + 8 mm + 9 mm = 47 mm: in a section of 500 x 300 mm z = 203 and y = 103 mm.
// Ten bars around it: gaps of 103 mm along y (one bar a face) and of 135.3 mm along z (two).
TEST(BarLayout, BarsStandWhereTheRuleSays)
{
    const double s60 = std::sqrt(3.0) / 2.0;
    const struct {
        const char* label;
        T_SECT_D section;
        P place;
        int count;
        double diameter;
        std::vector<std::array<double, 2>> yz;
    } kRows[] = {
        {"corners",
         Rectangle(0.5, 0.3),
         P::Corners,
         0,
         0.018,
         {{-0.103, 0.203}, {0.103, 0.203}, {-0.103, -0.203}, {0.103, -0.203}}},
        {"top",
         Rectangle(0.5, 0.3),
         P::Top,
         3,
         0.018,
         {{-0.0515, 0.203}, {0.0, 0.203}, {0.0515, 0.203}}},
        {"bottom", Rectangle(0.5, 0.3), P::Bottom, 1, 0.018, {{0.0, -0.203}}},
        {"right", Rectangle(0.5, 0.3), P::Right, 1, 0.018, {{0.103, 0.0}}},
        {"left",
         Rectangle(0.5, 0.3),
         P::Left,
         2,
         0.018,
         {{-0.103, -0.203 / 3.0}, {-0.103, 0.203 / 3.0}}},
        {"around",
         Rectangle(0.5, 0.3),
         P::Around,
         10,
         0.018,
         {{-0.103, 0.203},
          {0.103, 0.203},
          {-0.103, -0.203},
          {0.103, -0.203},
          {0.0, 0.203},
          {0.103, -0.203 / 3.0},
          {0.103, 0.203 / 3.0},
          {0.0, -0.203},
          {-0.103, -0.203 / 3.0},
          {-0.103, 0.203 / 3.0}}},
        {"circle",
         Circle(0.5),
         P::Around,
         3,
         0.02,
         {{0.0, 0.202}, {s60 * 0.202, -0.101}, {-s60 * 0.202, -0.101}}},
    };
    for (const auto& row : kRows) {
        SCOPED_TRACE(row.label);
        std::vector<T_REBAR> bars;
        std::string reason;
        ASSERT_EQ(1, LayBars(row.section, {row.place, row.count, row.diameter}, bars, reason))
            << reason;
        ASSERT_EQ(row.yz.size(), bars.size());
        for (std::size_t i = 0; i < bars.size(); ++i) {
            EXPECT_NEAR(row.yz[i][0], bars[i].y, 1e-12) << i;
            EXPECT_NEAR(row.yz[i][1], bars[i].z, 1e-12) << i;
            EXPECT_NEAR(std::numbers::pi / 4.0 * row.diameter * row.diameter, bars[i].area, 1e-15);
        }
    }
}

TEST(BarLayout, RefusesWhatCannotStandAndLeavesTheBarsAlone)
{
    T_SECT_D bare = Rectangle(0.5, 0.3), pipe = Circle(0.5), taken = Rectangle(0.5, 0.3);
    bare.detailing.reset();
    pipe.shape = SECT_SHAPE::Pipe;
    taken.bars = {{0.0, 0.19, BarArea(0.018)}}; // 13 mm below the middle of the top row
    const struct {
        T_SECT_D section;
        T_BAR_GROUP group;
        const char* says;
    } kRows[] = {
        {bare, {P::Corners, 4, 0.02}, "detailing"},
        {pipe, {P::Around, 8, 0.02}, "rectangles and circles"},
        {Circle(0.5), {P::Corners, 4, 0.02}, "all round alone"},
        {Circle(0.5), {P::Around, 2, 0.02}, "3 to 1000"},
        {Circle(0.08), {P::Around, 4, 0.02}, "no room"},
        {Rectangle(0.5, 0.09), {P::Corners, 4, 0.02}, "no room"},
        {Rectangle(0.5, 0.3), {P::Corners, 4, 0.0}, "above 0"},
        {Rectangle(0.5, 0.3), {P::Top, 0, 0.02}, "1 to 1000"},
        {Rectangle(0.5, 0.3), {P::Around, 7, 0.02}, "even"},
        {Rectangle(0.5, 0.3), {P::Around, 2, 0.02}, "even"},
        {Rectangle(0.5, 0.3), {P::Top, 1001, 0.02}, "1 to 1000"},
        {Rectangle(0.5, 0.3), {P::Top, 12, 0.018}, "another bar"}, // 15.8 mm apart
        {taken, {P::Top, 1, 0.018}, "y = 0, z = 0.203"},
    };
    for (const auto& row : kRows) {
        SCOPED_TRACE(row.says);
        std::vector<T_REBAR> bars{{1.0, 2.0, 3.0}};
        const std::vector<T_REBAR> before = bars;
        std::string reason;
        EXPECT_EQ(0, LayBars(row.section, row.group, bars, reason));
        EXPECT_NE(std::string::npos, reason.find(row.says)) << reason;
        EXPECT_EQ(before, bars);
    }
}
