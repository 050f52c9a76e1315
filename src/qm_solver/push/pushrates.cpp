// Rates along the path of a push, and which way along it.
#include "qm_solver/push/pushpath.h"

#include <algorithm>
#include <cmath>

namespace solver {

using ON = CHingeBackbone::ON;

namespace {

constexpr double kArrived = 1e-10; // of a way: back at an event
constexpr int kMostTurnsBack = 12;

} // namespace

int CPushPath::SolveDirection(std::vector<double>& x)
{
    if (m_system.Direction(x)) return 1;
    // The control does not move along the path, or the load factor alone does not: another border.
    for (const int border : {0, 1, 2}) {
        if (border == m_border || (border == 0 && !m_control)) continue;
        m_border = border;
        std::vector<double> row(m_system.Size(), 0.0);
        const std::size_t set = m_factors.size() - 1;
        if (border == 0) row[0] = m_watches[*m_control].byLoads[set];
        if (border == 1) row[0] = 1.0;
        for (std::size_t k = 0; k < m_active.size(); ++k) {
            CPushFlow& flow = m_flows.flows[m_active[k]];
            if (border == 2) row[k + 1] = flow.force;
            if (border == 0)
                for (const T_FLOW_TERM& d : flow.Direction(m_force, Resistance(m_active[k])))
                    row[k + 1] += d.factor * m_columnOf[d.row]->watch[*m_control];
        }
        m_system.SetControl(row);
        if (m_system.Direction(x)) return 1;
    }
    return 0;
}

void CPushPath::RatesOf(std::span<const double> x, double sign)
{
    const std::size_t rows = m_structure.RowCount(), set = m_factors.size() - 1;
    m_rate.factor = sign * x[0];
    m_rate.flow.resize(m_active.size());
    m_rate.plastic.assign(rows, 0.0);
    for (std::size_t k = 0; k < m_active.size(); ++k) {
        m_rate.flow[k] = sign * x[k + 1];
        CPushFlow& flow = m_flows.flows[m_active[k]];
        for (const T_FLOW_TERM& d : flow.Direction(m_force, Resistance(m_active[k])))
            m_rate.plastic[d.row] += d.factor * m_rate.flow[k];
    }
    const std::vector<double>& loads = m_structure.Loads(set).force;
    m_rate.force.resize(rows);
    for (std::size_t r = 0; r < rows; ++r)
        m_rate.force[r] = m_rate.factor * loads[r];
    for (T_WATCH& w : m_watches)
        w.rate = m_rate.factor * w.byLoads[set];
    AddColumns(m_rate.plastic, m_rate.force);
    for (std::size_t c = 0; c < rows; ++c)
        for (std::size_t w = 0; w < m_watches.size() && m_rate.plastic[c] != 0.0; ++w)
            m_watches[w].rate += m_rate.plastic[c] * m_columnOf[c]->watch[w];
    m_norm = Norm();
    m_rate.control = m_control ? m_watches[*m_control].rate : m_rate.factor;
}

/// Rates by strengths: of forces, and of what flows as the force that it would make elastically.
double CPushPath::Norm() const
{
    double norm = 0.0;
    for (std::size_t r = 0; r < m_byForce.size(); ++r)
        norm = std::max({norm, std::fabs(m_rate.force[r]) * m_byForce[r],
                         std::fabs(m_rate.plastic[r]) * m_byStiffness[r]});
    return norm;
}

/// Sums of columns, four at a time: the forces are read and written once for all four.
void CPushPath::AddColumns(std::span<const double> by, std::span<double> forces) const
{
    std::array<const double*, 4> column{};
    std::array<double, 4> factor{};
    std::size_t count = 0;
    const auto flush = [&] {
        for (std::size_t k = count; k < 4; ++k)
            column[k] = column[0], factor[k] = 0.0;
        for (std::size_t r = 0; r < forces.size(); ++r)
            forces[r] += factor[0] * column[0][r] + factor[1] * column[1][r] +
                         factor[2] * column[2][r] + factor[3] * column[3][r];
        count = 0;
    };
    for (std::size_t c = 0; c < by.size(); ++c) {
        if (by[c] == 0.0) continue;
        column[count] = m_columnOf[c]->force.data();
        factor[count] = by[c];
        if (++count == 4) flush();
    }
    if (count > 0) flush();
}

/// Which way along the line of solutions: rates are those of sign +1.
double CPushPath::DriveSign() const
{
    using KIND = T_PUSH_DRIVE::KIND;
    const double least = Least();
    double sum = 0.0;
    switch (m_drive.kind) {
    case KIND::Control:
        sum = m_drive.sign * m_rate.control;
        break;
    case KIND::Factor:
        sum = m_drive.sign * LoadRate();
        break;
    case KIND::Flows:
        for (const std::size_t f : m_drive.flows)
            if (IsMoving(f))
                sum += FlowRate(f) * m_flows.flows[f].stiffness / m_flows.flows[f].force;
        if (std::fabs(sum) > least) return sum > 0.0 ? 1.0 : -1.0;
        sum = 0.0;
        break;
    case KIND::Forces:
        for (const std::size_t f : m_drive.flows)
            sum += m_drive.sign * m_flows.flows[f].Value(m_rate.force) / m_flows.flows[f].force;
        if (std::fabs(sum) > least) return sum > 0.0 ? 1.0 : -1.0;
        sum = 0.0;
        break;
    case KIND::Before:
        break;
    }
    if (sum != 0.0) return sum > 0.0 ? 1.0 : -1.0;
    // As before: what flows on the backbone goes on, else the forces do.
    const auto add = [&](std::size_t f) {
        if (Backbone(f).On() == ON::Virgin)
            sum += FlowRate(f) * m_flows.flows[f].stiffness / m_flows.flows[f].force;
    };
    for (const std::size_t f : m_active)
        add(f);
    for (const std::size_t f : m_softFlows)
        if (!IsActive(f)) add(f);
    if (std::fabs(sum) > least) return sum > 0.0 ? 1.0 : -1.0;
    if (!m_hasBefore) return m_rate.control >= 0.0 ? 1.0 : -1.0;
    sum = 0.0;
    double size = 0.0;
    for (std::size_t r = 0; r < m_byForce.size(); ++r) {
        if (std::fabs(m_before[r]) * m_byForce[r] <= m_beforeLeast) continue; // did not change
        const double product = m_rate.force[r] * m_before[r] * m_byForce[r] * m_byForce[r];
        sum += product;
        size += std::fabs(product);
    }
    if (size > 0.0 && std::fabs(sum) > kLeastRate * size) return sum > 0.0 ? 1.0 : -1.0;
    return m_rate.control * m_beforeControl >= 0.0 ? 1.0 : -1.0; // nothing resisted before
}

bool CPushPath::IsElsewhere() const
{
    if (!m_control || m_norm == 0.0 || LoadRate() != 0.0) return false;
    const T_WATCH& watch = m_watches[*m_control];
    // what elastic forces of the size of these rates would move it by
    const double loads = LoadSize();
    double size = loads > 0.0 ? std::fabs(watch.byLoads.back()) * m_norm / loads : 0.0;
    for (std::size_t r = 0; r < m_rate.plastic.size(); ++r)
        if (m_rate.plastic[r] != 0.0)
            size += std::fabs(m_rate.plastic[r] * m_columnOf[r]->watch[*m_control]);
    return std::fabs(watch.rate) <= kLeastRate * size;
}

int CPushPath::MakeRates()
{
    std::vector<double> x;
    if (!SolveDirection(x)) return 0;
    RatesOf(x, 1.0);
    if (DriveSign() < 0.0) RatesOf(x, -1.0);
    return 1;
}

double CPushPath::Recede(double by)
{
    double back = 0.0;
    for (int tries = 0; m_isBent && tries < kMostTurnsBack; ++tries) {
        const double left = NextEvent(by + back);
        if (!(left < -kArrived * by)) break;
        Advance(left);
        back += left;
    }
    return back;
}

} // namespace solver
