#include "qm_db/store/modelreader.h"

#include "qm_base/msgfunction.h"
#include "qm_db/file/checksum.h"
#include "qm_db/file/filehandle.h"
#include "qm_db/file/storefault.h"
#include "qm_db/records/modelfault.h"
#include "qm_db/store/recordcodec.h"
#include "qm_db/store/resultblocks.h"
#include "qm_db/store/resultblocksource.h"
#include "qm_db/store/runblocksource.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"
#include "qm_db/store/sqlitetransaction.h"
#include "qm_db/store/stagedblocks.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace {

using zql::lib::MMSGFunction;

constexpr std::int64_t kCheckAllUpTo = std::int64_t{16} << 20; // bytes
constexpr const char* kSchemaTable = "sqlite_schema";          // also the name of its checksum

/// The part of the SQLite file header that we look at; see "The Database File Format" of SQLite.
struct T_HEADER {
    std::int64_t fileSize = 0;
    int version = 0; // ours
};

using HeaderBytes = std::array<unsigned char, 100>;

std::uint32_t BigEndian(const HeaderBytes& header, std::size_t at, std::size_t bytes)
{
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < bytes; ++i)
        value = value << 8 | header[at + i];
    return value;
}

/// Opens a regular file and reads the header as far as there is one; returns the file's size.
std::int64_t ReadHeaderBytes(const std::string& path, HeaderBytes& header, std::size_t& count)
{
    const CFileHandle file = CFileHandle::OpenRegular(path, "IDS_QM_DB_FILE_CANT_OPEN");
    const ssize_t got = ::pread(file.Get(), header.data(), header.size(), 0);
    if (got < 0) ThrowSystem("IDS_QM_DB_FILE_CANT_READ", errno);
    count = static_cast<std::size_t>(got);
    return file.Status().st_size;
}

[[noreturn]] void ThrowTruncated(std::int64_t size, std::int64_t expected)
{
    throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_TRUNCATED", std::to_string(size),
                      std::to_string(expected));
}

/// SQLite itself would take an empty file for an empty database and a cut one for a damaged one.
T_HEADER CheckHeader(const std::string& path, const T_SCHEMA& schema)
{
    static constexpr std::string_view kMagic{"SQLite format 3\0", 16};
    HeaderBytes header{};
    std::size_t count = 0;
    const std::int64_t size = ReadHeaderBytes(path, header, count);
    if (size == 0) throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_EMPTY");
    if (std::memcmp(header.data(), kMagic.data(), std::min(count, kMagic.size())) != 0)
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_FOREIGN");
    if (count < header.size()) ThrowTruncated(size, static_cast<std::int64_t>(header.size()));
    if (BigEndian(header, 68, 4) != kModelApplicationId)
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_OTHER_APP");

    const auto version = static_cast<int>(BigEndian(header, 60, 4));
    if (version > schema.version) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NEWER", std::to_string(version),
                          std::to_string(schema.version));
    }
    if (!CanMigrate(version, schema)) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_TOO_OLD", std::to_string(version),
                          std::to_string(schema.version));
    }
    const std::uint32_t pageSize = BigEndian(header, 16, 2) == 1 ? 65536 : BigEndian(header, 16, 2);
    const std::int64_t expected = std::int64_t{pageSize} * BigEndian(header, 28, 4);
    if (size < expected) ThrowTruncated(size, expected);
    const bool rollbackFormat = header[18] == 1 && header[19] == 1; // 2 would be a WAL file
    if (size != expected || !rollbackFormat || BigEndian(header, 24, 4) != BigEndian(header, 92, 4))
        ThrowDamaged(MMSGFunction::GetValue("IDS_QM_DB_DAMAGE_HEADER"));
    return {size, version};
}

void CheckIntegrity(const CSqliteDb& db, bool whole)
{
    const auto check = [&](const std::string& pragma) {
        const std::string answer = db.QueryText("PRAGMA " + pragma);
        if (answer != "ok") ThrowDamaged(answer);
    };
    if (whole) return check("integrity_check(1)"); // stop at the first finding
    // There are no indexes, so the quick check leaves out little; the checksums come after it.
    check(std::string("quick_check(") + kSchemaTable + ')');
    check(std::string("quick_check(") + kSumTable + ')');
    for (const char* const table : kModelTables)
        check(std::string("quick_check(") + table + ')');
}

T_TABLE_SUMS ReadChecksums(const CSqliteDb& db)
{
    T_TABLE_SUMS sums;
    CSqliteStmt rows(db, std::string("SELECT name, value FROM ") + kSumTable);
    while (rows.Step())
        sums[std::string(rows.Text(0))] = static_cast<std::uint64_t>(rows.Int(1));
    return sums;
}

std::uint64_t SumOfRows(const CSqliteDb& db, const std::string& select)
{
    CChecksum sum;
    CSqliteStmt rows(db, select);
    while (rows.Step())
        rows.AddRowTo(sum);
    return sum.Value();
}

/// Sum of the rows of one table as `name` in "checksums" has it.
std::uint64_t SumOfTable(const CSqliteDb& db, const std::string& name)
{
    if (name == kSchemaTable)
        return SumOfRows(db, "SELECT type, name, tbl_name, sql FROM sqlite_schema ORDER BY rowid");
    if (name == kBlockTable) { // without the data: each block has its own sum
        return SumOfRows(db, "SELECT pushover, part, chunk, step, count, width, byte_order, "
                             "checksum FROM result_blocks ORDER BY pushover, part, chunk, step");
    }
    const char* const order = name == "arrays" ? " ORDER BY owner, key, name" : " ORDER BY key";
    return SumOfRows(db, "SELECT * FROM " + name + order);
}

void CompareSum(const T_TABLE_SUMS& stored, const std::string& table, std::uint64_t found)
{
    const auto it = stored.find(table);
    if (it == stored.end() || it->second != found)
        ThrowDamaged(MMSGFunction::Format("IDS_QM_DB_DAMAGE_TABLE", {table}));
}

/// An older file is checked by the list of its own tables, which CheckSchema() knows, before
/// anything is changed.
CSqliteDb MigratedCopy(const CSqliteDb& db, int version, const T_SCHEMA& schema)
{
    const T_TABLE_SUMS stored = ReadChecksums(db);
    CompareSum(stored, kSchemaTable, SumOfTable(db, kSchemaTable));
    CSqliteStmt tables(db, "SELECT name FROM sqlite_schema ORDER BY rowid");
    while (tables.Step()) {
        const std::string table(tables.Text(0));
        if (table != kSumTable) CompareSum(stored, table, SumOfTable(db, table));
    }
    CSqliteDb copy = CSqliteDb::MemoryCopyOf(db);
    Migrate(copy, version, schema);
    return copy;
}

/// Heads can't speak of more numbers than the file has bytes for.
void CheckSizes(std::int64_t fileSize, const std::vector<T_RESULT_HEAD>& heads,
                const std::vector<T_STATIC_HEAD>& staticHeads, const std::vector<T_RUN_ROW>& runs)
{
    double bytes = 0.0;
    for (const T_RESULT_HEAD& head : heads)
        bytes += BytesOf(head);
    for (const T_STATIC_HEAD& head : staticHeads)
        bytes += BytesOf(head);
    for (const T_RUN_ROW& run : runs)
        bytes += BytesOf(run);
    if (bytes > static_cast<double>(fileSize)) ThrowDamaged(kBlockTable);
}

} // namespace

T_MODEL_CONTENT ReadModelFile(const std::string& path, const T_SCHEMA& schema, CHECK_DEPTH depth)
{
    const T_HEADER header = CheckHeader(path, schema);
    const bool older = header.version < schema.version;
    const bool whole = depth == CHECK_DEPTH::Whole || older || header.fileSize <= kCheckAllUpTo;

    auto db = std::make_shared<const CSqliteDb>(CSqliteDb::OpenReadOnly(path, header.fileSize));
    CheckSchema(*db, header.version); // before any statement that a foreign schema could extend
    CheckIntegrity(*db, whole);
    if (older) db = std::make_shared<const CSqliteDb>(MigratedCopy(*db, header.version, schema));

    T_MODEL_CONTENT content;
    T_TABLE_SUMS found;
    content.model = ReadModel(*db, found);
    const std::vector<T_RESULT_HEAD> heads = ReadResultHeads(*db, found);
    const std::vector<T_STATIC_HEAD> staticHeads = ReadStaticHeads(*db, found);
    const std::vector<T_STAGED_HEAD> stagedHeads = ReadStagedHeads(*db, found);
    const std::vector<T_RUN_ROW> runs = ReadRunRows(*db, found);
    if (!older) {
        const T_TABLE_SUMS stored = ReadChecksums(*db);
        found[kSchemaTable] = SumOfTable(*db, kSchemaTable);
        if (whole) found[kBlockTable] = SumOfTable(*db, kBlockTable);
        for (const auto& [table, sum] : found)
            CompareSum(stored, table, sum);
    }
    if (const std::string fault = ModelFault(content.model); !fault.empty()) ThrowDamaged(fault);
    std::vector<T_STATIC_HEAD> all = staticHeads;
    for (const T_STAGED_HEAD& staged : stagedHeads)
        all.push_back(staged.head);
    CheckSizes(header.fileSize, heads, all, runs);
    if (whole) {
        CheckBlocks(*db, heads);
        CheckStaticBlocks(*db, all);
        CheckRunBlocks(*db, runs);
    }
    for (const T_RESULT_HEAD& head : heads)
        content.results[head.pushover] = std::make_shared<CBlockPushResult>(db, path, head);
    for (const T_RUN_ROW& run : runs) {
        auto source = std::make_shared<CBlockPushRun>(db, path, run);
        if (run.head.turn == 0)
            content.results[run.pushover] = std::move(source);
        else
            content.turnedResults[{run.pushover, run.head.turn}] = std::move(source);
    }
    for (const T_STATIC_HEAD& head : staticHeads)
        content.staticResults[head.loadCase] = std::make_shared<CBlockStaticResult>(db, path, head);
    if (!stagedHeads.empty())
        content.stagedResult = std::make_shared<CBlockStagedResult>(db, path, stagedHeads);
    return content;
}

std::uint64_t StampOfModelFile(const std::string& path)
{
    const auto header = CheckHeader(path, CurrentSchema());
    return SumOfRows(CSqliteDb::OpenReadOnly(path, header.fileSize),
                     std::string("SELECT name, value FROM ") + kSumTable + " ORDER BY name");
}

void WriteChecksums(const CSqliteDb& db)
{
    CSqliteStmt insert(db, std::string("INSERT OR REPLACE INTO ") + kSumTable +
                               "(name, value) VALUES(?1, ?2)");
    const auto write = [&](const std::string& table) {
        insert.Bind(1, std::string_view(table));
        insert.Bind(2, static_cast<std::int64_t>(SumOfTable(db, table)));
        insert.Run();
    };
    write(kSchemaTable);
    write(kBlockTable);
    for (const char* const table : kModelTables)
        write(table);
}

void WriteModelFile(const std::string& path, const T_MODEL_CONTENT& content)
{
    // What would not open again is not written.
    if (std::string fault = ModelFault(content.model); !fault.empty())
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_BAD_RECORD", std::move(fault));
    const CSqliteDb db = CSqliteDb::OpenForWriting(path);
    CSqliteTransaction transaction(db);
    CreateSchema(db);
    WriteModel(db, content.model);
    WriteResults(db, content.results);
    WriteRuns(db, content.model, content.results, content.turnedResults);
    WriteStaticResults(db, content.model, content.staticResults);
    if (content.stagedResult && !content.model.stages.empty())
        WriteStagedResults(db, *content.stagedResult);
    WriteChecksums(db);
    transaction.Commit();
}
