// ATC-40 (1996) 8.2.2.1.2, procedure A: direct iteration on a trial point, accepted within 5 %.
#pragma once

#include "qm_rps/pushovercalcperfptbase.h"

class CPushOverCalcPerfPtProcA : public CPushOverCalcPerfPtBase {
public:
    using CPushOverCalcPerfPtBase::CPushOverCalcPerfPtBase;

    int IteratePerformancePoint(double& Dp, double& Ap, std::optional<double>& beta, double dpi,
                                double api, double slopeChangeD, double Dd, double Ad) override;

private:
    /// One trial: reduced spectrum of the trial point and its crossing (Di, Ai) with the capacity.
    /// 1 done; 0 the outcome says why.
    int CalcTrial(double dpi, double api, double& Di, double& Ai, double& betaEff);

    std::vector<double> m_T, m_Sa, m_Sd; // reduced spectrum, kept between trials
};
