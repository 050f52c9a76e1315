#include "qm_rps/pushoveradditionalstepdlg.h"

#include "qm_rps/pushover/evaluation/pushevaluator.h"
#include "qm_rps/pushover/refusal.h"

#include <algorithm>

int CPushOverAdditionalStepDlg::AddStep(int step, T_FINDING& refusal)
{
    if (m_steps.size() >= kMaxAdditional)
        return Refuse(refusal, "step", "IDS_RPS_PUSHOVER_Maxnum_reached");
    if (StepCount() < 1) return Refuse(refusal, "step", "IDS_QM_NO_STEPS", {std::to_string(step)});
    if (step < 1 || step > StepCount())
        return Refuse(refusal, "step", "IDS_QM_NO_SUCH_STEP",
                      {std::to_string(step), std::to_string(StepCount())});
    if (std::ranges::find(m_curve, step) == m_curve.end())
        return Refuse(refusal, "step", "IDS_QM_STEP_EVALUATED", {std::to_string(step)});
    if (std::ranges::find(m_steps, step) != m_steps.end())
        return Refuse(refusal, "step", "IDS_QM_STEP_LISTED", {std::to_string(step)});
    m_steps.push_back(step);
    return 1;
}

int CPushOverAdditionalStepDlg::OnAdd()
{
    T_FINDING refusal;
    if (AddStep(m_step, refusal)) return 1;
    ShowMessage(refusal.messageKey, refusal.text);
    return 0;
}

void CPushOverAdditionalStepDlg::OnRemove()
{
    if (m_row < 0 || m_row >= static_cast<int>(m_steps.size())) return;
    m_steps.erase(m_steps.begin() + m_row);
    m_row = -1;
}
