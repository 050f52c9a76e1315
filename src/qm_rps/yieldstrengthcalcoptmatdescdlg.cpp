#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"

CYieldStrengthCalcOptMatDescDlg::CYieldStrengthCalcOptMatDescDlg(const std::vector<int>& elements,
                                                                 const T_YIELD_CALC_LOOKUP& lookup)
{
    for (const int element : elements) {
        T_ROW& row = m_rows.emplace_back();
        row.element = element;
        const T_YIELD_CALC_ELEM found = lookup ? lookup(element) : T_YIELD_CALC_ELEM{};
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
        if (bars) row.fyk = m.fyk, row.Es = m.Es;
    }
}
