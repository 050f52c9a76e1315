#include "qm_rps/generate/pushedshear.h"

#include <algorithm>
#include <cmath>

CPushedShears::CPushedShears(const std::vector<T_HINGE_MEMBER>& members)
{
    for (const T_HINGE_MEMBER& member : members) {
        m_sizes[member.element] = 4 * member.bending.size();
        for (std::size_t axis = 0; axis < member.bending.size(); ++axis)
            for (const bool atJ : {false, true}) {
                T_END& end = m_ends.emplace_back();
                end.place = {member.element, atJ, member.bending[axis]};
                end.value = 4 * axis + (atJ ? 2 : 0);
            }
    }
}

void CPushedShears::Begin(const T_PUSH_RUN& run)
{
    for (T_END& end : m_ends) {
        end.V = end.M = 0.0;
        end.flows = false;
        const char* const at = end.place.atJ ? "J" : "I";
        const auto hinge = std::ranges::find_if(run.hinges, [&](const T_PUSH_HINGE_SERIES& h) {
            return h.place.element == end.place.element &&
                   h.place.component == end.place.component && h.place.end == at;
        });
        end.hinge = hinge == run.hinges.end() ? nullptr : &*hinge;
    }
}

void CPushedShears::TakeEnd(const T_STEP_FORCES& step, T_END& end)
{
    constexpr double kNothing = 1e-9; // 1/m: what rounding leaves of the shear of a moment
    if (!end.hinge || end.flows) return;
    const T_END_FORCES forces = EndForces(end.place, step);
    const double V = std::fabs(forces.V), M = std::fabs(forces.M);
    end.flows = end.hinge->state[step.step] != PUSH_STATE::Elastic;
    if (!end.flows && V <= end.V) return;
    end.V = V > kNothing * M ? V : 0.0;
    end.M = M;
}

void CPushedShears::Take(const T_STEP_FORCES& step)
{
    if (step.of != FORCES_OF::Step) return;
    if (step.step == 0) Begin(step.run);
    for (T_END& end : m_ends)
        TakeEnd(step, end);
    if (step.step + 1 < step.run.displacement.size()) return;
    for (T_END& end : m_ends) {
        if (!(end.V > end.largest) || !(end.M > 0.0)) continue;
        end.largest = end.V;
        end.span = end.M / end.V;
    }
}

std::map<int, std::vector<double>> CPushedShears::Values() const
{
    std::map<int, std::vector<double>> out;
    for (const T_END& end : m_ends) {
        if (!(end.largest > 0.0)) continue;
        std::vector<double>& values =
            out.try_emplace(end.place.element, m_sizes.at(end.place.element)).first->second;
        values[end.value] = end.largest;
        values[end.value + 1] = end.span;
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
