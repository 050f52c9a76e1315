#include "qm_rps/push/pushstoreys.h"

#include "qm_rps/push/loadalgebra.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kSameLevel = 0.01; // of the storey height

double PlanDistance(const T_LEVEL_NODE& a, const T_LEVEL_NODE& b)
{
    return std::hypot(a.plan[0] - b.plan[0], a.plan[1] - b.plan[1]);
}

T_LEVEL LevelOf(const T_PUSH_STOREY& storey, const solver::T_FRAME& frame, std::size_t vertical)
{
    T_LEVEL level;
    level.height = storey.height;
    for (const std::size_t node : storey.nodes) {
        T_LEVEL_NODE& at = level.nodes.emplace_back();
        at.plan[0] = frame.nodes[node].xyz[0];
        at.plan[1] = vertical == 2 ? frame.nodes[node].xyz[1] : 0.0;
    }
    return level;
}

void PairWithNearest(T_LEVEL& level, const T_LEVEL& below)
{
    for (T_LEVEL_NODE& node : level.nodes) {
        const auto nearest = std::ranges::min_element(
            below.nodes, {}, [&](const T_LEVEL_NODE& b) { return PlanDistance(node, b); });
        node.below = static_cast<std::size_t>(nearest - below.nodes.begin());
    }
}

/// Weights by mass; 0 all over: all alike.
std::vector<double> WeightsOf(const std::vector<std::size_t>& nodes,
                              const std::vector<solver::T_VEC3>& masses, std::size_t direction)
{
    std::vector<double> weights;
    double sum = 0.0;
    for (const std::size_t node : nodes) {
        weights.push_back(direction < 3 ? masses[node][direction] : 0.0);
        sum += weights.back();
    }
    for (double& w : weights)
        w = sum > 0.0 ? w / sum : 1.0 / static_cast<double>(nodes.size());
    return weights;
}

} // namespace

std::size_t VerticalAxis(const T_MODEL& model)
{
    return model.styp.plane == MODEL_PLANE::XY ? 1 : 2;
}

std::vector<T_PUSH_STOREY> StoreysOf(const T_MODEL& model, const CAnalysisModel& frame,
                                     std::size_t direction)
{
    const std::vector<int>& ids = frame.NodeIds();
    const std::size_t vertical = VerticalAxis(model);
    const std::vector<solver::T_VEC3> masses = NodeMasses(frame.Frame());
    std::vector<T_PUSH_STOREY> out;
    double height = 0.0;
    for (const auto& [key, record] : model.storeys) {
        height += record.height;
        T_PUSH_STOREY storey{record.name, 0.0, height, {}, {}};
        for (const int id : record.nodes) {
            const auto at = std::ranges::lower_bound(ids, id);
            if (at == ids.end() || *at != id) continue;
            storey.nodes.push_back(static_cast<std::size_t>(at - ids.begin()));
            storey.elevation += frame.Frame().nodes[storey.nodes.back()].xyz[vertical];
        }
        if (storey.nodes.empty() || !(height > 0.0)) continue;
        storey.elevation /= static_cast<double>(storey.nodes.size());
        storey.weights = WeightsOf(storey.nodes, masses, direction);
        out.push_back(std::move(storey));
        height = 0.0;
    }
    return out;
}

std::vector<solver::T_PUSH_DRIFT> DriftsOf(const T_MODEL& model, const CAnalysisModel& frame,
                                           const std::vector<T_PUSH_STOREY>& storeys)
{
    std::vector<solver::T_PUSH_DRIFT> out;
    T_LEVEL below;
    for (std::size_t k = 0; k < storeys.size(); ++k) {
        T_LEVEL level = LevelOf(storeys[k], frame.Frame(), VerticalAxis(model));
        if (k > 0) {
            PairWithBelow(level, below);
            if (std::ranges::none_of(level.nodes,
                                     [](const auto& n) { return n.below.has_value(); }))
                PairWithNearest(level, below);
        }
        for (std::size_t i = 0; i < level.nodes.size(); ++i) {
            solver::T_PUSH_DRIFT drift{storeys[k].nodes[i], solver::T_PUSH_DRIFT::kGround,
                                       storeys[k].height};
            if (k > 0 && !level.nodes[i].below) continue;
            if (k > 0) drift.below = storeys[k - 1].nodes[*level.nodes[i].below];
            out.push_back(drift);
        }
        below = std::move(level);
    }
    return out;
}

double DisplacementOf(const T_PUSH_STOREY& storey, const std::vector<solver::T_VEC6>& nodes,
                      const solver::T_VEC3& direction)
{
    double sum = 0.0;
    for (std::size_t i = 0; i < storey.nodes.size(); ++i)
        for (std::size_t d = 0; d < 3; ++d)
            sum += storey.weights[i] * direction[d] * nodes[storey.nodes[i]][d];
    return sum;
}

double ShearOf(const T_PUSH_STOREY& storey, const std::vector<solver::T_VEC3>& forces,
               const solver::T_FRAME& frame, std::size_t vertical, const solver::T_VEC3& direction)
{
    const double level = storey.elevation - kSameLevel * storey.height;
    double sum = 0.0;
    for (std::size_t i = 0; i < forces.size(); ++i) {
        if (frame.nodes[i].xyz[vertical] < level) continue;
        for (std::size_t d = 0; d < 3; ++d)
            sum += direction[d] * forces[i][d];
    }
    return sum;
}
