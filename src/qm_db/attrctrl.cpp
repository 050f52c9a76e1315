#include "qm_db/attrctrl.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/records/lcomflatten.h"

#include <set>
#include <utility>

using zql::lib::MMSGFunction;

namespace {

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

std::vector<int> ElementsWithHingeType(const T_MODEL& model, int hingeType)
{
    std::set<int> ids;
    for (const auto& entry : model.hinges) {
        if (entry.second.hingeType == hingeType) ids.insert(entry.second.element);
    }
    return {ids.begin(), ids.end()};
}

int CAttrCtrl::GetStyp(T_STYP_D& out) const
{
    out = m_data.Model().styp;
    RecordFromSi(out, m_data.Units());
    return 1;
}

int CAttrCtrl::GetPogc(T_POGC_D& out) const
{
    out = m_data.Model().pushControl; // it has no quantities
    return 1;
}

int CAttrCtrl::GetConsNode(int id, std::array<int, 6>& out) const
{
    const auto it = m_data.Model().nodes.find(id);
    if (it == m_data.Model().nodes.end()) return 0;
    out = it->second.restraint;
    return 1;
}

int CAttrCtrl::GetPhgt(int key, T_PHGT_D& out) const
{
    const auto it = m_data.Model().hingeTypes.find(key);
    if (it == m_data.Model().hingeTypes.end()) return 0;
    out = it->second;
    // As entered, so that a switch of the deformation measure starts from the entered digits.
    ForEachQuantity(out, [&](double& v, T_DIM d) { v = ShortFromSi(v, m_data.Units(), d); });
    return 1;
}

int CAttrCtrl::GetLcom_(std::string_view name, T_LCOM_D& out) const
{
    int key = 0;
    return Find<T_LCOM_D>(name, key) && GetLcom(key, out);
}

int CAttrCtrl::GetUlfc_(std::string_view name, T_ULFC_D& out) const
{
    int key = 0;
    return Find<T_ULFC_D>(name, key) && GetUlfc(key, out);
}

int CAttrCtrl::NormalizeLcom(const T_LCOM_D& in, T_LCOM_D& out, std::string& error) const
{
    return FlattenLcom(m_data.Model(), in, out, error);
}

int CAttrCtrl::NormalizeLcom(const T_LCOM_D& in, T_LCOM_D& out) const
{
    std::string ignored;
    return NormalizeLcom(in, out, ignored);
}

int CAttrCtrl::GetSectMatlByElem(int element, T_SECT_D& sect, T_MATL_D& matl) const
{
    T_ELEM_D elem;
    T_SECT_D s;
    T_MATL_D m;
    if (!GetElem(element, elem) || !GetSect(elem.section, s) || !GetMatl(elem.material, m))
        return 0;
    sect = std::move(s);
    matl = std::move(m);
    return 1;
}

std::vector<int> CAttrCtrl::GetElemsByPhgt(int hingeType) const
{
    return ElementsWithHingeType(m_data.Model(), hingeType);
}

// ---- construction stages ------------------------------------------------------------------------

int CAttrCtrl::GetStct(T_STCT_D& out) const
{
    out = m_data.Model().styp.stageControl;
    return 1;
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
