// Base of the dialogs that are opened on a document, modal or not.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/editscope.h"

#include <functional>
#include <memory>

/// The window of a modeless dialog. Its end takes it off the screen.
class IRPSWindow {
public:
    IRPSWindow() = default;
    IRPSWindow(const IRPSWindow&) = delete;
    IRPSWindow& operator=(const IRPSWindow&) = delete;
    virtual ~IRPSWindow() = default;
    /// On the screen, in front.
    virtual void Show() = 0;
    /// Reads everything again from the model.
    virtual void Refresh() = 0;
};

/// State: the document that it works on, and its window where it is modeless.
class CRPSDlgBase : public CCheckedDialog {
public:
    /// Makes the window of a modeless dialog, over the parent; null: it can't be made.
    using WINDOW_MAKER = std::function<std::unique_ptr<IRPSWindow>(CRPSDlgBase& dialog, int id,
                                                                   zql::frx::IDialogView* parent)>;

    /// The document must outlive the dialog.
    virtual void SetDoc(CDBDoc* doc) { m_doc = doc; }
    /// Null before SetDoc.
    CDBDoc* Doc() const { return m_doc; }

    /// Makes the window. 1 done; 0 it has one, no maker, or the maker made none.
    [[nodiscard]] int Create(const WINDOW_MAKER& maker, int id, zql::frx::IDialogView* parent);
    /// Brings the window to the front; nothing without one.
    void ShowWindow();
    /// The window reads everything again; nothing without one.
    void RefreshWindow();
    /// Before the dialog goes: its window reads it to the last.
    void DestroyWindow() { m_window.reset(); }

    std::vector<T_FINDING> Findings() const override { return {}; }

protected:
    /// Runs a change of the document as one edit that can be undone, whole or not at all. 0 also
    /// where another edit is open, with a message.
    int Edit(const char* titleKey, const std::function<bool(CEditScope&)>& change);

private:
    CDBDoc* m_doc = nullptr;
    std::unique_ptr<IRPSWindow> m_window;
};
