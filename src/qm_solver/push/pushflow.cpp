#include "qm_solver/push/pushflow.h"

#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kCorner = 1e-9; // width of a corner over that of the line

} // namespace

CAxialLine::CAxialLine(std::vector<T_POINT> points) : m_points(std::move(points))
{
    if (!IsGiven()) return;
    std::size_t low = 0, high = m_points.size() - 1;
    while (low + 1 < high && m_points[low].strength == m_points[low + 1].strength)
        ++low;
    while (high > low + 1 && m_points[high].strength == m_points[high - 1].strength)
        --high;
    m_width = m_points[high].axial - m_points[low].axial;
}

void CAxialLine::Choose(double axial, double rate)
{
    const double near = kCorner * Width();
    m_part = 0;
    while (m_part + 2 < m_points.size() && m_points[m_part + 1].axial < axial - near)
        ++m_part;
    if (rate > 0.0 && m_part + 2 < m_points.size() &&
        std::fabs(m_points[m_part + 1].axial - axial) <= near)
        ++m_part;
}

double CAxialLine::Slope() const
{
    if (!IsGiven()) return 0.0;
    const T_POINT &a = m_points[m_part], &b = m_points[m_part + 1];
    return (b.strength - a.strength) / (b.axial - a.axial);
}

double CAxialLine::Value(double axial) const
{
    if (!IsGiven()) return m_points.empty() ? 1.0 : m_points[0].strength;
    return m_points[m_part].strength + Slope() * (axial - m_points[m_part].axial);
}

double CAxialLine::Corner(double rate) const
{
    if (!IsGiven() || rate == 0.0) return std::numeric_limits<double>::infinity();
    return m_points[rate > 0.0 ? m_part + 1 : m_part].axial;
}

bool CAxialLine::IsLast(double rate) const
{
    return rate > 0.0 ? m_part + 2 >= m_points.size() : m_part == 0;
}

void CPushFlow::SetSide(std::size_t row, bool isPositive, std::size_t axialRow, CAxialLine ratio)
{
    m_rows[0] = row;
    m_count = 1;
    positive = isPositive;
    m_normal[0] = isPositive ? 1.0 : -1.0;
    m_axialRow = axialRow;
    m_lines[0] = std::move(ratio);
}

void CPushFlow::SetFace(std::array<std::size_t, 2> rows, std::array<double, 2> normal,
                        double distance, std::array<double, 2> strength, std::size_t axialRow,
                        std::array<CAxialLine, 2> ratios)
{
    m_rows = rows;
    m_count = 2;
    m_normal = normal;
    m_distance = distance;
    m_strength = strength;
    m_axialRow = axialRow;
    m_lines = std::move(ratios);
}

/// Of the force of row k in the value.
double CPushFlow::Weight(std::size_t k, double axial) const
{
    if (m_count == 1) return m_normal[0];
    return m_normal[k] * force / (m_strength[k] * m_lines[k].Value(axial));
}

double CPushFlow::Value(std::span<const double> s) const
{
    double sum = 0.0;
    for (std::size_t k = 0; k < m_count; ++k)
        sum += Weight(k, Axial(s)) * s[m_rows[k]];
    return sum;
}

double CPushFlow::Scale(std::span<const double> s) const
{
    return m_count == 1 ? m_lines[0].Value(Axial(s)) : m_distance;
}

std::span<const T_FLOW_TERM> CPushFlow::Gradient(std::span<const double> s, double resistance) const
{
    const double axial = Axial(s);
    for (std::size_t k = 0; k < m_count; ++k)
        m_gradient[k] = {m_rows[k], Weight(k, axial)};
    if (!HangsOnAxial()) return {m_gradient.data(), m_count};
    double byAxial = 0.0;
    if (m_count == 1) byAxial = -m_lines[0].Slope() * resistance;
    for (std::size_t k = 0; k < m_count && m_count == 2; ++k)
        byAxial -= Weight(k, axial) * s[m_rows[k]] * m_lines[k].Slope() / m_lines[k].Value(axial);
    m_gradient[m_count] = {m_axialRow, byAxial};
    return {m_gradient.data(), m_count + 1};
}

std::span<const T_FLOW_TERM> CPushFlow::Direction(std::span<const double> s,
                                                  double resistance) const
{
    const auto gradient = Gradient(s, resistance);
    const std::size_t count = associated ? gradient.size() : m_count;
    std::copy_n(gradient.begin(), count, m_direction.begin());
    return {m_direction.data(), count};
}

namespace {

CAxialLine LineOf(const T_HINGE_LAW& law, bool positive)
{
    const T_HINGE_SIDE& side = positive ? law.positive : law.negative;
    std::vector<CAxialLine::T_POINT> points;
    for (const T_AXIAL_STRENGTH& row : law.byAxial)
        points.push_back(
            {row.axial, (positive ? row.positive : row.negative) / side.points[0].force});
    return CAxialLine(std::move(points));
}

bool Flows(const T_HINGE_SIDE& side)
{
    return side.free || !side.points.empty();
}

} // namespace

T_PUSH_FLOWS MakeFlows(const T_PUSH_MODEL& model, const CPushStructure& structure)
{
    T_PUSH_FLOWS out;
    const auto add = [&](std::size_t h, std::size_t l, bool positive) -> CPushFlow& {
        const T_HINGE_LAW& law = model.hinges[h].laws[l];
        const T_HINGE_SIDE& side = positive ? law.positive : law.negative;
        CPushFlow& flow = out.flows.emplace_back();
        flow.hinge = h;
        flow.law = l;
        flow.positive = positive;
        flow.backbone = out.backbones.size();
        flow.associated = model.hinges[h].flow == HINGE_FLOW::Associated;
        const CHingeBackbone& own = out.backbones.emplace_back(side, law.stiffness);
        if (own.Strength() > 0.0) flow.force = own.Strength();
        flow.stiffness = structure.OwnStiffness(structure.RowOf(h, l));
        return flow;
    };
    for (std::size_t h = 0; h < model.hinges.size(); ++h) {
        const T_PUSH_HINGE& hinge = model.hinges[h];
        const std::size_t axial = structure.AxialRow(h);
        std::array<std::size_t, 2> bending{hinge.laws.size(), hinge.laws.size()};
        for (std::size_t l = 0; l < hinge.laws.size(); ++l)
            if (hinge.biaxial && hinge.laws[l].component > 3)
                bending[static_cast<std::size_t>(hinge.laws[l].component) - 4] = l;
        const bool isBiaxial =
            hinge.biaxial && bending[0] < hinge.laws.size() && bending[1] < hinge.laws.size();
        for (std::size_t l = 0; l < hinge.laws.size(); ++l) {
            if (isBiaxial && hinge.laws[l].component > 3) continue;
            for (const bool positive : {true, false})
                if (Flows(positive ? hinge.laws[l].positive : hinge.laws[l].negative))
                    add(h, l, positive)
                        .SetSide(structure.RowOf(h, l), positive, axial,
                                 LineOf(hinge.laws[l], positive));
        }
        for (std::size_t f = 0; f < kFaces && isBiaxial; ++f) {
            // normals midway between the vertices, which lie on the axes and between them
            const double angle =
                2.0 * std::numbers::pi * (static_cast<double>(f) + 0.5) / double(kFaces);
            const std::array<double, 2> normal{std::cos(angle), std::sin(angle)};
            const std::size_t larger = std::fabs(normal[0]) >= std::fabs(normal[1]) ? 0 : 1;
            std::array<double, 2> strength{};
            std::array<CAxialLine, 2> lines;
            for (std::size_t k = 0; k < 2; ++k) {
                const T_HINGE_LAW& law = hinge.laws[bending[k]];
                strength[k] = (normal[k] > 0.0 ? law.positive : law.negative).points[0].force;
                lines[k] = LineOf(law, normal[k] > 0.0);
            }
            CPushFlow& flow = add(h, bending[larger], normal[larger] > 0.0);
            flow.force = strength[larger];
            flow.SetFace({structure.RowOf(h, bending[0]), structure.RowOf(h, bending[1])}, normal,
                         std::cos(std::numbers::pi / double(kFaces)), strength, axial,
                         std::move(lines));
        }
    }
    return out;
}

} // namespace solver
