// Model of the window that pushes load cases: which ones, the curves as they grow, how each ended.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/push/pushrun.h"

#include <set>

class CPushWorker;
struct T_PUSH_TASK;

class CPushOverRunDlg : public zql::frx::MDialog {
public:
    static constexpr std::array<const char*, 2> kCaseHeads{"IDS_QM_UI_PUSH_RUN_CASE",
                                                           "IDS_QM_UI_PUSH_RUN_RESULTS"};
    static constexpr std::array<const char*, 6> kRowHeads{
        "IDS_QM_UI_PUSH_RUN_RESULT",       "IDS_QM_UI_PUSH_RUN_OUTCOME",
        "IDS_QM_UI_PUSH_RUN_STEPS",        "IDS_QM_UI_PUSH_RUN_FACTOR",
        "IDS_QM_UI_PUSH_RUN_DISPLACEMENT", "IDS_QM_UI_PUSH_RUN_REACTION"};

    /// A curve as far as it has come, in SI, from the state before the first step on.
    struct T_CURVE {
        std::string name;
        std::size_t done = 0, total = 0; // steps
        std::vector<double> displacement, baseReaction;
    };
    /// What has come of a load case, or of a direction of it.
    struct T_ROW {
        int key = 0;                       // of the load case
        std::string name, outcome, advice; // advice: also why it could not be pushed
        bool reached = false;              // the target, or a stop that was asked for
        std::size_t steps = 0;
        std::size_t direction = 0;
        double loadFactor = 0.0, displacement = 0.0, largestReaction = 0.0; // SI
    };

    /// All load cases that can be pushed are chosen; those without control data are not listed.
    explicit CPushOverRunDlg(CDBDoc& doc);
    bool m_atOnce = false; // its window pushes as it comes up, and shows the hinges in the end

    ~CPushOverRunDlg() override;

    std::size_t Cases() const { return m_cases.size(); }
    std::string CaseText(std::size_t row, std::size_t column) const;
    bool IsChosen(std::size_t row) const { return m_chosen.contains(m_cases.at(row)); }
    void OnChoose(std::size_t row, bool chosen);

    /// Pushes the chosen load cases in a thread of their own and calls m_changed with each news;
    /// in the end the results are those of the document. Load cases that ask for steps at what
    /// their evaluations find are then pushed again with these. Load cases with steps of another
    /// solver are pushed only if the person says so. 1 each came to an end, good or not; 0 nothing
    /// is chosen, or a load case was not pushed (its row says why).
    [[nodiscard]] int OnRun();
    bool CanRun() const { return !m_running && !m_chosen.empty(); }
    bool IsRunning() const { return m_running; }
    void OnPause() { m_paused = m_running && !m_paused; }
    bool IsPaused() const { return m_paused; }
    /// The load case at hand ends with its next step; its steps are kept, those of others too.
    void OnCancelRun() { m_cancel = true; }
    /// May the window close? While it runs, it is cancelled instead, and the answer is no.
    bool OnClose();
    std::function<void()> m_changed;

    std::string StatusText() const;
    const std::vector<T_CURVE>& Curves() const { return m_curves; }
    /// The results of the run with their events, once it has ended.
    const std::vector<T_PUSH_RUN>& Runs() const { return m_runs; }
    const std::vector<T_ROW>& Rows() const { return m_rows; }
    std::string RowText(std::size_t row, std::size_t column) const;
    std::size_t Direction() const; // of the chosen load cases' first: what the axes are titled by
    T_UNITS Units() const { return m_doc.Data().Units(); }
    CDBDoc& Doc() { return m_doc; }

private:
    [[nodiscard]] int Push(const std::vector<T_PUSH_TASK>& tasks);
    std::vector<T_PUSH_TASK> FirstTasks();
    std::vector<T_PUSH_TASK> FurtherTasks() const;
    void Watch(CPushWorker& worker);
    void TakeStep(const T_PUSH_PROGRESS& step);
    [[nodiscard]] int TakeResults(CPushWorker& worker);
    void AddRow(const T_PUSH_RUN& run);
    void AddNotPushed(int key, const std::string& why);

    CDBDoc& m_doc;
    std::vector<int> m_cases; // keys
    std::set<int> m_chosen;
    bool m_running = false, m_paused = false, m_cancel = false;
    std::vector<T_CURVE> m_curves;
    std::vector<T_PUSH_RUN> m_runs;
    std::vector<T_ROW> m_rows;
};
