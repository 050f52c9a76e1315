// Base of the performance-point calculators of the capacity spectrum method.
// ATC-40 (1996) chapter 8; FEMA 440 (2005) chapter 6.
//
// A calculator serves one evaluation: it reads its owner's capacity and demand spectra and damping
// settings, runs once through CalcPerformancePoint and is destroyed. Routines return 1 or 0; on 0
// the outcome names the reason. The trace never changes a number.
// Units: Sd in the model's length, Sa in g, periods in s, damping in per cent.
#pragma once

#include "qm_rps/pushover/perfptoperations.h"

/// Result codes of CalcPerformancePoint and IteratePerformancePoint.
inline constexpr int kPerfPtNone = 0;
inline constexpr int kPerfPtFound = 1;   // with damping beyond the elastic one
inline constexpr int kPerfPtElastic = 2; // found, with a damping that counts as elastic

/// Largest number of trials of one evaluation.
inline constexpr int kMaxTrials = 1500;

class CPushOverCalcPerfPtBase {
public:
    /// The owner is not owned and must outlive the calculator.
    explicit CPushOverCalcPerfPtBase(CPushOverPerfPtRecord& owner);
    CPushOverCalcPerfPtBase(const CPushOverCalcPerfPtBase&) = delete;
    CPushOverCalcPerfPtBase& operator=(const CPushOverCalcPerfPtBase&) = delete;
    virtual ~CPushOverCalcPerfPtBase() = default;

    /// Finds the performance point (Dp, Ap) and its effective damping; `slopeChange` (may be null)
    /// receives the first change of slope of the capacity spectrum, (0, 0) where there is none.
    /// 0 none, 1 found, 2 found and elastic. `beta` stays empty where the procedure sets none.
    virtual int CalcPerformancePoint(double& Dp, double& Ap, std::optional<double>& beta,
                                     T_POINT2* slopeChange);

    /// Runs the procedure from a trial point (dpi, api); Dd, Ad is the elastic demand point.
    virtual int IteratePerformancePoint(double& Dp, double& Ap, std::optional<double>& beta,
                                        double dpi, double api, double slopeChangeD, double Dd,
                                        double Ad) = 0;

    /// Equal-displacement estimate: the radial line through (D1, A1) meets the demand spectrum at
    /// (Dd, Ad), the vertical line there meets the capacity spectrum at (dpi, api).
    [[nodiscard]] virtual int FindInitialTrialPoint(double D1, double A1, double& dpi, double& api,
                                                    double& Dd, double& Ad);

    // Geometry and damping of the capacity spectrum: see CPerfPtOperations.
    [[nodiscard]] virtual int FindFirstSlopeChange(double& D, double& A);
    /// Area under the capacity spectrum from its first stored point to d.
    [[nodiscard]] virtual int CalcCapacityArea(double d, double& area)
    {
        return m_operations.CalcCapacityArea(d, area);
    }
    /// Yield point of the bilinear curve of equal area through (dpi, api). ATC-40 8.2.2.1.1.
    [[nodiscard]] virtual int BilinearizeAt(double dpi, double api, double& dy, double& ay)
    {
        return m_operations.BilinearizeAt(dpi, api, dy, ay);
    }
    /// Sa of the capacity spectrum at d. 0 beyond the curve, the last point included.
    [[nodiscard]] virtual int GetCapacityAccelAt(double d, double& Sa) const
    {
        return m_operations.GetCapacityAccelAt(d, Sa);
    }
    /// kappa of ATC-40 Table 8-1; `fraction` is beta0 / 63.7. Type 3 may limit beta0.
    virtual double GetDampingModificationFactor(int type, double& beta0, double fraction) const
    {
        return m_operations.GetDampingModificationFactor(type, beta0, fraction);
    }
    /// Whether an effective damping counts as that of an elastic structure.
    virtual bool IsElasticDamping(double beta) const { return m_operations.IsElasticDamping(beta); }
    /// CPerfPtOperations::CalcReduction; kappa is kept for the trace.
    [[nodiscard]] virtual int CalcSpectralReductionFactors(double dy, double ay, double dpi,
                                                           double api, double& SRa, double& SRv,
                                                           double& betaEff);

    /// First crossing of the segment P1-P2 with the capacity spectrum.
    [[nodiscard]] virtual int IntersectSegmentWithCapacity(T_POINT2 P1, T_POINT2 P2,
                                                           T_POINT2& point) const;

    /// First crossing of the half line of period T with a curve; (0, 0) where there is none.
    [[nodiscard]] virtual int IntersectPeriodLineWithCurve(const std::vector<double>& Sd,
                                                           const std::vector<double>& Sa, double T,
                                                           double& D, double& A) const;

    /// The trials in their order, also of a calculation that found nothing.
    const std::vector<T_PERFPT_TRIAL>& Trace() const { return m_trace; }
    /// How the calculation ended.
    const T_OUTCOME& Outcome() const { return m_outcome; }
    /// The first change of slope that was found; empty: there is none.
    const std::optional<T_POINT2>& SlopeChange() const { return m_slopeChange; }

protected:
    /// FEMA 440 effective period (s) and damping (per cent) for a ductility range 0 to 2; another
    /// range or a value that is not real raises the release assertion and fails.
    [[nodiscard]] int CalcFema440EffectivePeriod(double T0, double mu, double alpha, int range,
                                                 double& Teff);
    /// As above; T0 and Teff in s.
    [[nodiscard]] int CalcFema440EffectiveDamping(double T0, double Teff, double mu, double alpha,
                                                  int range, double& betaPct);

    /// Record of the FEMA 440 iteration log.
    struct T_LOG_RECORD {
        int kind = 0;                                    // 0 "A", 1 "B", 2 "C"
        int step = 0;                                    // trial
        double dpi = 0.0, api = 0.0, dy = 0.0, ay = 0.0; // Sd in the model's length, Sa in g
        /// Ductility; s; per cent; factor of the MADRS; s.
        double mu = 0.0, Teff = 0.0, betaEff = 0.0, M = 0.0, Tsec = 0.0;
    };
    /// Appends to "<model>_Pushover.txt" while the test switch "FEMA440" is "yes". 1 written or
    /// switched off; 0 the model has no path or the file can't be written.
    int WriteIterationLog(const T_LOG_RECORD& record) const;

    /// Starts the row of a trial; returns it for the values to come.
    T_PERFPT_TRIAL& StartTrial(int trial, double dpi, double api);
    /// Number of trials since an earlier trial with bit for bit the same point; 0 when it is new.
    int RepeatsAfter(double dpi, double api) const;
    /// Sets the outcome and returns the result code that goes with it.
    int End(PUSH_OUTCOME code, int result, int count = 0);

    /// The owner's capacity spectrum.
    const T_ADRS_CURVE& Capacity() const { return m_owner.Capacity(); }
    /// Period of the radial line through a point, s.
    double PeriodOf(double Sd, double Sa) const { return m_operations.PeriodOf(Sd, Sa); }

    CPushOverPerfPtRecord& m_owner;        // spectra and settings, not owned
    CPerfPtOperations m_operations;        // geometry and damping on them
    int m_iteration = 0;                   // trials so far
    std::vector<T_PERFPT_TRIAL> m_trace;   // the trials
    T_OUTCOME m_outcome;                   // set by End
    std::optional<T_POINT2> m_slopeChange; // (Sd, Sa)
    T_PERFPT_TRIAL m_last; // values of the trial being computed that helpers fill in
};
