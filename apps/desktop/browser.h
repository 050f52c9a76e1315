// The panes on the records of the model, bound together by the selection: tree, properties, table.
#pragma once

#include "desktop.h"
#include "explorerpane.h"
#include "modeltreepane.h"
#include "propertypane.h"

class CBrowser {
public:
    /// The panes are children of the desktop's window, which must outlive the browser.
    CBrowser(T_DESKTOP& desktop, CFrameScene& scene);
    ~CBrowser();
    CBrowser(const CBrowser&) = delete;
    CBrowser& operator=(const CBrowser&) = delete;

    CModelTreePane& Tree() { return *m_tree; }
    CPropertyPane& Properties() { return *m_properties; }
    CExplorerPane& Table() { return *m_table; }

    /// Everything again from the document.
    void Refresh();
    void Retranslate();
    /// Commands of the menu: in the tree where the keyboard is there, else in the table.
    void Add();
    void Delete();

    std::function<void(const T_SHAPE_SOURCE& source)> m_showResult;

private:
    void Choose(RECORD_KIND kind, int key);
    void ShowSelection();
    void Open(EXPLORER_TABLE table, int key);

    T_DESKTOP& m_desktop;
    CModelTreePane* m_tree;
    CPropertyPane* m_properties;
    CExplorerPane* m_table;
};
