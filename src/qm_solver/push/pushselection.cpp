// Who flows: the active flows of a push, their rates, and their changes at an event.
#include "qm_solver/push/pushpath.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kAtLimit = 1e-10; // of the strength: a force that has reached its limit
constexpr int kTogether = 12;      // rounds in which all that must change does so at once
constexpr int kMostRounds = 400;   // then one at a time
constexpr std::size_t kBlock = 16; // columns solved together

using ON = CHingeBackbone::ON;

} // namespace

double CPushPath::Tolerance(std::size_t flow) const
{
    return kAtLimit * m_flows.flows[flow].force;
}

double CPushPath::Phi(std::size_t f, double resistance) const
{
    const CPushFlow& flow = m_flows.flows[f];
    return flow.Value(m_force) - flow.Scale(m_force) * resistance;
}

double CPushPath::Resistance(std::size_t f) const
{
    return m_flows.backbones[m_flows.flows[f].backbone].Force();
}

/// Of the condition with its resistance held.
double CPushPath::PhiRate(std::size_t f) const
{
    const CPushFlow& flow = m_flows.flows[f];
    double rate = 0.0;
    for (const T_FLOW_TERM& t : flow.Gradient(m_force, Resistance(f)))
        rate += t.factor * m_rate.force[t.row];
    if (IsShared(f)) // its limit moves, too
        rate -= m_flows.flows[f].Scale(m_force) * Backbone(f).ShareSlope() *
                std::max(0.0, MeasureRate(f));
    return rate;
}

CPushPath::T_FAULT CPushPath::Fetch(std::span<const std::size_t> rows)
{
    std::vector<T_PROBE> probes;
    for (const T_WATCH& w : m_watches)
        probes.push_back(w.probe);
    std::vector<double> forces, values;
    if (auto fault = m_structure.Columns(rows, probes, forces, values)) return fault;
    const std::size_t count = m_structure.RowCount();
    for (std::size_t c = 0; c < rows.size(); ++c) {
        T_COLUMN& column = m_columns[rows[c]];
        column.force.assign(forces.begin() + static_cast<long>(c * count),
                            forces.begin() + static_cast<long>((c + 1) * count));
        column.watch.assign(values.begin() + static_cast<long>(c * probes.size()),
                            values.begin() + static_cast<long>((c + 1) * probes.size()));
        m_columnOf[rows[c]] = &column;
    }
    return {};
}

/// Rows of these flows without a column, and of those that are next to flow as the path goes now.
std::vector<std::size_t> CPushPath::MissingRows(std::span<const std::size_t> flows)
{
    std::vector<std::size_t> rows;
    const auto take = [&](std::size_t f) {
        for (const T_FLOW_TERM& t : m_flows.flows[f].Direction(m_force, Resistance(f)))
            if (!m_columnOf[t.row] && std::find(rows.begin(), rows.end(), t.row) == rows.end())
                rows.push_back(t.row);
    };
    for (const std::size_t f : flows)
        take(f);
    if (rows.empty() || m_rate.force.empty()) return rows;
    std::vector<std::pair<double, std::size_t>> next;
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        const CPushFlow& flow = m_flows.flows[f];
        const CHingeBackbone& backbone = m_flows.backbones[flow.backbone];
        if (backbone.On() != ON::Locked || m_columnOf[flow.Rows()[0]]) continue;
        const double rate = PhiRate(f);
        if (rate > 0.0) next.emplace_back(-Phi(f, backbone.Upper()) / rate, f);
    }
    std::sort(next.begin(), next.end());
    for (std::size_t k = 0; k < next.size() && rows.size() < kBlock; ++k)
        take(next[k].second);
    return rows;
}

CPushPath::T_FAULT CPushPath::Activate(std::size_t f)
{
    const std::size_t one[] = {f};
    if (const auto rows = MissingRows(one); !rows.empty())
        if (auto fault = Fetch(rows)) return fault;
    const CPushFlow& flow = m_flows.flows[f];
    const CHingeBackbone& backbone = m_flows.backbones[flow.backbone];
    const double resistance = backbone.Force();
    const auto gradient = flow.Gradient(m_force, resistance);
    const auto direction = flow.Direction(m_force, resistance);
    const std::vector<double>& loads = m_structure.Loads(m_factors.size() - 1).force;
    std::vector<double> row(m_system.Size()), column(m_system.Size());
    const double alpha = Alpha(f);
    for (const T_FLOW_TERM& g : gradient)
        row[0] -= alpha * g.factor * loads[g.row];
    if (m_border == 0 && m_control)
        for (const T_FLOW_TERM& d : direction)
            column[0] += d.factor * m_columnOf[d.row]->watch[*m_control];
    if (m_border == 2) column[0] = flow.force;
    for (std::size_t k = 0; k < m_active.size(); ++k) {
        CPushFlow& other = m_flows.flows[m_active[k]];
        const double theirs = Resistance(m_active[k]), theirAlpha = Alpha(m_active[k]);
        for (const T_FLOW_TERM& g : gradient)
            for (const T_FLOW_TERM& d : other.Direction(m_force, theirs))
                row[k + 1] -= alpha * g.factor * d.factor * m_columnOf[d.row]->force[g.row];
        if (!flow.mates.empty()) {
            row[k + 1] += ShareOf(f, m_active[k]) * Beta(f);
            column[k + 1] += ShareOf(m_active[k], f) * Beta(m_active[k]);
        }
        for (const T_FLOW_TERM& g : other.Gradient(m_force, theirs))
            for (const T_FLOW_TERM& d : direction)
                column[k + 1] -= theirAlpha * g.factor * d.factor * m_columnOf[d.row]->force[g.row];
    }
    double diagonal = Beta(f);
    for (const T_FLOW_TERM& g : gradient)
        for (const T_FLOW_TERM& d : direction)
            diagonal -= alpha * g.factor * d.factor * m_columnOf[d.row]->force[g.row];
    m_system.Add(row, column, diagonal);
    m_active.push_back(f);
    m_place[f] = m_active.size();
    return {};
}

void CPushPath::Deactivate(std::size_t f)
{
    const std::size_t at = m_place[f];
    m_system.Remove(at);
    m_active.erase(m_active.begin() + static_cast<long>(at - 1));
    m_place[f] = 0;
    for (std::size_t k = at - 1; k < m_active.size(); ++k)
        m_place[m_active[k]] = k + 1;
}

/// The flow's place in the system as its backbone is now.
CPushPath::T_FAULT CPushPath::Sync(std::size_t f)
{
    UpdateLock(f);
    if (IsActive(f)) Deactivate(f);
    if (!BelongsInSystem(f)) return {};
    return Activate(f);
}

/// What can't go on as it is with these rates.
std::vector<CPushPath::T_CHANGE> CPushPath::Violations()
{
    using KIND = T_CHANGE::KIND;
    std::vector<T_CHANGE> out;
    const double least = Least();
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        if (const T_LOCK& lock = m_lock[f]; lock.isPlain) {
            const double force = lock.sign * m_force[lock.row], near = kAtLimit * lock.force;
            if (force < lock.upper - near && force > lock.lower + near) continue;
        }
        CPushFlow& flow = m_flows.flows[f];
        const CHingeBackbone& backbone = m_flows.backbones[flow.backbone];
        if (flow.HangsOnAxial()) {
            const auto slopes = flow.Slopes();
            ChoosePart(f);
            if (IsMoving(f) && slopes != flow.Slopes()) out.push_back({f, 0.0, KIND::Part});
        }
        if (IsMoving(f)) {
            const double rate = FlowRate(f) * flow.stiffness / flow.force;
            const double end = kAtLimit * flow.force / flow.stiffness;
            if (backbone.On() == ON::Virgin && rate < -least)
                out.push_back({f, -rate, KIND::Unload});
            else if (backbone.On() == ON::Back && rate > least && backbone.Room(true) <= end)
                out.push_back({f, rate, KIND::End});
            else if (backbone.On() == ON::Back && rate < -least && backbone.Room(false) <= end)
                out.push_back({f, -rate, KIND::EndBack});
        } else if (backbone.On() == ON::Locked) {
            const double rate = PhiRate(f) / flow.force;
            if (rate > least && Phi(f, backbone.Upper()) >= -Tolerance(f))
                out.push_back({f, rate, KIND::Start});
            else if (rate < -least && backbone.Lower() > -CHingeBackbone::kFar &&
                     Phi(f, backbone.Lower()) <= Tolerance(f))
                out.push_back({f, -rate, KIND::StartBack});
        }
    }
    return out;
}

CPushPath::T_FAULT CPushPath::Apply(const T_CHANGE& change)
{
    using KIND = T_CHANGE::KIND;
    Touch(change.flow);
    CHingeBackbone& backbone = Backbone(change.flow);
    switch (change.kind) {
    case KIND::Unload:
        backbone.Unload();
        break;
    case KIND::Start:
        backbone.Start(true);
        break;
    case KIND::StartBack:
        backbone.Start(false);
        break;
    case KIND::End:
        backbone.End(true);
        break;
    case KIND::EndBack:
        backbone.End(false);
        break;
    case KIND::Part: // chosen already
        break;
    }
    if (backbone.On() == ON::Drop) TakeDrive({&change.flow, 1});
    return Sync(change.flow);
}

/// Keeps what the flow was before the changes of an event.
void CPushPath::Touch(std::size_t f)
{
    const CHingeBackbone& backbone = Backbone(f);
    m_touched.try_emplace(f, T_WAS{backbone.On(), backbone.Vertex()});
}

/// Vertices passed, hinges that unload and load again. Where the path ends nothing goes on after
/// them: vertices alone.
void CPushPath::NoteTurns(bool isEnd)
{
    for (const auto& [f, was] : m_touched) {
        const CPushFlow& flow = m_flows.flows[f];
        const CHingeBackbone& now = Backbone(f);
        const auto note = [&](HINGE_TURN turn, int point) {
            m_turned.push_back({flow.hinge, flow.law, turn, point, flow.positive});
        };
        // Faces of a biaxial hinge follow one law: a vertex is told once.
        int& told = m_told[2 * (m_firstLaw[flow.hinge] + flow.law) + (flow.positive ? 0 : 1)];
        for (int v = std::max(told, was.vertex) + 1; v <= now.Vertex(); ++v)
            note(HINGE_TURN::Point, v);
        told = std::max(told, now.Vertex());
        if (isEnd || now.Vertex() != was.vertex) continue;
        // From one face to the next: the hinge goes on.
        if (std::ranges::any_of(flow.mates, [&](const CPushFlow::T_MATE& mate) {
                return Backbone(mate.flow).On() == ON::Virgin;
            }))
            continue;
        const bool wasBack = was.on == ON::Back, isBack = now.On() == ON::Back;
        if (now.HasGap() && wasBack != isBack) {
            const bool isStart = // it begins with its gap open
                now.Flowed() == 0.0 &&
                std::ranges::all_of(m_factors, [](double by) { return by == 0.0; });
            if (wasBack || !isStart)
                note(wasBack ? HINGE_TURN::Contact : HINGE_TURN::Slip, now.Vertex());
            continue;
        }
        const bool wasOn = was.on == ON::Virgin, isOn = now.On() == ON::Virgin;
        if (wasOn && !isOn && now.On() != ON::Drop) note(HINGE_TURN::Unload, now.Vertex());
        if (!wasOn && isOn && was.on != ON::Drop) note(HINGE_TURN::Reload, now.Vertex());
    }
    m_touched.clear();
}

CPushPath::WAY CPushPath::Select(T_FAULT& fault)
{
    if ((fault = SyncTouched())) return WAY::Fault;
    for (int round = 0; round < kMostRounds; ++round) {
        if (!MakeRates()) break;
        std::vector<T_CHANGE> changes = Violations();
        if (changes.empty()) {
            NoteTurns(false);
            m_hasBefore = true;
            m_before = m_rate.force;
            m_beforeControl = m_rate.control;
            m_beforeLeast = Least();
            return WAY::On;
        }
        if (round >= kTogether) { // the largest alone, so that a circle is left
            const auto worst = std::max_element(
                changes.begin(), changes.end(),
                [](const T_CHANGE& a, const T_CHANGE& b) { return a.amount < b.amount; });
            changes = {*worst};
        }
        for (const T_CHANGE& change : changes)
            if ((fault = Apply(change))) return WAY::Fault;
    }
    NoteTurns(true);
    return WAY::None;
}

} // namespace solver
