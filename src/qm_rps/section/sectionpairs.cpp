#include "qm_rps/section/sectionpairs.h"

#include <algorithm>
#include <set>

namespace {

template <class T>
int KeyOf(const T_TABLE<T>& table, const std::string& nameOrNumber)
{
    for (const auto& [key, record] : table)
        if (record.name == nameOrNumber) return key;
    for (const auto& [key, record] : table)
        if (std::to_string(key) == nameOrNumber) return key;
    return 0;
}

} // namespace

std::vector<T_SECTION_PAIR> SectionPairs(const T_MODEL& model)
{
    std::set<std::pair<int, int>> found;
    std::set<int> known;
    const auto add = [&](int section, int material) {
        if (!model.sections.contains(section) || !model.materials.contains(material)) return;
        found.emplace(section, material);
    };
    for (const auto& [id, element] : model.elements)
        add(element.section, element.material);
    for (const auto& [section, material] : found)
        known.insert(section);
    for (const auto& [key, type] : model.hingeTypes)
        if (!known.contains(type.section)) add(type.section, type.sectionMaterial);
    std::vector<T_SECTION_PAIR> pairs;
    for (const auto& [section, material] : found)
        pairs.push_back({section, material});
    return pairs;
}

int SectionKey(const T_MODEL& model, const std::string& nameOrNumber)
{
    return KeyOf(model.sections, nameOrNumber);
}

int MaterialKey(const T_MODEL& model, const std::string& nameOrNumber)
{
    return KeyOf(model.materials, nameOrNumber);
}
