// The properties of what is chosen, edited in place.
#pragma once

#include "qm_rps/desk/propertymodel.h"

#include <QWidget>

#include <functional>
#include <set>

class QLabel;
class QPushButton;
class QTreeWidget;
class QTreeWidgetItem;

class CPropertyPane : public QWidget {
public:
    /// The document must outlive the pane.
    CPropertyPane(CDBDoc& doc, QWidget* parent = nullptr);

    CPropertyModel& Model() { return m_model; }
    QTreeWidget& Tree() { return *m_tree; }
    /// Rows again from the model.
    void Refresh();
    void Retranslate();

    std::function<void()> m_changed;
    std::function<void(EXPLORER_TABLE table, int key)> m_open;

    // What the buttons do with the current row.
    void Add();
    void Remove();

private:
    void Fill();
    void MakeRow(QTreeWidgetItem* item, std::size_t row);
    std::size_t RowOf(const QTreeWidgetItem* item) const;
    void TakeText(QTreeWidgetItem* item);
    void Finish(int done);
    void UpdateButtons();

    CPropertyModel m_model;
    QLabel *m_title, *m_reason;
    QTreeWidget* m_tree;
    QPushButton *m_add, *m_remove, *m_window;
    std::set<std::string> m_unfolded; // paths
    bool m_quiet = false;
};
