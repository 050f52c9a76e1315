#include "qm_rps/hinge/femafigure.h"

#include "qm_base/msgfunction.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr double kLossPerEnergy = 0.012; // strength lost per dissipated Fy Dy
constexpr double kLeastStrength = 0.2;

/// Elastic range of a degraded loop in F / Fy: 2 for the full one.
double ElasticRange(double energy, double factor)
{
    const double least = 2.0 * energy;
    return least + 0.5 * (factor + 1.0) * (2.0 - least);
}

/// The response as it grows: its points, what was reached on each side, what was dissipated.
class CResponse {
public:
    explicit CResponse(bool energyBased) : m_energyBased(energyBased) {}

    /// Loads to `sign` times the amplitude.
    void HalfCycle(double sign, double amplitude)
    {
        m_strength =
            m_energyBased ? std::max(kLeastStrength, 1.0 - kLossPerEnergy * m_energy) : 1.0;
        const T_FIGURE_POINT from = m_points.back();
        if (from.y * sign < 0.0) Go(from.x - from.y, 0.0); // initial stiffness 1
        double& reached = m_reached[sign > 0.0 ? 0 : 1];
        const double start = std::max(reached, 1.0); // no less than the yield deformation
        Go(sign * start, sign * Strength(start));
        for (const T_FIGURE_POINT& p : FigureBackbone())
            if (p.x > start && p.x < amplitude) Go(sign * p.x, sign * Strength(p.x));
        if (amplitude > start) Go(sign * amplitude, sign * Strength(amplitude));
        reached = std::max(reached, amplitude);
    }
    std::vector<T_FIGURE_POINT> Take() { return std::move(m_points); }

private:
    double Strength(double deform) const { return m_strength * FigureStrength(deform); }
    void Go(double x, double y)
    {
        const T_FIGURE_POINT& from = m_points.back();
        m_energy += 0.5 * (from.y + y) * (x - from.x);
        m_points.push_back({x, y});
    }

    bool m_energyBased;
    double m_strength = 1.0;
    double m_energy = 0.0; // work done so far, in Fy Dy
    std::array<double, 2> m_reached{};
    std::vector<T_FIGURE_POINT> m_points{{0.0, 0.0}};
};

} // namespace

const std::vector<T_FIGURE_POINT>& FigureBackbone()
{
    static const std::vector<T_FIGURE_POINT> points{{0.0, 0.0, "A"},  {1.0, 1.0, "B"},
                                                    {4.5, 1.15, "C"}, {5.5, 0.5, "D"},
                                                    {8.0, 0.5, "E"},  {8.0, 0.0}};
    return points;
}

double FigureStrength(double deform)
{
    const std::vector<T_FIGURE_POINT>& line = FigureBackbone();
    const double x = std::abs(deform);
    for (std::size_t i = 1; i < line.size(); ++i) {
        const T_FIGURE_POINT &a = line[i - 1], &b = line[i];
        if (x > b.x || b.x == a.x) continue;
        return std::copysign(a.y + (b.y - a.y) * (x - a.x) / (b.x - a.x), deform);
    }
    return 0.0;
}

const std::vector<double>& FigureAmplitudes()
{
    static const std::vector<double> amplitudes{2.0, 2.0, 4.0, 4.0, 6.0, 6.0};
    return amplitudes;
}

std::vector<T_FIGURE_POINT> CyclicResponse(bool energyBased)
{
    CResponse response(energyBased);
    for (const double amplitude : FigureAmplitudes())
        for (const double sign : {1.0, -1.0})
            response.HalfCycle(sign, amplitude);
    return response.Take();
}

std::vector<T_FIGURE_CURVE> StrengthLossCurves(bool energyBased)
{
    T_FIGURE_CURVE backbone{zql::lib::MMSGFunction::GetValue("IDS_QM_UI_FIGURE_BACKBONE"), {}};
    const std::vector<T_FIGURE_POINT>& side = FigureBackbone();
    for (auto p = side.rbegin(); p != side.rend(); ++p)
        backbone.points.push_back({-p->x, -p->y});
    backbone.points.insert(backbone.points.end(), side.begin() + 1, side.end());
    return {backbone,
            {zql::lib::MMSGFunction::GetValue("IDS_QM_UI_FIGURE_RESPONSE"),
             CyclicResponse(energyBased)}};
}

std::vector<T_FIGURE_POINT> BackbonePoints()
{
    std::vector<T_FIGURE_POINT> points = FigureBackbone();
    std::erase_if(points, [](const T_FIGURE_POINT& p) { return p.label.empty(); });
    return points;
}

// Corners of the loop: P (ductility, 1), Q (ductility - range / k, 1 - range), -P, -Q. Half the
// cross product of its diagonals, 2 range (ductility - 1 / k), is energy times the area of the full
// loop, 4 (ductility - 1); that gives k.
double UnloadingStiffness(double ductility, double energy, double factor)
{
    const double range = ElasticRange(energy, factor);
    return 1.0 / (ductility - 2.0 * energy * (ductility - 1.0) / range);
}

std::vector<T_FIGURE_POINT> DegradedLoop(double ductility, double energy, double factor)
{
    const double range = ElasticRange(energy, factor);
    const double x = ductility - range / UnloadingStiffness(ductility, energy, factor);
    const double y = 1.0 - range;
    return {{ductility, 1.0}, {x, y}, {-ductility, -1.0}, {-x, -y}, {ductility, 1.0}};
}
