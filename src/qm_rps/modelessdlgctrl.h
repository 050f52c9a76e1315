// The modeless dialogs of a document: at most one for each id.
#pragma once

#include "qm_base/dynmodule.h"
#include "qm_rps/rpsdlgbase.h"

#include <map>

/// State: the open dialogs, which it owns, and how the host shows dialogs of this document. Lives
/// in the document's module registry under kName.
class CModelessDlgCtrl : public CDynModule {
public:
    ~CModelessDlgCtrl() override { CloseAll(); }

    /// In the module registry.
    static constexpr const char* kName = "CModelessDlgCtrl";
    /// The document's controller, made when it is first asked for.
    static CModelessDlgCtrl& Of(CDBDoc& doc);

    /// Installed by the host: how windows of modeless dialogs are made, and where modal ones that
    /// have no window of their own to stand over are shown. The view must outlive the document or
    /// be reset to null.
    void SetWindowMaker(CRPSDlgBase::WINDOW_MAKER maker) { m_maker = std::move(maker); }
    /// Empty: none was installed.
    const CRPSDlgBase::WINDOW_MAKER& WindowMaker() const { return m_maker; }
    void SetView(zql::frx::IDialogView* view) { m_view = view; }
    zql::frx::IDialogView* View() const { return m_view; }

    /// The open dialog of that id, or null.
    CRPSDlgBase* Find(int id) const;
    /// Takes a dialog over, in place of the one of that id.
    CRPSDlgBase& Add(int id, std::unique_ptr<CRPSDlgBase> dialog);
    /// Ends a dialog and its window, as the host does when the person closes it.
    void Close(int id);
    /// Likewise all of them.
    void CloseAll();

private:
    CRPSDlgBase::WINDOW_MAKER m_maker;
    zql::frx::IDialogView* m_view = nullptr;
    std::map<int, std::unique_ptr<CRPSDlgBase>> m_dialogs;
};
