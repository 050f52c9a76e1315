#include "qm_db/datactrl.h"

#include "qm_db/records/modelfault.h"

#include "qm_db/editscope.h"
#include "qm_db/records/lcomflatten.h"

#include <algorithm>
#include <utility>

void CDataCtrl::Assign(T_MODEL_CONTENT content)
{
    m_content = std::move(content);
    m_place = 0;
    SetModified(false);
    ++m_revision;
}

void CDataCtrl::SetModified(bool modified)
{
    if (!modified)
        m_saved = m_place;
    else if (!m_modified)
        m_saved = kNowhere;
    m_modified = modified;
}

void CDataCtrl::ComeTo(long place)
{
    m_place = place;
    m_modified = m_place != m_saved;
}

void CDataCtrl::SetStaticResult(int loadCase, std::shared_ptr<IStaticResult> result)
{
    if (result)
        m_content.staticResults[loadCase] = std::move(result);
    else
        m_content.staticResults.erase(loadCase);
    ChangeForGood();
    ++m_revision;
}

std::string CDataCtrl::Fault() const
{
    return ModelFault(m_content.model);
}

void CDataCtrl::SetPushRuns(int pushover, const std::vector<std::shared_ptr<IPushRun>>& runs)
{
    T_RESULT_MAP& results = m_content.results;
    const auto before = results.find(pushover);
    if (before != results.end() && before->second->Run()) results.erase(before);
    std::erase_if(m_content.turnedResults,
                  [&](const auto& entry) { return entry.first.first == pushover; });
    for (const std::shared_ptr<IPushRun>& run : runs)
        if (const int turn = run->Head().turn; turn == 0)
            results[pushover] = run;
        else
            m_content.turnedResults[{pushover, turn}] = run;
    m_content.model.poverSteps.erase(pushover); // they number the steps of the run before
    ChangeForGood();
    ++m_revision;
}

void CDataCtrl::SetStagedResult(std::shared_ptr<IStagedResult> result)
{
    m_content.stagedResult = std::move(result);
    ChangeForGood();
    ++m_revision;
}

int CDataCtrl::AddLcom(const T_LCOM_D& combination)
{
    const auto& table = Model().combinations;
    const bool taken = std::ranges::any_of(
        table, [&](const auto& entry) { return entry.second.name == combination.name; });
    T_LCOM_D flat;
    std::string ignored;
    if (!m_editor || combination.name.empty() || taken ||
        !FlattenLcom(Model(), combination, flat, ignored))
        return 0;
    CEditScope edit(*m_editor, combination.name, EDIT_STEP::Join);
    return edit.Put(NextKey(table), combination) && edit.Commit();
}

/// No step takes results back.
void CDataCtrl::ChangeForGood()
{
    m_saved = kNowhere;
    m_modified = true;
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
    ChangeForGood();
}
