#include "explorerpane.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/desk/gridexport.h"

#include <QComboBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QItemSelectionModel>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QVBoxLayout>

using zql::lib::MMSGFunction;

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(MMSGFunction::GetValue(key));
}

constexpr int kTables = static_cast<int>(EXPLORER_TABLE::Count);
constexpr int kAllDigits = -1, kMostDecimals = 9;

} // namespace

CExplorerPane::CExplorerPane(CDBDoc& doc, CSelection& selection, zql::frx::IDialogView& view,
                             std::function<void()> changed, QWidget* parent)
    : QWidget(parent), m_doc(doc), m_selection(selection), m_view(view),
      m_changed(std::move(changed)), m_list(new QComboBox(this)), m_filter(new QLineEdit(this)),
      m_decimalsLabel(new QLabel(this)), m_decimals(new QSpinBox(this)),
      m_layout(new QVBoxLayout(this)), m_add(new QPushButton(this)),
      m_delete(new QPushButton(this)), m_export(new QPushButton(this))
{
    auto* line = new QHBoxLayout;
    line->addWidget(m_list);
    line->addWidget(m_filter, 1);
    line->addWidget(m_decimalsLabel);
    line->addWidget(m_decimals);
    for (QPushButton* const button : {m_add, m_delete, m_export})
        line->addWidget(button);
    m_layout->setContentsMargins(2, 2, 2, 2);
    m_layout->addLayout(line);
    constexpr int kLeastLetters = 12; // a narrow window has room for the rest
    m_list->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    m_list->setMinimumContentsLength(kLeastLetters);
    m_filter->setClearButtonEnabled(true);
    m_decimals->setRange(kAllDigits, kMostDecimals);
    m_decimals->setValue(kAllDigits);
    for (int i = 0; i < kTables; ++i)
        m_list->addItem(QString());
    connect(m_list, &QComboBox::currentIndexChanged, this, [this] { ShowTable(); });
    connect(m_filter, &QLineEdit::textChanged, this, [this](const QString& text) {
        T_GRID_ORDER order = m_grid->Order();
        order.filter = text.toStdString();
        m_grid->SetOrder(order);
        m_table->Refresh();
    });
    connect(m_decimals, &QSpinBox::valueChanged, this,
            [this](int decimals) { m_table->SetDecimals(decimals); });
    connect(m_add, &QPushButton::clicked, this, [this] { Add(); });
    connect(m_delete, &QPushButton::clicked, this, [this] { Delete(); });
    connect(m_export, &QPushButton::clicked, this, [this] { Export(); });
    ShowTable();
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
    return static_cast<EXPLORER_TABLE>(std::max(m_list->currentIndex(), 0));
}

void CExplorerPane::Choose(EXPLORER_TABLE table)
{
    m_list->setCurrentIndex(static_cast<int>(table));
}

void CExplorerPane::ShowTable()
{
    delete m_table;
    m_grid = MakeRecordGrid(m_doc, Chosen());
    m_grid->SetView(&m_view);
    m_grid->SetOrder({-1, false, m_filter->text().toStdString()});
    T_GRID_BINDING binding = GridOf(*m_grid);
    binding.open = [this](std::size_t row) {
        if (m_open) m_open(Chosen(), m_grid->KeyOf(row));
    };
    m_table = new CRecordTableView(*m_grid, std::move(binding), m_changed, this);
    m_table->setAccessibleName(Text(TitleKey(Chosen())));
    m_table->SetDecimals(m_decimals->value());
    m_layout->addWidget(m_table, 1);
    connect(m_table->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            [this] { TakeRows(); });
    ShowSelection();
}

void CExplorerPane::TakeRows()
{
    if (m_quiet) return;
    m_quiet = true;
    m_selection.Choose(Chosen(), m_table->ChosenKeys());
    m_quiet = false;
}

void CExplorerPane::ShowSelection()
{
    if (m_quiet) return;
    const CSelection::T_KEYS& keys = m_selection.Chosen(Chosen());
    for (int i = 0; keys.empty() && !m_selection.IsEmpty() && i < kTables; ++i) {
        const auto other = static_cast<EXPLORER_TABLE>(i);
        if (m_selection.Chosen(other).empty()) continue;
        return Choose(other); // shows its selection
    }
    m_quiet = true;
    m_table->ChooseKeys(keys);
    m_quiet = false;
}

void CExplorerPane::Refresh()
{
    const QSignalBlocker quiet(m_list);
    for (int i = 0; i < kTables; ++i)
        m_list->setItemText(i, NameOf(static_cast<EXPLORER_TABLE>(i)));
    const bool before = std::exchange(m_quiet, true); // rows may stand elsewhere now
    m_table->Refresh();
    if (!m_selection.Chosen(Chosen()).empty()) m_table->ChooseKeys(m_selection.Chosen(Chosen()));
    m_quiet = before;
}

void CExplorerPane::Retranslate()
{
    m_add->setText(Text("IDS_QM_UI_ADD"));
    m_delete->setText(Text("IDS_QM_UI_DELETE"));
    m_export->setText(Text("IDS_QM_GRID_EXPORT"));
    m_list->setAccessibleName(Text("IDS_QM_UI_TABLES"));
    m_filter->setPlaceholderText(Text("IDS_QM_GRID_FILTER"));
    m_filter->setAccessibleName(Text("IDS_QM_GRID_FILTER"));
    m_decimalsLabel->setText(Text("IDS_QM_GRID_DECIMALS"));
    m_decimals->setSpecialValueText(Text("IDS_QM_GRID_ALL_DIGITS"));
    m_decimals->setMinimumWidth(m_decimals->sizeHint().width());
    m_decimals->setAccessibleName(Text("IDS_QM_GRID_DECIMALS"));
    Refresh();
}

void CExplorerPane::Add()
{
    if (!m_grid->OnAdd()) return;
    m_changed();
    m_table->ChooseKeys({m_grid->MadeKey()});
}

void CExplorerPane::Delete()
{
    std::set<std::size_t> rows;
    for (const QModelIndex& at : m_table->selectionModel()->selectedIndexes())
        rows.insert(static_cast<std::size_t>(at.row()));
    if (rows.empty() || !m_grid->OnDelete({rows.begin(), rows.end()})) return;
    m_changed();
}

void CExplorerPane::Export()
{
    const std::string path = m_askPath ? m_askPath() : std::string();
    std::string error;
    if (path.empty() || ExportGrid(*m_grid, path, error)) return;
    m_view.ShowMessage("IDS_QM_UI_FILE_REFUSED", error);
}
