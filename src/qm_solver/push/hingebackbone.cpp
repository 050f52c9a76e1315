#include "qm_solver/push/hingebackbone.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kRounding = 1e-9; // of a deformation that the spring takes whole

/// Beyond the spring; nothing where the spring takes all but the rounding of entered numbers.
double Plastic(const T_BACKBONE_POINT& point, double spring)
{
    const double flowed = point.deformation - (spring > 0.0 ? point.force / spring : 0.0);
    return std::fabs(flowed) <= kRounding * point.deformation ? 0.0 : flowed;
}

} // namespace

bool CHingeBackbone::IsFlowing(const T_HINGE_SIDE& side, double spring)
{
    double before = 0.0;
    for (const T_BACKBONE_POINT& point : side.points) {
        const double flowed = Plastic(point, spring);
        if (flowed < before - kRounding * point.deformation) return false;
        before = std::max(before, flowed);
    }
    return true;
}

CHingeBackbone::CHingeBackbone(const T_HINGE_SIDE& side, double spring)
    : m_gap(side.gap), m_slips(side.slips), m_unloading(side.unloading)
{
    if (side.free) m_gap = kFar;
    double before = 0.0;
    for (const T_BACKBONE_POINT& point : side.points) {
        before = std::max(before, Plastic(point, spring));
        m_points.push_back({before + (side.free ? 0.0 : m_gap), point.force});
    }
    m_furthest = m_gap;
    if (!m_points.empty() && m_points[0].flowed > m_gap && !side.free) {
        // A first vertex beyond the end of the gap: rigid until it would be the same as force 0.
        m_points.insert(m_points.begin(), {m_gap, 0.0});
        m_start = 1;
    }
}

double CHingeBackbone::Floor() const
{
    if (m_slips || !HasGap()) return 0.0;
    return m_gap < kFar ? m_furthest - m_gap : 0.0;
}

std::size_t CHingeBackbone::PartAt(double flowed) const
{
    std::size_t part = 1;
    while (part < m_points.size() && m_points[part].flowed < flowed)
        ++part;
    return part;
}

/// Part k lies between vertices k - 1 and k; the last one is level.
double CHingeBackbone::SlopeOf(std::size_t part) const
{
    if (part == 0 || part >= m_points.size()) return 0.0;
    const T_POINT &a = m_points[part - 1], &b = m_points[part];
    return b.flowed > a.flowed ? (b.force - a.force) / (b.flowed - a.flowed) : 0.0;
}

double CHingeBackbone::OnBackbone(double flowed) const
{
    const std::size_t part = PartAt(flowed);
    const T_POINT& a = m_points[part - 1];
    return a.force + SlopeOf(part) * (flowed - a.flowed);
}

double CHingeBackbone::Summit() const
{
    if (m_points.empty()) return 0.0;
    if (m_vertex == 0) return m_points[0].force;
    const T_POINT& a = m_points[m_vertex - 1];
    return a.force + SlopeOf(m_vertex) * (m_furthest - a.flowed);
}

double CHingeBackbone::Strength() const
{
    double most = 0.0;
    for (const T_POINT& point : m_points)
        most = std::max(most, point.force);
    return most;
}

double CHingeBackbone::Force() const
{
    switch (m_on) {
    case ON::Locked:
        return Upper();
    case ON::Virgin:
        return Summit();
    case ON::Drop:
        return m_points[m_vertex].force;
    case ON::Back:
        break;
    }
    if (HasGap()) return 0.0;
    if (Way() == UNLOADING::Origin) return Slope() * m_flowed;
    const T_POINT& a = m_points[m_back - 1];
    return a.force + SlopeOf(m_back) * (m_flowed - a.flowed);
}

double CHingeBackbone::Slope() const
{
    if (m_on == ON::Virgin) return SlopeOf(m_vertex);
    if (m_on != ON::Back || HasGap()) return 0.0;
    if (Way() == UNLOADING::Origin) return m_furthest > 0.0 ? Summit() / m_furthest : 0.0;
    return SlopeOf(m_back);
}

double CHingeBackbone::Upper() const
{
    if (m_flowed >= m_furthest) return Summit();
    if (!HasGap() && Way() == UNLOADING::Backbone) return m_points[0].force;
    return 0.0; // at the floor of a gap or of the line to the origin
}

double CHingeBackbone::Lower() const
{
    const bool atTop = m_flowed >= m_furthest && m_flowed > Floor();
    if (!IsReversible() || !atTop) return -kFar;
    return HasGap() ? 0.0 : Summit();
}

double CHingeBackbone::Room(bool forwards) const
{
    if (m_on == ON::Virgin) {
        if (!forwards || m_vertex >= m_points.size()) return forwards ? kFar : 0.0;
        return m_points[m_vertex].flowed - m_flowed;
    }
    if (m_on != ON::Back) return kFar;
    const bool isBackbone = !HasGap() && Way() == UNLOADING::Backbone;
    if (isBackbone && forwards && m_back < m_points.size())
        return std::min(m_furthest, m_points[m_back].flowed) - m_flowed;
    if (isBackbone && !forwards) return m_flowed - m_points[m_back - 1].flowed;
    return forwards ? m_furthest - m_flowed : m_flowed - Floor();
}

void CHingeBackbone::Flow(double by)
{
    m_flowed += by;
    if (m_on == ON::Virgin) m_furthest = m_flowed;
}

double CHingeBackbone::ShareRoom() const
{
    const std::size_t next = std::max<std::size_t>(1, m_vertex);
    return next < m_points.size() ? std::max(0.0, m_points[next].flowed - m_flowed) : kFar;
}

double CHingeBackbone::ShareSlope() const
{
    return ShareRoom() > 0.0 ? SlopeOf(std::max<std::size_t>(1, m_vertex)) : 0.0;
}

void CHingeBackbone::Share(double by)
{
    if (!(by > 0.0)) return;
    m_vertex = std::max<std::size_t>(1, m_vertex);
    const double room = ShareRoom();
    m_flowed = by < room ? m_flowed + by : m_points[m_vertex].flowed;
    m_furthest = m_flowed;
}

/// At the furthest deformation, on its way on: past all vertices that lie there.
void CHingeBackbone::EnterVirgin()
{
    m_on = ON::Virgin;
    if (m_vertex == 0) ++m_vertex;
    m_flowed = m_furthest;
    if (m_vertex < m_points.size() && m_points[m_vertex].flowed <= m_furthest) {
        m_furthest = m_flowed = m_points[m_vertex].flowed;
        if (m_points[m_vertex].force < m_points[m_vertex - 1].force) {
            m_on = ON::Drop;
        } else { // rises upright: rigid up to there
            m_on = ON::Locked;
            ++m_vertex;
        }
    }
}

void CHingeBackbone::Start(bool forwards)
{
    m_begun = true;
    if (forwards && m_flowed >= m_furthest) {
        EnterVirgin();
        return;
    }
    m_on = ON::Back;
    if (!HasGap() && Way() == UNLOADING::Backbone)
        m_back = forwards ? 1 : std::max<std::size_t>(1, PartAt(m_flowed));
}

void CHingeBackbone::End(bool forwards)
{
    if (m_on == ON::Virgin) {
        m_flowed = m_furthest = m_points[m_vertex].flowed;
        ++m_vertex;
        EnterVirgin();
        return;
    }
    const bool isBackbone = !HasGap() && Way() == UNLOADING::Backbone;
    if (forwards) {
        if (isBackbone && m_back < m_points.size() && m_points[m_back].flowed < m_furthest) {
            m_flowed = m_points[m_back++].flowed;
            return;
        }
        m_flowed = m_furthest;
        if (HasGap())
            m_on = ON::Locked;
        else
            EnterVirgin();
        return;
    }
    if (isBackbone && m_back > 1) {
        m_flowed = m_points[--m_back].flowed;
        return;
    }
    m_flowed = Floor();
    m_on = ON::Locked;
}

void CHingeBackbone::Unload()
{
    if (m_on == ON::Virgin && !HasGap() && Way() != UNLOADING::Elastic && m_furthest > 0.0) {
        m_on = ON::Back;
        m_back = std::max<std::size_t>(1, PartAt(m_flowed));
        return;
    }
    m_on = ON::Locked;
}

void CHingeBackbone::EndDrop()
{
    m_broken = true;
    ++m_vertex;
    EnterVirgin();
}

} // namespace solver
