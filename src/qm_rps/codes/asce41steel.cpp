#include "qm_rps/codes/asce41steel.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kBeam = "ASCE 41-17 Table 9-6";
constexpr const char* kFemaBeam = "FEMA 356 Table 5-6";

struct T_LADDER {
    T_CODE_PLASTIC compact, slender; // multiples of theta_y
    CODE_MARK mark;
};
// clang-format off
// By ASCE_EDITION; multiples of theta_y.
constexpr std::array<T_LADDER, 4> kLadders{{
    //  a    b     c    IO    LS   CP         a    b    c    IO    LS   CP
    {{9.0, 11.0, 0.6, 1.0,  9.0, 11.0}, {4.0, 6.0, 0.2, 0.25, 3.0, 4.0}, S1},
    {{9.0, 11.0, 0.6, 1.0,  9.0, 11.0}, {4.0, 6.0, 0.2, 0.25, 3.0, 4.0}, S1},
    {{9.0, 11.0, 0.6, 1.0,  6.0,  8.0}, {4.0, 6.0, 0.2, 0.25, 2.0, 3.0}, R},
    {{9.0, 11.0, 0.6, 1.0,  9.0, 11.0}, {4.0, 6.0, 0.2, 0.25, 3.0, 4.0}, R},
}};


struct T_BRACE_ROWS {
    BRACE_SHAPE shape;
    T_CODE_PLASTIC stocky, slender; // multiples of Delta_c
};
// ASCE 41 Table 9-8, compression; recalled with low confidence.
constexpr std::array<T_BRACE_ROWS, 3> kBraces{{
    {BRACE_SHAPE::WideFlange, {1.0,  8.0, 0.5, 0.5, 7.0,  8.0}, {0.5, 10.0, 0.3, 0.5, 8.0, 10.0}},
    {BRACE_SHAPE::Tube,       {1.0,  7.0, 0.5, 0.5, 6.0,  7.0}, {0.5,  9.0, 0.3, 0.5, 7.0,  9.0}},
    {BRACE_SHAPE::Angle,      {1.0, 10.0, 0.5, 0.5, 8.0, 10.0}, {0.5, 12.0, 0.3, 0.5, 9.0, 12.0}},
}};
// Tension, multiples of Delta_T: primary, secondary.
constexpr std::array<T_CODE_PLASTIC, 2> kTension{{{11.0, 14.0, 0.8, 0.25, 7.0, 9.0},
                                                  {11.0, 14.0, 0.8, 0.25, 11.0, 13.0}}};
// clang-format on

T_STEEL_PLASTIC InElongations(const T_CODE_PLASTIC& p, const T_STEEL_BRACE& brace,
                              const char* clause, CCodeSheet& sheet)
{
    return {brace.yieldDeform,
            InYields(p, brace.yieldDeform, clause, brace.tension ? "Delta_T" : "Delta_c", sheet,
                     kDimLength),
            false};
}

} // namespace

bool SoundSteel(const T_STEEL_MEMBER& m, CCodeSheet& sheet)
{
    sheet.Positive({{"Fye", m.Fye}, {"E", m.E}, {"Z", m.Z}, {"I", m.I}, {"length", m.length}});
    sheet.Positive({{"bf", m.bf}, {"tf", m.tf}, {"h", m.h}, {"tw", m.tw}, {"A", m.A}});
    return sheet.Finite({{"axial", m.axial}});
}

std::optional<double> AsceSteelYieldRotation(const T_STEEL_MEMBER& m, bool column,
                                             ASCE_EDITION edition, CCodeSheet& sheet)
{
    if (!SoundSteel(m, sheet)) return {};
    const double bare = m.Z * m.Fye * m.length / (6.0 * m.E * m.I);
    if (!column) return sheet.Put("theta_y", bare, "ASCE 41-17 Eq. (9-1)", "Z Fye L/(6 E I)", S2);

    constexpr const char* kClause = "ASCE 41-17 Eq. (9-2)";
    const double p =
        sheet.Put("P/Pye", std::max(0.0, m.axial) / (m.A * m.Fye), kClause, "tension: 0", R);
    if (!sheet.Within("axial", p, 0.0, 0.999)) return {};
    double tau = 1.0;
    if (edition == ASCE_EDITION::Asce17)
        tau = sheet.Put("tau_b", p <= 0.5 ? 1.0 : 4.0 * p * (1.0 - p), kClause,
                        "1, P/Pye <= 0.5; 4 P/Pye (1 - P/Pye)", S1);
    return sheet.Put("theta_y", bare * (1.0 - p) / tau, kClause,
                     "Z Fye L (1 - P/Pye)/(6 tau_b E I)", R);
}

T_CODE_PLASTIC SteelBeamLadder(double slenderShare, ASCE_EDITION edition, const char* clause,
                               CCodeSheet& sheet)
{
    const T_LADDER& row = kLadders.at(static_cast<std::size_t>(edition));
    const T_CODE_PLASTIC p = Between(row.compact, row.slender, slenderShare);
    PutPlastic(p, clause,
               CodeNumber(1.0 - slenderShare) + " compact + " + CodeNumber(slenderShare) +
                   " slender (theta_y)",
               row.mark, sheet);
    return p;
}

double AsceSlenderShare(const T_STEEL_MEMBER& m, const char* clause, CCodeSheet& sheet)
{
    const double root = std::sqrt(m.E / m.Fye);
    const double flange = sheet.Put("bf/2tf / sqrt(E/Fye)", m.bf / (2.0 * m.tf) / root, clause,
                                    "compact <= 0.30, slender >= 0.38", S2);
    const double web = sheet.Put("h/tw / sqrt(E/Fye)", m.h / m.tw / root, clause,
                                 "compact <= 2.45, slender >= 3.76", S2);
    return std::max(LinearClamped(flange, 0.30, 0.0, 0.38, 1.0),
                    LinearClamped(web, 2.45, 0.0, 3.76, 1.0));
}

std::optional<T_STEEL_PLASTIC> AsceSteelBeam(const T_STEEL_MEMBER& m, ASCE_EDITION edition,
                                             CCodeSheet& sheet)
{
    const std::optional<double> yield = AsceSteelYieldRotation(m, false, edition, sheet);
    if (!yield) return {};
    const bool fema =
        edition == ASCE_EDITION::Fema356Primary || edition == ASCE_EDITION::Fema356Secondary;
    const char* clause = fema ? kFemaBeam : kBeam;
    const double share = AsceSlenderShare(m, clause, sheet);
    const T_CODE_PLASTIC p = SteelBeamLadder(share, edition, clause, sheet);
    if (!sheet.Sound()) return {};
    return T_STEEL_PLASTIC{*yield, InYields(p, *yield, clause, "theta_y", sheet), false};
}

std::optional<T_STEEL_PLASTIC> AsceBrace(const T_STEEL_BRACE& brace, CCodeSheet& sheet)
{
    constexpr const char* kClause = "ASCE 41 Table 9-8";
    if (!sheet.Positive({{"yieldDeform", brace.yieldDeform}})) return {};
    if (brace.tension) {
        const T_CODE_PLASTIC& p = kTension[brace.primary ? 0 : 1];
        PutPlastic(p, kClause, "tension (Delta_T)", R, sheet);
        return InElongations(p, brace, kClause, sheet);
    }
    if (!sheet.Positive({{"slenderness", brace.slenderness}, {"Fy", brace.Fy}, {"E", brace.E}}))
        return {};
    const auto row = std::find_if(kBraces.begin(), kBraces.end(),
                                  [&](const auto& r) { return r.shape == brace.shape; });
    if (row == kBraces.end()) {
        sheet.Refuse(CODE_REASON::NoRow, "shape", kClause);
        return {};
    }
    const double ratio =
        sheet.Put("KL/r / sqrt(E/Fy)", brace.slenderness / std::sqrt(brace.E / brace.Fy), kClause,
                  "stocky <= 2.1, slender >= 4.2", R);
    const double share = LinearClamped(ratio, 2.1, 0.0, 4.2, 1.0);
    const T_CODE_PLASTIC p = Between(row->stocky, row->slender, share);
    PutPlastic(p, kClause,
               CodeNumber(1.0 - share) + " stocky + " + CodeNumber(share) + " slender (Delta_c)", R,
               sheet);
    if (!sheet.Sound()) return {};
    return InElongations(p, brace, kClause, sheet);
}
