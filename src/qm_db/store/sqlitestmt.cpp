#include "qm_db/store/sqlitestmt.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitedb.h"

#include <bit>
#include <limits>
#include <sqlite3.h>

namespace {

int SizeOf(std::size_t size)
{
    if (size > static_cast<std::size_t>(std::numeric_limits<int>::max()))
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_TOO_LARGE");
    return static_cast<int>(size);
}

} // namespace

CSqliteStmt::CSqliteStmt(const CSqliteDb& db, const std::string& sql) : m_db(db)
{
    Check(sqlite3_prepare_v2(db.Handle(), sql.c_str(), SizeOf(sql.size() + 1), &m_stmt, nullptr));
}

CSqliteStmt::~CSqliteStmt()
{
    sqlite3_finalize(m_stmt);
}

void CSqliteStmt::Check(int code) const
{
    if (code != SQLITE_OK) m_db.ThrowLast(code);
}

void CSqliteStmt::Bind(int at, std::int64_t value)
{
    Check(sqlite3_bind_int64(m_stmt, at, value));
}

void CSqliteStmt::Bind(int at, double value)
{
    Check(sqlite3_bind_double(m_stmt, at, value));
}

void CSqliteStmt::Bind(int at, std::string_view value)
{
    const char* const text = value.empty() ? "" : value.data(); // a null pointer would bind NULL
    Check(sqlite3_bind_text(m_stmt, at, text, SizeOf(value.size()), SQLITE_TRANSIENT));
}

void CSqliteStmt::Bind(int at, std::span<const std::byte> value)
{
    if (value.empty())
        Check(sqlite3_bind_zeroblob(m_stmt, at, 0));
    else
        Check(sqlite3_bind_blob(m_stmt, at, value.data(), SizeOf(value.size()), SQLITE_STATIC));
}

void CSqliteStmt::BindNull(int at)
{
    Check(sqlite3_bind_null(m_stmt, at));
}

bool CSqliteStmt::Step()
{
    m_db.StartStep();
    const int code = sqlite3_step(m_stmt);
    if (code != SQLITE_ROW && code != SQLITE_DONE) m_db.ThrowLast(code);
    return code == SQLITE_ROW;
}

void CSqliteStmt::Run()
{
    while (Step()) {
    }
    Reset();
}

void CSqliteStmt::Reset()
{
    Check(sqlite3_reset(m_stmt));
}

int CSqliteStmt::ColumnCount() const
{
    return sqlite3_column_count(m_stmt);
}

std::string_view CSqliteStmt::ColumnName(int column) const
{
    return sqlite3_column_name(m_stmt, column);
}

CELL_TYPE CSqliteStmt::Type(int column) const
{
    switch (sqlite3_column_type(m_stmt, column)) {
    case SQLITE_INTEGER:
        return CELL_TYPE::Integer;
    case SQLITE_FLOAT:
        return CELL_TYPE::Real;
    case SQLITE_TEXT:
        return CELL_TYPE::Text;
    case SQLITE_BLOB:
        return CELL_TYPE::Blob;
    default:
        return CELL_TYPE::Null;
    }
}

std::int64_t CSqliteStmt::Int(int column) const
{
    return sqlite3_column_int64(m_stmt, column);
}

double CSqliteStmt::Real(int column) const
{
    return sqlite3_column_double(m_stmt, column);
}

std::string_view CSqliteStmt::Text(int column) const
{
    const auto* const text = reinterpret_cast<const char*>(sqlite3_column_text(m_stmt, column));
    if (!text) return {};
    return {text, static_cast<std::size_t>(sqlite3_column_bytes(m_stmt, column))};
}

std::span<const std::byte> CSqliteStmt::Blob(int column) const
{
    const auto* const bytes = static_cast<const std::byte*>(sqlite3_column_blob(m_stmt, column));
    if (!bytes) return {};
    return {bytes, static_cast<std::size_t>(sqlite3_column_bytes(m_stmt, column))};
}

void CSqliteStmt::AddRowTo(CChecksum& sum) const
{
    for (int column = 0; column < ColumnCount(); ++column) {
        const CELL_TYPE type = Type(column);
        sum.AddWord(static_cast<std::uint64_t>(type));
        if (type == CELL_TYPE::Integer)
            sum.AddWord(static_cast<std::uint64_t>(Int(column)));
        else if (type == CELL_TYPE::Real)
            sum.AddWord(std::bit_cast<std::uint64_t>(Real(column)));
        else if (type == CELL_TYPE::Text)
            sum.AddBytes(std::as_bytes(std::span(Text(column))));
        else if (type == CELL_TYPE::Blob)
            sum.AddBytes(Blob(column));
    }
}
