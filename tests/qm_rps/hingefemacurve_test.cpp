#include "hingesample.h"
#include "numbers.h"
#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"

#include <gtest/gtest.h>

namespace {

using F = T_SKEL_FEMA;

/// A curve and its sides, to be spoiled.
struct X {
    F f = ValidBackbone<F>();
    T_SKEL_SIDE &p = f.sides.pos, &n = f.sides.neg;
};

struct T_CASE {
    const char* rule; // first finding; empty: none
    void (*spoil)(X&);
};

// Each rule just outside and just inside its bound; the negative side mirrors the positive one.
// clang-format off
const T_CASE kCases[] = {
    { "F(B) > 0",   [](X& x) { x.p.B.strength = 0; } },
    { "",           [](X& x) { x.p.B.strength = 1e-12; } },
    { "D(B) > 0",   [](X& x) { x.p.B.deform = 0; } },
    { "",           [](X& x) { x.p.B.deform = 0; x.f.measure = SKEL_MEASURE::Plastic; } },
    { "F(C) > 0",   [](X& x) { x.p.C.strength = 0; } },
    { "F(D) >= 0",  [](X& x) { x.p.D.strength = -1e-12; } },
    { "",           [](X& x) { // many at their bounds at once
        x.p.D.strength = x.p.E.strength = x.n.D.strength = x.n.E.strength = 0;
        x.p.IO = 4, x.n.IO = -3, x.f.dcRatio = T_SIDES<double>{0, 1}, x.f.unloadProportion = 1; } },
    { "F(-B) < 0",  [](X& x) { x.n.B.strength = 0; } },
    { "F(-E) <= 0", [](X& x) { x.n.E.strength = 1e-12; } },
    { "D(B) <  D(C)",  [](X& x) { x.p.C.deform = 1; } },
    { "",              [](X& x) { x.p.C.deform = 1; x.p.C.strength = 1; } },
    { "D(B) <= D(C)",  [](X& x) { x.p.C.deform = 0.999; x.p.C.strength = 1; } },
    { "D(C) <= D(D) <= D(E)", [](X& x) { x.p.D.deform = 5.999; } },
    { "D(D) <  D(E)",  [](X& x) { x.p.E.deform = 6; } },
    { "",              [](X& x) { x.p.E.deform = 6; x.p.E.strength = 0.1; } },
    { "F(B) <= F(C)",  [](X& x) { x.p.C.strength = 0.999; } },
    { "F(D) <  F(C)",  [](X& x) { x.p.D.strength = 1.2; } },
    { "",              [](X& x) { x.p.D.strength = 1.199; } },
    { "F(E) <= F(D)",  [](X& x) { x.p.E.strength = 0.201; } },
    { "F(E) = F(D)",   [](X& x) { x.f.strengthLoss = false; x.p.E.strength = 0.199; } },
    { "",
      [](X& x) { x.f.strengthLoss = false; x.p.D.strength = x.p.E.strength = 1.2; } },
    { "D(-C) < D(-B)", [](X& x) { x.n.C.deform = -1; } },
    { "D(-E) <=  D(-D) <= D(-C)", [](X& x) { x.n.D.deform = -4.999; } },
    { "F(-E) = F(-D)",  [](X& x) { x.f.strengthLoss = false; x.n.E.strength = -0.299; } },
    { "IO <= LS",  [](X& x) { x.p.IO = 4.001; } },
    { "IO <= LS",  [](X& x) { x.n.IO = -3.001; } },
    { "LS <= CP",  [](X& x) { x.p.LS = 6.001; } },
    { "IDS_RPS_Error_Pushove_Hinge_Properties_DC_RATIO",
      [](X& x) { x.f.dcRatio = T_SIDES<double>{-0.001, 1}; } },
    { "IDS_RPS_Error_Pushove_Hinge_Properties_DC_RATIO",
      [](X& x) { x.f.dcRatio = T_SIDES<double>{0, 1.001}; } },
    { "IDS_RPS_PO_FEMA_Yield_FY_P", [](X& x) { x.p.yield = 0; } },
    { "IDS_RPS_PO_FEMA_Yield_FY_M", [](X& x) { x.n.yield = 0; } },
    { "",                           [](X& x) { x.p.yield = 0; x.f.autoYield = true; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness", [](X& x) { x.p.userStiffness = -0.001; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness",
      [](X& x) { x.f.asymStiffness = true; x.n.userStiffness = -0.001; } },
    { "",
      [](X& x) { x.f.initStiffness = INIT_STIFFNESS::EI6L; x.p.userStiffness = -1; } },
    { "IDS_RPS_PO_PHGT_UNLOADING_EXP", [](X& x) { x.f.unloadExponent = -0.001; } },
    { "IDS_RPS_PO_PHGT_UNLOADING_PRF", [](X& x) { x.f.unloadProportion = 1.001; } },
    { "",           [](X& x) { x.f.energyBased = true; x.f.unloadFactor = 1; x.p.energy = {}; } },
    { "A~B >= 0.0", [](X& x) { x.f.energyBased = true; x.p.energy[0] = -0.001; } },
    { "A~B >= 0.0",
      [](X& x) { x.f.energyBased = true; x.n.energy[0] = -0.001; x.p.energy[1] = 2; } },
    { "C >= D",     [](X& x) { x.f.energyBased = true; x.p.energy[2] = 0.751; } },
    { "D >= E",     [](X& x) { x.f.energyBased = true; x.p.energy[3] = 0.501; } },
    { "E >= 0.0",   [](X& x) { x.f.energyBased = true; x.p.energy[3] = -0.001; } },
    { "A~B >= C",   [](X& x) { x.f.energyBased = true; x.n.energy[1] = 1.001; } },
    { "-1.0 <= Unloading Stiffness Factor <= 1.0",
      [](X& x) { x.f.energyBased = true; x.f.unloadFactor = 1.001; } },
    { "-1.0 <= Unloading Stiffness Factor <= 1.0",
      [](X& x) { x.f.energyBased = true; x.f.unloadFactor = -1.001; } },
    { "D(C) <= D(D) <= D(E)", [](X& x) { x.p.E.deform = kNan; x.p.E.strength = 0.1; } },
    { "",           [](X& x) { x.f.symmetric = true; x.n = {}; } }, // mirrored, not entered
    { "F(E) >= 0", // the groups in their order
      [](X& x) { x.p.E.strength = -1; x.n.E.strength = 1; x.p.E.deform = 6; x.p.IO = 5;
        x.p.yield = 0; x.p.userStiffness = -1; x.f.unloadExponent = -1; } },
    { "IO <= LS",
      [](X& x) { x.p.IO = 5; x.f.dcRatio = T_SIDES<double>{2, 2}; x.p.yield = 0; } },
    { "IDS_RPS_PO_FEMA_Yield_FY_P",
      [](X& x) { x.p.yield = 0; x.p.userStiffness = -1; x.f.unloadExponent = -1; } },
    { "IDS_RPS_MULTI_CURVE_COUNT",
      [](X& x) { x.f.multiCurve = true; x.f.curves = {{0, x.f.sides}};
        x.f.curves[0].sides.pos.B.strength = 0; } },
    { "F(B) > 0",
      [](X& x) { x.f.multiCurve = true; x.f.curves = {{0, x.f.sides}, {5, x.f.sides}};
        x.f.curves[1].sides.pos.B.strength = 0; } },
    { "Axial Force 5 already exists!",
      [](X& x) { x.f.multiCurve = true; x.f.curves = {{5, x.f.sides}, {5, x.f.sides}}; } },
};
// clang-format on

TEST(HingeFemaCurve, ReportsEachRuleOutsideItsBoundAlone)
{
    for (const T_CASE& c : kCases) {
        X x;
        c.spoil(x);
        std::vector<T_FINDING> found;
        CurveFindings(x.f, {0}, found);
        EXPECT_EQ(c.rule, First(found)) << "row " << &c - kCases;
    }
}

TEST(HingeAxialForces, RefusesTheSameTheMissingAndTheOutlying)
{
    F f = ValidBackbone<F>();
    CPO_HingeSkcvTabFemaAxialGrid grid;
    grid.Data2Dlg({{-100, f.sides}, {200, {}}});
    EXPECT_EQ(0, grid.AddForce(200));
    EXPECT_EQ("Axial Force 200 already exists!", grid.Messages().back().text);
    EXPECT_EQ(0, grid.RemoveForce(1.5) + grid.ChangeForce(3, 4));
    EXPECT_EQ("Old Axial Force 3 does not exist!", grid.Messages().back().text);
    EXPECT_EQ(0, grid.ChangeForce(-100, 200) + grid.AddForce(kNan));
    EXPECT_EQ("IDS_RPS_PO_FEMA_AXIALFORE_OUTOFRANGE", grid.Messages().back().key);
    grid.Data2Dlg({{-100, f.sides}, {200, {}}}, CAxialForceList::T_RANGE{-500, 1000});
    EXPECT_EQ(0, grid.AddForce(1000.5) + grid.AddForce(-500.5) + grid.ChangeForce(200, 1001));
    EXPECT_EQ("IDS_RPS_PO_FEMA_AXIALFORE_OUTOFRANGE", grid.Messages().back().key);
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
