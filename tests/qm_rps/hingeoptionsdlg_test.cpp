#include "qm_rps/hingeoptionsdlg.h"

#include "numbers.h"
#include "qm_rps/hinge/hingechoices.h"

#include <gtest/gtest.h>

TEST(HingeOptions, CodePairsChooseTheMode)
{
    using Y = YIELD_CODE;
    const struct {
        const char *concrete, *steel;
        Y code;
    } kPairs[] = {
        {"Eurocode2", "Eurocode3:05", Y::Eurocode}, {"Eurocode2:04", "Eurocode3", Y::Eurocode},
        {"AIJ-WSD99", "AIJ-ASD02", Y::Aij},         {"Eurocode2:04", "AIJ-ASD02", Y::General},
        {"eurocode2", "Eurocode3", Y::General},     {"", "", Y::General}};
    for (const auto& p : kPairs)
        EXPECT_EQ(p.code, YieldCodeOf(p.concrete, p.steel)) << p.concrete << ' ' << p.steel;
}

TEST(HingeOptions, AreStoredAsOneStepAndKeepWhatElseTheModelHas)
{
    CDBDoc doc;
    CHingeOptionsDlg dlg(doc);
    const T_STYP_D before = doc.Data().Model().styp;
    dlg.m_alpha2[1] = -0.1;
    EXPECT_EQ(0, dlg.OnOK());
    EXPECT_EQ("alpha2.neg", dlg.Findings().at(0).field);
    dlg.m_alpha2[1] = kNan;
    EXPECT_EQ(0, dlg.OnOK());
    EXPECT_EQ(before, doc.Data().Model().styp);
    dlg.m_alpha2 = {0.02, 0.03};
    dlg.m_concreteCode = "my code";
    dlg.m_gsd = true;
    ASSERT_EQ(1, dlg.OnOK());
    T_STYP_D expected = before;
    expected.defaultAlpha2 = {0.02, 0.03};
    expected.designCodes.concrete = "my code";
    expected.gsd = true;
    EXPECT_EQ(expected, doc.Data().Model().styp);
    EXPECT_EQ("my code", CHingeOptionsDlg(doc).m_concreteCode);
    EXPECT_EQ("my code", CHingeOptionsDlg::ConcreteCodes("my code").back());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model().styp);
}
