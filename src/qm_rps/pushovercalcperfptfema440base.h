// What the FEMA 440 (2005) chapter 6 procedures share beyond ATC-40.
#pragma once

#include "qm_rps/pushover/fema440workingspectrum.h"
#include "qm_rps/pushovercalcperfptbase.h"

class CPushOverCalcPerfPtFEMA440Base : public CPushOverCalcPerfPtBase {
public:
    /// `source` is the file that release assertions name; the owner must outlive the calculator.
    CPushOverCalcPerfPtFEMA440Base(CPushOverPerfPtRecord& owner, const char* source)
        : CPushOverCalcPerfPtBase(owner), m_working(owner), m_source(source)
    {
    }

    /// Point (Ds, As) of the working spectrum on the radial line through (D, A) and, with the flag,
    /// the capacity point (Dc, Ac) above it. 1 found; 0 not.
    [[nodiscard]] virtual int FindTrialPointOnWorkingSpectrum(double D, double A, bool withCapacity,
                                                              double& Dc, double& Ac, double& Ds,
                                                              double& As);
    /// Capacity point at displacement d; the outputs are cleared to 0 first.
    [[nodiscard]] virtual int GetCapacityPointAtDisplacement(double d, double& D, double& A);
    /// The same crossing; `a` is not used and the outputs are not cleared, on purpose.
    [[nodiscard]] virtual int GetCapacityPointAtDisplacement2(double d, double a, double& D,
                                                              double& A);

protected:
    /// Raises the release assertion of that line; the calculation goes on.
    void Assert(int line) const;
    /// Warns where the any-type hysteresis model is used outside its period range.
    void WarnAnyType(double T0) const;
    /// Fails the trial: log record, outcome, no performance point.
    int Fail(PUSH_OUTCOME code);
    /// Keeps the log's values in the trace row of the trial.
    void KeepTrial();
    /// Damping exp(5.6 - 4 / B') of the performance point, B' = Ds / Dp with Ds read on the
    /// 5 %-damped spectrum, and the spectrum reduced by B'. 1 done; 0 there is no such value.
    [[nodiscard]] int CalcSecantDamping(double Dp, double Ap, int assertLine, double& betaPct);

    CFema440WorkingSpectrum m_working; // demand of the trial at hand
    double m_T0 = 0.0;                 // initial period, s
    T_LOG_RECORD m_log;                // of the trial at hand

private:
    const char* m_source;
};
