// The evaluation window: modeless, one for each main window.
#pragma once

#include "desktop.h"

#include "qm_rps/evaluationdeskdlg.h"
#include "qm_ui/form/dialogwindow.h"

class QTimer;

/// Follows the document: what changes there is evaluated again while the window is open. What is
/// typed is evaluated after a short pause already, and kept when the field is left.
class CPushOverWindow : public CDialogWindow {
public:
    /// Of the desktop's main window, made if there is none yet; shown and in front.
    static CPushOverWindow& Show(T_DESKTOP& desktop);
    /// Closes it where it holds an evaluation that is not stored, which asks. False: it stays.
    static bool MayLeave(const QWidget& mainWindow);
    /// Made, not shown.
    static std::unique_ptr<CPushOverWindow> Make(T_DESKTOP& desktop, QWidget* parent);
    ~CPushOverWindow() override;

    CEvaluationDeskDlg& Model() { return m_desk; }
    void reject() override;

protected:
    void changeEvent(QEvent* event) override;

private:
    CPushOverWindow(T_DESKTOP& desktop, const T_VIEW& view, CEvaluationDeskDlg& desk,
                    QWidget* parent);
    void LookAtDocument();
    void TakeTyped();

    CEvaluationDeskDlg& m_desk; // kept with the window
    QTimer* m_typing;
};
