#include "qm_solver/section/sectionbalance.h"

#include "qm_solver/section/bracketroot.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr double kTol = 1e-11; // of the balance, over the scale of the forces
constexpr int kNewtonSteps = 40;
constexpr int kLineHalvings = 12;
constexpr double kAcross = 1e-3; // first step across, over the curvature along

} // namespace

CSectionBalance::CSectionBalance(const T_SECTION_SHAPE& shape, const T_CURVATURE_REQUEST& request)
    : m_view(shape, request.direction), m_request(request), m_depth(m_view.Top() - m_view.Bottom())
{
}

CSectionBalance::T_BALANCE CSectionBalance::Balance(const T_BENDING& at)
{
    const double kappa = std::hypot(at.along, at.across);
    const double turn = kappa > 0.0 ? std::atan2(at.across, at.along) : 0.0;
    if (m_request.direction + turn != m_view.Direction()) m_view.Turn(m_request.direction + turn);
    const T_SUMS sums = m_view.SumsAndTangent(at.axial, kappa);
    // t runs against the direction a quarter turn on.
    const double c = std::cos(turn), s = std::sin(turn);
    const auto& [k, ks, kt, kss, kst, ktt] = sums.tangent;
    T_BALANCE out;
    out.force = sums.force;
    out.along = c * sums.overS + s * sums.overT;
    out.across = s * sums.overS - c * sums.overT;
    out.byAxial = k;
    out.mixed = s * ks - c * kt;
    out.byAcross = s * s * kss - 2.0 * s * c * kst + c * c * ktt;
    return out;
}

double CSectionBalance::Miss(const T_BALANCE& b, bool turning) const
{
    const double across = turning ? std::fabs(b.across) / m_depth : 0.0;
    return (std::fabs(b.force - m_request.axial) + across) / m_force;
}

/// Of axial strain and, where the axis turns, the curvature across.
std::optional<T_BENT_STATE> CSectionBalance::Newton(T_BENDING at, bool turning)
{
    T_BALANCE b = Balance(at);
    for (int i = 0; i < kNewtonSteps && Miss(b, turning) > kTol; ++i) {
        const double r = m_request.axial - b.force, q = -b.across;
        const double det = b.byAxial * b.byAcross - b.mixed * b.mixed;
        double axial = r / b.byAxial, across = 0.0;
        if (turning) {
            axial = (r * b.byAcross - q * b.mixed) / det;
            across = (q * b.byAxial - r * b.mixed) / det;
        }
        if (!std::isfinite(axial) || !std::isfinite(across)) return std::nullopt;
        double part = 1.0;
        T_BENDING next;
        T_BALANCE nextBalance;
        for (int k = 0; k < kLineHalvings; ++k, part *= 0.5) {
            next = {at.axial + part * axial, at.along, at.across + part * across};
            nextBalance = Balance(next);
            if (Miss(nextBalance, turning) < Miss(b, turning)) break;
        }
        if (!(Miss(nextBalance, turning) < Miss(b, turning))) return std::nullopt;
        at = next, b = nextBalance;
    }
    if (!(Miss(b, turning) <= kTol)) return std::nullopt;
    return StateOf(at);
}

/// The axial strain nearest to the guess, for a fixed neutral axis.
std::optional<T_BENT_STATE> CSectionBalance::Bracketed(T_BENDING at)
{
    const double guess = at.axial;
    const auto miss = [&](double axial) {
        at.axial = axial;
        return Balance(at).force - m_request.axial;
    };
    const double reach = 1e-3 * (std::fabs(guess) + at.along * m_depth);
    const double mid = miss(guess);
    double low = guess, high = guess, fLow = mid, fHigh = mid;
    for (double step = reach; step < 1e4 * reach && (fLow > 0.0) == (fHigh > 0.0); step *= 1.3) {
        const double down = miss(guess - step), up = miss(guess + step);
        if ((up > 0.0) != (fHigh > 0.0))
            low = high, fLow = fHigh, high = guess + step, fHigh = up;
        else if ((down > 0.0) != (fLow > 0.0))
            high = low, fHigh = fLow, low = guess - step, fLow = down;
        else
            low = guess - step, fLow = down, high = guess + step, fHigh = up;
    }
    if ((fLow > 0.0) == (fHigh > 0.0)) return std::nullopt;
    const T_BRACKET root = BracketRoot(miss, low, fLow, high, fHigh, kTol * m_force);
    if (!(std::fabs(root.f) <= kTol * m_force)) return std::nullopt;
    at.axial = root.x;
    return StateOf(at);
}

std::optional<T_BENT_STATE> CSectionBalance::AtAxis(const T_BENDING& guess)
{
    const auto found = Newton(guess, false);
    return found ? found : Bracketed(guess);
}

/// The curvature across nearest to the guess by its bracket: where concrete spalls, the tangent
/// does not know how fast it goes.
std::optional<T_BENT_STATE> CSectionBalance::Turned(T_BENDING at)
{
    const double guess = at.across, c = std::cos(m_request.direction),
                 s = std::sin(m_request.direction);
    const auto miss = [&](double across) {
        at.across = across;
        const auto state = AtAxis(at);
        if (!state) return std::numeric_limits<double>::quiet_NaN();
        at.axial = state->at.axial;
        return (c * state->point.Mz - s * state->point.My) / m_depth;
    };
    double low = guess, high = guess, fLow = miss(guess), fHigh = fLow;
    // The moment across rises with the curvature across.
    for (double step = kAcross * at.along; step < at.along; step *= 2.0) {
        if (fLow > 0.0) high = low, fHigh = fLow, low = guess - step, fLow = miss(low);
        if (fHigh <= 0.0) low = high, fLow = fHigh, high = guess + step, fHigh = miss(high);
    }
    if (!(fLow <= 0.0) || !(fHigh > 0.0)) return std::nullopt;
    const T_BRACKET root = BracketRoot(miss, low, fLow, high, fHigh, kTol * m_force);
    if (!(std::fabs(root.f) <= kTol * m_force)) return std::nullopt;
    at.across = root.x;
    return AtAxis(at);
}

std::optional<T_BENT_STATE> CSectionBalance::Near(const T_BENDING& guess)
{
    if (!m_request.ofMoment) return AtAxis(guess);
    const auto found = Newton(guess, true);
    return found ? found : Turned(guess);
}

std::optional<T_BENT_STATE> CSectionBalance::Reach(const T_BENT_STATE& from, double curvature,
                                                   int halvings)
{
    const auto found = Near({from.at.axial, curvature, from.at.across});
    if (found || halvings == 0) return found;
    const auto mid = Reach(from, 0.5 * (from.at.along + curvature), halvings - 1);
    return mid ? Reach(*mid, curvature, halvings - 1) : std::nullopt;
}

T_REACHED CSectionBalance::Reached(const std::vector<T_MARK>& marks, double e0, double kappa) const
{
    T_REACHED out;
    for (const T_MARK& mark : marks) {
        const double part = (e0 + kappa * mark.s) / mark.strain;
        if (part > out.part) out = {part, mark.fibre};
    }
    return out;
}

T_BENT_STATE CSectionBalance::StateOf(const T_BENDING& at)
{
    const T_BALANCE b = Balance(at);
    const double kappa = std::hypot(at.along, at.across);
    const double c = std::cos(m_request.direction), s = std::sin(m_request.direction);
    T_BENT_STATE out;
    out.at = at;
    out.point = {at.along, b.along, c * b.along - s * b.across, s * b.along + c * b.across,
                 m_view.Plane(at.axial, kappa)};
    out.limit = Reached(m_view.Limits(), at.axial, kappa);
    out.yield = Reached(m_view.Yields(), at.axial, kappa);
    return out;
}

} // namespace solver
