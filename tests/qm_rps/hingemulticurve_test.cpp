#include "hingesample.h"
#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"

#include <gtest/gtest.h>

namespace {

using M = T_SKEL_MULTI;
using E = T_SKEL_EC8;

M ValidMulti()
{
    M m;
    m.symmetric = m.autoYield = false;
    m.initStiffness = INIT_STIFFNESS::User;
    m.sides.pos = {10, 20, 30, 0.1, 0.2, 0.3, 0.5, 0.1, 0, 100};
    m.sides.neg = {11, 21, 31, 0.1, 0.2, 0.3, 0.5, 0.1, 0, 100};
    return m;
}

/// A curve and its sides, to be spoiled.
struct X {
    M m = ValidMulti();
    T_SKEL_MULTI_SIDE &p = m.sides.pos, &n = m.sides.neg;
};
struct Y {
    E e = ValidBackbone<E>();
    T_SKEL_SIDE &p = e.sides.pos, &n = e.sides.neg;
};

struct T_CASE {
    int component; // 0 Fx, 4 My
    SKEL_TYPE type;
    const char* rule;
    void (*spoil)(X&);
};
constexpr auto kBi = SKEL_TYPE::Bilinear;
constexpr auto kTri = SKEL_TYPE::Trilinear;
constexpr auto kSlip = SKEL_TYPE::SlipBilinear;

// clang-format off
const T_CASE kCases[] = {
    { 0, kBi,  "", [](X&) {} },
    { 0, kTri, "", [](X& x) { x.m.useUltimate = x.m.useDeformation = true; } },
    { 0, kBi,  "IDS_DB_YIELD_FORCE_POS1",  [](X& x) { x.p.P1 = 1e-9; } },
    { 0, kBi,  "",                         [](X& x) { x.p.P1 = 1.1e-9; } },
    { 4, kBi,  "IDS_DB_YIELD_MOMENT_POS1", [](X& x) { x.p.P1 = 0; x.n.P1 = 0; } },
    { 0, SKEL_TYPE::CompressionOnly, "IDS_DB_YIELD_FORCE_NEG1", [](X& x) { x.n.P1 = 0; } },
    { 4, kSlip, "IDS_DB_YIELD_MOMENT_NEG1", [](X& x) { x.n.P1 = 0; } },
    { 0, kBi,  "", [](X& x) { x.m.autoYield = true; x.p.P1 = 0; } },
    { 0, kBi,  "", [](X& x) { x.m.symmetric = true; x.n = {}; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_POS",  [](X& x) { x.p.P2 = 0; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_NEG",  [](X& x) { x.n.P2 = 0; x.p.P1 = 99; } },
    { 4, SKEL_TYPE::SlipTrilinear, "IDS_DB_YIELD_MOMENT_NEG", [](X& x) { x.n.P2 = 0; } },
    { 0, kTri, "IDS_DB_CRACK_FORCE_COMP_PLUS", [](X& x) { x.p.P1 = 20.001; x.n.P1 = 99; } },
    { 0, kTri, "IDS_DB_CRACK_FORCE_COMP_MNUS", [](X& x) { x.p.P1 = 20; x.n.P1 = 21.001; } },
    { 0, kTri, "IDS_DB_ULTIMATE_FORCE_POS",  [](X& x) { x.m.useUltimate = true; x.p.P3 = 0; } },
    { 0, kTri, "",                           [](X& x) { x.p.P3 = 0; } },
    { 0, kTri, "IDS_DB_ULTIMATE_FORCE_NEG",
      [](X& x) { x.m.useUltimate = true; x.n.P3 = 0; x.p.P3 = 1; } },
    { 4, kTri, "IDS_DB_ULTIMATE_MOMENT_NEG", [](X& x) { x.m.useUltimate = true; x.n.P3 = 0; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_COMP_PLUS",
      [](X& x) { x.m.useUltimate = true; x.p.P3 = 19.999; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_COMP_MNUS",
      [](X& x) { x.m.useUltimate = true; x.p.P3 = 20; x.n.P3 = 20.999; } },
    { 0, kBi,  "IDS_DB_1ST_YIELD_DISP", [](X& x) { x.m.useDeformation = true; x.p.D1 = 0; } },
    { 4, kBi,  "IDS_DB_1ST_YIELD_ROTN",
      [](X& x) { x.m.useDeformation = true; x.n.D1 = 0; x.p.D2 = 0; } },
    { 4, kBi,  "IDS_DB_2ND_YIELD_ROTN", [](X& x) { x.m.useDeformation = true; x.p.D2 = 0; } },
    { 0, kTri, "IDS_DB_3RD_YIELD_DISP", [](X& x) { x.m.useDeformation = true; x.p.D3 = 0; } },
    { 0, kBi,  "",
      [](X& x) { x.m.useDeformation = true; x.p.D3 = 0; x.p.alpha1 = -1; } },
    { 0, kBi,  "IDS_DB_YIELD_DISP_COMPARE1",
      [](X& x) { x.m.useDeformation = true; x.p.D1 = 0.201; } },
    { 4, kBi,  "IDS_DB_YIELD_ROTN_COMPARE1",
      [](X& x) { x.m.useDeformation = true; x.n.D1 = 0.201; x.p.D2 = 0.101; } },
    { 0, kBi,  "D2 > D1 (if P2 > P1)", [](X& x) { x.m.useDeformation = true; x.p.D1 = 0.2; } },
    { 0, kBi,  "D2 > D1 (if P2 > P1)", [](X& x) { x.m.useDeformation = true; x.n.D1 = 0.2; } },
    { 0, kBi,  "",
      [](X& x) { x.m.useDeformation = true; x.p.D1 = 0.2; x.p.P2 = 10; } },
    { 0, kTri, "IDS_DB_YIELD_DISP_COMPARE2",
      [](X& x) { x.m.useDeformation = true; x.p.D2 = 0.301; } },
    { 0, kTri, "D3 > D2 (if P3 > P2)", [](X& x) { x.m.useDeformation = true; x.p.D3 = 0.2; } },
    { 0, kTri, "",
      [](X& x) { x.m.useDeformation = true; x.p.D3 = 0.2; x.p.P3 = 20; } },
    { 0, kBi,  "IDS_DB_1ST_STIF_REDU_RATIO_POS", [](X& x) { x.p.alpha1 = -0.001; } },
    { 0, kBi,  "IDS_DB_1ST_STIF_REDU_RATIO_NEG",
      [](X& x) { x.p.alpha1 = 0; x.n.alpha1 = -0.001; } },
    { 0, kBi,  "",                               [](X& x) { x.p.alpha1 = 0; x.p.alpha2 = -1; } },
    { 0, kTri, "IDS_DB_2ND_STIF_REDU_RATIO_POS", [](X& x) { x.p.alpha2 = -0.001; } },
    { 0, kTri, "IDS_DB_2ND_STIF_REDU_RATIO_NEG", [](X& x) { x.n.alpha2 = -0.001; } },
    { 0, kSlip, "IDS_DB_INIT_GAP_VALUE", [](X& x) { x.p.gap = -0.001; } },
    { 0, kSlip, "",
      [](X& x) { x.m.gapSides = GAP_SIDES::Positive; x.n.gap = -1; } },
    { 0, kSlip, "",
      [](X& x) { x.m.gapSides = GAP_SIDES::Negative; x.p.gap = -1; } },
    { 0, kBi,   "",                      [](X& x) { x.p.gap = -1; } },
    { 0, kBi,  "IDS_RPS_PO_PHGT_Initial_Stiffness", [](X& x) { x.p.userStiffness = -0.001; } },
    { 0, kBi,  "", [](X& x) { x.m.initStiffness = INIT_STIFFNESS::EI3L; x.p.userStiffness = -1; } },
};

struct T_EC8_CASE {
    const char* rule;
    void (*spoil)(Y&);
};
const T_EC8_CASE kEc8[] = {
    { "M(-E) <= 0", [](Y& x) { x.n.E.strength = 0.001; } },
    { "D(B) <  D(C)", [](Y& x) { x.p.C.deform = 1; } },
    { "D(C) <= D(D) <= D(E)", [](Y& x) { x.p.D.deform = 5.999; } },
    { "D(C) <= D(C) <= D(D) <= D(E)", [](Y& x) { x.p.C = {0.999, 1}; } },
    { "",             [](Y& x) { x.p.C = {1, 1}; } },
    { "D(D) <  D(E)", [](Y& x) { x.p.E.deform = 6; } },
    { "M(D) <  M(C)", [](Y& x) { x.p.D.strength = x.p.E.strength = 1.2; } },
    { "M(C) <= M(D)",
      [](Y& x) { x.e.strengthLoss = false; x.p.D.strength = x.p.E.strength = 1.199; } },
    { "M(E) =  M(D)", [](Y& x) { x.p.E.strength = 0.199; } },
    { "D(-E) <=  D(-D) <= D(-C)", [](Y& x) { x.n.D.deform = -4.999; } },
    { "D(-E) <=  D(-D) <= D(-C) <= D(-B)", [](Y& x) { x.n.C = {-0.999, -1}; } },
    { "M(-E) =  M(-D)", [](Y& x) { x.n.E.strength = -0.299; } },
    { "LS <= CP", [](Y& x) { x.n.CP = -2.999; } },
    { "IDS_RPS_PO_FEMA_Yield_MY_P", [](Y& x) { x.p.yield = 0; x.p.userStiffness = 0; } },
    { "",                           [](Y& x) { x.p.yield = 0; x.e.autoYield = true; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness", [](Y& x) { x.p.userStiffness = 0; } },
    { "",
      [](Y& x) { x.p.userStiffness = 0; x.n.userStiffness = 0;
        x.e.initStiffness = INIT_STIFFNESS::EI6L; } },
};
// clang-format on

TEST(HingeMultilinear, ReportsEachRuleOutsideItsBoundAlone)
{
    for (const T_CASE& c : kCases) {
        X x;
        c.spoil(x);
        std::vector<T_FINDING> found;
        CurveFindings(x.m, c.type, {c.component}, found);
        EXPECT_EQ(c.rule, First(found)) << "row " << &c - kCases;
    }
}

TEST(HingeMultilinear, NamesTheItemAndWritesNothingWhenRefused)
{
    T_HINGE_COMPONENT data = ComponentWith(kBi, ValidMulti());
    const T_HINGE_COMPONENT before = data;
    CPO_HingeSkcvTabDlg dlg;
    ASSERT_EQ(1, dlg.Data2Dlg(HINGE_COMPONENT::Fz, data));
    dlg.Curve(HINGE_END::I)->sides.pos.P1 = -1;
    EXPECT_EQ(0, dlg.Dlg2Data(data));
    EXPECT_EQ(before, data);
    EXPECT_EQ("Hinge properties of component Fz are wrong. "
              "Look at: yield force P1(+), must be > 0.",
              dlg.Messages().back().text);
    dlg.Curve(HINGE_END::I)->symmetric = true;
    dlg.Curve(HINGE_END::I)->sides.pos.P1 = 7;
    EXPECT_EQ(1, dlg.Dlg2Data(data));
    EXPECT_EQ(7, std::get<M>(data.curves.J).sides.neg.P1);
}

TEST(HingeEc8, ReportsEachRuleOutsideItsBoundAlone)
{
    for (const T_EC8_CASE& c : kEc8) {
        Y y;
        c.spoil(y);
        std::vector<T_FINDING> found;
        CurveFindings(y.e, {5}, found);
        EXPECT_EQ(c.rule, First(found)) << "row " << &c - kEc8;
    }
}

} // namespace
