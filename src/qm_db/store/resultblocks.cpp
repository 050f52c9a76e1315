#include "qm_db/store/resultblocks.h"

#include "qm_base/msgfunction.h"
#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modelschema.h"
#include "qm_db/store/packednumbers.h"
#include "qm_db/store/recordcodecrow.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace {

using zql::lib::MMSGFunction;

// By BLOCK_PART: what it is called, and the bytes of one number.
struct T_PART {
    const char* nameKey;
    int width;
};
constexpr std::array<T_PART, 17> kParts{{{"IDS_QM_DB_PART_LOAD_FACTORS", 8},
                                         {"IDS_QM_DB_PART_BASE_REACTIONS", 8},
                                         {"IDS_QM_DB_PART_NODE_IDS", 4},
                                         {"IDS_QM_DB_PART_DISPLACEMENTS", 8},
                                         {"IDS_QM_DB_PART_NODE_IDS", 4},
                                         {"IDS_QM_DB_PART_ELEMENT_IDS", 4},
                                         {"IDS_QM_DB_PART_DISPLACEMENTS", 8},
                                         {"IDS_QM_DB_PART_REACTIONS", 8},
                                         {"IDS_QM_DB_PART_FORCES", 8},
                                         {"IDS_QM_DB_PART_NODE_IDS", 4},
                                         {"IDS_QM_DB_PART_HINGES", 8},
                                         {"IDS_QM_DB_PART_STEPS", 8},
                                         {"IDS_QM_DB_PART_EVENTS", 8},
                                         {"IDS_QM_DB_PART_EVENTS", 4},
                                         {"IDS_QM_DB_PART_DISPLACEMENTS", 8},
                                         {"IDS_QM_DB_PART_HINGE_STATES", 8},
                                         {"IDS_QM_DB_PART_DISPLACEMENTS", 8}}};
static_assert(kParts.size() == static_cast<std::size_t>(BLOCK_PART::RunStart) + 1);

const T_PART& PartOf(const T_BLOCK_KEY& key)
{
    return kParts[static_cast<std::size_t>(key.part)];
}

/// Key, count and width are part of the sum: a block that lies in another's place is found.
std::int64_t SumOf(const T_BLOCK_KEY& key, int count, std::span<const std::byte> bytes)
{
    CChecksum sum;
    for (const int field :
         {key.pushover, static_cast<int>(key.part), key.chunk, key.step, count, PartOf(key).width})
        sum.AddWord(static_cast<std::uint64_t>(field));
    sum.AddBytes(bytes);
    return static_cast<std::int64_t>(sum.Value());
}

/// One load case: reads its source and writes its blocks.
class CResultWriter {
public:
    CResultWriter(const CSqliteDb& db, int pushover, IPushResult& source)
        : m_db(db), m_pushover(pushover), m_source(source), m_blocks(db)
    {
    }

    void Write()
    {
        std::vector<double> loadFactor, baseReaction;
        const bool read =
            m_source.ReadLoadFactors(loadFactor) && m_source.ReadBaseReactions(baseReaction);
        if (!read) ThrowSource();
        m_steps = static_cast<std::size_t>(std::max(m_source.StepCount(), 0));
        m_nodes = m_source.NodeIds();
        if (!m_source.Error().empty()) ThrowSource();
        CheckSeries(loadFactor, "load_factor");
        CheckSeries(baseReaction, "base_reaction");

        WriteHead();
        m_blocks.Write({m_pushover, BLOCK_PART::LoadFactor}, std::span<const double>(loadFactor));
        m_blocks.Write({m_pushover, BLOCK_PART::BaseReaction},
                       std::span<const double>(baseReaction));
        const int chunks = ChunkCount(static_cast<int>(m_nodes.size()));
        for (int chunk = 0; chunk < chunks; ++chunk)
            m_blocks.Write({m_pushover, BLOCK_PART::NodeIds, chunk}, NodesOf(chunk));
        for (int chunk = 0; chunk < chunks; ++chunk)
            WriteDisplacements(chunk);
    }

private:
    [[noreturn]] void ThrowSource() const
    {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_SOURCE",
                          std::to_string(m_pushover), m_source.Error());
    }

    /// One finite value per step, or a refusal.
    void CheckSeries(const std::vector<double>& values, const std::string& place) const
    {
        const std::string where = "results " + std::to_string(m_pushover) + ' ' + place;
        if (values.size() != m_steps) {
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_LENGTH", where,
                              std::to_string(values.size()), std::to_string(m_steps));
        }
        if (!std::all_of(values.begin(), values.end(), [](double v) { return std::isfinite(v); }))
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NOT_FINITE", where);
    }

    std::span<const int> NodesOf(int chunk) const
    {
        const int size = ChunkSize(static_cast<int>(m_nodes.size()), chunk);
        return std::span(m_nodes).subspan(static_cast<std::size_t>(chunk * kBlockNodes),
                                          static_cast<std::size_t>(size));
    }

    void WriteHead() const
    {
        CRecordRow row("results", m_pushover);
        row.Put("steps", static_cast<std::int64_t>(m_steps));
        row.Put("nodes", static_cast<std::int64_t>(m_nodes.size()));
        row.Insert(m_db);
    }

    /// Reads node by node, writes step by step.
    void WriteDisplacements(int chunk)
    {
        const std::span<const int> nodes = NodesOf(chunk);
        std::vector<double> values(m_steps * nodes.size()); // row-major, steps x nodes
        std::vector<double> series;
        for (std::size_t n = 0; n < nodes.size(); ++n) {
            if (!m_source.ReadDisplacements(nodes[n], series)) ThrowSource();
            CheckSeries(series, "displacement " + std::to_string(nodes[n]));
            for (std::size_t step = 0; step < m_steps; ++step)
                values[step * nodes.size() + n] = series[step];
        }
        for (std::size_t step = 0; step < m_steps; ++step) {
            const auto row =
                std::span<const double>(values).subspan(step * nodes.size(), nodes.size());
            m_blocks.Write({m_pushover, BLOCK_PART::Displacement, chunk, static_cast<int>(step)},
                           row);
        }
    }

    const CSqliteDb& m_db;
    int m_pushover;
    IPushResult& m_source;
    CBlockWriter m_blocks;
    std::size_t m_steps = 0;
    std::vector<int> m_nodes; // ascending
};

} // namespace

CBlockWriter::CBlockWriter(const CSqliteDb& db)
    : m_insert(db, std::string("INSERT INTO ") + kBlockTable + '(' + kBlockColumns +
                       ") VALUES(?1, ?2, ?3, ?4, ?5, ?6, 'little', ?7, ?8)")
{
}

void CBlockWriter::Insert(const T_BLOCK_KEY& key, int count, std::span<const std::byte> bytes)
{
    int at = 0;
    for (const int field :
         {key.pushover, static_cast<int>(key.part), key.chunk, key.step, count, PartOf(key).width})
        m_insert.Bind(++at, std::int64_t{field});
    m_insert.Bind(++at, SumOf(key, count, bytes));
    m_insert.Bind(++at, bytes);
    m_insert.Run();
}

CBlockRun::CBlockRun(const CSqliteDb& db, T_BLOCK_KEY key)
    : m_key(key), m_rows(db, std::string("SELECT ") + kBlockColumns + " FROM " + kBlockTable +
                                 " WHERE pushover = ?1 AND part = ?2 AND chunk = ?3 "
                                 "AND step >= ?4 ORDER BY step")
{
    m_rows.Bind(1, std::int64_t{key.pushover});
    m_rows.Bind(2, std::int64_t{static_cast<int>(key.part)});
    m_rows.Bind(3, std::int64_t{key.chunk});
    m_rows.Bind(4, std::int64_t{key.step});
}

std::span<const std::byte> CBlockRun::Step(int count)
{
    if (!m_rows.Step()) ThrowBadBlock(m_key);
    return CheckedBlock(m_rows, m_key, count);
}

int HeadField(const CRecordRow& row, const char* column)
{
    const auto* const value = std::get_if<std::int64_t>(&row.Get(column));
    if (!value || *value < 0 || *value > std::numeric_limits<int>::max()) row.ThrowBadCell(column);
    return static_cast<int>(*value);
}

void ThrowBadBlock(const T_BLOCK_KEY& key)
{
    const std::string loadCase = std::to_string(key.shown != 0 ? key.shown : key.pushover);
    const std::string chunk = std::to_string(key.chunk + 1);
    const std::string part = MMSGFunction::GetValue(PartOf(key).nameKey);
    if (key.stage != 0) {
        ThrowDamaged(MMSGFunction::Format(
            "IDS_QM_DB_DAMAGE_STAGE_BLOCK",
            {std::to_string(key.stage), std::to_string(key.stageStep), loadCase, part, chunk}));
    }
    ThrowDamaged(MMSGFunction::Format("IDS_QM_DB_DAMAGE_BLOCK",
                                      {loadCase, part, chunk, std::to_string(key.step + 1)}));
}

std::span<const std::byte> CheckedBlock(const CSqliteStmt& row, const T_BLOCK_KEY& key, int count)
{
    const int width = PartOf(key).width;
    const std::array<std::int64_t, 6> expected{
        key.pushover, static_cast<int>(key.part), key.chunk, key.step, count, width};
    for (std::size_t i = 0; i < expected.size(); ++i) {
        if (row.Int(static_cast<int>(i)) != expected[i]) ThrowBadBlock(key);
    }
    const std::span<const std::byte> bytes = row.Blob(8);
    if (row.Text(6) != "little" ||
        bytes.size() != static_cast<std::size_t>(count) * static_cast<std::size_t>(width) ||
        row.Int(7) != SumOf(key, count, bytes) || (width == 8 && !AllFinite(bytes)))
        ThrowBadBlock(key);
    return bytes;
}

void WriteResults(const CSqliteDb& db, const T_RESULT_MAP& results)
{
    for (const auto& [pushover, source] : results) {
        if (source && !source->Run()) CResultWriter(db, pushover, *source).Write();
    }
}

std::vector<T_RESULT_HEAD> ReadResultHeads(const CSqliteDb& db, T_TABLE_SUMS& sums)
{
    std::vector<T_RESULT_HEAD> heads;
    CChecksum sum;
    for (const CRecordRow& row : CRecordRow::ReadAll(db, "results", sum)) {
        const auto key = static_cast<int>(row.Key());
        if (key != row.Key()) row.ThrowBadCell("key");
        heads.push_back({key, HeadField(row, "steps"), HeadField(row, "nodes")});
    }
    sums["results"] = sum.Value();
    return heads;
}

double BytesOf(const T_RESULT_HEAD& head)
{
    const double steps = head.steps, nodes = head.nodes;
    return 8.0 * steps * (2.0 + nodes) + 4.0 * nodes;
}

void CheckBlocks(const CSqliteDb& db, const std::vector<T_RESULT_HEAD>& heads)
{
    CSqliteStmt rows(db, std::string("SELECT ") + kBlockColumns + " FROM " + kBlockTable +
                             " WHERE part < ?1 ORDER BY pushover, part, chunk, step");
    rows.Bind(1, std::int64_t{static_cast<int>(BLOCK_PART::StaticNodes)});
    const auto check = [&](const T_BLOCK_KEY& key, int count) {
        if (!rows.Step()) ThrowBadBlock(key);
        CheckedBlock(rows, key, count);
    };
    for (const T_RESULT_HEAD& head : heads) {
        check({head.pushover, BLOCK_PART::LoadFactor}, head.steps);
        check({head.pushover, BLOCK_PART::BaseReaction}, head.steps);
        for (int chunk = 0; chunk < ChunkCount(head.nodes); ++chunk)
            check({head.pushover, BLOCK_PART::NodeIds, chunk}, ChunkSize(head.nodes, chunk));
        for (int chunk = 0; chunk < ChunkCount(head.nodes); ++chunk) {
            for (int step = 0; step < head.steps; ++step)
                check({head.pushover, BLOCK_PART::Displacement, chunk, step},
                      ChunkSize(head.nodes, chunk));
        }
    }
    if (rows.Step()) ThrowDamaged(kBlockTable);
}
