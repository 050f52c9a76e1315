// Model of the dialog of the options of plastic hinges and of the design codes, which hold for the
// whole model.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"

class CHingeOptionsDlg : public CCheckedDialog {
public:
    /// The document must outlive the dialog.
    explicit CHingeOptionsDlg(CDBDoc& doc);

    bool m_alternativeHysteresis = false, m_wallStrengthDegradation = false, m_gsd = false;
    std::string m_concreteCode, m_steelCode; // empty: none
    /// Stiffness reduction ratios of new multilinear curves, (+) and (-).
    std::array<double, 2> m_alpha1{}, m_alpha2{};

    /// Codes that are offered: none, those with a mode of their own, and the one in use.
    static std::vector<std::string> ConcreteCodes(const std::string& inUse);
    static std::vector<std::string> SteelCodes(const std::string& inUse);
    /// What the pair of codes means for the strength calculation.
    std::string ModeText() const;

    /// Ratios are not negative.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores all of them as one edit that can be undone. 0: refused, nothing changed.
    int OnOK() override;

private:
    CDBDoc& m_doc;
};
