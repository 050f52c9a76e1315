// One row of a record table, between a record and SQLite.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

class CChecksum;
class CSqliteDb;

/// Column names and values of one row; a column that is not named is NULL.
class CRecordRow {
public:
    using Cell = std::variant<std::monostate, std::int64_t, double, std::string>;

    /// A non-finite number is refused (BadInput) with table, key and column.
    CRecordRow(std::string table, std::int64_t key) : m_table(std::move(table)), m_key(key) {}

    std::int64_t Key() const { return m_key; }
    const std::string& Table() const { return m_table; }

    void Put(const std::string& column, Cell value);
    /// NULL for a column that is not there.
    const Cell& Get(const std::string& column) const;
    /// Whether a column whose name begins so is not NULL.
    bool HasAny(std::string_view prefix) const;
    /// Throws "damaged", naming table, key and column.
    [[noreturn]] void ThrowBadCell(const std::string& column) const;

    void Insert(const CSqliteDb& db) const;
    /// Every row of a table in the order of keys; adds the rows to the sum.
    static std::vector<CRecordRow> ReadAll(const CSqliteDb& db, const std::string& table,
                                           CChecksum& sum);

private:
    std::string m_table;
    std::int64_t m_key;
    std::vector<std::pair<std::string, Cell>> m_cells;
};
