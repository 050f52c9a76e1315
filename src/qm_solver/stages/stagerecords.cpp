#include "qm_solver/stages/stagerecords.h"

#include <algorithm>

namespace solver {

CStageRecords::CStageRecords(const T_STAGED_MODEL& model, const T_STAGE_PLAN& plan)
    : m_model(model), m_plan(plan)
{
}

void CStageRecords::BeginStage()
{
    m_from.push_back(m_records.size());
}

const T_STEP_RECORD* CStageRecords::Find(std::size_t stage, int step) const
{
    if (stage >= m_from.size()) return nullptr;
    const int steps = m_model.stages[stage].steps;
    if (step == kLastStep) step = steps;
    if (step < 1 || step > steps) return nullptr;
    const std::size_t at = m_from[stage] + static_cast<std::size_t>(step - 1);
    return at < m_records.size() ? &m_records[at] : nullptr;
}

std::vector<double> CStageRecords::Sum(const T_STEP_RECORD& record, const T_MIX& mix,
                                       std::size_t fullCount)
{
    std::vector<double> sum(fullCount, 0.0);
    for (const auto& [loadCase, factor] : mix)
        if (const T_SHARED_FIELD& field = record.moved[loadCase])
            for (std::size_t i = 0; i < fullCount; ++i)
                sum[i] += factor * (*field)[i];
    return sum;
}

decltype(T_HISTORY::birth) CStageRecords::Births(const CStagePart& part,
                                                 std::vector<T_MIX> columns) const
{
    if (m_model.options.birth == BIRTH::ToDesign) return {};
    return [this, &part, columns = std::move(columns)](std::size_t own, std::size_t column,
                                                       T_VEC12& displacement) {
        const std::size_t e = part.Active().elements[own];
        const std::size_t from = m_from[static_cast<std::size_t>(m_plan.bornIn[e])];
        if (from == 0) return false; // nothing stood before it
        const T_STEP_RECORD& before = m_records[from - 1];
        const T_ELEMENT& element = m_model.frame.elements[e];
        displacement = {};
        for (const auto& [loadCase, factor] : columns[column])
            if (const T_SHARED_FIELD& field = before.moved[loadCase])
                for (std::size_t k = 0; k < ElementSize(element); ++k)
                    displacement[k] += factor * (*field)[ElementIndex(element, k)];
        return std::any_of(displacement.begin(), displacement.end(),
                           [](double u) { return u != 0.0; });
    };
}

} // namespace solver
