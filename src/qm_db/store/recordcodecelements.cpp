#include "qm_db/store/recordcodecpacked.h"

#include "qm_db/file/storefault.h"

#include <algorithm>
#include <bit>

namespace {

constexpr const char* kElements = "elements";
constexpr std::size_t kWidth = 6; // id, nodes, section, material, member
constexpr std::size_t kDirs = std::tuple_size_v<T_DIRS6>;

/// One bit per released direction, the I-end's first.
int ReleaseBits(const T_ENDS<T_DIRS6>& release)
{
    int bits = 0;
    for (std::size_t i = 0; i < kDirs; ++i) {
        if (release.I[i]) bits |= 1 << i;
        if (release.J[i]) bits |= 1 << (i + kDirs);
    }
    return bits;
}

T_ENDS<T_DIRS6> ReleaseOf(int bits)
{
    T_ENDS<T_DIRS6> release;
    for (std::size_t i = 0; i < kDirs; ++i) {
        release.I[i] = (bits >> i & 1) != 0;
        release.J[i] = (bits >> (i + kDirs) & 1) != 0;
    }
    return release;
}

/// A list in which everything is 0 is left out, as files of version 2 leave out all but "data";
/// -0.0 is not 0.
void PutUnlessZero(CPackedArrays& arrays, const char* name, const std::vector<int>& values)
{
    if (std::ranges::any_of(values, [](int v) { return v != 0; }))
        arrays.Put(kElements, 0, name, values);
}
void PutUnlessZero(CPackedArrays& arrays, const char* name, const std::vector<double>& values)
{
    if (std::ranges::any_of(values, [](double v) { return std::bit_cast<std::uint64_t>(v) != 0; }))
        arrays.Put(kElements, 0, name, values);
}

template <class T, std::size_t N>
void Append(std::vector<T>& to, const std::array<T, N>& from)
{
    to.insert(to.end(), from.begin(), from.end());
}

/// A list of `width` numbers per element; absent: 0.
class CColumn {
public:
    CColumn(const CPackedArrays& arrays, const char* name, std::size_t count, std::size_t width)
        : m_values(arrays.Doubles(kElements, 0, name)), m_width(width)
    {
        if (!m_values.empty() && m_values.size() != count * width) ThrowDamaged(kElements);
    }
    template <std::size_t N>
    void Take(std::size_t element, std::size_t at, std::array<double, N>& out) const
    {
        if (m_values.empty()) return;
        std::copy_n(&m_values[element * m_width + at], N, out.begin());
    }

private:
    std::vector<double> m_values;
    std::size_t m_width;
};

std::vector<int> Ints(const CPackedArrays& arrays, const char* name, std::size_t count)
{
    std::vector<int> values = arrays.Ints(kElements, 0, name);
    if (!values.empty() && values.size() != count) ThrowDamaged(kElements);
    values.resize(count);
    return values;
}

} // namespace

void PutElements(const T_TABLE<T_ELEM_D>& elements, CPackedArrays& arrays)
{
    std::vector<int> data, kind, release;
    std::vector<double> zAxis, offset, stiffness;
    for (const auto& [key, e] : elements) {
        data.insert(data.end(), {key, e.nodeI, e.nodeJ, e.section, e.material, e.member});
        kind.push_back(static_cast<int>(e.kind));
        release.push_back(ReleaseBits(e.release));
        Append(zAxis, e.zAxis);
        Append(offset, e.offset.I);
        Append(offset, e.offset.J);
        Append(stiffness, e.stiffness);
    }
    if (!data.empty()) arrays.Put(kElements, 0, "data", data);
    PutUnlessZero(arrays, "kind", kind);
    PutUnlessZero(arrays, "release", release);
    PutUnlessZero(arrays, "z_axis", zAxis);
    PutUnlessZero(arrays, "offset", offset);
    PutUnlessZero(arrays, "stiffness", stiffness);
}

void GetElements(const CPackedArrays& arrays, T_TABLE<T_ELEM_D>& elements)
{
    const std::vector<int> data = arrays.Ints(kElements, 0, "data");
    const std::size_t count = data.size() / kWidth;
    if (data.size() % kWidth != 0) ThrowDamaged(kElements);
    const std::vector<int> kind = Ints(arrays, "kind", count);
    const std::vector<int> release = Ints(arrays, "release", count);
    const CColumn zAxis(arrays, "z_axis", count, 3);
    const CColumn offset(arrays, "offset", count, 6);
    const CColumn stiffness(arrays, "stiffness", count, 6);
    for (std::size_t i = 0; i < count; ++i) {
        const int* const from = &data[i * kWidth];
        T_ELEM_D& e = elements.try_emplace(elements.end(), from[0])->second;
        e = {from[0], from[1], from[2], from[3], from[4], from[5]};
        if (kind[i] < 0 || kind[i] > static_cast<int>(ELEM_KIND::Spring)) ThrowDamaged(kElements);
        e.kind = static_cast<ELEM_KIND>(kind[i]);
        e.release = ReleaseOf(release[i]);
        zAxis.Take(i, 0, e.zAxis);
        offset.Take(i, 0, e.offset.I);
        offset.Take(i, 3, e.offset.J);
        stiffness.Take(i, 0, e.stiffness);
    }
}
