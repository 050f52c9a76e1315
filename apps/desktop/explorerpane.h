// The table of the records of one kind: sorted, filtered, edited, exported.
#pragma once

#include "recordtableview.h"

#include "qm_rps/desk/selection.h"

#include <QWidget>

#include <functional>

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QSpinBox;
class QVBoxLayout;

class CExplorerPane : public QWidget {
public:
    /// Document and selection must outlive the pane.
    CExplorerPane(CDBDoc& doc, CSelection& selection, zql::frx::IDialogView& view,
                  std::function<void()> changed, QWidget* parent = nullptr);
    ~CExplorerPane() override;

    /// Counts and rows again from the document.
    void Refresh();
    void Retranslate();
    void Choose(EXPLORER_TABLE table);
    EXPLORER_TABLE Chosen() const;
    /// Shows which rows are chosen; the table of another kind where nothing of this one is.
    void ShowSelection();
    /// The table on show.
    CRecordTableView& Table() { return *m_table; }
    CRecordGrid& Grid() { return *m_grid; }
    QLineEdit& Filter() { return *m_filter; }
    QSpinBox& Decimals() { return *m_decimals; }
    /// A record was opened by a double click: the caller shows its window.
    std::function<void(EXPLORER_TABLE table, int key)> m_open;
    /// Asks for the name of a file to export to; empty: cancelled.
    std::function<std::string()> m_askPath;

    void Add();
    void Delete();
    void Export();

private:
    void ShowTable();
    void TakeRows();
    QString NameOf(EXPLORER_TABLE table) const;

    CDBDoc& m_doc;
    CSelection& m_selection;
    zql::frx::IDialogView& m_view;
    std::function<void()> m_changed;
    std::unique_ptr<CRecordGrid> m_grid;
    QComboBox* m_list;
    QLineEdit* m_filter;
    QLabel* m_decimalsLabel;
    QSpinBox* m_decimals;
    QVBoxLayout* m_layout;
    CRecordTableView* m_table = nullptr;
    QPushButton *m_add, *m_delete, *m_export;
    bool m_quiet = false;
};
