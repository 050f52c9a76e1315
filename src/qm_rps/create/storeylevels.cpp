#include "qm_rps/create/storeylevels.h"

#include "qm_rps/create/createfault.h"

#include <algorithm>
#include <numeric>

namespace {

bool IsHeldSideways(const T_NODE_D& node, bool isXY)
{
    return node.restraint[0] != 0 && (isXY || node.restraint[1] != 0);
}

} // namespace

std::vector<T_LEVEL_OF_NODES> LevelsOf(const T_MODEL& model, double tolerance)
{
    const bool isXY = model.styp.plane == MODEL_PLANE::XY;
    const std::size_t up = isXY ? 1 : 2;
    std::vector<std::pair<double, int>> byHeight;
    for (const auto& [id, node] : model.nodes)
        byHeight.emplace_back(node.xyz[up], id);
    std::ranges::sort(byHeight);
    std::vector<T_LEVEL_OF_NODES> levels;
    for (const auto& [height, id] : byHeight) {
        if (levels.empty() || height - levels.back().lowest > tolerance) {
            levels.emplace_back();
            levels.back().lowest = height;
        }
        T_LEVEL_OF_NODES& level = levels.back();
        level.highest = height;
        level.elevation += height;
        level.nodes.push_back(id);
    }
    for (T_LEVEL_OF_NODES& level : levels) {
        level.elevation /= static_cast<double>(level.nodes.size());
        std::ranges::sort(level.nodes);
        level.isGround = &level == &levels.front() || std::ranges::all_of(level.nodes, [&](int id) {
            return IsHeldSideways(model.nodes.at(id), isXY);
        });
    }
    return levels;
}

int StoreysFromLevels(const std::vector<T_LEVEL_OF_NODES>& levels, const std::vector<bool>& taken,
                      const std::vector<std::string>& names, std::vector<T_STOR_D>& out,
                      T_FINDING& fault)
{
    std::vector<T_STOR_D> storeys;
    double below = levels.empty() ? 0.0 : levels.front().elevation;
    for (std::size_t i = 0; i < levels.size(); ++i) {
        const T_LEVEL_OF_NODES& level = levels[i];
        const bool isTaken = i >= taken.size() || taken[i];
        if (level.isGround && i > 0 && storeys.empty()) below = level.elevation;
        if (level.isGround || !isTaken) continue;
        const std::size_t n = storeys.size();
        T_STOR_D& storey = storeys.emplace_back();
        storey.name =
            n < names.size() && !names[n].empty() ? names[n] : std::to_string(n + 1) + "F";
        storey.height = level.elevation - below;
        storey.nodes = level.nodes;
        below = level.elevation;
        for (std::size_t k = 0; k < n; ++k)
            if (storeys[k].name == storey.name)
                return CreateFault(fault, "names", "IDS_QM_NEW_STOREY_TWICE", storey.name);
    }
    if (storeys.empty()) return CreateFault(fault, "tolerance", "IDS_QM_NEW_NO_LEVELS");
    out = std::move(storeys);
    return 1;
}
