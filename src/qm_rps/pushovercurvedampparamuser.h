// Model of the dialog for user-defined damping modification: kappa over hysteretic damping.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/mathfunc.h"

#include <array>
#include <vector>

class CPushOverCurveDampParamUser : public zql::frx::MDialog {
public:
    /// Fields in their order on the dialog: damping in per cent, factors without unit.
    double m_beta1 = 0.0, m_kappa1 = 0.0, m_beta2 = 0.0, m_kappa2 = 0.0;

    /// beta1, kappa1, beta2, kappa2, as evaluations keep them.
    void Data2Dlg(const std::array<double, 4>& points);
    /// In the same order.
    void Dlg2Data(std::array<double, 4>& points) const;

    /// Kappa over the hysteretic damping, for a picture: level to beta1, straight to beta2, level
    /// beyond, up to the damping of a rectangular loop (63.7 per cent) or beta2.
    std::vector<T_POINT2> Curve() const;

    /// beta1 <= beta2, both above 0 and all finite; the kappa values are as the engineer wants
    /// them. 0 shows IDS_PUSHOVER_Wrong_Input_ and the dialog stays open.
    int CheckData() override;
};
