#include "qm_db/store/stagedblocks.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/recordcodecrow.h"

#include <limits>
#include <set>

namespace {

constexpr const char* kStagedTable = "staged_results";

/// Leaves out the nodes and elements whose numbers are all 0.
T_STATIC_DATA WithoutZeros(const T_STATIC_DATA& all)
{
    T_STATIC_DATA out;
    out.fingerprint = all.fingerprint;
    for (std::size_t i = 0; i < all.nodes.size(); ++i) {
        if (all.displacement[i] == T_DOF6{} && all.reaction[i] == T_DOF6{}) continue;
        out.nodes.push_back(all.nodes[i]);
        out.displacement.push_back(all.displacement[i]);
        out.reaction.push_back(all.reaction[i]);
    }
    for (std::size_t i = 0; i < all.elements.size(); ++i) {
        if (all.force[i] == T_ELEM_FORCES{}) continue;
        out.elements.push_back(all.elements[i]);
        out.force.push_back(all.force[i]);
    }
    return out;
}

T_STATIC_DATA ReadCase(const IStagedResult& results, const T_STAGE_CHOICE& at)
{
    std::vector<std::shared_ptr<IStaticResult>> terms;
    T_STATIC_DATA data;
    const bool opened = results.Open(at, terms) && terms.size() <= 1;
    if (!opened || (!terms.empty() && !terms.front()->ReadAll(data))) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_RESULT_SOURCE",
                          std::to_string(at.load), opened ? terms.front()->Error() : "");
    }
    const bool fits = data.displacement.size() == data.nodes.size() &&
                      data.reaction.size() == data.nodes.size() &&
                      data.force.size() == data.elements.size();
    data.fingerprint = results.Fingerprint();
    return fits ? WithoutZeros(data) : data; // what does not fit is refused by the writer
}

int WholeField(const CRecordRow& row, const char* column, int least)
{
    const int value = HeadField(row, column);
    if (value < least) row.ThrowBadCell(column);
    return value;
}

} // namespace

void WriteStagedResults(const CSqliteDb& db, const IStagedResult& results)
{
    CBlockWriter blocks(db);
    int key = 0;
    for (const T_STAGE_CASE& c : results.Cases()) {
        CRecordRow row(kStagedTable, ++key);
        row.Put("stage", std::int64_t{c.at.stage});
        row.Put("step", std::int64_t{c.at.step});
        row.Put("load_case", std::int64_t{c.at.load});
        row.Put("load_group", std::int64_t{c.group});
        T_STATIC_HEAD head;
        head.loadCase = c.at.load;
        head.row = key;
        WriteStaticBlocks(db, blocks, row, head, ReadCase(results, c.at));
    }
}

std::vector<T_STAGED_HEAD> ReadStagedHeads(const CSqliteDb& db, T_TABLE_SUMS& sums)
{
    std::vector<T_STAGED_HEAD> heads;
    std::set<T_STAGE_CHOICE> seen;
    CChecksum sum;
    for (const CRecordRow& row : CRecordRow::ReadAll(db, kStagedTable, sum)) {
        T_STAGED_HEAD staged{ReadHead(row), WholeField(row, "load_group", kLoadGroupDead)};
        T_STATIC_HEAD& head = staged.head;
        if (row.Key() < 1 || row.Key() > std::numeric_limits<int>::max()) row.ThrowBadCell("key");
        head.row = static_cast<int>(row.Key());
        head.stage = WholeField(row, "stage", 1);
        head.step = WholeField(row, "step", kStageFirstStep);
        head.loadCase = WholeField(row, "load_case", 1);
        if (!seen.insert({head.stage, head.step, head.loadCase}).second) row.ThrowBadCell("key");
        if (!heads.empty() && head.fingerprint != heads.front().head.fingerprint)
            row.ThrowBadCell("fingerprint");
        heads.push_back(staged);
    }
    sums[kStagedTable] = sum.Value();
    return heads;
}

CBlockStagedResult::CBlockStagedResult(std::shared_ptr<const CSqliteDb> db, std::string path,
                                       std::vector<T_STAGED_HEAD> heads)
    : m_db(std::move(db)), m_path(std::move(path)), m_heads(std::move(heads))
{
}

std::vector<T_STAGE_CASE> CBlockStagedResult::Cases() const
{
    std::vector<T_STAGE_CASE> all;
    for (const auto& [head, group] : m_heads)
        all.push_back({{head.stage, head.step, head.loadCase}, group});
    return all;
}

int CBlockStagedResult::Open(const T_STAGE_CHOICE& choice,
                             std::vector<std::shared_ptr<IStaticResult>>& out) const
{
    std::vector<std::shared_ptr<IStaticResult>> terms;
    bool isThere = false;
    for (const auto& [head, group] : m_heads) {
        if (head.stage != choice.stage || head.step != choice.step) continue;
        isThere = isThere || choice.load < 0 || head.loadCase == choice.load;
        if (BelongsTo(choice.load, head.loadCase, group) && head.nodes + head.elements > 0)
            terms.push_back(std::make_shared<CBlockStaticResult>(m_db, m_path, head));
    }
    if (isThere) out = std::move(terms);
    return isThere ? 1 : 0;
}
