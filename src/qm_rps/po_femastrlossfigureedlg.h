// Figure of the strength loss with cyclic degradation: it also falls with dissipated energy.
#pragma once

#include "qm_rps/hinge/femafigure.h"

class CPO_FEMAStrLossFigureEDlg : public CFemaFigureDlg {
public:
    const char* TitleKey() const override { return "IDS_QM_UI_FIGURE_STRLOSS_E"; }
    const char* TextKey() const override { return "IDS_QM_UI_FIGURE_STRLOSS_E_TEXT"; }
    std::vector<T_FIGURE_CURVE> Curves() const override;
    std::vector<T_FIGURE_POINT> Points() const override;
};
