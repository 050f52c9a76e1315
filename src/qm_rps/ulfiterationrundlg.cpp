#include "qm_rps/ulfiterationrundlg.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/factors/checks/ulfitemchecks.h"
#include "qm_rps/factors/ulfanalysis.h"
#include "qm_rps/ulfiterationdochost.h"
#include "qm_rps/unknownloadfactoriteranaldlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"

#include <algorithm>
#include <filesystem>

using zql::lib::MMSGFunction;

namespace {

struct T_END_KEY {
    ULF_ITER_END end;
    const char* key;
};
constexpr T_END_KEY kEnds[] = {
    {ULF_ITER_END::Converged, "IDS_QM_UI_ULF_CONVERGED"},
    {ULF_ITER_END::Required, "IDS_QM_UI_ULF_NOT_CONVERGED"},
    {ULF_ITER_END::Declined, "IDS_QM_UI_ULF_DECLINED"},
    {ULF_ITER_END::Cancelled, "IDS_QM_UI_ULF_CANCELLED"},
    {ULF_ITER_END::NotSolved, "IDS_QM_UI_ULF_NOT_SOLVED"},
    {ULF_ITER_END::ReportNotWritten, "IDS_QM_UI_ULF_NO_REPORT"},
    {ULF_ITER_END::NotSaved, "IDS_QM_UI_ULF_NOT_SAVED"},
    {ULF_ITER_END::NotScaled, "IDS_QM_UI_ULF_NOT_SCALED"},
    {ULF_ITER_END::NotAnalysed, "IDS_QM_UI_ULF_NOT_ANALYSED"},
};

std::string TextOf(ULF_ITER_END end, const std::string& reason)
{
    const auto* it = std::ranges::find(kEnds, end, &T_END_KEY::end);
    const std::string text = MMSGFunction::GetValue(it->key);
    return reason.empty() ? text : text + "\n" + reason;
}

std::string NumberText(const std::optional<double>& value)
{
    return value ? FormatText("%.7g", *value + 0.0) : std::string();
}

std::string RunningText(int iterations, int required)
{
    return MMSGFunction::Format("IDS_QM_UI_ULF_RUNNING",
                                {std::to_string(iterations), std::to_string(required)});
}

/// While it lives, the flag is set.
struct T_RUNNING {
    bool& flag;
    explicit T_RUNNING(bool& f) : flag(f) { flag = true; }
    ~T_RUNNING() { flag = false; }
    T_RUNNING(const T_RUNNING&) = delete;
    T_RUNNING& operator=(const T_RUNNING&) = delete;
};

} // namespace

CUlfIterationRunDlg::CUlfIterationRunDlg(CDBDoc& doc, int item) : m_doc(doc), m_item(item)
{
    const std::vector<int> keys = ItemKeys();
    if (std::ranges::find(keys, item) == keys.end()) m_item = keys.empty() ? 0 : keys.front();
}

std::vector<int> CUlfIterationRunDlg::ItemKeys() const
{
    std::vector<int> keys;
    for (const auto& entry : m_doc.Data().Model().ulfStageItems)
        keys.push_back(entry.first);
    return keys;
}

T_ULF_ITER_ITEM CUlfIterationRunDlg::Item() const
{
    if (m_given) return *m_given;
    const T_TABLE<T_ULSI_D>& items = m_doc.Data().Model().ulfStageItems;
    const auto it = items.find(m_item);
    return it == items.end() ? T_ULF_ITER_ITEM() : T_ULF_ITER_ITEM{m_item, it->second};
}

std::vector<std::string> CUlfIterationRunDlg::ItemTexts() const
{
    if (m_given) return {m_given->record.name};
    std::vector<std::string> names;
    for (const auto& entry : m_doc.Data().Model().ulfStageItems)
        names.push_back(entry.second.name);
    return names;
}

int CUlfIterationRunDlg::ItemIndex() const
{
    if (m_given) return 0;
    const std::vector<int> keys = ItemKeys();
    const auto it = std::ranges::find(keys, m_item);
    return it == keys.end() ? -1 : static_cast<int>(it - keys.begin());
}

void CUlfIterationRunDlg::OnSelChangeItem(int index)
{
    const std::vector<int> keys = ItemKeys();
    if (m_given || m_running || index < 0 || index >= std::ssize(keys)) return;
    m_item = keys[static_cast<std::size_t>(index)];
    Clear();
}

void CUlfIterationRunDlg::Clear()
{
    m_history.clear();
    m_result.reset();
    m_analysed.clear();
    m_stays.clear();
    m_status.clear();
    m_step = -1;
}

int CUlfIterationRunDlg::OnShowResult()
{
    if (!m_result || m_running) return 0;
    CUnknownLoadFactorResultDlg dialog(m_doc, *m_result);
    dialog.SetView(View());
    (void)dialog.DoModal();
    return 1;
}

T_ULF_ITER_SETTINGS CUlfIterationRunDlg::Settings() const
{
    const auto* settings = CUnknownLoadFactorIterAnal::Of(m_doc.DynModules());
    return settings ? settings->Settings() : T_ULF_ITER_SETTINGS();
}

int CUlfIterationRunDlg::OnSettings()
{
    auto* settings = CUnknownLoadFactorIterAnal::Of(m_doc.DynModules());
    if (!settings || m_running) return 0;
    CUnknownLoadFactorIterAnalDlg dialog(*settings);
    dialog.SetView(View());
    return dialog.DoModal();
}

void CUlfIterationRunDlg::Tell(std::string status)
{
    m_status = std::move(status);
    if (m_changed) m_changed();
}

int CUlfIterationRunDlg::Fail(const std::string& text)
{
    Tell(text);
    return 0;
}

bool CUlfIterationRunDlg::OnClose()
{
    if (m_running) OnCancelRun();
    return !m_running;
}

std::string CUlfIterationRunDlg::StatusText() const
{
    return m_status.empty() ? MMSGFunction::GetValue("IDS_QM_UI_ULF_READY") : m_status;
}

int CUlfIterationRunDlg::Analyse()
{
    if (m_doc.Post().CheckStagedResult()) return 1;
    Tell(MMSGFunction::GetValue("IDS_QM_UI_ANALYSING"));
    const auto goesOn = [this](std::size_t, std::size_t) {
        if (View()) View()->DispatchEvents();
        return !m_cancel;
    };
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    T_ANALYSIS_ERROR error;
    if (RunWatchedAnalysis(m_doc, options, goesOn, error)) return 1;
    const bool cancelled = error.fault == ANALYSIS_FAULT::Cancelled;
    return Fail(TextOf(cancelled ? ULF_ITER_END::Cancelled : ULF_ITER_END::NotAnalysed,
                       cancelled ? std::string() : error.text));
}

int CUlfIterationRunDlg::OnRun()
{
    if (m_running) return 0;
    const T_RUNNING running(m_running);
    m_cancel = false;
    Clear();
    const int done = Start();
    GSaveHistoryFormatNF("%s", StatusText().c_str());
    return done;
}

void CUlfIterationRunDlg::Solved(const T_ULF_ITER_STEP& step, const std::optional<T_FINDING>& said)
{
    if (said) ShowMessage(said->messageKey, said->text);
    m_history.push_back(step);
    m_step = static_cast<int>(m_history.size()) - 1;
    Tell(RunningText(step.iteration, Settings().required));
}

ULF_ITER_WISH CUlfIterationRunDlg::Wish(const T_ULF_ITER_STEP& step)
{
    CUlfIterationResultDlg dialog(step);
    dialog.SetView(View());
    if (!dialog.DoModal() || !dialog.m_iterate) return ULF_ITER_WISH::Stop;
    return dialog.m_dontAsk ? ULF_ITER_WISH::IterateUnasked : ULF_ITER_WISH::Iterate;
}

bool CUlfIterationRunDlg::MayOverwrite(const std::string& report)
{
    constexpr const char* key = "IDS_QM_ULF_REPORT_EXISTS";
    return AskYesNo(key, MMSGFunction::Format(key, {report}));
}

bool CUlfIterationRunDlg::MayReplace(const std::string& copy)
{
    constexpr const char* key = "IDS_QM_ULF_COPY_EXISTS";
    return AskYesNo(key, MMSGFunction::Format(key, {copy}));
}

bool CUlfIterationRunDlg::GoesOn(int done, int required)
{
    std::string status = RunningText(done, required);
    if (status != m_status) Tell(std::move(status));
    if (View()) View()->DispatchEvents(); // a cancel that came while the factors were found
    return !m_cancel;
}

int CUlfIterationRunDlg::Start()
{
    // Copies and report stand beside the model.
    if (m_doc.Path().empty()) return Fail(MMSGFunction::GetValue("IDS_QM_UI_ULF_SAVE_FIRST"));
    const T_ULF_ITER_ITEM item = Item();
    const auto findings = CheckUlfStageItem(item.record, item.key, m_doc.Data());
    if (!findings.empty()) return Fail(findings.front().text);
    if (!Analyse()) return 0;

    CUlfIterationDocHost host(m_doc, item.record);
    CUlfIteration run(host, *this, Settings());
    const int done = run.Run();
    m_result = host.Result();
    if (run.History().size() > 1) { // something was applied
        m_analysed = host.Analysed(Settings().tolerance);
        m_stays = host.Stays();
    }
    const ULF_ITER_END end = run.End();
    if (end == ULF_ITER_END::NotSolved || end == ULF_ITER_END::ReportNotWritten)
        ShowMessage(run.Said()->messageKey, run.Said()->text);
    const bool isKept = end == ULF_ITER_END::NotSaved && host.Error().empty() && run.Said();
    Tell(EndText(run, isKept ? run.Said()->text : host.Error()));
    return done;
}

std::string CUlfIterationRunDlg::EndText(const CUlfIteration& run, const std::string& reason) const
{
    if (run.End() == ULF_ITER_END::Required && Settings().required == 0)
        return MMSGFunction::GetValue("IDS_QM_UI_ULF_SOLVED");
    std::string names;
    for (const T_ULF_ANALYSED& a : m_analysed)
        if (!a.Agrees()) names += (names.empty() ? "" : ", ") + UlfNameAt(a.name, a.place);
    return run.End() == ULF_ITER_END::Converged && !names.empty()
               ? MMSGFunction::Format("IDS_QM_UI_ULF_DIFFERS", {names})
               : TextOf(run.End(), reason);
}

std::string CUlfIterationRunDlg::AnalysedText(std::size_t row, std::size_t column) const
{
    const T_ULF_ANALYSED& a = m_analysed.at(row);
    switch (column) {
    case 0:
        return UlfNameAt(a.name, a.place);
    case 1:
        return NumberText(a.Shown(a.forecast));
    case 2:
        return NumberText(a.Shown(a.analysed));
    case 3:
        return NumberText(a.Shown(a.analysed - a.forecast));
    default:
        return a.unit;
    }
}

std::string CUlfIterationRunDlg::ForceUnit() const
{
    return std::string(NameOf(m_doc.Data().Units().force));
}

std::string CUlfIterationRunDlg::StepText(std::size_t row, std::size_t column) const
{
    if (row >= m_history.size()) return {};
    const T_ULF_ITER_STEP& step = m_history[row];
    if (column == 0) return std::to_string(step.iteration);
    return column == 1 ? FormatText("%.6g", step.tolerance)
                       : std::filesystem::path(step.file).filename().string();
}

std::size_t CUlfIterationRunDlg::Rows() const
{
    const auto step = static_cast<std::size_t>(m_step);
    return m_step >= 0 && step < m_history.size() ? m_history[step].rows.size() : 0;
}

std::string CUlfIterationRunDlg::RowText(std::size_t row, std::size_t column) const
{
    if (row >= Rows()) return {};
    const auto step = m_history.begin() + m_step;
    if (column < CUlfIterationResultDlg::kHeads.size())
        return UlfIterCellText(step->rows[row], column);
    return FormatText("%.9g", UlfIterApplied({m_history.begin(), step + 1})[row]);
}
