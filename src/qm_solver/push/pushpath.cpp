#include "qm_solver/push/pushpath.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kNear = 1e-10;    // of strength, or of elastic deformation: at an event
constexpr double kSettled = 1e-13; // of strengths: yield conditions are met
constexpr double kKept = 1e-11;    // ... by the sums of many ways
constexpr int kMostCorrections = 12;
constexpr std::size_t kMostSince = 50;

using ON = CHingeBackbone::ON;

} // namespace

CPushPath::CPushPath(const T_PUSH_MODEL& model, CPushStructure& structure)
    : m_model(model), m_structure(structure), m_flows(MakeFlows(model, structure)),
      m_place(m_flows.flows.size(), 0), m_columnOf(structure.RowCount(), nullptr),
      m_force(structure.RowCount(), 0.0), m_plastic(structure.RowCount(), 0.0)
{
    m_isCurved = std::any_of(m_flows.flows.begin(), m_flows.flows.end(),
                             [](const CPushFlow& flow) { return flow.HangsOnAxial(); });
    m_isBent = std::any_of(m_flows.flows.begin(), m_flows.flows.end(), [](const CPushFlow& flow) {
        return flow.HangsOnAxial() && flow.Rows().size() > 1;
    });
    m_soft.assign(m_flows.flows.size(), 0.0);
    m_lock.resize(m_flows.flows.size());
    FindOpposites();
    for (std::size_t f = 0; f < m_lock.size(); ++f)
        UpdateLock(f);
    MakeRowScales();
    for (const T_PUSH_HINGE& hinge : model.hinges) {
        m_firstLaw.push_back(m_lawCount);
        m_lawCount += hinge.laws.size();
    }
    m_told.assign(2 * m_lawCount, 0);
}

void CPushPath::MakeRowScales()
{
    m_byForce.assign(m_structure.RowCount(), 0.0);
    m_byStiffness = m_byForce;
    for (const CPushFlow& flow : m_flows.flows)
        for (const std::size_t r : flow.Rows()) {
            m_byForce[r] = std::max(m_byForce[r], 1.0 / flow.force);
            m_byStiffness[r] = std::max(m_byStiffness[r], flow.stiffness / flow.force);
        }
}

void CPushPath::UpdateLock(std::size_t f)
{
    const CPushFlow& flow = m_flows.flows[f];
    const CHingeBackbone& backbone = Backbone(f);
    T_LOCK& lock = m_lock[f];
    lock.isPlain = backbone.On() == ON::Locked && flow.Rows().size() == 1 && !flow.HangsOnAxial();
    if (!lock.isPlain) return;
    lock = {flow.Rows()[0],   flow.positive ? 1.0 : -1.0,
            backbone.Upper(), backbone.Lower(),
            flow.force,       true};
}

double CPushPath::LoadSize() const
{
    const std::vector<double>& loads = m_structure.Loads(m_factors.size() - 1).force;
    double most = 0.0;
    for (std::size_t r = 0; r < loads.size(); ++r)
        most = std::max(most, std::fabs(loads[r]) * m_byForce[r]);
    return most;
}

double CPushPath::LoadRate() const
{
    const double rate = m_rate.factor * LoadSize();
    return std::fabs(rate) >= kMechanism * m_norm ? rate : 0.0;
}

std::size_t CPushPath::Watch(T_PROBE probe)
{
    m_watches.push_back({std::move(probe), 0.0, 0.0, {}});
    return m_watches.size() - 1;
}

CPushPath::T_FAULT CPushPath::BeginStage(std::size_t set, std::optional<std::size_t> control)
{
    m_factors.resize(set + 1, 0.0);
    m_control = control;
    m_border = control ? 0 : 1;
    m_hasBefore = false;
    m_rate.force.clear();
    return Renew();
}

/// What the answers of the structure make of the state.
CPushPath::T_FAULT CPushPath::Renew()
{
    m_columns.clear();
    std::fill(m_columnOf.begin(), m_columnOf.end(), nullptr);
    for (T_WATCH& w : m_watches) {
        w.byLoads.clear();
        for (std::size_t l = 0; l < m_structure.LoadCount(); ++l)
            w.byLoads.push_back(m_structure.Value(w.probe, m_structure.Loads(l).unknowns));
    }
    std::vector<double> change = m_force;
    if (auto fault = Rebase()) return fault;
    for (std::size_t r = 0; r < change.size(); ++r)
        change[r] = m_force[r] - change[r];
    MoveFlows(std::vector<double>(m_active.size(), 0.0), change, 1.0); // what is folded follows
    std::vector<std::size_t> rows;
    for (const std::size_t f : m_active)
        for (const T_FLOW_TERM& d : m_flows.flows[f].Direction(m_force, Resistance(f)))
            rows.push_back(d.row);
    std::sort(rows.begin(), rows.end());
    rows.erase(std::unique(rows.begin(), rows.end()), rows.end());
    if (!rows.empty())
        if (auto fault = Fetch(rows)) return fault;
    return Rebuild();
}

/// Forces and displacements of the state from the structure; what follows is added to them.
CPushPath::T_FAULT CPushPath::Rebase()
{
    std::vector<double> unknowns;
    m_base.factors = m_factors;
    m_base.plastic = m_plastic;
    if (auto fault = m_structure.Solve(State(), unknowns, m_base.force)) return fault;
    m_base.watch.clear();
    for (const T_WATCH& w : m_watches)
        m_base.watch.push_back(m_structure.Value(w.probe, unknowns));
    SumUp();
    return {};
}

CPushPath::T_FAULT CPushPath::Rebuild()
{
    const std::size_t set = m_factors.size() - 1;
    m_system.Reset(m_border == 0 ? m_watches[*m_control].byLoads[set] : m_border == 1 ? 1.0 : 0.0);
    const std::vector<std::size_t> active = std::move(m_active);
    m_active.clear();
    for (const std::size_t f : active)
        m_place[f] = 0;
    for (const std::size_t f : active)
        if (auto fault = Activate(f)) return fault;
    return {};
}

void CPushPath::SumUp()
{
    m_force = m_base.force;
    for (std::size_t w = 0; w < m_watches.size(); ++w)
        m_watches[w].value = m_base.watch[w];
    for (std::size_t l = 0; l < m_factors.size(); ++l) {
        const double more = m_factors[l] - m_base.factors[l];
        if (more == 0.0) continue;
        const std::vector<double>& loads = m_structure.Loads(l).force;
        for (std::size_t r = 0; r < m_force.size(); ++r)
            m_force[r] += more * loads[r];
        for (T_WATCH& w : m_watches)
            w.value += more * w.byLoads[l];
    }
    std::vector<double> more(m_plastic);
    for (std::size_t r = 0; r < more.size(); ++r)
        more[r] -= m_base.plastic[r];
    AddColumns(more, m_force);
    for (std::size_t c = 0; c < more.size(); ++c)
        for (std::size_t w = 0; w < m_watches.size() && more[c] != 0.0; ++w)
            m_watches[w].value += more[c] * m_columnOf[c]->watch[w];
    m_sinceSum = 0;
}

void CPushPath::ChoosePart(std::size_t f)
{
    CPushFlow& flow = m_flows.flows[f];
    const double rate = m_rate.force.empty() ? 0.0 : m_rate.force[flow.AxialRow()];
    for (CAxialLine& line : flow.Lines())
        if (line.IsGiven()) line.Choose(m_force[flow.AxialRow()], rate);
}

double CPushPath::NextEvent(double back) const
{
    const double least = Least();
    double first = CHingeBackbone::kFar;
    const auto take = [&](double distance, double rate) {
        first = std::min(first, std::max(-back, distance / rate));
    };
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        if (const T_LOCK& lock = m_lock[f]; lock.isPlain) {
            const double force = lock.sign * m_force[lock.row];
            const double rate = lock.sign * m_rate.force[lock.row];
            if (rate > least * lock.force) take(lock.upper - force, rate);
            if (rate < -least * lock.force && lock.lower > -CHingeBackbone::kFar)
                take(force - lock.lower, -rate);
            continue;
        }
        const CPushFlow& flow = m_flows.flows[f];
        const CHingeBackbone& backbone = Backbone(f);
        const bool flows = IsMoving(f);
        const double rate = flows ? FlowRate(f) : PhiRate(f);
        const double size = rate * (flows ? flow.stiffness : 1.0) / flow.force;
        const double measure = flow.mates.empty() ? rate : MeasureRate(f);
        if (flows && measure * flow.stiffness / flow.force > least)
            take(backbone.Room(true), measure);
        if (IsShared(f) && backbone.ShareRoom() > 0.0 &&
            measure * flow.stiffness / flow.force > least)
            take(backbone.ShareRoom(), measure);
        if (flows && size < -least && backbone.On() == ON::Back) take(backbone.Room(false), -rate);
        if (backbone.On() == ON::Locked && size > least) take(-Phi(f, backbone.Upper()), rate);
        if (backbone.On() == ON::Locked && size < -least &&
            backbone.Lower() > -CHingeBackbone::kFar)
            take(Phi(f, backbone.Lower()), -rate);
        if (backbone.On() == ON::Drop && size < -least) take(Phi(f, backbone.Force()), -rate);
        if (!flow.HangsOnAxial()) continue;
        const double axial = m_force[flow.AxialRow()], goes = m_rate.force[flow.AxialRow()];
        for (const CAxialLine& line : flow.Lines())
            if (line.IsGiven() && std::fabs(goes) > least * 1e-3 * line.Width())
                take((line.Corner(goes) - axial) * (goes > 0.0 ? 1.0 : -1.0), std::fabs(goes));
    }
    return first;
}

void CPushPath::Advance(double by)
{
    ++m_sinceSum;
    m_factors.back() += by * m_rate.factor;
    for (std::size_t r = 0; r < m_force.size(); ++r)
        m_force[r] += by * m_rate.force[r];
    for (std::size_t r = 0; r < m_plastic.size(); ++r)
        m_plastic[r] += by * m_rate.plastic[r];
    MoveFlows(m_rate.flow, m_rate.force, by);
    for (T_WATCH& w : m_watches)
        w.value += by * w.rate;
}

long CPushPath::Turn()
{
    const double least = Least();
    std::vector<std::size_t> begun;
    long outside = -1;
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        const CPushFlow& flow = m_flows.flows[f];
        if (const T_LOCK& lock = m_lock[f]; lock.isPlain) {
            const double force = lock.sign * m_force[lock.row], close = kNear * lock.force;
            if (force < lock.upper - close && force > lock.lower + close) continue;
        }
        CHingeBackbone& backbone = Backbone(f);
        const double near = kNear * flow.force, close = near / flow.stiffness;
        const bool flows = IsMoving(f);
        const double rate = flows ? FlowRate(f) * flow.stiffness : PhiRate(f);
        const double size = rate / flow.force;
        const auto turn = [&](auto&& change) {
            Touch(f);
            change();
            begun.push_back(f);
        };
        switch (backbone.On()) {
        case ON::Locked:
            if (size > least && Phi(f, backbone.Upper()) >= -near)
                turn([&] { backbone.Start(true); });
            else if (size < -least && backbone.Lower() > -CHingeBackbone::kFar &&
                     Phi(f, backbone.Lower()) <= near)
                turn([&] { backbone.Start(false); });
            break;
        case ON::Virgin:
        case ON::Back:
            if (MeasureRate(f) * flow.stiffness > least * flow.force &&
                backbone.Room(true) <= close)
                turn([&] { backbone.End(true); });
            else if (backbone.On() == ON::Back && size < -least && backbone.Room(false) <= close)
                turn([&] { backbone.End(false); });
            break;
        case ON::Drop:
            if (size < -least && Phi(f, backbone.Force()) <= near)
                turn([&] { backbone.EndDrop(); });
            break;
        }
        if (!flow.HangsOnAxial()) continue;
        const double axial = m_force[flow.AxialRow()], goes = m_rate.force[flow.AxialRow()];
        for (const CAxialLine& line : flow.Lines())
            if (line.IsGiven() && goes != 0.0 && line.IsLast(goes) &&
                std::fabs(line.Corner(goes) - axial) <= kNear * line.Width())
                outside = static_cast<long>(flow.hinge);
        const auto slopes = flow.Slopes();
        ChoosePart(f);
        if (IsActive(f) && slopes != flow.Slopes()) Touch(f); // another row of the system
    }
    TakeDrive(begun);
    return outside;
}

/// A drop goes down to its end, whatever else begins on the way.
void CPushPath::TakeDrive(std::span<const std::size_t> begun)
{
    m_dropping.insert(m_dropping.end(), begun.begin(), begun.end());
    std::erase_if(m_dropping, [&](std::size_t f) { return Backbone(f).On() != ON::Drop; });
    std::sort(m_dropping.begin(), m_dropping.end());
    m_dropping.erase(std::unique(m_dropping.begin(), m_dropping.end()), m_dropping.end());
    T_PUSH_DRIVE drive;
    drive.flows = m_dropping;
    if (!drive.flows.empty()) {
        drive.kind = T_PUSH_DRIVE::KIND::Forces;
        drive.sign = -1.0;
        m_drive = std::move(drive);
        return;
    }
    for (const std::size_t f : begun)
        if (Backbone(f).On() == ON::Virgin) drive.flows.push_back(f);
    drive.kind = drive.flows.empty() ? T_PUSH_DRIVE::KIND::Before : T_PUSH_DRIVE::KIND::Flows;
    m_drive = std::move(drive);
}

CPushPath::T_FAULT CPushPath::SyncTouched()
{
    for (const auto& [f, was] : m_touched)
        if (auto fault = Sync(f)) return fault;
    return {};
}

std::vector<T_HINGE_EVENT> CPushPath::TakeTurned()
{
    std::sort(m_turned.begin(), m_turned.end(), [](const T_HINGE_EVENT& a, const T_HINGE_EVENT& b) {
        return std::tie(a.hinge, a.law) < std::tie(b.hinge, b.law);
    });
    return std::exchange(m_turned, {});
}

CPushPath::T_FAULT CPushPath::Correct(std::optional<double> control)
{
    std::vector<double> right, x;
    for (int tries = 0; tries < kMostCorrections; ++tries) {
        const bool isSum = tries > 0 || m_sinceSum > kMostSince;
        if (isSum) SumUp();
        right.assign(m_system.Size(), 0.0);
        double worst = 0.0;
        if (control && m_control && m_border == 0) {
            right[0] = *control - m_watches[*m_control].value;
            if (right[0] != 0.0) worst = std::fabs(right[0] / *control);
        }
        for (std::size_t k = 0; k < m_active.size(); ++k) {
            const std::size_t f = m_active[k];
            right[k + 1] = IsMoving(f) ? Phi(f, Resistance(f)) : Misfit(f) / m_soft[f];
            worst = std::max(worst, std::fabs(right[k + 1]) / m_flows.flows[f].force);
        }
        if (worst <= (isSum ? kSettled : kKept)) return {};
        if (!isSum) continue;
        if (tries > 1)
            if (auto fault = Rebuild()) return fault; // slopes may hang on the forces
        if (!m_system.Solve(right, x)) return {};
        m_factors.back() += x[0];
        for (std::size_t k = 0; k < m_active.size(); ++k) {
            const std::size_t f = m_active[k];
            for (const T_FLOW_TERM& d : m_flows.flows[f].Direction(m_force, Resistance(f)))
                m_plastic[d.row] += d.factor * x[k + 1];
        }
        std::vector<double> change = m_force;
        SumUp();
        for (std::size_t r = 0; r < change.size(); ++r)
            change[r] = m_force[r] - change[r];
        MoveFlows(std::span(x).subspan(1), change, 1.0);
    }
    SumUp();
    return {};
}

double CPushPath::Deformation(std::size_t hinge, std::size_t law, double& rate) const
{
    const std::size_t row = m_structure.RowOf(hinge, law);
    const double compliance = m_structure.Compliance(row);
    rate = m_rate.plastic.empty() ? 0.0 : m_rate.plastic[row] + compliance * m_rate.force[row];
    return m_plastic[row] + compliance * m_force[row];
}

std::vector<T_HINGE_STATE> CPushPath::HingeStates() const
{
    std::vector<std::array<int, 2>> vertex(m_lawCount);
    for (std::size_t f = 0; f < m_flows.flows.size(); ++f) {
        const CPushFlow& flow = m_flows.flows[f];
        int& most = vertex[m_firstLaw[flow.hinge] + flow.law][flow.positive ? 0 : 1];
        if (flow.mates.empty() || Backbone(f).HasBegun())
            most = std::max(most, Backbone(f).Vertex());
    }
    std::vector<T_HINGE_STATE> out;
    out.reserve(m_lawCount);
    double rate = 0.0;
    for (std::size_t h = 0; h < m_model.hinges.size(); ++h)
        for (std::size_t l = 0; l < m_model.hinges[h].laws.size(); ++l) {
            const auto [positive, negative] = vertex[out.size()];
            T_HINGE_STATE& state = out.emplace_back();
            state.deformation = Deformation(h, l, rate);
            state.force = m_force[m_structure.RowOf(h, l)];
            const bool isPositive = negative == 0 || (positive > 0 && state.force >= 0.0);
            state.place = isPositive ? positive : -negative;
        }
    return out;
}

} // namespace solver
