// Strengths and deformations at first yield of the pages of a hinge type.
#include "hingesample.h"
#include "qm_rps/hinge/pageyield.h"

#include <gtest/gtest.h>

namespace {

constexpr auto kMy = HINGE_COMPONENT::My;

/// Two sides with a yield strength.
T_SIDES<T_SKEL_SIDE> Sides(double pos, double neg)
{
    T_SIDES<T_SKEL_SIDE> s;
    s.pos.yield = pos, s.neg.yield = neg;
    return s;
}

} // namespace

TEST(PageYield, EnteredCurvesByAxialForceCountWithoutForce)
{
    const struct {
        std::vector<T_SKEL_AXIAL> curves;
        double pos, neg;
    } kCases[] = {
        {{{-400, Sides(80, 40)}, {1200, Sides(160, 56)}}, 100, 44}, // a quarter of the way
        {{{1200, Sides(160, 56)}, {-400, Sides(80, 40)}}, 100, 44}, // whatever the order
        {{{-100, Sides(1, 1)}, {0, Sides(90, 70)}, {50, Sides(2, 2)}}, 90, 70},
        {{{300, Sides(150, 60)}, {500, Sides(160, 50)}}, 150, 60},
        {{{-500, Sides(30, 20)}, {-300, Sides(50, 40)}}, 50, 40},
        {{}, 7, 6},
    };
    for (const auto& c : kCases) {
        SCOPED_TRACE(&c - kCases);
        T_SKEL_FEMA f;
        f.symmetric = f.autoYield = false;
        f.sides = Sides(7, 6);
        f.curves = c.curves, f.multiCurve = true;
        const auto s = PageStrength(f, SKEL_TYPE::Fema, kMy, {});
        EXPECT_DOUBLE_EQ(c.pos, s.yield.pos.value_or(0));
        EXPECT_DOUBLE_EQ(c.neg, s.yield.neg.value_or(0));
    }
}

// E = 100, I = 2, L = 3: 6EI/L = 400, EI = 200; a span of 12 makes 6EI/L = 100. M = 300.
TEST(PageYield, DeformationFollowsDefinitionSpanAndSide)
{
    using T = T_PHGT_D;
    using F = T_SKEL_FEMA;
    T_SECT_D section;
    section.area = section.Asy = section.Asz = section.J = section.Izz = 1;
    section.Iyy = 2, section.Zy = section.Zz = 1;
    T_MATL_D material;
    material.E = 100;
    constexpr auto kUser = INIT_STIFFNESS::User;
    constexpr auto kLink = HINGE_ELEMENT::GeneralLink; // has no section
    const struct {
        const char* what;
        void (*edit)(T&, F&);
        double pos, neg;
    } kCases[] = {
        // clang-format off
        {"rotation", [](T&, F&) {}, 0.75, 0.75},
        {"own span", [](T& t, F&) { t.length.autoSpan = false; }, 3, 3},
        {"curvature", [](T& t, F&) { t.definition = HINGE_DEFINITION::CurvatureLumped; }, 1.5, 1.5},
        {"one stiffness", [](T&, F& f) { f.initStiffness = kUser; }, 3, 3},
        {"two", [](T&, F& f) { f.initStiffness = kUser, f.asymStiffness = true; }, 3, 6},
        {"link", [](T& t, F& f) { f.initStiffness = kUser, t.element = kLink; }, 3, 3},
        // clang-format on
    };
    for (const auto& c : kCases) {
        T type;
        type.length.span = 12;
        F f; // symmetric
        f.sides.pos.userStiffness = 100, f.sides.neg.userStiffness = 50;
        c.edit(type, f);
        const bool line = HasLineElement(type);
        const auto lookup =
            LookupOf(type, line ? &section : nullptr, line ? &material : nullptr, 3);
        const auto d = PageDeform(f, kMy, HINGE_LOCATION::IEnd, lookup, {300.0, 300.0});
        EXPECT_DOUBLE_EQ(c.pos, d.pos.value_or(0)) << c.what;
        EXPECT_DOUBLE_EQ(c.neg, d.neg.value_or(0)) << c.what;
    }
}
