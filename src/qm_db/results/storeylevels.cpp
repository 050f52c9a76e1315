#include "qm_db/results/storeylevels.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kSamePlan = 0.01; // of the height

double PlanDistance(const T_LEVEL_NODE& a, const T_LEVEL_NODE& b)
{
    return std::hypot(a.plan[0] - b.plan[0], a.plan[1] - b.plan[1]);
}

double Mean(const T_LEVEL* level, std::size_t step, bool byMass)
{
    if (!level) return 0.0;
    double sum = 0.0, weight = 0.0, plain = 0.0;
    for (const T_LEVEL_NODE& node : level->nodes) {
        sum += node.mass * (*node.moves)[step];
        weight += node.mass;
        plain += (*node.moves)[step];
    }
    return byMass && weight > 0.0 ? sum / weight : plain / static_cast<double>(level->nodes.size());
}

} // namespace

void PairWithBelow(T_LEVEL& level, const T_LEVEL& below)
{
    const double tolerance = kSamePlan * level.height;
    std::vector<std::size_t> byX(below.nodes.size());
    for (std::size_t i = 0; i < byX.size(); ++i)
        byX[i] = i;
    const auto x = [&](std::size_t i) { return below.nodes[i].plan[0]; };
    std::ranges::sort(byX, {}, x);
    for (T_LEVEL_NODE& node : level.nodes) {
        double nearest = tolerance;
        for (auto it = std::ranges::lower_bound(byX, node.plan[0] - tolerance, {}, x);
             it != byX.end() && x(*it) <= node.plan[0] + tolerance; ++it) {
            const double distance = PlanDistance(node, below.nodes[*it]);
            if (distance > nearest) continue;
            nearest = distance;
            node.below = *it;
        }
    }
}

T_STOREY_DRIFT DriftOf(const T_LEVEL& level, const T_LEVEL* below, std::size_t step)
{
    const double mean = Mean(below, step, false);
    double largest = 0.0;
    for (const T_LEVEL_NODE& node : level.nodes) {
        const double foot = node.below ? (*below->nodes[*node.below].moves)[step] : mean;
        const double drift = ((*node.moves)[step] - foot) / level.height;
        if (std::fabs(drift) > std::fabs(largest)) largest = drift;
    }
    const double centre = (Mean(&level, step, true) - Mean(below, step, true)) / level.height;
    return {level.storey, largest, centre};
}
