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

struct T_CASE {
    int component; // 0 Fx, 4 My
    SKEL_TYPE type;
    const char* rule;
    void (*spoil)(M&);
};
constexpr auto kBi = SKEL_TYPE::Bilinear;
constexpr auto kTri = SKEL_TYPE::Trilinear;
constexpr auto kSlip = SKEL_TYPE::SlipBilinear;

// clang-format off
const T_CASE kCases[] = {
    { 0, kBi,  "", [](M&) {} },
    { 0, kTri, "", [](M& m) { m.useUltimate = m.useDeformation = true; } },
    { 0, kBi,  "IDS_DB_YIELD_FORCE_POS1",  [](M& m) { m.sides.pos.P1 = 1e-9; } },
    { 0, kBi,  "",                         [](M& m) { m.sides.pos.P1 = 1.1e-9; } },
    { 4, kBi,  "IDS_DB_YIELD_MOMENT_POS1", [](M& m) { m.sides.pos.P1 = 0; m.sides.neg.P1 = 0; } },
    { 0, SKEL_TYPE::CompressionOnly, "IDS_DB_YIELD_FORCE_NEG1", [](M& m) { m.sides.neg.P1 = 0; } },
    { 4, kSlip, "IDS_DB_YIELD_MOMENT_NEG1", [](M& m) { m.sides.neg.P1 = 0; } },
    { 0, kBi,  "", [](M& m) { m.autoYield = true; m.sides.pos.P1 = 0; } },
    { 0, kBi,  "", [](M& m) { m.symmetric = true; m.sides.neg = {}; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_POS",  [](M& m) { m.sides.pos.P2 = 0; } },
    { 4, kTri, "IDS_DB_YIELD_MOMENT_POS", [](M& m) { m.sides.pos.P2 = 0; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_NEG",  [](M& m) { m.sides.neg.P2 = 0; m.sides.pos.P1 = 99; } },
    { 4, SKEL_TYPE::SlipTrilinear, "IDS_DB_YIELD_MOMENT_NEG", [](M& m) { m.sides.neg.P2 = 0; } },
    { 0, kTri, "IDS_DB_CRACK_FORCE_COMP_PLUS", [](M& m) { m.sides.pos.P1 = 20.001; m.sides.neg.P1 = 99; } },
    { 0, kTri, "IDS_DB_CRACK_FORCE_COMP_MNUS", [](M& m) { m.sides.pos.P1 = 20; m.sides.neg.P1 = 21.001; } },
    { 0, kTri, "IDS_DB_ULTIMATE_FORCE_POS",  [](M& m) { m.useUltimate = true; m.sides.pos.P3 = 0; } },
    { 4, kTri, "IDS_DB_ULTIMATE_MOMENT_POS", [](M& m) { m.useUltimate = true; m.sides.pos.P3 = 0; } },
    { 0, kTri, "",                           [](M& m) { m.sides.pos.P3 = 0; } },
    { 0, kTri, "IDS_DB_ULTIMATE_FORCE_NEG",  [](M& m) { m.useUltimate = true; m.sides.neg.P3 = 0; m.sides.pos.P3 = 1; } },
    { 4, kTri, "IDS_DB_ULTIMATE_MOMENT_NEG", [](M& m) { m.useUltimate = true; m.sides.neg.P3 = 0; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_COMP_PLUS", [](M& m) { m.useUltimate = true; m.sides.pos.P3 = 19.999; } },
    { 0, kTri, "IDS_DB_YIELD_FORCE_COMP_MNUS", [](M& m) { m.useUltimate = true; m.sides.pos.P3 = 20; m.sides.neg.P3 = 20.999; } },
    { 0, kBi,  "IDS_DB_1ST_YIELD_DISP", [](M& m) { m.useDeformation = true; m.sides.pos.D1 = 0; } },
    { 4, kBi,  "IDS_DB_1ST_YIELD_ROTN", [](M& m) { m.useDeformation = true; m.sides.neg.D1 = 0; m.sides.pos.D2 = 0; } },
    { 0, kBi,  "IDS_DB_2ND_YIELD_DISP", [](M& m) { m.useDeformation = true; m.sides.neg.D2 = 0; m.sides.pos.D1 = 9; } },
    { 4, kBi,  "IDS_DB_2ND_YIELD_ROTN", [](M& m) { m.useDeformation = true; m.sides.pos.D2 = 0; } },
    { 0, kTri, "IDS_DB_3RD_YIELD_DISP", [](M& m) { m.useDeformation = true; m.sides.pos.D3 = 0; } },
    { 4, kTri, "IDS_DB_3RD_YIELD_ROTN", [](M& m) { m.useDeformation = true; m.sides.neg.D3 = 0; } },
    { 0, kBi,  "",                      [](M& m) { m.useDeformation = true; m.sides.pos.D3 = 0; m.sides.pos.alpha1 = -1; } },
    { 0, kBi,  "IDS_DB_YIELD_DISP_COMPARE1", [](M& m) { m.useDeformation = true; m.sides.pos.D1 = 0.201; } },
    { 4, kBi,  "IDS_DB_YIELD_ROTN_COMPARE1", [](M& m) { m.useDeformation = true; m.sides.neg.D1 = 0.201; m.sides.pos.D2 = 0.101; } },
    { 0, kBi,  "D2 > D1 (if P2 > P1)", [](M& m) { m.useDeformation = true; m.sides.pos.D1 = 0.2; } },
    { 0, kBi,  "D2 > D1 (if P2 > P1)", [](M& m) { m.useDeformation = true; m.sides.neg.D1 = 0.2; } },
    { 0, kBi,  "D2 > D1 (if P2 > P1)", [](M& m) { m.useDeformation = true; m.sides.pos.D1 = 0.2; m.sides.pos.P2 = 10 + 2e-9; } },
    { 0, kBi,  "",                     [](M& m) { m.useDeformation = true; m.sides.pos.D1 = 0.2; m.sides.pos.P2 = 10; } },
    { 0, kTri, "IDS_DB_YIELD_DISP_COMPARE2", [](M& m) { m.useDeformation = true; m.sides.pos.D2 = 0.301; } },
    { 4, kTri, "IDS_DB_YIELD_ROTN_COMPARE2", [](M& m) { m.useDeformation = true; m.sides.neg.D2 = 0.301; } },
    { 0, kTri, "D3 > D2 (if P3 > P2)", [](M& m) { m.useDeformation = true; m.sides.pos.D3 = 0.2; } },
    { 0, kTri, "D3 > D2 (if P3 > P2)", [](M& m) { m.useDeformation = true; m.sides.neg.D3 = 0.2; } },
    { 0, kTri, "",                     [](M& m) { m.useDeformation = true; m.sides.pos.D3 = 0.2; m.sides.pos.P3 = 20; } },
    { 0, kBi,  "IDS_DB_1ST_STIF_REDU_RATIO_POS", [](M& m) { m.sides.pos.alpha1 = -0.001; } },
    { 0, kBi,  "IDS_DB_1ST_STIF_REDU_RATIO_NEG", [](M& m) { m.sides.pos.alpha1 = 0; m.sides.neg.alpha1 = -0.001; } },
    { 0, kBi,  "",                               [](M& m) { m.sides.pos.alpha1 = 0; m.sides.pos.alpha2 = -1; } },
    { 0, kTri, "IDS_DB_2ND_STIF_REDU_RATIO_POS", [](M& m) { m.sides.pos.alpha2 = -0.001; } },
    { 0, kTri, "IDS_DB_2ND_STIF_REDU_RATIO_NEG", [](M& m) { m.sides.neg.alpha2 = -0.001; } },
    { 0, kSlip, "IDS_DB_INIT_GAP_VALUE", [](M& m) { m.sides.pos.gap = -0.001; } },
    { 0, kSlip, "IDS_DB_INIT_GAP_VALUE", [](M& m) { m.sides.neg.gap = -0.001; } },
    { 0, kSlip, "",                      [](M& m) { m.gapSides = GAP_SIDES::Positive; m.sides.neg.gap = -1; } },
    { 0, kSlip, "",                      [](M& m) { m.gapSides = GAP_SIDES::Negative; m.sides.pos.gap = -1; } },
    { 0, kBi,   "",                      [](M& m) { m.sides.pos.gap = -1; } },
    { 0, kBi,  "IDS_RPS_PO_PHGT_Initial_Stiffness", [](M& m) { m.sides.pos.userStiffness = -0.001; } },
    { 0, kBi,  "IDS_RPS_PO_PHGT_Initial_Stiffness", [](M& m) { m.sides.pos.userStiffness = 0; m.sides.neg.userStiffness = -0.001; } },
    { 0, kBi,  "", [](M& m) { m.initStiffness = INIT_STIFFNESS::EI3L; m.sides.pos.userStiffness = -1; } },
};

struct T_EC8_CASE {
    const char* rule;
    void (*spoil)(E&);
};
const T_EC8_CASE kEc8[] = {
    { "",          [](E&) {} },
    { "M(-E) <= 0", [](E& e) { e.sides.neg.E.strength = 0.001; } },
    { "D(B) <  D(C)", [](E& e) { e.sides.pos.C.deform = 1; } },
    { "D(C) <= D(D) <= D(E)", [](E& e) { e.sides.pos.D.deform = 5.999; } },
    { "D(C) <= D(C) <= D(D) <= D(E)", [](E& e) { e.sides.pos.C = {0.999, 1}; } },
    { "",             [](E& e) { e.sides.pos.C = {1, 1}; } },
    { "D(D) <  D(E)", [](E& e) { e.sides.pos.E.deform = 6; } },
    { "M(B) <= M(C)", [](E& e) { e.sides.pos.C.strength = 0.999; } },
    { "M(D) <  M(C)", [](E& e) { e.sides.pos.D.strength = e.sides.pos.E.strength = 1.2; } },
    { "M(C) <= M(D)", [](E& e) { e.strengthLoss = false; e.sides.pos.D.strength = e.sides.pos.E.strength = 1.199; } },
    { "M(E) =  M(D)", [](E& e) { e.sides.pos.E.strength = 0.199; } },
    { "D(-E) <=  D(-D) <= D(-C)", [](E& e) { e.sides.neg.D.deform = -4.999; } },
    { "D(-E) <=  D(-D) <= D(-C) <= D(-B)", [](E& e) { e.sides.neg.C = {-0.999, -1}; } },
    { "D(-E) <  D(-D)", [](E& e) { e.sides.neg.E.deform = -5; } },
    { "M(-C) <  M(-D)", [](E& e) { e.sides.neg.D.strength = e.sides.neg.E.strength = -1.3; } },
    { "M(-D) <= M(-C)", [](E& e) { e.strengthLoss = false; e.sides.pos.D.strength = e.sides.pos.E.strength = 1.2; e.sides.neg.D.strength = e.sides.neg.E.strength = -1.299; } },
    { "M(-E) =  M(-D)", [](E& e) { e.sides.neg.E.strength = -0.299; } },
    { "LS <= CP", [](E& e) { e.sides.neg.CP = -2.999; } },
    { "IDS_RPS_PO_FEMA_Yield_MY_P", [](E& e) { e.sides.pos.yield = 0; e.sides.pos.userStiffness = 0; } },
    { "",                           [](E& e) { e.sides.pos.yield = 0; e.autoYield = true; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness", [](E& e) { e.sides.pos.userStiffness = 0; } },
    { "IDS_RPS_PO_PHGT_Initial_Stiffness", [](E& e) { e.sides.neg.userStiffness = 0; } },
    { "", [](E& e) { e.sides.pos.userStiffness = 0; e.sides.neg.userStiffness = 0; e.initStiffness = INIT_STIFFNESS::EI6L; } },
};
// clang-format on

TEST(HingeMultilinear, ReportsEachRuleOutsideItsBoundAlone)
{
    for (const T_CASE& c : kCases) {
        M m = ValidMulti();
        c.spoil(m);
        std::vector<T_FINDING> found;
        CurveFindings(m, c.type, {c.component}, found);
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
        E e = ValidBackbone<E>();
        c.spoil(e);
        std::vector<T_FINDING> found;
        CurveFindings(e, {5}, found);
        EXPECT_EQ(c.rule, First(found)) << "row " << &c - kEc8;
    }
}

} // namespace
