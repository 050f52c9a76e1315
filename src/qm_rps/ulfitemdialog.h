// What the dialogs of unknown load factor items have in common, static ones and those of
// construction stages: name, objective, sign, constraints, and what a calculation leaves.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_rps/factors/ulfanalysis.h"
#include "qm_rps/factors/ulfexplain.h"

class CUlfItemDialog : public CCheckedDialog {
public:
    /// Texts of the choices, by index.
    static constexpr std::array<const char*, 3> kObjectiveKeys{
        "IDS_QM_ULF_LINEAR", "IDS_QM_ULF_SQUARE", "IDS_QM_ULF_MIN_MAX"};
    static constexpr std::array<const char*, 3> kSignKeys{"IDS_QM_ULF_NEGATIVE", "IDS_QM_ULF_FREE",
                                                          "IDS_QM_ULF_POSITIVE"};

    struct T_CHECK {
        std::string name; // of a constraint of the model
        bool checked = false;
        int times = 1; // that the item names it; another choice of the person makes it 1
        bool operator==(const T_CHECK&) const = default;
    };

    /// The document must outlive the dialog.
    explicit CUlfItemDialog(CDBDoc& doc) : m_doc(doc) {}

    std::string m_name;
    int m_objective = 0; // index of kObjectiveKeys
    int m_sign = 1;      // index of kSignKeys
    bool m_solveByEquations = false;
    std::vector<T_CHECK> m_checks; // all constraints of the model
    /// The constraint of a check in words, with its place.
    std::string CheckText(std::size_t check) const;

    /// Analyses what the calculation reads and the document has no current results of; an item
    /// with findings is left to its calculation, which refuses it. 1 done; 0 cancelled, or `error`
    /// says why not.
    [[nodiscard]] int OnAnalyse(const ULF_PROGRESS& progress, std::string& error);

    /// Checks and calculates without a word to the person. A refused check is what it has said.
    const T_ULF_CALCULATION& Calculate();
    /// The same, then shows what it has said. 1: Result() has the factors; 0: it has none.
    [[nodiscard]] int OnCalculate();
    /// Calculates and shows the window of the result. 1 solved.
    [[nodiscard]] int OnSolve();
    /// Calculates and explains the outcome; progress as of ExplainUlf. 1 ShowExplanation can show
    /// it; 0 the calculation was refused before it had anything to explain, with its message.
    [[nodiscard]] int OnExplain(const std::function<bool(int, int)>& progress);
    /// Shows the window of the latest explanation, or the message of the refused calculation.
    void ShowExplanation();
    /// The latest calculation, and its result.
    const T_ULF_CALCULATION& Calculation() const { return m_calculation; }
    const std::optional<T_ULF_RESULT>& Result() const { return m_calculation.result; }

    bool m_dump = false; // debug: write the problem handed to the solver beside the model file

    /// What a calculation does not refuse and a person should know; of no static item.
    virtual std::vector<T_FINDING> Warnings() const { return {}; }

protected:
    CDBDoc& m_doc;

    /// The calculation of an item that keeps its rules.
    virtual T_ULF_CALCULATION Calculated() = 0;
    /// What to analyse for a calculation; empty: the document has current results of it all.
    virtual std::optional<T_ANALYSIS_OPTIONS> MissingResults() const = 0;

    /// The dump of a calculation; a file that is there is overwritten or extended as the person
    /// says.
    T_OPT_DUMP Dump();

    /// Flags of the grids: "1" and "0".
    static std::string Flag(bool on) { return on ? "1" : "0"; }

    /// The constraints of the model in its order, or those of the item before the others, with
    /// these names checked.
    void SetChecks(const std::vector<std::string>& names, bool itemsFirst);
    /// Names that are checked, then those that the model lacks.
    std::vector<std::string> CheckedNames() const;

private:
    std::vector<std::string> m_missing; // constraints that the item names and the model lacks
    T_ULF_CALCULATION m_calculation;
    std::optional<T_ULF_EXPLAINED> m_explained; // of it
};
