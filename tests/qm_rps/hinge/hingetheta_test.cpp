#include "qm_rps/hinge/hingetheta.h"

#include <gtest/gtest.h>

namespace {

using C = HINGE_COMPONENT;
using L = HINGE_LOCATION;
using S = INIT_STIFFNESS;

// N, mm. G = 260000 / 2.6 = 100000.
T_SECT_D Section()
{
    T_SECT_D s;
    s.Iyy = 1e8;
    s.Izz = 4e7;
    s.Asy = 2000;
    s.Asz = 5000;
    s.factorsI = {1, 0.5, 0.2, 1, 0.5, 1.0}; // area, Asy, Asz, J, Iyy, Izz
    s.factorsJ = {1, 0.25, 0.4, 1, 0.25, 0.8};
    return s;
}
T_MATL_D Material()
{
    T_MATL_D m;
    m.E = 260000;
    m.nu = 0.3;
    return m;
}

} // namespace

TEST(HingeTheta, FollowsComponentEndAndOption)
{
    const T_SECT_D section = Section();
    const T_MATL_D material = Material();
    const T_THETA_LOOKUP lookup{&section, &material, 4000};
    struct T_CASE {
        const char* label;
        bool moment;
        C component;
        L end;
        S option;
        double strength, expected;
    };
    // EI/L of My at I: 260000 * 1e8 * 0.5 / 4000 = 3.25e9; at J 1.625e9; of Mz 2.6e9 and 2.08e9.
    const T_CASE cases[] = {
        {"My I 6EI/L", true, C::My, L::IEnd, S::EI6L, 3.9e8, 3.9e8 / 1.95e10},
        {"My I 3EI/L", true, C::My, L::IEnd, S::EI3L, 3.9e8, 0.04},
        {"My J 6EI/L", true, C::My, L::JEnd, S::EI6L, 3.9e8, 0.04},
        {"Mz I 6EI/L", true, C::Mz, L::IEnd, S::EI6L, 1.56e8, 0.01},
        {"Mz J 6EI/L", true, C::Mz, L::JEnd, S::EI6L, 1.56e8, 0.0125},
        {"My user", true, C::My, L::IEnd, S::User, 3.9e8, 0.0039},
        {"negative", true, C::My, L::IEnd, S::EI6L, -3.9e8, -0.02},
        {"Fy I", false, C::Fy, L::IEnd, S::Elastic, 1e5, 1e-3}, // K = 1e5 * 1000
        {"Fy J", false, C::Fy, L::JEnd, S::Elastic, 1e5, 2e-3}, // 1e5 * 500
        {"Fz J", false, C::Fz, L::JEnd, S::Elastic, 2e5, 1e-3}, // 1e5 * 2000
        {"moment of Fy", true, C::Fy, L::IEnd, S::EI6L, 1e8, 0},
        {"moment at centre", true, C::My, L::Center, S::EI6L, 1e8, 0},
        {"shear of My", false, C::My, L::IEnd, S::Elastic, 1e5, 0},
        {"shear 6EI/L", false, C::Fy, L::IEnd, S::EI6L, 1e5, 0},
    };
    for (const T_CASE& c : cases) {
        const double r = c.moment ? CHingeTheta::CalcThetaMoment(lookup, c.component, c.end,
                                                                 c.option, 1e11, c.strength)
                                  : CHingeTheta::CalcThetaShear(lookup, c.component, c.end,
                                                                c.option, 1e11, c.strength);
        EXPECT_NEAR(c.expected, r, 1e-12) << c.label;
    }
    T_MATL_D given = material;
    given.G = 50000; // goes before E / 2.6
    const double D =
        CHingeTheta::CalcThetaShear({&section, &given, 4000}, C::Fy, L::IEnd, S::Elastic, 0, 1e5);
    EXPECT_NEAR(2e-3, D, 1e-12);
}

TEST(HingeTheta, IsZeroWithoutBasisOrStiffness)
{
    const T_SECT_D section = Section();
    const T_MATL_D material = Material();
    const auto moment = [](const T_THETA_LOOKUP& lookup, S option, double user) {
        return CHingeTheta::CalcThetaMoment(lookup, C::My, L::IEnd, option, user, 1.0);
    };
    EXPECT_EQ(0.0, moment({nullptr, &material, 1}, S::User, 5));
    EXPECT_EQ(0.0, moment({&section, nullptr, 1}, S::User, 5));
    EXPECT_EQ(0.0, moment({&section, &material, 0}, S::EI6L, 0)) << "no length";
    for (const double user : {-5.0, 0.9e-10})
        EXPECT_EQ(0.0, moment({&section, &material, 1}, S::User, user)) << user;
    EXPECT_DOUBLE_EQ(1 / 1.1e-10, moment({&section, &material, 1}, S::User, 1.1e-10));
}

TEST(HingeTheta, TakesTheInertiaOfAShapeFromItsDimensions)
{
    T_SECT_D s;
    s.shape = SECT_SHAPE::Rectangle;
    s.size = {500, 300};
    s.Iyy = 1.0; // entered values of a shape do not count
    const T_MATL_D material = Material();
    // 6 * 260000 * 3.125e9 / 4875 = 1e12
    const T_THETA_LOOKUP lookup{&s, &material, 4875};
    const double theta = CHingeTheta::CalcThetaMoment(lookup, C::My, L::IEnd, S::EI6L, 0, 1e9);
    EXPECT_NEAR(1e-3, theta, 1e-12);
    s.size = {500, -300};
    EXPECT_EQ(0.0, CHingeTheta::CalcThetaMoment(lookup, C::My, L::IEnd, S::EI6L, 0, 1e9));
}
