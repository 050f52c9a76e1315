#include "qm_solver/section/stresslaw.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kEndless = std::numeric_limits<double>::infinity();
/// Where panels of 16 points end on the Mander curve, over its peak strain. A steep curve (r large)
/// has poles at an angle of pi / r beside x0 = (r - 1)^(1 / r): panels as wide as that around them,
/// wider further off. Both leave errors below 1e-11.
std::array<double, 6> ManderPanels(double r)
{
    constexpr double kSteep = 2.5;
    if (r < kSteep) return {0.25, 0.5, 1.0, 2.0, 4.0, 8.0};
    const double x0 = std::pow(r - 1.0, 1.0 / r), wide = 0.8 * std::numbers::pi / r;
    std::array<double, 6> panels{-7.0, -3.0, -1.0, 1.0, 3.0, 7.0};
    for (double& at : panels)
        at = x0 * std::exp(at * wide);
    return panels;
}

} // namespace

CStressLaw::CStressLaw(const T_STRESS_LAW& law, bool plastic) : m_law(law)
{
    if (law.kind == STRESS_LAW::Steel)
        MakeSteel(plastic);
    else
        MakeConcrete();
}

void CStressLaw::AddUpTo(double to, LAW_SHAPE shape, std::array<double, 3> c,
                         std::optional<double> root)
{
    T_LAW_PIECE& piece = m_pieces[m_count];
    piece.from = m_count ? m_pieces[m_count - 1].to : -kEndless;
    piece.to = to;
    piece.shape = shape;
    piece.c = c;
    piece.root = root;
    ++m_count;
}

/// The power begins with the first panel.
void CStressLaw::AddMander(double to)
{
    AddUpTo(to, LAW_SHAPE::Mander, {}, m_count == 1 ? std::optional(0.0) : std::nullopt);
}

void CStressLaw::MakeConcrete()
{
    AddUpTo(0.0, LAW_SHAPE::Polynomial); // no tension
    const double f = m_law.strength, peak = m_law.peakStrain;
    const double end = m_law.spalls ? m_law.limitStrain : kEndless;
    switch (m_law.kind) {
    case STRESS_LAW::Block:
        AddUpTo(kEndless, LAW_SHAPE::Polynomial, {f, 0.0, 0.0});
        return;
    case STRESS_LAW::Mander:
        m_power = m_law.modulus / (m_law.modulus - f / peak);
        for (const double to : ManderPanels(m_power))
            if (to * peak < end) AddMander(to * peak);
        AddMander(end);
        break;
    default:
        if (m_law.exponent == 2.0)
            AddUpTo(peak, LAW_SHAPE::Polynomial, {0.0, 2.0 * f / peak, -f / (peak * peak)});
        else
            AddUpTo(peak, LAW_SHAPE::Power, {}, peak);
        if (peak < end) AddUpTo(end, LAW_SHAPE::Polynomial, {f, 0.0, 0.0});
    }
    if (m_law.spalls) AddUpTo(kEndless, LAW_SHAPE::Polynomial);
}

void CStressLaw::MakeSteel(bool plastic)
{
    const double f = m_law.strength, H = plastic ? 0.0 : m_law.hardening;
    const double yield = plastic ? 0.0 : f / m_law.modulus;
    AddUpTo(-yield, LAW_SHAPE::Polynomial, {-f + H * yield, H, 0.0});
    if (!plastic) AddUpTo(yield, LAW_SHAPE::Polynomial, {0.0, m_law.modulus, 0.0});
    AddUpTo(kEndless, LAW_SHAPE::Polynomial, {f - H * yield, H, 0.0});
}

void CStressLaw::SetTopStrain(double strain)
{
    if (m_law.kind != STRESS_LAW::Block) return;
    const double end = strain > 0.0 ? (1.0 - m_law.blockDepth) * strain : kEndless;
    m_pieces[0].to = m_pieces[1].from = end;
}

const T_LAW_PIECE& CStressLaw::PieceAt(double strain) const
{
    std::size_t i = 0;
    while (i + 1 < m_count && strain >= m_pieces[i].to)
        ++i;
    return m_pieces[i];
}

double CStressLaw::Stress(const T_LAW_PIECE& piece, double strain) const
{
    if (piece.shape == LAW_SHAPE::Polynomial)
        return piece.c[0] + strain * (piece.c[1] + strain * piece.c[2]);
    const double x = strain / m_law.peakStrain;
    if (piece.shape == LAW_SHAPE::Power)
        return m_law.strength * (1.0 - std::pow(std::max(0.0, 1.0 - x), m_law.exponent));
    const double r = m_power;
    return m_law.strength * x * r / (r - 1.0 + std::pow(std::max(0.0, x), r));
}

double CStressLaw::Tangent(const T_LAW_PIECE& piece, double strain) const
{
    if (piece.shape == LAW_SHAPE::Polynomial) return piece.c[1] + 2.0 * strain * piece.c[2];
    const double x = strain / m_law.peakStrain, E = m_law.strength / m_law.peakStrain;
    if (piece.shape == LAW_SHAPE::Power)
        return E * m_law.exponent * std::pow(std::max(0.0, 1.0 - x), m_law.exponent - 1.0);
    const double r = m_power, power = std::pow(std::max(0.0, x), r), sum = r - 1.0 + power;
    return E * r * (r - 1.0) * (1.0 - power) / (sum * sum);
}

} // namespace solver
