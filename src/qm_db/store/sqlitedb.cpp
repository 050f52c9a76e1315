#include "qm_db/store/sqlitedb.h"

#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitestmt.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <new>
#include <sqlite3.h>
#include <utility>

namespace {

/// "file:///a%20b.qmdb?<options>"; every byte with a meaning in an URI is escaped.
std::string UriOf(const std::string& path, const char* options)
{
    static constexpr char kHex[] = "0123456789ABCDEF";
    std::string uri = "file://";
    for (const char letter : std::filesystem::absolute(path).string()) {
        const auto code = static_cast<unsigned char>(letter);
        const bool plain = (letter >= 'a' && letter <= 'z') || (letter >= 'A' && letter <= 'Z') ||
                           (letter >= '0' && letter <= '9') || std::strchr("/._-", letter);
        if (plain)
            uri += letter;
        else
            (uri += '%').append({kHex[code >> 4], kHex[code & 15]});
    }
    return uri + options;
}

constexpr int kStepsPerCall = 1000;            // of SQLite's machine, between two calls
constexpr std::int64_t kLeastCalls = 1000;     // a million steps for any file
constexpr std::int64_t kBytesPerCall = 100;    // ten steps for each byte of the file
constexpr std::int64_t kLeastLength = 1 << 20; // bytes of a value or row, whatever the file's size
constexpr std::int64_t kMostLength = 1000000000;

struct T_LIMIT {
    int id, value;
};
// What our own statements need, with room to spare.
constexpr T_LIMIT kLimits[] = {
    {SQLITE_LIMIT_SQL_LENGTH, 100000},   {SQLITE_LIMIT_COLUMN, 100},
    {SQLITE_LIMIT_EXPR_DEPTH, 100},      {SQLITE_LIMIT_COMPOUND_SELECT, 10},
    {SQLITE_LIMIT_VDBE_OP, 100000},      {SQLITE_LIMIT_FUNCTION_ARG, 16},
    {SQLITE_LIMIT_ATTACHED, 0},          {SQLITE_LIMIT_LIKE_PATTERN_LENGTH, 100},
    {SQLITE_LIMIT_VARIABLE_NUMBER, 100}, {SQLITE_LIMIT_TRIGGER_DEPTH, 1},
    {SQLITE_LIMIT_WORKER_THREADS, 0}};

/// Error number behind an input or output error, or 0. SQLite does not always keep it; of the
/// process's own number only what can come from such an error is believed.
int ReasonOf(sqlite3* db, int lastErrno)
{
    const int kept = sqlite3_system_errno(db);
    if (kept != 0) return kept;
    return lastErrno == EFBIG || lastErrno == EDQUOT || lastErrno == EIO ? lastErrno : 0;
}

} // namespace

CSqliteDb::CSqliteDb(const std::string& uri, int flags, bool writes) : m_writes(writes)
{
    const int code = sqlite3_open_v2(uri.c_str(), &m_db, flags | SQLITE_OPEN_URI, nullptr);
    if (code != SQLITE_OK) {
        const int errorNumber = m_db ? sqlite3_system_errno(m_db) : 0;
        const std::string text = sqlite3_errstr(code);
        sqlite3_close_v2(std::exchange(m_db, nullptr));
        const char* const key = writes ? "IDS_QM_DB_FILE_CANT_WRITE" : "IDS_QM_DB_FILE_CANT_OPEN";
        if (errorNumber != 0) ThrowSystem(key, errorNumber);
        throw CStoreFault(FILE_FAULT::NoAccess, key, text);
    }
    sqlite3_extended_result_codes(m_db, 1);
    // Guards against what a crafted file may ask for; it would also forbid to write unjournalled.
    if (!writes) sqlite3_db_config(m_db, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(m_db, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
}

CSqliteDb::CSqliteDb(CSqliteDb&& other) noexcept
    : m_db(std::exchange(other.m_db, nullptr)), m_writes(other.m_writes), m_bytes(other.m_bytes),
      m_work(std::move(other.m_work))
{
}

int CSqliteDb::CountWork(void* work)
{
    auto& count = *static_cast<T_WORK*>(work);
    return ++count.calls > count.most ? 1 : 0;
}

void CSqliteDb::StartStep() const
{
    if (m_work) m_work->calls = 0;
}

void CSqliteDb::Distrust(std::int64_t bytes)
{
    for (const T_LIMIT& limit : kLimits)
        sqlite3_limit(m_db, limit.id, limit.value);
    sqlite3_limit(m_db, SQLITE_LIMIT_LENGTH,
                  static_cast<int>(std::clamp(bytes, kLeastLength, kMostLength)));
    m_bytes = bytes;
    m_work = std::make_unique<T_WORK>(T_WORK{0, kLeastCalls + bytes / kBytesPerCall});
    sqlite3_progress_handler(m_db, kStepsPerCall, CountWork, m_work.get());
    // Nothing goes to a temporary file, and no function of a schema's runs.
    Exec("PRAGMA temp_store = MEMORY; PRAGMA trusted_schema = OFF; PRAGMA mmap_size = 0");
}

CSqliteDb::~CSqliteDb()
{
    sqlite3_close_v2(m_db);
}

CSqliteDb CSqliteDb::OpenReadOnly(const std::string& path, std::int64_t bytes)
{
    CSqliteDb db(UriOf(path, "?mode=ro&immutable=1"), SQLITE_OPEN_READONLY, false);
    db.Distrust(bytes);
    // Everything is read once and in order: a large page cache would only cost memory.
    db.Exec("PRAGMA cell_size_check = ON; PRAGMA cache_size = 64");
    return db;
}

CSqliteDb CSqliteDb::OpenForWriting(const std::string& path)
{
    CSqliteDb db(UriOf(path, "?mode=rw&nolock=1"), SQLITE_OPEN_READWRITE, true);
    // A result block of 512 values fits a leaf's share and one overflow page of 4096 bytes.
    db.Exec("PRAGMA page_size = 4096; PRAGMA encoding = 'UTF-8';"
            "PRAGMA journal_mode = OFF; PRAGMA synchronous = OFF; PRAGMA foreign_keys = OFF");
    return db;
}

CSqliteDb CSqliteDb::MemoryCopyOf(const CSqliteDb& source)
{
    CSqliteDb copy(":memory:", SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, false);
    sqlite3_backup* const backup = sqlite3_backup_init(copy.m_db, "main", source.m_db, "main");
    if (!backup) copy.ThrowLast(sqlite3_extended_errcode(copy.m_db));
    sqlite3_backup_step(backup, -1);
    const int code = sqlite3_backup_finish(backup);
    if (code != SQLITE_OK) copy.ThrowLast(code);
    copy.Distrust(source.m_bytes);
    return copy;
}

void CSqliteDb::Exec(const std::string& sql) const
{
    StartStep();
    const int code = sqlite3_exec(m_db, sql.c_str(), nullptr, nullptr, nullptr);
    if (code != SQLITE_OK) ThrowLast(code);
}

std::string CSqliteDb::QueryText(const std::string& sql) const
{
    CSqliteStmt stmt(*this, sql);
    return stmt.Step() ? std::string(stmt.Text(0)) : std::string();
}

void CSqliteDb::ThrowLast(int code) const
{
    const int lastErrno = errno;
    const int kind = code & 0xff; // the extended code without its refinement
    if (kind == SQLITE_NOMEM) throw std::bad_alloc();
    const std::string text = sqlite3_errmsg(m_db);
    const bool accessFault = kind == SQLITE_IOERR || kind == SQLITE_FULL ||
                             kind == SQLITE_CANTOPEN || kind == SQLITE_PERM ||
                             kind == SQLITE_READONLY || kind == SQLITE_BUSY;
    if (!accessFault && !m_writes) ThrowDamaged(text);
    const char* const key = m_writes ? "IDS_QM_DB_FILE_CANT_WRITE" : "IDS_QM_DB_FILE_CANT_READ";
    const int errorNumber = ReasonOf(m_db, lastErrno);
    if (kind == SQLITE_IOERR && errorNumber != 0) ThrowSystem(key, errorNumber);
    throw CStoreFault(FILE_FAULT::NoAccess, key, text);
}
