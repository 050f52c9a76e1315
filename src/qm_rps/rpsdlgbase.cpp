#include "qm_rps/rpsdlgbase.h"

#include "qm_base/msgfunction.h"

int CRPSDlgBase::Create(const WINDOW_MAKER& maker, int id, zql::frx::IDialogView* parent)
{
    if (m_window || !maker) return 0;
    m_window = maker(*this, id, parent);
    return m_window ? 1 : 0;
}

void CRPSDlgBase::ShowWindow()
{
    if (m_window) m_window->Show();
}

void CRPSDlgBase::RefreshWindow()
{
    if (m_window) m_window->Refresh();
}

int CRPSDlgBase::Edit(const char* titleKey, const std::function<bool(CEditScope&)>& change)
{
    CEditScope edit(*m_doc, zql::lib::MMSGFunction::GetValue(titleKey));
    if (!edit.IsOpen()) ShowMessage("IDS_QM_UI_EDIT_BUSY");
    return edit.IsOpen() && change(edit) && edit.Commit();
}
