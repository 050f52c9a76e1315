// The tree of the model with its filter: records are made, copied, deleted, renamed and opened
// from it.
#pragma once

#include "qm_rps/desk/modeltree.h"
#include "qm_rps/desk/selection.h"

#include <QTreeWidget>

#include <functional>
#include <set>

class QLabel;
class QLineEdit;
class QPushButton;

class CModelTreePane : public QWidget {
public:
    /// What they are given must outlive the pane.
    CModelTreePane(CDBDoc& doc, CFrameScene& scene, CSelection& selection,
                   QWidget* parent = nullptr);

    /// Nodes again from the document; what was open stays open.
    void Refresh();
    void Retranslate();
    /// The record is chosen in the tree, its place unfolded.
    void Show(RECORD_KIND kind, int key);

    // Told by the tree.
    std::function<void(RECORD_KIND kind)> m_showTable;
    std::function<void(RECORD_KIND kind, int key)> m_choose; // a record
    std::function<void(EXPLORER_TABLE table, int key)> m_open;
    std::function<void(const T_SHAPE_SOURCE& source)> m_showResult;
    std::function<void()> m_changed;
    std::function<void(const std::string& text)> m_refused;

    // Commands on the current node.
    void Add();
    void Duplicate();
    void Delete();
    void Rename();
    void Open();
    void ShowOnly();
    void Hide();

    QTreeWidget& Tree() { return *m_tree; }
    QLineEdit& Filter() { return *m_filter; }

protected:
    bool eventFilter(QObject* object, QEvent* event) override;

private:
    const T_TREE_NODE* Current() const;
    const T_TREE_NODE* NodeOf(const QTreeWidgetItem* item) const;
    void Fill(QTreeWidgetItem* item);
    QTreeWidgetItem* MakeItem(const T_TREE_NODE& node);
    QTreeWidgetItem* FindItem(const std::vector<std::string>& path);
    void TakeCurrent();
    void TakeName(QTreeWidgetItem* item);
    void ShowMenu(const QPoint& at);
    CSelection::T_KEYS ElementsOfCurrent() const;
    void Finish(int done, const std::string& reason);

    CDBDoc& m_doc;
    CModelTree m_model;
    CSelection& m_selection;
    QTreeWidget* m_tree;
    QLineEdit* m_filter;
    QPushButton *m_add, *m_delete;
    std::vector<T_TREE_NODE> m_nodes; // by the index that an item keeps
    std::set<std::string> m_unfolded;
    bool m_quiet = false;
};
