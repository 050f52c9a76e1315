#include "qm_rps/pushoverglobalcontroldlg.h"

#include "qm_db/recordfacts.h"

void CPushOverGlobalControlDlg::SetDoc(CDBDoc* doc)
{
    CRPSDlgBase::SetDoc(doc);
    if (doc) m_control = doc->Data().Model().pushControl;
}

std::vector<T_FINDING> CPushOverGlobalControlDlg::Findings() const
{
    return Doc() ? PushControlFindings(m_control, Doc()->Data().Model()) : std::vector<T_FINDING>();
}

int CPushOverGlobalControlDlg::OnOK()
{
    if (!CheckData()) return 0;
    if (!Doc() || m_control == Doc()->Data().Model().pushControl) return 1;
    return Edit("IDS_QM_UI_POGC_TITLE",
                [this](CEditScope&) { return Doc()->Edit().PutPogc(m_control) != 0; });
}
