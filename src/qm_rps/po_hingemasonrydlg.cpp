#include "qm_rps/po_hingemasonrydlg.h"

#include "qm_rps/hinge/hingesiderules.h"

namespace {

using M = T_MASONRY_HINGE;

// clang-format off
const T_RULE<M> kRules[] = {
    {{.message = "IDS_QM_MASONRY_FORM", .field = "form"}, [](const M& m) { return m.form == 1 || m.form == 2; }},
    {{.message = "IDS_RPS_PO_Masonry_Comp_Strength_larger_than_0", .field = "compStrength"}, [](const M& m) { return Below(0, m.compStrength); }},
    {{.message = "IDS_RPS_PO_Masonry_Shear_Strength_larger_than_0", .field = "shearStrength"}, [](const M& m) { return Below(0, m.shearStrength); }},
    {{.message = "IDS_RPS_PO_Masonry_Hp_0", .field = "Hp"}, [](const M& m) { return Below(0, m.Hp); }, [](const M& m) { return m.form == 1; }},
    {{.message = "IDS_RPS_PO_Masonry_Dist_Coeff_0_1", .field = "distribution"},
     [](const M& m) { return Below(0, m.distribution) && NotAbove(m.distribution, 1); }, [](const M& m) { return m.form == 2; }},
};
// clang-format on

} // namespace

int CPO_HingeMasonryDlg::Dlg2Data(T_MASONRY_HINGE& data)
{
    if (!CheckData()) return 0;
    data = m_masonry;
    return 1;
}

std::vector<T_FINDING> CPO_HingeMasonryDlg::Findings() const
{
    std::vector<T_FINDING> out;
    WalkRules(kRules, m_masonry, {}, out);
    return out;
}
