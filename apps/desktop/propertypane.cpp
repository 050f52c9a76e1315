#include "propertypane.h"

#include "qm_base/msgfunction.h"
#include "qm_ui/form/localnumber.h"

#include <QComboBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyledItemDelegate>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace {

constexpr int kRowRole = Qt::UserRole;
constexpr int kValue = 1, kUnit = 2; // columns

QString Text(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

bool IsNumber(const T_FIELD_ROW& row)
{
    return row.kind == FIELD_KIND::Number || row.kind == FIELD_KIND::Integer;
}

bool HasText(const T_FIELD_ROW& row)
{
    const bool records = row.kind == FIELD_KIND::List && row.items == FIELD_KIND::Group;
    return row.kind != FIELD_KIND::Group && !records;
}

/// What is typed over: of a key without the name behind it.
QString EditedText(const T_PROPERTY& property)
{
    if (property.various) return {};
    if (property.row.kind == FIELD_KIND::List) return QString::fromStdString(property.value);
    return IsNumber(property.row) ? LocalNumberText(property.row.text)
                                  : QString::fromStdString(property.row.text);
}

/// Choices by list, texts and numbers as they are.
class CPropertyDelegate : public QStyledItemDelegate {
public:
    CPropertyDelegate(CPropertyModel& model, QObject* parent)
        : QStyledItemDelegate(parent), m_model(model)
    {
    }

    QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem&,
                          const QModelIndex& at) const override
    {
        const T_FIELD_ROW& row = Property(at).row;
        QStringList choices;
        if (row.kind == FIELD_KIND::Flag)
            choices << "true"
                    << "false";
        for (const std::string& choice : row.choices)
            choices << QString::fromStdString(choice);
        if (choices.isEmpty() || row.kind == FIELD_KIND::List) return new QLineEdit(parent);
        if (row.canRemove || !row.isThere) choices.prepend(QString());
        auto* box = new QComboBox(parent);
        box->addItems(choices);
        box->setEditable(row.kind == FIELD_KIND::Text);
        return box;
    }
    void setEditorData(QWidget* editor, const QModelIndex& at) const override
    {
        const QString text = EditedText(Property(at));
        if (auto* box = qobject_cast<QComboBox*>(editor)) box->setCurrentText(text);
        if (auto* line = qobject_cast<QLineEdit*>(editor)) line->setText(text);
    }
    void setModelData(QWidget* editor, QAbstractItemModel* model,
                      const QModelIndex& at) const override
    {
        QString text;
        if (auto* box = qobject_cast<QComboBox*>(editor)) text = box->currentText();
        if (auto* line = qobject_cast<QLineEdit*>(editor)) text = line->text();
        if (text != EditedText(Property(at))) model->setData(at, text);
    }
    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& at) const override
    {
        constexpr int kRowHeight = 22;
        QSize size = QStyledItemDelegate::sizeHint(option, at);
        size.setHeight(std::max(size.height(), kRowHeight));
        return size;
    }

private:
    const T_PROPERTY& Property(const QModelIndex& at) const
    {
        return m_model.Rows().at(at.siblingAtColumn(0).data(kRowRole).toULongLong());
    }
    CPropertyModel& m_model;
};

} // namespace

CPropertyPane::CPropertyPane(CDBDoc& doc, QWidget* parent)
    : QWidget(parent), m_model(doc), m_title(new QLabel(this)), m_reason(new QLabel(this)),
      m_tree(new QTreeWidget(this)), m_add(new QPushButton(this)), m_remove(new QPushButton(this)),
      m_window(new QPushButton(this))
{
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(2, 2, 2, 2);
    QFont bold = m_title->font();
    bold.setBold(true);
    m_title->setFont(bold);
    m_reason->setWordWrap(true);
    m_reason->setStyleSheet("color: #b00020");
    layout->addWidget(m_title);
    layout->addWidget(m_tree);
    layout->addWidget(m_reason);
    auto* buttons = new QHBoxLayout;
    for (QPushButton* const button : {m_add, m_remove, m_window})
        buttons->addWidget(button);
    buttons->addStretch();
    layout->addLayout(buttons);
    m_tree->setColumnCount(3);
    m_tree->setAlternatingRowColors(true);
    m_tree->setItemDelegateForColumn(kValue, new CPropertyDelegate(m_model, m_tree));
    m_tree->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_tree->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_tree->header()->setSectionResizeMode(0, QHeaderView::Interactive);
    m_tree->header()->setStretchLastSection(false);
    m_tree->header()->setSectionResizeMode(kValue, QHeaderView::Stretch);
    m_tree->header()->setSectionResizeMode(kUnit, QHeaderView::ResizeToContents);
    constexpr int kMembers = 150, kLeast = 300; // pixels
    m_tree->header()->resizeSection(0, kMembers);
    setMinimumWidth(kLeast);
    connect(m_tree, &QTreeWidget::itemChanged, this, [this](QTreeWidgetItem* item) {
        if (!m_quiet) TakeText(item);
    });
    const auto edit = [this](QTreeWidgetItem* item) {
        if (item && (item->flags() & Qt::ItemIsEditable)) m_tree->editItem(item, kValue);
    };
    connect(m_tree, &QTreeWidget::itemClicked, this, [edit](QTreeWidgetItem* item, int column) {
        if (column == kValue) edit(item);
    });
    connect(m_tree, &QTreeWidget::itemActivated, this, edit);
    connect(m_tree, &QTreeWidget::currentItemChanged, this, [this] { UpdateButtons(); });
    connect(m_tree, &QTreeWidget::itemExpanded, this, [this](QTreeWidgetItem* item) {
        if (!m_quiet) m_unfolded.insert(m_model.Rows().at(RowOf(item)).row.path);
    });
    connect(m_tree, &QTreeWidget::itemCollapsed, this, [this](QTreeWidgetItem* item) {
        if (!m_quiet) m_unfolded.erase(m_model.Rows().at(RowOf(item)).row.path);
    });
    connect(m_add, &QPushButton::clicked, this, [this] { Add(); });
    connect(m_remove, &QPushButton::clicked, this, [this] { Remove(); });
    connect(m_window, &QPushButton::clicked, this, [this] {
        const std::optional<EXPLORER_TABLE> table = TableOfKind(m_model.Kind());
        if (table && m_open && !m_model.IsEmpty()) m_open(*table, m_model.Keys().front());
    });
    Retranslate();
}

std::size_t CPropertyPane::RowOf(const QTreeWidgetItem* item) const
{
    return item->data(0, kRowRole).toULongLong();
}

void CPropertyPane::MakeRow(QTreeWidgetItem* item, std::size_t row)
{
    const T_PROPERTY& property = m_model.Rows()[row];
    const bool number = IsNumber(property.row) && !property.various;
    item->setText(0, QString::fromStdString(property.label));
    item->setToolTip(0, QString::fromStdString(property.row.path)); // as commands name it
    item->setText(kValue, number ? LocalNumberText(property.value)
                                 : QString::fromStdString(property.value));
    item->setToolTip(kValue, item->text(kValue).size() > 40 ? item->text(kValue) : QString());
    item->setText(kUnit, QString::fromStdString(property.unit));
    item->setData(0, kRowRole, QVariant::fromValue<qulonglong>(row));
    Qt::ItemFlags flags = Qt::ItemIsSelectable | Qt::ItemIsEnabled;
    if (HasText(property.row)) flags |= Qt::ItemIsEditable;
    item->setFlags(flags);
    if (!property.row.isThere) item->setForeground(0, palette().placeholderText());
    if (property.various) item->setForeground(kValue, palette().placeholderText());
}

void CPropertyPane::Fill()
{
    std::vector<QTreeWidgetItem*> holders{m_tree->invisibleRootItem()};
    for (std::size_t row = 0; row < m_model.Rows().size(); ++row) {
        const T_FIELD_ROW& field = m_model.Rows()[row].row;
        holders.resize(static_cast<std::size_t>(field.depth) + 1);
        auto* item = new QTreeWidgetItem;
        MakeRow(item, row);
        holders.back()->addChild(item);
        holders.push_back(item);
    }
    for (QTreeWidgetItemIterator it(m_tree); *it; ++it)
        if (m_unfolded.contains(m_model.Rows()[RowOf(*it)].row.path)) (*it)->setExpanded(true);
}

void CPropertyPane::Refresh()
{
    const std::vector<T_PROPERTY>& rows = m_model.Rows();
    QTreeWidgetItem* const now = m_tree->currentItem();
    const QString current = now ? now->toolTip(0) : QString();
    const bool quiet = std::exchange(m_quiet, true);
    m_tree->clear();
    Fill();
    for (QTreeWidgetItemIterator it(m_tree); *it; ++it)
        if (!current.isEmpty() && (*it)->toolTip(0) == current) m_tree->setCurrentItem(*it);
    m_quiet = quiet;
    m_title->setText(rows.empty() && m_model.IsEmpty() ? Text("IDS_QM_PROP_NOTHING")
                                                       : QString::fromStdString(m_model.Title()));
    m_reason->setText(QString::fromStdString(m_model.Reason()));
    m_reason->setVisible(!m_model.Reason().empty());
    UpdateButtons();
}

void CPropertyPane::UpdateButtons()
{
    QTreeWidgetItem* const item = m_tree->currentItem();
    const auto& rows = m_model.Rows();
    const bool is = item && RowOf(item) < rows.size();
    m_add->setEnabled(is && rows[RowOf(item)].row.canAdd);
    m_remove->setEnabled(is && rows[RowOf(item)].row.canRemove);
    m_window->setEnabled(m_model.Keys().size() == 1 && TableOfKind(m_model.Kind()).has_value());
}

/// The items are made again: not while one of them tells of its change.
void CPropertyPane::Finish(int done)
{
    QMetaObject::invokeMethod(
        this,
        [this, done] {
            if (done && m_changed) m_changed();
            Refresh();
        },
        Qt::QueuedConnection);
}

void CPropertyPane::TakeText(QTreeWidgetItem* item)
{
    const std::size_t row = RowOf(item);
    const QString typed = item->text(kValue);
    const bool number = IsNumber(m_model.Rows().at(row).row);
    Finish(m_model.OnSet(row, number ? PlainNumberText(typed) : typed.toStdString()));
}

void CPropertyPane::Add()
{
    QTreeWidgetItem* const item = m_tree->currentItem();
    if (!item) return;
    m_unfolded.insert(m_model.Rows().at(RowOf(item)).row.path);
    Finish(m_model.OnAdd(RowOf(item)));
}

void CPropertyPane::Remove()
{
    QTreeWidgetItem* const item = m_tree->currentItem();
    if (item) Finish(m_model.OnRemove(RowOf(item)));
}

void CPropertyPane::Retranslate()
{
    m_tree->setHeaderLabels(
        {Text("IDS_QM_PROP_MEMBER"), Text("IDS_QM_PROP_VALUE"), Text("IDS_QM_PROP_UNIT")});
    m_tree->setAccessibleName(Text("IDS_QM_UI_PROPERTIES"));
    m_add->setText(Text("IDS_QM_PROP_ADD"));
    m_remove->setText(Text("IDS_QM_PROP_REMOVE"));
    m_window->setText(Text("IDS_QM_TREE_OPEN"));
    Refresh();
}
