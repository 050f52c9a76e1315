#include "recordtableview.h"

#include "qm_ui/form/localnumber.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QHeaderView>
#include <QItemSelectionModel>
#include <QKeyEvent>
#include <QLocale>
#include <QStyledItemDelegate>

namespace {

/// Numbers with so many decimals; everything else as the table's own delegate has it.
class CDecimals : public QStyledItemDelegate {
public:
    CDecimals(const CRecordTableView& view, QAbstractItemDelegate& own, QObject* parent)
        : QStyledItemDelegate(parent), m_view(view), m_own(own)
    {
    }
    QString displayText(const QVariant& value, const QLocale& locale) const override
    {
        const QString text = value.toString();
        const std::optional<double> number =
            m_view.Decimals() < 0 ? std::optional<double>() : ParseLocalNumber(text);
        const bool whole = !text.contains('.') && !text.contains(',') && !text.contains('e');
        if (!number || whole) return QStyledItemDelegate::displayText(value, locale);
        QLocale plain;
        plain.setNumberOptions(QLocale::OmitGroupSeparator);
        return plain.toString(*number, 'f', m_view.Decimals());
    }
    QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem& option,
                          const QModelIndex& at) const override
    {
        return m_own.createEditor(parent, option, at);
    }
    void setEditorData(QWidget* editor, const QModelIndex& at) const override
    {
        m_own.setEditorData(editor, at);
    }
    void setModelData(QWidget* editor, QAbstractItemModel* model,
                      const QModelIndex& at) const override
    {
        m_own.setModelData(editor, model, at);
    }

private:
    const CRecordTableView& m_view;
    QAbstractItemDelegate& m_own;
};

} // namespace

CRecordTableView::CRecordTableView(CRecordGrid& grid, T_GRID_BINDING binding, ChangedFn changed,
                                   QWidget* parent)
    : CGridView(std::move(binding), std::move(changed), parent), m_grid(grid)
{
    constexpr int kRowHeight = 22;
    verticalHeader()->setMinimumSectionSize(kRowHeight);
    verticalHeader()->setDefaultSectionSize(kRowHeight);
    verticalHeader()->hide(); // the first column has the key
    setItemDelegate(new CDecimals(*this, *itemDelegate(), this));
    horizontalHeader()->setSectionsClickable(true);
    horizontalHeader()->setSortIndicatorShown(true);
    horizontalHeader()->setSortIndicator(-1, Qt::AscendingOrder);
    connect(horizontalHeader(), &QHeaderView::sectionClicked, this,
            [this](int column) { SortBy(column); });
}

void CRecordTableView::SetDecimals(int decimals)
{
    m_decimals = decimals;
    viewport()->update();
}

void CRecordTableView::SortBy(int column)
{
    const std::set<int> chosen = ChosenKeys();
    T_GRID_ORDER order = m_grid.Order();
    if (order.column != column)
        order = {column, false, order.filter};
    else if (!order.falling)
        order.falling = true;
    else
        order = {-1, false, order.filter};
    m_grid.SetOrder(order);
    horizontalHeader()->setSortIndicator(order.column,
                                         order.falling ? Qt::DescendingOrder : Qt::AscendingOrder);
    Refresh();
    ChooseKeys(chosen);
}

std::set<int> CRecordTableView::ChosenKeys() const
{
    std::set<int> keys;
    for (const QItemSelectionRange& range : selectionModel()->selection())
        for (int row = range.top(); row <= range.bottom(); ++row)
            keys.insert(m_grid.KeyOf(static_cast<std::size_t>(row)));
    return keys;
}

void CRecordTableView::ChooseKeys(const std::set<int>& keys)
{
    if (keys == ChosenKeys()) return;
    auto* const model = const_cast<QAbstractItemModel*>(selectionModel()->model());
    QItemSelection rows;
    int first = -1;
    for (const int key : keys) {
        const long row = m_grid.RowOf(key);
        if (row < 0) continue;
        if (first < 0) first = static_cast<int>(row);
        rows.select(model->index(static_cast<int>(row), 0),
                    model->index(static_cast<int>(row), model->columnCount() - 1));
    }
    selectionModel()->select(rows, QItemSelectionModel::ClearAndSelect);
    if (first < 0) return;
    selectionModel()->setCurrentIndex(model->index(first, std::max(currentIndex().column(), 0)),
                                      QItemSelectionModel::NoUpdate);
    scrollTo(currentIndex());
}

QString CRecordTableView::ChosenTextWithHeads() const
{
    std::set<int> columns;
    for (const QItemSelectionRange& range : selectionModel()->selection())
        for (int c = range.left(); c <= range.right(); ++c)
            columns.insert(c);
    QStringList heads;
    for (const int c : columns)
        heads << QString::fromStdString(m_grid.ColumnHead(static_cast<std::size_t>(c)));
    return heads.join('\t') + '\n' + ChosenText();
}

void CRecordTableView::keyPressEvent(QKeyEvent* event)
{
    const bool heads = event->key() == Qt::Key_C &&
                       event->modifiers() == (Qt::ControlModifier | Qt::ShiftModifier);
    if (heads)
        QGuiApplication::clipboard()->setText(ChosenTextWithHeads());
    else
        CGridView::keyPressEvent(event);
}

/// At its first or last cell the table is left.
bool CRecordTableView::focusNextPrevChild(bool next)
{
    const QModelIndex now = currentIndex();
    const auto* const model = selectionModel()->model();
    const bool last =
        now.row() == model->rowCount() - 1 && now.column() == model->columnCount() - 1;
    const bool first = now.row() == 0 && now.column() == 0;
    if (!now.isValid() || (next && last) || (!next && first))
        return QAbstractScrollArea::focusNextPrevChild(next);
    return CGridView::focusNextPrevChild(next);
}
