#include "qm_db/storyload.h"

#include "qm_db/records/recordunits.h"

#include <algorithm>
#include <set>

namespace {

T_NODAL_MASS FreeMass(T_NODE_D node, const T_UNITS& units)
{
    RecordFromSi(node, units);
    T_NODAL_MASS m{node.id, node.mass, node.restraint};
    for (std::size_t d = 0; d < 3; ++d) {
        if (m.restraint[d]) m.mass[d] = 0.0;
    }
    return m;
}

} // namespace

std::vector<T_NODAL_MASS> CStoryLoad::Calc_Nodal_Mass() const
{
    const T_MODEL& model = m_data.Model();
    std::set<int> listed;
    for (const auto& entry : model.storeys)
        listed.insert(entry.second.nodes.begin(), entry.second.nodes.end());

    std::vector<T_NODAL_MASS> out;
    const auto add = [&](const T_NODE_D& node) {
        const auto& m = node.mass;
        if (std::ranges::any_of(m, [](double v) { return v != 0.0; }))
            out.push_back(FreeMass(node, m_data.Units()));
    };
    if (model.storeys.empty()) {
        for (const auto& entry : model.nodes)
            add(entry.second);
    } else {
        for (const int id : listed) {
            if (const auto it = model.nodes.find(id); it != model.nodes.end()) add(it->second);
        }
    }
    return out;
}
