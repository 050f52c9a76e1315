#include "qm_rps/po_femastrlossfigureedlg.h"

std::vector<T_FIGURE_CURVE> CPO_FEMAStrLossFigureEDlg::Curves() const
{
    return StrengthLossCurves(true);
}

std::vector<T_FIGURE_POINT> CPO_FEMAStrLossFigureEDlg::Points() const
{
    return BackbonePoints();
}
