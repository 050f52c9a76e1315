#include "qm_db/store/staticblocks.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modelschema.h"
#include "qm_db/store/recordcodecrow.h"
#include "qm_db/store/sqlitedb.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <new>
#include <tuple>

namespace {

constexpr const char* kStaticTable = "static_results";
constexpr int kNodeWidth = 6;                                      // numbers of a node
constexpr int kForceWidth = static_cast<int>(kForcePositions) * 6; // of an element
static_assert(sizeof(T_DOF6) == kNodeWidth * sizeof(double));      // packed
static_assert(sizeof(T_ELEM_FORCES) == kForceWidth * sizeof(double));

/// What a part consists of: by what ids it goes and how many numbers each has.
struct T_STATIC_PART {
    BLOCK_PART part;
    bool byElement;
    int width;
};
constexpr std::array<T_STATIC_PART, 5> kParts{{{BLOCK_PART::StaticNodes, false, 1},
                                               {BLOCK_PART::StaticElements, true, 1},
                                               {BLOCK_PART::StaticDisplacement, false, kNodeWidth},
                                               {BLOCK_PART::StaticReaction, false, kNodeWidth},
                                               {BLOCK_PART::StaticForce, true, kForceWidth}}};

const T_STATIC_PART& PartOf(BLOCK_PART part)
{
    return kParts[static_cast<std::size_t>(part) -
                  static_cast<std::size_t>(BLOCK_PART::StaticNodes)];
}

int CountOf(const T_STATIC_HEAD& head, const T_STATIC_PART& part)
{
    return part.byElement ? head.elements : head.nodes;
}

/// The same numbers without their grouping.
template <class T>
std::span<const double> Flat(const std::vector<T>& values)
{
    return {reinterpret_cast<const double*>(values.data()),
            values.size() * (sizeof(T) / sizeof(double))};
}

T_BLOCK_KEY KeyOf(const T_STATIC_HEAD& head, BLOCK_PART part, int chunk)
{
    return {head.loadCase, part, chunk, head.row, head.stage, head.step};
}

/// Writes one part, chunk by chunk.
template <class T>
void WritePart(CBlockWriter& blocks, const T_STATIC_HEAD& head, BLOCK_PART part,
               std::span<const T> values)
{
    const int count = CountOf(head, PartOf(part));
    const auto width = static_cast<std::size_t>(PartOf(part).width);
    for (int chunk = 0; chunk < ChunkCount(count); ++chunk) {
        const auto from = static_cast<std::size_t>(chunk * kBlockNodes) * width;
        const auto size = static_cast<std::size_t>(ChunkSize(count, chunk)) * width;
        blocks.Write(KeyOf(head, part, chunk), values.subspan(from, size));
    }
}

bool Ascends(const std::vector<int>& ids)
{
    return std::adjacent_find(ids.begin(), ids.end(), std::greater_equal<>()) == ids.end();
}

void CheckData(const T_STATIC_DATA& data, const std::string& place)
{
    if (data.displacement.size() != data.nodes.size() ||
        data.reaction.size() != data.nodes.size() || data.force.size() != data.elements.size() ||
        !Ascends(data.nodes) || !Ascends(data.elements)) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_LENGTH", place,
                          std::to_string(data.displacement.size()),
                          std::to_string(data.nodes.size()));
    }
    for (const auto values : {Flat(data.displacement), Flat(data.reaction), Flat(data.force)}) {
        if (!std::all_of(values.begin(), values.end(), [](double v) { return std::isfinite(v); }))
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NOT_FINITE", place);
    }
}

void WriteCase(const CSqliteDb& db, CBlockWriter& blocks, int key, IStaticResult& source)
{
    T_STATIC_DATA data;
    if (!source.ReadAll(data)) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_SOURCE", std::to_string(key),
                          source.Error());
    }
    CRecordRow row(kStaticTable, key);
    T_STATIC_HEAD head;
    head.loadCase = key;
    WriteStaticBlocks(db, blocks, row, head, data);
}

} // namespace

T_STATIC_HEAD ReadHead(const CRecordRow& row)
{
    const auto* const print = std::get_if<std::int64_t>(&row.Get("fingerprint"));
    if (!print) row.ThrowBadCell("fingerprint");
    return {0, HeadField(row, "nodes"), HeadField(row, "elements"),
            std::bit_cast<std::uint64_t>(*print)};
}

void WriteStaticBlocks(const CSqliteDb& db, CBlockWriter& blocks, CRecordRow& row,
                       const T_STATIC_HEAD& of, const T_STATIC_DATA& data)
{
    CheckData(data, row.Table() + ' ' + std::to_string(row.Key()));
    T_STATIC_HEAD head = of;
    head.nodes = static_cast<int>(data.nodes.size());
    head.elements = static_cast<int>(data.elements.size());
    row.Put("nodes", std::int64_t{head.nodes});
    row.Put("elements", std::int64_t{head.elements});
    row.Put("fingerprint", std::bit_cast<std::int64_t>(data.fingerprint));
    row.Insert(db);
    WritePart(blocks, head, BLOCK_PART::StaticNodes, std::span<const int>(data.nodes));
    WritePart(blocks, head, BLOCK_PART::StaticElements, std::span<const int>(data.elements));
    WritePart(blocks, head, BLOCK_PART::StaticDisplacement, Flat(data.displacement));
    WritePart(blocks, head, BLOCK_PART::StaticReaction, Flat(data.reaction));
    WritePart(blocks, head, BLOCK_PART::StaticForce, Flat(data.force));
}

void WriteStaticResults(const CSqliteDb& db, const T_MODEL& model, const T_STATIC_MAP& results)
{
    CBlockWriter blocks(db);
    for (const auto& [key, source] : results) {
        if (source && model.loadCases.contains(key)) WriteCase(db, blocks, key, *source);
    }
}

std::vector<T_STATIC_HEAD> ReadStaticHeads(const CSqliteDb& db, T_TABLE_SUMS& sums)
{
    std::vector<T_STATIC_HEAD> heads;
    CChecksum sum;
    for (const CRecordRow& row : CRecordRow::ReadAll(db, kStaticTable, sum)) {
        const auto key = static_cast<int>(row.Key());
        if (key != row.Key()) row.ThrowBadCell("key");
        heads.push_back(ReadHead(row));
        heads.back().loadCase = key;
    }
    sums[kStaticTable] = sum.Value();
    return heads;
}

double BytesOf(const T_STATIC_HEAD& head)
{
    double bytes = 0.0;
    for (const T_STATIC_PART& part : kParts)
        bytes += 1.0 * CountOf(head, part) * part.width * (part.width == 1 ? 4 : 8);
    return bytes;
}

void CheckStaticBlocks(const CSqliteDb& db, const std::vector<T_STATIC_HEAD>& heads)
{
    std::vector<std::pair<T_BLOCK_KEY, int>> expected; // with the count of numbers
    for (const T_STATIC_HEAD& head : heads) {
        for (const T_STATIC_PART& part : kParts) {
            const int count = CountOf(head, part);
            for (int chunk = 0; chunk < ChunkCount(count); ++chunk)
                expected.emplace_back(KeyOf(head, part.part, chunk),
                                      ChunkSize(count, chunk) * part.width);
        }
    }
    const auto place = [](const auto& block) {
        const T_BLOCK_KEY& k = block.first;
        return std::tuple(k.pushover, k.part, k.chunk, k.step);
    };
    std::ranges::sort(expected, {}, place);
    CSqliteStmt rows(db,
                     std::string("SELECT ") + kBlockColumns + " FROM " + kBlockTable +
                         " WHERE part >= ?1 AND part < ?2 ORDER BY pushover, part, chunk, step");
    rows.Bind(1, std::int64_t{static_cast<int>(BLOCK_PART::StaticNodes)});
    rows.Bind(2, std::int64_t{static_cast<int>(BLOCK_PART::RunNodes)});
    for (const auto& [key, count] : expected) {
        if (!rows.Step()) ThrowBadBlock(key);
        CheckedBlock(rows, key, count);
    }
    if (rows.Step()) ThrowDamaged(kBlockTable);
}

CBlockStaticResult::CBlockStaticResult(std::shared_ptr<const CSqliteDb> db, std::string path,
                                       T_STATIC_HEAD head)
    : m_db(std::move(db)), m_path(std::move(path)), m_head(head)
{
}

template <class F>
int CBlockStaticResult::Guarded(const F& read)
{
    m_error.clear();
    try {
        return read() ? 1 : 0;
    } catch (const CStoreFault& fault) {
        m_error = fault.ForFile(m_path).text;
    } catch (const std::bad_alloc&) {
        throw; // not a fault of the results
    } catch (const std::exception& fault) {
        m_error = m_path + ": " + fault.what();
    }
    return 0;
}

const std::vector<int>& CBlockStaticResult::Ids(BLOCK_PART part, int chunk)
{
    auto& known = PartOf(part).byElement ? m_elements : m_nodes;
    const auto it = known.find(chunk);
    if (it != known.end()) return it->second;
    std::vector<int> ids;
    CBlockRun(*m_db, KeyOf(m_head, part, chunk))
        .Next(ChunkSize(CountOf(m_head, PartOf(part)), chunk), ids);
    if (!Ascends(ids)) ThrowBadBlock(KeyOf(m_head, part, chunk));
    return known.emplace(chunk, std::move(ids)).first->second;
}

/// Ids ascend through the chunks: the last chunk whose first id is not above the id has it.
int CBlockStaticResult::Find(BLOCK_PART idPart, int count, int id)
{
    int low = 0, high = ChunkCount(count) - 1;
    while (low < high) {
        const int middle = (low + high + 1) / 2;
        if (Ids(idPart, middle).front() <= id)
            low = middle;
        else
            high = middle - 1;
    }
    if (count == 0) return -1;
    const std::vector<int>& ids = Ids(idPart, low);
    const auto it = std::lower_bound(ids.begin(), ids.end(), id);
    if (it == ids.end() || *it != id) return -1;
    return low * kBlockNodes + static_cast<int>(it - ids.begin());
}

template <class T>
int CBlockStaticResult::Read(BLOCK_PART part, int id, T& out)
{
    return Guarded([&] {
        const T_STATIC_PART& kind = PartOf(part);
        const int count = CountOf(m_head, kind);
        const int at =
            Find(kind.byElement ? BLOCK_PART::StaticElements : BLOCK_PART::StaticNodes, count, id);
        if (at < 0) return false;
        T_BLOCK& block = m_blocks[static_cast<std::size_t>(part) -
                                  static_cast<std::size_t>(BLOCK_PART::StaticDisplacement)];
        const int chunk = at / kBlockNodes;
        if (block.chunk != chunk) {
            block = {};
            CBlockRun(*m_db, KeyOf(m_head, part, chunk))
                .Next(ChunkSize(count, chunk) * kind.width, block.values);
            block.chunk = chunk;
        }
        std::memcpy(&out, &block.values[static_cast<std::size_t>(at % kBlockNodes * kind.width)],
                    sizeof out);
        return true;
    });
}

int CBlockStaticResult::ReadDisplacement(int node, T_DOF6& out)
{
    return Read(BLOCK_PART::StaticDisplacement, node, out);
}

int CBlockStaticResult::ReadReaction(int node, T_DOF6& out)
{
    return Read(BLOCK_PART::StaticReaction, node, out);
}

int CBlockStaticResult::ReadForces(int element, T_ELEM_FORCES& out)
{
    return Read(BLOCK_PART::StaticForce, element, out);
}

int CBlockStaticResult::ReadAll(T_STATIC_DATA& out)
{
    return Guarded([&] {
        T_STATIC_DATA data;
        data.fingerprint = m_head.fingerprint;
        const auto read = [&](BLOCK_PART part, auto& values) {
            const int count = CountOf(m_head, PartOf(part));
            for (int chunk = 0; chunk < ChunkCount(count); ++chunk)
                CBlockRun(*m_db, KeyOf(m_head, part, chunk))
                    .Next(ChunkSize(count, chunk) * PartOf(part).width, values);
        };
        read(BLOCK_PART::StaticNodes, data.nodes);
        read(BLOCK_PART::StaticElements, data.elements);
        read(BLOCK_PART::StaticDisplacement, data.displacement);
        read(BLOCK_PART::StaticReaction, data.reaction);
        read(BLOCK_PART::StaticForce, data.force);
        out = std::move(data);
        return true;
    });
}
