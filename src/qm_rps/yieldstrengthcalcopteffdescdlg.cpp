#include "qm_rps/yieldstrengthcalcopteffdescdlg.h"

#include "qm_db/sectionproperties.h"

namespace {

T_SECT_FACTORS Effective(const T_SECT_D& s, const T_SECT_FACTORS& f)
{
    return {s.area * f.area, s.Asy * f.Asy, s.Asz * f.Asz, s.J * f.J, s.Iyy * f.Iyy, s.Izz * f.Izz};
}

} // namespace

CYieldStrengthCalcOptEffDescDlg::CYieldStrengthCalcOptEffDescDlg(const std::vector<int>& elements,
                                                                 const T_YIELD_CALC_LOOKUP& lookup)
{
    for (const int element : elements) {
        T_ROW& row = m_rows.emplace_back();
        row.element = element;
        const T_YIELD_CALC_ELEM found = lookup ? lookup(element) : T_YIELD_CALC_ELEM{};
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
    }
}
