// Over a place that no path of equilibrium leads on from: the control moves with every hinge held,
// then what exceeds its strength gives way, each hinge only as far as its own condition needs.
#include "qm_solver/push/pushrun.h"

#include <cmath>

namespace solver {

namespace {

constexpr int kMostGiving = 200000;
constexpr int kMostTries = 10;       // with P-Delta of each step
constexpr double kClose = 1e-10;     // of the strength: close enough for the last correction
constexpr double kAdmitted = 1e-9;   // ... that no condition may be beyond after it
constexpr double kLeastGiven = 1e-9; // of the elastic deformation at yield: has given way

using ON = CHingeBackbone::ON;

} // namespace

/// How far the state is beyond the flow's condition, over the strength; negative backwards.
double CPushPath::Excess(std::size_t f)
{
    const CHingeBackbone& backbone = Backbone(f);
    const double force = m_flows.flows[f].force;
    if (m_flows.flows[f].HangsOnAxial()) ChoosePart(f);
    if (backbone.On() != ON::Locked) return Phi(f, backbone.Force()) / force;
    if (const double over = Phi(f, backbone.Upper()) / force; over > 0.0) return over;
    if (backbone.Lower() == -CHingeBackbone::kFar) return 0.0;
    return std::min(0.0, Phi(f, backbone.Lower()) / force);
}

/// The flow that is furthest beyond its condition, their number where none is; what is below the
/// force of its backbone unloads.
CPushPath::T_FAULT CPushPath::FindWorst(double close, std::size_t& worst)
{
    double most = close;
    worst = m_flows.flows.size();
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        const double excess = Excess(f);
        const ON on = Backbone(f).On();
        if (on == ON::Virgin && excess < -close) {
            Touch(f);
            Backbone(f).Unload();
            if (auto fault = Sync(f)) return fault;
            continue;
        }
        const double size = on == ON::Drop ? std::max(excess, 1.0) : std::fabs(excess);
        if (size <= most) continue;
        most = size;
        worst = f;
    }
    return {};
}

/// The flow gives way until its condition holds, or to the end of its branch. The control is held.
CPushPath::WAY CPushPath::Give(std::size_t f, T_FAULT& fault)
{
    CHingeBackbone& backbone = Backbone(f);
    const bool forwards = Excess(f) > 0.0;
    if (!IsMoving(f)) {
        Touch(f);
        backbone.On() == ON::Drop ? backbone.EndDrop() : backbone.Start(forwards);
        fault = Sync(f);
        return fault ? WAY::Fault : WAY::On;
    }
    const CPushFlow& flow = m_flows.flows[f];
    const std::size_t control = *m_control;
    std::vector<double> force(m_force.size(), 0.0);
    double factor = 0.0;
    for (const T_FLOW_TERM& d : flow.Direction(m_force, Resistance(f))) {
        factor -= d.factor * m_columnOf[d.row]->watch[control];
        for (std::size_t r = 0; r < force.size(); ++r)
            force[r] += d.factor * m_columnOf[d.row]->force[r];
    }
    factor /= m_watches[control].byLoads.back();
    const std::vector<double>& loads = m_structure.Loads(m_factors.size() - 1).force;
    for (std::size_t r = 0; r < force.size(); ++r)
        force[r] += factor * loads[r];
    double falls = flow.Scale(m_force) * backbone.Slope(); // of phi by unit flow
    for (const T_FLOW_TERM& g : flow.Gradient(m_force, Resistance(f)))
        falls -= g.factor * force[g.row];
    const double room = backbone.Room(forwards);
    double by = room;
    if (falls > 0.0) by = std::min(room, std::fabs(Phi(f, Resistance(f))) / falls);
    if (!(by < CHingeBackbone::kFar)) return WAY::None; // nothing holds it
    const double way = forwards ? by : -by;
    std::vector<double> unknowns(m_active.size(), 0.0);
    unknowns[m_place[f] - 1] = 1.0;
    for (const T_FLOW_TERM& d : flow.Direction(m_force, Resistance(f)))
        m_plastic[d.row] += d.factor * way;
    m_factors.back() += factor * way;
    for (std::size_t r = 0; r < force.size(); ++r)
        m_force[r] += force[r] * way;
    MoveFlows(unknowns, force, way);
    if (by < room) return WAY::On;
    Touch(f);
    backbone.End(forwards);
    fault = Sync(f);
    return fault ? WAY::Fault : WAY::On;
}

bool CPushPath::IsAdmitted()
{
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f)
        if (Backbone(f).On() == ON::Drop || std::fabs(Excess(f)) > kAdmitted) return false;
    return true;
}

void CPushPath::NoteLeap(std::span<const CHingeBackbone> before)
{
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        const CPushFlow& flow = m_flows.flows[f];
        const double given =
            (Backbone(f).Flowed() - before[flow.backbone].Flowed()) * flow.stiffness / flow.force;
        if (std::fabs(given) > kLeastGiven)
            m_turned.push_back(
                {flow.hinge, flow.law, HINGE_TURN::Leap, Backbone(f).Vertex(), flow.positive});
    }
}

/// Every flow as these backbones say, loads and plastic deformations as given.
CPushPath::T_FAULT CPushPath::Restore(T_BEFORE before)
{
    m_flows.backbones = std::move(before.backbones);
    m_factors = std::move(before.factors);
    m_plastic = std::move(before.plastic);
    m_active.clear();
    std::fill(m_place.begin(), m_place.end(), 0);
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        UpdateLock(f);
        if (BelongsInSystem(f)) m_active.push_back(f);
    }
    m_touched.clear();
    if (auto fault = Rebase()) return fault;
    return Rebuild();
}

CPushPath::WAY CPushPath::Settle(double control, T_FAULT& fault)
{
    const std::size_t none = m_flows.flows.size();
    std::size_t worst = 0;
    for (int round = 0; round < kMostGiving && worst != none; ++round) {
        if ((fault = FindWorst(kClose, worst))) return WAY::Fault;
        if (worst == none) break;
        if (const WAY way = Give(worst, fault); way != WAY::On) return way;
    }
    if (worst != none) return WAY::None;
    SumUp(); // what is watched has stood still
    if ((fault = Rebuild()) || (fault = Correct(control))) return WAY::Fault;
    return IsAdmitted() ? WAY::On : WAY::None;
}

CPushPath::WAY CPushPath::Leap(double control, T_FAULT& fault)
{
    if (!m_softFlows.empty() && (fault = Unfold())) return WAY::Fault;
    T_WATCH& watch = m_watches[*m_control];
    if (watch.byLoads.back() == 0.0) return WAY::None;
    const T_BEFORE before{m_factors, m_plastic, m_flows.backbones};
    m_border = 0;
    if ((fault = Rebuild())) return WAY::Fault;
    SumUp();
    m_factors.back() += (control - watch.value) / watch.byLoads.back();
    SumUp();
    const WAY way = Settle(control, fault);
    if (way == WAY::None && (fault = Restore(before))) return WAY::Fault;
    if (way != WAY::On) return way;
    NoteLeap(before.backbones);
    m_hasBefore = false;
    m_dropping.clear();
    return WAY::On;
}

CPushPath::WAY CPushRun::Leap(const T_PUSH_STAGE& stage, int number, T_PUSH_END& end,
                              T_FAULT& fault)
{
    using WAY = CPushPath::WAY;
    // The last state on the path is a step.
    if (m_path->Factor() != m_stored && !IsBehind(stage)) {
        if ((fault = m_path->Correct(std::nullopt)) || (fault = Store(stage, number, false, end)))
            return WAY::Fault;
    }
    if ((fault = Flush(end))) return WAY::Fault;
    const T_TARGET target = m_targets[m_target];
    WAY way = WAY::None;
    for (int tries = 0; tries < kMostTries && !m_cancelled; ++tries) {
        way = m_path->Leap(target.value, fault);
        if (way != WAY::On || !IsUpdated()) break;
        if ((fault = Update(stage, target.value))) return WAY::Fault; // moves the forces, too
        if (m_path->IsAdmitted()) break;
        way = WAY::None;
    }
    if (way != WAY::On || m_cancelled) return way;
    m_hasLept = true;
    m_far = target.value;
    m_peak.reaction = std::max(m_peak.reaction, m_sign * Reaction(stage));
    if ((fault = Store(stage, number, target.additional, end))) return WAY::Fault;
    ++m_target;
    m_path->SetDrive({T_PUSH_DRIVE::KIND::Control, m_sign, {}});
    return WAY::On;
}

/// A stop that was asked for lies behind the leap, or right where it has led to.
bool CPushRun::StopsBehindLeap(const T_PUSH_STAGE& stage, int number, T_PUSH_END& end)
{
    T_PUSH_END stop;
    if (!StopsAtHinge(stage.stops, stop) && ToStop(stage, stop) > 0.0) return false;
    NoteEvent(number);
    end.outcome = stop.outcome;
    end.hinge = stop.hinge;
    end.drift = stop.drift;
    return true;
}

} // namespace solver
