// What the windows of hinges ask their models for.
#include "hingesample.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"

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
