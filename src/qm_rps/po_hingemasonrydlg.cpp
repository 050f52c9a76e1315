#include "qm_rps/po_hingemasonrydlg.h"

#include "qm_rps/hinge/hingepartfindings.h"

int CPO_HingeMasonryDlg::Dlg2Data(T_MASONRY_HINGE& data)
{
    if (!CheckData()) return 0;
    data = m_masonry;
    return 1;
}

std::vector<T_FINDING> CPO_HingeMasonryDlg::Findings() const
{
    return MasonryFindings(m_masonry);
}
