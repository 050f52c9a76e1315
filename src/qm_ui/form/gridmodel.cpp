#include "qm_ui/form/gridmodel.h"

#include "qm_ui/form/localnumber.h"
#include "qm_ui/shown/showndecimals.h"

#include <QColor>

namespace {

// Translucent, so that they suit light and dark tables.
constexpr QRgb kMarked = 0x40ff3b30U, kNoticed = 0x48ffb300U;

std::size_t Size(int n)
{
    return static_cast<std::size_t>(n);
}

} // namespace

CGridModel::CGridModel(T_GRID_BINDING binding, ChangedFn changed, QObject* parent)
    : QAbstractTableModel(parent), m_binding(std::move(binding)), m_changed(std::move(changed)),
      m_rows(static_cast<int>(m_binding.rows()))
{
}

const T_GRID_COLUMN& CGridModel::Column(int column) const
{
    return m_binding.columns.at(Size(column));
}

void CGridModel::Refresh()
{
    const int rows = static_cast<int>(m_binding.rows());
    if (rows > m_rows) {
        beginInsertRows({}, m_rows, rows - 1);
        m_rows = rows;
        endInsertRows();
    } else if (rows < m_rows) {
        beginRemoveRows({}, rows, m_rows - 1);
        m_rows = rows;
        endRemoveRows();
    }
    const int last = columnCount() - 1;
    if (rows > 0 && last >= 0) emit dataChanged(index(0, 0), index(rows - 1, last));
    if (rows > 0) emit headerDataChanged(Qt::Vertical, 0, rows - 1);
    if (last >= 0) emit headerDataChanged(Qt::Horizontal, 0, last);
}

int CGridModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : m_rows;
}

int CGridModel::columnCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : static_cast<int>(m_binding.columns.size());
}

QString CGridModel::Text(const QModelIndex& at) const
{
    const std::string text = m_binding.text(Size(at.row()), Size(at.column()));
    return Column(at.column()).kind == CELL_KIND::Number ? LocalNumberText(text)
                                                         : QString::fromStdString(text);
}

/// Numbers with the decimals of their quantity; editing and copying take Text.
QString CGridModel::ShownText(const QModelIndex& at) const
{
    const T_GRID_COLUMN& column = Column(at.column());
    if (column.kind != CELL_KIND::Number) return Text(at);
    return LocalNumberText(
        ShownNumber(m_binding.text(Size(at.row()), Size(at.column())), column.head()));
}

QVariant CGridModel::data(const QModelIndex& at, int role) const
{
    if (!at.isValid() || at.row() >= m_rows) return {};
    const CELL_KIND kind = Column(at.column()).kind;
    const bool flag = kind == CELL_KIND::Flag;
    switch (role) {
    case Qt::DisplayRole:
        return flag ? QVariant() : QVariant(ShownText(at));
    case Qt::EditRole:
        return flag ? QVariant() : QVariant(Text(at));
    case Qt::CheckStateRole:
        return flag ? QVariant(Text(at) == QLatin1String("1") ? Qt::Checked : Qt::Unchecked)
                    : QVariant();
    case Qt::TextAlignmentRole:
        return kind == CELL_KIND::Number ? QVariant(Qt::AlignRight | Qt::AlignVCenter) : QVariant();
    case Qt::ToolTipRole:
    case Qt::BackgroundRole: {
        const std::string mark =
            m_binding.mark ? m_binding.mark(Size(at.row()), Size(at.column())) : std::string();
        if (role == Qt::ToolTipRole) {
            constexpr qsizetype kLong = 40; // letters: a column may be too narrow for it
            const QString text = at.data(Qt::DisplayRole).toString();
            if (mark.empty()) return text.size() > kLong ? QVariant(text) : QVariant();
            return QString::fromStdString(mark);
        }
        const CELL_TONE tone =
            m_binding.tone ? m_binding.tone(Size(at.row()), Size(at.column())) : CELL_TONE::Plain;
        if (!mark.empty() || tone == CELL_TONE::Fault) return QColor::fromRgba(kMarked);
        return tone == CELL_TONE::Notice ? QVariant(QColor::fromRgba(kNoticed)) : QVariant();
    }
    default:
        return {};
    }
}

QVariant CGridModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (role != Qt::DisplayRole) return {};
    if (orientation == Qt::Horizontal)
        return section < columnCount() ? QString::fromStdString(Column(section).head())
                                       : QVariant();
    if (!m_binding.rowHead) return section + 1;
    return section < m_rows ? QString::fromStdString(m_binding.rowHead(Size(section))) : QVariant();
}

Qt::ItemFlags CGridModel::flags(const QModelIndex& at) const
{
    Qt::ItemFlags flags = QAbstractTableModel::flags(at);
    if (!at.isValid() || !Column(at.column()).edit) return flags;
    return flags | (Column(at.column()).kind == CELL_KIND::Flag ? Qt::ItemIsUserCheckable
                                                                : Qt::ItemIsEditable);
}

int CGridModel::Take(int row, int column, const QString& typed)
{
    if (row >= m_rows || column >= columnCount() || !m_binding.set || !Column(column).edit)
        return 0;
    const std::string text =
        Column(column).kind == CELL_KIND::Number ? PlainNumberText(typed) : typed.toStdString();
    return m_binding.set(Size(row), Size(column), text);
}

bool CGridModel::setData(const QModelIndex& at, const QVariant& value, int role)
{
    if (!at.isValid() || (role != Qt::EditRole && role != Qt::CheckStateRole)) return false;
    const QString typed = role == Qt::CheckStateRole
                              ? QString(value.toInt() == Qt::Checked ? "1" : "0")
                              : value.toString();
    // A cell that was opened and not changed keeps the digits that it does not show.
    if (role == Qt::EditRole && typed == Text(at)) return true;
    if (!Take(at.row(), at.column(), typed)) return false;
    m_changed();
    return true;
}
