#include "qm_db/store/recordcodecrow.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr const char* kKey = "key";
constexpr const char* kZeros = "negative_zeros";

/// Position of a column in its table: the bit of negative_zeros.
int ColumnBit(const CSqliteStmt& columns, const std::string& name)
{
    for (int column = 0; column < columns.ColumnCount(); ++column) {
        if (columns.ColumnName(column) == name) return column;
    }
    ThrowDamaged(name); // a column that the schema lacks
}

CRecordRow::Cell CellOf(const CSqliteStmt& row, int column, std::int64_t zeros)
{
    switch (row.Type(column)) {
    case CELL_TYPE::Integer:
        return row.Int(column);
    case CELL_TYPE::Real:
        return (zeros >> column) & 1 ? -0.0 : row.Real(column);
    case CELL_TYPE::Text:
        return std::string(row.Text(column));
    default:
        return std::monostate{};
    }
}

} // namespace

void CRecordRow::Put(const std::string& column, Cell value)
{
    const double* const number = std::get_if<double>(&value);
    if (number && !std::isfinite(*number)) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NOT_FINITE",
                          m_table + ' ' + std::to_string(m_key) + ' ' + column);
    }
    m_cells.emplace_back(column, std::move(value));
}

const CRecordRow::Cell& CRecordRow::Get(const std::string& column) const
{
    static const Cell null;
    const auto it = std::find_if(m_cells.begin(), m_cells.end(),
                                 [&](const auto& cell) { return cell.first == column; });
    return it == m_cells.end() ? null : it->second;
}

bool CRecordRow::HasAny(std::string_view prefix) const
{
    return std::any_of(m_cells.begin(), m_cells.end(), [&](const auto& cell) {
        return cell.first.starts_with(prefix) && cell.second.index() != 0;
    });
}

void CRecordRow::ThrowBadCell(const std::string& column) const
{
    ThrowDamaged(m_table + ' ' + std::to_string(m_key) + ' ' + column);
}

void CRecordRow::Insert(const CSqliteDb& db) const
{
    const CSqliteStmt columns(db, "SELECT * FROM " + m_table);
    std::string names = std::string(kKey) + ", " + kZeros;
    std::string places = "?1, ?2";
    std::int64_t zeros = 0;
    for (std::size_t i = 0; i < m_cells.size(); ++i) {
        const auto& [name, cell] = m_cells[i];
        names += ", " + name;
        places += ", ?" + std::to_string(i + 3);
        const double* const number = std::get_if<double>(&cell);
        if (number && *number == 0.0 && std::signbit(*number))
            zeros |= std::int64_t{1} << ColumnBit(columns, name);
    }
    CSqliteStmt insert(db, "INSERT INTO " + m_table + '(' + names + ") VALUES(" + places + ')');
    insert.Bind(1, m_key);
    insert.Bind(2, zeros);
    for (std::size_t i = 0; i < m_cells.size(); ++i) {
        const int at = static_cast<int>(i) + 3;
        const Cell& cell = m_cells[i].second;
        if (const auto* whole = std::get_if<std::int64_t>(&cell))
            insert.Bind(at, *whole);
        else if (const auto* number = std::get_if<double>(&cell))
            insert.Bind(at, *number);
        else if (const auto* text = std::get_if<std::string>(&cell))
            insert.Bind(at, std::string_view(*text));
        else
            insert.BindNull(at);
    }
    insert.Run();
}

std::vector<CRecordRow> CRecordRow::ReadAll(const CSqliteDb& db, const std::string& table,
                                            CChecksum& sum)
{
    std::vector<CRecordRow> all;
    CSqliteStmt rows(db, "SELECT * FROM " + table + " ORDER BY key");
    const int keyColumn = ColumnBit(rows, kKey);
    const int zerosColumn = ColumnBit(rows, kZeros);
    while (rows.Step()) {
        rows.AddRowTo(sum);
        CRecordRow& row = all.emplace_back(table, rows.Int(keyColumn));
        const std::int64_t zeros = rows.Int(zerosColumn);
        for (int column = 0; column < rows.ColumnCount(); ++column) {
            if (column != keyColumn && column != zerosColumn)
                row.m_cells.emplace_back(rows.ColumnName(column), CellOf(rows, column, zeros));
        }
    }
    return all;
}
