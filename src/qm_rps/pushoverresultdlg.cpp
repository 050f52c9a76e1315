#include "qm_rps/pushoverresultdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>

CPushOverResultDlg::CPushOverResultDlg(CDBDoc& doc)
    : m_doc(doc), m_results(PushResultsOf(doc)), m_reader(doc)
{
}

std::vector<std::string> CPushOverResultDlg::ResultTexts() const
{
    std::vector<std::string> names;
    for (const T_PUSH_RESULT_ID& id : m_results)
        names.push_back(id.name);
    return names;
}

void CPushOverResultDlg::OnSelChangeResult(int index)
{
    m_run = {};
    m_old.clear();
    m_error.clear();
    m_index = index >= 0 && index < std::ssize(m_results) ? index : -1;
    if (m_index >= 0) {
        const T_PUSH_RESULT_ID& id = m_results[static_cast<std::size_t>(m_index)];
        if (m_doc.Post().IsStale(id.key, m_old, id.turn))
            (void)ReadOldRun(m_doc, id, m_run, m_error);
        else
            (void)m_reader.Read(id.key, id.turn, m_run, m_error);
    }
    m_step = Steps();
    OnShown(true);
}

int CPushOverResultDlg::OnOpen(const std::string& name)
{
    const auto it = std::ranges::find(m_results, name, &T_PUSH_RESULT_ID::name);
    if (it == m_results.end()) return 0;
    OnSelChangeResult(static_cast<int>(it - m_results.begin()));
    return 1;
}

void CPushOverResultDlg::OnStep(int step)
{
    m_step = std::clamp(step, std::min(1, Steps()), Steps());
    OnShown(false);
}

std::string CPushOverResultDlg::TitleText() const
{
    return IsOld() ? Say("IDS_QM_UI_PUSH_OLD_NAME", m_run.name) : m_run.name;
}

std::string CPushOverResultDlg::StatusText() const
{
    if (m_index < 0) return Say("IDS_QM_UI_PUSH_NO_RESULT");
    if (!m_error.empty()) return m_error;
    return IsOld() ? m_old : m_run.advice;
}

std::string CPushOverResultDlg::StepText() const
{
    if (m_step < 1) return {};
    const auto i = static_cast<std::size_t>(m_step - 1);
    const T_PUSH_QUANTITY displacement = DisplacementIn(m_run.direction, Units());
    const T_PUSH_QUANTITY reaction = ReactionIn(m_run.direction, Units());
    return Say("IDS_QM_UI_PUSH_STEP_OF", std::to_string(m_step), std::to_string(Steps()),
               FormatText("%.5g", m_run.loadFactor[i]),
               FormatText("%.5g", displacement.Shown(m_run.displacement[i])) + " " +
                   displacement.Unit(),
               FormatText("%.5g", reaction.Shown(m_run.baseReaction[i])) + " " + reaction.Unit());
}
