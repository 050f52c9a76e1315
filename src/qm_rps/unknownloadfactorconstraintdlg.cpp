#include "qm_rps/unknownloadfactorconstraintdlg.h"

#include "qm_rps/ulfchecks.h"
#include "qm_rps/ulftexts.h"

#include <algorithm>

namespace {

/// Items of a kind that name the constraint take the new name over.
template <class T>
int RenameIn(CDBDoc& doc, const T_TABLE<T>& table, const std::string& before,
             const std::string& after)
{
    const T_TABLE<T> items = table; // the edit changes the table
    for (const auto& [key, item] : items) {
        T changed = item;
        const auto it = std::ranges::find(changed.constraints, before);
        if (it == changed.constraints.end()) continue;
        *it = after;
        if (!doc.Edit().Put(key, changed)) return 0;
    }
    return 1;
}

int RenameInItems(CDBDoc& doc, const std::string& before, const std::string& after)
{
    const T_MODEL& model = doc.Data().Model();
    return RenameIn(doc, model.ulfItems, before, after) &&
           RenameIn(doc, model.ulfStageItems, before, after);
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
    const int key = m_key ? m_key : table.empty() ? 1 : table.rbegin()->first + 1;
    CEditData& edit = m_doc.Edit();
    if (!edit.Begin(c.name)) return 0;
    const bool renamed = before == c.name || RenameInItems(m_doc, before, c.name);
    if (!renamed || !edit.Put(key, c) || !edit.Commit()) {
        edit.Rollback();
        return 0;
    }
    m_key = key;
    return 1;
}
