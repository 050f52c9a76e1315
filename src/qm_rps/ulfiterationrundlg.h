// Model of the window of the iterative analysis for pretension: the item, the run with its table
// of iterations, and how it has ended.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/factors/ulfstageresults.h"
#include "qm_rps/ulfiterationresultdlg.h"
#include "qm_rps/unknownloadfactoriteranal.h"
#include "qm_rps/unknownstageitemdlg.h"

#include <memory>

class CUlfIterationRunDlg : public zql::frx::MDialog {
public:
    /// Columns of the table of iterations, and of the unknowns of the chosen one: those of the
    /// result dialog, and by what the pretension had been multiplied before it.
    static constexpr std::array<const char*, 3> kStepHeads{
        "IDS_QM_UI_ULF_ITERATION", "IDS_QM_UI_ULF_TOLERANCE", "IDS_QM_UI_ULF_MODEL_FILE"};
    static constexpr std::array<const char*, 5> kRowHeads{
        "IDS_RPS_GXGRID_Stage", "IDS_RPS_GXGRID_LCase", "IDS_RPS_GXGRID_Factor",
        "IDS_QM_ULSI_HEAD_PRETENSION", "IDS_QM_UI_ULF_APPLIED"};

    /// On the stored items of the model, of which one is chosen (0: the first).
    explicit CUlfIterationRunDlg(CDBDoc& doc, int item = 0);
    /// On an item as it is edited in its dialog, which must outlive this one.
    CUlfIterationRunDlg(CDBDoc& doc, CUnknownStageItemDlg& item);

    /// Names of the items that can be chosen; only the edited one, where it is given.
    std::vector<std::string> ItemTexts() const;
    int ItemIndex() const; // -1: there is none
    /// Another item: the table of the run before is emptied. Not while it runs.
    void OnSelChangeItem(int index);

    /// The settings of the document, and their dialog. 1 changed.
    T_ULF_ITER_SETTINGS Settings() const;
    [[nodiscard]] int OnSettings();

    /// The run: analyses the stages where they have no current results, then iterates. Calls
    /// m_changed with each news. 1 see CUlfIteration::Run; 0 refused with a message, cancelled or
    /// failed; StatusText has it in words.
    [[nodiscard]] int OnRun();
    bool IsRunning() const { return m_running; }
    /// Asks the run to end; the iteration at hand is taken back.
    void OnCancelRun() { m_cancel = true; }
    /// May the window close? While it runs, it is cancelled instead, and the answer is no.
    bool OnClose();
    std::function<void()> m_changed;

    std::string StatusText() const;
    const std::vector<T_ULF_ITER_STEP>& History() const { return m_history; }
    std::string StepText(std::size_t row, std::size_t column) const;
    int m_step = -1; // chosen row of the table of iterations; the last one comes with each solution
    std::size_t Rows() const; // of the chosen iteration
    std::string RowText(std::size_t row, std::size_t column) const;
    /// Shows the window of the latest solution's result. 0: there is none.
    [[nodiscard]] int OnShowResult();
    std::string ReportPath() const { return m_report; }

private:
    std::vector<int> ItemKeys() const;
    void Clear();
    [[nodiscard]] int Start();
    [[nodiscard]] int Analyse();
    void Tell(std::string status);
    int Fail(const std::string& text);

    CDBDoc& m_doc;
    CUlfStageResults m_results{m_doc};
    CUnknownStageItemDlg* m_given = nullptr;
    int m_item = 0; // key
    bool m_running = false, m_cancel = false;
    std::vector<T_ULF_ITER_STEP> m_history;
    std::optional<T_ULF_RESULT> m_result; // of the latest solution
    std::string m_status, m_report;
};
