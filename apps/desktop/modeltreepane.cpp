#include "modeltreepane.h"

#include "shell/icons.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordform.h"

#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QVBoxLayout>

#include <algorithm>

namespace {

using W = T_TREE_NODE::WHAT;
constexpr int kIndexRole = Qt::UserRole;

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

struct T_KIND_ICON {
    RECORD_KIND kind;
    const char* icon;
};
constexpr T_KIND_ICON kIcons[] = {
    {kModelOptionsKind, "settings"},    {KindOf<T_NODE_D>(), "node"},
    {KindOf<T_ELEM_D>(), "element"},    {KindOf<T_SECT_D>(), "section"},
    {KindOf<T_MATL_D>(), "material"},   {KindOf<T_STOR_D>(), "storeys"},
    {KindOf<T_EIGV_D>(), "mode"},       {KindOf<T_STLD_D>(), "load-case"},
    {KindOf<T_LCOM_D>(), "load"},       {KindOf<T_PHGT_D>(), "hinge-types"},
    {KindOf<T_PHGE_D>(), "hinge"},      {KindOf<T_SPFC_D>(), "spectrum"},
    {KindOf<T_POLC_D>(), "push"},       {KindOf<T_EVAL_D>(), "curve"},
    {KindOf<T_ULFC_D>(), "constraint"}, {KindOf<T_ULFI_D>(), "stay"},
    {KindOf<T_ULSI_D>(), "iterate"},
};

/// Of a kind of records, once above them; null: it has none.
QIcon IconOfNode(const T_TREE_NODE& node)
{
    if (node.what != W::Kind) return {};
    const auto at = std::ranges::find(kIcons, node.kind, &T_KIND_ICON::kind);
    return at == std::end(kIcons) ? QIcon() : DrawnIcon(QLatin1String(at->icon));
}

bool IsOnce(RECORD_KIND kind)
{
    return kind == kModelOptionsKind || kind == kPushControlKind;
}

} // namespace

CModelTreePane::CModelTreePane(CDBDoc& doc, CFrameScene& scene, CSelection& selection,
                               QWidget* parent)
    : QWidget(parent), m_doc(doc), m_model(doc, scene), m_selection(selection),
      m_tree(new QTreeWidget(this)), m_filter(new QLineEdit(this)), m_add(new QPushButton(this)),
      m_delete(new QPushButton(this))
{
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(2, 2, 2, 2);
    layout->addWidget(m_filter);
    layout->addWidget(m_tree);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_add);
    buttons->addWidget(m_delete);
    buttons->addStretch();
    layout->addLayout(buttons);
    m_filter->setClearButtonEnabled(true);
    m_tree->setHeaderHidden(true);
    m_tree->setUniformRowHeights(true);
    m_tree->setContextMenuPolicy(Qt::CustomContextMenu);
    m_tree->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_tree->installEventFilter(this);
    connect(m_filter, &QLineEdit::textChanged, this, [this](const QString& text) {
        m_model.SetFilter(text.toStdString());
        Refresh();
    });
    connect(m_tree, &QTreeWidget::itemExpanded, this, [this](QTreeWidgetItem* item) {
        m_unfolded.insert(NodeOf(item)->id);
        Fill(item);
    });
    connect(m_tree, &QTreeWidget::itemCollapsed, this, [this](QTreeWidgetItem* item) {
        if (!m_quiet) m_unfolded.erase(NodeOf(item)->id);
    });
    connect(m_tree, &QTreeWidget::currentItemChanged, this, [this] { TakeCurrent(); });
    connect(m_tree, &QTreeWidget::itemDoubleClicked, this, [this] { Open(); });
    connect(m_tree, &QTreeWidget::itemChanged, this, [this](QTreeWidgetItem* item) {
        if (!m_quiet) TakeName(item);
    });
    connect(m_tree, &QTreeWidget::customContextMenuRequested, this,
            [this](const QPoint& at) { ShowMenu(at); });
    connect(m_add, &QPushButton::clicked, this, [this] { Add(); });
    connect(m_delete, &QPushButton::clicked, this, [this] { Delete(); });
    Retranslate();
}

// ---- nodes --------------------------------------------------------------------------------------

const T_TREE_NODE* CModelTreePane::NodeOf(const QTreeWidgetItem* item) const
{
    return item ? &m_nodes.at(item->data(0, kIndexRole).toULongLong()) : nullptr;
}

const T_TREE_NODE* CModelTreePane::Current() const
{
    return NodeOf(m_tree->currentItem());
}

QTreeWidgetItem* CModelTreePane::MakeItem(const T_TREE_NODE& node)
{
    auto* item = new QTreeWidgetItem({QString::fromStdString(node.text)});
    item->setIcon(0, IconOfNode(node));
    item->setData(0, kIndexRole, QVariant::fromValue<qulonglong>(m_nodes.size()));
    m_nodes.push_back(node);
    Qt::ItemFlags flags = Qt::ItemIsSelectable | Qt::ItemIsEnabled;
    if (node.what == W::Record && !NameOfRecord(m_doc.Data().Model(), node.kind, node.key).empty())
        flags |= Qt::ItemIsEditable;
    item->setFlags(flags);
    if (m_model.HasChildren(node)) item->setChildIndicatorPolicy(QTreeWidgetItem::ShowIndicator);
    return item;
}

/// The children of an item that is unfolded for the first time.
void CModelTreePane::Fill(QTreeWidgetItem* item)
{
    if (item->childCount() > 0) return;
    const bool quiet = std::exchange(m_quiet, true);
    const T_TREE_NODE node = *NodeOf(item);
    for (const T_TREE_NODE& child : m_model.Children(node)) {
        QTreeWidgetItem* made = MakeItem(child);
        item->addChild(made);
        const bool searched = !m_model.Filter().empty() && child.what == W::Kind;
        if (m_unfolded.contains(child.id) || searched) {
            Fill(made);
            made->setExpanded(true);
        }
    }
    m_quiet = quiet;
}

void CModelTreePane::Refresh()
{
    const std::string current = Current() ? Current()->id : std::string();
    const bool quiet = std::exchange(m_quiet, true);
    m_tree->clear();
    m_nodes.clear();
    for (const T_TREE_NODE& root : m_model.Roots()) {
        QTreeWidgetItem* item = MakeItem(root);
        m_tree->addTopLevelItem(item);
        const bool open = root.what == W::Subject || m_unfolded.contains(root.id);
        if (!open) continue;
        Fill(item);
        item->setExpanded(true);
    }
    for (QTreeWidgetItemIterator it(m_tree); *it; ++it)
        if (NodeOf(*it)->id == current) m_tree->setCurrentItem(*it);
    m_quiet = quiet;
}

QTreeWidgetItem* CModelTreePane::FindItem(const std::vector<std::string>& path)
{
    QTreeWidgetItem* at = m_tree->invisibleRootItem();
    for (const std::string& id : path) {
        QTreeWidgetItem* next = nullptr;
        for (int i = 0; i < at->childCount(); ++i)
            if (NodeOf(at->child(i))->id == id) next = at->child(i);
        if (!next) return at == m_tree->invisibleRootItem() ? nullptr : at;
        if (id != path.back()) {
            Fill(next);
            next->setExpanded(true);
        }
        at = next;
    }
    return at;
}

void CModelTreePane::Show(RECORD_KIND kind, int key)
{
    const bool quiet = std::exchange(m_quiet, true);
    if (QTreeWidgetItem* item = FindItem(m_model.PathTo(kind, key))) m_tree->setCurrentItem(item);
    m_quiet = quiet;
}

void CModelTreePane::TakeCurrent()
{
    const T_TREE_NODE* const node = Current();
    if (m_quiet || !node) return;
    const T_TREE_NODE chosen = *node; // what is told may make the nodes again
    if (chosen.what == W::Result && m_showResult) m_showResult(chosen.source);
    const bool kind = chosen.what == W::Kind || chosen.what == W::More;
    if (kind && !IsOnce(chosen.kind) && m_showTable) m_showTable(chosen.kind);
    const bool once = chosen.what == W::Kind && IsOnce(chosen.kind);
    if ((chosen.what == W::Record || once) && m_choose) m_choose(chosen.kind, chosen.key);
}

// ---- commands -----------------------------------------------------------------------------------

void CModelTreePane::Finish(int done, const std::string& reason)
{
    if (!done && m_refused) m_refused(reason);
    if (done && m_changed) m_changed();
}

void CModelTreePane::Add()
{
    const T_TREE_NODE* const node = Current();
    if (!node || (node->what != W::Kind && node->what != W::Record && node->what != W::More))
        return;
    const RECORD_KIND kind = node->kind;
    int key = 0;
    std::string reason;
    const int done = MakeRecord(m_doc, kind, {}, key, reason);
    if (done) m_unfolded.insert(KindWord(kind));
    Finish(done, reason);
    if (done && m_choose) m_choose(kind, key);
    if (done) Show(kind, key);
}

void CModelTreePane::Duplicate()
{
    const T_TREE_NODE* const node = Current();
    if (!node || node->what != W::Record) return;
    const RECORD_KIND kind = node->kind;
    int key = 0;
    std::string reason;
    const int done = DuplicateRecord(m_doc, kind, node->key, key, reason);
    Finish(done, reason);
    if (done && m_choose) m_choose(kind, key);
    if (done) Show(kind, key);
}

void CModelTreePane::Delete()
{
    const T_TREE_NODE* const node = Current();
    if (!node || node->what != W::Record) return;
    const std::array keys{node->key};
    std::string reason;
    const int done = DeleteRecords(m_doc, node->kind, keys, reason);
    Finish(done, reason);
}

void CModelTreePane::Rename()
{
    QTreeWidgetItem* const item = m_tree->currentItem();
    if (item && (item->flags() & Qt::ItemIsEditable)) m_tree->editItem(item);
}

void CModelTreePane::TakeName(QTreeWidgetItem* item)
{
    const T_TREE_NODE node = *NodeOf(item);
    const std::string name = item->text(0).toStdString();
    if (node.what != W::Record || name == node.text) return;
    CRecordForm form(m_doc, node.kind, {node.key});
    const int done = form.Set("name", name);
    // The items are made again: not while this one tells of its change.
    const std::string reason = form.Reason();
    QMetaObject::invokeMethod(
        this,
        [this, done, reason] {
            Finish(done, reason);
            if (!done) Refresh();
        },
        Qt::QueuedConnection);
}

void CModelTreePane::Open()
{
    const T_TREE_NODE* const node = Current();
    if (!node || node->what != W::Record || !m_open) return;
    const std::optional<EXPLORER_TABLE> table = TableOfKind(node->kind);
    if (table) m_open(*table, node->key);
}

/// The element itself, or those with the section, the material, in the storey, with the hinge.
CSelection::T_KEYS CModelTreePane::ElementsOfCurrent() const
{
    const T_TREE_NODE* const node = Current();
    CSelection::T_KEYS keys;
    if (!node || node->what != W::Record) return keys;
    const T_MODEL& model = m_doc.Data().Model();
    if (node->kind == KindOf<T_PHGE_D>()) return {model.hinges.at(node->key).element};
    for (const auto& [id, element] : model.elements) {
        const bool is = (node->kind == KindOf<T_ELEM_D>() && id == node->key) ||
                        (node->kind == KindOf<T_SECT_D>() && element.section == node->key) ||
                        (node->kind == KindOf<T_MATL_D>() && element.material == node->key) ||
                        (node->kind == KindOf<T_NODE_D>() &&
                         (element.nodeI == node->key || element.nodeJ == node->key));
        if (is) keys.insert(id);
    }
    return keys;
}

void CModelTreePane::ShowOnly()
{
    m_selection.ShowOnly(m_doc.Data().Model(), ElementsOfCurrent());
}

void CModelTreePane::Hide()
{
    m_selection.Hide(ElementsOfCurrent());
}

void CModelTreePane::ShowMenu(const QPoint& at)
{
    const T_TREE_NODE* const node = Current();
    if (!node || node->what == W::Subject || node->what == W::Results) return;
    const bool record = node->what == W::Record;
    const bool elements = !ElementsOfCurrent().empty();
    const bool adds = node->what != W::Result && !IsOnce(node->kind);
    QMenu menu(this);
    const auto put = [&](const char* key, bool enabled, void (CModelTreePane::*run)()) {
        QAction* action = menu.addAction(Text(key));
        action->setEnabled(enabled);
        connect(action, &QAction::triggered, this, run);
    };
    put("IDS_QM_TREE_ADD", adds, &CModelTreePane::Add);
    put("IDS_QM_TREE_DUPLICATE", record, &CModelTreePane::Duplicate);
    put("IDS_QM_TREE_RENAME", m_tree->currentItem()->flags() & Qt::ItemIsEditable,
        &CModelTreePane::Rename);
    put("IDS_QM_TREE_DELETE", record, &CModelTreePane::Delete);
    menu.addSeparator();
    put("IDS_QM_TREE_OPEN", record, &CModelTreePane::Open);
    put("IDS_QM_TREE_SHOW_ONLY", elements, &CModelTreePane::ShowOnly);
    put("IDS_QM_TREE_HIDE", elements, &CModelTreePane::Hide);
    menu.exec(m_tree->viewport()->mapToGlobal(at));
}

bool CModelTreePane::eventFilter(QObject* object, QEvent* event)
{
    if (object == m_tree && event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        const bool plain = static_cast<QKeyEvent*>(event)->modifiers() == Qt::NoModifier ||
                           static_cast<QKeyEvent*>(event)->modifiers() == Qt::KeypadModifier;
        const std::map<int, void (CModelTreePane::*)()> keys{
            {Qt::Key_F2, &CModelTreePane::Rename},
            {Qt::Key_Delete, &CModelTreePane::Delete},
            {Qt::Key_Insert, &CModelTreePane::Add},
            {Qt::Key_Return, &CModelTreePane::Open},
            {Qt::Key_Enter, &CModelTreePane::Open}};
        const auto it = keys.find(key);
        // The Enter that ends a name comes here too, from its editor.
        const bool editing = m_tree->viewport()->findChild<QLineEdit*>() != nullptr;
        if (plain && !editing && it != keys.end()) {
            (this->*it->second)();
            return true;
        }
    }
    return QWidget::eventFilter(object, event);
}

void CModelTreePane::Retranslate()
{
    m_add->setText(Text("IDS_QM_TREE_ADD"));
    m_delete->setText(Text("IDS_QM_TREE_DELETE"));
    m_filter->setPlaceholderText(Text("IDS_QM_TREE_FILTER"));
    m_filter->setAccessibleName(Text("IDS_QM_TREE_FILTER"));
    m_tree->setAccessibleName(Text("IDS_QM_UI_EXPLORER"));
    Refresh();
}
