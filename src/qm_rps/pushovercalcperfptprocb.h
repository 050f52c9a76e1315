// ATC-40 (1996) 8.2.2.2, procedure B: a sweep over ductility gives a locus of demand points; where
// it crosses the capacity spectrum lies the performance point.
#pragma once

#include "qm_rps/pushovercalcperfptbase.h"

class CPushOverCalcPerfPtProcB : public CPushOverCalcPerfPtBase {
public:
    using CPushOverCalcPerfPtBase::CPushOverCalcPerfPtBase;

    int IteratePerformancePoint(double& Dp, double& Ap, std::optional<double>& beta, double dpi,
                                double api, double slopeChangeD, double Dd, double Ad) override;

private:
    enum class SWEEP { Next, CurveEnds, Failed };

    /// One ductility: adds the demand point to the locus and moves the yield point.
    SWEEP Step(double mu, double T0, double& dy, double& ay);
    /// First crossing of the locus with the capacity spectrum.
    int CrossLocus(double& Dp, double& Ap, double& beta);
    /// What the driver keeps of a found point.
    void StoreFound(double Dp, double Ap, double beta);

    std::vector<double> m_traceD, m_traceA, m_traceBeta; // locus and its damping, per cent
    std::vector<double> m_teffs;                         // T0 and Teff at ductility 2, 4, 6, 8
    std::vector<double> m_T, m_Sa, m_Sd;                 // reduced spectrum
};
