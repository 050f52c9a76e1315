#include "qm_rps/generate/pushedshear.h"

#include <algorithm>
#include <cmath>

namespace {

/// Moments of one end over the steps; null: it has no hinge about this axis.
const T_PUSH_HINGE_SERIES* SeriesOf(const T_PUSH_RUN& run, int element, HINGE_COMPONENT component,
                                    const char* end)
{
    const auto found = std::ranges::find_if(run.hinges, [&](const T_PUSH_HINGE_SERIES& h) {
        return h.place.element == element && h.place.component == component && h.place.end == end;
    });
    return found == run.hinges.end() ? nullptr : &*found;
}

double MomentAt(const T_PUSH_HINGE_SERIES* series, std::size_t step)
{
    return series ? series->force[step] : 0.0; // an end without a hinge is released
}

/// V and M / V of an end; V 0: there is none.
std::array<double, 2> OfEnd(const T_PUSH_HINGE_SERIES* own, const T_PUSH_HINGE_SERIES* other,
                            double clear)
{
    if (!own || own->force.empty()) return {};
    const auto shear = [&](std::size_t step) {
        return std::fabs(MomentAt(own, step) - MomentAt(other, step)) / clear;
    };
    std::size_t at = 0;
    for (std::size_t i = 0; i < own->force.size(); ++i) {
        if (own->state[i] != PUSH_STATE::Elastic) {
            at = i;
            break;
        }
        if (shear(i) > shear(at)) at = i;
    }
    const double v = shear(at);
    constexpr double kNothing = 1e-9; // of the moment over the length
    const double moment = std::fabs(MomentAt(own, at));
    if (!(v > kNothing * moment / clear) || !(moment > 0.0)) return {};
    return {v, moment / v};
}

} // namespace

std::map<int, std::vector<double>> PushedShears(const std::vector<T_PUSH_RUN>& runs,
                                                const std::vector<T_HINGE_MEMBER>& members)
{
    std::map<int, std::vector<double>> out;
    for (const T_HINGE_MEMBER& member : members) {
        std::vector<double> values(4 * member.bending.size());
        for (const T_PUSH_RUN& run : runs)
            for (std::size_t axis = 0; axis < member.bending.size(); ++axis) {
                const auto* i = SeriesOf(run, member.element, member.bending[axis], "I");
                const auto* j = SeriesOf(run, member.element, member.bending[axis], "J");
                for (const bool atI : {true, false}) {
                    const auto [v, span] = OfEnd(atI ? i : j, atI ? j : i, member.clear);
                    double* const place = &values[4 * axis + (atI ? 0 : 2)];
                    if (!(v > place[0])) continue;
                    place[0] = v;
                    // The loads along a beam are not in its end moments: with them M / V is less.
                    place[1] =
                        member.kind == MEMBER_KIND::Beam ? std::min(span, member.clear / 2) : span;
                }
            }
        if (std::ranges::any_of(values, [](double v) { return v > 0.0; }))
            out.emplace(member.element, std::move(values));
    }
    return out;
}

T_SHEAR_CHANGE LargestChange(const std::map<int, std::vector<double>>& before,
                             const std::map<int, std::vector<double>>& now)
{
    T_SHEAR_CHANGE largest;
    for (const auto& [element, values] : now) {
        const auto old = before.find(element);
        for (std::size_t i = 0; i < values.size(); i += 2) { // V of each end and axis
            if (!(values[i] > 0.0)) continue;
            const double was = old == before.end() ? 0.0 : old->second[i];
            const double change = std::fabs(values[i] - was) / values[i];
            if (change <= largest.change) continue;
            largest = {element, change, was, values[i]};
        }
    }
    return largest;
}
