#include "qm_rps/view/parts.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

constexpr double kSame = 1e-6; // m: coordinates of one plane

using T_ELEMENTS = CSelection::T_KEYS;

std::vector<T_MODEL_PART> BySection(const T_MODEL& model)
{
    std::map<int, T_ELEMENTS> found;
    for (const auto& [id, e] : model.elements)
        if (model.sections.contains(e.section)) found[e.section].insert(id);
    std::vector<T_MODEL_PART> out;
    for (auto& [key, elements] : found)
        out.push_back({PART_KIND::Section, model.sections.at(key).name, std::move(elements)});
    return out;
}

/// Height of both ends; a spring has one.
std::pair<double, double> Heights(const T_MODEL& model, const T_ELEM_D& e)
{
    const double i = model.nodes.at(e.nodeI).xyz[2];
    const auto j = model.nodes.find(e.nodeJ);
    return std::minmax(i, j == model.nodes.end() ? i : j->second.xyz[2]);
}

std::vector<T_MODEL_PART> ByStorey(const T_MODEL& model)
{
    double low = std::numeric_limits<double>::infinity();
    for (const auto& entry : model.nodes)
        low = std::min(low, entry.second.xyz[2]);
    std::vector<T_MODEL_PART> out;
    for (const auto& entry : model.storeys) {
        const double high = low + entry.second.height;
        T_MODEL_PART part{PART_KIND::Storey, entry.second.name, {}};
        for (const auto& [id, e] : model.elements) {
            const auto [bottom, top] = Heights(model, e);
            if (bottom >= low - kSame && top <= high + kSame && top > low + kSame)
                part.elements.insert(id);
        }
        if (!part.elements.empty()) out.push_back(std::move(part));
        low = high;
    }
    return out;
}

std::vector<T_MODEL_PART> ByPlane(CDBDoc& doc, std::size_t axis, std::size_t least,
                                  std::size_t most)
{
    const T_MODEL& model = doc.Data().Model();
    std::map<long long, T_ELEMENTS> found; // by the coordinate in steps of kSame
    for (const auto& [id, e] : model.elements) {
        const auto j = model.nodes.find(e.nodeJ);
        if (j == model.nodes.end()) continue;
        const double at = model.nodes.at(e.nodeI).xyz[axis];
        if (std::fabs(at - j->second.xyz[axis]) <= kSame)
            found[std::llround(at / kSame)].insert(id);
    }
    std::vector<std::size_t> sizes;
    for (const auto& entry : found)
        sizes.push_back(entry.second.size());
    std::ranges::sort(sizes, std::greater{});
    if (sizes.size() > most) least = std::max(least, sizes[most - 1]);
    std::vector<T_MODEL_PART> out;
    for (auto& [steps, elements] : found) {
        if (elements.size() < least || out.size() == most) continue;
        const double at = doc.Unit().ConvertUnitLengthOut(kSame * static_cast<double>(steps));
        out.push_back({PART_KIND::Plane,
                       FormatText("%c = %.6g ", "XYZ"[axis], at) +
                           std::string(NameOf(doc.Unit().Units().length)),
                       std::move(elements)});
    }
    return out;
}

} // namespace

std::vector<T_MODEL_PART> PartsOf(CDBDoc& doc, std::size_t least, std::size_t most)
{
    const T_MODEL& model = doc.Data().Model();
    std::vector<T_MODEL_PART> out = BySection(model);
    const auto add = [&](std::vector<T_MODEL_PART> parts) {
        std::ranges::move(parts, std::back_inserter(out));
    };
    add(ByStorey(model));
    for (std::size_t axis = 0; axis < 3; ++axis)
        add(ByPlane(doc, axis, least, most));
    return out;
}
