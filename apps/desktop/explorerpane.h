// The model explorer: the list of tables with their counts, and the table that is chosen.
#pragma once

#include "qm_rps/desk/recordgrid.h"

#include <QWidget>

#include <functional>

class CFormView;
class CGridView;
class QListWidget;
class QPushButton;
class QSplitter;
class QVBoxLayout;

class CExplorerPane : public QWidget {
public:
    /// The document must outlive the pane.
    CExplorerPane(CDBDoc& doc, zql::frx::IDialogView& view, std::function<void()> changed,
                  QWidget* parent = nullptr);
    ~CExplorerPane() override;

    /// Counts and rows again from the document.
    void Refresh();
    void Retranslate();
    void Choose(EXPLORER_TABLE table);
    EXPLORER_TABLE Chosen() const;
    /// The table on show.
    CGridView& Table() { return *m_table; }
    CRecordGrid& Grid() { return *m_grid; }
    /// A record was opened by a double click: the caller shows its window.
    std::function<void(EXPLORER_TABLE table, int key)> m_open;

    void Add();
    void Delete();

private:
    void ShowTable();
    QString NameOf(EXPLORER_TABLE table) const;

    CDBDoc& m_doc;
    zql::frx::IDialogView& m_view;
    std::function<void()> m_changed;
    std::unique_ptr<CRecordGrid> m_grid;
    QListWidget* m_list;
    QWidget* m_right;
    QVBoxLayout* m_rightLayout;
    CGridView* m_table = nullptr;
    QPushButton *m_add, *m_delete;
};
