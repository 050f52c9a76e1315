#include "explorerpane.h"

#include "qm_base/msgfunction.h"
#include "qm_ui/form/gridview.h"

#include <QHBoxLayout>
#include <QHeaderView>
#include <QItemSelectionModel>
#include <QListWidget>
#include <QPushButton>
#include <QSplitter>
#include <QVBoxLayout>

#include <set>

using zql::lib::MMSGFunction;

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

constexpr int kTables = static_cast<int>(EXPLORER_TABLE::Count);

} // namespace

CExplorerPane::CExplorerPane(CDBDoc& doc, zql::frx::IDialogView& view,
                             std::function<void()> changed, QWidget* parent)
    : QWidget(parent), m_doc(doc), m_view(view), m_changed(std::move(changed)),
      m_list(new QListWidget(this)), m_right(new QWidget(this)),
      m_rightLayout(new QVBoxLayout(m_right)), m_add(new QPushButton(this)),
      m_delete(new QPushButton(this))
{
    auto* splitter = new QSplitter(Qt::Vertical, this);
    splitter->addWidget(m_list);
    splitter->addWidget(m_right);
    splitter->setStretchFactor(1, 2);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(splitter);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(m_add);
    buttons->addWidget(m_delete);
    buttons->addStretch();
    m_rightLayout->setContentsMargins(0, 0, 0, 0);
    m_rightLayout->addLayout(buttons);
    for (int i = 0; i < kTables; ++i)
        m_list->addItem(QString());
    connect(m_list, &QListWidget::currentRowChanged, this, [this] { ShowTable(); });
    connect(m_add, &QPushButton::clicked, this, [this] { Add(); });
    connect(m_delete, &QPushButton::clicked, this, [this] { Delete(); });
    m_list->setCurrentRow(0);
    Retranslate();
}

CExplorerPane::~CExplorerPane()
{
    delete m_table; // it reads the grid
}

QString CExplorerPane::NameOf(EXPLORER_TABLE table) const
{
    return QStringLiteral("%1 (%2)").arg(Text(TitleKey(table))).arg(RecordCount(m_doc, table));
}

EXPLORER_TABLE CExplorerPane::Chosen() const
{
    return static_cast<EXPLORER_TABLE>(std::max(m_list->currentRow(), 0));
}

void CExplorerPane::Choose(EXPLORER_TABLE table)
{
    m_list->setCurrentRow(static_cast<int>(table));
}

void CExplorerPane::ShowTable()
{
    delete m_table;
    m_grid = MakeRecordGrid(m_doc, Chosen());
    m_grid->SetView(&m_view);
    T_GRID_BINDING binding = GridOf(*m_grid);
    binding.open = [this](std::size_t row) {
        if (m_open) m_open(Chosen(), m_grid->KeyOf(row));
    };
    m_table = new CGridView(std::move(binding), m_changed, m_right);
    m_table->setAccessibleName(Text(TitleKey(Chosen())));
    m_rightLayout->insertWidget(0, m_table);
    m_add->setEnabled(m_grid->CanAdd());
}

void CExplorerPane::Refresh()
{
    for (int i = 0; i < kTables; ++i)
        m_list->item(i)->setText(NameOf(static_cast<EXPLORER_TABLE>(i)));
    m_table->Refresh();
}

void CExplorerPane::Retranslate()
{
    m_add->setText(Text("IDS_QM_UI_ADD"));
    m_delete->setText(Text("IDS_QM_UI_DELETE"));
    m_list->setAccessibleName(Text("IDS_QM_UI_EXPLORER"));
    Refresh();
}

void CExplorerPane::Add()
{
    if (!m_grid->CanAdd() || !m_grid->OnAdd()) return;
    m_changed();
    m_table->setCurrentIndex(m_table->Model().index(m_table->Model().rowCount() - 1, 0));
}

void CExplorerPane::Delete()
{
    std::set<std::size_t> rows;
    for (const QModelIndex& at : m_table->selectionModel()->selectedIndexes())
        rows.insert(static_cast<std::size_t>(at.row()));
    if (rows.empty() || !m_grid->OnDelete({rows.begin(), rows.end()})) return;
    m_changed();
}
