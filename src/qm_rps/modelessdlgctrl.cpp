#include "qm_rps/modelessdlgctrl.h"

#include "qm_rps/desk/docmodule.h"

CModelessDlgCtrl& CModelessDlgCtrl::Of(CDBDoc& doc)
{
    CModelessDlgCtrl* ctrl = DocModule<CModelessDlgCtrl>(doc, "src/qm_rps/modelessdlgctrl");
    return *ctrl; // nothing else registers under this name
}

CRPSDlgBase* CModelessDlgCtrl::Find(int id) const
{
    const auto it = m_dialogs.find(id);
    return it == m_dialogs.end() ? nullptr : it->second.get();
}

CRPSDlgBase& CModelessDlgCtrl::Add(int id, std::unique_ptr<CRPSDlgBase> dialog)
{
    auto& place = m_dialogs[id];
    place = std::move(dialog);
    return *place;
}

void CModelessDlgCtrl::Close(int id)
{
    const auto it = m_dialogs.find(id);
    if (it == m_dialogs.end()) return;
    it->second->DestroyWindow();
    m_dialogs.erase(it);
}

void CModelessDlgCtrl::CloseAll()
{
    while (!m_dialogs.empty())
        Close(m_dialogs.begin()->first);
}
