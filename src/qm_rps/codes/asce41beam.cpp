#include "qm_rps/codes/asce41concrete.h"
#include "qm_rps/codes/concretelaw.h"

#include <algorithm>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;

// Conforming (C) or not (NC), and spacing up to d / 2 or above.
enum GROUP { FlexureC, FlexureNC, ShearClose, ShearWide, SpliceClose, SpliceWide, Embedment };
constexpr std::array<const char*, 7> kNames{
    "i, C", "i, NC", "ii, s <= d/2", "ii, s > d/2", "iii, s <= d/2", "iii, s > d/2", "iv"};

// ASCE 41-17 (and 41-13) Table 10-7: (rho - rho') / rho_bal; V / (bw d sqrt(f'cE)) in psi.
// clang-format off
constexpr T_CODE_ROW kAsce[] = {
    //                                        a      b      c    IO      LS     CP
    {FlexureC,    {0.0, 3.0, kAnyValue}, {0.025, 0.05,  0.2, 0.010,  0.025, 0.05},  S2},
    {FlexureC,    {0.0, 6.0, kAnyValue}, {0.02,  0.04,  0.2, 0.005,  0.02,  0.04},  S2},
    {FlexureC,    {0.5, 3.0, kAnyValue}, {0.02,  0.03,  0.2, 0.005,  0.02,  0.03},  S2},
    {FlexureC,    {0.5, 6.0, kAnyValue}, {0.015, 0.02,  0.2, 0.005,  0.015, 0.02},  S2},
    {FlexureNC,   {0.0, 3.0, kAnyValue}, {0.02,  0.03,  0.2, 0.005,  0.02,  0.03},  S2},
    {FlexureNC,   {0.0, 6.0, kAnyValue}, {0.01,  0.015, 0.2, 0.0015, 0.01,  0.015}, S2},
    {FlexureNC,   {0.5, 3.0, kAnyValue}, {0.01,  0.015, 0.2, 0.005,  0.01,  0.015}, S2},
    {FlexureNC,   {0.5, 6.0, kAnyValue}, {0.005, 0.01,  0.2, 0.0015, 0.005, 0.01},  S2},
    {ShearClose,  {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.02, 0.2, 0.0015, 0.01,  0.02}, S1},
    {ShearWide,   {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.01, 0.2, 0.0015, 0.005, 0.01}, S1},
    {SpliceClose, {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.02, 0.0, 0.0015, 0.01,  0.02}, S1},
    {SpliceWide,  {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.01, 0.0, 0.0015, 0.005, 0.01}, S1},
    {Embedment,   {kAnyValue, kAnyValue, kAnyValue}, {0.015, 0.03, 0.2, 0.01,   0.02,  0.03}, S1},
};
// FEMA 356 Table 6-7, primary components; a, b, c, IO as above. LS of ii to iv is recalled.
constexpr T_CODE_ROW kFemaPrimary[] = {
    {FlexureC,    {0.0, 3.0, kAnyValue}, {0.025, 0.05,  0.2, 0.010,  0.020, 0.025}, S1},
    {FlexureC,    {0.0, 6.0, kAnyValue}, {0.02,  0.04,  0.2, 0.005,  0.010, 0.02},  S1},
    {FlexureC,    {0.5, 3.0, kAnyValue}, {0.02,  0.03,  0.2, 0.005,  0.010, 0.02},  S1},
    {FlexureC,    {0.5, 6.0, kAnyValue}, {0.015, 0.02,  0.2, 0.005,  0.005, 0.015}, S1},
    {FlexureNC,   {0.0, 3.0, kAnyValue}, {0.02,  0.03,  0.2, 0.005,  0.010, 0.02},  S1},
    {FlexureNC,   {0.0, 6.0, kAnyValue}, {0.01,  0.015, 0.2, 0.0015, 0.005, 0.01},  S1},
    {FlexureNC,   {0.5, 3.0, kAnyValue}, {0.01,  0.015, 0.2, 0.005,  0.010, 0.01},  S1},
    {FlexureNC,   {0.5, 6.0, kAnyValue}, {0.005, 0.01,  0.2, 0.0015, 0.005, 0.005}, S1},
    {ShearClose,  {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.02, 0.2, 0.0015, 0.002, 0.003}, R},
    {ShearWide,   {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.01, 0.2, 0.0015, 0.002, 0.003}, R},
    {SpliceClose, {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.02, 0.0, 0.0015, 0.002, 0.003}, R},
    {SpliceWide,  {kAnyValue, kAnyValue, kAnyValue}, {0.003, 0.01, 0.0, 0.0015, 0.002, 0.003}, R},
    {Embedment,   {kAnyValue, kAnyValue, kAnyValue}, {0.015, 0.03, 0.2, 0.01,   0.01,  0.015}, R},
};
// clang-format on
constexpr std::array<const char*, 3> kVariables{"(rho - rho')/rho_bal", "V/(bw d sqrt(f'cE)) (psi)",
                                                ""};
// Secondary components of FEMA 356 have the later standards' LS and CP.
const T_CODE_TABLE kTables[] = {
    {"ASCE 41-17 Table 10-7", kVariables, kAsce},
    {"ASCE 41-13 Table 10-7", kVariables, kAsce},
    {"FEMA 356 Table 6-7", kVariables, kFemaPrimary},
    {"FEMA 356 Table 6-7", kVariables, kAsce},
};

bool Sound(const T_ASCE_BEAM& b, CCodeSheet& sheet)
{
    sheet.Positive({{"bw", b.bw}, {"d", b.d}, {"fc", b.fc}, {"fy", b.fy}, {"Es", b.Es}});
    sheet.Positive({{"spacing", b.spacing}, {"tensionRatio", b.tensionRatio}});
    sheet.NotNegative({{"compressionRatio", b.compressionRatio}, {"ductility", b.ductility}});
    return sheet.NotNegative({{"shear", b.shear}, {"hoopShear", b.hoopShear}});
}

/// Transverse reinforcement: close enough and, where the ductility demand wants it, strong enough.
bool Conforms(const T_ASCE_BEAM& b)
{
    const bool lowDemand = b.ductility > 0.0 && b.ductility < 2.0;
    return b.spacing <= b.d / 3.0 && (lowDemand || b.hoopShear >= 0.75 * b.shear);
}

} // namespace

std::optional<T_CODE_PLASTIC> AsceBeam(const T_ASCE_BEAM& beam, ASCE_EDITION edition,
                                       CCodeSheet& sheet)
{
    if (!Sound(beam, sheet)) return {};
    const T_CODE_TABLE& table = kTables[static_cast<std::size_t>(edition)];
    const double balanced = BalancedRatio(beam.fc, beam.fy, beam.Es, sheet);
    const std::array<double, 3> x{(beam.tensionRatio - beam.compressionRatio) / balanced,
                                  beam.shear / (beam.bw * beam.d * RootPsi(beam.fc)), 0.0};
    const bool wide = beam.spacing > beam.d / 2.0;
    std::vector<GROUP> groups;
    if (beam.shearControls)
        groups.push_back(wide ? ShearWide : ShearClose);
    else
        groups.push_back(Conforms(beam) ? FlexureC : FlexureNC);
    if (beam.poorSplice) groups.push_back(wide ? SpliceWide : SpliceClose);
    if (beam.poorEmbedment) groups.push_back(Embedment);

    std::optional<T_CODE_PLASTIC> least;
    for (const GROUP group : groups) {
        const auto p = Interpolate(table, group, kNames[group], x, sheet);
        if (!p) return {};
        least = least ? LeastOf(*least, *p) : *p;
    }
    if (groups.size() > 1) PutPlastic(*least, table.clause, "min", S2, sheet);
    return sheet.Sound() ? least : std::nullopt;
}
