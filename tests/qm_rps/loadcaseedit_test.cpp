// Load cases edited on a document: stored as one step, refused whole.
#include "frametest.h"
#include "qm_db/casefile.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/po_loadcaselistdlg.h"

namespace {

class LoadCaseEdit : public FrameTest {
protected:
    void Start(CRPSDlgBase& dialog)
    {
        dialog.SetDoc(&m_doc);
        dialog.SetView(&m_view);
    }
    std::string LastMessage() const
    {
        return m_view.m_messages.empty() ? "" : m_view.m_messages.back();
    }
    std::string Text()
    {
        std::string text;
        T_FILE_ERROR error;
        EXPECT_EQ(1, CCaseFile::Print(m_doc.Data().Content(), text, error)) << error.text;
        return text;
    }
};

struct T_SPOIL {
    const char* key;
    void (*spoil)(CPO_LoadCaseDlg&);
};
const T_SPOIL kSpoils[] = {
    {"IDS_PUSHOVER_Error___Loadcase_name_is_not_input_", [](auto& d) { d.m_case.name = ""; }},
    {"IDS_QM_UI_POLC_NAME_TAKEN", [](auto& d) { d.m_case.name = "PX_UNIFORM"; }},
    {"IDS_QM_UI_POLC_NO_NODE", [](auto& d) { d.m_case.controlNode = 999; }},
    {"IDS_QM_UI_POLC_NO_RESULT", [](auto& d) { d.m_case.controlNode = 11; }}, // a support
    {"IDS_RPS_PO_POLC_Current_Stif_Ratio_0",
     [](auto& d) {
         d.m_case.control.emplace().incrementMethod = 2;
         d.m_case.control->stiffnessRatioLimit = -0.01;
     }},
    {"IDS_QM_UI_POLC_NO_MODE",
     [](auto& d) {
         d.m_input = {.kind = 2, .mode = 77.0};
         EXPECT_EQ(1, d.OnAddPattern(d.m_input));
     }},
    {"IDS_QM_UI_POLC_NO_CASE",
     [](auto& d) {
         d.m_input = {.kind = 0, .loadCase = 4};
         EXPECT_EQ(1, d.OnAddPattern(d.m_input));
     }},
};

} // namespace

TEST_F(LoadCaseEdit, EveryRuleIsAskedOfTheDocumentToo)
{
    Open("rc-frame-3-storey");
    ASSERT_EQ(1, m_doc.Edit().Begin("load case"));
    T_STLD_D load;
    load.name = "dead";
    ASSERT_EQ(1, m_doc.Edit().Put(1, load));
    ASSERT_EQ(1, m_doc.Edit().Commit());
    m_doc.Data().SetModified(false);
    const std::string before = Text();
    for (const T_SPOIL& s : kSpoils) {
        CPO_LoadCaseDlg dialog;
        Start(dialog);
        ASSERT_EQ(1, dialog.Key());
        EXPECT_TRUE(dialog.HasResults());
        EXPECT_TRUE(dialog.Findings().empty());
        s.spoil(dialog);
        EXPECT_EQ(0, dialog.OnOK()) << s.key;
        EXPECT_EQ(s.key, LastMessage());
        EXPECT_FALSE(m_doc.Data().IsModified()) << s.key;
    }
    EXPECT_EQ(before, Text());
}

TEST_F(LoadCaseEdit, OkIsOneStepAndEvaluationsFollowTheName)
{
    Open("rc-frame-3-storey");
    const std::string before = Text();
    CPO_LoadCaseDlg dialog;
    Start(dialog);
    dialog.m_case.name = "PUSH X";
    ASSERT_EQ(1, dialog.OnOK());
    int followed = 0;
    for (const auto& [key, eval] : Model().evaluations) {
        EXPECT_NE("PX_MODE1", eval.push);
        followed += eval.push == "PUSH X";
    }
    EXPECT_EQ(11, followed); // as many as named PX_MODE1
    ASSERT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ(before, Text());
    EXPECT_FALSE(m_doc.Undo().CanUndo());
}

TEST_F(LoadCaseEdit, ANewCaseGetsAFreeKeyAndNameAndMustBeFilled)
{
    Open("rc-frame-3-storey");
    CPO_LoadCaseDlg dialog;
    Start(dialog);
    ASSERT_EQ(1, dialog.SetKey(0));
    EXPECT_EQ("New 1", dialog.m_case.name);
    EXPECT_EQ(41, dialog.m_case.controlNode); // first of the top storey
    EXPECT_EQ(0, dialog.OnOK());              // no displacement yet
    dialog.m_case.control->masterMaxDispl = 10.0;
    dialog.m_input = {.kind = 1, .directionIndex = 0};
    ASSERT_EQ(1, dialog.OnAddPattern(dialog.m_input));
    ASSERT_EQ(1, dialog.OnOK());
    EXPECT_EQ(1, Model().pushovers.at(4).patternKind);
    dialog.m_case.control.reset(); // it has no results, so nothing would be left of it
    EXPECT_EQ(0, dialog.OnOK());
    EXPECT_EQ("IDS_QM_UI_POLC_NO_CONTROL", LastMessage());
    EXPECT_EQ(0, dialog.SetKey(12));
    ASSERT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ(0, dialog.OnOK()); // gone meanwhile
    EXPECT_EQ("IDS_QM_UI_POLC_GONE", LastMessage());
}

TEST_F(LoadCaseEdit, AUsedCaseStaysAndItsUsersAreNamed)
{
    Open("rc-frame-3-storey");
    CPO_LoadCaseListDlg list;
    Start(list);
    list.m_selected = 1;
    EXPECT_EQ(0, list.OnDelete());
    EXPECT_EQ("IDS_QM_UI_RECORD_USED", LastMessage());
    EXPECT_NE(std::string::npos, list.Messages().back().text.find("PX_MODE1 ATC-40 A"));
    EXPECT_EQ(3U, Model().pushovers.size());
    EXPECT_FALSE(m_doc.Data().IsModified());
}

TEST_F(LoadCaseEdit, ANewCaseNeverInheritsTheResultsOfADeletedOne)
{
    Open("rc-frame-3-storey");
    ASSERT_EQ(1, m_doc.Edit().Begin("delete"));
    for (const int key : m_doc.Attr().GetKeys<T_EVAL_D>())
        ASSERT_EQ(1, m_doc.Edit().Erase<T_EVAL_D>(key));
    ASSERT_EQ(1, m_doc.Edit().Erase<T_POLC_D>(2));
    ASSERT_EQ(1, m_doc.Edit().Commit());
    CPO_LoadCaseListDlg list;
    Start(list);
    list.m_selected = 1;
    ASSERT_EQ(1, list.OnCopy());
    EXPECT_EQ(0, m_doc.Post().SelectPushover(list.m_selected));
}

TEST_F(LoadCaseEdit, WhatHasChangedElsewhereIsNotOverwritten)
{
    Open("hinge-library");
    CPO_LoadCaseDlg first, second;
    Start(first);
    Start(second);
    first.m_case.name = "A";
    second.m_case.name = "B";
    ASSERT_EQ(1, first.OnOK());
    EXPECT_EQ(0, second.OnOK());
    EXPECT_EQ("IDS_QM_UI_POLC_CHANGED", LastMessage());
    first.m_case.name = "C"; // its own edit does not count
    EXPECT_EQ(1, first.OnOK());
    Open("rc-frame-3-storey"); // another model with a load case of that key
    EXPECT_EQ(0, first.OnOK());
    EXPECT_EQ("PX_MODE1", Model().pushovers.at(1).name);
}

TEST(LoadCaseWarnings, StopsThatCantActAreSaidAndStored)
{
    CDBDoc doc;
    T_FILE_ERROR error;
    ASSERT_EQ(1, doc.ImportCase(QM_TEST_DATA "/push/pc_two_storey.json", error)) << error.text;
    CPO_LoadCaseDlg dialog;
    dialog.SetDoc(&doc);
    dialog.m_case.stops = {0.03, PUSH_STATE_STOP::CP, {}}; // there are storeys, but no criteria
    EXPECT_EQ(1, dialog.OnOK());
    ASSERT_EQ(1U, dialog.Messages().size());
    EXPECT_EQ("IDS_QM_PUSH_STOP_NO_CRITERIA", dialog.Messages()[0].key);
    EXPECT_EQ(dialog.m_case.stops, doc.Data().Model().pushovers.at(dialog.Key()).stops);
}
