#include "qm_rps/factors/ulfiteration.h"

#include "qm_base/logfile.h"
#include "qm_base/msgfunction.h"
#include "qm_db/filectrl.h"
#include "qm_rps/ulfiterationresultdlg.h"

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
    if (!m_host.Solve(step.rows)) return Stop(ULF_ITER_END::NotSolved);
    step.tolerance = UlfIterTolerance(step.rows);
    m_history.push_back(std::move(step));
    if (m_solved) m_solved();
    return 1;
}

/// Head and block 0: over an existing report, or after it.
int CUlfIteration::WriteFirst()
{
    const std::string text =
        UlfIterHead(m_settings.required, m_settings.tolerance) + UlfIterBlock(m_history.front());
    std::error_code ignored;
    const bool add = std::filesystem::exists(m_report, ignored) &&
                     !AskYesNo("IDS_QM_ULF_REPORT_EXISTS",
                               MMSGFunction::Format("IDS_QM_ULF_REPORT_EXISTS", {m_report}));
    T_FILE_ERROR error;
    if (add ? CLogFile(m_report).Write(text) : CFileCtrl::WriteWholeFile(m_report, text, error))
        return 1;
    constexpr const char* key = "IDS_QM_ULF_REPORT_NOT_WRITTEN";
    ShowMessage(key, MMSGFunction::Format(key, {m_report}));
    return Stop(ULF_ITER_END::ReportNotWritten);
}

int CUlfIteration::AskForMore()
{
    if (!m_asks) return 1;
    CUlfIterationResultDlg dialog(m_history.back());
    dialog.SetView(View());
    const bool accepted = View() && View()->RunModal(dialog) != 0;
    if (!accepted || !dialog.m_iterate) return Stop(ULF_ITER_END::Declined);
    m_asks = !dialog.m_dontAsk;
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
        m_host.DispatchEvents();
        if (cancelled || !m_progress || m_progress(iteration - 1, m_settings.required)) continue;
        cancelled = true;
        m_host.CancelAnalysis();
    }
    if (started && m_host.IsPostMode()) return 1; // a request that came too late is heard again
    m_host.UndoEdit();
    const bool saved = m_host.SaveCopy(m_host.ModelPath()) != 0;
    return Stop(!cancelled ? ULF_ITER_END::NotAnalysed
                           : (saved ? ULF_ITER_END::Cancelled : ULF_ITER_END::NotSaved));
}

int CUlfIteration::Iterate(int iteration)
{
    if (!m_host.SaveCopy(UlfIterCopyPath(m_model, iteration))) return Stop(ULF_ITER_END::NotSaved);
    if (!Scale() || !Analyse(iteration) || !Solve(iteration)) return 0;
    if (!CLogFile(m_report).Write(UlfIterBlock(m_history.back()))) {
        constexpr const char* key = "IDS_QM_ULF_REPORT_NOT_WRITTEN";
        ShowMessage(key, MMSGFunction::Format(key, {m_report}));
        return Stop(ULF_ITER_END::ReportNotWritten);
    }
    if (m_settings.tolerance >= m_history.back().tolerance) return Stop(ULF_ITER_END::Converged);
    return AskForMore();
}

int CUlfIteration::Run()
{
    m_history.clear();
    m_asks = true;
    m_model = m_host.ModelPath();
    m_report = UlfIterReportPath(m_model);
    // The dialog comes before the report: who declines here leaves no report.
    if (!Solve(0)) return 0;
    if (!AskForMore()) return 1;
    if (!WriteFirst()) return 0;
    for (int done = 0;; ++done) {
        if (done >= m_settings.required) {
            m_end = ULF_ITER_END::Required;
            return 1;
        }
        if (m_progress && !m_progress(done, m_settings.required))
            return Stop(ULF_ITER_END::Cancelled);
        if (!Iterate(done + 1))
            return m_end == ULF_ITER_END::Converged || m_end == ULF_ITER_END::Declined;
    }
}
