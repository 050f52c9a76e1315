// Skeleton curves as laws of the engine. Expected points are worked by hand: total deformation less
// force over initial stiffness.
#include "qm_rps/push/law/lawcurve.h"
#include "qm_rps/push/law/lawplaces.h"
#include "qm_rps/push/pushstates.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

using T_POINTS = std::vector<std::array<double, 2>>; // deformation, force

T_SKEL_SIDE Side(double sign, double d, double c, double residual)
{
    T_SKEL_SIDE s;
    s.B = {sign * 1, sign * 1}, s.C = {sign * d, sign * c};
    s.D = {sign * d, sign * residual}, s.E = {sign * 10, sign * residual};
    s.IO = sign * 2, s.LS = sign * 4, s.CP = sign * d;
    return s;
}

/// Dy = 0.01 at 100; C at 6 Dy and 1.2, D there at 0.2, E at 10 Dy.
T_SKEL_FEMA Fema()
{
    T_SKEL_FEMA f;
    f.autoYield = false;
    f.sides = {Side(1, 6, 1.2, 0.2), Side(-1, 3, 1.1, 0.3)};
    return f;
}
T_SKEL_FEMA Plastic(INIT_STIFFNESS option, double user)
{
    T_SKEL_FEMA f = Fema();
    f.measure = SKEL_MEASURE::Plastic;
    f.initStiffness = option;
    T_SKEL_SIDE& s = f.sides.pos;
    s.userStiffness = user;
    s.B.deform = 0, s.C.deform = s.D.deform = 0.05, s.E.deform = 0.09;
    s.IO = 0.01, s.LS = 0.03, s.CP = 0.05;
    return f;
}
T_SKEL_MULTI Multi(double alpha1, double alpha2 = 0.0)
{
    T_SKEL_MULTI m;
    m.autoYield = false;
    m.sides.pos.alpha1 = alpha1, m.sides.pos.alpha2 = alpha2;
    return m;
}

T_LAW_BASIS Basis(double crack = 0.0)
{
    return {{100, 80}, {crack, crack}, 1e4, 0.0, 1.0};
}

void Expect(const T_POINTS& expected, const solver::T_HINGE_SIDE& side, const char* label)
{
    ASSERT_EQ(expected.size(), side.points.size()) << label;
    for (std::size_t i = 0; i < expected.size(); ++i) {
        EXPECT_NEAR(expected[i][0], side.points[i].deformation, 1e-12) << label << i;
        EXPECT_NEAR(expected[i][1], side.points[i].force, 1e-9) << label << i;
    }
}

} // namespace

TEST(LawCurve, PositiveSideLosesItsElasticPart)
{
    T_SKEL_FEMA kept = Fema(), both = Fema();
    kept.strengthLoss = false;
    both.sides.pos.C = {1, 1}; // B and C at one point
    T_SKEL_MULTI capped = Multi(0.02), entered = Multi(0), three = Multi(0.35, 0);
    capped.useUltimate = true, capped.sides.pos.P3 = 150;
    entered.useDeformation = true;
    entered.sides.pos.D1 = 0.02, entered.sides.pos.D2 = 0.05, entered.sides.pos.P2 = 120;
    T_SKEL_EC8 ec8;
    ec8.sides.pos = Side(1, 6, 1.2, 0.2);
    ec8.autoYield = false;
    const struct {
        const char* label;
        T_SKEL_CURVE curve;
        SKEL_TYPE type;
        double crack, stiffness; // of the spring
        T_POINTS points;
        const char* letters;
    } cases[] = {
        {"ratios",
         Fema(),
         SKEL_TYPE::Fema,
         0,
         0,
         {{0, 100}, {0.048, 120}, {0.058, 20}, {0.098, 20}},
         "BCDE"},
        {"ec8",
         ec8,
         SKEL_TYPE::Ec8,
         0,
         0,
         {{0, 100}, {0.048, 120}, {0.058, 20}, {0.098, 20}},
         "BCDE"},
        {"plastic",
         Plastic(INIT_STIFFNESS::EI6L, 0),
         SKEL_TYPE::Fema,
         0,
         0,
         {{0, 100}, {0.048, 120}, {0.058, 20}, {0.098, 20}},
         "BCDE"},
        {"spring",
         Plastic(INIT_STIFFNESS::User, 1e4),
         SKEL_TYPE::Fema,
         0,
         1e4,
         {{0.01, 100}, {0.06, 120}, {0.06, 20}, {0.1, 20}},
         "BCDE"},
        {"rigid",
         Plastic(INIT_STIFFNESS::User, 0),
         SKEL_TYPE::Fema,
         0,
         0,
         {{0, 100}, {0.05, 120}, {0.05, 20}, {0.09, 20}},
         "BCDE"},
        {"kept", kept, SKEL_TYPE::Fema, 0, 0, {{0, 100}, {0.048, 120}, {0.088, 120}}, "BDE"},
        {"one point", both, SKEL_TYPE::Fema, 0, 0, {{0, 100}, {0.058, 20}, {0.098, 20}}, "CDE"},
        {"flat", Multi(0), SKEL_TYPE::Bilinear, 0, 0, {{0, 100}}, "B"},
        // At 1000 Dy the force is 100 (1 + 0.02 * 999).
        {"bilinear", Multi(0.02), SKEL_TYPE::Bilinear, 0, 0, {{0, 100}, {9.7902, 2098}}, "BC"},
        // 50 at 200 per unit, less 150 / 1e4.
        {"capped", capped, SKEL_TYPE::Bilinear, 0, 0, {{0, 100}, {0.245, 150}}, "BC"},
        {"entered", entered, SKEL_TYPE::Bilinear, 0, 0, {{0, 100}, {0.028, 120}}, "BC"},
        // 0.004 + 60 / 3500 - 0.01.
        {"trilinear", three, SKEL_TYPE::Trilinear, 40, 0, {{0, 40}, {0.078 / 7.0, 100}}, "BC"},
    };
    for (const auto& c : cases) {
        T_PUSH_LAW law;
        std::string reason;
        ASSERT_EQ(1, MakeLaw(c.curve, c.type, Basis(c.crack), law, reason)) << c.label << reason;
        Expect(c.points, law.law.positive, c.label);
        EXPECT_EQ(c.letters, law.letters.pos) << c.label;
        EXPECT_NEAR(c.stiffness, law.law.stiffness, 1e-9) << c.label;
    }
}

TEST(LawCurve, SidesMarksAndLengthFollowTheRecord)
{
    T_SKEL_FEMA f = Fema();
    f.symmetric = false;
    f.unloadType = UNLOAD_TYPE::Origin;
    T_LAW_BASIS basis = Basis();
    basis.length = 0.5; // K = EI of a curvature, Dy and points times the length
    T_PUSH_LAW law;
    std::string reason;
    ASSERT_EQ(1, MakeLaw(f, SKEL_TYPE::Fema, basis, law, reason)) << reason;
    Expect({{0, 100}, {0.024, 120}, {0.029, 20}, {0.049, 20}}, law.law.positive, "+");
    // Dy = 0.008: 0.024 - 88 / 1e4, 0.024 - 24 / 1e4, 0.08 - 24 / 1e4, each halved.
    Expect({{0, 80}, {0.0076, 88}, {0.0108, 24}, {0.0388, 24}}, law.law.negative, "-");
    EXPECT_EQ(solver::UNLOADING::Origin, law.law.negative.unloading);
    // At 2 Dy the force is 104, at 4 Dy 112: 0.02 - 0.0104, 0.04 - 0.0112, C.
    const double marks[] = {0.0048, 0.0144, 0.024};
    ASSERT_EQ(3u, law.law.positive.marks.size());
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_NEAR(marks[i], law.law.positive.marks[i], 1e-12);
    T_SKEL_MULTI slip = Multi(0);
    slip.sides.pos.gap = 0.02, slip.sides.neg.gap = 0.04, slip.gapSides = GAP_SIDES::Negative;
    T_PUSH_LAW pinched, contact;
    ASSERT_EQ(1, MakeLaw(slip, SKEL_TYPE::SlipBilinear, basis, pinched, reason));
    EXPECT_TRUE(pinched.law.positive.slips && pinched.law.negative.slips);
    EXPECT_EQ(0.0, pinched.law.positive.gap);
    EXPECT_EQ(0.02, pinched.law.negative.gap);
    ASSERT_EQ(1, MakeLaw(Multi(0), SKEL_TYPE::CompressionOnly, basis, contact, reason));
    EXPECT_TRUE(contact.law.positive.free && contact.law.positive.points.empty());
    Expect({{0, 80}}, contact.law.negative, "contact");
}

TEST(LawCurve, AxialForcePicksTheCurveBetweenTwo)
{
    T_SKEL_FEMA f = Plastic(INIT_STIFFNESS::User, 0);
    f.multiCurve = true;
    f.curves = {{0.0, f.sides}, {1000.0, f.sides}};
    f.curves[1].sides.pos.C.deform = 0.01, f.curves[1].sides.pos.C.strength = 1.0;
    T_LAW_BASIS basis = Basis();
    basis.axial = 250;
    T_PUSH_LAW law;
    std::string reason;
    ASSERT_EQ(1, MakeLaw(f, SKEL_TYPE::Fema, basis, law, reason)) << reason;
    EXPECT_NEAR(0.04, law.law.positive.points[1].deformation, 1e-15);
    EXPECT_NEAR(115, law.law.positive.points[1].force, 1e-12);
    EXPECT_EQ(0.01, SidesAt(f, 5000).pos.C.deform);
}

TEST(LawCurve, PlasticPointsHaveTheElasticPartAtTheInitialAxialForce)
{
    T_LAW_BASIS basis = Basis();
    basis.atAxial = {0.5, 1.0};
    T_PUSH_LAW law;
    std::string reason;
    ASSERT_EQ(1, MakeLaw(Plastic(INIT_STIFFNESS::Elastic, 0), SKEL_TYPE::Fema, basis, law, reason));
    // Yield at 0.005, forces half of 100, 120, 20: D = 0.05 + 0.005 - 0.5 x 20 / 1e4.
    Expect({{0, 100}, {0.049, 120}, {0.054, 20}, {0.094, 20}}, law.law.positive, "half");
}

TEST(LawCurve, RefusesWhatNoHingeCanFollow)
{
    T_SKEL_FEMA off = Fema(), back = Fema(), rigid = Fema(),
                two = Plastic(INIT_STIFFNESS::User, 1e4), drift = Fema();
    off.sides.pos.B = {1, 0.8};
    back.sides.pos.C = {1.1, 1.2}; // 0.011 - 0.012
    rigid.initStiffness = INIT_STIFFNESS::User;
    two.asymStiffness = true, two.sides.neg.userStiffness = 2e4;
    drift.infillStrut = drift.infillGeneral = true;
    T_SKEL_MULTI low = Multi(0.1);
    low.useUltimate = true, low.sides.pos.P3 = 90;
    const struct {
        const char* text;
        T_SKEL_CURVE curve;
        SKEL_TYPE type;
        T_LAW_BASIS basis;
    } cases[] = {
        {"the strength of the side (-)", Fema(), SKEL_TYPE::Fema, {{100, 0}, {}, 1e4}},
        {"point B of the side (+)", off, SKEL_TYPE::Fema, Basis()},
        {"at point C of the side (+) falls behind", back, SKEL_TYPE::Fema, Basis()},
        {"rigid", rigid, SKEL_TYPE::Fema, Basis()},
        {"different user stiffnesses", two, SKEL_TYPE::Fema, Basis()},
        {"drifts of the panel", drift, SKEL_TYPE::Fema, Basis()},
        {"1 or more", Multi(1.0), SKEL_TYPE::Bilinear, Basis()},
        {"must not fall", low, SKEL_TYPE::Bilinear, Basis()},
        {"must not fall", Multi(0.1), SKEL_TYPE::Trilinear, Basis(120)},
        {"crack strength", Multi(0.1), SKEL_TYPE::Trilinear, Basis(0)},
    };
    for (const auto& c : cases) {
        T_PUSH_LAW law;
        std::string reason;
        EXPECT_EQ(0, MakeLaw(c.curve, c.type, c.basis, law, reason)) << c.text;
        EXPECT_NE(std::string::npos, reason.find(c.text)) << reason;
    }
}

TEST(PushStates, FollowPlaceAndDeformation)
{
    T_PUSH_LAW law;
    std::string reason;
    ASSERT_EQ(1, MakeLaw(Plastic(INIT_STIFFNESS::User, 0), SKEL_TYPE::Fema, Basis(), law, reason));
    T_PUSH_LAW_PLACE place;
    place.letters = law.letters, place.criteria = true, place.fails = true;
    T_PUSH_LAW_PLACE plain = place;
    plain.criteria = plain.fails = false;
    const struct {
        double deformation;
        int at;
        PUSH_STATE state, plain;
    } cases[] = {
        {0, 0, PUSH_STATE::Elastic, PUSH_STATE::Elastic},
        {0.0, 1, PUSH_STATE::BtoIO, PUSH_STATE::BtoC},
        {0.01, 1, PUSH_STATE::IOtoLS, PUSH_STATE::BtoC},
        {-0.03, -1, PUSH_STATE::LStoCP, PUSH_STATE::BtoC},
        {0.03, -1, PUSH_STATE::LStoCP, PUSH_STATE::BtoC}, // went back, the other side flows
        {0.05, 1, PUSH_STATE::CPtoC, PUSH_STATE::BtoC},
        {0.05, 2, PUSH_STATE::CtoD, PUSH_STATE::CtoD},
        {0.06, 3, PUSH_STATE::DtoE, PUSH_STATE::DtoE},
        {0.1, 4, PUSH_STATE::Failed, PUSH_STATE::DtoE},
    };
    for (const auto& c : cases) {
        const solver::T_HINGE_STATE state{c.deformation, 0.0, c.at};
        EXPECT_EQ(c.state, StateOf(place, law.law, state)) << c.deformation << " " << c.at;
        EXPECT_EQ(c.plain, StateOf(plain, law.law, state)) << c.deformation << " " << c.at;
    }
    EXPECT_EQ("C", EventTarget(place, {0, 0, solver::HINGE_TURN::Point, 2, false}));
    EXPECT_EQ("unload", EventTarget(place, {0, 0, solver::HINGE_TURN::Unload, 0, true}));
}

// Abramowitz and Stegun Table 25.6: x = 0, sqrt(3/7), 1; w = 32/45, 49/90, 1/10 on -1 to 1.
TEST(LawPlaces, DistributedHingesStandAtLobattoPoints)
{
    const double x = std::sqrt(3.0 / 7.0);
    const double at[] = {0, 0.5 - 0.5 * x, 0.5, 0.5 + 0.5 * x, 1};
    const double weight[] = {0.05, 49.0 / 180, 16.0 / 45, 49.0 / 180, 0.05};
    T_PHGT_D type;
    type.definition = HINGE_DEFINITION::CurvatureDistributed;
    T_HINGE_SPAN span{ELEM_KIND::Beam, 4.0, 8.0, false};
    std::vector<T_HINGE_SPOT> spots;
    std::string reason;
    ASSERT_EQ(1, HingeSpots(type, HINGE_COMPONENT::My, span, spots, reason));
    ASSERT_EQ(5u, spots.size());
    for (std::size_t i = 0; i < 5; ++i) {
        EXPECT_NEAR(at[i], spots[i].at, 1e-15);
        EXPECT_NEAR(4.0 * weight[i], spots[i].length, 1e-14);
    }
    type.definition = HINGE_DEFINITION::CurvatureLumped;
    EXPECT_EQ(0, HingeSpots(type, HINGE_COMPONENT::My, span, spots, reason));
    type.length.relative = true;
    type.length.components.I[4] = 0.05, type.length.components.J[4] = 0.1;
    ASSERT_EQ(1, HingeSpots(type, HINGE_COMPONENT::My, span, spots, reason));
    EXPECT_EQ((std::vector<T_HINGE_SPOT>{{0.0, "I", false, 0.4}, {1.0, "J", false, 0.8}}), spots);
    type.definition = HINGE_DEFINITION::MomentRotation;
    // Both ends of an unloaded beam carry the same shear: one hinge.
    ASSERT_EQ(1, HingeSpots(type, HINGE_COMPONENT::Fz, span, spots, reason));
    EXPECT_EQ((std::vector<T_HINGE_SPOT>{{0.5, "C", false, 1.0}}), spots);
    span.isLoaded = true;
    ASSERT_EQ(1, HingeSpots(type, HINGE_COMPONENT::Fz, span, spots, reason));
    EXPECT_EQ(2u, spots.size());
    span.kind = ELEM_KIND::Link;
    ASSERT_EQ(1, HingeSpots(type, HINGE_COMPONENT::Fz, span, spots, reason));
    EXPECT_EQ((std::vector<T_HINGE_SPOT>{{0.0, "C", false, 1.0}}), spots);
}
