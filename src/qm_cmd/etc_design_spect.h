// Design spectrum: elastic acceleration ordinates in g over periods in s, reducible for damping.
//
// Every spectrum is Sa(T) = min(SRa * A(T), SRv * V(T)), with A the acceleration branch (ramp and
// plateau, the plateau continued to the right) and V the velocity branch (1/T continued to the
// left, 1/T2 beyond TD). The unreduced spectrum has SRa = SRv = 1.
// Code spectra stand on the grid 0, 0.01 ... 10 s with their corner periods added.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_cmd/spectralreduction.h"
#include "qm_db/records.h"

#include <algorithm>
#include <limits>
#include <memory>
#include <optional>
#include <vector>

/// A code spectrum in one form: ramp from a0 at T = 0 to the plateau at TB, plateau to TC,
/// plateau * TC / T to TD, plateau * TC * TD / T2 beyond.
struct T_SPECT_SHAPE {
    double a0 = 0.0;      // g
    double plateau = 0.0; // g
    double TB = 0.0, TC = 0.0;
    double TD = std::numeric_limits<double>::infinity();

    /// Acceleration branch: ramp, then the plateau for all T.
    double AccelAt(double T) const { return T < TB ? a0 + (plateau - a0) * T / TB : plateau; }
    /// Velocity branch, T > 0.
    double VelocityAt(double T) const
    {
        return T > TD ? plateau * TC * TD / (T * T) : plateau * TC / T;
    }
    double SaAt(double T) const
    {
        return T > 0.0 ? std::min(AccelAt(T), VelocityAt(T)) : AccelAt(0.0);
    }
};

class CETC_DESIGN_SPECT {
public:
    /// behaviorType: structural behaviour 0 to 3, for the floors of the reduction factors.
    /// limitState: LIMIT_STATE as int, read by spectra that have several. showMode: how a window
    /// shows it. The parent is not owned and may be null.
    CETC_DESIGN_SPECT(const T_SPFC_D& record, int behaviorType, int limitState, int showMode,
                      zql::frx::MDialog* parent = nullptr);
    virtual ~CETC_DESIGN_SPECT() = default;
    CETC_DESIGN_SPECT(const CETC_DESIGN_SPECT&) = delete;
    CETC_DESIGN_SPECT& operator=(const CETC_DESIGN_SPECT&) = delete;

    /// The spectrum with its constant-acceleration ordinates times SRa and its constant-velocity
    /// ordinates times SRv (after the floors, where this spectrum has them). Periods ascending;
    /// both arrays of equal length. Keeps the arrays' memory when they are large enough.
    void CalcPOSpectrumSRaSRv(double SRa, double SRv, std::vector<double>& T,
                              std::vector<double>& Sa) const;

    /// Periods of the grid, ascending, s.
    const std::vector<double>& Periods() const { return m_T; }
    /// One ordinate of CalcPOSpectrumSRaSRv, at grid point i.
    double CalcPOOrdinate(double SRa, double SRv, std::size_t i) const;

    /// The spectrum for an effective damping in per cent: by the code's own damping correction
    /// where it has one, else by SRA and SRV. 1 done; 0 the damping is not above 0.
    [[nodiscard]] int CalcPOSpectrumByDamping(double betaPct, std::vector<double>& T,
                                              std::vector<double>& Sa) const;

    /// Recomputes the grid and the two branches from the record.
    virtual void CalcCurrentPOSpectra();

    /// Elastic ordinate in g at exactly T, at the record's own damping, from the formula.
    virtual double CalcSaAt(double T) const;
    /// End of the constant-acceleration range, s.
    virtual double CornerPeriod() const { return m_shape.TC; }
    /// Of a code spectrum, at its own damping; of a table only TC.
    const T_SPECT_SHAPE& Shape() const { return m_shape; }
    /// Gravity that the spectrum itself states, m/s2 in SI; absent for code spectra.
    virtual std::optional<double> GravitySi() const { return std::nullopt; }

    /// Multiplies every ordinate of the record by a factor above 0; periods stay.
    void ScaleBy(double factor);

    void SetCurrentDlg(int dlg) { m_currentDlg = dlg; }
    void SetShowMode(int mode) { m_showMode = mode; }
    int GetCurrentDlg() const { return m_currentDlg; }
    int GetShowMode() const { return m_showMode; }

protected:
    /// Shape of the code spectrum at a damping in per cent.
    virtual T_SPECT_SHAPE CalcShape(double dampingPct) const;
    /// Damping that the record itself states, per cent.
    virtual double OwnDamping() const { return 5.0; }
    /// True where the damping changes the shape itself (the eta of the European codes).
    virtual bool HasDampingRule() const { return false; }
    /// True where the lower bounds of SRA and SRV apply.
    bool HasFloors() const;

    /// Fills grid and branches for a shape of the record, times the factor.
    void SetBranches(const T_SPECT_SHAPE& shape);

    T_SPFC_D m_record;
    double m_factor = 1.0; // on the ordinates
    int m_behaviorType = 0;
    int m_limitState = 0;
    T_SPECT_SHAPE m_shape;
    std::vector<double> m_T, m_A, m_V; // periods, acceleration branch, velocity branch

private:
    int m_showMode = 0;
    int m_currentDlg = 0;
};

/// EN 1998-1:2004 elastic spectrum, type 1 or 2 (Tables 3.2 and 3.3).
class CETC_GDS_EURO2003 : public CETC_DESIGN_SPECT {
public:
    CETC_GDS_EURO2003(const T_SPFC_D& record, zql::frx::MDialog* parent, int showMode);

protected:
    T_SPECT_SHAPE CalcShape(double dampingPct) const override;
    double OwnDamping() const override;
    bool HasDampingRule() const override { return true; }
};

/// ENV 1998-1-1:1994 elastic spectrum.
class CETC_GDS_EURO1996_ELA : public CETC_DESIGN_SPECT {
public:
    explicit CETC_GDS_EURO1996_ELA(const T_SPFC_D& record, zql::frx::MDialog* parent = nullptr);

protected:
    T_SPECT_SHAPE CalcShape(double dampingPct) const override;
    double OwnDamping() const override;
    bool HasDampingRule() const override { return true; }
};

/// NTC 2008/2018 3.2.3.2.1 elastic spectrum of one limit state.
class CETC_GDS_NTC : public CETC_DESIGN_SPECT {
public:
    CETC_GDS_NTC(const T_SPFC_D& record, LIMIT_STATE state, zql::frx::MDialog* parent = nullptr);

protected:
    T_SPECT_SHAPE CalcShape(double dampingPct) const override;
    double OwnDamping() const override;
    bool HasDampingRule() const override { return true; }
};

/// A table of periods and ordinates, used as given.
class CETC_GDS_USER : public CETC_DESIGN_SPECT {
public:
    explicit CETC_GDS_USER(const T_SPFC_D& record, zql::frx::MDialog* parent = nullptr);
    void CalcCurrentPOSpectra() override;
    double CalcSaAt(double T) const override;
    std::optional<double> GravitySi() const override;
};

/// The spectrum object of a record. `state` is read by NTC spectra only; null when that limit
/// state is not enabled there.
std::unique_ptr<CETC_DESIGN_SPECT> MakeDesignSpectrum(const T_SPFC_D& record, int behaviorType,
                                                      LIMIT_STATE state);
