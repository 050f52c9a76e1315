// Model of the dialog for additional steps: steps of the curve that the engineer wants listed and
// drawn beside the result. At most 10.
#pragma once

#include "qm_base/finding.h"
#include "qm_base/mdialog.h"

#include <vector>

class CPushOverAdditionalStepDlg : public zql::frx::MDialog {
public:
    /// Numbers of the steps of the curve, ascending; 0 is none.
    void SetCurve(std::vector<int> steps) { m_curve = std::move(steps); }
    /// The last one.
    int StepCount() const { return m_curve.empty() ? 0 : m_curve.back(); }

    /// 1 added; 0 the list is full (IDS_RPS_PUSHOVER_Maxnum_reached), there are no steps
    /// (IDS_QM_NO_STEPS), this one does not exist (IDS_QM_NO_SUCH_STEP), is not on the curve
    /// (IDS_QM_STEP_EVALUATED) or is listed already (IDS_QM_STEP_LISTED).
    [[nodiscard]] int AddStep(int step, T_FINDING& refusal);
    void Clear() { m_steps.clear(); }
    /// In the order of adding.
    const std::vector<int>& Steps() const { return m_steps; }

    // ---- the window ----
    int m_step = 1; // to be added
    int m_row = -1; // chosen in the list
    /// Adds m_step; 0 shows why not.
    int OnAdd();
    /// Takes the chosen step off the list.
    void OnRemove();

private:
    std::vector<int> m_curve, m_steps;
};
