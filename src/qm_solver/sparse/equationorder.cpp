#include "qm_solver/sparse/equationorder.h"

#include "qm_solver/sparse/librarylock.h"

#include <array>

#include <metis.h>

namespace solver {

namespace {

static_assert(sizeof(idx_t) == sizeof(int));

/// The graph of the blocks, both directions of each edge, without loops.
struct T_GRAPH {
    std::vector<idx_t> start, neighbour, weight; // weight: equations of the block
};

T_GRAPH BlockGraph(const T_SYMMETRIC_MATRIX& m, std::span<const int> block)
{
    const auto blocks = static_cast<std::size_t>(block.back()) + 1;
    std::vector<std::vector<idx_t>> above(blocks); // neighbours with a higher number
    T_GRAPH graph;
    graph.weight.assign(blocks, 0);
    std::vector<int> seenBy(blocks, -1);
    for (std::size_t i = 0; i < m.Size(); ++i) {
        const auto own = static_cast<std::size_t>(block[i]);
        ++graph.weight[own];
        seenBy[own] = block[i];
        for (int k = m.rowStart[i]; k < m.rowStart[i + 1]; ++k) {
            const int other =
                block[static_cast<std::size_t>(m.column[static_cast<std::size_t>(k)])];
            int& seen = seenBy[static_cast<std::size_t>(other)];
            if (seen == block[i]) continue;
            seen = block[i];
            above[own].push_back(other);
        }
    }
    graph.start.assign(blocks + 1, 0);
    for (std::size_t b = 0; b < blocks; ++b) {
        graph.start[b + 1] += static_cast<idx_t>(above[b].size());
        for (idx_t other : above[b])
            ++graph.start[static_cast<std::size_t>(other) + 1];
    }
    for (std::size_t b = 0; b < blocks; ++b)
        graph.start[b + 1] += graph.start[b];
    graph.neighbour.resize(static_cast<std::size_t>(graph.start.back()));
    std::vector<idx_t> next(graph.start.begin(), graph.start.end() - 1);
    for (std::size_t b = 0; b < blocks; ++b)
        for (idx_t other : above[b]) {
            const auto o = static_cast<std::size_t>(other);
            graph.neighbour[static_cast<std::size_t>(next[b]++)] = other;
            graph.neighbour[static_cast<std::size_t>(next[o]++)] = static_cast<idx_t>(b);
        }
    return graph;
}

/// Position of each block in the order of elimination. Nested dissection; where the library has
/// nothing to dissect or fails, the order that is there.
std::vector<idx_t> BlockOrder(T_GRAPH& graph)
{
    auto blocks = static_cast<idx_t>(graph.weight.size());
    std::vector<idx_t> atPosition(graph.weight.size()), position(graph.weight.size());
    const auto keep = [&] {
        for (idx_t b = 0; b < blocks; ++b)
            position[static_cast<std::size_t>(b)] = b;
    };
    if (graph.neighbour.empty()) {
        keep();
        return position;
    }
    std::array<idx_t, METIS_NOPTIONS> options{};
    METIS_SetDefaultOptions(options.data());
    options[METIS_OPTION_SEED] = 1; // the same order in every run
    const std::lock_guard<std::mutex> guard(LibraryLock());
    if (METIS_NodeND(&blocks, graph.start.data(), graph.neighbour.data(), graph.weight.data(),
                     options.data(), atPosition.data(), position.data()) != METIS_OK)
        keep();
    return position;
}

} // namespace

std::vector<int> EquationOrder(const T_SYMMETRIC_MATRIX& matrix, std::span<const int> block)
{
    T_GRAPH graph = BlockGraph(matrix, block);
    const std::vector<idx_t> position = BlockOrder(graph), &weight = graph.weight;
    std::vector<int> first(weight.size() + 1, 1), at(weight.size());
    for (std::size_t b = 0; b < weight.size(); ++b)
        first[static_cast<std::size_t>(position[b]) + 1] = weight[b];
    for (std::size_t p = 1; p < first.size(); ++p)
        first[p] += first[p - 1];
    for (std::size_t b = 0; b < weight.size(); ++b)
        at[b] = first[static_cast<std::size_t>(position[b])];
    std::vector<int> order(block.size());
    for (std::size_t i = 0; i < block.size(); ++i)
        order[i] = at[static_cast<std::size_t>(block[i])]++;
    return order;
}

} // namespace solver
