// What the windows of hinges ask their models for.
#include "hingesample.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/po_hingefemaenrgdsptgrid.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"
#include "scriptview.h"

#include <gtest/gtest.h>

TEST(HingeEditors, ElementListsAreReadWholeOrNotAtAll)
{
    for (const auto& [text, shown] : {std::pair{"", ""},
                                      {" 9 , 5-7,6 ", "5-7, 9"},
                                      {"2,1", "1, 2"},
                                      {"2147483647", "2147483647"}})
        EXPECT_EQ(shown, ElementListText(ParseElementList(text).value())) << text;
    for (const char* bad :
         {"x", "1,", ",1", "3-1", "0", "-3", "1-2-3", "1-2000002", "99999999999", "1.5"})
        EXPECT_FALSE(ParseElementList(bad)) << bad;
}

TEST(HingeEditors, HeadsNameTheUnitOfTheDefinition)
{
    using C = HINGE_COMPONENT;
    T_HINGE_OWNER owner;
    owner.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    EXPECT_EQ("x (kN m)", StrengthHead("x", C::My, owner));
    EXPECT_EQ("x (rad)", DeformHead("x", C::My, owner));
    EXPECT_EQ("x (m)", DeformHead("x", C::Fz, owner));
    EXPECT_EQ("x (kN/m)", StiffnessHead("x", C::Fz, owner));
    owner.type.definition = HINGE_DEFINITION::CurvatureLumped;
    EXPECT_EQ("x (m-1)", DeformHead("x", C::My, owner));
    EXPECT_EQ("x (kN m2)", StiffnessHead("x", C::My, owner));
    EXPECT_EQ("x", DeformHead("x", C::Fx, owner)); // strain
}

TEST(HingeEditors, AEurocodeCurveComesBackDigitByDigitEvenWithoutAYieldDeformation)
{
    T_SKEL_EC8 curve = ValidBackbone<T_SKEL_EC8>();
    curve.sides.neg.yieldDeform = 0.0;
    CPO_HingeSkcvTabEuroDlg dlg;
    ASSERT_TRUE(dlg.Data2Dlg(HINGE_COMPONENT::My, ComponentWith(SKEL_TYPE::Ec8, curve)));
    ASSERT_TRUE(dlg.OnMeasureRdo(HINGE_END::Both, SKEL_MEASURE::Plastic));
    const T_SKEL_EC8& now = *dlg.Curve(HINGE_END::Both);
    EXPECT_DOUBLE_EQ(0.05, now.sides.pos.C.deform); // (6 - 1) 0.01
    EXPECT_EQ(0.0, now.sides.neg.C.deform);
    ASSERT_TRUE(dlg.OnMeasureRdo(HINGE_END::Both, SKEL_MEASURE::DDy));
    EXPECT_EQ(curve, *dlg.Curve(HINGE_END::Both));
}

TEST(HingeEditors, NameTheModelAndWhatIsNotInUse)
{
    using D = HINGE_DEFINITION;
    using C = HINGE_COMPONENT;
    EXPECT_EQ("Moment - Rotation (M-Ry)", HingeModelLabel(D::MomentRotation, C::My));
    EXPECT_EQ("Moment - Curvature (M-Rz Lumped)", HingeModelLabel(D::CurvatureLumped, C::Mz));
    EXPECT_EQ("Moment - Curvature (M-Rx Distributed)",
              HingeModelLabel(D::CurvatureDistributed, C::Mx));
    EXPECT_EQ("", HingeModelLabel(D::MomentRotation, C::Fz));
    EXPECT_EQ("0.5", CriterionText(true, 0.5));
    EXPECT_EQ("Inactive", CriterionText(false, 0.5));
    T_PHGT_D type;
    type.interaction = HINGE_INTERACTION::PMM;
    type.interactionMz = HINGE_INTERACTION::P;
    type.components[0] = ComponentWith(SKEL_TYPE::Trilinear, T_SKEL_MULTI());
    type.components[4] = ComponentWith(SKEL_TYPE::Fema, T_SKEL_FEMA());
    type.components[5] = ComponentWith(SKEL_TYPE::SlipBilinear, T_SKEL_MULTI());
    EXPECT_EQ("PMM, P; Multilinear, FEMA", CPushOverHingeListDlg::KindText(type));
}

namespace {

/// A type of a solid steel section 200 x 100 mm, fy 300, in N and mm.
T_HINGE_OWNER SteelOwner()
{
    T_SECT_D bar;
    bar.shape = SECT_SHAPE::Rectangle, bar.size = {200, 100};
    T_MATL_D steel;
    steel.Fy = 300, steel.E = 210000;
    const T_UNITS units{FORCE_UNIT::N, LENGTH_UNIT::mm};
    T_HINGE_OWNER owner;
    owner.type.section = owner.type.sectionMaterial = 1;
    owner.units = units;
    owner.sources = std::make_shared<CHingeSources>(T_TABLE<T_SECT_D>{{1, bar}},
                                                    T_TABLE<T_MATL_D>{{1, steel}}, units);
    return owner;
}

} // namespace

// My = 300 * 100 * 200^2 / 4 = 300 kNm.
TEST(HingeEditors, AutomaticStrengthsAreTakenWhenTheyAreChosen)
{
    const auto my = HINGE_COMPONENT::My;
    CPO_HingeSkcvTabFemaDlg dlg;
    dlg.m_owner = SteelOwner();
    T_SKEL_FEMA entered = ValidBackbone<T_SKEL_FEMA>();
    ASSERT_EQ(1, dlg.Data2Dlg(my, ComponentWith(SKEL_TYPE::Fema, entered)));
    dlg.OnUserAutoRdo(my, HINGE_END::Both, true);
    const T_SKEL_FEMA& curve = *dlg.Curve(my, HINGE_END::Both);
    EXPECT_TRUE(curve.autoYield);
    EXPECT_NEAR(300e6, curve.sides.pos.yield, 1.0);
    EXPECT_NEAR(300e6, curve.sides.neg.yield, 1.0);
    dlg.OnUserAutoRdo(my, HINGE_END::Both, false);
    dlg.Curve(my, HINGE_END::Both)->sides.pos.yield = 7;
    dlg.SetAutoCalcValue(my, HINGE_END::Both, {1, 1}); // no longer automatic
    dlg.OnEdited();
    EXPECT_EQ(7, curve.sides.pos.yield);
}

TEST(HingeEditors, EnergyFactorsOfTheTableAreTakenOnlyWhenTheirRulesHold)
{
    const auto my = HINGE_COMPONENT::My;
    CPO_HingeSkcvTabFemaDlg dlg;
    CScriptView view;
    dlg.SetView(&view);
    const T_SKEL_FEMA given = ValidBackbone<T_SKEL_FEMA>();
    ASSERT_EQ(1, dlg.Data2Dlg(my, ComponentWith(SKEL_TYPE::Fema, given)));
    double last = 0.8; // E above D = 0.5
    view.m_run = [&](zql::frx::MDialog& child) {
        dynamic_cast<CPO_HingeFEMAEnrgDsptGrid&>(child).m_factors[1][3] = last;
        return 1;
    };
    EXPECT_EQ(0, dlg.OnEnergyBtn(my, HINGE_END::Both));
    EXPECT_EQ(given, *dlg.Curve(my, HINGE_END::Both));
    last = 0.1;
    EXPECT_EQ(1, dlg.OnEnergyBtn(my, HINGE_END::Both));
    EXPECT_EQ(0.1, dlg.Curve(my, HINGE_END::Both)->sides.neg.energy[3]);
}

TEST(HingeEditors, ACalculatedSurfaceIsDrawnWholeUntilItIsEdited)
{
    T_YIELD_SURFACE record;
    CPO_HingeYieldPropDlgNew dlg(record, SKEL_TYPE::Bilinear);
    dlg.m_owner = SteelOwner();
    EXPECT_TRUE(dlg.LinesOf(dlg.m_surface.yield).y.pos.empty());
    dlg.m_calculated = CalculatedLevel(dlg.m_owner);
    ASSERT_EQ(1, dlg.OnCalculateBtn());
    EXPECT_TRUE(dlg.Findings().empty()) << "the largest moment keeps the rule of the ratios";
    dlg.OnAxisChk(false, false); // what is drawn, not what the curve is
    const T_PM_LINES lines = dlg.LinesOf(dlg.m_surface.yield);
    ASSERT_LT(20u, lines.y.pos.size());
    for (const T_PM_POINT& p : lines.y.pos) // of a rectangle M / Mp = 1 - n2
        EXPECT_NEAR(1 - p.p * p.p, p.m, 1e-9);
    dlg.m_surface.yield.y.curves.pos[2].m -= 0.01;
    EXPECT_TRUE(dlg.LinesOf(dlg.m_surface.yield).y.pos.empty());
}

TEST(HingeEditors, TheOlderTableShowsTheOtherMeasureAndSwitches)
{
    CDBDoc doc;
    T_PHGT_D type;
    type.name = "column";
    T_SKEL_FEMA curve = ValidBackbone<T_SKEL_FEMA>(); // Dy 0.01 and 0.02
    type.components[4] = ComponentWith(SKEL_TYPE::Fema, curve);
    ASSERT_EQ(1, StoreHingeType(doc, 1, type));
    CPushOverHingeDataType table(doc);
    ASSERT_EQ(1, table.Data2Dlg(1, HINGE_COMPONENT::My));
    EXPECT_EQ("-0.12", table.OtherMeasureText(0)); // -E: -(7 - 1) 0.02
    EXPECT_EQ("", table.OtherMeasureText(4));
    EXPECT_EQ("0", table.OtherMeasureText(5));
    EXPECT_EQ("0.05", table.OtherMeasureText(6)); // C: (6 - 1) 0.01
    ASSERT_EQ(1, table.OnMeasureRdo(SKEL_MEASURE::Plastic));
    EXPECT_NEAR(-0.12, table.Point(0)->deform, 1e-15);
    EXPECT_EQ("-7", table.OtherMeasureText(0));
    curve.sides.neg.yieldDeform = 0;
    type.components[4] = ComponentWith(SKEL_TYPE::Fema, curve);
    ASSERT_EQ(1, StoreHingeType(doc, 1, type));
    ASSERT_EQ(1, table.Data2Dlg(1, HINGE_COMPONENT::My));
    EXPECT_EQ("-", table.OtherMeasureText(0));
    EXPECT_EQ(0, table.OnMeasureRdo(SKEL_MEASURE::Plastic)) << "every value would become 0";
    EXPECT_EQ(SKEL_MEASURE::DDy, table.Shown()->measure);
}

// Zy fy = 300, A fy = 200; 6 E I / span = 100, so that the rotation is 3.
TEST(HingeEditors, AutomaticPagesShowWhatTheTypesOwnSectionGives)
{
    T_SECT_D section;
    section.area = 2, section.Asy = section.Asz = section.J = section.Izz = section.Zz = 1;
    section.Iyy = 2, section.Zy = 3;
    T_MATL_D steel;
    steel.Fy = 100, steel.E = 100;
    T_HINGE_OWNER owner;
    owner.sources = std::make_shared<CHingeSources>(T_TABLE<T_SECT_D>{{1, section}},
                                                    T_TABLE<T_MATL_D>{{1, steel}}, owner.units);
    const auto fema = [&](double& deform) {
        CPO_HingeSkcvTabFemaDlg dlg;
        dlg.m_owner = owner;
        EXPECT_TRUE(
            dlg.Data2Dlg(HINGE_COMPONENT::My, ComponentWith(SKEL_TYPE::Fema, T_SKEL_FEMA())));
        dlg.OnEdited();
        const T_SKEL_SIDE& neg = dlg.Curve(HINGE_COMPONENT::My, HINGE_END::Both)->sides.neg;
        deform = neg.yieldDeform;
        return neg.yield;
    };
    double deform = 0.0;
    EXPECT_EQ(0.0, fema(deform)); // the type has no section: each element has its own
    owner.type.section = owner.type.sectionMaterial = 1;
    EXPECT_DOUBLE_EQ(300.0, fema(deform));
    EXPECT_EQ(0.0, deform); // each element has its own length
    owner.type.length.autoSpan = false, owner.type.length.span = 12;
    EXPECT_DOUBLE_EQ(300.0, fema(deform));
    EXPECT_DOUBLE_EQ(3.0, deform);

    T_YIELD_SURFACE surface;
    surface.yield.z.used = false;
    CPO_HingeYieldPropDlgNew dlg(surface, SKEL_TYPE::Fema);
    EXPECT_FALSE(dlg.OnCalculateBtn());
    dlg.m_calculated = CalculatedLevel(owner);
    ASSERT_TRUE(dlg.OnCalculateBtn());
    EXPECT_DOUBLE_EQ(200.0, dlg.m_surface.yield.compression);
    EXPECT_DOUBLE_EQ(300.0, dlg.m_surface.yield.y.moment.neg);
    EXPECT_FALSE(dlg.m_surface.yield.z.used);
}
