// FEMA 440 (2005) 6.4: direct iteration on a trial point (procedure A) and, as a variant, the
// intersection of the MADRS with the capacity spectrum (procedure B). Accepted within 5 %.
#pragma once

#include "qm_rps/pushovercalcperfptfema440base.h"

class CPushOverCalcPerfPtFEMA440ProcA : public CPushOverCalcPerfPtFEMA440Base {
public:
    /// variant 0: iterate on the effective-period line; 1: MADRS crossing. It is also the kind of
    /// the log records.
    CPushOverCalcPerfPtFEMA440ProcA(CPushOverPerfPtRecord& owner, int variant);

    int CalcPerformancePoint(double& Dp, double& Ap, std::optional<double>& beta,
                             T_POINT2* slopeChange) override;
    int IteratePerformancePoint(double& Dp, double& Ap, std::optional<double>& beta, double dpi,
                                double api, double slopeChangeD, double Dd, double Ad) override;

private:
    struct T_POINT_FOUND {
        double D = 0.0, A = 0.0;
        std::optional<double> beta;
    };
    /// Bilinear representation and its ductility: dy, ay, mu into the log record, alpha out.
    int CalcDuctility(double dpi, double api, double& alpha);
    /// One trial. 1: (Di, Ai) found; 0: ended without a point.
    int CalcTrial(double dpi, double api, T_POINT_FOUND& found, double& Di, double& Ai);
    int CalcEquivalentSystem(double mu, double alpha);
    int FindTrialResult(double mu, double alpha, double& Di, double& Ai);
    int Converge(double Di, double Ai, T_POINT_FOUND& found);

    int m_variant;
};
