#include "qm_db/mathfunc.h"

#include "numbers.h"

#include <gtest/gtest.h>

namespace {

struct T_CASE {
    const char* label;
    T_POINT2 P1, P2, Q1, Q2;
    int crosses;
    double param; // along Q
    T_POINT2 at;
};

constexpr double kFar = 1e48;

// clang-format off
const T_CASE kCases[] = {
    { "radial to 1e48",   {0, 0}, {kFar, kFar}, {0, 2}, {4, 0}, 1, 1.0 / 3, {4.0 / 3, 4.0 / 3} },
    { "two units",       {0, 0}, {2e6, 2e-6}, {0, 2e-6}, {4e6, 0}, 1, 1.0 / 3, {4e6 / 3, 4e-6 / 3}},
    { "touch at its end", {0, 0}, {1, 0},       {1, 0}, {1, 5},          1, 0.0,     {1, 0} },
    { "inside 1e-9",      {0, 0}, {1 - 5e-10, 0}, {1, -1}, {1, 1},       1, 0.5,     {1, 0} },
    { "clamped to Q",     {0, 0}, {2, 0},       {1, 5e-10}, {1, 1 + 5e-10}, 1, 0.0,  {1, 5e-10} },
    { "outside 1e-9",     {0, 0}, {1 - 5e-9, 0}, {1, -1}, {1, 1},        0, 0, {} },
    { "Q ends before",    {0, 0}, {2, 0},       {1, 5e-9}, {1, 1 + 5e-9}, 0, 0, {} },
    { "beyond P",         {0, 0}, {1, 1},       {0, 4}, {4, 0},          0, 0, {} },
    { "parallel, 5e-10",  {0, 0}, {1, 1},       {0, 0}, {1, 1 + 5e-10},  0, 0, {} },
    { "not parallel",     {0, 0}, {1, 1},       {0, 0}, {1, 1 + 5e-8},   1, 0, {0, 0} },
    { "on one line",      {0, 0}, {2, 2},       {1, 1}, {3, 3},          0, 0, {} },
    { "a point",          {1, 1}, {1, 1},       {0, 0}, {2, 2},          0, 0, {} },
    { "not a number",     {0, 0}, {kNan, 1},    {0, 2}, {4, 0},          0, 0, {} },
};
// clang-format on

} // namespace

TEST(MathFunc, SegmentsCrossWithinOnePartInABillion)
{
    for (const T_CASE& c : kCases) {
        double param = -7.0;
        T_POINT2 p{-8.0, -9.0};
        EXPECT_EQ(c.crosses, CMathFunc::mathIntersectLine2(c.P1, c.P2, c.Q1, c.Q2, 1e-18, param, p))
            << c.label;
        EXPECT_NEAR(c.crosses ? c.param : -7.0, param, 1e-9) << c.label;
        EXPECT_TRUE(!c.crosses || (param >= 0.0 && param <= 1.0)) << c.label;
        EXPECT_NEAR(c.crosses ? c.at.x : -8.0, p.x, 1e-9 * (1.0 + c.at.x)) << c.label;
        EXPECT_NEAR(c.crosses ? c.at.y : -9.0, p.y, 1e-9) << c.label;
    }
}

TEST(MathFunc, TheCallersLargerToleranceCounts)
{
    double param = 0.0;
    T_POINT2 p;
    const T_POINT2 P1{0, 0}, P2{0.95, 0}, Q1{1, -1}, Q2{1, 1};
    EXPECT_EQ(0, CMathFunc::mathIntersectLine2(P1, P2, Q1, Q2, 0.01, param, p));
    EXPECT_EQ(1, CMathFunc::mathIntersectLine2(P1, P2, Q1, Q2, 0.1, param, p));
}
