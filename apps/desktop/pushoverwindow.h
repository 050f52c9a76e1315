// The pushover curve window: modeless, one for each main window.
#pragma once

#include "desktop.h"

#include "qm_rps/pushovercurveedit.h"
#include "qm_ui/form/dialogwindow.h"

/// Follows the document: what changes there is evaluated again while the window is open.
class CPushOverWindow : public CDialogWindow {
public:
    /// Of the desktop's main window, made if there is none yet; shown and in front.
    static CPushOverWindow& Show(T_DESKTOP& desktop);
    /// Made, not shown.
    static std::unique_ptr<CPushOverWindow> Make(T_DESKTOP& desktop, QWidget* parent);

    CPushOverCurveEdit& Model() { return m_edit; }

protected:
    void changeEvent(QEvent* event) override;

private:
    CPushOverWindow(T_DESKTOP& desktop, const T_VIEW& view, CPushOverCurveEdit& edit,
                    QWidget* parent);
    void LookAtDocument();

    CPushOverCurveEdit& m_edit; // kept with the window
};
