// Results of construction stages in the model file: a row of "staged_results" per stage, step and
// load case, and the blocks of a static result, with the nodes and elements that have anything but
// zeros. Sums of load cases are not stored: the results superpose.
#pragma once

#include "qm_db/results/stagedresult.h"
#include "qm_db/store/staticblocks.h"

/// A row of the table "staged_results".
struct T_STAGED_HEAD {
    T_STATIC_HEAD head;
    int group = kLoadGroupRest; // of the load case
};

/// Writes every load case of every step; throws CStoreFault (BadInput for a source that fails, for
/// unequal lengths and for numbers that are not finite).
void WriteStagedResults(const CSqliteDb& db, const IStagedResult& results);

/// Rows of "staged_results"; their sum goes to `sums`. Throws "damaged" where stage, step and load
/// case come twice or the rows do not belong together.
std::vector<T_STAGED_HEAD> ReadStagedHeads(const CSqliteDb& db, T_TABLE_SUMS& sums);

/// Opens the load cases of a choice, each of which reads only the blocks that it is asked for.
class CBlockStagedResult : public IStagedResult {
public:
    /// `heads` is not empty.
    CBlockStagedResult(std::shared_ptr<const CSqliteDb> db, std::string path,
                       std::vector<T_STAGED_HEAD> heads);

    std::uint64_t Fingerprint() const override { return m_heads.front().head.fingerprint; }
    std::vector<T_STAGE_CASE> Cases() const override;
    [[nodiscard]] int Open(const T_STAGE_CHOICE& choice,
                           std::vector<std::shared_ptr<IStaticResult>>& out) const override;

private:
    std::shared_ptr<const CSqliteDb> m_db;
    std::string m_path; // for messages
    std::vector<T_STAGED_HEAD> m_heads;
};
