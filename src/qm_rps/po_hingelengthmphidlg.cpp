#include "qm_rps/po_hingelengthmphidlg.h"

void CPO_HingeLengthMPhiDlg::OnEnChangeMy_I(double length)
{
    m_blocks.I.fill(length);
}

void CPO_HingeLengthMPhiDlg::OnEnChangeMy_J(double length)
{
    m_blocks.J.fill(length);
}
