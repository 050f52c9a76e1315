#include "qm_solver/section/capacitycurve.h"

#include "qm_solver/section/bracketroot.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kSamePoint = 1e-9; // of axial forces, over their range
constexpr double kAngleTol = 1e-11; // of the moment across the direction, over the moment
constexpr int kSteps = 12;          // of the search for the neutral axis, to a quarter turn
constexpr double kStep = 0.5 * std::numbers::pi / kSteps;

enum EXTREME { Compression, Tension, Largest, Bending, BalancedBar };

struct T_EXTREME {
    T_CAPACITY at;
    std::vector<EXTREME> what;
};

/// From compression to tension; extremes at one axial force are one.
std::vector<T_EXTREME> ExtremesOf(CUltimateStates& states)
{
    std::vector<T_EXTREME> out{{states.At(states.Last()), {Compression}},
                               {states.At(states.First()), {Tension}}};
    const double same = kSamePoint * std::fabs(out[0].at.axial - out[1].at.axial);
    const auto add = [&](const std::optional<T_CAPACITY>& at, EXTREME what) {
        if (!at) return;
        for (T_EXTREME& e : out)
            if (std::fabs(e.at.axial - at->axial) <= same) {
                if (e.what.size() == 1 && what == Largest && e.what[0] == Bending) e.at = *at;
                e.what.push_back(what);
                return;
            }
        out.push_back({*at, {what}});
    };
    add(states.At(states.Peak()), Largest);
    add(states.AtAxial(0.0), Bending);
    add(states.Balanced(), BalancedBar);
    std::ranges::sort(out, std::ranges::greater(), [](const T_EXTREME& e) { return e.at.axial; });
    return out;
}

/// How many of `rest` points go between neighbours, by their distance; all of them are spread.
std::vector<std::size_t> Spread(const std::vector<T_EXTREME>& extremes, std::size_t rest)
{
    const double range = extremes.front().at.axial - extremes.back().at.axial;
    std::vector<std::size_t> out;
    std::size_t given = 0;
    for (std::size_t i = 0; i + 1 < extremes.size(); ++i) {
        const double way = extremes.front().at.axial - extremes[i + 1].at.axial;
        const auto until = static_cast<std::size_t>(std::llround(double(rest) * way / range));
        out.push_back(until - given);
        given = until;
    }
    return out;
}

void Name(const T_EXTREME& extreme, T_AXIAL_CURVE& curve)
{
    const long at = static_cast<long>(curve.points.size());
    for (const EXTREME what : extreme.what) {
        if (what == Largest) curve.largest = at;
        if (what == Bending) curve.bending = at;
        if (what == BalancedBar) curve.balanced = at;
    }
    curve.points.push_back(extreme.at);
}

} // namespace

T_AXIAL_CURVE CurveOf(CUltimateStates& states, std::size_t points)
{
    const std::vector<T_EXTREME> extremes = ExtremesOf(states);
    const std::vector<std::size_t> between = Spread(extremes, points - extremes.size());
    T_AXIAL_CURVE curve;
    for (std::size_t i = 0; i < extremes.size(); ++i) {
        Name(extremes[i], curve);
        if (i + 1 == extremes.size()) break;
        const double from = extremes[i].at.axial, to = extremes[i + 1].at.axial;
        for (std::size_t k = 1; k <= between[i]; ++k) {
            const auto at = states.AtAxial(from + (to - from) * double(k) / double(between[i] + 1));
            if (!at) return {};
            curve.points.push_back(*at);
        }
    }
    return curve;
}

std::optional<T_CAPACITY> TowardsMoment(CUltimateStates& states, double direction, double axial,
                                        T_SECTION_ERROR& error)
{
    const double c = std::cos(direction), s = std::sin(direction);
    const auto along = [&](const T_CAPACITY& at) { return at.My * c + at.Mz * s; };
    const auto across = [&](const T_CAPACITY& at) { return at.Mz * c - at.My * s; };
    double largest = 0.0;
    bool carried = false;
    const auto at = [&](double bending) -> std::optional<T_CAPACITY> {
        states.Turn(bending);
        const auto found = states.AtAxial(axial);
        if (found) largest = std::max(largest, std::hypot(found->My, found->Mz));
        carried = carried || found;
        return found;
    };
    const auto miss = [&](double bending) {
        const auto found = at(bending);
        return found ? across(*found) : std::numeric_limits<double>::quiet_NaN();
    };
    // The moment turns with the neutral axis, at most a quarter ahead or behind.
    double lo = direction, hi = direction, fLo = miss(direction), fHi = fLo;
    for (int i = 1; i <= kSteps && !(fLo <= 0.0); ++i)
        hi = lo, fHi = fLo, lo = direction - i * kStep, fLo = miss(lo);
    for (int i = 1; i <= kSteps && fLo <= 0.0 && !(fHi > 0.0); ++i)
        lo = hi, fLo = fHi, hi = direction + i * kStep, fHi = miss(hi);
    if (!carried) {
        const CUltimateStates::T_RANGE range = states.AxialRange();
        error.fault = SECTION_FAULT::AxialBeyond;
        error.axialMin = range.low, error.axialMax = range.high;
        return std::nullopt;
    }
    error.fault = SECTION_FAULT::NoSuchMoment;
    if (!(fLo <= 0.0) || !(fHi > 0.0)) return std::nullopt;
    const T_BRACKET root = BracketRoot(miss, lo, fLo, hi, fHi, kAngleTol * largest);
    auto found = at(root.x);
    if (!found) return std::nullopt;
    if (std::fabs(root.f) > kAngleTol * largest) { // the moment jumps while the axis turns
        const auto other = at(root.other);
        if (!other) return std::nullopt;
        const double part = root.f / (root.f - root.fOther);
        found->My += part * (other->My - found->My);
        found->Mz += part * (other->Mz - found->Mz);
    }
    if (!(along(*found) > 0.0)) return std::nullopt;
    error = {};
    return found;
}

} // namespace solver
