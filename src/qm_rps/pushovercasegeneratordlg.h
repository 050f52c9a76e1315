// Model of the dialog that makes pushover load cases at once: both ways along X and Y, two
// patterns, eccentricities.
#pragma once

#include "qm_rps/push/casegenerator.h"
#include "qm_rps/rpsdlgbase.h"

class CPushOverCaseGeneratorDlg : public CRPSDlgBase {
public:
    /// Takes the document and chooses the directions in which its model can be pushed.
    void SetDoc(CDBDoc* doc) override;

    T_CASE_CHOICE m_choice;

    /// What the last OnOK made the cases with, in words: node, target, modes.
    std::string BasisText() const;
    /// Makes the cases and stores them as one edit that can be undone. 0 with a message, the
    /// document as it was.
    int OnOK() override;

private:
    T_CASE_BASIS m_basis;
    bool m_isTargetGiven = false;
};
