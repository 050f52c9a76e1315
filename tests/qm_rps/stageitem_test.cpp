#include "qm_rps/ulfitemdialog.h"
#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknowntabletabgrid1.h"
#include "scriptview.h"
#include "twotrusses.h"

#include <gtest/gtest.h>

TEST(StageItem, HoldsItsConstraintsInTheTableAndTakesTheirNewNames)
{
    T_MODEL_CONTENT content = two::Content();
    content.model.ulfConstraints[1].stage = 1;
    CDBDoc doc;
    doc.Data().Assign(std::move(content));
    CUnknownTableTabGrid1 grid(doc);
    grid.m_selected = 1;
    EXPECT_EQ("DX of node 2 =      0.0000 (S1/Last Step)", grid.Rows().at(0).description);
    EXPECT_EQ(0, grid.OnDelete());
    EXPECT_NE(std::string::npos, grid.Messages().back().text.find("STAY"));
    CUnknownLoadFactorConstraintDlg constraint(doc, 1);
    constraint.m_constraint.name = "FAST";
    ASSERT_EQ(1, constraint.OnOK());
    EXPECT_EQ("FAST", doc.Data().Model().ulfStageItems.at(1).constraints.at(0));
}

TEST(StageItem, IsListedChangedAndDeletedWithTheStaticOnes)
{
    CDBDoc doc, empty;
    doc.Data().Assign(two::Content());
    CScriptView view;
    view.m_run = [](zql::frx::MDialog& child) {
        dynamic_cast<CUlfItemDialog&>(child).m_name = "STAY 2";
        return child.OnOK();
    };
    CUnknownLoadFactorDlg list(doc);
    list.SetView(&view);
    list.m_selected = 1;
    EXPECT_EQ(0, list.OnModify()) << "there is no static item 1";
    list.m_stage = true;
    ASSERT_EQ(1, list.OnModify());
    EXPECT_EQ((CUnknownLoadFactorDlg::T_ROW{1, "STAY 2", "", true}), list.Rows().at(0));
    EXPECT_EQ(0, list.OnAddStage()) << "an empty item is refused";
    ASSERT_EQ(1, list.OnDelete());
    EXPECT_TRUE(doc.Data().Model().ulfStageItems.empty());
    CUnknownLoadFactorDlg none(empty);
    EXPECT_EQ(0, none.OnAddStage());
    EXPECT_EQ("IDS_QM_ULSI_NO_STAGES", none.Messages().back().key);
}
