// How dialog models reach the person through windows: message boxes, questions, child dialogs.
#pragma once

#include "qm_ui/form/viewfactory.h"

#include <QMessageBox>
#include <QPointer>

/// Boxes and child windows stand over `parent`. Every message also goes to the message history.
class CDialogView : public zql::frx::IDialogView {
public:
    /// The factory must outlive the view.
    CDialogView(const CViewFactory& factory, QWidget* parent);

    void ShowMessage(const std::string& key, const std::string& text) override;
    bool AskYesNo(const std::string& key, const std::string& text) override;
    zql::frx::ANSWER AskYesNoCancel(const std::string& key, const std::string& text) override;
    /// Shows the model's window until it is closed; the model's own view is that window meanwhile.
    /// 0 also for a model that no view is registered for (said in a message).
    int RunModal(zql::frx::MDialog& child) override;
    /// Handles what has come in; windows are not closed by it, nor are system commands carried out.
    void DispatchEvents() override;

private:
    int Ask(const std::string& text, QMessageBox::StandardButtons buttons,
            QMessageBox::StandardButton preset);

    const CViewFactory& m_factory;
    QPointer<QWidget> m_parent;
};
