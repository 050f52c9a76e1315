#include "qm_rps/codes/asce41strength.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kShear = "ASCE 41-17 Eq. (10-3)";
constexpr const char* kTies = "ASCE 41-17 10.3.4";
constexpr const char* kStiffness = "ASCE 41 Table 10-5";

struct T_STIFFNESS_ROW {
    ASCE_MEMBER member;
    double low, high; // over Ec Ig, at P <= 0.1 and P >= 0.5 Ag f'cE
    double earlier;   // before ASCE 41-17; 0: as now
    const char* text;
};
constexpr std::array<T_STIFFNESS_ROW, 4> kStiffnessRows{{
    {ASCE_MEMBER::Beam, 0.3, 0.3, 0.0, "0.3 EcE Ig"},
    {ASCE_MEMBER::PrestressedBeam, 1.0, 1.0, 0.0, "1.0 EcE Ig"},
    {ASCE_MEMBER::Column, 0.3, 0.7, 0.0, "0.3 EcE Ig, P <= 0.1 Ag f'cE; 0.7, P >= 0.5 Ag f'cE"},
    {ASCE_MEMBER::Wall, 0.35, 0.35, 0.5, "0.35 EcE Ig; 41-13: 0.5"},
}};

struct T_FACTOR_ROW {
    double factor;
    const char *symbol, *clause;
};
constexpr std::array<T_FACTOR_ROW, 4> kExpected{{
    {1.50, "f'cE/f'c", "ASCE 41-17 Table 10-1"},
    {1.25, "fyE/fy", "ASCE 41-17 Table 10-1"},
    {1.50, "fyE/fy", "ASCE 41-17 Table 10-1"},
    {1.10, "Fye/Fy", "ASCE 41-17 Table 9-3"},
}};
constexpr std::array<double, 3> kKappas{0.75, 0.90, 1.00};

} // namespace

std::optional<T_ASCE_COLUMN_STRENGTH> AsceColumnShear(const T_ASCE_COLUMN_SHEAR& c,
                                                      CCodeSheet& sheet)
{
    sheet.Positive({{"spacing", c.spacing}, {"fc", c.fc}, {"d", c.d}, {"Ag", c.Ag}});
    sheet.NotNegative({{"tieArea", c.tieArea}, {"fyt", c.fyt}, {"ductility", c.ductility}});
    sheet.Positive({{"momentShear", c.momentShear}});
    sheet.Within("lambda", c.lambda, 0.5, 1.0);
    if (!sheet.Finite({{"axial", c.axial}})) return {};

    // In N and mm, where the root of a strength in MPa has the factor 0.5 (6 in psi).
    const double root = 0.5 * RootMpa(c.fc);
    const double alpha = sheet.Put("alpha_col", LinearClamped(c.spacing / c.d, 0.75, 1.0, 1.0, 0.0),
                                   kShear, "1.0, s/d <= 0.75; 0.0, s/d >= 1.0", S2);
    const double slender = sheet.Put("M/(V d)", std::clamp(c.momentShear / c.d, 2.0, 4.0), kShear,
                                     "2 <= M_UD/(V_UD d) <= 4", S2);
    const double axial =
        sheet.Put("N_UG", std::max(0.0, c.axial), kDimForce, kShear, "tension: 0", S2);
    if (c.lambda != 1.0) sheet.Put("lambda", c.lambda, kShear, "0.75: lightweight", R);
    const double concrete =
        c.lambda * root / slender * std::sqrt(1.0 + axial / (c.Ag * root)) * 0.8 * c.Ag;
    T_ASCE_COLUMN_STRENGTH v;
    v.initial = sheet.Put("V_ColO", alpha * c.tieArea * c.fyt * c.d / c.spacing + concrete,
                          kDimForce, kShear,
                          "alpha_col Av fytE d/s + lambda (0.5 sqrt(f'cE)/(M/(V d)))"
                          " sqrt(1 + N_UG/(0.5 Ag sqrt(f'cE))) 0.8 Ag (N, mm)",
                          S2);
    v.factor = sheet.Put("k_nl", LinearClamped(c.ductility, 2.0, 1.0, 6.0, 0.7), kShear,
                         "1.0, ductility <= 2; 0.7, >= 6", S2);
    v.strength = sheet.Put("V_Col", v.factor * v.initial, kDimForce, kShear, "k_nl V_ColO", S2);
    return sheet.Sound() ? std::optional(v) : std::nullopt;
}

std::optional<double> AsceTieShare(double spacing, double d, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"spacing", spacing}, {"d", d}})) return {};
    const double ratio = spacing / d;
    return sheet.Put("share of ties", ratio <= 0.5 ? 1.0 : std::max(0.0, 2.0 * (1.0 - ratio)),
                     kTies, "s > d/2: 2 (1 - s/d) >= 0", S1);
}

std::optional<T_ASCE_STIFFNESS> AsceStiffness(ASCE_MEMBER member, double axialRatio,
                                              ASCE_EDITION edition, CCodeSheet& sheet)
{
    if (!sheet.Finite({{"axialRatio", axialRatio}})) return {};
    const auto row = std::find_if(kStiffnessRows.begin(), kStiffnessRows.end(),
                                  [&](const auto& r) { return r.member == member; });
    const bool fema =
        edition == ASCE_EDITION::Fema356Primary || edition == ASCE_EDITION::Fema356Secondary;
    if (row == kStiffnessRows.end() || fema) {
        sheet.Refuse(CODE_REASON::NoRow, "member", kStiffness);
        return {};
    }
    const bool earlier = edition == ASCE_EDITION::Asce13 && row->earlier > 0.0;
    T_ASCE_STIFFNESS s;
    s.flexure =
        sheet.Put("EI/(EcE Ig)",
                  earlier ? row->earlier : LinearClamped(axialRatio, 0.1, row->low, 0.5, row->high),
                  kStiffness, row->text, R);
    s.shear = sheet.Put("GA/(EcE Aw)", 0.4, kStiffness, "0.4 EcE Aw", R);
    return s;
}

double AsceExpectedFactor(ASCE_MATERIAL material, CCodeSheet& sheet)
{
    const T_FACTOR_ROW& row = kExpected.at(static_cast<std::size_t>(material));
    return sheet.Put(row.symbol, row.factor, row.clause, "", R);
}

double AsceKappa(ASCE_KNOWLEDGE knowledge, CCodeSheet& sheet)
{
    return sheet.Put("kappa", kKappas.at(static_cast<std::size_t>(knowledge)), "ASCE 41-17 6.2.4",
                     "0.75, 0.9, 1.0", R);
}
