// Model of the window that shows a push by storey: displacement, drift and shear over the height.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/pushoverresultdlg.h"

enum class STOREY_VALUE { Displacement, Drift, Shear };

class CPushOverStoreyDlg : public CPushOverResultDlg {
public:
    explicit CPushOverStoreyDlg(CDBDoc& doc) : CPushOverResultDlg(doc) { ShowFirst(); }

    /// Storeys with values: not of a turn about an axis, nor of results that are out of date.
    bool HasStoreys() const { return Step() > 0 && Run().direction < 3 && !Run().storeys.empty(); }
    bool m_envelope = true; // the values that are largest over all steps, too
    /// Storeys from the top down: elevation, then each value at the step and its envelope.
    T_TEXT_TABLE Table() const;

private:
    void OnShown(bool) override {}
};

/// The values of a storey, by step; empty: not known.
const std::vector<double>& ValuesOf(const T_PUSH_STOREY_SERIES& storey, STOREY_VALUE value);
/// The one with the largest magnitude, with its sign; values must not be empty.
double Envelope(const std::vector<double>& values);
