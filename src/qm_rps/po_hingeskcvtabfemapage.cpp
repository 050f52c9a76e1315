// What a page of the editor of FEMA curves shows.
#include "qm_base/textformat.h"
#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/po_hingefemaenrgdsptgrid.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"

#include <algorithm>

namespace {

std::size_t EndIndex(HINGE_END end)
{
    return end == HINGE_END::J ? 1 : 0;
}

} // namespace

void CPO_HingeSkcvTabFemaDlg::OnSelChangeAxialCombo(HINGE_COMPONENT c, HINGE_END end, int index)
{
    m_axial[static_cast<std::size_t>(c)][EndIndex(end)] = index;
}

int CPO_HingeSkcvTabFemaDlg::AxialIndex(HINGE_COMPONENT c, HINGE_END end)
{
    const T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve || !curve->multiCurve || curve->curves.empty()) return -1;
    const int last = static_cast<int>(curve->curves.size()) - 1;
    return std::clamp(m_axial[static_cast<std::size_t>(c)][EndIndex(end)], 0, last);
}

std::vector<std::string> CPO_HingeSkcvTabFemaDlg::AxialTexts(HINGE_COMPONENT c, HINGE_END end)
{
    std::vector<std::string> texts;
    if (const T_SKEL_FEMA* curve = Curve(c, end))
        for (const T_SKEL_AXIAL& a : curve->curves)
            texts.push_back(ShortestText(a.axial));
    return texts;
}

T_SIDES<T_SKEL_SIDE>& CPO_HingeSkcvTabFemaDlg::ShownSides(HINGE_COMPONENT c, HINGE_END end)
{
    T_SIDES<T_SKEL_SIDE>* chosen = SidesOf(c, end, AxialIndex(c, end));
    return chosen ? *chosen : Curve(c, end)->sides;
}

T_SKEL_FEMA CPO_HingeSkcvTabFemaDlg::ShownCurve(HINGE_COMPONENT c, HINGE_END end)
{
    T_SKEL_FEMA shown = *Curve(c, end);
    shown.sides = ShownSides(c, end);
    shown.multiCurve = false;
    return shown;
}

void CPO_HingeSkcvTabFemaDlg::OnDcRatioChk(HINGE_COMPONENT c, HINGE_END end, bool on)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve || curve->dcRatio.has_value() == on) return;
    curve->dcRatio = on ? std::optional(T_SIDES<double>{1.0, 1.0}) : std::nullopt;
}

void CPO_HingeSkcvTabFemaDlg::OnUserAutoRdo(HINGE_COMPONENT c, HINGE_END end, bool automatic)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve) return;
    curve->autoYield = automatic;
    const T_SIDE_VALUES yield = Calculated(c, end).yield;
    if (yield.pos && yield.neg) SetAutoCalcValue(c, end, {*yield.pos, *yield.neg});
    OnEdited();
}

int CPO_HingeSkcvTabFemaDlg::OnEnergyBtn(HINGE_COMPONENT c, HINGE_END end)
{
    if (!Curve(c, end)) return 0;
    CPO_HingeFEMAEnrgDsptGrid grid;
    grid.SetView(View());
    grid.Data2Dlg(ShownSides(c, end));
    if (!grid.DoModal() || !grid.CheckData()) return 0;
    grid.Dlg2Data(ShownSides(c, end));
    return 1;
}

void CPO_HingeSkcvTabFemaDlg::OnEdited()
{
    for (std::size_t i = 0; i < m_components.size(); ++i) {
        auto& component = m_components[i];
        if (!component) continue;
        const auto c = static_cast<HINGE_COMPONENT>(i);
        ForEachPage(*component, [&](HINGE_END end, T_SKEL_CURVE& curve) {
            const T_PAGE_VALUES values = Calculated(c, end);
            if (values.yield.pos && values.yield.neg)
                SetAutoCalcValue(c, end, {*values.yield.pos, *values.yield.neg});
            PutCalculated({{}, values.deform}, component->type, curve);
        });
        *component = MirroredComponent(*component);
    }
}

T_PAGE_VALUES CPO_HingeSkcvTabFemaDlg::Calculated(HINGE_COMPONENT c, HINGE_END end)
{
    const T_SKEL_FEMA* curve = Curve(c, end);
    return curve ? CalculatedPage(m_owner, c, end, *curve) : T_PAGE_VALUES{};
}

std::string CPO_HingeSkcvTabFemaDlg::FieldOnPages(const T_FINDING& f)
{
    T_FINDING shown = f;
    const int chosen = AxialIndex(ComponentOf(f), EndOf(f));
    const std::string list = "curves[" + std::to_string(chosen) + "].";
    if (f.field.starts_with(list)) shown.field = f.field.substr(list.size());
    return PathOnPages(shown);
}

HINGE_COMPONENT CPO_HingeSkcvTabFemaDlg::First() const
{
    const auto at = std::ranges::find_if(m_components, [](const auto& c) { return c.has_value(); });
    return at == m_components.end() ? HINGE_COMPONENT::Fx
                                    : static_cast<HINGE_COMPONENT>(at - m_components.begin());
}
