#include "qm_rps/pushovercurvedlg.h"

#include "qm_rps/pushover/releaseassert.h"
#include "qm_rps/pushovercalculators.h"

CPushOverCurveDlg::CPushOverCurveDlg(CDBDoc& doc) : m_evaluator(doc, RunPerfPtProcedure) {}

int CPushOverCurveDlg::SetEvaluation(const T_EVAL_D& evaluation)
{
    return m_evaluator.SetEvaluation(evaluation, m_refusal);
}

int CPushOverCurveDlg::Evaluate()
{
    ClearMessages();
    m_additionalSteps.Clear();
    const int result = m_evaluator.Evaluate();
    for (const zql::frx::T_MESSAGE& m : Result().messages)
        ShowMessage(m.key, m.text);
    return result;
}

int CPushOverCurveDlg::ShowRefusal()
{
    ShowMessage(m_refusal.messageKey, m_refusal.text);
    return 0;
}

int CPushOverCurveDlg::CalcAdditionalPerformancePoint(const std::string& spectrum)
{
    if (!m_evaluator.CalcAdditionalPerformancePoint(spectrum, m_refusal)) return ShowRefusal();
    return 1;
}

int CPushOverCurveDlg::OnPushoverCurveAddStep(int step)
{
    m_additionalSteps.SetCurve(Result().steps);
    if (!m_additionalSteps.AddStep(step, m_refusal)) return ShowRefusal();
    m_evaluator.ListStep(step);
    return 1;
}

int CPushOverCurveDlg::ExistEC8() const
{
    ReleaseAssert("src/qm_rps/pushovercurvedlg", __LINE__);
    return 0;
}
