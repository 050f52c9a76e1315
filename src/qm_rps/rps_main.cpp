#include "qm_rps/rps_main.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/modelessdlgctrl.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/po_loadcaselistdlg.h"
#include "qm_rps/po_selectloadcasedlg.h"
#include "qm_rps/pushovermanager.h"
#include "qm_rps/serviceagencyrps.h"

#include <cerrno>

namespace {

std::unique_ptr<CRPSDlgBase> MakeDialog(int id)
{
    if (id == IDD_PO_LOADCASE_ITEM) return std::make_unique<CPO_LoadCaseDlg>();
    if (id == IDD_PO_LOADCASE_LIST) return std::make_unique<CPO_LoadCaseListDlg>();
    return nullptr;
}

/// The error number that making the window leaves comes back where nothing else has set one.
class CKeepLastError {
public:
    CKeepLastError() : m_error(errno) { errno = 0; }
    CKeepLastError(const CKeepLastError&) = delete;
    CKeepLastError& operator=(const CKeepLastError&) = delete;
    ~CKeepLastError()
    {
        if (errno == 0) errno = m_error;
    }

private:
    int m_error;
};

CRPSDlgBase* OpenDialog(CDBDoc& doc, CModelessDlgCtrl& ctrl, int id, zql::frx::IDialogView* parent)
{
    std::unique_ptr<CRPSDlgBase> dialog = MakeDialog(id);
    if (!dialog) return nullptr;
    dialog->SetDoc(&doc);
    dialog->SetView(parent);
    if (!dialog->Create(ctrl.WindowMaker(), id, parent)) return nullptr;
    const CKeepLastError keep;
    return &ctrl.Add(id, std::move(dialog));
}

} // namespace

CRPSDlgBase* CreateOrActivateRPSDlg(CDBDoc* doc, int id, zql::frx::IDialogView* parent,
                                    const int* parameter)
{
    if (!doc) return nullptr;
    CModelessDlgCtrl& ctrl = CModelessDlgCtrl::Of(*doc);
    CRPSDlgBase* dialog = ctrl.Find(id);
    if (!dialog) dialog = OpenDialog(*doc, ctrl, id, parent);
    if (!dialog) return nullptr;
    dialog->ShowWindow();
    auto* item = dynamic_cast<CPO_LoadCaseDlg*>(dialog);
    if (parameter && item) item->ExternalSetting(*parameter);
    return dialog;
}

void RPS_DoModal(int kind, int* data)
{
    CDBDoc* doc = CDBDoc::GetDocPoint();
    CPushoverManager* manager = CPushoverManager::Current();
    if (kind != kSelectLoadCase || !doc || !manager) return;
    CPO_SelectLoadCaseDlg dialog;
    dialog.SetDoc(doc);
    dialog.SetView(CModelessDlgCtrl::Of(*doc).View());
    dialog.SetSelected(data && *data ? *data : manager->m_loadCase);
    if (!dialog.DoModal()) return;
    manager->m_loadCase = dialog.Selected();
    if (data) *data = dialog.Selected();
}

int RegisterRPSService()
{
    CServiceHeadOffice* office = CServiceHeadOffice::Instance();
    if (!office) return 0;
    const std::string name = zql::lib::MMSGFunction::RemoveQuote("\"rps\"");
    if (CServiceAgency* agency = office->GetAgency(name))
        return dynamic_cast<CServiceAgencyRps*>(agency) ? 1 : 0;
    return office->RegAgency(name, std::make_unique<CServiceAgencyRps>());
}
