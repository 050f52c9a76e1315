// The demand spectrum that a FEMA 440 procedure reduces and modifies, and the look-ups on it.
#pragma once

#include "qm_rps/pushover/pushoverperfptrecord.h"

class CFema440WorkingSpectrum {
public:
    /// The owner is not owned and must outlive this object.
    explicit CFema440WorkingSpectrum(const CPushOverPerfPtRecord& owner) : m_owner(owner) {}

    const T_ADRS_CURVE& Curve() const { return m_isReduced ? m_curve : m_owner.Demand(); }

    /// Puts the 5 %-damped spectrum back.
    void Restore() { m_isReduced = false; }

    /// 5 %-damped spectrum divided by B, from the driver's copy. FEMA 440 (6-16).
    /// 1 done; 0 B is 0 or not finite, curve as it was.
    [[nodiscard]] int ReduceByB(double B);

    /// Multiplies every acceleration by M, keeping the displacements: the modified ADRS. Only after
    /// ReduceByB.
    void Modify(double M);

    /// Point on the radial line through (D, A). 1 found; 0 not, outputs as they were.
    [[nodiscard]] int OnRadialLine(double D, double A, double& Ds, double& As) const;

private:
    const CPushOverPerfPtRecord& m_owner;
    T_ADRS_CURVE m_curve; // reduced, perhaps modified; keeps its memory between trials
    bool m_isReduced = false;
};

/// B = 4 / (5.6 - ln beta), beta in per cent. FEMA 440 (6-17). 1 done; 0 undefined.
[[nodiscard]] int CalcFema440B(double betaPct, double& B);

/// M = (Teff / T0)2 (alpha (mu - 1) + 1) / mu. FEMA 440 (6-13) to (6-15). 1 done; 0 undefined.
[[nodiscard]] int CalcFema440M(double Teff, double T0, double alpha, double mu, double& M);
