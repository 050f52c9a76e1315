#include "qm_rps/unknownloadfactorresultdlg.h"

#include "scriptview.h"
#include "tempfolder.h"
#include "ulfdocument.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/unknownloadfactoritemdlg.h"

#include <gtest/gtest.h>

namespace {

using zql::lib::MMSGFunction;

struct UnknownLoadFactorResult : testing::Test {
    UnknownLoadFactorResult()
    {
        five::Fill(m_doc);
        m_result = CUnknownLoadFactorItemDlg(m_doc, 1).Calculate().result.value();
        (void)TakeMessageHistory();
    }
    CDBDoc m_doc;
    T_ULF_RESULT m_result;
};

} // namespace

TEST_F(UnknownLoadFactorResult, SplitsCombinationsAndGoesOnAfterARefusedOne)
{
    T_MODEL_CONTENT content = m_doc.Data().Content();
    T_LCOM_D& base = content.model.combinations[1];
    base.items.clear();
    T_ULF_RESULT result;
    result.item.combination = 1;
    for (int key = 1; key <= 999; ++key) {
        content.model.loadCases[key].name = "L" + std::to_string(key);
        base.items.push_back({false, key, 2.0});
        result.cases.push_back({key, "", 2.0});
        result.factors.push_back(3.0);
    }
    content.model.combinations[5] = {"taken-2", {{false, 1, 1.0}}};
    m_doc.Data().Assign(content);
    (void)TakeMessageHistory();
    CUnknownLoadFactorResultDlg dlg(m_doc, result);
    dlg.m_combinationName = "taken";
    EXPECT_EQ(0, dlg.OnMakeCombination());
    const std::vector<std::string> lines = TakeMessageHistory();
    ASSERT_EQ(3u, lines.size());
    EXPECT_EQ(MMSGFunction::Format("IDS_RPS_UNKNOWN_LOAD_LCOM_FAIL", {"taken-2"}), lines[1]);
    const auto& made = m_doc.Data().Model().combinations;
    EXPECT_EQ((T_LCOM_ITEM{false, 999, 6.0}), made.at(6).items.at(998));     // multiplied
    EXPECT_EQ((T_LCOM_D{"taken", {{true, 6, 1.0}}}), made.rbegin()->second); // what was added
    EXPECT_EQ(1, m_doc.Undo().Undo());                                       // all in one edit
    EXPECT_EQ(2u, m_doc.Data().Model().combinations.size());
}

TEST_F(UnknownLoadFactorResult, ExportsTheSheetOrSaysWhyNot)
{
    CUnknownLoadFactorResultDlg dlg(m_doc, m_result);
    const CTempFolder folder;
    const std::string path = folder / "sheet.xlsx";
    EXPECT_EQ(1, dlg.OnExport(path, {16, 2024, 5, 6, "five"}));
    EXPECT_GT(std::filesystem::file_size(path), 1000u);
    EXPECT_EQ(0, dlg.OnExport(folder / "missing/x.xlsx", {}));
    EXPECT_EQ("IDS_QM_ULF_SHEET_NOT_WRITTEN", dlg.Messages().back().key);
    T_ULF_RESULT wide = m_result;
    wide.constraints.resize(231);
    CUnknownLoadFactorResultDlg old(m_doc, wide);
    EXPECT_EQ(0, old.OnExport(folder / "old.xlsx", {11, 0, 0, 0, {}}));
    EXPECT_EQ("IDS_RPS_UNKNOWN_LOAD_EXCEED_COLUMN_ERROR", old.Messages().back().key);
    EXPECT_EQ(1u, folder.Names().size());
}

TEST_F(UnknownLoadFactorResult, FactorsThatMissConstraintsAreWrittenOnlyWhenThePersonWantsIt)
{
    m_result.constraints.at(0).upper = m_result.constraints.at(0).lower = 1.0; // it is 0
    const CTempFolder folder;
    CScriptView view;
    for (const bool yes : {false, true}) {
        view.m_yes = yes;
        CUnknownLoadFactorResultDlg dlg(m_doc, m_result);
        dlg.SetView(&view);
        dlg.m_combinationName = "N";
        EXPECT_EQ(yes, dlg.OnMakeCombination() == 1);
        EXPECT_EQ(yes, dlg.OnExport(folder / "s.xlsx", {}) == 1);
        EXPECT_EQ(yes ? 1U : 0U, folder.Names().size());
    }
    EXPECT_EQ(2U, m_doc.Data().Model().combinations.size());
}
