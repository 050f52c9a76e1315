#include "qm_rps/po_femastrlossfigure0dlg.h"

std::vector<T_FIGURE_CURVE> CPO_FEMAStrLossFigure0Dlg::Curves() const
{
    return StrengthLossCurves(false);
}

std::vector<T_FIGURE_POINT> CPO_FEMAStrLossFigure0Dlg::Points() const
{
    return BackbonePoints();
}
