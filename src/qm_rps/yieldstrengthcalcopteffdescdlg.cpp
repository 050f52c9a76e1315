#include "qm_rps/yieldstrengthcalcopteffdescdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetable.h"

namespace {

T_SECT_FACTORS Effective(const T_SECT_D& s, const T_SECT_FACTORS& f)
{
    return {s.area * f.area, s.Asy * f.Asy, s.Asz * f.Asz, s.J * f.J, s.Iyy * f.Iyy, s.Izz * f.Izz};
}

/// A property of the table: its symbol, dimension and place.
struct T_PROPERTY {
    const char* symbol;
    T_DIM dim;
    double T_SECT_FACTORS::*value;
};
// clang-format off
constexpr T_PROPERTY kProperties[] = {
    {"A",   {0, 2}, &T_SECT_FACTORS::area}, {"Asy", {0, 2}, &T_SECT_FACTORS::Asy},
    {"Asz", {0, 2}, &T_SECT_FACTORS::Asz},  {"J",   {0, 4}, &T_SECT_FACTORS::J},
    {"Iyy", {0, 4}, &T_SECT_FACTORS::Iyy},  {"Izz", {0, 4}, &T_SECT_FACTORS::Izz},
};
// clang-format on

} // namespace

CYieldStrengthCalcOptEffDescDlg::CYieldStrengthCalcOptEffDescDlg(CDBDoc& doc,
                                                                 const std::vector<int>& elements)
    : m_units(doc.Unit().Units())
{
    for (const int element : elements) {
        T_ROW& row = m_rows.emplace_back();
        row.element = element;
        const T_YIELD_CALC_ELEM found = YieldCalcElemOf(doc, element);
        if (!found.section) {
            row.faultKey = "IDS_CMD_IEHP_NO_SECT";
            continue;
        }
        T_SECT_D s;
        SECT_FAULT fault{};
        if (!CSectionProperties::Calc(*found.section, s, fault)) {
            row.faultKey = MessageKeyOf(fault);
            continue;
        }
        row.section = s.name;
        row.factors = {s.factorsI, s.factorsJ};
        row.effective = {Effective(s, s.factorsI), Effective(s, s.factorsJ)};
        row.plasticModuli = {s.Zy, s.Zz};
        if (!found.material || found.material->type != MATL_CLASS::Steel) continue;
        const T_SHEAR_AREAS areas = CSectionProperties::StrengthShearAreas(s);
        row.shearAreas = {areas.y, areas.z};
    }
}

std::vector<std::string> CYieldStrengthCalcOptEffDescDlg::Heads() const
{
    std::vector<std::string> heads{HeadWithUnit("IDS_QM_UI_HEAD_ELEMENT", kDimNone, m_units),
                                   HeadWithUnit("IDS_CMD_IEHP_SECT_TXT", kDimNone, m_units)};
    for (const char* end : {", I", ", J"})
        for (const T_PROPERTY& p : kProperties)
            heads.push_back(HeadWithUnit(std::string(p.symbol) + end, p.dim, m_units));
    for (const char* symbol : {"Zy", "Zz"})
        heads.push_back(HeadWithUnit(symbol, T_DIM{0, 3}, m_units));
    for (const char* symbol : {"Avy", "Avz"})
        heads.push_back(HeadWithUnit(symbol, T_DIM{0, 2}, m_units));
    return heads;
}

std::vector<std::string> CYieldStrengthCalcOptEffDescDlg::Cells(std::size_t row) const
{
    const T_ROW& r = m_rows.at(row);
    if (*r.faultKey) {
        std::vector<std::string> cells(Heads().size());
        cells[0] = std::to_string(r.element);
        cells[1] = zql::lib::MMSGFunction::GetValue(r.faultKey);
        return cells;
    }
    std::vector<std::string> cells{std::to_string(r.element), r.section};
    for (const T_SECT_FACTORS& end : {r.effective.I, r.effective.J})
        for (const T_PROPERTY& p : kProperties)
            cells.push_back(ShortestText(end.*p.value));
    for (const double z : r.plasticModuli)
        cells.push_back(ShortestText(z));
    for (const double area : r.shearAreas)
        cells.push_back(area > 0.0 ? ShortestText(area) : std::string());
    return cells;
}
