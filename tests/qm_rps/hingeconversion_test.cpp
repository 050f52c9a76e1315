#include "hingesample.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"

#include <gtest/gtest.h>
#include <random>

namespace {

using F = T_SKEL_FEMA;
using D = CPO_HingeSkcvTabFemaDlg;
constexpr auto kMy = HINGE_COMPONENT::My;

void ExpectRow(const D::T_ROW& expected, const D::T_ROW& row)
{
    for (std::size_t i = 0; i < row.size(); ++i)
        EXPECT_NEAR(expected[i], row[i], 1e-12) << "position " << i + 1;
}

TEST(HingeConversion, GivesZeroForAnUnknownYieldDeformation)
{
    for (double theta : {0.0, 0.99e-7, -0.99e-7}) {
        EXPECT_EQ(0, D::ConvertParamPR2DDy(5, theta));
        EXPECT_EQ(0, D::ConvertParamDDy2PR(5, theta));
    }
    EXPECT_NEAR(4e-7, D::ConvertParamPR2DDy(5, 1e-7), 1e-20);
    EXPECT_NEAR(6, D::ConvertParamDDy2PR(0.05, 0.01), 1e-14);
}

TEST(HingeConversion, KeepsTheOddSourcesOfTheRowConversions)
{
    // By hand, f(v) = (v - 1) theta. Positions 2 and 3 both from 3; 7 from 9; 8 and 9 from the
    // new 7.
    D::T_ROW row{8, 7, 6, 1, 0, 1, 5, 6, 9};
    D::ConvertPR2DDy(0.5, 0.25, row);
    ExpectRow({-3.5, -2.5, -2.5, 1, 0, 1, 2, 0.25, 0.25}, row);
    // f(v) = 1 + v / theta
    row = {0.5, 0.25, 1, 9, 9, 9, 0.1, 0.2, 0.5};
    D::ConvertDDy2PR(0.5, 0.25, row);
    ExpectRow({-2, -3, -3, 0, 0, 0, 3, 13, 13}, row);
}

TEST(HingeConversion, ConvertsWholeCurvesValueByValueUnlikeTheRow)
{
    F f = ValidBackbone<F>();
    f.sides.pos.D.deform = 7; // C 6, D 7, E 8: all different
    f.curves = {{1, f.sides}};
    ASSERT_EQ(1, D::ConvertHingeParamPR2DDy(f));
    EXPECT_EQ(0, D::ConvertHingeParamPR2DDy(f));
    EXPECT_EQ(SKEL_MEASURE::Plastic, f.measure);
    const T_SKEL_SIDE &p = f.sides.pos, &n = f.sides.neg; // thetas 0.01 and 0.02
    const double expected[] = {0, 0.05,  0.06,  0.07,  0.01,  0.03,  0.05,
                               0, -0.08, -0.08, -0.12, -0.02, -0.04, -0.08};
    const double got[] = {p.B.deform, p.C.deform, p.D.deform, p.E.deform, p.IO, p.LS, p.CP,
                          n.B.deform, n.C.deform, n.D.deform, n.E.deform, n.IO, n.LS, n.CP};
    for (std::size_t i = 0; i < std::size(got); ++i)
        EXPECT_NEAR(expected[i], got[i], 1e-15) << i;
    EXPECT_EQ(1.2, p.C.strength);
    EXPECT_EQ(f.sides, f.curves[0].sides);
}

TEST(HingeConversion, GivesBackTheEnteredDigitsFromTheRecordAlone)
{
    std::mt19937 random(20240611);
    std::uniform_int_distribution<int> cents(2, 1500), theta(1, 999);
    for (int i = 0; i < 20000; ++i) {
        F f = ValidBackbone<F>();
        const double v = (100 + cents(random)) / 100.0; // two decimals, as typed
        f.sides.pos.yieldDeform = theta(random) / 1e5;
        f.sides.pos.C.deform = v;
        f.sides.neg.C.deform = -v;
        ASSERT_EQ(1, D::ConvertHingeParamPR2DDy(f));
        ASSERT_EQ(1, D::ConvertHingeParamDDy2PR(f));
        ASSERT_EQ(v, f.sides.pos.C.deform) << f.sides.pos.yieldDeform;
        ASSERT_EQ(-v, f.sides.neg.C.deform);
    }
}

TEST(HingeConversion, SwitchesThereAndBackWithoutLosingADigit)
{
    F f = ValidBackbone<F>();
    f.sides.pos.C.deform = 1.0000000012345678; // its plastic part keeps few digits
    f.sides.neg.yieldDeform = 0;               // makes every value of the side 0
    f.curves = {{-50, f.sides}, {80, f.sides}};
    D dlg;
    ASSERT_EQ(1, dlg.Data2Dlg(kMy, ComponentWith(SKEL_TYPE::Fema, f)));
    F& edited = *dlg.Curve(kMy, HINGE_END::Both);
    ASSERT_EQ(1, dlg.OnMeasureRdo(kMy, HINGE_END::Both, SKEL_MEASURE::Plastic));
    EXPECT_EQ(0, edited.sides.neg.C.deform);
    ASSERT_EQ(1, dlg.OnMeasureRdo(kMy, HINGE_END::Both, SKEL_MEASURE::DDy));
    EXPECT_EQ(f, edited);
    ASSERT_EQ(1, dlg.OnMeasureRdo(kMy, HINGE_END::Both, SKEL_MEASURE::Plastic));
    edited.sides.pos.LS = 0.05; // edited in between: converted, the others come back
    ASSERT_EQ(1, dlg.OnMeasureRdo(kMy, HINGE_END::Both, SKEL_MEASURE::DDy));
    f.sides.pos.LS = edited.sides.pos.LS;
    EXPECT_NEAR(6, edited.sides.pos.LS, 1e-14);
    EXPECT_EQ(f, edited);
}

} // namespace
