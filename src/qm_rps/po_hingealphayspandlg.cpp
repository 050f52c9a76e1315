#include "qm_rps/po_hingealphayspandlg.h"

void CPO_HingeAlphaYSpanDlg::Data2Dlg(const T_HINGE_LENGTH& data)
{
    m_auto = data.autoSpan;
    m_span = data.span;
}

void CPO_HingeAlphaYSpanDlg::Dlg2Data(T_HINGE_LENGTH& data) const
{
    data.autoSpan = m_auto;
    if (!m_auto) data.span = m_span;
}
