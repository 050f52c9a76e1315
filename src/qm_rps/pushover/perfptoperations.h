// Geometry and damping of a capacity spectrum: what every performance-point procedure, and the
// search for all points, is built on. ATC-40 (1996) chapter 8, FEMA 440 (2005) chapter 6.
//
// Reads the record's capacity spectrum, damping settings and gravity; changes nothing. Routines
// return 1 or 0; on 0 their outputs are as they were unless stated.
// Units: Sd in the model's length, Sa in g, periods in s, damping in per cent.
#pragma once

#include "qm_rps/pushover/pushoverperfptrecord.h"

/// Reduction of the demand at a point of the capacity spectrum.
struct T_PERFPT_REDUCTION {
    double kappa = 0.0;       // damping modification factor; set in every case
    double betaEff = 0.0;     // effective damping, per cent
    T_SPEC_REDUCTION factors; // without lower bounds: those belong to the spectrum
};

class CPerfPtOperations {
public:
    /// The record is not owned and must outlive this object.
    explicit CPerfPtOperations(const CPushOverPerfPtRecord& record) : m_record(record) {}

    /// First capacity point where the slope, relative to the segment before, changes by more than
    /// 0.1. 0 none: the point examined last, or (0, 0) where the curve starts at the origin.
    [[nodiscard]] int FindFirstSlopeChange(double& D, double& A) const;

    /// Area under the capacity spectrum from its first stored point to d.
    [[nodiscard]] int CalcCapacityArea(double d, double& area) const;

    /// Yield point of the bilinear curve of equal area through (dpi, api), anchored at the initial
    /// stiffness. ATC-40 8.2.2.1.1.
    [[nodiscard]] int BilinearizeAt(double dpi, double api, double& dy, double& ay) const;

    /// Sa of the capacity spectrum at d. 0 beyond the curve, the last point included.
    [[nodiscard]] int GetCapacityAccelAt(double d, double& Sa) const;

    /// Effective damping and reduction factors of a bilinear curve. ATC-40 (8-5) to (8-10).
    [[nodiscard]] int CalcReduction(double dy, double ay, double dpi, double api,
                                    T_PERFPT_REDUCTION& out) const;

    /// kappa of ATC-40 Table 8-1 for type 0 (A), 1 (B), 2 (C), or from the user's points for
    /// type 3, which may limit beta0 to beta2; 0 for other types. `fraction` is beta0 / 63.7.
    double GetDampingModificationFactor(int type, double& beta0, double fraction) const;

    /// True below the elastic damping setting, or within 0.001 of the constant 5 (not of the
    /// setting, on purpose).
    bool IsElasticDamping(double beta) const;

    /// Row of the FEMA 440 coefficient tables for a post-yield stiffness ratio, which is compared
    /// as a fraction or, where the settings say so, in per cent.
    int CoefficientRow(double alpha) const;

    /// Period of the radial line through a point, s.
    double PeriodOf(double Sd, double Sa) const;

private:
    const T_ADRS_CURVE& Capacity() const { return m_record.Capacity(); }

    const CPushOverPerfPtRecord& m_record;
};
