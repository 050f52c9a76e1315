#include "qm_db/store/runblocksource.h"

#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_solver/pushresult.h"

#include <algorithm>
#include <limits>
#include <new>

namespace {

constexpr int kLargest = std::numeric_limits<int>::max();

T_DOF6 VectorAt(std::span<const double> numbers, std::size_t at)
{
    T_DOF6 v;
    std::copy_n(numbers.begin() + static_cast<std::ptrdiff_t>(at), v.size(), v.begin());
    return v;
}

} // namespace

CBlockPushRun::CBlockPushRun(std::shared_ptr<const CSqliteDb> db, std::string path, T_RUN_ROW row)
    : m_db(std::move(db)), m_path(std::move(path)), m_row(std::move(row))
{
}

template <class T, class F>
int CBlockPushRun::Guarded(std::vector<T>& out, const F& read) const
{
    m_error.clear();
    out.clear();
    try {
        read();
        return 1;
    } catch (const CStoreFault& fault) {
        m_error = fault.ForFile(m_path).text;
    } catch (const std::bad_alloc&) {
        throw; // not a fault of the results
    } catch (const std::exception& fault) {
        m_error = m_path + ": " + fault.what();
    }
    out.clear();
    return 0;
}

template <class N>
std::vector<N> CBlockPushRun::List(BLOCK_PART part) const
{
    std::vector<N> values;
    CBlockRun(*m_db, RunKey(m_row, part)).Next(RunChunkNumbers(m_row, RunPartOf(part), 0), values);
    return values;
}

int CBlockPushRun::WholeOf(BLOCK_PART part, double value, int low, int high) const
{
    if (!(value >= low && value <= high) || value != std::floor(value))
        ThrowBadBlock(RunKey(m_row, part));
    return static_cast<int>(value);
}

const std::vector<int>& CBlockPushRun::Nodes() const
{
    if (m_nodes) return *m_nodes;
    std::vector<int> nodes = List<int>(BLOCK_PART::RunNodes);
    if (std::ranges::adjacent_find(nodes, std::ranges::greater_equal()) != nodes.end())
        ThrowBadBlock(RunKey(m_row, BLOCK_PART::RunNodes));
    return m_nodes.emplace(std::move(nodes));
}

std::vector<int> CBlockPushRun::NodeIds() const
{
    std::vector<int> nodes;
    (void)Guarded(nodes, [&] { nodes = Nodes(); });
    return nodes;
}

bool CBlockPushRun::HasNode(int node) const
{
    return std::ranges::binary_search(NodeIds(), node);
}

int CBlockPushRun::ReadSteps(std::vector<T_RUN_STEP>& out)
{
    return Guarded(out, [&] {
        constexpr BLOCK_PART kPart = BLOCK_PART::RunSteps;
        const std::vector<double> all = List<double>(kPart);
        constexpr std::size_t kWidth = std::tuple_size_v<T_STEP_NUMBERS>;
        for (std::size_t at = 0; at < all.size(); at += kWidth) {
            const auto n = std::span(all).subspan(at, kWidth);
            const int additional = WholeOf(kPart, n[11], 0, 2);
            out.push_back({WholeOf(kPart, n[0], 0, kLargest), n[1], n[2], n[3], VectorAt(n, 4),
                           n[10], additional > 0, additional == 2});
        }
    });
}

int CBlockPushRun::ReadEvents(std::vector<T_RUN_EVENT>& out)
{
    return Guarded(out, [&] {
        constexpr BLOCK_PART kPart = BLOCK_PART::RunEvents, kTurns = BLOCK_PART::RunTurns;
        const std::vector<double> all = List<double>(kPart);
        const std::vector<int> turns = List<int>(kTurns);
        constexpr std::size_t kWidth = std::tuple_size_v<T_EVENT_NUMBERS>;
        std::size_t turn = 0;
        for (std::size_t at = 0; at < all.size(); at += kWidth) {
            const auto n = std::span(all).subspan(at, kWidth);
            T_RUN_EVENT& event = out.emplace_back(T_RUN_EVENT{
                WholeOf(kPart, n[0], -1, kLargest), n[1], n[2], n[3], VectorAt(n, 4), {}});
            const auto left = static_cast<int>((turns.size() - turn) / 4);
            for (int i = WholeOf(kPart, n[10], 0, left); i > 0; --i, turn += 4)
                event.turns.push_back(
                    {WholeOf(kTurns, turns[turn], 0, m_row.hinges - 1),
                     static_cast<solver::HINGE_TURN>(WholeOf(
                         kTurns, turns[turn + 1], 0, static_cast<int>(solver::HINGE_TURN::Leap))),
                     turns[turn + 2], WholeOf(kTurns, turns[turn + 3], 0, 1) == 1});
        }
        if (turn != turns.size()) ThrowBadBlock(RunKey(m_row, kTurns));
    });
}

int CBlockPushRun::ReadHinges(std::vector<T_RUN_HINGE>& out)
{
    return Guarded(out, [&] {
        constexpr BLOCK_PART kPart = BLOCK_PART::RunHinges;
        const std::vector<double> all = List<double>(kPart);
        for (std::size_t at = 0; at < all.size(); at += std::tuple_size_v<T_HINGE_NUMBERS>)
            out.push_back({WholeOf(kPart, all[at], 0, kLargest), all[at + 1],
                           WholeOf(kPart, all[at + 2], 0, 5)});
    });
}

std::vector<double> CBlockPushRun::OfStep(BLOCK_PART partKey, int step) const
{
    const T_RUN_PART& part = RunPartOf(partKey);
    if (step < 1 || step > m_row.steps)
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NO_STEP_RESULT",
                          std::to_string(m_row.pushover), std::to_string(step));
    std::vector<double> values;
    for (int chunk = 0; chunk < RunChunks(m_row, part); ++chunk)
        CBlockRun(*m_db, RunKey(m_row, partKey, chunk, step - 1))
            .Next(RunChunkNumbers(m_row, part, chunk), values);
    return values;
}

template <class F>
void CBlockPushRun::ForEachStep(BLOCK_PART partKey, int at, T_CHUNK& kept, const F& f) const
{
    const T_RUN_PART& part = RunPartOf(partKey);
    const int chunk = at / part.block;
    const int numbers = RunChunkNumbers(m_row, part, chunk);
    if (kept.chunk != chunk) {
        kept = {};
        CBlockRun run(*m_db, RunKey(m_row, partKey, chunk));
        for (int step = 0; step < m_row.steps; ++step)
            run.Next(numbers, kept.values);
        kept.chunk = chunk;
    }
    const auto width = static_cast<std::size_t>(part.width);
    for (auto from = static_cast<std::size_t>(at % part.block) * width; from < kept.values.size();
         from += static_cast<std::size_t>(numbers))
        f(std::span(kept.values).subspan(from, width));
}

int CBlockPushRun::ReadStart(std::vector<T_DOF6>& out)
{
    return Guarded(out, [&] {
        const std::vector<double> all = List<double>(BLOCK_PART::RunStart);
        for (std::size_t at = 0; at < all.size(); at += std::tuple_size_v<T_DOF6>)
            out.push_back(VectorAt(all, at));
    });
}

int CBlockPushRun::ReadNode(int node, std::vector<T_DOF6>& out)
{
    return Guarded(out, [&] {
        const std::vector<int>& nodes = Nodes();
        const auto it = std::ranges::lower_bound(nodes, node);
        if (it == nodes.end() || *it != node)
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NO_NODE_RESULT",
                              std::to_string(m_row.pushover), std::to_string(node));
        ForEachStep(BLOCK_PART::RunDisplacement, static_cast<int>(it - nodes.begin()), m_shapes,
                    [&](std::span<const double> n) { out.push_back(VectorAt(n, 0)); });
    });
}

int CBlockPushRun::ReadShape(int step, std::vector<T_DOF6>& out)
{
    return Guarded(out, [&] {
        const std::vector<double> all = OfStep(BLOCK_PART::RunDisplacement, step);
        for (std::size_t at = 0; at < all.size(); at += std::tuple_size_v<T_DOF6>)
            out.push_back(VectorAt(all, at));
    });
}

T_RUN_STATE CBlockPushRun::StateOf(std::span<const double> n) const
{
    return {n[0], n[1], n[2], WholeOf(BLOCK_PART::RunState, n[3], -kLargest, kLargest)};
}

int CBlockPushRun::ReadHinge(std::size_t hinge, std::vector<T_RUN_STATE>& out)
{
    return Guarded(out, [&] {
        if (hinge >= static_cast<std::size_t>(m_row.hinges))
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NO_HINGE_RESULT",
                              std::to_string(m_row.pushover), std::to_string(hinge + 1));
        ForEachStep(BLOCK_PART::RunState, static_cast<int>(hinge), m_states,
                    [&](std::span<const double> n) { out.push_back(StateOf(n)); });
    });
}

int CBlockPushRun::ReadStates(int step, std::vector<T_RUN_STATE>& out)
{
    return Guarded(out, [&] {
        const std::vector<double> all = OfStep(BLOCK_PART::RunState, step);
        constexpr std::size_t kWidth = std::tuple_size_v<T_STATE_NUMBERS>;
        for (std::size_t at = 0; at < all.size(); at += kWidth)
            out.push_back(StateOf(std::span(all).subspan(at, kWidth)));
    });
}
