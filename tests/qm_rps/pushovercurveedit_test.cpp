#include "qm_rps/pushovercurveedit.h"

#include "numbers.h"
#include "pushsample.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "scriptview.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace {

/// Elastic-perfectly plastic push with a constant demand of 0.2 g, which it meets while elastic.
T_MODEL_CONTENT Plastic()
{
    T_MODEL_CONTENT c = ThreeMasses({0.03, 0.06, 0.09, 0.12}, {10, 10, 10, 10});
    c.model.spectra[1] = {"U", T_SPFC_USER{{0, 4}, {0.2, 0.2}, {}}};
    c.model.spectra[2] = {"low", T_SPFC_USER{{0, 4}, {0.1, 0.1}, {}}};
    return c;
}

struct T_EDIT {
    CDBDoc doc;
    std::unique_ptr<CPushOverCurveEdit> edit;
    explicit T_EDIT(const T_MODEL_CONTENT& content = Plastic())
    {
        doc.Data().Assign(content);
        edit = std::make_unique<CPushOverCurveEdit>(doc);
    }
    CPushOverCurveEdit* operator->() { return edit.get(); }
    bool Said(const char* key) const
    {
        return std::ranges::any_of(edit->Messages(), [&](const auto& m) { return m.key == key; });
    }
};

} // namespace

// Settings that break a rule are refused at their field; the result on show stays.
TEST(PushOverCurveEdit, RefusedSettingsKeepTheLastResultAndNameTheField)
{
    using E = T_EVAL_D;
    struct T_BAD {
        const char* field;
        void (*spoil)(E&);
    };
    // clang-format off
    const T_BAD bad[] = {
        {"push",            [](E& e) { e.push = "gone"; }},
        {"spectrum",        [](E& e) { e.spectrum = ""; }},
        {"procedure",       [](E& e) { e.procedure = 'C'; }},
        {"behavior",        [](E& e) { e.behavior = 4; }},
        {"elasticDamping",  [](E& e) { e.elasticDamping = -1.0; }},
        {"elasticDamping",  [](E& e) { e.elasticDamping = 100.1; }},
        {"elasticDamping",  [](E& e) { e.elasticDamping = kNan; }},
        {"userDamping",     [](E& e) { e.userDamping = {40, 0.9, 30, 0.5}; }},
        {"driftKind",       [](E& e) { e.driftKind = 3; }},
        {"plotType",        [](E& e) { e.plotType = -1; }},
        {"bilinear.secant", [](E& e) { e.bilinear = T_EVAL_BILINEAR{{}, 0.0, 0.85, {}}; }},
        {"bilinear.drop",   [](E& e) { e.bilinear = T_EVAL_BILINEAR{{}, 0.6, 1.01, {}}; }},
    };
    // clang-format on
    T_EDIT edit;
    const T_EVAL_D good = edit->m_settings;
    const double before = edit->Shown().Result().point->Sd;
    for (const T_BAD& b : bad) {
        edit->m_settings = good;
        b.spoil(edit->m_settings);
        edit->OnEdited();
        ASSERT_EQ(1U, edit->Findings().size()) << b.field;
        EXPECT_EQ(b.field, edit->Findings()[0].field);
        EXPECT_NE(std::string::npos, edit->Shown().Refusal().find(edit->Findings()[0].text))
            << b.field;
        EXPECT_EQ(before, edit->Shown().Pictured().point->Sd) << b.field;
        EXPECT_EQ(0, edit->OnStore()) << b.field;
    }
    edit->m_settings = good;
    edit->OnEdited();
    EXPECT_TRUE(edit->Findings().empty());
    EXPECT_EQ("", edit->Shown().Refusal());
}

TEST(PushOverCurveEdit, ACurveWithoutSpectrumKeepsTheLastPictureButNotItsValues)
{
    T_MODEL_CONTENT c = Plastic();
    c.model.pushovers[2] = PushX("P0", 3); // no results
    T_EDIT edit(c);
    edit->m_settings.push = "P0";
    edit->OnEdited();
    EXPECT_FALSE(edit->Shown().Result().point);
    EXPECT_EQ("PX", edit->Shown().Pictured().eval.push);
    EXPECT_NE("", edit->Shown().Refusal());
    EXPECT_EQ("-", PushoverResultCells(edit->Shown().Result()).rows.at(1).at(1));
}

TEST(PushOverCurveEdit, AnotherMethodTakesAProcedureAndPlotThatItHas)
{
    T_EDIT edit;
    const T_EVAL_D& e = edit->m_settings;
    edit->m_methodPage.ChangeMethod(PUSH_METHOD::Fema440);
    edit->m_settings.procedure = 'C';
    edit->m_settings.plotType = 4;
    edit->m_methodPage.ChangeMethod(PUSH_METHOD::Atc40);
    EXPECT_FALSE(e.procedure || e.plotType);
    edit->m_settings.procedure = 'B';
    edit->m_settings.plotType = 2; // not of a method
    edit->m_methodPage.ChangeMethod(PUSH_METHOD::Fema440);
    EXPECT_EQ('B', e.procedure);
    edit->m_methodPage.ChangeMethod(PUSH_METHOD::Ec8Opcm);
    EXPECT_EQ(std::nullopt, e.procedure);
    EXPECT_EQ(2, e.plotType);
}

TEST(PushOverCurveEdit, StoringIsOneUndoableEditAndAsksBeforeItReplaces)
{
    T_EDIT edit;
    const auto& stored = edit.doc.Data().Model().evaluations;
    edit->m_settings.name = "mine";
    edit->m_settings.elasticDamping = 4.0;
    ASSERT_EQ(1, edit->OnStore());
    ASSERT_EQ(1U, stored.size());
    EXPECT_EQ(edit->m_settings, stored.at(1));
    edit->m_settings.elasticDamping = 3.0;
    EXPECT_EQ(0, edit->OnStore()); // nobody to say yes
    CScriptView view;
    edit->SetView(&view);
    EXPECT_EQ(0, edit->OnStore()); // the answer is no
    EXPECT_EQ(4.0, stored.at(1).elasticDamping);
    view.m_yes = true;
    EXPECT_EQ(1, edit->OnStore());
    EXPECT_EQ(3.0, stored.at(1).elasticDamping);
    EXPECT_EQ(1, edit.doc.Undo().Undo());
    EXPECT_EQ(4.0, edit.doc.Data().Model().evaluations.at(1).elasticDamping);
    edit->m_settings.name.clear();
    EXPECT_EQ(0, edit->OnStore());
    EXPECT_TRUE(edit.Said("IDS_QM_UI_PUSH_NO_NAME"));
}

TEST(PushOverCurveEdit, StepsAreStoredOnRequestOnly)
{
    T_EDIT edit;
    EXPECT_EQ(0, edit->OnStoreSteps()); // ATC-40 has none
    EXPECT_TRUE(edit.Said("IDS_QM_UI_PUSH_NO_STEPS"));
    edit->m_methodPage.ChangeMethod(PUSH_METHOD::Ec8Opcm);
    edit->OnEdited();
    EXPECT_FALSE(edit.doc.Data().IsModified());
    EXPECT_EQ(1, edit->OnStoreSteps());
    EXPECT_TRUE(edit.doc.Data().IsModified());
}

TEST(PushOverCurveEdit, AdditionalStepsAndPointsComeAgainWithEachEvaluation)
{
    T_EDIT edit;
    for (const int step : {2, 4, 2, 5}) { // one listed already, one that does not exist
        edit->m_addStep = step;
        edit->OnAddStep();
    }
    EXPECT_TRUE(edit.Said("IDS_QM_STEP_LISTED"));
    EXPECT_TRUE(edit.Said("IDS_QM_NO_SUCH_STEP"));
    edit->m_addSpectrum = "low";
    EXPECT_EQ(1, edit->OnAddPoint());
    edit->m_settings.elasticDamping = 6.0;
    edit->OnEdited();
    const T_PUSH_EVALUATION& e = edit->Shown().Result();
    ASSERT_EQ(2U, e.additionalSteps.size());
    EXPECT_NEAR(0.06, e.additionalSteps[0].D, 1e-12);
    ASSERT_EQ(1U, e.additionalPoints.size());
    EXPECT_NEAR(e.point->Sa / 2, e.additionalPoints[0].point->Sa, 1e-9);
    edit->OnRemoveStep(0);
    ASSERT_EQ(1U, e.additionalSteps.size());
    EXPECT_EQ(4, e.additionalSteps[0].step);
    edit->OnRemovePoint(0);
    EXPECT_TRUE(e.additionalPoints.empty());
}

TEST(PushOverCurveEdit, TheDocumentIsFollowedWhenItChanges)
{
    T_EDIT edit;
    EXPECT_EQ(0, edit->OnDocumentChanged());
    T_MODEL_CONTENT other = Plastic();
    const double before = edit->Shown().Result().point->Sa;
    std::swap(other.model.spectra[1].data, other.model.spectra[2].data);
    edit.doc.Data().Assign(other);
    EXPECT_EQ(1, edit->OnDocumentChanged());
    EXPECT_NEAR(before / 2, edit->Shown().Result().point->Sa, 1e-12);
    other.model.pushovers[1].name = "PY";
    edit.doc.Data().Assign(other);
    EXPECT_EQ(1, edit->OnDocumentChanged());
    EXPECT_EQ("PY", edit->m_settings.push);
    edit.doc.Data().Assign({});
    EXPECT_EQ(1, edit->OnDocumentChanged());
    EXPECT_TRUE(edit->Shown().Pictured().capacity.Sd.empty());
    EXPECT_NE("", edit->Shown().Refusal());
}

// Between the steps at 0.03 m with 10 kN and 0.06 m with 14 kN, at a quarter of the way.
TEST(PushoverCells, APointIsPlacedOnTheCurvesOfOtherPlotTypes)
{
    T_MODEL_CONTENT c = ThreeMasses({0.03, 0.06, 0.09}, {10, 14, 15});
    c.model.spectra[1] = Plastic().model.spectra[1];
    T_EDIT edit(c);
    for (const auto& [type, y] : {std::pair(0, 11.0), {3, 0.625}}) { // load factor: 0.5 per step
        edit->m_settings.plotType = type;
        edit->OnEdited();
        const auto at = PlaceOnCurve(edit->Shown().Result(), 0.0375 / kGamma);
        ASSERT_TRUE(at) << type;
        EXPECT_NEAR(0.0375, at->x, 1e-12) << type;
        EXPECT_NEAR(y, at->y, 1e-12) << type;
        EXPECT_FALSE(PlaceOnCurve(edit->Shown().Result(), 0.091 / kGamma)) << "beyond the curve";
    }
}

TEST(PushoverCells, ATargetTellsItsBranchInOneLine)
{
    T_TARGET_DISP t;
    t.Tstar = 0.75;
    t.Se = 0.3;
    t.det = t.dt = 0.04;
    EXPECT_EQ("(Long) det* = dt* = 0.04, Gamma = 1.25, Se(T*) = 0.3, T* = 0.75",
              TargetLine(t, 1.25));
    t.qu = 1.5;
    t.dt = 0.05;
    EXPECT_EQ("(Short) T* = 0.75, Se(T*) = 0.3 , det* = 0.04, dt* = 0.05, Gamma = 1.25",
              TargetLine(t, 1.25));
}

// A push along one line gives no capacity; a kink of 1 % at its end does.
TEST(PushoverCells, ACurveThatStaysElasticShowsNoCapacity)
{
    for (const bool kink : {false, true}) {
        T_MODEL_CONTENT c = ThreeMasses({0.03, 0.06, 0.09}, {10, 20, kink ? 29.7 : 30});
        c.model.spectra[1] = Plastic().model.spectra[1];
        T_EDIT edit(c);
        edit->m_settings.method = PUSH_METHOD::Ntc2008;
        edit->OnEdited();
        EXPECT_EQ(!kink, edit->Shown().Result().elastic);
        const std::vector<std::string> row = PushoverStateCells(edit->Shown().Result()).rows.at(1);
        EXPECT_EQ(!kink, row.at(3) == "Elastic" && row.at(1) == "-" && row.at(2) == "-");
    }
}
