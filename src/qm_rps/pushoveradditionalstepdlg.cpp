#include "qm_rps/pushoveradditionalstepdlg.h"

#include "qm_base/msgfunction.h"

#include <algorithm>

int CPushOverAdditionalStepDlg::AddStep(int step)
{
    if (m_steps.size() >= kMaxAdditional) {
        ShowMessage("IDS_RPS_PUSHOVER_Maxnum_reached");
        return 0;
    }
    if (step < 1 || step > m_stepCount) {
        ShowMessage(
            "IDS_QM_NO_SUCH_STEP",
            zql::lib::MMSGFunction::Format("IDS_QM_NO_SUCH_STEP",
                                           {std::to_string(step), std::to_string(m_stepCount)}));
        return 0;
    }
    if (std::ranges::find(m_steps, step) != m_steps.end()) {
        ShowMessage("IDS_PUSHOVER_Error___The_data_already_exist_");
        return 0;
    }
    m_steps.push_back(step);
    return 1;
}

int CPushOverAdditionalStepDlg::RemoveStep(int step)
{
    return std::erase(m_steps, step) > 0 ? 1 : 0;
}
