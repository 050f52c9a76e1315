#include "qm_rps/po_hingelengthmphidlg.h"

void CPO_HingeLengthMPhiDlg::OnEnChangeMy_I(double length)
{
    m_blocks.I.fill(length);
}

void CPO_HingeLengthMPhiDlg::OnEnChangeMy_J(double length)
{
    m_blocks.J.fill(length);
}

void CPO_HingeLengthMPhiDlg::OnEnChange(HINGE_COMPONENT c, HINGE_LOCATION end, double length)
{
    const bool j = end == HINGE_LOCATION::JEnd;
    if (c == HINGE_COMPONENT::My) return j ? OnEnChangeMy_J(length) : OnEnChangeMy_I(length);
    (j ? m_blocks.J : m_blocks.I)[static_cast<std::size_t>(c)] = length;
}
