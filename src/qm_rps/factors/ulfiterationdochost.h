// The iterative analysis on a document and its construction-stage item.
#pragma once

#include "qm_rps/unknownstageitemdlg.h"

class CUlfIterationDocHost : public IUlfIterationHost {
public:
    /// Document and dialog must outlive the host; refusals are shown by the dialog.
    CUlfIterationDocHost(CDBDoc& doc, CUnknownStageItemDlg& dialog, zql::frx::IDialogView* view)
        : m_doc(doc), m_dialog(dialog), m_view(view)
    {
    }

    std::string ModelPath() const override { return m_doc.Path(); }
    [[nodiscard]] int Solve(std::vector<T_ULF_ITER_ROW>& rows) override;
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
    /// Those of the view; waits for the analysis a little. When it has ended the model is saved, so
    /// that its file has the loads of the results, and the results.
    void DispatchEvents() override;
    /// Also false when the latest analysis failed or its results were not saved.
    bool IsPostMode() override { return m_isAnalysed && m_doc.IsPostMode(); }

    /// Why the latest operation was refused, in words.
    const std::string& Error() const { return m_error; }

private:
    [[nodiscard]] int ScaleLoad(int loadCase, double factor);
    int Refuse(const std::string& text);
    [[nodiscard]] int EndAnalysis();

    CDBDoc& m_doc;
    CUnknownStageItemDlg& m_dialog;
    zql::frx::IDialogView* m_view;
    std::string m_error;
    bool m_isScaled = false;                 // the latest edit has changed a load
    bool m_isAnalysed = true;                // the latest analysis has its results, in the file too
    std::shared_ptr<IStagedResult> m_before; // results before the latest edit
};
