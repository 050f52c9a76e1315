#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknownstageitemdlg.h"
#include "qm_rps/unknowntabletabgrid1.h"
#include "scriptview.h"
#include "twotrusses.h"

#include <gtest/gtest.h>

namespace {

class StageItem : public testing::Test {
protected:
    void Open(T_MODEL_CONTENT content)
    {
        m_doc.Data().Assign(std::move(content));
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        T_ANALYSIS_ERROR fault;
        ASSERT_EQ(1, m_doc.RunAnalysis(options, fault)) << fault.text;
        m_dialog.emplace(m_doc, 1);
    }
    CDBDoc m_doc;
    std::optional<CUnknownStageItemDlg> m_dialog;
};

} // namespace

// By hand: T moves node 2 by -1/20, G by 4/20; T = 4 holds it.
TEST_F(StageItem, ResultHasARowForEachLoadWithStageAndStep)
{
    T_MODEL_CONTENT content = two::Content();
    content.model.ulfConstraints[1].stage = 1;
    content.model.ulfStageItems[1].rows.push_back(
        {1, kStageFirstStep, 3, false, 0.0, 1.0, false, kLoadGroupRest}); // known with 0
    content.model.loadCases[3].name = "P";
    content.model.loadCases[3].nodal = {{2, {20, 0, 0, 0, 0, 0}}};
    content.model.stages[1].activate.loads.push_back({3, kStageFirstStep});
    Open(std::move(content));
    ASSERT_EQ(1, m_dialog->OnCalculate());
    const T_ULF_RESULT& r = *m_dialog->Result();
    ASSERT_EQ(3U, r.cases.size());
    EXPECT_EQ("S1/First Step T", r.cases[0].name);
    EXPECT_EQ("S1/First Step G", r.cases[1].name);
    EXPECT_NEAR(4.0, r.factors[0], 1e-12);
    EXPECT_EQ(1.0, r.factors[1]);
    EXPECT_NEAR(-1.0 / 20, r.influence.at(0).at(0), 1e-15);
    EXPECT_NEAR(4.0 / 20, r.influence[0].at(1), 1e-15);
    EXPECT_NEAR(1.0, r.influence[0].at(2), 1e-15) << "also of the row that has no part";
    const T_ULF_RESULT_ROW row = UlfResultRows(r).at(0);
    EXPECT_EQ("HOLD (S1/Last Step)", UlfNameAt(row.name, row.place));
    EXPECT_TRUE(row.met && row.active);
}

TEST_F(StageItem, GroupOneReadsTheDeadLoadToo)
{
    T_MODEL_CONTENT content = two::Content();
    content.model.loadCases[2].group = kLoadGroupErection;
    content.model.ulfStageItems[1].rows[1].loadGroup = kLoadGroupErection;
    Open(std::move(content));
    ASSERT_EQ(1, m_dialog->OnCalculate());
    EXPECT_NEAR(4.0 / 20, m_dialog->Result()->influence.at(0).at(1), 1e-15); // that of G
    m_dialog->m_sumStageLoads = true;
    ASSERT_EQ(1, m_dialog->OnCalculate());
    EXPECT_NEAR(3.0 / 20, m_dialog->Result()->influence.at(0).at(1), 1e-15); // G and T
    using S = CUnknownStageItemDlg::T_SUMMARY;
    EXPECT_EQ(
        (std::array<S, 3>{S{"IDS_RPS_DL", 0, 0}, {"IDS_RPS_ER", 1, 0}, {"IDS_RPS_SUM", 2, 1}}),
        m_dialog->Summary());
}

TEST_F(StageItem, HoldsItsConstraintsInTheTableAndTakesTheirNewNames)
{
    T_MODEL_CONTENT content = two::Content();
    content.model.ulfConstraints[1].stage = 1;
    Open(std::move(content));
    CUnknownTableTabGrid1 grid(m_doc);
    grid.m_selected = 1;
    EXPECT_EQ("DX of node 2 =      0.0000 (S1/Last Step)", grid.Rows().at(0).description);
    EXPECT_EQ(0, grid.OnDelete());
    EXPECT_NE(std::string::npos, grid.Messages().back().text.find("STAY"));
    EXPECT_TRUE(m_doc.Data().Model().ulfConstraints.contains(1));
    CUnknownLoadFactorConstraintDlg constraint(m_doc, 1);
    constraint.m_constraint.name = "FAST";
    ASSERT_EQ(1, constraint.OnOK());
    EXPECT_EQ("FAST", m_doc.Data().Model().ulfStageItems.at(1).constraints.at(0));
}

TEST_F(StageItem, IsListedChangedAndDeletedWithTheStaticOnes)
{
    m_doc.Data().Assign(two::Content());
    CScriptView view;
    view.m_run = [](zql::frx::MDialog& child) {
        dynamic_cast<CUlfItemDialog&>(child).m_name = "STAY 2";
        return child.OnOK();
    };
    CUnknownLoadFactorDlg list(m_doc);
    list.SetView(&view);
    list.m_selected = 1;
    EXPECT_EQ(0, list.OnModify()) << "there is no static item 1";
    list.m_stage = true;
    ASSERT_EQ(1, list.OnModify());
    EXPECT_EQ((CUnknownLoadFactorDlg::T_ROW{1, "STAY 2", "", true}), list.Rows().at(0));
    EXPECT_EQ(0, list.OnAddStage()) << "an empty item is refused";
    ASSERT_EQ(1, list.OnDelete());
    EXPECT_TRUE(m_doc.Data().Model().ulfStageItems.empty());
    CDBDoc empty;
    CUnknownLoadFactorDlg none(empty);
    EXPECT_EQ(0, none.OnAddStage());
    EXPECT_EQ("IDS_QM_ULSI_NO_STAGES", none.Messages().back().key);
}
