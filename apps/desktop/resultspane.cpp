#include "resultspane.h"

#include "desktop.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_ui/form/localnumber.h"

#include <QAbstractTableModel>
#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QSortFilterProxyModel>
#include <QTableView>
#include <QToolButton>

/// Shown with six digits; sorts and copies with all of them.
class CResultTableModel : public QAbstractTableModel {
public:
    CResultTableModel(const T_RESULT_TABLE& table, QObject* parent)
        : QAbstractTableModel(parent), m_table(table)
    {
    }
    void Reset()
    {
        beginResetModel();
        endResetModel();
    }
    int rowCount(const QModelIndex& = {}) const override
    {
        return static_cast<int>(m_table.rows.size());
    }
    int columnCount(const QModelIndex& = {}) const override
    {
        return static_cast<int>(m_table.heads.size());
    }
    QVariant headerData(int section, Qt::Orientation way, int role) const override
    {
        if (way != Qt::Horizontal || role != Qt::DisplayRole) return {};
        return QString::fromStdString(m_table.heads[static_cast<std::size_t>(section)]);
    }
    QVariant data(const QModelIndex& index, int role) const override
    {
        const T_RESULT_CELL& cell = m_table.rows[static_cast<std::size_t>(index.row())]
                                                [static_cast<std::size_t>(index.column())];
        if (role == Qt::TextAlignmentRole && cell.number)
            return static_cast<int>(Qt::AlignRight | Qt::AlignVCenter);
        if (role != Qt::DisplayRole && role != Qt::UserRole) return {};
        if (!cell.number) return QString::fromStdString(cell.text);
        return role == Qt::UserRole ? QVariant(*cell.number)
                                    : QVariant(LocalNumberText(FormatText("%.6g", *cell.number)));
    }

private:
    const T_RESULT_TABLE& m_table;
};

namespace {

constexpr int kRowHeight = 22; // px
constexpr std::array<const char*, 3> kWhats{
    "IDS_QM_VIEW_TABLE_MOVES", "IDS_QM_VIEW_TABLE_REACTIONS", "IDS_QM_VIEW_TABLE_FORCES"};
constexpr std::array<const char*, 2> kOf{"IDS_QM_VIEW_TABLE_SHOWN", "IDS_QM_VIEW_TABLE_ENVELOPE"};

QString Text(const char* key)
{
    return QString::fromStdString(Say(key));
}

} // namespace

CResultsPane::CResultsPane(CFramePane& frame, QWidget* parent)
    : QWidget(parent), m_frame(frame), m_scene(frame.Doc()),
      m_model(new CResultTableModel(m_table, this)), m_what(new QComboBox(this)),
      m_of(new QComboBox(this)), m_chosen(new QCheckBox(this)), m_copy(new QToolButton(this)),
      m_export(new QToolButton(this)), m_note(new QLabel(this)), m_view(new QTableView(this))
{
    for (std::size_t i = 0; i < kWhats.size(); ++i)
        m_what->addItem(QString());
    for (std::size_t i = 0; i < kOf.size(); ++i)
        m_of->addItem(QString());
    m_what->setCurrentIndex(static_cast<int>(RESULT_TABLE::Forces));
    auto* bar = new QHBoxLayout;
    for (QWidget* widget : {static_cast<QWidget*>(m_what), static_cast<QWidget*>(m_of),
                            static_cast<QWidget*>(m_chosen), static_cast<QWidget*>(m_copy),
                            static_cast<QWidget*>(m_export)})
        bar->addWidget(widget);
    bar->addStretch();
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(4, 4, 4, 4);
    layout->addLayout(bar);
    layout->addWidget(m_note);
    layout->addWidget(m_view, 1);
    m_view->setMinimumSize(480, 6 * kRowHeight);
    auto* sorted = new QSortFilterProxyModel(this);
    sorted->setSourceModel(m_model);
    sorted->setSortRole(Qt::UserRole);
    m_view->setModel(sorted);
    m_view->setSortingEnabled(true);
    sorted->sort(-1); // as the table is made
    m_view->horizontalHeader()->setSortIndicator(-1, Qt::AscendingOrder);
    m_view->verticalHeader()->setDefaultSectionSize(kRowHeight);
    m_view->verticalHeader()->hide();
    m_view->setTabKeyNavigation(false); // Tab leaves the table
    m_note->setWordWrap(true);
    for (QComboBox* box : {m_what, m_of})
        connect(box, &QComboBox::currentIndexChanged, this, [this] { Refresh(); });
    connect(m_chosen, &QCheckBox::toggled, this, [this] { Refresh(); });
    connect(m_copy, &QToolButton::clicked, this, [this] { Copy(); });
    connect(m_export, &QToolButton::clicked, this, [this] { Export(); });
    m_frame.Selection().Watch(this, [this] {
        if (m_chosen->isChecked()) Refresh();
    });
    m_frame.m_onResults = [this] { Refresh(); };
    Retranslate();
}

CResultsPane::~CResultsPane()
{
    m_frame.Selection().Unwatch(this);
}

void CResultsPane::Retranslate()
{
    for (std::size_t i = 0; i < kWhats.size(); ++i)
        m_what->setItemText(static_cast<int>(i), Text(kWhats[i]));
    for (std::size_t i = 0; i < kOf.size(); ++i)
        m_of->setItemText(static_cast<int>(i), Text(kOf[i]));
    m_chosen->setText(Text("IDS_QM_VIEW_TABLE_CHOSEN"));
    m_copy->setText(Text("IDS_QM_VIEW_TABLE_COPY"));
    m_export->setText(Text("IDS_QM_VIEW_TABLE_EXPORT"));
    Refresh();
}

T_RESULT_TABLE_CHOICE CResultsPane::Choice() const
{
    T_RESULT_TABLE_CHOICE choice;
    choice.what = static_cast<RESULT_TABLE>(m_what->currentIndex());
    choice.envelope = m_of->currentIndex() == 1;
    const CResultView& shown = m_frame.Shown();
    if (!choice.envelope) {
        choice.sources.emplace_back(shown.Source(), shown.Step());
    } else {
        for (const T_SHAPE_SOURCE& source : EnvelopeSources(shown.Sources()))
            choice.sources.emplace_back(source, 1);
    }
    if (m_chosen->isChecked()) {
        choice.elements = m_frame.Selection().Chosen(EXPLORER_TABLE::Elements);
        choice.nodes = m_frame.Selection().Chosen(EXPLORER_TABLE::Nodes);
    }
    return choice;
}

void CResultsPane::Refresh()
{
    if (!isVisible()) return;
    const T_RESULT_TABLE_CHOICE choice = Choice();
    std::string why;
    m_table = {};
    if (choice.sources.empty())
        why = Say("IDS_QM_VIEW_NOT_ANALYSED");
    else
        (void)MakeResultTable(m_frame.Doc(), m_scene, choice, m_table, why);
    std::string note = !why.empty() ? why : choice.envelope ? "" : m_frame.Shown().Subtitle();
    for (const std::string& text : m_table.notes)
        note += (note.empty() ? "" : "; ") + text;
    m_note->setText(QString::fromStdString(note));
    m_model->Reset();
    m_view->resizeColumnsToContents();
}

void CResultsPane::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    Refresh();
}

void CResultsPane::Copy() const
{
    QString text;
    const auto add = [&text](const QStringList& cells) { text += cells.join('\t') + "\n"; };
    QStringList heads;
    for (const std::string& head : m_table.heads)
        heads << QString::fromStdString(head);
    add(heads);
    for (const auto& row : m_table.rows) {
        QStringList cells;
        for (const T_RESULT_CELL& cell : row)
            cells << (cell.number ? LocalNumberText(ShortestText(*cell.number))
                                  : QString::fromStdString(cell.text));
        add(cells);
    }
    QApplication::clipboard()->setText(text);
}

void CResultsPane::Export()
{
    const QString path =
        AskFileName(this, true, Text("IDS_QM_VIEW_TABLE_EXPORT"), QStringLiteral("*.xlsx;;*.csv"));
    if (path.isEmpty()) return;
    T_FILE_ERROR error;
    const std::string name = path.toStdString();
    const int done = path.endsWith(".csv", Qt::CaseInsensitive)
                         ? CFileCtrl::WriteWholeFile(name, CsvText(m_table), error)
                         : WriteSheet(name, SheetOf(m_table), error);
    if (!done) m_note->setText(QString::fromStdString(error.text));
}
