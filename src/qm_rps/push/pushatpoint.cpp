#include "qm_rps/push/pushatpoint.h"

#include <algorithm>
#include <cmath>
#include <tuple>

namespace {

constexpr double kSame = 1e-9; // of the largest displacement of the run, of a ratio

constexpr std::size_t kCp = 2; // of the marks IO, LS, CP

/// Deformation that the ratio of a component counts in, a magnitude; empty: there is none.
std::optional<double> LimitOf(const T_PUSH_HINGE_SERIES& hinge, double deformation)
{
    const bool negative = deformation < 0.0;
    const solver::T_HINGE_SIDE& side = negative ? hinge.law.negative : hinge.law.positive;
    const T_PUSH_LAW_PLACE& place = hinge.place;
    std::optional<double> limit;
    if (place.criteria) {
        if (side.marks.size() > kCp) limit = side.marks[kCp];
    } else {
        const std::size_t c = (negative ? place.letters.neg : place.letters.pos).find('C');
        if (c < side.points.size()) limit = side.points[c].deformation;
    }
    return limit && *limit > 0.0 ? limit : std::nullopt;
}

/// Beyond C a component has lost strength, although CP of a secondary member may lie further.
bool HasLost(PUSH_STATE state)
{
    return state >= PUSH_STATE::CtoD;
}

/// By place: what stands first where nothing else tells two components apart.
bool StandsBefore(const T_HINGE_AT_POINT& a, const T_HINGE_AT_POINT& b)
{
    const auto place = [](const T_HINGE_AT_POINT& h) {
        return std::tuple(h.place.element, h.place.hinge, h.place.component);
    };
    return place(a) < place(b);
}

/// Ratios that differ by rounding alone are one: the units of the file must not order them.
bool IsAsBad(const T_HINGE_AT_POINT& a, const T_HINGE_AT_POINT& b)
{
    if (HasLost(a.state) != HasLost(b.state) || a.ratio.has_value() != b.ratio.has_value())
        return false;
    return a.ratio ? std::fabs(*a.ratio - *b.ratio) <= kSame * *a.ratio : a.state == b.state;
}

/// Those that have lost strength, then larger ratios, then those without one by their state.
bool IsWorse(const T_HINGE_AT_POINT& a, const T_HINGE_AT_POINT& b)
{
    if (HasLost(a.state) != HasLost(b.state)) return HasLost(a.state);
    if (a.ratio.has_value() != b.ratio.has_value()) return a.ratio.has_value();
    if (a.ratio && *a.ratio != *b.ratio) return *a.ratio > *b.ratio;
    return a.state > b.state;
}

void TakeStep(const T_PUSH_RUN& run, std::size_t step, T_PUSH_AT_POINT& to)
{
    to.found = AT_POINT::Reached;
    to.step = static_cast<int>(step) + 1;
    to.loadFactor = run.loadFactor[step];
    for (const T_PUSH_HINGE_SERIES& hinge : run.hinges) {
        const PUSH_STATE state = hinge.state[step];
        ++to.states[static_cast<std::size_t>(state)];
        if (state == PUSH_STATE::Elastic) continue;
        T_HINGE_AT_POINT at{hinge.place, hinge.deformation[step], hinge.force[step], state, {}};
        if (const auto limit = LimitOf(hinge, at.deformation))
            at.ratio = std::fabs(at.deformation) / *limit;
        to.worst.push_back(std::move(at));
    }
    std::ranges::stable_sort(to.worst, IsWorse);
    for (auto from = to.worst.begin(); from != to.worst.end();) {
        const auto other = std::find_if_not(
            from, to.worst.end(), [&](const T_HINGE_AT_POINT& h) { return IsAsBad(*from, h); });
        std::stable_sort(from, other, StandsBefore);
        from = other;
    }
    if (to.worst.size() > kMostWorst) to.worst.resize(kMostWorst);
    for (const T_PUSH_STOREY_SERIES& storey : run.storeys) {
        T_STOREY_AT_POINT at{storey.name, storey.displacement[step], storey.drift[step], {}};
        if (!storey.shear.empty()) at.shear = storey.shear[step];
        to.storeys.push_back(std::move(at));
    }
}

} // namespace

const char* RatioOf(const T_PUSH_LAW_PLACE& place)
{
    return place.criteria ? "CP" : "C";
}

std::vector<T_PUSH_AT_POINT> PushAtPoints(const T_PUSH_RUN& run,
                                          const std::vector<T_PUSH_POINT>& points)
{
    double furthest = 0.0;
    for (const double d : run.displacement)
        furthest = std::max(furthest, std::fabs(d));
    std::vector<T_PUSH_AT_POINT> out;
    for (const T_PUSH_POINT& point : points) {
        T_PUSH_AT_POINT& at = out.emplace_back();
        at.point = point;
        const auto step = std::ranges::find_if(run.displacement, [&](double d) {
            return std::fabs(d - point.displacement) <= kSame * furthest;
        });
        if (step != run.displacement.end())
            TakeStep(run, static_cast<std::size_t>(step - run.displacement.begin()), at);
        else if (std::fabs(point.displacement) <= furthest)
            at.found = AT_POINT::NoStep;
    }
    return out;
}
