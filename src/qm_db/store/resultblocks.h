// The table of result blocks: packed numbers, each block with a checksum of its own.
// A block of displacements holds one step of up to 512 nodes; the blocks of the same nodes follow
// each other step by step, so that one node over all steps is one short run of the table.
#pragma once

#include "qm_db/results/pushresult.h"
#include "qm_db/store/recordcodec.h"
#include "qm_db/store/sqlitestmt.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>
#include <string>
#include <vector>

class CRecordRow;
class CSqliteDb;

inline constexpr int kBlockNodes = 512; // nodes in one block

enum class BLOCK_PART {
    LoadFactor,
    BaseReaction,
    NodeIds,
    Displacement,
    // Of static load cases; see staticblocks.h.
    StaticNodes,
    StaticElements,
    StaticDisplacement,
    StaticReaction,
    StaticForce,
    // Of runs of a push; see runblocks.h.
    RunNodes,
    RunHinges,
    RunSteps,
    RunEvents,
    RunTurns,
    RunDisplacement,
    RunState,
    RunStart
};

struct T_BLOCK_KEY {
    /// Key of the load case, of a static one for the parts of static results; of a run the row of
    /// "push_results".
    int pushover = 0;
    BLOCK_PART part = BLOCK_PART::LoadFactor;
    int chunk = 0; // from 0: nodes 512 * chunk ... of the list of node ids
    int step = 0;  // from 0; of construction stages: the row of "staged_results", from 1
    int stage = 0, stageStep = 0; // of construction stages; for messages only
    int shown = 0;                // of a run: its load case; for messages only
    bool operator==(const T_BLOCK_KEY&) const = default;
};

/// A row of the table "results".
struct T_RESULT_HEAD {
    int pushover = 0;
    int steps = 0;
    int nodes = 0;
};

/// Columns that CheckedBlock expects, in this order.
inline constexpr const char* kBlockColumns =
    "pushover, part, chunk, step, count, width, byte_order, checksum, data";

/// Packed numbers of the row, after checking that it is the block of that key with that many
/// numbers, the right checksum, and numbers that are finite; throws "damaged", naming the block.
/// The view is the row's.
std::span<const std::byte> CheckedBlock(const CSqliteStmt& row, const T_BLOCK_KEY& key, int count);
/// "Damaged", naming the block: what a missing row is.
[[noreturn]] void ThrowBadBlock(const T_BLOCK_KEY& key);

/// Writes blocks, each with its checksum.
class CBlockWriter {
public:
    explicit CBlockWriter(const CSqliteDb& db);
    template <class T>
    void Write(const T_BLOCK_KEY& key, std::span<const T> values)
    {
        Insert(key, static_cast<int>(values.size()), std::as_bytes(values));
    }

private:
    void Insert(const T_BLOCK_KEY& key, int count, std::span<const std::byte> bytes);
    CSqliteStmt m_insert;
};

/// Reads the blocks of one part and chunk in the order of steps, from the step of the key on.
class CBlockRun {
public:
    CBlockRun(const CSqliteDb& db, T_BLOCK_KEY key);

    /// Appends the numbers of the next step.
    template <class T>
    void Next(int count, std::vector<T>& out)
    {
        const std::span<const std::byte> bytes = Step(count);
        const std::size_t at = out.size();
        out.resize(at + bytes.size() / sizeof(T));
        if (!bytes.empty()) std::memcpy(out.data() + at, bytes.data(), bytes.size());
        ++m_key.step;
    }

private:
    std::span<const std::byte> Step(int count);
    T_BLOCK_KEY m_key;
    CSqliteStmt m_rows;
};

/// A whole number of a head that must not be negative.
int HeadField(const CRecordRow& row, const char* column);

/// Writes all results; throws CStoreFault (BadInput for a source that fails, for unequal lengths
/// and for numbers that are not finite).
void WriteResults(const CSqliteDb& db, const T_RESULT_MAP& results);

/// Rows of "results"; their sum goes to `sums`.
std::vector<T_RESULT_HEAD> ReadResultHeads(const CSqliteDb& db, T_TABLE_SUMS& sums);

/// Bytes of the numbers that a head speaks of.
double BytesOf(const T_RESULT_HEAD& head);

/// Reads and checks every block of these results, and that there are no others of these parts.
void CheckBlocks(const CSqliteDb& db, const std::vector<T_RESULT_HEAD>& heads);

/// Number of blocks of nodes, and nodes in one of them.
inline int ChunkCount(int nodes)
{
    return (nodes + kBlockNodes - 1) / kBlockNodes;
}
inline int ChunkSize(int nodes, int chunk)
{
    return nodes - chunk * kBlockNodes < kBlockNodes ? nodes - chunk * kBlockNodes : kBlockNodes;
}
