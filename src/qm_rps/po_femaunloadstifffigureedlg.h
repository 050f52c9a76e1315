// Figure of the unloading stiffness of energy-based hinges: what the unloading stiffness factor
// does to a loop of given area.
#pragma once

#include "qm_rps/hinge/femafigure.h"

class CPO_FEMAUnloadStiffFigureEDlg : public CFemaFigureDlg {
public:
    static constexpr double kDuctility = 4.0; // D / Dy of the loops
    static constexpr double kEnergy = 0.6;    // their area over that of the full one

    const char* TitleKey() const override { return "IDS_QM_UI_FIGURE_UNLOAD"; }
    const char* TextKey() const override { return "IDS_QM_UI_FIGURE_UNLOAD_TEXT"; }
    std::vector<T_FIGURE_CURVE> Curves() const override;
    std::vector<T_FIGURE_POINT> Points() const override;
};
