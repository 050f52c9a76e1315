#include "qm_rps/po_selectloadcasedlg.h"

std::vector<T_LOADCASE_ROW> CPO_SelectLoadCaseDlg::Rows() const
{
    return Doc() ? LoadCaseRows(*Doc()) : std::vector<T_LOADCASE_ROW>();
}

int CPO_SelectLoadCaseDlg::CheckData()
{
    if (Doc() && Doc()->Data().Model().pushovers.contains(m_selected)) return 1;
    ShowMessage("IDS_QM_UI_POLC_NONE_CHOSEN");
    return 0;
}
