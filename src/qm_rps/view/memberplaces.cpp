#include "qm_rps/view/memberplaces.h"

#include <algorithm>
#include <cmath>

namespace {

/// 1 rises, -1 falls, 0 stays from a station to the next.
int Way(const T_STATION& from, const T_STATION& to)
{
    const double rise = to.before - from.behind;
    if (std::fabs(rise) <= to.rounding) return 0;
    return rise > 0.0 ? 1 : -1;
}

} // namespace

std::vector<T_STATION> StationsAlong(const CMemberLine& member, std::size_t c)
{
    constexpr double kRounding = 1e-9; // of the largest value
    std::vector<T_STATION> out;
    double largest = 0.0;
    for (const double x : member.Stations(c, 1)) {
        out.push_back({x, member.Force(c, x), member.Force(c, x, true)});
        largest = std::max({largest, std::fabs(out.back().before), std::fabs(out.back().behind)});
    }
    for (T_STATION& at : out) {
        at.rounding = kRounding * largest;
        at.leaps = at.x < member.Length() && std::fabs(at.behind - at.before) > at.rounding;
    }
    return out;
}

std::map<double, bool> PlacesBetween(const CMemberLine& member)
{
    constexpr double kAtPosition = 1e-5; // of a quarter
    std::map<double, bool> out;
    for (std::size_t c = 0; c < 6; ++c) {
        const std::vector<T_STATION> along = StationsAlong(member, c);
        for (std::size_t i = 0; i < along.size(); ++i) {
            if (along[i].leaps) out[along[i].x] = true;
            const double quarters = 4.0 * along[i].x / member.Length();
            if (c < 4 || i == 0 || i + 1 == along.size() ||
                std::fabs(quarters - std::round(quarters)) <= kAtPosition)
                continue;
            if (Way(along[i - 1], along[i]) == Way(along[i], along[i + 1])) continue;
            const double reach = kAtPosition * member.Length();
            const auto near = out.lower_bound(along[i].x - reach); // My and Mz may turn together
            if (near == out.end() || near->first > along[i].x + reach) out[along[i].x] = false;
        }
    }
    return out;
}
