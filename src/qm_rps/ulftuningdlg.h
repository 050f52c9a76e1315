// Model of the window in which the load factors of stays are tuned by hand: what deck and stays do
// follows each factor by superposition, and an item of construction stages is iterated from here.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/factors/tuning/ulfdeck.h"
#include "qm_rps/ulfitemdialog.h"
#include "qm_rps/ulfiterationrundlg.h"

class CUlfTuningDlg : public zql::frx::MDialog {
public:
    /// Opens the first item of the model, static or of stages. The document must outlive this.
    explicit CUlfTuningDlg(CDBDoc& doc);

    // ---- the item ----
    std::vector<std::string> ItemTexts() const;
    int ItemIndex() const { return m_index; } // -1: there is none
    /// Another item, with its own factors; not while it is iterated.
    void OnSelChangeItem(int index);
    /// The item with this name. 0: there is none.
    [[nodiscard]] int OnOpen(const std::string& item);
    /// Analyses what is missing, then finds the factors again. 0: StatusText says why not.
    int OnSolve(const ULF_PROGRESS& progress);
    bool IsSolved() const { return m_result.has_value(); }

    // ---- the factors ----
    std::size_t Unknowns() const { return m_unknowns.size(); }
    const std::string& NameOf(std::size_t unknown) const;
    double Factor(std::size_t unknown) const { return m_factors.at(unknown); }
    /// Start forces of 1 N make factors of millions; far beyond, sums of forces lose their digits.
    static constexpr double kMostFactor = 1e12;
    /// 1 taken; 0 not finite, beyond kMostFactor, or there is no such unknown.
    [[nodiscard]] int OnFactor(std::size_t unknown, double factor);
    int m_chosen = 0; // the unknown that the slider moves
    /// Positions 0 to kSlider of the slider, over as much as the factor's size on either side.
    static constexpr int kSlider = 400;
    int SliderPosition() const;
    void OnSlider(int position);
    /// The factors as they were found.
    void OnReset();

    // ---- what follows from them ----
    /// stay | load case | start force | factor | final pretension | force.
    T_TEXT_TABLE StayCells() const;
    /// The unknown of a row of that table, and the first row of an unknown; -1: none.
    int UnknownOfRow(int row) const;
    int RowOfUnknown(int unknown) const;
    /// Constraint, value, bounds, unit, whether it is met.
    T_TEXT_TABLE ConstraintCells() const;
    /// Whether every constraint is met with these factors.
    bool IsMet() const;
    const T_ULF_DECK& Deck() const { return m_deck; }
    /// Along the deck: place, node or element with its position, value before and now.
    T_TEXT_TABLE DeckCells() const;
    CUlfDeckValues::T_VALUES Values() const { return m_values.At(m_factors); }
    /// As it was analysed (stages), or with the factors that were found (static).
    CUlfDeckValues::T_VALUES ValuesBefore() const;
    T_UNITS Units() const { return m_doc.Unit().Units(); }
    /// Whether forces and deck are superposed or analysed, what the run has come to, or why there
    /// is nothing.
    std::string StatusText() const;

    // ---- iteration of an item of stages ----
    bool IsStage() const { return m_index >= m_statics; }
    bool IsRunning() const { return m_run && m_run->IsRunning(); }
    /// Iterates as the window of the iteration does, and reads the analysed structure again.
    int OnIterate();
    void OnStop();
    /// May the window close? A run is stopped first.
    bool OnClose();
    std::function<void()> m_changed; // with each news of the run

private:
    /// A stay whose pretension an unknown scales, in current units; element 0: the unknown scales
    /// loads without pretension.
    struct T_STAY {
        int element = 0;
        std::string load;
        double start = 0.0;
        std::size_t unknown = 0;
    };
    void Clear();
    int Solve();
    int ReadValues();
    void ReadStays();
    T_STLD_D LoadOf(int key) const;

    CDBDoc& m_doc;
    int m_index = -1, m_statics = 0;
    std::unique_ptr<CUlfItemDialog> m_item;
    T_ULSI_D m_stageItem;
    std::optional<T_ULF_RESULT> m_result;
    std::vector<std::size_t> m_unknowns; // cases of the result
    std::vector<double> m_found, m_factors;
    T_ULF_DECK m_deck;
    std::vector<T_STAY> m_stays; // those with an element in the order of the deck's
    CUlfDeckValues m_values;
    std::unique_ptr<CUlfIterationRunDlg> m_run;
    std::string m_why; // there is nothing, or what the run has come to
};
