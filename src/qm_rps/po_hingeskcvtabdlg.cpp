#include "qm_rps/po_hingeskcvtabdlg.h"

#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/hinge/hingemirror.h"

namespace {

bool IsMultilinear(SKEL_TYPE t)
{
    return t != SKEL_TYPE::Fema && t != SKEL_TYPE::Ec8;
}

} // namespace

int CPO_HingeSkcvTabDlg::Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data)
{
    if (!IsMultilinear(data.type) || !std::holds_alternative<T_SKEL_MULTI>(data.curves.I) ||
        !std::holds_alternative<T_SKEL_MULTI>(data.curves.J))
        return 0;
    m_component = c;
    m_data = data;
    return 1;
}

int CPO_HingeSkcvTabDlg::Dlg2Data(T_HINGE_COMPONENT& data)
{
    if (!CheckData()) return 0;
    data = MirroredComponent(m_data);
    return 1;
}

T_SKEL_MULTI* CPO_HingeSkcvTabDlg::Curve(HINGE_END end)
{
    const bool j = end == HINGE_END::J && !m_data.sameEnds;
    return std::get_if<T_SKEL_MULTI>(j ? &m_data.curves.J : &m_data.curves.I);
}

T_PAGE_VALUES CPO_HingeSkcvTabDlg::Calculated(HINGE_END end)
{
    const auto* curve = Curve(end);
    return curve ? CalculatedPage(m_owner, m_component, end, *curve) : T_PAGE_VALUES{};
}

void CPO_HingeSkcvTabDlg::OnUserAutoRdo(HINGE_END end, bool automatic)
{
    auto* curve = Curve(end);
    if (!curve) return;
    curve->autoYield = automatic;
    OnEdited();
}

void CPO_HingeSkcvTabDlg::OnEdited()
{
    ForEachPage(m_data, [&](HINGE_END end, T_SKEL_CURVE& curve) {
        PutCalculated(Calculated(end), m_data.type, curve);
    });
    m_data = MirroredComponent(m_data);
}

void CPO_HingeSkcvTabDlg::SetDefaultAlpha(HINGE_END end, const T_SIDES<double>& alpha1,
                                          const T_SIDES<double>& alpha2)
{
    T_SKEL_MULTI* m = Curve(end);
    if (!m) return;
    m->sides.pos.alpha1 = alpha1.pos;
    m->sides.neg.alpha1 = alpha1.neg;
    m->sides.pos.alpha2 = alpha2.pos;
    m->sides.neg.alpha2 = alpha2.neg;
}

void CPO_HingeSkcvTabDlg::ChangeInitStiff(HINGE_END end, INIT_STIFFNESS option)
{
    if (T_SKEL_MULTI* m = Curve(end)) m->initStiffness = option;
}

void CPO_HingeSkcvTabDlg::OnChangeSlipInitGap(HINGE_END end, GAP_SIDES sides)
{
    if (T_SKEL_MULTI* m = Curve(end)) m->gapSides = sides;
}

std::vector<T_FINDING> CPO_HingeSkcvTabDlg::Findings() const
{
    return ComponentFindings(m_component, m_data);
}
