#include "qm_base/mdialog.h"

#include "qm_base/msgfunction.h"

#include <gtest/gtest.h>

using namespace zql::frx;

namespace {

class CSampleDlg : public MDialog {
public:
    int good = 1;

    int CheckData() override
    {
        if (!good) ShowMessage("IDS_PUSHOVER_Wrong_Input_");
        return good;
    }
    void Say(const std::string& text) { ShowMessage("IDS_OWN", text); }
    bool Ask() { return AskYesNo("IDS_TB_PHGE_YES"); }
};

/// Answers yes, accepts what passes its check, and keeps what it was shown.
class CScript : public IDialogView {
public:
    std::vector<T_MESSAGE> shown, asked;

    void ShowMessage(const std::string& key, const std::string& text) override
    {
        shown.push_back({key, text});
    }
    bool AskYesNo(const std::string& key, const std::string& text) override
    {
        asked.push_back({key, text});
        return true;
    }
    int RunModal(MDialog& child) override { return child.OnOK(); }
};

} // namespace

TEST(MDialog, RefusesAndGuessesNothingWithoutAView)
{
    CSampleDlg dlg;
    EXPECT_EQ(0, dlg.DoModal());
    EXPECT_FALSE(dlg.Ask());
    dlg.Say("kept");
    EXPECT_EQ((std::vector<T_MESSAGE>{{"IDS_OWN", "kept"}}), dlg.Messages());
    dlg.ClearMessages();
    EXPECT_TRUE(dlg.Messages().empty());
}

TEST(MDialog, TalksThroughItsView)
{
    CScript view;
    CSampleDlg dlg;
    dlg.SetView(&view);
    EXPECT_EQ(1, dlg.DoModal());
    EXPECT_TRUE(dlg.Ask());
    ASSERT_EQ(1u, view.asked.size());
    EXPECT_EQ("Yes", view.asked[0].text);

    dlg.good = 0;
    EXPECT_EQ(0, dlg.DoModal());
    const std::string key = "IDS_PUSHOVER_Wrong_Input_";
    EXPECT_EQ((std::vector<T_MESSAGE>{{key, zql::lib::MMSGFunction::GetValue(key)}}), view.shown);
    EXPECT_EQ(view.shown, dlg.Messages());
    dlg.SetView(nullptr);
    EXPECT_EQ(0, dlg.DoModal());
}
