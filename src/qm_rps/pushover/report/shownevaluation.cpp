#include "qm_rps/pushover/report/shownevaluation.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/pushover/report/pushovercells.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

bool HasPicture(const T_PUSH_EVALUATION& e)
{
    if (IsOtherPlot(e)) return e.curve.x.size() > 1;
    const auto code = e.outcome.code;
    const bool noSpectrum = code == PUSH_OUTCOME::NoCapacity || code == PUSH_OUTCOME::NoEigen ||
                            code == PUSH_OUTCOME::EigenError ||
                            code == PUSH_OUTCOME::ConversionFailed;
    return !noSpectrum && e.capacity.Sd.size() > 1;
}

} // namespace

void CShownEvaluation::Take(const T_PUSH_EVALUATION& result)
{
    ++m_turn;
    m_result = result;
    m_refused.clear();
    m_noPicture.clear();
    if (HasPicture(m_result))
        m_pictured = m_result;
    else
        m_noPicture = m_result.messages.empty() ? OutcomeAdvice(m_result.outcome)
                                                : m_result.messages.back().text;
    SetTrial(m_trial);
}

std::string CShownEvaluation::Refusal() const
{
    if (!m_refused.empty()) return MMSGFunction::Format("IDS_QM_UI_PUSH_REFUSED", {m_refused});
    if (m_noPicture.empty()) return {};
    return MMSGFunction::Format("IDS_QM_UI_PUSH_NO_PICTURE", {m_noPicture});
}

void CShownEvaluation::SetTrial(int trial)
{
    m_trial = std::clamp(trial, 0, TrialCount());
}

std::string CShownEvaluation::CaseText() const
{
    constexpr std::array kPatterns{"IDS_PUSHOVER_Static_Load", "IDS_PUSHOVER_Accerelation",
                                   "IDS_PUSHOVER_Mode_Shape", "IDS_PUSHOVER_Mode_Shape_Story_Mass"};
    const T_POLC_D& polc = m_pictured.loadCase;
    if (polc.name.empty()) return {};
    const char* const direction = kDirectionNames.at(static_cast<std::size_t>(polc.direction - 1));
    return MMSGFunction::Format("IDS_PUSHOVER_Control_Node___d__Dir____",
                                {std::to_string(polc.controlNode), direction}) +
           "; " +
           MMSGFunction::Format(
               "IDS_PUSHOVER_Master_Load_Pattern",
               {MMSGFunction::GetValue(kPatterns.at(static_cast<std::size_t>(polc.patternKind)))});
}
