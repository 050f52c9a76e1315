// What a performance-point calculator sees of an evaluation: the capacity spectrum, the demand
// spectrum, the damping settings and the gravity; and where it puts its curves.
//
// Spectra are in ADRS form: Sd in the model's length unit, Sa in g, related by the period through
// Sd = T2 Sa g / (4 pi2). Capacity index 0 is one tenth of the first step, index i is step i.
#pragma once

#include "qm_cmd/etc_design_spect.h"
#include "qm_rps/pushover/curvearea.h"
#include "qm_rps/pushover/pushoutcome.h"

#include <array>
#include <memory>
#include <optional>
#include <vector>

/// A curve in ADRS with its own storage; both arrays of equal length.
struct T_ADRS_CURVE {
    std::vector<double> Sd; // length
    std::vector<double> Sa; // g
    T_ADRS_VIEW View() const { return {Sd, Sa}; }
    bool operator==(const T_ADRS_CURVE&) const = default;
};
inline auto Numbers(const T_ADRS_CURVE& c)
{
    return std::tie(c.Sd, c.Sa);
}

/// One trial of a procedure; what a procedure does not have stays empty.
struct T_PERFPT_TRIAL {
    int trial = 0;
    double dpi = 0.0, api = 0.0;     // trial point (length, g)
    std::optional<double> dy, ay;    // yield point of the bilinear representation
    std::optional<double> alpha, mu; // post-yield stiffness ratio, ductility
    std::optional<int> row;          // row of the FEMA 440 coefficient tables, see Fema440RowText
    std::optional<double> kappa;     // damping modification factor
    std::optional<double> betaEff;   // effective damping, per cent
    std::optional<double> SRa, SRv;  // spectral reduction factors
    std::optional<double> Teff;      // effective period, s
    std::optional<double> M;         // MADRS modification factor
    std::optional<double> Di, Ai;    // point found by the trial
    bool operator==(const T_PERFPT_TRIAL&) const = default;
};

/// Damping settings of an evaluation.
struct T_DAMP_PARAM {
    int behaviorType = 0;    // 0 to 3: A, B, C, user-defined; FEMA 440: hysteresis model
    double elasticPct = 5.0; // inherent viscous damping, per cent
    double beta1 = 0.0, kappa1 = 0.0, beta2 = 0.0, kappa2 = 0.0; // user-defined, beta in per cent
};

class CPushOverPerfPtRecord {
public:
    virtual ~CPushOverPerfPtRecord() = default;

    /// Gravity in current units; the argument asks for the user spectrum's own where it has one.
    double GetGravity(int fromSpectrum) const { return fromSpectrum ? m_gravity : m_modelGravity; }

    /// First crossing of a demand spectrum (periods ascending) with the capacity spectrum.
    /// 1 found; 0 they do not cross, outputs as they were.
    [[nodiscard]] int PerfPt_GetCrossPointDiAi(const std::vector<double>& Sd,
                                               const std::vector<double>& Sa, double& Di,
                                               double& Ai) const;

    /// Demand spectrum at the performance point.
    void SetPerfPointSpectrumData(const std::vector<double>& Sa, const std::vector<double>& Sd);
    /// Locus of demand points (ATC-40 procedure B).
    void SetPerfPointTraceData(const std::vector<double>& D, const std::vector<double>& A);
    /// Effective period of the performance point, s.
    void SetPerfPointTeffData(double Teff) { m_perfPointTeff = Teff; }
    /// Initial period and effective periods at ductility 2, 4, 6, 8, s.
    void SetTeffsData(const std::vector<double>& Teffs) { m_teffs = Teffs; }

    /// Demand curve that a FEMA 440 trial worked with (reduced, or the MADRS).
    void SetWorkingDemand(const T_ADRS_CURVE& demand) { m_workingDemand = demand; }
    const T_ADRS_CURVE& WorkingDemand() const { return m_workingDemand; }

    /// A warning that does not stop the computation: message key, shown by the driver.
    void AddWarning(const char* key) { m_warnings.emplace_back(key); }
    const std::vector<std::string>& Warnings() const { return m_warnings; }

    /// Model file's path and name without extension, for the iteration log; may be empty.
    void SetModelPath(std::string path) { m_modelPath = std::move(path); }
    const std::string& ModelPath() const { return m_modelPath; }

    const T_ADRS_CURVE& Capacity() const { return m_capacity; }
    const CCurveArea& CapacityArea() const { return m_capacityArea; }
    /// The driver's 5 %-damped demand spectrum (the record at its own damping) and its periods.
    const T_ADRS_CURVE& Demand() const { return m_demand; }
    const std::vector<double>& DemandPeriods() const { return m_demandT; }
    const T_DAMP_PARAM& Damping() const { return m_damping; }
    const CETC_DESIGN_SPECT* DesignSpectrum() const { return m_spectrum.get(); }
    bool AlphaInPercent() const { return m_alphaInPercent; }

    const T_ADRS_CURVE& PerfPointSpectrum() const { return m_perfPointSpectrum; }
    const T_ADRS_CURVE& PerfPointTrace() const { return m_perfPointTrace; }
    std::optional<double> PerfPointTeff() const { return m_perfPointTeff; }
    const std::vector<double>& Teffs() const { return m_teffs; }

    void SetCapacity(T_ADRS_CURVE capacity)
    {
        m_capacity = std::move(capacity);
        m_capacityArea = CCurveArea(m_capacity.View());
    }
    void SetDamping(const T_DAMP_PARAM& damping) { m_damping = damping; }
    void SetAlphaInPercent(bool on) { m_alphaInPercent = on; }
    /// Gravity in current units: of the model, and the one that serves the evaluation.
    void SetGravity(double model, double evaluation);
    /// Takes the spectrum object and computes the 5 %-damped demand from it. Needs the gravity.
    void SetDesignSpectrum(std::unique_ptr<CETC_DESIGN_SPECT> spectrum);

    /// Sd of each ordinate: T2 Sa g / (4 pi2).
    void ToAdrs(const std::vector<double>& T, const std::vector<double>& Sa,
                std::vector<double>& Sd) const;

    /// Forgets what a calculator stored.
    void ClearPerfPoint();

private:
    T_ADRS_CURVE m_capacity, m_demand;
    CCurveArea m_capacityArea;
    std::vector<double> m_demandT;
    T_DAMP_PARAM m_damping;
    std::unique_ptr<CETC_DESIGN_SPECT> m_spectrum;
    double m_gravity = 9.80665, m_modelGravity = 9.80665;
    bool m_alphaInPercent = false;

    std::string m_modelPath;

    T_ADRS_CURVE m_perfPointSpectrum, m_perfPointTrace, m_workingDemand;
    std::vector<std::string> m_warnings;
    std::optional<double> m_perfPointTeff;
    std::vector<double> m_teffs;
};
