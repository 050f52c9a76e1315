#include "qm_solver/push/pushflow.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kCorner = 1e-9;    // width of a corner over that of the line
constexpr std::size_t kNormals = 2; // of the lines: where the parts of the normal begin

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
    m_hangs = m_lines[0].IsGiven();
}

void CPushFlow::SetFace(std::array<std::size_t, 2> rows, std::array<double, 2> normal,
                        double distance, std::array<double, 2> strength, std::size_t axialRow,
                        std::array<CAxialLine, 2> ratios)
{
    m_rows = rows;
    m_count = 2;
    m_normal = normal;
    m_leading = std::fabs(normal[1]) > std::fabs(normal[0]) ? 1 : 0;
    m_distance = distance;
    m_strength = strength;
    m_axialRow = axialRow;
    for (std::size_t k = 0; k < 2; ++k)
        m_lines[k] = std::move(ratios[k]);
    m_hangs = m_lines[0].IsGiven() || m_lines[1].IsGiven();
}

void CPushFlow::SetNormal(std::array<double, 2> normal, std::array<CAxialLine, 2> byAxial)
{
    m_normal = normal;
    for (std::size_t k = 0; k < 2; ++k) {
        m_hangs = m_hangs || byAxial[k].IsGiven();
        m_lines[kNormals + k] = std::move(byAxial[k]);
    }
}

std::array<double, 4> CPushFlow::Slopes() const
{
    std::array<double, 4> slopes{};
    for (std::size_t i = 0; i < slopes.size(); ++i)
        slopes[i] = m_lines[i].Slope();
    return slopes;
}

double CPushFlow::Normal(std::size_t k, double axial) const
{
    const CAxialLine& line = m_lines[kNormals + k];
    return line.IsGiven() ? line.Value(axial) : m_normal[k];
}

/// Strength of the leading component over that of component k.
double CPushFlow::Strengths(std::size_t k, double axial) const
{
    const double ratio = force / m_strength[k];
    return k == m_leading ? ratio
                          : ratio * m_lines[m_leading].Value(axial) / m_lines[k].Value(axial);
}

/// Of the force of row k in the value.
double CPushFlow::Weight(std::size_t k, double axial) const
{
    return m_count == 1 ? m_normal[0] : Normal(k, axial) * Strengths(k, axial);
}

/// Derivative of the weight by the axial force, of a face.
double CPushFlow::WeightSlope(std::size_t k, double axial) const
{
    double slope = m_lines[kNormals + k].Slope();
    if (k != m_leading)
        slope += Normal(k, axial) * (m_lines[m_leading].Slope() / m_lines[m_leading].Value(axial) -
                                     m_lines[k].Slope() / m_lines[k].Value(axial));
    return slope * Strengths(k, axial);
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
    return m_distance * m_lines[m_leading].Value(Axial(s));
}

std::span<const T_FLOW_TERM> CPushFlow::Gradient(std::span<const double> s, double resistance) const
{
    const double axial = Axial(s);
    for (std::size_t k = 0; k < m_count; ++k)
        m_gradient[k] = {m_rows[k], Weight(k, axial)};
    if (!HangsOnAxial()) return {m_gradient.data(), m_count};
    double byAxial = -m_distance * m_lines[m_leading].Slope() * resistance;
    for (std::size_t k = 0; k < m_count && m_count == 2; ++k)
        byAxial += WeightSlope(k, axial) * s[m_rows[k]];
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
constexpr std::size_t kChords = 4;                         // between two of them
constexpr double kLeastShare = 1e-9;                       // of a normal: less is rounding

/// The normal of a face of a biaxial hinge, for strengths of 1.
struct T_NORMAL {
    std::array<double, 2> fixed{};
    std::array<CAxialLine, 2> byAxial; // of what changes
};
T_NORMAL NormalOf(std::size_t face, double distance, const std::vector<T_AXIAL_SHAPE>& shape)
{
    T_NORMAL out;
    for (std::size_t k = 0; k < 2; ++k) {
        std::vector<CAxialLine::T_POINT> points;
        for (const T_AXIAL_SHAPE& row : shape)
            points.push_back({row.axial, distance * FaceNormal(face, row.share)[k]});
        const auto [low, high] =
            std::ranges::minmax_element(points, {}, &CAxialLine::T_POINT::strength);
        out.fixed[k] = std::fabs(low->strength) < kLeastShare ? 0.0 : low->strength;
        if (high->strength - low->strength > kLeastShare)
            out.byAxial[k] = CAxialLine(std::move(points));
    }
    return out;
}

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
        const std::vector<T_FACE> faces = BiaxialFaces();
        for (std::size_t i = 0; i < faces.size(); ++i) {
            const T_FACE& face = faces[i];
            std::array<double, 2> normal{std::cos(face.angle), std::sin(face.angle)};
            for (double& n : normal)
                if (std::fabs(n) < kLeastShare) n = 0.0; // across an axis
            const std::size_t larger = std::fabs(normal[1]) > std::fabs(normal[0]) ? 1 : 0;
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
            const std::vector<T_AXIAL_SHAPE>& shape = m_model.hinges[h].shape;
            if (shape.empty()) continue;
            T_NORMAL own = NormalOf(i, face.distance, shape);
            flow.SetNormal(own.fixed, std::move(own.byAxial));
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

std::array<double, kBiaxialCorners> BiaxialCorners()
{
    constexpr double kQuarter = std::numbers::pi / 2.0;
    constexpr double kChord = (kQuarter - 2.0 * kAcross) / kChords;
    std::array<double, kBiaxialCorners> corners{};
    static_assert(kBiaxialCorners == 4 * (kChords + 1));
    for (std::size_t i = 0; i < corners.size(); ++i)
        corners[i] = static_cast<double>(i / (kChords + 1)) * kQuarter + kAcross +
                     static_cast<double>(i % (kChords + 1)) * kChord;
    return corners;
}

std::array<double, 2> FaceNormal(std::size_t k, const std::array<double, kBiaxialCorners>& share)
{
    const auto corners = BiaxialCorners();
    const std::size_t a = (k + kBiaxialCorners - 1) % kBiaxialCorners;
    // n . (cos, sin) of a corner = 1 over its distance from the centre.
    const double first = std::cos(kAcross) / share[a], second = std::cos(kAcross) / share[k];
    const double turn = std::sin(corners[k] - corners[a]);
    return {(first * std::sin(corners[k]) - second * std::sin(corners[a])) / turn,
            (second * std::cos(corners[a]) - first * std::cos(corners[k])) / turn};
}

std::vector<T_FACE> BiaxialFaces()
{
    std::array<double, kBiaxialCorners> ellipse;
    ellipse.fill(1.0);
    std::vector<T_FACE> faces;
    for (std::size_t k = 0; k < kBiaxialCorners; ++k) {
        const std::array<double, 2> n = FaceNormal(k, ellipse);
        faces.push_back({std::atan2(n[1], n[0]), 1.0 / std::hypot(n[0], n[1])});
    }
    return faces;
}

T_PUSH_FLOWS MakeFlows(const T_PUSH_MODEL& model, const CPushStructure& structure)
{
    return CFlowMaker(model, structure).Make();
}

} // namespace solver
