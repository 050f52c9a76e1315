// A run of a push that stays in the model file until it is asked for.
#pragma once

#include "qm_db/store/runblocks.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

/// Reads only the blocks that hold what is asked for, checking each; keeps the last run of blocks
/// of nodes and of hinges, so that reading neighbours reads the file once. For one thread.
class CBlockPushRun : public IPushRun {
public:
    CBlockPushRun(std::shared_ptr<const CSqliteDb> db, std::string path, T_RUN_ROW row);

    int StepCount() const override { return m_row.steps; }
    std::vector<int> NodeIds() const override;
    bool HasNode(int node) const override;
    std::string Error() const override { return m_error; }

    const T_RUN_HEAD& Head() const override { return m_row.head; }
    [[nodiscard]] int ReadSteps(std::vector<T_RUN_STEP>& out) override;
    [[nodiscard]] int ReadEvents(std::vector<T_RUN_EVENT>& out) override;
    [[nodiscard]] int ReadHinges(std::vector<T_RUN_HINGE>& out) override;
    [[nodiscard]] int ReadStart(std::vector<T_DOF6>& out) override;
    [[nodiscard]] int ReadNode(int node, std::vector<T_DOF6>& out) override;
    [[nodiscard]] int ReadShape(int step, std::vector<T_DOF6>& out) override;
    [[nodiscard]] int ReadHinge(std::size_t hinge, std::vector<T_RUN_STATE>& out) override;
    [[nodiscard]] int ReadStates(int step, std::vector<T_RUN_STATE>& out) override;

private:
    /// Runs a read that fills the list; a fault becomes m_error, an empty list and 0.
    template <class T, class F>
    int Guarded(std::vector<T>& out, const F& read) const;
    /// The node ids, read with the first use.
    const std::vector<int>& Nodes() const;
    /// All numbers of a part that is one block.
    template <class N>
    std::vector<N> List(BLOCK_PART part) const;
    /// All blocks of one step.
    std::vector<double> OfStep(BLOCK_PART part, int step) const;
    T_RUN_STATE StateOf(std::span<const double> numbers) const;
    /// A whole number of a block of that part; a fault unless it lies between.
    int WholeOf(BLOCK_PART part, double value, int low, int high) const;

    /// All steps of one chunk, row-major, steps x numbers.
    struct T_CHUNK {
        int chunk = -1;
        std::vector<double> values;
    };
    /// Calls f(numbers) for a thing of the part, step by step.
    template <class F>
    void ForEachStep(BLOCK_PART part, int at, T_CHUNK& kept, const F& f) const;

    std::shared_ptr<const CSqliteDb> m_db;
    std::string m_path; // for messages
    T_RUN_ROW m_row;
    mutable std::optional<std::vector<int>> m_nodes; // ascending
    mutable std::string m_error;
    T_CHUNK m_shapes, m_states;
};
