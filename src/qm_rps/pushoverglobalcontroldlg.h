// Model of the dialog of the global control of the pushover analysis: initial loads, P-Delta,
// increments, failed hinges, hinge types that act, limits of a run. All load cases follow it where
// they have nothing of their own.
#pragma once

#include "qm_rps/rpsdlgbase.h"

class CPushOverGlobalControlDlg : public CRPSDlgBase {
public:
    /// Takes the document and reads its global control.
    void SetDoc(CDBDoc* doc) override;

    T_POGC_D m_control;

    /// Rules of the control that are not kept, in the order of the check.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores as one edit that can be undone. 0 with a message: a rule is not kept, or
    /// another edit is open; the document as it was.
    int OnOK() override;
};
