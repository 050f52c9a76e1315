// What the windows of hinges ask their models for.
#include "hingesample.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/pushoverhingedatatype.h"

#include <gtest/gtest.h>

TEST(HingeEditors, ElementListsAreReadWholeOrNotAtAll)
{
    struct T_CASE {
        const char* text;
        const char* shown; // null: refused
    };
    for (const T_CASE& c : {T_CASE{"", ""},
                            {"7", "7"},
                            {" 9 , 5-7,6 ", "5-7, 9"},
                            {"2,1", "1, 2"},
                            {"x", nullptr},
                            {"1,", nullptr},
                            {",1", nullptr},
                            {"3-1", nullptr},
                            {"0", nullptr},
                            {"-3", nullptr},
                            {"1-2-3", nullptr},
                            {"1-2000002", nullptr},
                            {"99999999999", nullptr},
                            {"1.5", nullptr}}) {
        const auto ids = ParseElementList(c.text);
        ASSERT_EQ(c.shown != nullptr, ids.has_value()) << c.text;
        if (ids) {
            EXPECT_EQ(c.shown, ElementListText(*ids)) << c.text;
        }
    }
}

TEST(HingeEditors, HeadsNameTheUnitOfTheDefinition)
{
    using C = HINGE_COMPONENT;
    T_HINGE_OWNER owner;
    owner.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    EXPECT_EQ("x (kN m)", StrengthHead("x", C::My, owner));
    EXPECT_EQ("x (rad)", DeformHead("x", C::My, owner));
    EXPECT_EQ("x (kN m)", StiffnessHead("x", C::My, owner));
    EXPECT_EQ("x (m)", DeformHead("x", C::Fz, owner));
    EXPECT_EQ("x (kN/m)", StiffnessHead("x", C::Fz, owner));
    owner.type.definition = HINGE_DEFINITION::CurvatureLumped;
    EXPECT_EQ("x (m-1)", DeformHead("x", C::My, owner));
    EXPECT_EQ("x (kN m2)", StiffnessHead("x", C::My, owner));
    EXPECT_EQ("x", DeformHead("x", C::Fx, owner)); // strain
    EXPECT_EQ("x (kN)", StiffnessHead("x", C::Fx, owner));
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

TEST(HingeEditors, AnAxialForceOnShowIsEditedAndMarkedAloneAndSidesAreMirrored)
{
    T_SKEL_FEMA curve = ValidBackbone<T_SKEL_FEMA>();
    curve.symmetric = true;
    curve.multiCurve = true;
    curve.curves = {{0.0, curve.sides}, {100.0, curve.sides}};
    constexpr auto kMy = HINGE_COMPONENT::My;
    CPO_HingeSkcvTabFemaDlg dlg;
    ASSERT_TRUE(dlg.Data2Dlg(kMy, ComponentWith(SKEL_TYPE::Fema, curve)));
    EXPECT_EQ(kMy, dlg.First());
    dlg.OnSelChangeAxialCombo(kMy, HINGE_END::Both, 1);
    dlg.ShownSides(kMy, HINGE_END::Both).pos.C.deform = 0.5; // before B
    dlg.OnEdited();
    const T_SKEL_FEMA& now = *dlg.Curve(kMy, HINGE_END::Both);
    EXPECT_EQ(6.0, now.curves[0].sides.pos.C.deform);
    EXPECT_EQ(-0.5, now.curves[1].sides.neg.C.deform);
    EXPECT_EQ(0.5, dlg.ShownCurve(kMy, HINGE_END::Both).sides.pos.C.deform);
    const std::vector<T_FINDING> found = dlg.Findings();
    ASSERT_FALSE(found.empty());
    EXPECT_EQ("sides.pos.C.deform", dlg.FieldOnPages(found.front()));
    dlg.OnSelChangeAxialCombo(kMy, HINGE_END::Both, 0);
    EXPECT_EQ("curves[1].sides.pos.C.deform", dlg.FieldOnPages(found.front()));
    dlg.OnSelChangeAxialCombo(kMy, HINGE_END::Both, 9); // the list has become shorter
    EXPECT_EQ(1, dlg.AxialIndex(kMy, HINGE_END::Both));
}

TEST(HingeEditors, FindingsOfATypeNameThePartOfTheEditorTheyBelongTo)
{
    const auto field = [](const char* path, int component, HINGE_END end = HINGE_END::Both) {
        T_FINDING f;
        f.field = path;
        f.part = component;
        f.page = static_cast<int>(end);
        return CPO_HingeTypeDlg::FieldOf(f) + " " + PathInType(f);
    };
    EXPECT_EQ("name name", field("name", -1));
    EXPECT_EQ("Fz.type Fz.type", field("type", 2));
    EXPECT_EQ("My.curve My.J.sides.pos.B.deform", field("sides.pos.B.deform", 4, HINGE_END::J));
    EXPECT_EQ("yieldSurface.yield.y.moment.pos My.yieldSurface.yield.y.moment.pos",
              field("yieldSurface.yield.y.moment.pos", 4));
}

TEST(HingeEditors, TheTableNamesItsPointsAsFindingsDo)
{
    const char* expected[] = {"sides.neg.E.", "sides.neg.D.", "sides.neg.C.", "sides.neg.B.", "",
                              "sides.pos.B.", "sides.pos.C.", "sides.pos.D.", "sides.pos.E.", ""};
    for (std::size_t row = 0; row < std::size(expected); ++row)
        EXPECT_EQ(expected[row], CPushOverHingeDataType::PointField(row)) << row;
}
