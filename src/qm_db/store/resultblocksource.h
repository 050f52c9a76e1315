// Results that stay in the model file until they are asked for.
#pragma once

#include "qm_db/results/pushresult.h"
#include "qm_db/store/resultblocks.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

class CSqliteDb;

/// Reads only the blocks that hold what is asked for, checking each; keeps the last run of blocks,
/// so that reading neighbouring nodes reads the file once. One object is for one thread.
class CBlockPushResult : public IPushResult {
public:
    CBlockPushResult(std::shared_ptr<const CSqliteDb> db, std::string path, T_RESULT_HEAD head);

    int StepCount() const override { return m_head.steps; }
    std::vector<int> NodeIds() const override;
    bool HasNode(int node) const override;
    [[nodiscard]] int ReadLoadFactors(std::vector<double>& out) override;
    [[nodiscard]] int ReadBaseReactions(std::vector<double>& out) override;
    [[nodiscard]] int ReadDisplacements(int node, std::vector<double>& out) override;
    std::string Error() const override { return m_error; }

private:
    /// Runs a read; a fault becomes m_error and 0.
    template <class F>
    int Guarded(const F& read) const;
    int ReadSeries(BLOCK_PART part, std::vector<double>& out);
    /// The node ids, read with the first use.
    const std::vector<int>& Nodes() const;
    /// All steps of one chunk of nodes, row-major, steps x nodes.
    const std::vector<double>& Chunk(int chunk);

    std::shared_ptr<const CSqliteDb> m_db;
    std::string m_path; // for messages
    T_RESULT_HEAD m_head;
    mutable std::optional<std::vector<int>> m_nodes; // ascending
    mutable std::string m_error;
    int m_chunk = -1; // which one m_values holds
    std::vector<double> m_values;
};
