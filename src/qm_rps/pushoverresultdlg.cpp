#include "qm_rps/pushoverresultdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushatpointtext.h"
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
    if (!m_points.points.empty())
        names.push_back(Say("IDS_QM_UI_PUSH_WITH_POINTS", m_points.push, m_points.evaluation));
    return names;
}

void CPushOverResultDlg::OnSelChangeResult(int index)
{
    m_run = {};
    m_old.clear();
    m_error.clear();
    const std::ptrdiff_t count = std::ssize(m_results) + (m_points.points.empty() ? 0 : 1);
    m_index = index >= 0 && index < count ? index : -1;
    if (m_index >= 0 && ShowsPoints()) {
        m_run = m_pointsRun;
    } else if (m_index >= 0) {
        const T_PUSH_RESULT_ID& id = m_results[static_cast<std::size_t>(m_index)];
        if (m_doc.Post().IsStale(id.key, m_old, id.turn))
            (void)ReadOldRun(m_doc, id, m_run, m_error);
        else
            (void)m_reader.Read(id.key, id.turn, m_run, m_error);
    }
    m_step = ShowsPoints() ? FirstPoint().step : Steps();
    OnShown(true);
}

/// What an evaluation asks for stands before what the structure can do.
const T_PUSH_AT_POINT& CPushOverResultDlg::FirstPoint() const
{
    const auto at = std::ranges::find_if(m_points.points, [](const T_PUSH_AT_POINT& p) {
        return p.point.kind != PUSH_POINT::Capacity;
    });
    return at == m_points.points.end() ? m_points.points.front() : *at;
}

int CPushOverResultDlg::OnShowPoints(const T_PUSH_EVALUATION& result,
                                     const PUSH_PROGRESS_FN& progress, std::string& error)
{
    T_PUSH_RUN run;
    T_HINGES_AT points = PushToEvaluation(m_doc, result, progress, run);
    error = points.push.empty()     ? Say("IDS_QM_UI_PUSH_POINTS_NO_PUSH", result.eval.push)
            : !points.note.empty()  ? points.note
            : points.points.empty() ? Say("IDS_QM_UI_PUSH_POINTS_NONE")
                                    : WhyNot(points.points.front().found);
    std::erase_if(points.points,
                  [](const T_PUSH_AT_POINT& at) { return at.found != AT_POINT::Reached; });
    if (points.points.empty()) return 0;
    m_points = std::move(points);
    m_pointsRun = std::move(run);
    OnSelChangeResult(static_cast<int>(std::ssize(m_results)));
    return 1;
}

std::vector<std::string> CPushOverResultDlg::PointTexts() const
{
    std::vector<std::string> names;
    if (ShowsPoints())
        for (const T_PUSH_AT_POINT& at : m_points.points)
            names.push_back(PointName(at.point));
    return names;
}

int CPushOverResultDlg::PointIndex() const
{
    if (!ShowsPoints()) return -1;
    const auto at = std::ranges::find(m_points.points, m_step, &T_PUSH_AT_POINT::step);
    return at == m_points.points.end() ? -1 : static_cast<int>(at - m_points.points.begin());
}

void CPushOverResultDlg::OnSelChangePoint(int index)
{
    if (ShowsPoints() && index >= 0 && index < std::ssize(m_points.points))
        OnStep(m_points.points[static_cast<std::size_t>(index)].step);
}

int CPushOverResultDlg::OnShowState(const std::string& state)
{
    const auto at = std::ranges::find_if(m_points.points, [&](const T_PUSH_AT_POINT& p) {
        return p.point.kind == PUSH_POINT::Demand && p.point.state == state;
    });
    if (!ShowsPoints() || at == m_points.points.end()) return 0;
    OnStep(at->step);
    return 1;
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

std::string CPushOverResultDlg::PointText() const
{
    const int point = PointIndex();
    if (point < 0) return {};
    return Say("IDS_QM_PLOT_PUSH_POINT_OF",
               PointName(m_points.points[static_cast<std::size_t>(point)].point),
               m_points.evaluation);
}

std::string CPushOverResultDlg::MarkName() const
{
    if (!ShowsPoints() || m_step < 1) return Say("IDS_QM_PLOT_PUSH_STEP", std::to_string(m_step));
    return Say("IDS_QM_PLOT_PUSH_AT", DisplacementText());
}

std::string CPushOverResultDlg::StepName() const
{
    const std::string point = PointText();
    return MarkName() + (point.empty() ? "" : " (" + point + ")");
}

std::string CPushOverResultDlg::DisplacementText() const
{
    const T_PUSH_QUANTITY displacement = DisplacementIn(m_run.direction, Units());
    return FormatText("%.5g", displacement.Shown(
                                  m_run.displacement[static_cast<std::size_t>(m_step - 1)])) +
           " " + displacement.Unit();
}

std::string CPushOverResultDlg::StepText() const
{
    if (m_step < 1) return {};
    const auto i = static_cast<std::size_t>(m_step - 1);
    const T_PUSH_QUANTITY reaction = ReactionIn(m_run.direction, Units());
    const std::string factor = FormatText("%.5g", m_run.loadFactor[i]);
    const std::string base =
        FormatText("%.5g", reaction.Shown(m_run.baseReaction[i])) + " " + reaction.Unit();
    if (ShowsPoints()) return Say("IDS_QM_UI_PUSH_STEP_AT", StepName(), factor, base);
    return Say("IDS_QM_UI_PUSH_STEP_OF", StepName(), std::to_string(Steps()), factor,
               DisplacementText(), base);
}
