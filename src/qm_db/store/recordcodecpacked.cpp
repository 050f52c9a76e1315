#include "qm_db/store/recordcodecpacked.h"

#include "qm_db/file/storefault.h"

#include <algorithm>
#include <cstring>

namespace {

constexpr std::size_t kChunkNodes = 512; // nodes that are packed together

// Generated hinges are many and small: a few packed lists for all of them.
constexpr const char* kHinges = "hinges";
constexpr std::size_t kHingeWidth = 3; // key, element, type
constexpr std::size_t kStrengthWidth = sizeof(T_PHGE_D::crack) / sizeof(double); // crack; yield

/// Takes the n-th group of as many packed numbers as `to` has.
template <class T, std::size_t N>
void TakeGroup(std::span<const std::byte> from, std::size_t n, std::array<T, N>& to)
{
    std::memcpy(to.data(), from.data() + n * sizeof to, sizeof to);
}

} // namespace

void PutNodes(const T_TABLE<T_NODE_D>& nodes, CPackedArrays& arrays)
{
    auto node = nodes.begin();
    for (std::int64_t chunk = 0; node != nodes.end(); ++chunk) {
        std::vector<int> ids, restraint;
        std::vector<double> xyz, mass;
        for (; node != nodes.end() && ids.size() < kChunkNodes; ++node) {
            const T_NODE_D& n = node->second;
            ids.push_back(n.id);
            xyz.insert(xyz.end(), n.xyz.begin(), n.xyz.end());
            mass.insert(mass.end(), n.mass.begin(), n.mass.end());
            restraint.insert(restraint.end(), n.restraint.begin(), n.restraint.end());
        }
        arrays.Put(kNodes, chunk, "id", ids);
        arrays.Put(kNodes, chunk, "xyz", xyz);
        arrays.Put(kNodes, chunk, "mass", mass);
        // Most nodes have no restraint: a chunk without any has no array of them.
        if (std::any_of(restraint.begin(), restraint.end(), [](int flag) { return flag != 0; }))
            arrays.Put(kNodes, chunk, "restraint", restraint);
    }
}

void GetNodeChunk(const CPackedArrays& arrays, std::int64_t chunk, T_TABLE<T_NODE_D>& nodes)
{
    if (static_cast<std::size_t>(chunk) * kChunkNodes != nodes.size())
        ThrowDamaged(kNodes + (' ' + std::to_string(chunk)));
    const std::vector<int> ids = arrays.Ints(kNodes, chunk, "id");
    const auto xyz = arrays.Bytes(kNodes, chunk, "xyz", 'f');
    const auto mass = arrays.Bytes(kNodes, chunk, "mass", 'f');
    const auto restraint = arrays.Bytes(kNodes, chunk, "restraint", 'i');
    if (xyz.size() != ids.size() * sizeof(T_NODE_D::xyz) ||
        mass.size() != ids.size() * sizeof(T_NODE_D::mass) ||
        (!restraint.empty() && restraint.size() != ids.size() * sizeof(T_NODE_D::restraint)))
        ThrowDamaged(kNodes + (' ' + std::to_string(chunk)));
    for (std::size_t i = 0; i < ids.size(); ++i) {
        T_NODE_D& node = nodes.try_emplace(nodes.end(), ids[i])->second;
        node.id = ids[i];
        TakeGroup(xyz, i, node.xyz);
        TakeGroup(mass, i, node.mass);
        if (!restraint.empty()) TakeGroup(restraint, i, node.restraint);
    }
}

void PutHinges(const T_TABLE<T_PHGE_D>& hinges, CPackedArrays& arrays)
{
    std::vector<int> refs;
    std::vector<double> crack, yield;
    for (const auto& [key, hinge] : hinges) {
        refs.insert(refs.end(), {key, hinge.element, hinge.hingeType});
        for (std::size_t i = 0; i < hinge.crack.size(); ++i) {
            crack.insert(crack.end(), {hinge.crack[i].pos, hinge.crack[i].neg});
            yield.insert(yield.end(), {hinge.yield[i].pos, hinge.yield[i].neg});
        }
    }
    if (refs.empty()) return;
    arrays.Put(kHinges, 0, "refs", refs);
    arrays.Put(kHinges, 0, "crack", crack);
    arrays.Put(kHinges, 0, "yield", yield);
}

void GetHinges(const CPackedArrays& arrays, T_TABLE<T_PHGE_D>& hinges)
{
    const std::vector<int> refs = arrays.Ints(kHinges, 0, "refs");
    const std::vector<double> crack = arrays.Doubles(kHinges, 0, "crack");
    const std::vector<double> yield = arrays.Doubles(kHinges, 0, "yield");
    const std::size_t count = refs.size() / kHingeWidth;
    if (refs.size() % kHingeWidth != 0 || crack.size() != count * kStrengthWidth ||
        yield.size() != crack.size())
        ThrowDamaged(kHinges);
    for (std::size_t i = 0; i < count; ++i) {
        const int* const from = &refs[i * kHingeWidth];
        T_PHGE_D& hinge = hinges.try_emplace(hinges.end(), from[0])->second;
        hinge.element = from[1];
        hinge.hingeType = from[2];
        for (std::size_t c = 0; c < hinge.crack.size(); ++c) {
            const std::size_t at = i * kStrengthWidth + 2 * c;
            hinge.crack[c] = {crack[at], crack[at + 1]};
            hinge.yield[c] = {yield[at], yield[at + 1]};
        }
    }
}
