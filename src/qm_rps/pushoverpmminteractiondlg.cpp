#include "qm_rps/pushoverpmminteractiondlg.h"

#include "qm_rps/hinge/hingepartfindings.h"

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
