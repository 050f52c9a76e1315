// The iterative analysis on a document and its construction-stage item.
#pragma once

#include "qm_rps/factors/ulfanalysed.h"
#include "qm_rps/factors/ulfiterationhost.h"
#include "qm_rps/ulfcalculation.h"

class CUlfIterationDocHost : public IUlfIterationHost {
public:
    /// An item that keeps its rules. The document must outlive the host.
    CUlfIterationDocHost(CDBDoc& doc, T_ULSI_D item);

    std::string ModelPath() const override { return m_doc.Path(); }
    [[nodiscard]] int Solve(std::vector<T_ULF_ITER_ROW>& rows,
                            std::optional<T_FINDING>& said) override;
    [[nodiscard]] int SaveCopy(const std::string& path) override;
    [[nodiscard]] int StartEdit(const std::string& title) override;
    /// Reads and writes back each pretension of the loads that the row scales (LoadsScaledBy).
    [[nodiscard]] int ScalePretension(std::size_t unknown, double factor) override;
    [[nodiscard]] int CloseEdit() override;
    void CancelEdit() override;
    /// Undoes the edit if it changed a load, and puts the results before the analysis back.
    void UndoEdit() override;
    /// The construction stages, in the document's worker.
    [[nodiscard]] int StartAnalysis() override;
    bool IsExcuted() override { return m_doc.IsExcuted(); }
    void CancelAnalysis() override { m_doc.CancelAnalysis(); }
    /// When the analysis has ended the model is saved, so that its file has the loads of the
    /// results, and the results.
    void Wait() override;
    /// Also false when the latest analysis failed or its results were not saved.
    bool IsPostMode() override { return m_isAnalysed && m_doc.IsPostMode(); }

    /// Whether the latest save was refused: a full disk is not a failure of the analysis.
    bool IsSaveRefused() const { return m_isSaveRefused; }
    /// Why the latest operation was refused, in words.
    const std::string& Error() const { return m_error; }
    /// Of the latest solution.
    const std::optional<T_ULF_RESULT>& Result() const { return m_result; }
    /// The constraints of the latest solution in the structure that it was solved from, see
    /// CompareWithAnalysis; empty before a solution, or where they can't be read.
    std::vector<T_ULF_ANALYSED> Analysed(double tolerance);
    /// Every element whose pretension is scaled, since this host began.
    std::vector<T_ULF_STAY> Stays();

private:
    std::vector<T_ULF_ITER_ROW> RowsOf(const T_ULF_RUN& run) const;
    [[nodiscard]] int ScaleLoad(int loadCase, double factor);
    int Refuse(const std::string& text);
    [[nodiscard]] int EndAnalysis();

    CDBDoc& m_doc;
    T_ULSI_D m_item;
    std::vector<std::size_t> m_unknowns; // rows of the item, of the latest problem
    ULF_PRETENSION m_start;              // before the first iteration
    std::optional<T_ULF_RUN> m_run;      // of the latest solution
    std::optional<T_ULF_RESULT> m_result;
    std::string m_error;
    bool m_isSaveRefused = false;
    bool m_isScaled = false;                 // the latest edit has changed a load
    bool m_isAnalysed = true;                // the latest analysis has its results, in the file too
    std::shared_ptr<IStagedResult> m_before; // results before the latest edit
};
