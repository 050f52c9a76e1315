#include "qm_rps/pushoverpmminteractiondlg.h"

#include "qm_rps/hinge/hingepartfindings.h"

void CPushOverPMMInteractionDlg::OnSameSidesChk(bool same)
{
    if (same)
        m_table.negative.reset();
    else if (!m_table.negative)
        m_table.negative = m_table.curves;
}

std::vector<T_FINDING> CPushOverPMMInteractionDlg::Findings() const
{
    return PmmFindings(m_table);
}

int CPushOverPMMInteractionDlg::OnOK()
{
    if (!CheckData()) return 0;
    m_record = m_table;
    return 1;
}
