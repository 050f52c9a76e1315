#include "qm_rps/pushover/overview/evaluationunits.h"

#include "qm_db/recordfacts.h"

namespace {

/// Factors from one set of units to another.
class CUnitChange {
public:
    CUnitChange(const T_UNITS& from, const T_UNITS& to) : m_from(from), m_to(to) {}

    double Factor(T_DIM dim) const { return SiFactor(m_from, dim) / SiFactor(m_to, dim); }
    void Change(double& value, T_DIM dim) const { value *= Factor(dim); }
    void Change(std::optional<double>& value, T_DIM dim) const
    {
        if (value) Change(*value, dim);
    }
    void Change(std::vector<double>& values, T_DIM dim) const
    {
        for (double& value : values)
            Change(value, dim);
    }
    void Lengths(auto&... values) const { (Change(values, kDimLength), ...); }

private:
    T_UNITS m_from, m_to;
};

void Change(T_PUSH_FACTORS& f, const CUnitChange& to)
{
    to.Change(f.mass, kDimMass);
    to.Change(f.weight, kDimForce);
    to.Change(f.gravity, kDimAccel);
}

void Change(T_PERF_POINT& p, const CUnitChange& to)
{
    to.Lengths(p.Sd, p.D);
    to.Change(p.V, kDimForce);
}

void ChangeCurves(T_PUSH_EVALUATION& e, const CUnitChange& to)
{
    to.Lengths(e.capacity.Sd, e.demand.Sd, e.reduced.Sd, e.working.Sd, e.locus.Sd);
    for (T_ADRS_CURVE& curve : e.stateDemands)
        to.Lengths(curve.Sd);
}

void ChangePoints(T_PUSH_EVALUATION& e, const CUnitChange& to)
{
    if (e.slopeChange) to.Lengths(e.slopeChange->x);
    if (e.point) Change(*e.point, to);
    for (T_PERF_POINT& p : e.allPoints)
        Change(p, to);
    for (T_PERFPT_TRIAL& t : e.trace)
        to.Lengths(t.dpi, t.dy, t.Di);
    for (T_ADDITIONAL_STEP& s : e.additionalSteps) {
        to.Lengths(s.D, s.Sd);
        to.Change(s.V, kDimForce);
    }
    for (T_ADDITIONAL_POINT& p : e.additionalPoints)
        if (p.point) Change(*p.point, to);
}

void ChangeTargets(T_PUSH_EVALUATION& e, const CUnitChange& to)
{
    if (e.bilinear) to.Lengths(e.bilinear->dy, e.bilinear->du);
    for (T_TARGET_DISP& t : e.targets) {
        to.Lengths(t.dy, t.det, t.dt);
        to.Change(t.Fy, kDimForce);
        to.Change(t.mStar, kDimMass);
    }
    for (T_LIMIT_ROW& row : e.limitStates)
        to.Lengths(row.demand, row.capacity);
    for (T_GUIDE_LINE& line : e.guideLines)
        to.Lengths(line.Sd);
    to.Change(e.outcome.between[0], kDimLength);
    to.Change(e.outcome.between[1], kDimLength);
}

/// The plotted curve, whose axes are those of its plot type.
void ChangePlotted(T_PUSH_EVALUATION& e, const CUnitChange& to)
{
    using P = PLOT_TYPE;
    T_PLOTTED_CURVE& c = e.curve;
    const T_DIM moved = IsSpectral(c.type) ? kDimLength : DisplacementDim(e.loadCase.direction);
    const T_DIM x = c.type == P::Drift ? kDimNone : moved;
    const T_DIM y = c.type == P::BaseReaction ? ReactionDim(e.loadCase.direction) : kDimNone;
    to.Change(c.x, x);
    to.Change(c.y, y);
    to.Change(c.largestX, x);
    to.Change(c.largestY, y);
    for (T_MONITORED_NODE& node : c.monitored)
        to.Change(node.x, x);
}

} // namespace

T_PUSH_EVALUATION InUnits(T_PUSH_EVALUATION e, const T_UNITS& units)
{
    if (e.units == units) return e;
    const CUnitChange to(e.units, units);
    Change(e.factors, to);
    to.Change(e.mStar, kDimMass);
    ChangeCurves(e, to);
    ChangePoints(e, to);
    ChangeTargets(e, to);
    ChangePlotted(e, to);
    e.units = units;
    return e;
}
