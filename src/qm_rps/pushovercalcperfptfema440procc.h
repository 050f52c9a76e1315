// FEMA 440 (2005) 6.4, procedure C: the ductility grows step by step, the locus of MADRS points is
// followed until it crosses the capacity spectrum.
#pragma once

#include "qm_rps/pushovercalcperfptfema440base.h"

class CPushOverCalcPerfPtFEMA440ProcC : public CPushOverCalcPerfPtFEMA440Base {
public:
    explicit CPushOverCalcPerfPtFEMA440ProcC(CPushOverPerfPtRecord& owner);

    int CalcPerformancePoint(double& Dp, double& Ap, std::optional<double>& beta,
                             T_POINT2* slopeChange) override;
    /// Dd, Ad is the previous point of the locus.
    int IteratePerformancePoint(double& Dp, double& Ap, std::optional<double>& beta, double dpi,
                                double api, double slopeChangeD, double Dd, double Ad) override;

    /// Points of the locus, the elastic demand point first.
    const T_ADRS_CURVE& Locus() const { return m_locus; }

private:
    /// Bilinear representation of the trial point: alpha, ay, dy. 1 done; 0 failed.
    int CalcYield(double dpi, double api);
    /// MADRS for one ductility and its point at the secant period. 1 found; 0 ended.
    int CalcLocusPoint(double mu, double& Di, double& Ai);
    /// Performance point at the crossing of the locus with the capacity spectrum.
    int Finish(const T_POINT2& point, std::optional<double>& beta);

    double m_alpha = 0.0, m_ay = 0.0, m_dy = 0.0, m_mu0 = 0.0;
    T_ADRS_CURVE m_locus;
};
