// The window of a dialog model: its form in a scroll area, and the buttons.
#pragma once

#include "qm_ui/form/dialogview.h"

#include <QDialog>

class QDialogButtonBox;
class QScrollArea;

/// The property of a window that was given its place before it came up.
inline constexpr const char* kPlacedProperty = "placed";

/// Accepting gives what was typed to the model and asks its OnOK; where that refuses, the window
/// stays open with the first marked field in focus. A screen that is too small scrolls the form.
class CDialogWindow : public QDialog {
public:
    /// The model must outlive the window, which is its view as long as it lives.
    CDialogWindow(const CViewFactory& factory, const T_VIEW& view, zql::frx::MDialog& model,
                  QWidget* parent);
    ~CDialogWindow() override;

    CFormView& Form() { return *m_form; }
    const zql::frx::MDialog& Model() const { return m_model; }
    void accept() override;
    void reject() override;

protected:
    void changeEvent(QEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void ShowTexts();
    bool MayDrop();
    QSize WantedSize() const;
    void PutBeside();

    T_VIEW m_view;
    zql::frx::MDialog& m_model;
    zql::frx::IDialogView* m_before; // the model's view until then
    CDialogView m_dialogView;
    CFormView* m_form;
    QScrollArea* m_scroll;
    QDialogButtonBox* m_buttons;
};
