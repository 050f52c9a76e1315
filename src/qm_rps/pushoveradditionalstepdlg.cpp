#include "qm_rps/pushoveradditionalstepdlg.h"

#include "qm_rps/pushover/evaluation/pushevaluator.h"
#include "qm_rps/pushover/refusal.h"

#include <algorithm>

int CPushOverAdditionalStepDlg::AddStep(int step, T_FINDING& refusal)
{
    if (m_steps.size() >= kMaxAdditional)
        return Refuse(refusal, "step", "IDS_RPS_PUSHOVER_Maxnum_reached");
    if (step < 1 || step > m_stepCount)
        return Refuse(refusal, "step", "IDS_QM_NO_SUCH_STEP",
                      {std::to_string(step), std::to_string(m_stepCount)});
    if (std::ranges::find(m_steps, step) != m_steps.end())
        return Refuse(refusal, "step", "IDS_PUSHOVER_Error___The_data_already_exist_");
    m_steps.push_back(step);
    return 1;
}
