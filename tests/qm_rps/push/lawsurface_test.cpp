// The surface of a section in the measure of the engine. Shares by tests/oracle/section.py
// (strips): moments towards a direction over the ellipse of the moments about the axes.
#include "qm_rps/push/law/lawsurface.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace {

/// 0.3 x 0.5 m, C30, eight bars of 300 mm2: 1080 kN in tension, 5388 kN in compression.
CHingeSources Sources(double aside = 0.0)
{
    T_SECT_D section, square;
    section.shape = SECT_SHAPE::Rectangle;
    section.size = {0.5, 0.3};
    for (const auto& [y, z] : {std::pair{-0.11, -0.21},
                               {0.11, -0.21},
                               {-0.11, 0.0},
                               {0.11, 0.0},
                               {-0.11, 0.21},
                               {0.11, 0.21},
                               {aside, -0.21},
                               {aside, 0.21}})
        section.bars.push_back({y, z, 3e-4});
    T_MATL_D concrete;
    concrete.type = MATL_CLASS::Concrete;
    concrete.E = 30e9, concrete.fck = 30e6, concrete.fyk = 450e6, concrete.Es = 2e11;
    square.area = 0.01, square.Zy = square.Zz = 4e-4, square.Iyy = square.Izz = 2e-5;
    T_MATL_D steel;
    steel.E = 2e11, steel.Fy = 250e6;
    return {
        {{1, section}, {2, square}}, {{1, concrete}, {2, steel}}, {FORCE_UNIT::N, LENGTH_UNIT::m}};
}

solver::T_HINGE_LAW Law()
{
    solver::T_HINGE_LAW law;
    law.byAxial = {{-5.388e6, 0, 0}, {0, 3e5, 3e5}, {1.08e6, 0, 0}};
    return law;
}

} // namespace

TEST(LawSurface, StandsOnTheExactMomentsBetweenTheAxes)
{
    std::vector<solver::T_AXIAL_SHAPE> shape;
    std::string reason;
    ASSERT_EQ(1, SurfaceShape(Sources(), 1, 1, Law(), shape, reason)) << reason;
    EXPECT_EQ(-5.388e6, shape.front().axial);
    EXPECT_EQ(1.08e6, shape.back().axial);
    struct T_EXPECTED {
        double axial, share[3]; // at 24, 45, 66 degrees from My to Mz
    };
    for (const T_EXPECTED& e : {T_EXPECTED{-739125.0, {0.929998, 0.902622, 0.932895}},
                                {-2221375.0, {0.883856, 0.846672, 0.883664}},
                                {-3838375.0, {0.949668, 0.930063, 0.945079}}}) {
        const auto row = std::ranges::find_if(
            shape, [&](const auto& r) { return std::fabs(r.axial - e.axial) < 1.0; });
        ASSERT_NE(shape.end(), row);
        for (std::size_t k = 0; k < row->share.size(); ++k) {
            const std::size_t quadrant = k / 5, in = quadrant % 2 == 0 ? k % 5 : 4 - k % 5;
            const double expected = in == 0 || in == 4 ? 1.0 : e.share[in - 1];
            EXPECT_NEAR(expected, row->share[k], 2e-4) << e.axial << " " << k;
        }
    }
}

TEST(LawSurface, RefusesSectionsWithoutAShapeOrOneThatBendsAside)
{
    std::vector<solver::T_AXIAL_SHAPE> shape;
    std::string reason;
    EXPECT_EQ(0, SurfaceShape(Sources(), 2, 2, Law(), shape, reason));
    EXPECT_NE(std::string::npos, reason.find("no exact surface"));
    EXPECT_EQ(0, SurfaceShape(Sources(0.08), 1, 1, Law(), shape, reason));
    EXPECT_NE(std::string::npos, reason.find("not symmetric"));
    EXPECT_TRUE(shape.empty());
}
