// Flows that the elastic structure holds as springs in series with its members.
#include "qm_solver/push/pushpath.h"

#include <algorithm>

namespace solver {

namespace {

constexpr std::size_t kMostActive = 96;  // flows in the small system before some are folded
constexpr std::size_t kLeastFolded = 48; // that a factorisation is worth

using ON = CHingeBackbone::ON;

} // namespace

bool CPushPath::IsMoving(std::size_t f) const
{
    return Backbone(f).On() == ON::Virgin || Backbone(f).On() == ON::Back;
}

/// Hardens along its backbone, and hangs on the force of one row alone.
bool CPushPath::IsFoldable(std::size_t f) const
{
    const CPushFlow& flow = m_flows.flows[f];
    return Backbone(f).On() == ON::Virgin && Backbone(f).Slope() > 0.0 && flow.Rows().size() == 1 &&
           !flow.HangsOnAxial() && !m_structure.Kinks(flow.Rows()[0]);
}

bool CPushPath::IsFolded(std::size_t f) const
{
    return m_soft[f] > 0.0 && Backbone(f).On() == ON::Virgin &&
           m_soft[f] == 1.0 / Backbone(f).Slope();
}

bool CPushPath::BelongsInSystem(std::size_t f) const
{
    return m_soft[f] > 0.0 ? !IsFolded(f) : IsMoving(f);
}

double CPushPath::Alpha(std::size_t f) const
{
    return IsMoving(f) ? 1.0 - m_soft[f] * Backbone(f).Slope() : 1.0;
}

double CPushPath::Beta(std::size_t f) const
{
    if (!IsMoving(f)) return -1.0 / m_soft[f];
    return m_flows.flows[f].Scale(m_force) * Backbone(f).Slope();
}

/// Plastic deformation of the side: its unknown and what its spring in the structure gives.
double CPushPath::FlowRate(std::size_t f) const
{
    double rate = IsActive(f) ? m_rate.flow[m_place[f] - 1] : 0.0;
    if (m_soft[f] > 0.0) rate += m_soft[f] * m_flows.flows[f].Value(m_rate.force);
    return rate;
}

bool CPushPath::IsShared(std::size_t f) const
{
    return Backbone(f).On() == ON::Locked && !m_flows.flows[f].mates.empty();
}

double CPushPath::ShareOf(std::size_t f, std::size_t other) const
{
    if (Backbone(other).On() != ON::Virgin) return 0.0;
    for (const CPushFlow::T_MATE& mate : m_flows.flows[f].mates)
        if (mate.flow == other) return mate.share;
    return 0.0;
}

double CPushPath::MeasureRate(std::size_t f) const
{
    double rate = FlowRate(f);
    for (const CPushFlow::T_MATE& mate : m_flows.flows[f].mates)
        if (IsActive(mate.flow) && Backbone(mate.flow).On() == ON::Virgin)
            rate += mate.share * m_rate.flow[m_place[mate.flow] - 1];
    return rate;
}

/// unknowns: of the active flows; forces: changes of the rows.
void CPushPath::MoveFlows(std::span<const double> unknowns, std::span<const double> forces,
                          double by)
{
    std::map<std::size_t, double> shared;
    for (std::size_t k = 0; k < m_active.size(); ++k) {
        const std::size_t f = m_active[k];
        if (m_soft[f] == 0.0) Backbone(f).Flow(by * unknowns[k]);
        for (const CPushFlow::T_MATE& mate : m_flows.flows[f].mates)
            if (const double share = ShareOf(mate.flow, f); share > 0.0)
                shared[mate.flow] += by * share * unknowns[k];
    }
    for (const auto& [f, flowed] : shared)
        if (Backbone(f).On() == ON::Virgin)
            Backbone(f).Flow(flowed);
        else if (IsShared(f))
            Backbone(f).Share(flowed);
    for (const std::size_t f : m_softFlows) {
        if (!IsMoving(f)) continue;
        const double own = IsActive(f) ? unknowns[m_place[f] - 1] : 0.0;
        Backbone(f).Flow(by * (own + m_soft[f] * m_flows.flows[f].Value(forces)));
    }
}

void CPushPath::FindOpposites()
{
    const std::size_t none = m_flows.flows.size();
    std::vector<std::size_t> first(m_structure.RowCount(), none);
    m_opposite.assign(none, none);
    for (std::size_t f = 0; f < none; ++f) {
        if (m_flows.flows[f].Rows().size() != 1) continue;
        std::size_t& before = first[m_flows.flows[f].Rows()[0]];
        if (before == none) {
            before = f;
            continue;
        }
        m_opposite[f] = before;
        m_opposite[before] = f;
    }
}

/// By how much the row of a folded flow that is locked deforms more than its two sides have flowed.
double CPushPath::Misfit(std::size_t f) const
{
    const CPushFlow& flow = m_flows.flows[f];
    const std::size_t row = flow.Rows()[0], other = m_opposite[f];
    const double whole = m_plastic[row] + m_soft[f] * m_force[row];
    return (flow.positive ? whole : -whole) - Backbone(f).Flowed() +
           (other < m_flows.flows.size() ? Backbone(other).Flowed() : 0.0);
}

bool CPushPath::WantsFold() const
{
    if (m_active.size() < kMostActive) return false;
    const auto count = std::count_if(m_active.begin(), m_active.end(),
                                     [&](std::size_t f) { return IsFoldable(f); });
    return static_cast<std::size_t>(count) >= kLeastFolded;
}

/// folds: what hardens; else nothing stays folded.
CPushPath::T_FAULT CPushPath::FoldThose(bool folds)
{
    std::vector<double> compliance(m_structure.RowCount(), 0.0);
    std::vector<std::size_t> again;
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        const double before = m_soft[f];
        const double now = folds && IsFoldable(f) ? 1.0 / Backbone(f).Slope() : 0.0;
        const std::size_t row = m_flows.flows[f].Rows()[0];
        m_soft[f] = now;
        if (now > 0.0) compliance[row] = now;
        // What the spring takes over leaves the plastic deformation.
        if (now != before) m_plastic[row] += (before - now) * m_force[row];
    }
    m_softFlows.clear();
    for (std::size_t f = 0; f < m_soft.size(); ++f) {
        m_place[f] = 0;
        if (m_soft[f] > 0.0) m_softFlows.push_back(f);
        if (BelongsInSystem(f)) again.push_back(f);
    }
    m_active = std::move(again);
    if (auto fault = m_structure.Soften(compliance)) return fault;
    if (auto fault = m_structure.SolveLoads()) return fault;
    return Renew();
}

T_PUSH_STATE CPushPath::WholeState() const
{
    T_PUSH_STATE state = State();
    for (const std::size_t f : m_softFlows) {
        const std::size_t row = m_flows.flows[f].Rows()[0];
        state.plastic[row] += m_soft[f] * m_force[row];
    }
    return state;
}

} // namespace solver
