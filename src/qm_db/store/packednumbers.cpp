#include "qm_db/store/packednumbers.h"

#include <cmath>
#include <cstring>

namespace {

constexpr std::size_t kDirs = std::tuple_size_v<T_DIRS6>;

} // namespace

bool AllFinite(std::span<const std::byte> packed)
{
    bool finite = true;
    for (std::size_t at = 0; at < packed.size(); at += sizeof(double)) {
        double value = 0.0;
        std::memcpy(&value, packed.data() + at, sizeof value);
        finite = finite && std::isfinite(value);
    }
    return finite;
}

void CNumberWriter::Put(std::vector<int>& to, const T_END_RELEASES& release)
{
    int bits = 0;
    for (std::size_t i = 0; i < kDirs; ++i) {
        if (release.I[i]) bits |= 1 << i;
        if (release.J[i]) bits |= 1 << (i + kDirs);
    }
    to.push_back(bits);
}

bool CNumberReader::Take(const int*& from, T_END_RELEASES& release)
{
    const int bits = *from++;
    for (std::size_t i = 0; i < kDirs; ++i) {
        release.I[i] = (bits >> i & 1) != 0;
        release.J[i] = (bits >> (i + kDirs) & 1) != 0;
    }
    return true;
}

bool CNumberReader::Take(const int*& from, ELEM_KIND& kind)
{
    const int code = *from++;
    if (code < 0 || code > static_cast<int>(ELEM_KIND::Spring)) return false;
    kind = static_cast<ELEM_KIND>(code);
    return true;
}
