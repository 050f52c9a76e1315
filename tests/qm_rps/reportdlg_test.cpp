#include "qm_rps/reportdlg.h"

#include "qm_db/editscope.h"
#include "tempfolder.h"

#include <algorithm>
#include <functional>
#include <gtest/gtest.h>

TEST(ReportDlg, KeepsItsSettingsInTheModelAsOneStepThatFilesHold)
{
    CDBDoc doc;
    const T_REPORT_D before = doc.Data().Model().styp.report;
    CReportDlg dlg(doc);
    EXPECT_TRUE(std::ranges::all_of(dlg.m_chosen, std::identity()));
    EXPECT_EQ(200, dlg.m_rows);
    dlg.m_head.author = "A. Engineer";
    dlg.m_rows = -1;
    EXPECT_EQ(0, dlg.OnMake());
    EXPECT_EQ("IDS_QM_UI_REPORT_ROWS_REFUSED", dlg.Messages().back().key);
    EXPECT_EQ(before, doc.Data().Model().styp.report);
    EXPECT_FALSE(doc.Data().IsModified()); // nor does closing the window keep anything
    dlg.m_rows = 50;
    dlg.m_chosen.fill(false);
    dlg.m_chosen[0] = dlg.m_chosen[9] = true;
    ASSERT_EQ(1, dlg.OnMake());
    const T_REPORT_D kept{{}, "A. Engineer", {}, {}, {"model", "remarks"}, 50};
    EXPECT_EQ(kept, doc.Data().Model().styp.report);
    EXPECT_TRUE(doc.Data().IsModified());

    const CTempFolder folder;
    for (const char* const name : {"m.qmdb", "m.json"}) {
        const std::string path = folder / name;
        T_FILE_ERROR error;
        ASSERT_EQ(1, doc.SaveAs(path, error)) << error.text;
        CDBDoc opened;
        const bool isCase = path.ends_with(".json");
        ASSERT_EQ(1, isCase ? opened.ImportCase(path, error)
                            : opened.OpenModel(path, OPEN_MODE::ReadOnly, error))
            << error.text;
        const CReportDlg again(opened);
        EXPECT_EQ("A. Engineer", again.m_head.author) << name;
        EXPECT_EQ(50, again.m_rows) << name;
        EXPECT_EQ(dlg.m_chosen, again.m_chosen) << name;
    }
    ASSERT_EQ(1, dlg.OnMake()); // the same settings are no further step
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model().styp.report);
}

TEST(ReportDlg, SaysWhereTheModelCantKeepThem)
{
    CDBDoc doc;
    CReportDlg dlg(doc);
    dlg.m_head.project = "Mill";
    ASSERT_EQ(1, doc.Edit().Begin("another step"));
    EXPECT_EQ(0, dlg.OnMake());
    EXPECT_EQ("IDS_QM_UI_REPORT_NOT_KEPT", dlg.Messages().back().key);
    EXPECT_FALSE(dlg.IsMade());
    doc.Edit().Rollback();
}

// The title block is kept in the model; the file says the same of the structure as before.
TEST(ReportDlg, TheFileIsKnownByItsHashUntilTheStructureChanges)
{
    CDBDoc doc;
    const CTempFolder folder;
    T_FILE_ERROR error;
    ASSERT_EQ(1, doc.SaveAs(folder / "m.qmdb", error)) << error.text;
    CReportDlg dlg(doc);
    dlg.m_fileHash = "0123abcd";
    const auto names = [&dlg] {
        return std::ranges::any_of(
            dlg.Document().head, [](const T_DOC_HEAD_ROW& row) { return row.value == "0123abcd"; });
    };
    for (const char* author : {"A. Engineer", "B. Engineer"}) {
        dlg.m_head.author = author;
        ASSERT_EQ(1, dlg.OnMake());
        EXPECT_TRUE(names()) << author;
    }
    CEditScope edit(doc, "node");
    T_NODE_D node;
    node.id = 1;
    ASSERT_TRUE(edit.Put(1, node) && edit.Commit());
    ASSERT_EQ(1, dlg.OnMake());
    EXPECT_FALSE(names());
}
