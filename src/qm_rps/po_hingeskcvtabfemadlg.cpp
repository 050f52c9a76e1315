#include "qm_rps/po_hingeskcvtabfemadlg.h"

#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/hinge/hingemeasure.h"
#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"

#include <algorithm>
#include <cmath>

namespace {

/// Row conversion; the odd sources of positions 2 and 8 are meant.
void ConvertRow(double (*f)(double, double), double thetaNeg, double thetaPos,
                const std::array<double, 3>& middle, CPO_HingeSkcvTabFemaDlg::T_ROW& row)
{
    row[0] = -1.0 * f(row[0], thetaNeg);
    row[1] = -1.0 * f(row[2], thetaNeg);
    row[2] = -1.0 * f(row[2], thetaNeg);
    std::copy(middle.begin(), middle.end(), row.begin() + 3);
    row[6] = f(row[8], thetaPos);
    row[7] = f(row[6], thetaPos);
    row[8] = f(row[6], thetaPos);
}

void ConvertCurve(T_SKEL_FEMA& curve, SKEL_MEASURE to)
{
    ConvertSides(curve.sides, to);
    for (T_SKEL_AXIAL& c : curve.curves)
        ConvertSides(c.sides, to);
    curve.measure = to;
}

std::size_t Index(HINGE_COMPONENT c)
{
    return static_cast<std::size_t>(c);
}

/// A value of the curve's own sides and of those of every axial force.
void SetOnAllSides(T_SKEL_FEMA& curve, double T_SKEL_SIDE::*member, const T_SIDES<double>& value)
{
    const auto set = [&](T_SIDES<T_SKEL_SIDE>& s) {
        s.pos.*member = value.pos;
        s.neg.*member = value.neg;
    };
    set(curve.sides);
    for (T_SKEL_AXIAL& a : curve.curves)
        set(a.sides);
}

const T_SKEL_AXIAL* CurveOfForce(const T_SKEL_FEMA& f, double axial)
{
    for (const T_SKEL_AXIAL& c : f.curves)
        if (c.axial == axial) return &c;
    return nullptr;
}

} // namespace

int CPO_HingeSkcvTabFemaDlg::Data2Dlg(HINGE_COMPONENT c, const T_HINGE_COMPONENT& data)
{
    if (data.type != SKEL_TYPE::Fema || !std::holds_alternative<T_SKEL_FEMA>(data.curves.I) ||
        !std::holds_alternative<T_SKEL_FEMA>(data.curves.J))
        return 0;
    m_components[Index(c)] = data;
    m_switches[Index(c)] = {};
    return 1;
}

int CPO_HingeSkcvTabFemaDlg::Dlg2Data(HINGE_COMPONENT c, T_HINGE_COMPONENT& data)
{
    if (!Component(c) || !CheckData()) return 0;
    data = MirroredComponent(*Component(c));
    return 1;
}

T_HINGE_COMPONENT* CPO_HingeSkcvTabFemaDlg::Component(HINGE_COMPONENT c)
{
    return m_components[Index(c)] ? &*m_components[Index(c)] : nullptr;
}

T_SKEL_FEMA* CPO_HingeSkcvTabFemaDlg::Curve(HINGE_COMPONENT c, HINGE_END end)
{
    T_HINGE_COMPONENT* component = Component(c);
    if (!component) return nullptr;
    const bool j = end == HINGE_END::J && !component->sameEnds;
    return std::get_if<T_SKEL_FEMA>(j ? &component->curves.J : &component->curves.I);
}

std::vector<T_FINDING> CPO_HingeSkcvTabFemaDlg::Findings() const
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < m_components.size(); ++i) {
        if (!m_components[i]) continue;
        const auto found = ComponentFindings(static_cast<HINGE_COMPONENT>(i), *m_components[i]);
        out.insert(out.end(), found.begin(), found.end());
    }
    return out;
}

double CPO_HingeSkcvTabFemaDlg::ConvertParamPR2DDy(double value, double thetaY)
{
    return PlasticFromRatio(value, thetaY);
}

double CPO_HingeSkcvTabFemaDlg::ConvertParamDDy2PR(double value, double thetaY)
{
    return RatioFromPlastic(value, thetaY);
}

void CPO_HingeSkcvTabFemaDlg::ConvertPR2DDy(double thetaNeg, double thetaPos, T_ROW& row)
{
    ConvertRow(ConvertParamPR2DDy, thetaNeg, thetaPos, {1.0, 0.0, 1.0}, row);
}

void CPO_HingeSkcvTabFemaDlg::ConvertDDy2PR(double thetaNeg, double thetaPos, T_ROW& row)
{
    ConvertRow(ConvertParamDDy2PR, thetaNeg, thetaPos, {0.0, 0.0, 0.0}, row);
}

int CPO_HingeSkcvTabFemaDlg::ConvertHingeParamPR2DDy(T_SKEL_FEMA& curve)
{
    if (curve.measure != SKEL_MEASURE::DDy) return 0;
    ConvertCurve(curve, SKEL_MEASURE::Plastic);
    return 1;
}

int CPO_HingeSkcvTabFemaDlg::ConvertHingeParamDDy2PR(T_SKEL_FEMA& curve)
{
    if (curve.measure != SKEL_MEASURE::Plastic) return 0;
    ConvertCurve(curve, SKEL_MEASURE::DDy);
    return 1;
}

int CPO_HingeSkcvTabFemaDlg::OnMeasureRdo(HINGE_COMPONENT c, HINGE_END end, SKEL_MEASURE measure)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve) return 0;
    if (curve->measure == measure) return 1;
    const T_SKEL_FEMA was = *curve;
    if (measure == SKEL_MEASURE::Plastic ? !ConvertHingeParamPR2DDy(*curve)
                                         : !ConvertHingeParamDDy2PR(*curve))
        return 0;
    std::optional<T_SWITCH>& last = LastSwitch(c, end);
    if (last && last->before.measure == measure) {
        RestoreSides(curve->sides, was.sides, last->after.sides, last->before.sides);
        for (T_SKEL_AXIAL& now : curve->curves) {
            const T_SKEL_AXIAL* mid = CurveOfForce(was, now.axial);
            const T_SKEL_AXIAL* after = CurveOfForce(last->after, now.axial);
            const T_SKEL_AXIAL* before = CurveOfForce(last->before, now.axial);
            if (mid && after && before)
                RestoreSides(now.sides, mid->sides, after->sides, before->sides);
        }
    }
    last = T_SWITCH{was, *curve};
    return 1;
}

bool CPO_HingeSkcvTabFemaDlg::IsMomentRotationEnabled(HINGE_COMPONENT c) const
{
    if (!m_timeHistory) return c == HINGE_COMPONENT::My || c == HINGE_COMPONENT::Mz;
    return c == HINGE_COMPONENT::Mx || c == HINGE_COMPONENT::My; // components 3 and 4, as they are
}

bool CPO_HingeSkcvTabFemaDlg::IsNeedIJTab(HINGE_COMPONENT c) const
{
    return m_components[Index(c)] && NeedsIJPages(*m_components[Index(c)]);
}

void CPO_HingeSkcvTabFemaDlg::SetAutoCalcValue(HINGE_COMPONENT c, HINGE_END end,
                                               const T_SIDES<double>& yield)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (curve && curve->autoYield) SetOnAllSides(*curve, &T_SKEL_SIDE::yield, yield);
}

int CPO_HingeSkcvTabFemaDlg::OnComplianceChk(HINGE_COMPONENT c, HINGE_END end, bool on)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve) return 0;
    curve->compliance = on;
    return 1;
}

bool CPO_HingeSkcvTabFemaDlg::IsInfillStrutMode(HINGE_COMPONENT c, HINGE_END end)
{
    const T_SKEL_FEMA* curve = Curve(c, end);
    return curve && curve->infillStrut;
}

void CPO_HingeSkcvTabFemaDlg::SetInfillStrutMode(HINGE_COMPONENT c, HINGE_END end, bool on)
{
    if (T_SKEL_FEMA* curve = Curve(c, end)) curve->infillStrut = on;
}

std::array<const char*, 5> CPO_HingeSkcvTabFemaDlg::InfillLabels(bool general)
{
    if (general)
        return {"IDS_RPS_PO_FEMA_INFILL_GENERAL_QQY", "IDS_RPS_PO_FEMA_INFILL_GENERAL_DELTAHM",
                "IDS_RPS_PO_FEMA_INFILL_GENERAL_QY", "IDS_RPS_PO_FEMA_INFILL_GENERAL_DR",
                "IDS_RPS_PO_FEMA_INFILL_GENERAL_SHOW_DEFORM"};
    return {"IDS_RPS_PO_FEMA_INFILL_PLASTIC_FFY", "IDS_RPS_PO_FEMA_INFILL_PLASTIC_DDY",
            "IDS_RPS_PO_FEMA_INFILL_PLASTIC_FY", "IDS_RPS_PO_FEMA_INFILL_PLASTIC_CD",
            "IDS_RPS_PO_FEMA_INFILL_PLASTIC_DRIFT_RATIO"};
}

void CPO_HingeSkcvTabFemaDlg::OnMultiCurveChk(HINGE_COMPONENT c, HINGE_END end, bool on)
{
    if (T_SKEL_FEMA* curve = Curve(c, end)) curve->multiCurve = on;
}

int CPO_HingeSkcvTabFemaDlg::OnAxialForceBtn(HINGE_COMPONENT c, HINGE_END end)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve) return 0;
    CPO_HingeSkcvTabFemaAxialGrid grid;
    grid.SetView(View());
    grid.m_owner = m_owner;
    grid.Data2Dlg(curve->curves, m_axialRange);
    if (!grid.DoModal()) return 0;
    grid.Dlg2Data(curve->curves, curve->sides);
    return 1;
}

T_SIDES<T_SKEL_SIDE>* CPO_HingeSkcvTabFemaDlg::SidesOf(HINGE_COMPONENT c, HINGE_END end,
                                                       int axialIndex)
{
    T_SKEL_FEMA* curve = Curve(c, end);
    if (!curve) return nullptr;
    if (!curve->multiCurve) return &curve->sides;
    const bool inside = axialIndex >= 0 && axialIndex < static_cast<int>(curve->curves.size());
    return inside ? &curve->curves[static_cast<std::size_t>(axialIndex)].sides : nullptr;
}

std::optional<CPO_HingeSkcvTabFemaDlg::T_SWITCH>&
CPO_HingeSkcvTabFemaDlg::LastSwitch(HINGE_COMPONENT c, HINGE_END end)
{
    const bool j = end == HINGE_END::J && !m_components[Index(c)]->sameEnds;
    return m_switches[Index(c)][j ? 1 : 0];
}
