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

/// The component whose strength the condition is measured by; of a side the one it has.
std::size_t CPushFlow::Leading() const
{
    return m_count == 2 && std::fabs(m_normal[1]) > std::fabs(m_normal[0]) ? 1 : 0;
}

/// Of the force of row k in the value.
double CPushFlow::Weight(std::size_t k, double axial) const
{
    if (m_count == 1) return m_normal[0];
    const double weight = m_normal[k] * force / m_strength[k];
    const std::size_t leading = Leading();
    return k == leading ? weight : weight * m_lines[leading].Value(axial) / m_lines[k].Value(axial);
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
    return m_distance * m_lines[Leading()].Value(Axial(s));
}

std::span<const T_FLOW_TERM> CPushFlow::Gradient(std::span<const double> s, double resistance) const
{
    const double axial = Axial(s);
    for (std::size_t k = 0; k < m_count; ++k)
        m_gradient[k] = {m_rows[k], Weight(k, axial)};
    if (!HangsOnAxial()) return {m_gradient.data(), m_count};
    const std::size_t leading = Leading(), other = 1 - leading;
    const double slope = m_lines[leading].Slope();
    double byAxial = -m_distance * slope * resistance;
    if (m_count == 2)
        byAxial += Weight(other, axial) * s[m_rows[other]] *
                   (slope / m_lines[leading].Value(axial) -
                    m_lines[other].Slope() / m_lines[other].Value(axial));
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

constexpr double kAcross = 3.0 * std::numbers::pi / 180.0; // half a face across an axis
constexpr int kChords = 4;                                 // between two of them
constexpr double kLeastShare = 1e-9;                       // of a normal: less is rounding

class CFlowMaker {
public:
    CFlowMaker(const T_PUSH_MODEL& model, const CPushStructure& structure)
        : m_model(model), m_structure(structure)
    {
    }

    T_PUSH_FLOWS Make()
    {
        for (std::size_t h = 0; h < m_model.hinges.size(); ++h) {
            const auto bending = BendingOf(m_model.hinges[h]);
            AddSides(h, bending.has_value());
            if (bending) AddFaces(h, *bending);
        }
        return std::move(m_out);
    }

private:
    using T_BENDING = std::array<std::size_t, 2>; // laws of My and Mz

    static std::optional<T_BENDING> BendingOf(const T_PUSH_HINGE& hinge)
    {
        if (!hinge.biaxial) return {};
        T_BENDING bending{hinge.laws.size(), hinge.laws.size()};
        for (std::size_t l = 0; l < hinge.laws.size(); ++l)
            if (hinge.laws[l].component > 3)
                bending[static_cast<std::size_t>(hinge.laws[l].component) - 4] = l;
        if (bending[0] == hinge.laws.size() || bending[1] == hinge.laws.size()) return {};
        return bending;
    }

    CPushFlow& Add(std::size_t h, std::size_t l, bool positive)
    {
        const T_HINGE_LAW& law = m_model.hinges[h].laws[l];
        CPushFlow& flow = m_out.flows.emplace_back();
        flow.hinge = h;
        flow.law = l;
        flow.positive = positive;
        flow.backbone = m_out.backbones.size();
        flow.associated = m_model.hinges[h].flow == HINGE_FLOW::Associated;
        const CHingeBackbone& own =
            m_out.backbones.emplace_back(positive ? law.positive : law.negative, law.stiffness);
        if (own.Strength() > 0.0) flow.force = own.Strength();
        flow.stiffness = m_structure.OwnStiffness(m_structure.RowOf(h, l));
        return flow;
    }

    void AddSides(std::size_t h, bool isBiaxial)
    {
        const std::vector<T_HINGE_LAW>& laws = m_model.hinges[h].laws;
        for (std::size_t l = 0; l < laws.size(); ++l) {
            if (isBiaxial && laws[l].component > 3) continue;
            for (const bool positive : {true, false})
                if (Flows(positive ? laws[l].positive : laws[l].negative))
                    Add(h, l, positive)
                        .SetSide(m_structure.RowOf(h, l), positive, m_structure.AxialRow(h),
                                 LineOf(laws[l], positive));
        }
    }

    void AddFaces(std::size_t h, const T_BENDING& bending)
    {
        const std::size_t first = m_out.flows.size();
        for (const T_FACE& face : BiaxialFaces()) {
            std::array<double, 2> normal{std::cos(face.angle), std::sin(face.angle)};
            for (double& n : normal)
                if (std::fabs(n) < kLeastShare) n = 0.0; // across an axis
            const std::size_t larger = std::fabs(normal[0]) >= std::fabs(normal[1]) ? 0 : 1;
            std::array<double, 2> strength{};
            std::array<CAxialLine, 2> lines;
            for (std::size_t k = 0; k < 2; ++k) {
                const T_HINGE_LAW& law = m_model.hinges[h].laws[bending[k]];
                strength[k] = (normal[k] > 0.0 ? law.positive : law.negative).points[0].force;
                lines[k] = LineOf(law, normal[k] > 0.0);
            }
            CPushFlow& flow = Add(h, bending[larger], normal[larger] > 0.0);
            flow.force = strength[larger];
            flow.SetFace({m_structure.RowOf(h, bending[0]), m_structure.RowOf(h, bending[1])},
                         normal, face.distance, strength, m_structure.AxialRow(h),
                         std::move(lines));
        }
        ShareFlows(first);
    }

    /// A rotation counts for a face by its part along the face's normal, strengths taken as 1.
    void ShareFlows(std::size_t first)
    {
        const std::vector<T_FACE> faces = BiaxialFaces();
        for (std::size_t i = 0; i < faces.size(); ++i)
            for (std::size_t k = 0; k < faces.size(); ++k) {
                const double along = std::cos(faces[k].angle - faces[i].angle);
                CPushFlow& flow = m_out.flows[first + i];
                const CPushFlow& other = m_out.flows[first + k];
                if (i == k || along < kLeastShare) continue;
                if (!m_out.backbones[flow.backbone].CanShare()) continue;
                flow.mates.push_back({first + k, along * other.force / flow.force});
            }
    }

    const T_PUSH_MODEL& m_model;
    const CPushStructure& m_structure;
    T_PUSH_FLOWS m_out;
};

} // namespace

std::vector<T_FACE> BiaxialFaces()
{
    constexpr double kQuarter = std::numbers::pi / 2.0;
    const double corner = 1.0 / std::cos(kAcross), chord = (kQuarter - 2.0 * kAcross) / kChords;
    std::vector<T_FACE> faces;
    for (int q = 0; q < 4; ++q) {
        faces.push_back({q * kQuarter, 1.0});
        for (int c = 0; c < kChords; ++c)
            faces.push_back(
                {q * kQuarter + kAcross + (c + 0.5) * chord, corner * std::cos(0.5 * chord)});
    }
    return faces;
}

T_PUSH_FLOWS MakeFlows(const T_PUSH_MODEL& model, const CPushStructure& structure)
{
    return CFlowMaker(model, structure).Make();
}

} // namespace solver
