#include "qm_rps/po_hingemasonrydlg.h"

#include "qm_rps/hinge/hingesiderules.h"

namespace {

using M = T_MASONRY_HINGE;
constexpr auto kLit = RULE_TEXT::Literal;

// clang-format off
const T_RULE<M> kRules[] = {
    {{"IDS_QM_MASONRY_FORM", kLit, nullptr, nullptr, "form"}, [](const M& m) { return m.form == 1 || m.form == 2; }},
    {{"IDS_RPS_PO_Masonry_Comp_Strength_larger_than_0",  kLit, nullptr, nullptr, "compStrength"},  [](const M& m) { return Below(0, m.compStrength); }},
    {{"IDS_RPS_PO_Masonry_Shear_Strength_larger_than_0", kLit, nullptr, nullptr, "shearStrength"}, [](const M& m) { return Below(0, m.shearStrength); }},
    {{"IDS_RPS_PO_Masonry_Hp_0",         kLit, nullptr, nullptr, "Hp"},           [](const M& m) { return Below(0, m.Hp); }, [](const M& m) { return m.form == 1; }},
    {{"IDS_RPS_PO_Masonry_Dist_Coeff_0_1", kLit, nullptr, nullptr, "distribution"},
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
    WalkRules(std::span<const T_RULE<M>>(kRules), m_masonry, {}, out);
    return out;
}
