// One prepared SQLite statement. Failures are thrown as CStoreFault.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

struct sqlite3_stmt;
class CChecksum;
class CSqliteDb;

enum class CELL_TYPE { Integer, Real, Text, Blob, Null };

/// Parameters count from 1, columns from 0, as SQLite has it. The connection must outlive it.
class CSqliteStmt {
public:
    CSqliteStmt(const CSqliteDb& db, const std::string& sql);
    CSqliteStmt(const CSqliteStmt&) = delete;
    CSqliteStmt& operator=(const CSqliteStmt&) = delete;
    ~CSqliteStmt();

    void Bind(int at, std::int64_t value);
    void Bind(int at, double value);
    void Bind(int at, std::string_view value);
    /// The bytes must stay as they are until the statement has been reset.
    void Bind(int at, std::span<const std::byte> value);
    void BindNull(int at);

    /// True with a row, false at the end.
    bool Step();
    /// Step to the end and reset.
    void Run();
    /// Ready to run again; the parameters stay bound.
    void Reset();

    int ColumnCount() const;
    std::string_view ColumnName(int column) const;
    CELL_TYPE Type(int column) const;
    std::int64_t Int(int column) const;
    double Real(int column) const;
    /// Views of the row: gone with the next Step or Reset.
    std::string_view Text(int column) const;
    std::span<const std::byte> Blob(int column) const;

    /// Adds type and value of every column of the row.
    void AddRowTo(CChecksum& sum) const;

private:
    void Check(int code) const;

    const CSqliteDb& m_db;
    sqlite3_stmt* m_stmt = nullptr; // owned
};
