// Static results in the model file: a row of "static_results" per load case, and blocks in the
// table of result blocks, each with the ids, or the numbers of 512 nodes or elements. Results of
// construction stages (stagedblocks.h) have the same blocks under a head of their own.
#pragma once

#include "qm_db/results/staticresult.h"
#include "qm_db/store/resultblocks.h"

#include <memory>
#include <unordered_map>

/// A row of the table "static_results", or of "staged_results".
struct T_STATIC_HEAD {
    int loadCase = 0;
    int nodes = 0;
    int elements = 0;
    std::uint64_t fingerprint = 0;
    // Of "staged_results" only: key of the row, from 1, stage and step. Elsewhere 0.
    int row = 0;
    int stage = 0, step = 0;
};

/// Reads the fields that both tables have, but for the load case.
T_STATIC_HEAD ReadHead(const CRecordRow& row);
/// Writes the row of the head, with the columns that `row` has already, and the blocks; throws
/// CStoreFault (BadInput for unequal lengths and for numbers that are not finite).
void WriteStaticBlocks(const CSqliteDb& db, CBlockWriter& blocks, CRecordRow& row,
                       const T_STATIC_HEAD& head, const T_STATIC_DATA& data);

/// Writes the results of the load cases of the model; throws CStoreFault (BadInput for a source
/// that fails, for unequal lengths and for numbers that are not finite).
void WriteStaticResults(const CSqliteDb& db, const T_MODEL& model, const T_STATIC_MAP& results);

/// Rows of "static_results"; their sum goes to `sums`.
std::vector<T_STATIC_HEAD> ReadStaticHeads(const CSqliteDb& db, T_TABLE_SUMS& sums);

/// Bytes of the numbers that a head speaks of.
double BytesOf(const T_STATIC_HEAD& head);

/// Reads and checks every block of these results, static and of stages, and that there are no
/// others of these parts.
void CheckStaticBlocks(const CSqliteDb& db, const std::vector<T_STATIC_HEAD>& heads);

/// Reads only the blocks that hold what is asked for, checking each; keeps the blocks of ids that
/// it has read and the last block of each kind of number. One object is for one thread.
class CBlockStaticResult : public IStaticResult {
public:
    CBlockStaticResult(std::shared_ptr<const CSqliteDb> db, std::string path, T_STATIC_HEAD head);

    std::uint64_t Fingerprint() const override { return m_head.fingerprint; }
    [[nodiscard]] int ReadDisplacement(int node, T_DOF6& out) override;
    [[nodiscard]] int ReadReaction(int node, T_DOF6& out) override;
    [[nodiscard]] int ReadForces(int element, T_ELEM_FORCES& out) override;
    [[nodiscard]] int ReadAll(T_STATIC_DATA& out) override;
    std::string Error() const override { return m_error; }

private:
    template <class T>
    int Read(BLOCK_PART part, int id, T& out);
    const std::vector<int>& Ids(BLOCK_PART part, int chunk);
    /// Position of an id in the whole list, -1 when it is not there.
    int Find(BLOCK_PART idPart, int count, int id);
    template <class F>
    int Guarded(const F& read);

    std::shared_ptr<const CSqliteDb> m_db;
    std::string m_path; // for messages
    T_STATIC_HEAD m_head;
    std::unordered_map<int, std::vector<int>> m_nodes, m_elements; // ids by chunk
    struct T_BLOCK {
        int chunk = -1;
        std::vector<double> values;
    };
    std::array<T_BLOCK, 3> m_blocks; // displacement, reaction, force
    std::string m_error;
};
