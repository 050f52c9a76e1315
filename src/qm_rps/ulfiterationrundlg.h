// Model of the window of the iterative analysis for pretension: the item, the run with its table
// of iterations, and how it has ended.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/factors/ulfanalysed.h"
#include "qm_rps/factors/ulfiteration.h"
#include "qm_rps/ulfiterationresultdlg.h"
#include "qm_rps/unknownloadfactoriteranal.h"

/// An item of construction stages as it is to be iterated.
struct T_ULF_ITER_ITEM {
    int key = 0; // in the model; 0: it is not stored
    T_ULSI_D record;
};

class CUlfIterationRunDlg : public zql::frx::MDialog, private IUlfIterationPerson {
public:
    /// Columns of the table of iterations, and of the unknowns of the chosen one: those of the
    /// result dialog, and by what the pretension had been multiplied before it.
    static constexpr std::array<const char*, 3> kStepHeads{
        "IDS_QM_UI_ULF_ITERATION", "IDS_QM_UI_ULF_TOLERANCE", "IDS_QM_UI_ULF_MODEL_FILE"};
    static constexpr std::array<const char*, 5> kRowHeads{
        "IDS_RPS_GXGRID_Stage", "IDS_RPS_GXGRID_LCase", "IDS_RPS_GXGRID_Factor",
        "IDS_QM_ULSI_HEAD_PRETENSION", "IDS_QM_UI_ULF_APPLIED"};

    /// Columns of the constraints in the analysed structure.
    static constexpr std::array<const char*, 5> kAnalysedHeads{
        "IDS_RPS_UNKNOWN_LOAD_GXRESULT_Constraint", "IDS_QM_CLI_FORECAST", "IDS_QM_CLI_ANALYSED",
        "IDS_QM_CLI_DIFFERENCE", "IDS_QM_UI_ULF_UNIT"};

    /// On the stored items of the model, of which one is chosen (0: the first).
    explicit CUlfIterationRunDlg(CDBDoc& doc, int item = 0);
    /// On an item as it is edited.
    CUlfIterationRunDlg(CDBDoc& doc, T_ULF_ITER_ITEM item) : m_doc(doc), m_given(std::move(item)) {}

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
    /// Of the last copy, once an iteration has been made.
    const std::vector<T_ULF_ANALYSED>& Analysed() const { return m_analysed; }
    const std::vector<T_ULF_STAY>& Stays() const { return m_stays; }
    std::string AnalysedText(std::size_t row, std::size_t column) const;
    std::string ForceUnit() const;
    /// Shows the window of the latest solution's result. 0: there is none.
    [[nodiscard]] int OnShowResult();

private:
    void Solved(const T_ULF_ITER_STEP& step, const std::optional<T_FINDING>& said) override;
    ULF_ITER_WISH Wish(const T_ULF_ITER_STEP& step) override;
    bool MayOverwrite(const std::string& report) override;
    bool MayReplace(const std::string& copy) override;
    bool GoesOn(int done, int required) override;

    std::vector<int> ItemKeys() const;
    T_ULF_ITER_ITEM Item() const;
    void Clear();
    [[nodiscard]] int Start();
    std::string EndText(const CUlfIteration& run, const std::string& reason) const;
    [[nodiscard]] int Analyse();
    void Tell(std::string status);
    int Fail(const std::string& text);

    CDBDoc& m_doc;
    std::optional<T_ULF_ITER_ITEM> m_given;
    int m_item = 0; // key
    bool m_running = false, m_cancel = false;
    std::vector<T_ULF_ITER_STEP> m_history;
    std::optional<T_ULF_RESULT> m_result; // of the latest solution
    std::vector<T_ULF_ANALYSED> m_analysed;
    std::vector<T_ULF_STAY> m_stays;
    std::string m_status;
};
