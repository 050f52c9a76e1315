// Model of the dialog of user-defined P-M interaction curves.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/records.h"
#include "qm_rps/hinge/hingelabels.h"

class CPushOverPMMInteractionDlg : public CCheckedDialog {
public:
    T_HINGE_OWNER m_owner; // for titles and units

    /// Edits a copy; OnOK writes the whole table back to `record`, which is not owned.
    explicit CPushOverPMMInteractionDlg(T_PMM_TABLE& record) : m_table(record), m_record(record) {}

    T_PMM_TABLE m_table; // as edited; ratios, Pmax a force

    /// (-) as (+), or on its own, starting from the curves of (+).
    void OnSameSidesChk(bool same);
    bool IsSameSides() const { return !m_table.negative; }

    /// See PmmFindings.
    std::vector<T_FINDING> Findings() const override;
    /// 1 and the record holds the table; 0 and the record is unchanged.
    int OnOK() override;

private:
    T_PMM_TABLE& m_record;
};
