// The table of result blocks: packed numbers, each block with a checksum of its own.
// A block of displacements holds one step of up to 512 nodes; the blocks of the same nodes follow
// each other step by step, so that one node over all steps is one short run of the table.
#pragma once

#include "qm_db/pushresult.h"
#include "qm_db/recordcodec.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

class CSqliteDb;
class CSqliteStmt;

inline constexpr int kBlockNodes = 512; // nodes in one block

enum class BLOCK_PART { LoadFactor, BaseReaction, NodeIds, Displacement };

struct T_BLOCK_KEY {
    int pushover = 0; // key of the load case
    BLOCK_PART part = BLOCK_PART::LoadFactor;
    int chunk = 0; // from 0: nodes 512 * chunk ... of the list of node ids
    int step = 0;  // from 0
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
/// numbers and the right checksum; throws "damaged", naming the block. The view is the row's.
std::span<const std::byte> CheckedBlock(const CSqliteStmt& row, const T_BLOCK_KEY& key, int count);
/// "Damaged", naming the block: what a missing row is.
[[noreturn]] void ThrowBadBlock(const T_BLOCK_KEY& key);

/// Writes all results; throws CStoreFault (BadInput for a source that fails, for unequal lengths
/// and for numbers that are not finite).
void WriteResults(const CSqliteDb& db, const T_RESULT_MAP& results);

/// Rows of "results"; their sum goes to `sums`.
std::vector<T_RESULT_HEAD> ReadResultHeads(const CSqliteDb& db, T_TABLE_SUMS& sums);

/// Reads and checks every block of these results, and that there are no others.
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
