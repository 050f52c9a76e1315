#include "qm_rps/unknownloadfactorconstraintdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_db/editscope.h"
#include "qm_rps/factors/checks/ulfconstraintchecks.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulftexts.h"

#include <algorithm>
#include <tuple>

namespace {

/// Items of a kind that name the constraint take the new name over.
template <class T>
int RenameIn(CEditScope& edit, T_TABLE<T> items, const std::string& before,
             const std::string& after)
{
    for (auto& [key, item] : items) {
        const auto it = std::ranges::find(item.constraints, before);
        if (it == item.constraints.end()) continue;
        *it = after;
        if (!edit.Put(key, item)) return 0;
    }
    return 1;
}

int RenameInItems(CDBDoc& doc, CEditScope& edit, const std::string& before,
                  const std::string& after)
{
    const T_MODEL& model = doc.Data().Model();
    return RenameIn(edit, model.ulfItems, before, after) &&
           RenameIn(edit, model.ulfStageItems, before, after);
}

} // namespace

CUnknownLoadFactorConstraintDlg::CUnknownLoadFactorConstraintDlg(CDBDoc& doc, int key) : m_doc(doc)
{
    if (m_doc.Attr().GetUlfc(key, m_constraint)) m_key = key;
}

int CUnknownLoadFactorConstraintDlg::Dlg2Data(T_ULFC_D& constraint)
{
    if (!CheckData()) return 0;
    T_ULFC_D c = m_constraint;
    FitRecord(c);
    constraint = std::move(c);
    return 1;
}

std::vector<std::string> CUnknownLoadFactorConstraintDlg::ComponentTexts() const
{
    std::vector<std::string> texts;
    const int count = m_constraint.type == ULFC_TYPE::Truss ? 1 : 6;
    for (int i = 0; i < count; ++i)
        texts.push_back(UlfComponentText(m_constraint.type, i));
    return texts;
}

void CUnknownLoadFactorConstraintDlg::OnSelChangeType(int type)
{
    m_constraint.type = static_cast<ULFC_TYPE>(type);
    const int count = static_cast<int>(ComponentTexts().size());
    if (m_constraint.component >= count) m_constraint.component = 0;
}

CUnknownLoadFactorConstraintDlg::RELATION CUnknownLoadFactorConstraintDlg::Relation() const
{
    if (m_constraint.inequality) return Bounds;
    return m_constraint.compareWithValue ? EqualsValue : EqualsOther;
}

void CUnknownLoadFactorConstraintDlg::OnSelChangeRelation(int relation)
{
    m_constraint.inequality = relation == Bounds;
    m_constraint.compareWithValue = relation != EqualsOther;
}

std::vector<std::string> CUnknownLoadFactorConstraintDlg::PositionTexts()
{
    std::vector<std::string> texts;
    for (int i = 0; !UlfPositionText(i).empty(); ++i)
        texts.push_back(UlfPositionText(i));
    return texts;
}

std::string CUnknownLoadFactorConstraintDlg::UnitText() const
{
    return UlfUnitText(m_constraint.type, m_constraint.component, m_doc.Unit().Units());
}

std::vector<std::string> CUnknownLoadFactorConstraintDlg::PlaceTexts() const
{
    std::vector<std::string> texts{zql::lib::MMSGFunction::GetValue("IDS_QM_UI_ULF_NO_PLACE")};
    for (const auto& [stage, step] : UlfPlaces(m_doc.Data().Model()))
        texts.push_back(UlfPlaceText(m_doc.Data(), stage, step));
    return texts;
}

int CUnknownLoadFactorConstraintDlg::PlaceIndex() const
{
    if (m_constraint.stage == 0) return 0;
    const T_MODEL& model = m_doc.Data().Model();
    const auto places = UlfPlaces(model);
    const auto same = [&](const std::pair<int, int>& place) {
        return place.first == m_constraint.stage &&
               UlfStepNumber(model, place.first, place.second) ==
                   UlfStepNumber(model, m_constraint.stage, m_constraint.step);
    };
    const auto it = std::ranges::find_if(places, same);
    return it == places.end() ? -1 : static_cast<int>(it - places.begin()) + 1;
}

void CUnknownLoadFactorConstraintDlg::OnSelChangePlace(int index)
{
    const auto places = UlfPlaces(m_doc.Data().Model());
    m_constraint.stage = 0;
    m_constraint.step = kStageLastStep;
    if (index >= 1 && index <= std::ssize(places))
        std::tie(m_constraint.stage, m_constraint.step) =
            places[static_cast<std::size_t>(index - 1)];
}

std::vector<T_FINDING> CUnknownLoadFactorConstraintDlg::Findings() const
{
    return CheckUlfConstraint(m_constraint, m_key, m_doc.Data().Model());
}

int CUnknownLoadFactorConstraintDlg::OnOK()
{
    T_ULFC_D c;
    if (!Dlg2Data(c)) return 0;
    const T_TABLE<T_ULFC_D>& table = m_doc.Data().Model().ulfConstraints;
    const auto own = table.find(m_key);
    const std::string before = own == table.end() ? c.name : own->second.name;
    const int key = m_key ? m_key : NextKey(table);
    CEditScope edit(m_doc, c.name);
    const bool renamed = before == c.name || RenameInItems(m_doc, edit, before, c.name);
    if (!renamed || !edit.Put(key, c) || !edit.Commit()) return 0;
    m_key = key;
    return 1;
}
