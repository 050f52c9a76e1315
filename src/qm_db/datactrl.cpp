#include "qm_db/datactrl.h"

#include <utility>

void CDataCtrl::Assign(T_MODEL_CONTENT content)
{
    m_content = std::move(content);
    m_modified = false;
    ++m_revision;
}

void CDataCtrl::SetResult(int pushover, std::shared_ptr<IPushResult> result)
{
    m_content.results[pushover] = std::move(result);
    m_modified = true;
    ++m_revision;
}

T_MODEL& CDataCtrl::ModelForEdit()
{
    m_modified = true;
    ++m_revision;
    return m_content.model;
}

void CDataCtrl::SetPoverSteps(int pushover, const T_POVR_D& steps)
{
    const auto [it, isNew] = m_content.model.poverSteps.try_emplace(pushover);
    if (!isNew && it->second == steps) return;
    it->second = steps;
    m_modified = true;
}
