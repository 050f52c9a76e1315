#include "qm_ui/form/gridview.h"

#include <QClipboard>
#include <QComboBox>
#include <QGuiApplication>
#include <QHeaderView>
#include <QItemSelectionModel>
#include <QKeyEvent>
#include <QLineEdit>
#include <QLocale>
#include <QScrollBar>
#include <QStringList>
#include <QStyledItemDelegate>

#include <algorithm>

namespace {

/// Edits texts as they are (the stock delegate cuts numbers to two decimals) and choices by list.
class CCellDelegate : public QStyledItemDelegate {
public:
    using QStyledItemDelegate::QStyledItemDelegate;

    QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem&,
                          const QModelIndex& at) const override
    {
        const auto* model = static_cast<const CGridModel*>(at.model());
        const auto& column = model->Binding().columns.at(static_cast<std::size_t>(at.column()));
        if (column.kind != CELL_KIND::Choice) return new QLineEdit(parent);
        auto* box = new QComboBox(parent);
        for (const std::string& text : column.choices())
            box->addItem(QString::fromStdString(text));
        return box;
    }
    void setEditorData(QWidget* editor, const QModelIndex& at) const override
    {
        const QString text = at.data(Qt::EditRole).toString();
        if (auto* box = qobject_cast<QComboBox*>(editor)) box->setCurrentText(text);
        if (auto* line = qobject_cast<QLineEdit*>(editor)) line->setText(text);
    }
    void setModelData(QWidget* editor, QAbstractItemModel* model,
                      const QModelIndex& at) const override
    {
        if (auto* box = qobject_cast<QComboBox*>(editor)) model->setData(at, box->currentText());
        if (auto* line = qobject_cast<QLineEdit*>(editor)) model->setData(at, line->text());
    }
};

} // namespace

CGridView::CGridView(T_GRID_BINDING binding, ChangedFn changed, QWidget* parent)
    : QTableView(parent), m_model(new CGridModel(std::move(binding), changed, this)),
      m_changed(std::move(changed))
{
    setModel(m_model);
    setItemDelegate(new CCellDelegate(this));
    setAlternatingRowColors(true);
    setEditTriggers(DoubleClicked | EditKeyPressed | AnyKeyPressed);
    setSelectionMode(ContiguousSelection);
    const auto& columns = m_model->Binding().columns;
    const bool edits = std::any_of(columns.begin(), columns.end(), [](const auto& c) {
        return c.edit && c.kind != CELL_KIND::Flag;
    });
    setTabKeyNavigation(edits); // else Tab goes on to what follows the table
    if (!edits) setSelectionBehavior(SelectRows);
    verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    horizontalHeader()->setSectionResizeMode(QHeaderView::Interactive);
    connect(selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this](const QModelIndex& now) {
                if (m_quiet || !m_model->Binding().select) return;
                m_model->Binding().select(now.isValid() ? now.row() : -1);
                m_changed();
            });
    connect(this, &QTableView::doubleClicked, this, [this](const QModelIndex& at) {
        const auto& open = m_model->Binding().open;
        if (open && !(m_model->flags(at) & Qt::ItemIsEditable))
            open(static_cast<std::size_t>(at.row()));
    });
    resizeColumnsToContents();
}

void CGridView::Refresh()
{
    m_model->Refresh();
    for (int c = 0; c < m_model->columnCount(); ++c) // a table may use fewer than it has
        setColumnHidden(
            c, m_model->headerData(c, Qt::Horizontal, Qt::DisplayRole).toString().isEmpty());
    if (isVisible()) FitColumns();
    FollowChoice();
}

void CGridView::FitColumns()
{
    constexpr int kMeasured = 200; // columns of large tables are measured by their first rows
    horizontalHeader()->setResizeContentsPrecision(kMeasured);
    resizeColumnsToContents();
    CapWidest();
}

/// One long text must not push the numbers of its column out of sight.
void CGridView::CapWidest()
{
    int widest = 0, total = 0;
    for (int c = 0; c < m_model->columnCount(); ++c) {
        total += columnWidth(c);
        if (columnWidth(c) > columnWidth(widest)) widest = c;
    }
    const int bar = verticalScrollBar()->sizeHint().width(); // it may come up yet
    const int room = std::min(viewport()->width(), maximumViewportSize().width() - bar);
    const int others = total - columnWidth(widest);
    m_capped = total > room && columnWidth(widest) > room / 2;
    if (m_capped) setColumnWidth(widest, std::max(room - others, room / 2));
}

void CGridView::resizeEvent(QResizeEvent* event)
{
    QTableView::resizeEvent(event);
    if (!m_capped) return CapWidest();
    m_capped = false; // scroll bars that come or go resize it once more
    FitColumns();
}

/// Tables on pages behind are measured when they come to the front.
void CGridView::showEvent(QShowEvent* event)
{
    QTableView::showEvent(event);
    FitColumns();
}

void CGridView::FollowChoice()
{
    if (!m_model->Binding().selected) return;
    const int row = m_model->Binding().selected();
    if (row == (currentIndex().isValid() ? currentIndex().row() : -1)) return;
    m_quiet = true;
    if (row >= 0 && row < m_model->rowCount())
        setCurrentIndex(m_model->index(row, 0));
    else
        selectionModel()->clear();
    m_quiet = false;
}

T_GRID_RANGE CGridView::ChosenRange() const
{
    const QModelIndexList cells = selectionModel()->selectedIndexes();
    const QModelIndex now = currentIndex();
    if (cells.isEmpty()) {
        return now.isValid() ? T_GRID_RANGE{static_cast<std::size_t>(now.row()),
                                            static_cast<std::size_t>(now.column()), 1, 1}
                             : T_GRID_RANGE{};
    }
    int top = cells.front().row(), left = cells.front().column(), bottom = top, right = left;
    for (const QModelIndex& cell : cells) {
        top = std::min(top, cell.row());
        bottom = std::max(bottom, cell.row());
        left = std::min(left, cell.column());
        right = std::max(right, cell.column());
    }
    return {static_cast<std::size_t>(top), static_cast<std::size_t>(left),
            static_cast<std::size_t>(bottom - top + 1), static_cast<std::size_t>(right - left + 1)};
}

QString CGridView::ChosenText() const
{
    const T_GRID_RANGE range = ChosenRange();
    QStringList lines;
    for (std::size_t r = 0; r < range.rows; ++r) {
        QStringList cells;
        for (std::size_t c = 0; c < range.columns; ++c) {
            const QModelIndex at =
                m_model->index(static_cast<int>(range.row + r), static_cast<int>(range.column + c));
            const QVariant check = at.data(Qt::CheckStateRole);
            cells << (check.isValid() ? QString(check.toInt() == Qt::Checked ? "1" : "0")
                                      : at.data(Qt::EditRole).toString());
        }
        lines << cells.join(QLatin1Char('\t'));
    }
    return lines.join(QLatin1Char('\n'));
}

int CGridView::PasteCells(const QString& text, const T_GRID_RANGE& from)
{
    QString block = text;
    if (block.endsWith(QLatin1Char('\n'))) block.chop(1);
    int done = 1, row = static_cast<int>(from.row);
    for (const QString& line : block.split(QLatin1Char('\n'))) {
        int column = static_cast<int>(from.column);
        for (const QString& cell : line.split(QLatin1Char('\t')))
            done = m_model->Take(row, column++, cell.trimmed()) && done;
        ++row;
    }
    return done;
}

int CGridView::PasteText(const QString& text)
{
    const T_GRID_RANGE range = ChosenRange();
    const auto& paste = m_model->Binding().paste;
    QString plain = text;
    plain.remove(QLatin1Char('\r'));
    int done = 0;
    if (paste) {
        // Spreadsheets copy numbers as their locale writes them.
        if (QLocale().decimalPoint() != QLatin1String("."))
            plain.replace(QLocale().decimalPoint(), QLatin1String("."));
        done = paste(plain.toStdString(), range);
    } else {
        done = PasteCells(plain, range);
        if (!done && m_refuse) m_refuse("IDS_QM_UI_PASTE_REFUSED");
    }
    m_changed();
    return done;
}

void CGridView::keyPressEvent(QKeyEvent* event)
{
    const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    const bool fixed =
        currentIndex().isValid() && !(m_model->flags(currentIndex()) & Qt::ItemIsEditable);
    if (event->matches(QKeySequence::Copy))
        QGuiApplication::clipboard()->setText(ChosenText());
    else if (event->matches(QKeySequence::Paste))
        (void)PasteText(QGuiApplication::clipboard()->text());
    else if (enter && fixed && m_model->Binding().open)
        m_model->Binding().open(static_cast<std::size_t>(currentIndex().row()));
    else
        QTableView::keyPressEvent(event);
}
