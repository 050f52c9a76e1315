#include "qm_cmd/spectralreduction.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

struct T_FLOOR_ROW {
    int type;
    double minA, minV;
};

// ATC-40 (1996) Table 8-2: minimum allowable SRA and SRV.
// clang-format off
constexpr std::array<T_FLOOR_ROW, 3> kFloors{{
    {0, 0.33, 0.50},
    {1, 0.44, 0.56},
    {2, 0.56, 0.67},
}};
// clang-format on

} // namespace

int CalcSpectralReduction(double betaPct, T_SPEC_REDUCTION& out)
{
    if (!(betaPct > 0.0) || !std::isfinite(betaPct)) return 0;
    const double lnBeta = std::log(betaPct);
    out = {(3.21 - 0.68 * lnBeta) / 2.12, (2.31 - 0.41 * lnBeta) / 1.65};
    return 1;
}

void ApplyReductionFloors(int behaviorType, T_SPEC_REDUCTION& factors)
{
    for (const T_FLOOR_ROW& row : kFloors) {
        if (row.type != behaviorType) continue;
        factors.SRa = std::max(factors.SRa, row.minA);
        factors.SRv = std::max(factors.SRv, row.minV);
    }
}
