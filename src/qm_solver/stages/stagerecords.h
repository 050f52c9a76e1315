// What a run through the stages leaves behind: displacements by step and load case.
#pragma once

#include "qm_solver/frame/caseblock.h"
#include "qm_solver/stages/stagepart.h"

#include <memory>
#include <utility>

namespace solver {

/// Load cases with factors.
using T_MIX = std::vector<std::pair<std::size_t, double>>;
using T_SHARED_FIELD = std::shared_ptr<const std::vector<double>>; // by full index; null: 0

/// State at the end of a step. Fields that did not change since the step before are shared with it.
struct T_STEP_RECORD {
    std::size_t part = 0;
    std::vector<char> on;              // by load case: it acts
    std::vector<T_SHARED_FIELD> moved; // by load case
    std::vector<T_AXIAL> axial;        // by element of the part; empty: first order
};

/// Forces are not kept: they follow from the displacements, those at the elements' births among
/// them, in one pass over the elements.
class CStageRecords {
public:
    CStageRecords(const T_STAGED_MODEL& model, const T_STAGE_PLAN& plan);

    /// The first step of the stage is next.
    void BeginStage();
    void Add(T_STEP_RECORD record) { m_records.push_back(std::move(record)); }
    /// Null if the run has not come there.
    const T_STEP_RECORD* Find(std::size_t stage, int step) const;

    static std::vector<double> Sum(const T_STEP_RECORD& record, const T_MIX& mix,
                                   std::size_t fullCount);
    /// Birth displacements of the part's elements, each column a mix of load cases. Valid until the
    /// records change.
    decltype(T_HISTORY::birth) Births(const CStagePart& part, std::vector<T_MIX> columns) const;

private:
    const T_STAGED_MODEL& m_model;
    const T_STAGE_PLAN& m_plan;
    std::vector<T_STEP_RECORD> m_records;
    std::vector<std::size_t> m_from; // first record of each stage
};

} // namespace solver
