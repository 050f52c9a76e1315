#include "qm_rps/po_hingeskcvtabeurodlg.h"

#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/hinge/hingemeasure.h"
#include "qm_rps/hinge/hingemirror.h"

int CPO_HingeSkcvTabEuroDlg::Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data)
{
    if (data.type != SKEL_TYPE::Ec8 || !std::holds_alternative<T_SKEL_EC8>(data.curves.I) ||
        !std::holds_alternative<T_SKEL_EC8>(data.curves.J))
        return 0;
    m_component = c;
    m_data = data;
    m_switches = {};
    return 1;
}

int CPO_HingeSkcvTabEuroDlg::Dlg2Data(T_HINGE_COMPONENT& data)
{
    if (!CheckData()) return 0;
    data = MirroredComponent(m_data);
    return 1;
}

T_SKEL_EC8* CPO_HingeSkcvTabEuroDlg::Curve(HINGE_END end)
{
    const bool j = end == HINGE_END::J && !m_data.sameEnds;
    return std::get_if<T_SKEL_EC8>(j ? &m_data.curves.J : &m_data.curves.I);
}

T_PAGE_VALUES CPO_HingeSkcvTabEuroDlg::Calculated(HINGE_END end)
{
    const auto* curve = Curve(end);
    return curve ? CalculatedPage(m_owner, m_component, end, *curve) : T_PAGE_VALUES{};
}

void CPO_HingeSkcvTabEuroDlg::OnUserAutoRdo(HINGE_END end, bool automatic)
{
    auto* curve = Curve(end);
    if (!curve) return;
    curve->autoYield = automatic;
    OnEdited();
}

void CPO_HingeSkcvTabEuroDlg::OnEdited()
{
    ForEachPage(m_data, [&](HINGE_END end, T_SKEL_CURVE& curve) {
        PutCalculated(Calculated(end), m_data.type, curve);
    });
    m_data = MirroredComponent(m_data);
}

int CPO_HingeSkcvTabEuroDlg::OnMeasureRdo(HINGE_END end, SKEL_MEASURE measure)
{
    T_SKEL_EC8* curve = Curve(end);
    if (!curve) return 0;
    if (curve->measure == measure) return 1;
    const T_SKEL_EC8 was = *curve;
    ConvertSides(curve->sides, measure);
    curve->measure = measure;
    std::optional<T_SWITCH>& last = m_switches[end == HINGE_END::J && !m_data.sameEnds ? 1 : 0];
    if (last && last->before.measure == measure)
        RestoreSides(curve->sides, was.sides, last->after.sides, last->before.sides);
    last = T_SWITCH{was, *curve};
    return 1;
}

std::vector<T_FINDING> CPO_HingeSkcvTabEuroDlg::Findings() const
{
    return ComponentFindings(m_component, m_data);
}
