#include "qm_db/store/resultblocksource.h"

#include "qm_base/msgfunction.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modelschema.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <new>

CBlockPushResult::CBlockPushResult(std::shared_ptr<const CSqliteDb> db, std::string path,
                                   T_RESULT_HEAD head)
    : m_db(std::move(db)), m_path(std::move(path)), m_head(head)
{
}

template <class F>
int CBlockPushResult::Guarded(const F& read) const
{
    m_error.clear();
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
    return 0;
}

const std::vector<int>& CBlockPushResult::Nodes() const
{
    if (m_nodes) return *m_nodes;
    std::vector<int> nodes;
    for (int chunk = 0; chunk < ChunkCount(m_head.nodes); ++chunk) {
        CBlockRun run(*m_db, {m_head.pushover, BLOCK_PART::NodeIds, chunk});
        run.Next(ChunkSize(m_head.nodes, chunk), nodes);
        if (std::ranges::adjacent_find(nodes, std::ranges::greater_equal()) != nodes.end())
            ThrowBadBlock({m_head.pushover, BLOCK_PART::NodeIds, chunk});
    }
    return m_nodes.emplace(std::move(nodes));
}

std::vector<int> CBlockPushResult::NodeIds() const
{
    std::vector<int> nodes;
    return Guarded([&] { nodes = Nodes(); }) ? nodes : std::vector<int>{};
}

bool CBlockPushResult::HasNode(int node) const
{
    bool found = false;
    return Guarded([&] { found = std::binary_search(Nodes().begin(), Nodes().end(), node); }) &&
           found;
}

int CBlockPushResult::ReadSeries(BLOCK_PART part, std::vector<double>& out)
{
    std::vector<double> values;
    const int done = Guarded([&] {
        CBlockRun(*m_db, {m_head.pushover, part}).Next(m_head.steps, values);
    });
    out = std::move(values);
    if (!done) out.clear();
    return done;
}

int CBlockPushResult::ReadLoadFactors(std::vector<double>& out)
{
    return ReadSeries(BLOCK_PART::LoadFactor, out);
}

int CBlockPushResult::ReadBaseReactions(std::vector<double>& out)
{
    return ReadSeries(BLOCK_PART::BaseReaction, out);
}

const std::vector<double>& CBlockPushResult::Chunk(int chunk)
{
    if (chunk == m_chunk) return m_values;
    m_chunk = -1;
    m_values.clear();
    CBlockRun run(*m_db, {m_head.pushover, BLOCK_PART::Displacement, chunk});
    for (int step = 0; step < m_head.steps; ++step)
        run.Next(ChunkSize(m_head.nodes, chunk), m_values);
    m_chunk = chunk;
    return m_values;
}

int CBlockPushResult::ReadDisplacements(int node, std::vector<double>& out)
{
    std::vector<double> series;
    const int done = Guarded([&] {
        const std::vector<int>& nodes = Nodes();
        const auto it = std::lower_bound(nodes.begin(), nodes.end(), node);
        if (it == nodes.end() || *it != node) {
            throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NO_NODE_RESULT",
                              std::to_string(m_head.pushover), std::to_string(node));
        }
        const int index = static_cast<int>(it - nodes.begin());
        const int chunk = index / kBlockNodes;
        const auto size = static_cast<std::size_t>(ChunkSize(m_head.nodes, chunk));
        const std::vector<double>& values = Chunk(chunk);
        for (auto at = static_cast<std::size_t>(index % kBlockNodes); at < values.size();
             at += size)
            series.push_back(values[at]);
    });
    out = std::move(series);
    if (!done) out.clear();
    return done;
}
