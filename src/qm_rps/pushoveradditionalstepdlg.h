// Model of the dialog for additional steps: steps of the curve that the engineer wants listed and
// drawn beside the result. At most 10.
#pragma once

#include "qm_base/finding.h"
#include "qm_base/mdialog.h"

#include <vector>

class CPushOverAdditionalStepDlg : public zql::frx::MDialog {
public:
    /// Steps that exist: 1 to stepCount.
    void SetStepCount(int stepCount) { m_stepCount = stepCount; }
    int StepCount() const { return m_stepCount; }

    /// 1 added; 0 the list is full (IDS_RPS_PUSHOVER_Maxnum_reached), there are no steps
    /// (IDS_QM_NO_STEPS), this one does not exist (IDS_QM_NO_SUCH_STEP) or is listed already
    /// (IDS_QM_STEP_LISTED).
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
    int m_stepCount = 0;
    std::vector<int> m_steps;
};
