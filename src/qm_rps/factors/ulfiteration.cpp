#include "qm_rps/factors/ulfiteration.h"

#include "qm_base/msgfunction.h"
#include "qm_db/filectrl.h"

#include <filesystem>

using zql::lib::MMSGFunction;

int CUlfIteration::Stop(ULF_ITER_END end)
{
    m_end = end;
    return 0;
}

int CUlfIteration::Solve(int iteration)
{
    T_ULF_ITER_STEP step{iteration, m_host.ModelPath(), {}, 0.0};
    std::optional<T_FINDING> said;
    const bool solved = m_host.Solve(step.rows, said) != 0;
    if (said) m_said = said;
    if (!solved) return Stop(ULF_ITER_END::NotSolved);
    step.tolerance = UlfIterTolerance(step.rows);
    m_history.push_back(std::move(step));
    m_person.Solved(m_history.back(), said);
    return 1;
}

int CUlfIteration::RefuseReport()
{
    m_said.emplace();
    m_said->messageKey = "IDS_QM_ULF_REPORT_NOT_WRITTEN";
    m_said->text = MMSGFunction::Format(m_said->messageKey, {m_report});
    return Stop(ULF_ITER_END::ReportNotWritten);
}

/// Head and block 0: over an existing report, or after it.
int CUlfIteration::WriteFirst()
{
    const std::string text =
        UlfIterHead(m_settings.required, m_settings.tolerance) + UlfIterBlock(m_history.front());
    std::error_code ignored;
    const bool add = std::filesystem::exists(m_report, ignored) && !m_person.MayOverwrite(m_report);
    T_FILE_ERROR error;
    m_reportText.clear();
    m_isPipe = add && !std::filesystem::is_regular_file(m_report, ignored);
    if (add && !m_isPipe && !CFileCtrl::ReadWholeFile(m_report, m_reportText, error))
        return RefuseReport();
    return AddToReport(text);
}

/// The report is written as a whole: a full disk leaves the blocks before. A pipe keeps nothing.
int CUlfIteration::AddToReport(const std::string& text)
{
    if (m_isPipe) m_reportText.clear();
    m_reportText += text;
    T_FILE_ERROR error;
    return CFileCtrl::WriteWholeFile(m_report, m_reportText, error) ? 1 : RefuseReport();
}

int CUlfIteration::AskForMore()
{
    if (!m_asks) return 1;
    const ULF_ITER_WISH wish = m_person.Wish(m_history.back());
    if (wish == ULF_ITER_WISH::Stop) return Stop(ULF_ITER_END::Declined);
    m_asks = wish == ULF_ITER_WISH::Iterate;
    return 1;
}

int CUlfIteration::Scale()
{
    constexpr const char* key = "IDS_RPS_CHANGE_LOAD_VALUES_FOR_ITERATIVE_ANALYSIS";
    if (!m_host.StartEdit(MMSGFunction::GetValue(key))) return Stop(ULF_ITER_END::NotScaled);
    const std::vector<T_ULF_ITER_ROW>& rows = m_history.back().rows;
    int done = 1;
    for (std::size_t i = 0; done && i < rows.size(); ++i)
        done = m_host.ScalePretension(i, rows[i].factor);
    if (done && m_host.CloseEdit()) return 1;
    m_host.CancelEdit(); // the loads stay those of the iteration before
    return Stop(ULF_ITER_END::NotScaled);
}

int CUlfIteration::Analyse(int iteration)
{
    bool cancelled = false;
    const bool started = m_host.StartAnalysis() != 0;
    while (started && m_host.IsExcuted()) {
        const bool goesOn = m_person.GoesOn(iteration - 1, m_settings.required);
        if (!goesOn && !cancelled) m_host.CancelAnalysis();
        cancelled |= !goesOn;
        m_host.Wait();
    }
    if (started && m_host.IsPostMode()) return 1; // a request that came too late is heard again
    m_host.UndoEdit();
    const bool saved = m_host.SaveCopy(m_host.ModelPath()) != 0;
    return Stop(!cancelled ? ULF_ITER_END::NotAnalysed
                           : (saved ? ULF_ITER_END::Cancelled : ULF_ITER_END::NotSaved));
}

int CUlfIteration::SaveCopy(int iteration)
{
    const std::string copy = UlfIterCopyPath(m_model, iteration);
    std::error_code ignored;
    if (!m_replaces && std::filesystem::exists(copy, ignored)) {
        m_replaces = m_person.MayReplace(copy);
        if (!m_replaces) {
            m_said.emplace();
            m_said->messageKey = "IDS_QM_ULF_COPY_KEPT";
            m_said->text = MMSGFunction::Format(m_said->messageKey, {copy});
            return Stop(ULF_ITER_END::NotSaved);
        }
    }
    return m_host.SaveCopy(copy) ? 1 : Stop(ULF_ITER_END::NotSaved);
}

int CUlfIteration::Iterate(int iteration)
{
    if (!SaveCopy(iteration) || !Scale() || !Analyse(iteration) || !Solve(iteration)) return 0;
    if (!AddToReport(UlfIterBlock(m_history.back()))) return 0;
    if (m_settings.tolerance >= m_history.back().tolerance) return Stop(ULF_ITER_END::Converged);
    return AskForMore();
}

int CUlfIteration::Run()
{
    m_history.clear();
    m_said.reset();
    m_asks = true;
    m_replaces = false;
    m_model = m_host.ModelPath();
    m_report = UlfIterReportPath(m_model);
    // The question comes before the report: who declines here leaves no report.
    if (!Solve(0)) return 0;
    if (!AskForMore()) return 1;
    if (!WriteFirst()) return 0;
    for (int done = 0;; ++done) {
        if (done >= m_settings.required) {
            m_end = ULF_ITER_END::Required;
            return 1;
        }
        if (!m_person.GoesOn(done, m_settings.required)) return Stop(ULF_ITER_END::Cancelled);
        if (!Iterate(done + 1))
            return m_end == ULF_ITER_END::Converged || m_end == ULF_ITER_END::Declined;
    }
}
