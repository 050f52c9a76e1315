#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetable.h"

#include <algorithm>

CYieldStrengthCalcOptMatDescDlg::CYieldStrengthCalcOptMatDescDlg(CDBDoc& doc,
                                                                 const std::vector<int>& elements)
    : m_units(doc.Unit().Units())
{
    for (const int element : elements) {
        T_ROW& row = m_rows.emplace_back();
        row.element = element;
        const T_YIELD_CALC_ELEM found = YieldCalcElemOf(doc, element);
        if (!found.material) {
            row.faultKey = "IDS_CMD_IEHP_NO_MATL";
            continue;
        }
        const T_MATL_D& m = *found.material;
        row.material = m.name;
        row.E = m.E;
        const bool bars = m.type == MATL_CLASS::Concrete || m.type == MATL_CLASS::Composite;
        if (m.type == MATL_CLASS::Steel || m.type == MATL_CLASS::Composite) row.Fy = m.Fy;
        if (m.type != MATL_CLASS::Steel) row.fck = m.fck;
        const double fckMpa = ToSi(m.fck, m_units, kDimStress) / 1e6;
        if (bars && fckMpa <= kMaxFckMpa * (1.0 + 1e-9))
            row.law = ConcreteLaw(std::min(fckMpa, kMaxFckMpa));
        if (bars) row.fyk = m.fyk, row.Es = m.Es;
    }
}

std::vector<std::string> CYieldStrengthCalcOptMatDescDlg::Heads() const
{
    std::vector<std::string> heads{HeadWithUnit("IDS_QM_UI_HEAD_ELEMENT", kDimNone, m_units),
                                   HeadWithUnit("IDS_QM_UI_HINGE_MATERIAL", kDimNone, m_units)};
    for (const char* symbol : {"Fy", "fck", "fyk", "E", "Es"})
        heads.push_back(HeadWithUnit(symbol, kDimStress, m_units));
    for (const char* symbol : {"n", "eps_c2", "eps_cu2"})
        heads.push_back(symbol);
    return heads;
}

std::vector<std::string> CYieldStrengthCalcOptMatDescDlg::Cells(std::size_t row) const
{
    const T_ROW& r = m_rows.at(row);
    std::vector<std::string> cells{std::to_string(r.element),
                                   r.material.empty() && *r.faultKey
                                       ? zql::lib::MMSGFunction::GetValue(r.faultKey)
                                       : r.material};
    for (const std::optional<double>& v : {r.Fy, r.fck, r.fyk, r.E, r.Es})
        cells.push_back(v ? ShortestText(*v) : std::string());
    const T_CONCRETE_LAW law = r.law.value_or(T_CONCRETE_LAW{});
    for (const double v : {law.n, law.peakStrain, law.crushStrain})
        cells.push_back(r.law ? FormatText("%.4g", v) : std::string());
    return cells;
}
