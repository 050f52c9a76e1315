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

    /// 1 added; 0 the list is full (IDS_RPS_PUSHOVER_Maxnum_reached), the step does not exist
    /// (IDS_QM_NO_SUCH_STEP) or is listed already (IDS_PUSHOVER_Error___The_data_already_exist_).
    [[nodiscard]] int AddStep(int step, T_FINDING& refusal);
    void Clear() { m_steps.clear(); }

private:
    int m_stepCount = 0;
    std::vector<int> m_steps; // in the order of adding
};
