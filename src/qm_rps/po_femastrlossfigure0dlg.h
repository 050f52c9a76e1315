// Figure of the strength loss without cyclic degradation: it follows the backbone.
#pragma once

#include "qm_rps/hinge/femafigure.h"

class CPO_FEMAStrLossFigure0Dlg : public CFemaFigureDlg {
public:
    const char* TitleKey() const override { return "IDS_QM_UI_FIGURE_STRLOSS_0"; }
    const char* TextKey() const override { return "IDS_QM_UI_FIGURE_STRLOSS_0_TEXT"; }
    std::vector<T_FIGURE_CURVE> Curves() const override;
    std::vector<T_FIGURE_POINT> Points() const override;
};
