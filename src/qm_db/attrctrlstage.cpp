#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/attrctrl.h"
#include "qm_db/records/recordunits.h"

// Records of construction stages; they hold no quantities.

using zql::lib::MMSGFunction;

namespace {

template <class T>
int Get(const T_TABLE<T>& table, int key, T& out)
{
    const auto it = table.find(key);
    if (it == table.end()) return 0;
    out = it->second;
    return 1;
}

template <class T>
int FindByName(const T_TABLE<T>& table, std::string_view name, int& key)
{
    for (const auto& [k, record] : table) {
        if (record.name != name) continue;
        key = k;
        return 1;
    }
    return 0;
}

/// The same in every language: reports are compared by them.
std::string StepName(const T_STAG_D& stage, int step)
{
    if (step == kStageFirstStep) return "First Step";
    if (step == kStageLastStep || step == stage.steps) return "Last Step";
    return FormatText("User Step:%2d", step);
}

struct T_SUM_NAME {
    const char* text;
    int key;
};
constexpr T_SUM_NAME kSumNames[] = {{"IDS_DB_SGLD_SUM", kStageLoadSum},
                                    {"IDS_DB_SGLD_DL", kStageLoadDead},
                                    {"IDS_DB_SGLD_ER", kStageLoadErection}};

} // namespace

int CAttrCtrl::GetStag(int key, T_STAG_D& out) const
{
    return Get(m_data.Model().stages, key, out);
}

int CAttrCtrl::GetUlsi(int key, T_ULSI_D& out) const
{
    return Get(m_data.Model().ulfStageItems, key, out);
}

int CAttrCtrl::GetStct(T_STCT_D& out) const
{
    out = m_data.Model().styp.stageControl;
    return 1;
}

int CAttrCtrl::FindStag(std::string_view name, int& key) const
{
    return FindByName(m_data.Model().stages, name, key);
}

int CAttrCtrl::FindUlsi(std::string_view name, int& key) const
{
    return FindByName(m_data.Model().ulfStageItems, name, key);
}

int CAttrCtrl::GetStagStepInfo(int stage, int step, T_STAG_STEP_INFO& out) const
{
    T_STAG_D record;
    if (!GetStag(stage, record) || StageStepNumber(record, step) == 0) return 0;
    out = {stage, step, record.name, StepName(record, step)};
    return 1;
}

int CAttrCtrl::GetStagStepInfo(int number, T_STAG_STEP_INFO& out) const
{
    if (number < 1) return 0;
    for (const auto& [key, stage] : m_data.Model().stages) {
        if (number > stage.steps) {
            number -= stage.steps;
            continue;
        }
        const bool last = number == stage.steps && stage.steps > 1;
        return GetStagStepInfo(key, last ? kStageLastStep : number, out);
    }
    return 0;
}

int CAttrCtrl::GetSgldKey(std::string_view name, int& key) const
{
    for (const T_SUM_NAME& sum : kSumNames) {
        if (MMSGFunction::GetValue(sum.text) != name) continue;
        key = sum.key;
        return 1;
    }
    return FindStld(name, key);
}

int CAttrCtrl::GetPtns(int loadCase, int element, T_PTNS_D& out) const
{
    const auto it = m_data.Model().loadCases.find(loadCase);
    if (it == m_data.Model().loadCases.end()) return 0;
    bool found = false;
    double sum = 0.0;
    for (const T_PTNS_D& load : it->second.pretension) {
        if (load.element != element) continue;
        sum += load.force;
        found = true;
    }
    if (!found) return 0;
    out = {element, FromSi(sum, m_data.Units(), kDimForce)};
    return 1;
}
