#include "qm_rps/rps_main.h"

#include "frametest.h"
#include "qm_base/appbase.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/po_loadcaselistdlg.h"
#include "qm_rps/po_selectloadcasedlg.h"
#include "qm_rps/pushovermanager.h"
#include "qm_rps/rpsmanager.h"

#include <cerrno>

namespace {

struct T_RECORD {
    std::vector<int> made; // ids
    int shown = 0, refreshed = 0, ended = 0;
};

struct T_WINDOW : IRPSWindow {
    T_WINDOW(T_RECORD& record, CRPSDlgBase& dialog) : m_record(record), m_dialog(dialog) {}
    ~T_WINDOW() override
    {
        ++m_record.ended;
        (void)m_dialog.Findings(); // the dialog is still whole: a sanitizer sees it
    }
    void Show() override { ++m_record.shown; }
    void Refresh() override { ++m_record.refreshed; }
    T_RECORD& m_record;
    CRPSDlgBase& m_dialog;
};

class RpsMain : public FrameTest {
protected:
    void SetUp() override
    {
        Open("rc-frame-3-storey");
        CModelessDlgCtrl::Of(m_doc).SetWindowMaker(
            [this](CRPSDlgBase& d, int id, zql::frx::IDialogView* parent) {
                EXPECT_EQ(&m_view, parent);
                EXPECT_EQ(&m_doc, d.Doc()); // it has the document before its window is made
                m_record.made.push_back(id);
                errno = m_leaves;
                return std::make_unique<T_WINDOW>(m_record, d);
            });
    }
    CRPSDlgBase* Run(int id, const int* parameter = nullptr)
    {
        return CreateOrActivateRPSDlg(&m_doc, id, &m_view, parameter);
    }
    T_RECORD m_record;
    int m_leaves = 0;
};

} // namespace

TEST_F(RpsMain, OneDialogForEachIdIsMadeShownAndHandedBack)
{
    CRPSDlgBase* item = Run(5675);
    ASSERT_NE(nullptr, dynamic_cast<CPO_LoadCaseDlg*>(item));
    EXPECT_EQ(1, m_record.shown);
    EXPECT_EQ(item, Run(5675));
    EXPECT_EQ(2, m_record.shown);
    ASSERT_NE(nullptr, dynamic_cast<CPO_LoadCaseListDlg*>(Run(5676)));
    EXPECT_EQ((std::vector<int>{5675, 5676}), m_record.made);
    CModelessDlgCtrl::Of(m_doc).Close(5675);
    EXPECT_EQ(1, m_record.ended);
    EXPECT_NE(nullptr, Run(5675)); // made again
    EXPECT_EQ((std::vector<int>{5675, 5676, 5675}), m_record.made);
}

TEST_F(RpsMain, TheParameterChoosesTheLoadCaseWithEachCall)
{
    const int second = 2, missing = 77;
    auto* item = dynamic_cast<CPO_LoadCaseDlg*>(Run(5675, &second));
    ASSERT_NE(nullptr, item);
    EXPECT_EQ("PX_UNIFORM", item->m_case.name);
    Run(5675);
    Run(5675, &missing);
    EXPECT_EQ("PX_UNIFORM", item->m_case.name);
    EXPECT_EQ(1, m_record.refreshed);
    Run(5676, &second); // the list takes none
    EXPECT_EQ(1, m_record.refreshed);
}

TEST_F(RpsMain, OtherIdsNoDocumentAndNoWindowGiveNullAndShowNothing)
{
    for (const int id : {0, 5674, 5677, -1})
        EXPECT_EQ(nullptr, Run(id)) << id;
    EXPECT_EQ(nullptr, CreateOrActivateRPSDlg(nullptr, 5675, &m_view, nullptr));
    CModelessDlgCtrl::Of(m_doc).SetWindowMaker({});
    EXPECT_EQ(nullptr, Run(5675));
    EXPECT_EQ(nullptr, CModelessDlgCtrl::Of(m_doc).Find(5675));
    EXPECT_TRUE(m_record.made.empty());
}

TEST_F(RpsMain, TheErrorNumberThatAWindowLeavesIsKept)
{
    m_leaves = ENOENT;
    Run(5675);
    EXPECT_EQ(ENOENT, errno);
}

TEST_F(RpsMain, TheSelectionRunsForKindOneAlone)
{
    int chosen = 0;
    m_view.m_run = [](zql::frx::MDialog& dialog) {
        auto& d = dynamic_cast<CPO_SelectLoadCaseDlg&>(dialog);
        EXPECT_EQ(3U, d.Rows().size());
        d.SetSelected(9);
        EXPECT_EQ(0, d.OnOK()); // there is none
        d.SetSelected(2);
        return d.OnOK();
    };
    for (const int kind : {0, 2, 5675})
        RPS_DoModal(kind, &chosen);
    EXPECT_EQ(0, m_view.m_shown);
    RPS_DoModal(1, &chosen);
    EXPECT_EQ(1, m_view.m_shown);
    EXPECT_EQ(2, chosen);
    EXPECT_EQ(2, CPushoverManager::Current()->m_loadCase);
    m_view.m_run = {};
    chosen = 1;
    RPS_DoModal(1, &chosen); // cancelled
    EXPECT_EQ(1, chosen);
}

TEST_F(RpsMain, ManagersAreMadeOnceForEachDocumentUnderTheirNames)
{
    EXPECT_EQ(nullptr, m_doc.DynModules().GetDynModule("CPushoverManager"));
    CPushoverManager* pushover = CPushoverManager::Current();
    EXPECT_EQ(pushover, m_doc.DynModules().GetDynModule("CPushoverManager"));
    EXPECT_EQ(pushover, CPushoverManager::Current());
    {
        CDBDoc other;
        EXPECT_NE(pushover, CPushoverManager::Current());
    }
    CDBDoc::SetDocPoint(nullptr);
    EXPECT_EQ(nullptr, CRPSManager::Current());
    RPS_DoModal(1, nullptr);
    EXPECT_EQ(0, m_view.m_shown);
}

TEST_F(RpsMain, AnotherModuleUnderTheNameAssertsAndGivesNull)
{
    class COther : public CDynModule {};
    ASSERT_EQ(1, m_doc.DynModules().AddDynModule("CRPSManager", std::make_unique<COther>()));
    (void)CAppBase::TakeAssertions_ST();
    EXPECT_EQ(nullptr, CRPSManager::Current());
    EXPECT_EQ("src/qm_rps/rpsmanager", CAppBase::TakeAssertions_ST().at(0).source);
}
