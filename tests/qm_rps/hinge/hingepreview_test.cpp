#include "hingesample.h"
#include "qm_rps/hinge/hingepreview.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using L = std::vector<T_PREVIEW_POINT>;

void ExpectLine(const std::vector<std::array<double, 2>>& expected, const L& line)
{
    ASSERT_EQ(expected.size(), line.size());
    for (std::size_t i = 0; i < line.size(); ++i) {
        EXPECT_NEAR(expected[i][0], line[i].x, 1e-12) << i;
        EXPECT_NEAR(expected[i][1], line[i].y, 1e-12) << i;
    }
}

TEST(HingePreview, ExtendsTheNegativeEndFirstAndThenThePositiveOne)
{
    L line{{-1.5, -1.1, ""}, {-1, -1, ""}, {0, 0, ""}, {1, 1, ""}, {1.5, 1.1, ""}};
    AdjustEndPoint(line); // slope 0.2
    ExpectLine({{-2, -1.2}, {-1, -1}, {0, 0}, {1, 1}, {1.5, 1.1}}, line);
    AdjustEndPoint(line);
    ExpectLine({{-2, -1.2}, {-1, -1}, {0, 0}, {1, 1}, {2, 1.2}}, line);
    AdjustEndPoint(line);
    ExpectLine({{-2, -1.2}, {-1, -1}, {0, 0}, {1, 1}, {2, 1.2}}, line);
    line = {{-0.5, -1.5, ""}, {0, 0, ""}, {0.5, 1.5, ""}}; // slope 3: y = 2 at x = 2/3
    AdjustEndPoint(line);
    AdjustEndPoint(line);
    ExpectLine({{-2.0 / 3, -2}, {0, 0}, {2.0 / 3, 2}}, line);
}

TEST(HingePreview, TheSmallBoxHasBothEndsAtItsEdge)
{
    T_SKEL_MULTI m; // slopes 1, then 0.1
    m.sides.pos.alpha1 = m.sides.neg.alpha1 = 0.1;
    m.useDeformation = true;
    m.symmetric = false;
    for (T_SKEL_MULTI_SIDE* s : {&m.sides.pos, &m.sides.neg})
        s->P1 = 10, s->P2 = 10.5, s->D1 = 2, s->D2 = 3;
    T_HINGE_PREVIEW p;
    ASSERT_EQ(1, PreviewOf(m, SKEL_TYPE::Bilinear, p));
    // (1.5, 1.05) goes on with 0.05 / 0.5 to x = 2: 1.1; the negative side mirrors it.
    EXPECT_NEAR(2.0, p.line.back().x, 1e-12);
    EXPECT_NEAR(1.1, p.line.back().y, 1e-12);
    EXPECT_NEAR(-2.0, p.line.front().x, 1e-12);
    EXPECT_NEAR(-1.1, p.line.front().y, 1e-12);
}

TEST(HingePreview, DrawsAFemaBackboneWithItsCriteria)
{
    T_SKEL_FEMA f = ValidBackbone<T_SKEL_FEMA>();
    T_HINGE_PREVIEW p;
    ASSERT_EQ(1, BackboneOf(f, SKEL_TYPE::Fema, p));
    ExpectLine({{-7, -0.3},
                {-5, -0.3},
                {-5, -1.3},
                {-1, -1},
                {0, 0},
                {1, 1},
                {6, 1.2},
                {6, 0.2},
                {8, 0.2}},
               p.line);
    EXPECT_EQ("-E", p.line[0].label);
    // B (1, 1) to C (6, 1.2): slope 0.04; -B to -C: slope 0.075
    ExpectLine({{-2, -1.075}, {-3, -1.15}, {-5, -1.3}, {2, 1.04}, {4, 1.12}, {6, 1.2}}, p.marks);
    EXPECT_EQ("-IO", p.marks[0].label);
    f.compliance = false; // criteria that are not in use
    ASSERT_EQ(1, BackboneOf(f, SKEL_TYPE::Fema, p));
    EXPECT_TRUE(p.marks.empty());
    f.measure = SKEL_MEASURE::Plastic; // (E + Dy) / Dy, Dy = 0.01 and 0.02
    ASSERT_EQ(1, BackboneOf(f, SKEL_TYPE::Fema, p));
    EXPECT_NEAR(8 / 0.01 + 1, p.line.back().x, 1e-9);
    EXPECT_NEAR(-7 / 0.02 - 1, p.line.front().x, 1e-9);
    f.sides.pos.yieldDeform = 0;
    ASSERT_EQ(1, BackboneOf(f, SKEL_TYPE::Fema, p));
    EXPECT_TRUE(p.plasticAxis);
    EXPECT_EQ(8, p.line.back().x);
}

TEST(HingePreview, DrawsMultilinearCurves)
{
    T_SKEL_MULTI m;
    m.sides.pos.alpha1 = 0.1, m.sides.pos.alpha2 = 0.05;
    T_HINGE_PREVIEW p;
    ASSERT_EQ(1, BackboneOf(m, SKEL_TYPE::Bilinear, p));
    AdjustEndPoint(p.line);
    AdjustEndPoint(p.line);
    ExpectLine({{-2, -1.1}, {-1, -1}, {0, 0}, {1, 1}, {2, 1.1}}, p.line);
    EXPECT_EQ(0, BackboneOf(m, SKEL_TYPE::Trilinear, p)); // strengths not known
    EXPECT_TRUE(p.line.empty());
    m.sides.pos.P1 = 5, m.sides.pos.P2 = 10, m.sides.pos.alpha1 = 0.5;
    ASSERT_EQ(1, BackboneOf(m, SKEL_TYPE::Trilinear, p)); // crack at 0.5, yield at 0.5 + 0.5/0.5
    ExpectLine({{-2.5, -1.05}, {-1.5, -1}, {-0.5, -0.5}, {0, 0}, {0.5, 0.5}, {1.5, 1}, {2.5, 1.05}},
               p.line);
    ASSERT_EQ(1, BackboneOf(m, SKEL_TYPE::CompressionOnly, p));
    ExpectLine({{-2, -1.5}, {-1, -1}, {0, 0}, {1, 0}}, p.line);
    m.useDeformation = m.useUltimate = true;
    m.sides.pos.D1 = 0.01, m.sides.pos.D2 = 0.04, m.sides.pos.D3 = 0.08, m.sides.pos.P3 = 12;
    m.sides.pos.gap = 0.02, m.gapSides = GAP_SIDES::Positive;
    ASSERT_EQ(1, BackboneOf(m, SKEL_TYPE::SlipTrilinear, p)); // gap = half of Dy = 0.04
    ExpectLine(
        {{-2, -1.2}, {-1, -1}, {-0.25, -0.5}, {0, 0}, {0.5, 0}, {0.75, 0.5}, {1.5, 1}, {2.5, 1.2}},
        p.line);
    m.sides.pos.D3 = std::nan("");
    EXPECT_EQ(0, BackboneOf(m, SKEL_TYPE::Trilinear, p));
}

} // namespace
