#include "qm_rps/po_hingelengthmthetadlg.h"

void CPO_HingeLengthMThetaDlg::Data2Dlg(const T_HINGE_LENGTH& data)
{
    m_My = data.My;
    m_Mz = data.Mz;
    m_relative = data.relative;
}

void CPO_HingeLengthMThetaDlg::Dlg2Data(T_HINGE_LENGTH& data) const
{
    data.My = m_My;
    data.Mz = m_Mz;
    data.relative = m_relative;
}
