// The fields of the evaluation window that no other window has.
#pragma once

#include "qm_rps/evaluationdeskdlg.h"
#include "qm_ui/form/formview.h"

class CPlotWidget;

/// The list of evaluations: a tick for the overlay, the verdict as a coloured word, name, method,
/// spectrum and result. Its widget is a QListWidget.
std::unique_ptr<CFormField> MakeEvaluationList(CEvaluationDeskDlg& desk, ChangedFn changed,
                                               QWidget* parent);

/// Verdict and figures of the chosen evaluation; without an answer the reason.
std::unique_ptr<CFormField> MakeCards(CEvaluationDeskDlg& desk, QWidget* parent);

/// The plot with the frame at the point beside it, and the buttons over it.
class CDeskPane : public CFormField {
public:
    CDeskPane(CEvaluationDeskDlg& desk, ChangedFn changed, QWidget* parent);
    ~CDeskPane() override;
    void Show() override;
    void Retranslate() override;

    CPlotWidget& Plot();
    /// The picture as it is seen, with the part that the person has zoomed to.
    T_PLOT AsSeen();
    /// Puts it on the clipboard, as pixels or as SVG.
    void CopyPicture();
    void CopyVector();
    /// Asks for a file, or for a printer.
    void SavePicture();
    void Print();

private:
    struct T_PARTS;
    void ShowFrame();

    CEvaluationDeskDlg& m_desk;
    std::unique_ptr<T_PARTS> m_parts;
};

/// What a table of a window shows, numbers with '.'.
T_TEXT_TABLE TableOnShow(const T_GRID_BINDING& grid);
