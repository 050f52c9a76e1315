#include "qm_rps/pushoverrundlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/push/pushquantity.h"
#include "qm_rps/push/pushresultlist.h"
#include "qm_rps/push/pushwarnings.h"
#include "qm_rps/push/pushworker.h"

#include <algorithm>
#include <cmath>

namespace {

/// While it lives, no edit changes the document, and the flag is set.
class CRunning {
public:
    CRunning(CDataCtrl& data, bool& flag) : m_data(data), m_flag(flag) { Set(true); }
    ~CRunning() { Set(false); }
    CRunning(const CRunning&) = delete;
    CRunning& operator=(const CRunning&) = delete;

private:
    void Set(bool on)
    {
        m_data.SetLocked(on);
        m_flag = on;
    }
    CDataCtrl& m_data;
    bool& m_flag;
};

} // namespace

CPushOverRunDlg::CPushOverRunDlg(CDBDoc& doc) : m_doc(doc)
{
    for (const auto& [key, record] : doc.Data().Model().pushovers) {
        if (!record.control) continue;
        m_cases.push_back(key);
        m_chosen.insert(key);
    }
}

CPushOverRunDlg::~CPushOverRunDlg() = default;

std::string CPushOverRunDlg::CaseText(std::size_t row, std::size_t column) const
{
    const int key = m_cases.at(row);
    const auto record = m_doc.Data().Model().pushovers.find(key);
    if (record == m_doc.Data().Model().pushovers.end()) return {};
    if (column == 0) return record->second.name;
    if (HasImportedSteps(m_doc, key)) return Say("IDS_QM_UI_PUSH_RUN_IMPORTED");
    const std::vector<T_PUSH_RESULT_ID> results = PushResultsOf(m_doc);
    const auto own = std::ranges::find(results, key, &T_PUSH_RESULT_ID::key);
    if (own == results.end()) return Say("IDS_QM_UI_PUSH_RUN_NONE");
    std::string why;
    return Say(m_doc.Post().IsStale(key, why, own->turn) ? "IDS_QM_UI_PUSH_RUN_OLD"
                                                         : "IDS_QM_UI_PUSH_RUN_CURRENT");
}

void CPushOverRunDlg::OnChoose(std::size_t row, bool chosen)
{
    if (m_running) return;
    if (chosen)
        m_chosen.insert(m_cases.at(row));
    else
        m_chosen.erase(m_cases.at(row));
}

std::size_t CPushOverRunDlg::Direction() const
{
    const auto& records = m_doc.Data().Model().pushovers;
    const auto record = m_chosen.empty() ? records.end() : records.find(*m_chosen.begin());
    return record == records.end() ? 0 : static_cast<std::size_t>(record->second.direction - 1);
}

bool CPushOverRunDlg::OnClose()
{
    if (m_running) OnCancelRun();
    return !m_running;
}

int CPushOverRunDlg::OnRun()
{
    if (!CanRun()) return 0;
    m_cancel = m_paused = false;
    m_curves.clear();
    m_runs.clear();
    m_rows.clear();
    std::vector<T_PUSH_TASK> tasks = FirstTasks();
    int done = m_rows.empty() ? 1 : 0;
    if (!tasks.empty()) done = Push(tasks) && done ? 1 : 0;
    tasks = FurtherTasks();
    if (!tasks.empty() && !m_cancel) done = Push(tasks) && done ? 1 : 0;
    if (m_changed) m_changed();
    return done;
}

int CPushOverRunDlg::Push(const std::vector<T_PUSH_TASK>& tasks)
{
    int done = 0;
    {
        const CRunning running(m_doc.Data(), m_running);
        CPushWorker worker(m_doc, tasks);
        Watch(worker);
        done = TakeResults(worker);
        m_paused = false;
    }
    CPushRun(m_doc).Keep(m_runs);
    return done;
}

std::vector<T_PUSH_TASK> CPushOverRunDlg::FirstTasks()
{
    std::string names;
    for (const int key : m_chosen)
        if (HasImportedSteps(m_doc, key))
            names += (names.empty() ? "" : ", ") + m_doc.Data().Model().pushovers.at(key).name;
    constexpr const char* kAsk = "IDS_QM_UI_PUSH_RUN_REPLACE";
    const bool keep = !names.empty() && !AskYesNo(kAsk, Say(kAsk, names));
    std::vector<T_PUSH_TASK> tasks;
    for (const int key : m_chosen) {
        if (keep && HasImportedSteps(m_doc, key))
            AddNotPushed(key, Say("IDS_QM_UI_PUSH_RUN_KEPT"));
        else
            tasks.push_back({key});
    }
    return tasks;
}

std::vector<T_PUSH_TASK> CPushOverRunDlg::FurtherTasks() const
{
    std::vector<T_PUSH_TASK> tasks;
    for (auto from = m_runs.begin(); from != m_runs.end();) { // those of a load case together
        const auto to = std::find_if(from, m_runs.end(),
                                     [&](const T_PUSH_RUN& run) { return run.key != from->key; });
        T_PUSH_TASK task{from->key, StepsOfEvaluations(m_doc, {from, to})};
        if (!task.extra.empty()) tasks.push_back(std::move(task));
        from = to;
    }
    return tasks;
}

void CPushOverRunDlg::TakeStep(const T_PUSH_PROGRESS& step)
{
    if (step.done == 1)
        std::erase_if(m_curves, [&](const T_CURVE& c) { return c.name == step.name; });
    if (m_curves.empty() || m_curves.back().name != step.name)
        m_curves.push_back({step.name, 0, 0, {step.startDisplacement}, {step.startReaction}});
    T_CURVE& curve = m_curves.back();
    curve.done = step.done;
    curve.total = step.total;
    curve.displacement.push_back(step.displacement);
    curve.baseReaction.push_back(step.baseReaction);
}

void CPushOverRunDlg::Watch(CPushWorker& worker)
{
    constexpr int kWaitMs = 20; // short enough for a window
    std::vector<T_PUSH_PROGRESS> steps;
    bool ended = false;
    if (m_changed) m_changed();
    while (!ended) {
        steps.clear();
        ended = worker.TakeSteps(kWaitMs, steps);
        for (const T_PUSH_PROGRESS& step : steps)
            TakeStep(step);
        if (m_changed && !steps.empty()) m_changed();
        if (View()) View()->DispatchEvents();
        worker.Pause(m_paused);
        if (m_cancel) worker.Cancel();
    }
}

int CPushOverRunDlg::TakeResults(CPushWorker& worker)
{
    int done = 1;
    for (T_PUSH_DONE& one : worker.Finish()) {
        if (!one.runs.empty()) { // in place of those of a first round
            std::erase_if(m_rows, [&](const T_ROW& row) { return row.key == one.key; });
            std::erase_if(m_runs, [&](const T_PUSH_RUN& run) { return run.key == one.key; });
        }
        for (T_PUSH_RUN& run : one.runs) {
            AddRow(run);
            m_runs.push_back(std::move(run));
        }
        if (one.error.empty()) continue;
        done = 0;
        AddNotPushed(one.key, one.error);
    }
    return done;
}

void CPushOverRunDlg::AddNotPushed(int key, const std::string& why)
{
    T_ROW& row = m_rows.emplace_back();
    row.key = key;
    row.name = m_doc.Data().Model().pushovers.at(key).name;
    row.outcome = Say("IDS_QM_UI_PUSH_RUN_REFUSED");
    row.advice = why;
}

void CPushOverRunDlg::AddRow(const T_PUSH_RUN& run)
{
    const std::string outcome =
        run.cancelled ? Say("IDS_QM_UI_PUSH_RUN_CANCELLED") : PushStatusText(run.status);
    T_ROW row{run.key,
              run.name,
              outcome,
              run.advice,
              run.status != PUSH_STATUS::Failed,
              run.loadFactor.size(),
              run.direction};
    for (const std::string& warning : run.warnings)
        row.advice += " " + warning;
    if (row.steps > 0) {
        row.loadFactor = run.loadFactor.back();
        row.displacement = run.displacement.back();
        row.largestReaction =
            *std::ranges::max_element(run.baseReaction, {}, [](double v) { return std::fabs(v); });
    }
    m_rows.push_back(std::move(row));
}

std::string CPushOverRunDlg::RowText(std::size_t row, std::size_t column) const
{
    const T_ROW& r = m_rows.at(row);
    const auto number = [&](double si, const T_PUSH_QUANTITY& q) {
        return FormatText("%.6g", q.Shown(si));
    };
    if (column == 0) return r.name;
    if (column == 1) return r.outcome;
    if (r.steps == 0) return column == 2 ? "0" : "";
    if (column == 2) return std::to_string(r.steps);
    if (column == 3) return FormatText("%.6g", r.loadFactor);
    return column == 4 ? number(r.displacement, DisplacementIn(r.direction, Units()))
                       : number(r.largestReaction, ReactionIn(r.direction, Units()));
}

std::string CPushOverRunDlg::StatusText() const
{
    if (m_running && m_curves.empty()) return Say("IDS_QM_UI_PUSH_RUN_PREPARES");
    if (m_running) {
        const T_CURVE& c = m_curves.back();
        const T_PUSH_QUANTITY q = DisplacementIn(Direction(), Units());
        return Say(m_paused ? "IDS_QM_UI_PUSH_RUN_PAUSED" : "IDS_QM_UI_PUSH_RUN_AT", c.name,
                   std::to_string(c.done), std::to_string(c.total),
                   FormatText("%.4g", q.Shown(c.displacement.back())) + " " + q.Unit());
    }
    std::string text;
    for (const T_ROW& row : m_rows)
        text += (text.empty() ? "" : "\n") + row.name + ": " + row.advice;
    if (!text.empty()) return text;
    if (m_cases.empty()) return Say("IDS_QM_CLI_PUSH_NO_CASE");
    text = Say("IDS_QM_UI_PUSH_RUN_READY");
    for (const std::string& warning : PushWarnings(m_doc))
        text += "\n" + warning;
    return text;
}
