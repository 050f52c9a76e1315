#include "hingesample.h"
#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"

#include <gtest/gtest.h>
#include <limits>

namespace {

using F = T_SKEL_FEMA;
constexpr auto kFx = HINGE_COMPONENT::Fx;
constexpr auto kMy = HINGE_COMPONENT::My;
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

std::vector<T_FINDING> FindingsOf(const F& f, int component = 0)
{
    std::vector<T_FINDING> out;
    CurveFindings(f, {component}, out);
    return out;
}

struct T_CASE {
    const char* rule; // first finding; empty: none
    void (*spoil)(F&);
};

// Each rule just outside and just inside its bound.
// clang-format off
const T_CASE kCases[] = {
    { "F(B) > 0",   [](F& f) { f.sides.pos.B.strength = 0; } },
    { "",           [](F& f) { f.sides.pos.B.strength = 1e-12; } },
    { "D(B) > 0",   [](F& f) { f.sides.pos.B.deform = 0; } },
    { "",           [](F& f) { f.sides.pos.B.deform = 0; f.measure = SKEL_MEASURE::Plastic; } },
    { "F(C) > 0",   [](F& f) { f.sides.pos.C.strength = 0; } },
    { "F(D) >= 0",  [](F& f) { f.sides.pos.D.strength = -1e-12; } },
    { "",           [](F& f) { // many at their bounds at once
        f.sides.pos.D.strength = f.sides.pos.E.strength = f.sides.neg.D.strength = f.sides.neg.E.strength = 0;
        f.sides.pos.IO = 4, f.sides.neg.IO = -3, f.dcRatio = T_SIDES<double>{0, 1}, f.unloadProportion = 1; } },
    { "F(-B) < 0",  [](F& f) { f.sides.neg.B.strength = 0; } },
    { "D(-B) < 0",  [](F& f) { f.sides.neg.B.deform = 0; } },
    { "F(-C) < 0",  [](F& f) { f.sides.neg.C.strength = 0; } },
    { "F(-D) <= 0", [](F& f) { f.sides.neg.D.strength = 1e-12; } },
    { "F(-E) <= 0", [](F& f) { f.sides.neg.E.strength = 1e-12; } },
    { "D(B) <  D(C)",  [](F& f) { f.sides.pos.C.deform = 1; } },
    { "",              [](F& f) { f.sides.pos.C.deform = 1; f.sides.pos.C.strength = 1; } },
    { "D(B) <= D(C)",  [](F& f) { f.sides.pos.C.deform = 0.999; f.sides.pos.C.strength = 1; } },
    { "D(C) <= D(D) <= D(E)", [](F& f) { f.sides.pos.D.deform = 5.999; } },
    { "D(C) <= D(D) <= D(E)", [](F& f) { f.sides.pos.D.deform = 8.001; } },
    { "D(D) <  D(E)",  [](F& f) { f.sides.pos.E.deform = 6; } },
    { "",              [](F& f) { f.sides.pos.E.deform = 6; f.sides.pos.E.strength = 0.1; } },
    { "F(B) <= F(C)",  [](F& f) { f.sides.pos.C.strength = 0.999; } },
    { "F(D) <  F(C)",  [](F& f) { f.sides.pos.D.strength = 1.2; } },
    { "",              [](F& f) { f.sides.pos.D.strength = 1.199; } },
    { "F(E) <= F(D)",  [](F& f) { f.sides.pos.E.strength = 0.201; } },
    { "F(E) = F(D)",   [](F& f) { f.strengthLoss = false; f.sides.pos.E.strength = 0.199; } },
    { "",              [](F& f) { f.strengthLoss = false; f.sides.pos.D.strength = f.sides.pos.E.strength = 1.2; } },
    { "D(-C) < D(-B)", [](F& f) { f.sides.neg.C.deform = -1; } },
    { "D(-C) <= D(-B)", [](F& f) { f.sides.neg.C.deform = -0.999; f.sides.neg.C.strength = -1; } },
    { "D(-E) <=  D(-D) <= D(-C)", [](F& f) { f.sides.neg.D.deform = -4.999; } },
    { "D(-E) <=  D(-D) <= D(-C)", [](F& f) { f.sides.neg.D.deform = -7.001; } },
    { "D(-E) <  D(-D)", [](F& f) { f.sides.neg.E.deform = -5; } },
    { "F(-C) <= F(-B)", [](F& f) { f.sides.neg.C.strength = -0.999; } },
    { "F(-C) <  F(-D)", [](F& f) { f.sides.neg.D.strength = -1.3; } },
    { "F(-D) <= F(-E)", [](F& f) { f.sides.neg.E.strength = -0.301; } },
    { "F(-E) = F(-D)",  [](F& f) { f.strengthLoss = false; f.sides.neg.E.strength = -0.299; } },
    { "IO <= LS",  [](F& f) { f.sides.pos.IO = 4.001; } },
    { "IO <= LS",  [](F& f) { f.sides.neg.IO = -3.001; } },
    { "LS <= CP",  [](F& f) { f.sides.pos.LS = 6.001; } },
    { "LS <= CP",  [](F& f) { f.sides.neg.CP = -2.999; } },
    { "IDS_RPS_Error_Pushove_Hinge_Properties_DC_RATIO", [](F& f) { f.dcRatio = T_SIDES<double>{-0.001, 1}; } },
    { "IDS_RPS_Error_Pushove_Hinge_Properties_DC_RATIO", [](F& f) { f.dcRatio = T_SIDES<double>{0, 1.001}; } },
    { "IDS_RPS_PO_FEMA_Yield_FY_P", [](F& f) { f.sides.pos.yield = 0; } },
    { "IDS_RPS_PO_FEMA_Yield_FY_M", [](F& f) { f.sides.neg.yield = 0; } },
    { "",                           [](F& f) { f.sides.pos.yield = 0; f.autoYield = true; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness", [](F& f) { f.sides.pos.userStiffness = -0.001; } },
    { "",                                  [](F& f) { f.sides.pos.userStiffness = 0; f.sides.neg.userStiffness = -1; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness", [](F& f) { f.asymStiffness = true; f.sides.neg.userStiffness = -0.001; } },
    { "",                                  [](F& f) { f.initStiffness = INIT_STIFFNESS::EI6L; f.sides.pos.userStiffness = -1; } },
    { "IDS_RPS_PO_PHGT_UNLOADING_EXP", [](F& f) { f.unloadExponent = -0.001; } },
    { "IDS_RPS_PO_PHGT_UNLOADING_PRF", [](F& f) { f.unloadProportion = -0.001; } },
    { "IDS_RPS_PO_PHGT_UNLOADING_PRF", [](F& f) { f.unloadProportion = 1.001; } },
    { "",           [](F& f) { f.energyBased = true; f.unloadFactor = -1; } },
    { "",           [](F& f) { f.energyBased = true; f.unloadFactor = 1; f.sides.pos.energy = {}; } },
    { "A~B >= 0.0", [](F& f) { f.energyBased = true; f.sides.pos.energy[0] = -0.001; } },
    { "A~B >= 0.0", [](F& f) { f.energyBased = true; f.sides.neg.energy[0] = -0.001; f.sides.pos.energy[1] = 2; } },
    { "C >= D",     [](F& f) { f.energyBased = true; f.sides.pos.energy[2] = 0.751; } },
    { "D >= E",     [](F& f) { f.energyBased = true; f.sides.pos.energy[3] = 0.501; } },
    { "E >= 0.0",   [](F& f) { f.energyBased = true; f.sides.pos.energy[3] = -0.001; } },
    { "A~B >= C",   [](F& f) { f.energyBased = true; f.sides.neg.energy[1] = 1.001; } },
    { "-1.0 <= Unloading Stiffness Factor <= 1.0", [](F& f) { f.energyBased = true; f.unloadFactor = 1.001; } },
    { "-1.0 <= Unloading Stiffness Factor <= 1.0", [](F& f) { f.energyBased = true; f.unloadFactor = -1.001; } },
    { "F(B) > 0",   [](F& f) { f.sides.pos.B.strength = kNan; } },
    { "D(C) <= D(D) <= D(E)", [](F& f) { f.sides.pos.E.deform = kNan; f.sides.pos.E.strength = 0.1; } },
    { "",           [](F& f) { f.symmetric = true; f.sides.neg = {}; } }, // mirrored, not entered
    { "IDS_RPS_MULTI_CURVE_COUNT", [](F& f) { f.multiCurve = true; f.curves = {{0, f.sides}}; f.curves[0].sides.pos.B.strength = 0; } },
    { "F(B) > 0",   [](F& f) { f.multiCurve = true; f.curves = {{0, f.sides}, {5, f.sides}}; f.curves[1].sides.pos.B.strength = 0; } },
    { "Axial Force 5 already exists!", [](F& f) { f.multiCurve = true; f.curves = {{5, f.sides}, {5, f.sides}}; } },
};

/// Spoils one number in each group; each later row keeps those of the groups after it spoiled.
void (*const kGroups[])(F&) = {
    [](F& f) { f.sides.pos.E.strength = -1; }, [](F& f) { f.sides.neg.E.strength = 1; },
    [](F& f) { f.sides.pos.E.deform = 6; },    [](F& f) { f.sides.pos.IO = 5; },
    [](F& f) { f.dcRatio = T_SIDES<double>{2, 2}; }, [](F& f) { f.sides.pos.yield = 0; },
    [](F& f) { f.sides.pos.userStiffness = -1; },    [](F& f) { f.unloadExponent = -1; },
    [](F& f) { f.energyBased = true; f.sides.pos.energy[0] = -1; },
};
const char* const kGroupRules[] = {
    "M(E) >= 0", "M(-E) <= 0", "D(D) <  D(E)", "IO <= LS",
    "IDS_RPS_Error_Pushove_Hinge_Properties_DC_RATIO", "IDS_RPS_PO_FEMA_Yield_MY_P",
    "IDS_RPS_PO_PHGT_Initial_Stiffness", "IDS_RPS_PO_PHGT_UNLOADING_EXP", "A~B >= 0.0" };
// clang-format on

TEST(HingeFemaCurve, ReportsEachRuleOutsideItsBoundAlone)
{
    for (const T_CASE& c : kCases) {
        F f = ValidBackbone<F>();
        c.spoil(f);
        EXPECT_EQ(c.rule, First(FindingsOf(f))) << "row " << &c - kCases;
    }
}

TEST(HingeFemaCurve, ChecksTheGroupsInTheirOrder)
{
    for (std::size_t from = 0; from < std::size(kGroups); ++from) {
        F f = ValidBackbone<F>();
        for (std::size_t i = std::size(kGroups); i-- > from;)
            kGroups[i](f);
        EXPECT_EQ(kGroupRules[from], First(FindingsOf(f, 4)));
    }
}

TEST(HingeFemaCurve, ShowsTheFirstFindingAndWritesNothing)
{
    T_HINGE_COMPONENT data = ComponentWith(SKEL_TYPE::Fema, ValidBackbone<F>());
    data.sameEnds = false;
    CPO_HingeSkcvTabFemaDlg dlg;
    ASSERT_EQ(1, dlg.Data2Dlg(kMy, data));
    dlg.Curve(kMy, HINGE_END::J)->sides.pos.B.strength = 0;
    dlg.Curve(kMy, HINGE_END::J)->unloadExponent = -1;
    const T_HINGE_COMPONENT before = data;
    EXPECT_EQ(0, dlg.Dlg2Data(kMy, data));
    EXPECT_EQ(before, data);
    const auto found = dlg.Findings();
    ASSERT_EQ(2u, found.size());
    EXPECT_EQ(HINGE_END::J, EndOf(found[0]));
    EXPECT_EQ("Hinge properties of component My are wrong. This rule is not kept: M(B) > 0.",
              dlg.Messages().at(0).text);
    dlg.Component(kMy)->active = false;
    EXPECT_TRUE(dlg.Findings().empty());
}

TEST(HingeFemaCurve, WritesSymmetricCurvesMirrored)
{
    F f = ValidBackbone<F>();
    f.symmetric = true;
    T_HINGE_COMPONENT data = ComponentWith(SKEL_TYPE::Fema, f);
    CPO_HingeSkcvTabFemaDlg dlg;
    ASSERT_EQ(1, dlg.Data2Dlg(kFx, data));
    ASSERT_EQ(1, dlg.Dlg2Data(kFx, data));
    const T_SKEL_SIDE& n = std::get<F>(data.curves.J).sides.neg;
    EXPECT_EQ((T_SKEL_POINT{-6, -1.2}), n.C);
    EXPECT_EQ(-4, n.LS);
    EXPECT_EQ(100, n.yield);
}

TEST(HingeAxialForces, RefusesTheSameTheMissingAndTheOutlying)
{
    F f = ValidBackbone<F>();
    CPO_HingeSkcvTabFemaAxialGrid grid;
    grid.Data2Dlg({{-100, f.sides}, {200, {}}});
    grid.SetRange(-500, 1000);
    EXPECT_EQ(0, grid.AddForce(200));
    EXPECT_EQ("Axial Force 200 already exists!", grid.Messages().back().text);
    EXPECT_EQ(0, grid.RemoveForce(1.5));
    EXPECT_EQ(0, grid.ChangeForce(3, 4));
    EXPECT_EQ("Old Axial Force 3 does not exist!", grid.Messages().back().text);
    EXPECT_EQ(0, grid.ChangeForce(-100, 200));
    EXPECT_EQ("Axial Force 200 already exists!", grid.Messages().back().text);
    for (double force : {1000.5, -500.5, kNan}) {
        EXPECT_EQ(0, grid.AddForce(force));
        EXPECT_EQ("IDS_RPS_PO_FEMA_AXIALFORE_OUTOFRANGE", grid.Messages().back().key);
    }
    EXPECT_EQ(1, grid.AddForce(1000));
    EXPECT_EQ(1, grid.AddForce(-500));
    EXPECT_EQ(1, grid.ChangeForce(-100, 300)); // its curve moves with it
    EXPECT_EQ(1, grid.RemoveForce(1000));
    std::vector<T_SKEL_AXIAL> curves;
    grid.Dlg2Data(curves, {});
    ASSERT_EQ(3u, curves.size());
    EXPECT_EQ(-500, curves[0].axial);
    EXPECT_EQ(200, curves[1].axial);
    EXPECT_EQ((T_SKEL_AXIAL{300, f.sides}), curves[2]);
}

} // namespace
