#include "qm_rps/evaluationdeskdlg.h"

#include "pushsample.h"
#include "qm_rps/spectrumdlg.h"
#include "scriptview.h"

#include <gtest/gtest.h>

namespace {

/// Three evaluations of an elastic-perfectly plastic push under a constant demand.
T_MODEL_CONTENT Three()
{
    T_MODEL_CONTENT c = ThreeMasses({0.03, 0.06, 0.09, 0.12}, {10, 10, 10, 10});
    c.model.spectra[1] = {"U", T_SPFC_USER{{0, 4}, {0.2, 0.2}, {}}};
    const auto add = [&c](int key, const char* name, PUSH_METHOD method) {
        T_EVAL_D& e = c.model.evaluations[key];
        e.name = name;
        e.push = "PX";
        e.spectrum = "U";
        e.method = method;
    };
    add(1, "first", PUSH_METHOD::Atc40);
    add(2, "second", PUSH_METHOD::Fema440);
    add(3, "target", PUSH_METHOD::Ec8Opcm);
    return c;
}

class EvaluationDesk : public testing::Test {
protected:
    EvaluationDesk()
    {
        m_doc.Data().Assign(Three());
        m_desk = std::make_unique<CEvaluationDeskDlg>(m_doc);
        m_desk->SetView(&m_view);
    }
    const T_EVAL_D& Stored(int key) { return m_doc.Data().Model().evaluations.at(key); }

    CDBDoc m_doc;
    CScriptView m_view;
    std::unique_ptr<CEvaluationDeskDlg> m_desk;
};

} // namespace

// The demand of 0.2 g meets the first line, which reaches V = 10 kN at 0.03 m: V = 0.2 x 810/19 kN
// to the 5 % within which procedure A stops, D = 0.03 V / 10, and with storeys of 3 m that move
// alike a drift of D / 9.
TEST_F(EvaluationDesk, TheListHasEveryEvaluationWithItsFigures)
{
    ASSERT_EQ(3U, m_desk->List().size());
    EXPECT_EQ(0, m_desk->Chosen());
    const std::vector<T_CARD> cards = CardsOf(m_desk->List()[0]);
    const double V = *cards[static_cast<std::size_t>(CARD::V)].value, D = 0.003 * V;
    EXPECT_NEAR(0.2 * kWeightStar, V, 0.05 * V);
    EXPECT_NEAR(D, *cards[static_cast<std::size_t>(CARD::D)].value, 1e-12);
    EXPECT_NEAR(100.0 * D / 9.0, *cards[static_cast<std::size_t>(CARD::Drift)].value, 1e-9);
}

TEST_F(EvaluationDesk, AnEditOfAStoredEvaluationIsKeptAndUndone)
{
    m_desk->m_settings.elasticDamping = 8.0;
    m_desk->OnTaken();
    EXPECT_EQ(8.0, Stored(1).elasticDamping);
    EXPECT_FALSE(m_desk->HasUnsaved());
    EXPECT_EQ("Evaluation first", m_doc.Undo().UndoTitle());
    m_desk->OnTaken(); // nothing was changed: no further step
    ASSERT_EQ(1, m_doc.Undo().Undo());
    EXPECT_FALSE(m_doc.Undo().CanUndo());
    EXPECT_EQ(1, m_desk->Follow());
    EXPECT_EQ(std::nullopt, m_desk->m_settings.elasticDamping);
    EXPECT_EQ(std::nullopt, m_desk->Result().eval.elasticDamping);
}

// On the first line half the demand gives half the base shear, to the 5 % of procedure A.
TEST_F(EvaluationDesk, ResultsFollowTheSpectrumThatIsEditedBesideThem)
{
    const double before = *CardsOf(m_desk->List()[0])[static_cast<std::size_t>(CARD::V)].value;
    m_view.m_run = [](zql::frx::MDialog& child) {
        auto& spectrum = dynamic_cast<CSpectrumDlg&>(child);
        spectrum.m_edit.m_user.Sa = {0.1, 0.1};
        return spectrum.OnOK();
    };
    EXPECT_EQ(1, m_desk->OnSpectrum());
    const double after = *CardsOf(m_desk->List()[0])[static_cast<std::size_t>(CARD::V)].value;
    EXPECT_NEAR(0.1 * kWeightStar, after, 0.05 * after);
    EXPECT_LT(after, 0.6 * before);
}

TEST_F(EvaluationDesk, WhatIsRefusedOrBearsAnotherNameIsNotKept)
{
    m_desk->m_settings.elasticDamping = 101.0;
    m_desk->OnTaken();
    ASSERT_EQ(1U, m_desk->AllFindings().size());
    EXPECT_EQ("elasticDamping", m_desk->AllFindings()[0].field);
    EXPECT_EQ(EVALUATION_VERDICT::Refused, VerdictOf(m_desk->Entry()));
    EXPECT_FALSE(m_doc.Data().IsModified());
    EXPECT_EQ(0, m_desk->OnClose()); // it would be lost: the person is asked, and says no
    m_desk->m_settings.elasticDamping.reset();
    m_desk->m_settings.name = "second"; // of another one, which must not be overwritten
    m_desk->m_settings.behavior = 1;
    m_desk->OnTaken();
    EXPECT_FALSE(m_doc.Data().IsModified());
    m_desk->OnChoose(2);
    EXPECT_EQ(0, m_desk->Chosen()); // likewise
    m_view.m_yes = true;            // stores it, and replaces the other one
    m_desk->OnChoose(2);
    EXPECT_EQ("target", m_desk->Opened());
    EXPECT_EQ(1, Stored(2).behavior);
    EXPECT_EQ(PUSH_METHOD::Atc40, Stored(2).method);
}

TEST_F(EvaluationDesk, TwoTickedAreOverlaidAndCompared)
{
    EXPECT_EQ(3U, m_desk->Compared().size()); // none ticked: all of them
    m_desk->OnTick(0, true);
    EXPECT_TRUE(m_desk->Overlaid().empty()); // one is shown alone
    m_desk->OnTick(2, true);
    ASSERT_EQ(2U, m_desk->Overlaid().size());
    EXPECT_EQ("target", m_desk->Overlaid()[1]->eval.name);
    EXPECT_EQ(2U, m_desk->Compared().size());
    m_desk->OnTick(0, false);
    EXPECT_TRUE(m_desk->Overlaid().empty());
}

TEST_F(EvaluationDesk, AxesAreThoseOfThePersonElseOfTheRegion)
{
    const T_AXIS_SPAN region = m_desk->XSpan();
    ASSERT_TRUE(region.hi);
    EXPECT_GT(*region.hi, m_desk->Result().point->Sd);
    m_desk->m_axes.length = LENGTH_UNIT::mm;
    EXPECT_NEAR(1000.0 * *region.hi, *m_desk->XSpan().hi, 1e-9);
    EXPECT_EQ(LENGTH_UNIT::mm, m_desk->Entry().result.units.length);
    m_desk->m_axes.whole = true;
    EXPECT_EQ(T_AXIS_SPAN{}, m_desk->XSpan());
    m_desk->m_axes.xFrom = 5.0;
    m_desk->m_axes.xTo = 5.0;
    EXPECT_EQ((T_AXIS_SPAN{5.0, 5.0}), m_desk->XSpan());
    ASSERT_EQ(1U, m_desk->AllFindings().size());
    EXPECT_EQ("axes.x", m_desk->AllFindings()[0].field);
    EXPECT_FALSE(m_doc.Data().IsModified()); // it is of the window
}

TEST_F(EvaluationDesk, DeletingIsAStepAndANewOneIsStoredOnRequest)
{
    EXPECT_EQ(1, m_desk->OnDelete());
    EXPECT_EQ("second", m_desk->Opened());
    EXPECT_EQ(2U, m_desk->List().size());
    ASSERT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ("first", Stored(1).name);
    EXPECT_EQ(1, m_desk->Follow());
    m_desk->OnFresh();
    EXPECT_EQ(3, m_desk->Chosen()); // below the stored ones
    EXPECT_EQ(0, m_desk->OnDelete());
    EXPECT_EQ(1, m_desk->OnClose()); // nothing was changed in it
    EXPECT_EQ(1, m_desk->OnStore());
    EXPECT_EQ(4U, m_doc.Data().Model().evaluations.size());
}
