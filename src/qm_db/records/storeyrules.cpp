#include "qm_db/records/storeyrules.h"

#include "qm_base/say.h"

#include <optional>

namespace {

std::optional<double> ElevationOf(const T_STOR_D& storey, const T_MODEL& model)
{
    const std::size_t vertical = model.styp.plane == MODEL_PLANE::XY ? 1 : 2;
    double sum = 0.0, count = 0.0;
    for (const int id : storey.nodes) {
        const auto node = model.nodes.find(id);
        if (node == model.nodes.end()) continue;
        sum += node->second.xyz[vertical];
        count += 1.0;
    }
    return count > 0.0 ? std::optional(sum / count) : std::nullopt;
}

} // namespace

std::vector<T_FINDING> StoreyFindings(const T_MODEL& model)
{
    constexpr double kRounding = 1e-6; // of the storey's height
    constexpr const char* kKey = "IDS_QM_STOREY_ORDER";
    std::vector<T_FINDING> out;
    const T_STOR_D* below = nullptr;
    double before = 0.0;
    for (const auto& [key, storey] : model.storeys) {
        const auto elevation = ElevationOf(storey, model);
        if (!elevation) continue;
        if (below && *elevation < before - kRounding * storey.height) {
            T_FINDING& finding = out.emplace_back();
            finding.field = storey.name;
            finding.messageKey = kKey;
            finding.text = Say(kKey, storey.name, below->name);
        }
        below = &storey;
        before = *elevation;
    }
    return out;
}
