// Piers of masonry, walls and round columns of concrete in a state of a push, by hand.
#include "qm_db/sectionproperties.h"
#include "qm_rps/judge/judgedend.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <tuple>

namespace {

constexpr double kN = 1000.0; // N
constexpr auto kRotation = JUDGE_MODE::Rotation, kShear = JUDGE_MODE::Shear;

/// The foot of a member of 3 m whose M / V is 3 m.
T_JUDGED_END Foot(HINGE_CODE code, MEMBER_KIND kind)
{
    T_JUDGED_END end;
    end.basis = JUDGE_BASIS::Code;
    end.member.code = code;
    end.member.kind = kind;
    end.member.clear = 3.0;
    end.member.EI = 4e8, end.member.GA = 3e8;
    end.member.material.knowledge = MATL_KNOWLEDGE::KL2;
    return end;
}

T_JUDGED_END Pier(HINGE_CODE code)
{
    T_JUDGED_END end = Foot(code, MEMBER_KIND::Pier);
    end.member.section.shape = SECT_SHAPE::Rectangle;
    end.member.section.size = {2.0, 0.4, 0.0, 0.0};
    T_MATL_D& m = end.member.material;
    m.type = MATL_CLASS::Masonry;
    m.mean = T_MATL_MEAN{};
    m.mean->fc = 3.2e6;
    m.masonry = T_MATL_MASONRY{};
    m.masonry->tau0 = 76e3, m.masonry->fv0 = 150e3, m.masonry->fb = 8e6;
    m.masonry->bond = BOND_KIND::Regular;
    m.masonry->interlocking = 1.0;
    return end;
}

T_JUDGED_END OfConcrete(HINGE_CODE code, MEMBER_KIND kind)
{
    T_JUDGED_END end = Foot(code, kind);
    T_MATL_D& m = end.member.material;
    m.type = MATL_CLASS::Concrete;
    m.fck = 20e6, m.fyk = 400e6, m.Es = 200e9, m.E = 15e9;
    m.mean = T_MATL_MEAN{28e6, 450e6, 0.0};
    end.member.section.detailing = T_SECT_DETAIL{0.03, 0.008, 0.15};
    return end;
}

T_END_CHECKS Checked(const T_JUDGED_END& end, double N, double V, double chord)
{
    T_END_STATE s;
    s.N = N;
    s.V = V;
    s.M = 3.0 * V;
    s.chord = chord;
    T_STATE_CONTEXT with;
    with.brittle = s;
    with.gravity = T_END_STATE{};
    return CheckEnd(end, s, with);
}

/// A panel zone of an HEB 200 without fillets under beams 300 mm deep, Fye 303 MPa.
T_END_CHECKS PanelUnder(double moment, double axial)
{
    auto joint = std::make_shared<T_JUDGED_JOINT>();
    T_PANEL_ZONE zone;
    zone.joint.columnDepth = 0.2, zone.joint.columnWeb = 0.009, zone.joint.columnFye = 303e6;
    zone.joint.columnArea = 0.00753;
    zone.depth = 0.3;
    joint->panel = zone;
    T_JUDGED_END end;
    end.kind = JUDGED_KIND::Joint;
    end.basis = JUDGE_BASIS::Code;
    end.joint = joint;
    T_END_STATE s;
    s.M = moment, s.V = 30 * kN, s.N = axial;
    T_STATE_CONTEXT with;
    with.brittle = s;
    return CheckEnd(end, s, with);
}

} // namespace

// Vye = 0.55 303e6 0.2 0.009 = 299.97 kN; Vpz = M/(0.95 0.3) - 30. Beyond Vye the rotation would
// have to be known; P/Pye = 0.4 at 912.6 kN.
TEST(JudgedMaterials, PanelZonesPassUpToTheirYieldStrength)
{
    const T_END_CHECKS holds = PanelUnder(80 * kN, 100 * kN);
    for (std::size_t level = 0; level < kLevels; ++level) {
        const auto check = holds.At(JUDGE_MODE::Joint, level);
        ASSERT_TRUE(check);
        EXPECT_NEAR((80 / 0.285 - 30) * kN, check->demand, 1e-6);
        EXPECT_NEAR(299.97 * kN, check->capacity, 1e-6);
    }
    // The other way the shear above adds: (80/0.285 + 30)/299.97 = 1.036.
    for (const auto& [moment, axial, says] : {std::tuple{-80 * kN, 0.0, "Vpz/Vye = 1.036"},
                                              {100 * kN, 0.0, "Vpz/Vye = 1.07"},
                                              {80 * kN, 920 * kN, "P/Pye = 0.4032"}}) {
        const T_END_CHECKS checks = PanelUnder(moment, axial);
        EXPECT_FALSE(checks.At(JUDGE_MODE::Joint, 2)) << says;
        EXPECT_NE(std::string::npos, checks.Of(JUDGE_MODE::Joint)->why.find(says))
            << checks.Of(JUDGE_MODE::Joint)->why;
    }
}

// N = 300. Annex C: 83.8 in flexure, V = 0.065 fm/CF 0.4 3 (1 - 3 V/300) = 208/3.08 in sliding,
// which comes first: drift 0.004. NTC: Mu/h0 = 83.5 comes first: 3/4 of 0.01; sliding 520/(0.7 1.2)
// 0.4 3 (1 - 3 V/300) = 742.857143/8.428571.
TEST(JudgedMaterials, PiersByTheDriftOfTheModeThatComesFirst)
{
    const struct {
        HINGE_CODE code;
        double drift, shear;
    } kCases[] = {{HINGE_CODE::En1998, 0.004, 208.0 / 3.08},
                  {HINGE_CODE::Circolare2019, 0.0075, 742.8571429 / 8.428571429}};
    for (const auto& c : kCases) {
        const T_JUDGED_END end = Pier(c.code);
        const T_END_CHECKS checks = Checked(end, 300.0 * kN, 80.0 * kN, -0.003);
        ASSERT_TRUE(checks.At(kRotation, 1));
        EXPECT_NEAR(0.003 / c.drift, *checks.At(kRotation, 1)->Ratio(), 1e-9);
        ASSERT_TRUE(checks.At(kShear, 1));
        EXPECT_NEAR(80.0 / c.shear, *checks.At(kShear, 1)->Ratio(), 1e-6);
        T_JUDGED_END hinged = end; // its drift judges the shear
        hinged.shearHinge = true;
        EXPECT_FALSE(Checked(hinged, 300.0 * kN, 80.0 * kN, -0.003).Of(kShear));
    }
    EXPECT_NE("", Checked(Pier(HINGE_CODE::Asce17), 300.0 * kN, 80.0 * kN, 0.0).Of(kRotation)->why);
}

// 2.0 x 0.3: (2 sqrt(2900.75 psi) + 400 MPa 100.53/(300 150)) 0.6 m2, kappa 0.9; 1.69 V.
TEST(JudgedMaterials, ShearOfWallsIsThatOfWalls)
{
    T_JUDGED_END end = OfConcrete(HINGE_CODE::Asce17, MEMBER_KIND::Wall);
    end.member.section.shape = SECT_SHAPE::Rectangle;
    end.member.section.size = {2.0, 0.3, 0.0, 0.0};
    for (const double y : {-0.1, 0.1})
        for (const double z : {-0.9, -0.3, 0.3, 0.9})
            end.member.section.bars.push_back({y, z, 254.469e-6});
    const T_END_CHECKS checks = Checked(end, 1000.0 * kN, 100.0 * kN, 0.0);
    ASSERT_TRUE(checks.At(kShear, 1));
    const double psi = 6894.757293168;
    const double steel = 400e6 * 2.0 * std::numbers::pi / 4.0 * 0.008 * 0.008 / (0.3 * 0.15);
    const double strength = 0.9 * 0.6 * (2.0 * std::sqrt(20e6 / psi) * psi + steel);
    EXPECT_NEAR(169.0 * kN / strength, *checks.At(kShear, 1)->Ratio(), 1e-6);
}

// (A.4) with curvatures of the circle, not (A.1), which is of rectangles; its shear has no number.
TEST(JudgedMaterials, RoundColumnsAreNotTakenForRectangles)
{
    T_JUDGED_END end = OfConcrete(HINGE_CODE::En1998, MEMBER_KIND::Column);
    end.member.section.shape = SECT_SHAPE::Circle;
    end.member.section.size = {0.5, 0.0, 0.0, 0.0};
    for (int i = 0; i < 10; ++i) {
        const double turn = i * std::numbers::pi / 5.0;
        end.member.section.bars.push_back({0.2 * std::cos(turn), 0.2 * std::sin(turn), 254e-6});
    }
    const T_END_CHECKS checks = Checked(end, 1000.0 * kN, 100.0 * kN, 0.01);
    ASSERT_TRUE(checks.At(kRotation, 2));
    for (const T_CODE_TRACE& line : checks.Of(kRotation)->trace)
        EXPECT_NE("EN 1998-3 (A.1)", line.clause);
    EXPECT_FALSE(checks.At(kShear, 2));
    EXPECT_NE("", checks.Of(kShear)->why);
}

// Beam 300 x 500, bars alike above and below: rho - rho' = 0. Table 10-7, CP: 0.05 in row i where
// V/(bw d sqrt f'c) is at most 3 and the stirrups conform; 0.02 in row ii, s <= d/2, under 400 kN:
// Vc + Vs = 0.17 sqrt(28) 0.3 0.453 + Av fy d/s = 122 + 137 kN. kappa is the same in both.
TEST(JudgedMaterials, RowOfABeamGoesByTheShearOfTheState)
{
    T_JUDGED_END end = OfConcrete(HINGE_CODE::Asce17, MEMBER_KIND::Beam);
    end.hinge = 0;
    end.member.clear = 4.6;
    end.member.section.shape = SECT_SHAPE::Rectangle;
    end.member.section.size = {0.5, 0.3, 0.0, 0.0};
    for (const double y : {-0.1, 0.0, 0.1})
        for (const double z : {-0.203, 0.203})
            end.member.section.bars.push_back({y, z, 254.469e-6});
    SECT_FAULT fault = SECT_FAULT::None;
    ASSERT_TRUE(CSectionProperties::Calc(end.member.section, end.member.section, fault));
    const auto low = Checked(end, 0.0, 20 * kN, 0.0).At(kRotation, 2);
    const auto high = Checked(end, 0.0, 400 * kN, 0.0).At(kRotation, 2);
    ASSERT_TRUE(low && high);
    EXPECT_NEAR(0.02 / 0.05, high->capacity / low->capacity, 1e-9);
}

// The codes' limits of connections are not known here: no verdict is given on their rotation.
TEST(JudgedMaterials, RotationOfABeamWithAConnectionIsNotChecked)
{
    T_JUDGED_END end = Foot(HINGE_CODE::Asce17, MEMBER_KIND::Beam);
    end.hinge = 0;
    end.member.section.shape = SECT_SHAPE::IShape;
    end.member.section.size = {0.3, 0.15, 0.0071, 0.0107};
    SECT_FAULT fault = SECT_FAULT::None;
    ASSERT_TRUE(CSectionProperties::Calc(end.member.section, end.member.section, fault));
    end.member.material.E = 210e9, end.member.material.Fy = 275e6;
    EXPECT_TRUE(Checked(end, 0.0, 20 * kN, 0.0).At(kRotation, 0));
    end.member.connection = T_STEEL_CONNECTION{"RBS", 0.015, 0.0107, 0.75};
    const T_END_CHECKS checks = Checked(end, 0.0, 20 * kN, 0.0);
    for (std::size_t level = 0; level < kLevels; ++level)
        EXPECT_FALSE(checks.At(kRotation, level));
    EXPECT_FALSE(checks.Of(kRotation)->why.empty());
    EXPECT_TRUE(checks.At(kShear, 0)); // the web is checked all the same
}
