#include "qm_rps/codes/en1998rotation.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;
constexpr const char* kA1 = "EN 1998-3 (A.1)";
constexpr const char* kA3 = "EN 1998-3 (A.3)";
constexpr const char* kA4 = "EN 1998-3 (A.4)";
constexpr const char* kA10 = "EN 1998-3 (A.10)";
constexpr const char* kCircolare = "Circolare 2019 C8.7.2.3.2";
constexpr std::array<double, 3> kConfidence{1.35, 1.20, 1.00};
constexpr double kLeastOmega = 0.01;

double Mpa(double stress)
{
    return stress / kPascalsPerMpa;
}

/// Mechanical ratios, axial force, shear span and hoops that (A.1) and (A.3) share.
struct T_ARGUMENTS {
    double nu = 0.0, omega = 0.0, omegaPrime = 0.0, span = 0.0, hoops = 0.0;
};

T_ARGUMENTS Arguments(const T_EN_MEMBER& m, const char* clause, CCodeSheet& sheet)
{
    const double toOmega = m.fy / (m.b * m.d * m.fc);
    T_ARGUMENTS arg;
    arg.nu =
        sheet.Put("nu", std::max(0.0, m.axial) / (m.b * m.h * m.fc), clause, "N/(b h fc) >= 0", S2);
    arg.omega = sheet.Put("w", (m.As + m.AsWeb) * toOmega, clause, "(As1 + Asv) fy/(b d fc)", S1);
    arg.omegaPrime = sheet.Put("w'", m.AsPrime * toOmega, clause, "As2 fy/(b d fc)", S2);
    if (m.AsWeb > 0.0) sheet.WarnConflict(clause, "w: + Asv", "w: + Asv/2, w': + Asv/2");
    arg.span = sheet.Put("LV/h", m.shearSpan / m.h, clause, "M/(V h)", S2);
    arg.hoops =
        sheet.Put("alpha rho_sx fyw/fc", m.alpha * m.hoopRatio * m.fyw / m.fc, clause, "", K);
    return arg;
}

/// 25^(hoops) base^(100 rho_d).
double Steel(const T_EN_MEMBER& m, const T_ARGUMENTS& arg, double base)
{
    return std::pow(25.0, arg.hoops) * std::pow(base, 100.0 * m.diagonalRatio);
}

double GammaEl(const T_EN_MEMBER& m, double primary, const char* clause, CODE_MARK mark,
               CCodeSheet& sheet)
{
    return m.secondary ? sheet.Put("gamma_el", 1.0, clause, "secondary", R)
                       : sheet.Put("gamma_el", primary, clause, "primary", mark);
}

struct T_FACTOR_TEXT {
    double factor;
    const char* text;
    CODE_MARK mark;
};

/// Factors for walls, old detailing and laps; `en` is the wall's factor in EN 1998-3.
double DetailFactor(const T_EN_MEMBER& m, const T_FACTOR_TEXT& en, const char* clause,
                    CCodeSheet& sheet)
{
    const bool circolare = m.basis == EN_BASIS::Circolare2019;
    double factor = 1.0;
    if (m.wall) {
        const T_FACTOR_TEXT wall = circolare ? T_FACTOR_TEXT{1.0 / 1.6, "wall: 1/1.6", S1} : en;
        factor *=
            sheet.Put("k_wall", wall.factor, circolare ? kCircolare : clause, wall.text, wall.mark);
        if (!circolare) sheet.WarnConflict(clause, wall.text, "wall: 1/1.6");
    }
    if (!m.seismicDetails) {
        factor *= circolare ? sheet.Put("k_det", 0.85, kCircolare, "0.85", S1)
                            : sheet.Put("k_det", 0.825, clause, "0.825", R);
        if (!circolare) sheet.WarnConflict(clause, "k_det = 0.825", "k_det = 1/1.2");
    }
    if (m.lapRatio > 0.0 || m.smoothBars) {
        const double lap = m.lapRatio > 0.0 ? std::min(40.0, m.lapRatio) : 40.0;
        factor *= m.smoothBars
                      ? sheet.Put("k_lap", 0.02 * (10.0 + lap), kCircolare,
                                  "0.02 (10 + min(40; lo/dbL))", R)
                      : sheet.Put("k_lap", 0.025 * lap, kCircolare, "0.025 min(40; lo/dbL)", S1);
        if (!circolare)
            sheet.WarnConflict(clause, std::string("k_lap: ") + kCircolare, "EN 1998-3 A.3.2.2(4)");
    }
    return factor;
}

} // namespace

bool SoundMember(const T_EN_MEMBER& m, CCodeSheet& sheet)
{
    sheet.Positive({{"b", m.b}, {"h", m.h}, {"d", m.d}, {"dPrime", m.dPrime}});
    sheet.Positive({{"fc", m.fc}, {"fy", m.fy}, {"Es", m.Es}, {"shearSpan", m.shearSpan}});
    sheet.Positive(
        {{"As", m.As}, {"As2 (compressed side)", m.AsPrime}, {"barDiameter", m.barDiameter}});
    sheet.NotNegative({{"AsWeb", m.AsWeb}, {"fyw", m.fyw}, {"hoopRatio", m.hoopRatio}});
    sheet.NotNegative({{"diagonalRatio", m.diagonalRatio}, {"lapRatio", m.lapRatio}});
    if (sheet.Sound()) sheet.Within("d", m.d, m.dPrime * (1.0 + 1e-9), m.h);
    sheet.Within("alpha", m.alpha, 0.0, 1.0);
    if (m.smoothBars && m.basis == EN_BASIS::En1998) // its factors are not known to us
        sheet.Refuse(CODE_REASON::NoRow, "smoothBars", "EN 1998-3 A.3.2.2(5)");
    sheet.Finite({{"axial", m.axial}});
    if (sheet.Sound()) sheet.Within("axial", m.axial, -kAnyValue, m.b * m.h * m.fc);
    return sheet.Sound();
}

std::optional<double> ConfidenceFactor(int knowledgeLevel, CCodeSheet& sheet)
{
    if (!sheet.Within("knowledgeLevel", knowledgeLevel, 1.0, 3.0)) return {};
    return sheet.Put("CF", kConfidence.at(static_cast<std::size_t>(knowledgeLevel - 1)),
                     "EN 1998-3 Table 3.1, Circolare 2019 Tab. C8.5.IV", "1.35, 1.20, 1.00", S1);
}

std::optional<double> EnThetaY(const T_EN_MEMBER& m, THETA_Y form, double curvature, bool cracked,
                               CCodeSheet& sheet)
{
    if (!SoundMember(m, sheet) || !sheet.Positive({{"curvature", curvature}})) return {};
    const double span = m.shearSpan, z = m.d - m.dPrime;
    const double slip = m.barDiameter * Mpa(m.fy) / std::sqrt(Mpa(m.fc)); // dbL fy / sqrt fc
    const double beam = 1.0 + 1.5 * m.h / span;
    const double shifted = span + (cracked ? z : 0.0);
    const auto put = [&](double value, const char* clause, const char* text, CODE_MARK mark) {
        return sheet.Put("theta_y", value, clause, text, mark);
    };
    if (form == THETA_Y::CircolareBeam)
        return put(curvature * span / 3.0 + 0.0013 * beam + 0.13 * curvature * slip,
                   "Circolare 2019 [C8.7.2.7a]",
                   "phi_y LV/3 + 0.0013 (1 + 1.5 h/LV) + 0.13 phi_y dbL fy/sqrt(fc)", S1);
    if (form == THETA_Y::CircolareWall)
        return put(curvature * span / 3.0 + 0.002 * std::max(0.0, 1.0 - 0.125 * span / m.h) +
                       0.13 * curvature * slip,
                   "Circolare 2019 [C8.7.2.7b]",
                   "phi_y LV/3 + 0.002 (1 - 0.125 LV/h) + 0.13 phi_y dbL fy/sqrt(fc)", S1);
    if (cracked) sheet.WarnConflict(kA10, "z = d - d'", "z = 0.9 d");
    const double bending = curvature * shifted / 3.0;
    if (m.wall)
        return put(bending + 0.0013 + curvature * slip / 8.0, "EN 1998-3 (A.11b)",
                   "phi_y (LV + aV z)/3 + 0.0013 + phi_y dbL fy/(8 sqrt(fc))", R);
    if (form == THETA_Y::A10a)
        return put(bending + 0.0014 * beam + m.fy / m.Es / z * slip / 6.0, "EN 1998-3 (A.10a)",
                   "phi_y (LV + aV z)/3 + 0.0014 (1 + 1.5 h/LV) + eps_y/(d - d') dbL fy/(6"
                   " sqrt(fc))",
                   R);
    if (form == THETA_Y::A10bFirst)
        return put(bending + 0.0013 * beam + 0.13 * curvature * slip, "EN 1998-3:2004 (A.10b)",
                   "phi_y (LV + aV z)/3 + 0.0013 (1 + 1.5 h/LV) + 0.13 phi_y dbL fy/sqrt(fc)", S1);
    return put(bending + 0.0014 * beam + curvature * slip / 8.0, "EN 1998-3 (A.10b)",
               "phi_y (LV + aV z)/3 + 0.0014 (1 + 1.5 h/LV) + phi_y dbL fy/(8 sqrt(fc))", S2);
}

std::optional<double> EnThetaUm(const T_EN_MEMBER& m, CCodeSheet& sheet)
{
    if (!SoundMember(m, sheet)) return {};
    const T_ARGUMENTS arg = Arguments(m, kA1, sheet);
    const double omegas =
        std::max(kLeastOmega, arg.omegaPrime) / std::max(kLeastOmega, arg.omega) * Mpa(m.fc);
    if (arg.span > 9.0) sheet.WarnConflict(kA1, "LV/h", "min(9; LV/h)");
    const double mean = 0.016 * std::pow(0.3, arg.nu) * std::pow(omegas, 0.225) *
                        std::pow(arg.span, 0.35) * Steel(m, arg, 1.25);
    const double factor = DetailFactor(m, {0.58, "wall: 0.58", R}, kA1, sheet);
    const double gamma = GammaEl(m, 1.5, kA1, S2, sheet);
    return sheet.Put("theta_um", mean * factor / gamma, kA1,
                     "1/gamma_el 0.016 0.3^nu (max(0.01; w')/max(0.01; w) fc)^0.225 (LV/h)^0.35"
                     " 25^(alpha rho_sx fyw/fc) 1.25^(100 rho_d)",
                     S2);
}

std::optional<double> EnThetaPlastic(const T_EN_MEMBER& m, CCodeSheet& sheet)
{
    if (!SoundMember(m, sheet)) return {};
    const T_ARGUMENTS arg = Arguments(m, kA3, sheet);
    const double omegas = std::max(kLeastOmega, arg.omegaPrime) / std::max(kLeastOmega, arg.omega);
    const double mean = 0.0145 * std::pow(0.25, arg.nu) * std::pow(omegas, 0.3) *
                        std::pow(Mpa(m.fc), 0.2) * std::pow(std::min(9.0, arg.span), 0.35) *
                        Steel(m, arg, 1.275);
    const double factor = DetailFactor(m, {0.6, "wall: 0.6", R}, kA3, sheet);
    const double gamma = GammaEl(m, 1.8, kA3, R, sheet);
    if (!m.secondary) sheet.WarnConflict(kA3, "gamma_el = 1.8", "gamma_el = 1.5");
    if (m.diagonalRatio > 0.0) sheet.WarnConflict(kA3, "1.275^(100 rho_d)", "1.25^(100 rho_d)");
    return sheet.Put("theta_pl,um", mean * factor / gamma, kA3,
                     "1/gamma_el 0.0145 0.25^nu (max(0.01; w')/max(0.01; w))^0.3 fc^0.2"
                     " min(9; LV/h)^0.35 25^(alpha rho_sx fyw/fc) 1.275^(100 rho_d)",
                     S2);
}

std::optional<double> EnHingeLength(const T_EN_MEMBER& m, LPL_FORM form, CCodeSheet& sheet)
{
    if (!SoundMember(m, sheet)) return {};
    const double slip = m.barDiameter * Mpa(m.fy) / std::sqrt(Mpa(m.fc));
    if (form == LPL_FORM::A9)
        return sheet.Put("Lpl", m.shearSpan / 30.0 + 0.2 * m.h + 0.11 * slip, kDimLength,
                         "EN 1998-3 (A.9)", "LV/30 + 0.2 h + 0.11 dbL fy/sqrt(fc)", R);
    return sheet.Put("Lpl", 0.1 * m.shearSpan + 0.17 * m.h + 0.24 * slip, kDimLength,
                     "EN 1998-3 (A.5), Circolare 2019 [C8.7.2.6]",
                     "0.1 LV + 0.17 h + 0.24 dbL fy/sqrt(fc)", S1);
}

std::optional<double> EnThetaFromCurvature(const T_EN_MEMBER& m, LPL_FORM form, double thetaY,
                                           double yieldCurvature, double ultimateCurvature,
                                           CCodeSheet& sheet)
{
    const std::optional<double> length = EnHingeLength(m, form, sheet);
    if (!length) return {};
    sheet.Positive({{"thetaY", thetaY}, {"yieldCurvature", yieldCurvature}});
    if (!sheet.Within("ultimateCurvature", ultimateCurvature, yieldCurvature, kAnyValue)) return {};
    const double gamma = GammaEl(m, form == LPL_FORM::A9 ? 1.7 : 1.5, kA4, R, sheet);
    const double plastic =
        (ultimateCurvature - yieldCurvature) * *length * (1.0 - 0.5 * *length / m.shearSpan);
    return sheet.Put("theta_um", (thetaY + plastic) / gamma, kA4,
                     "1/gamma_el (theta_y + (phi_u - phi_y) Lpl (1 - 0.5 Lpl/LV))", S2);
}

std::optional<T_CHORD_LIMITS> EnChordLimits(double thetaY, double thetaUm, EN_BASIS basis,
                                            CCodeSheet& sheet)
{
    if (!sheet.Positive({{"thetaY", thetaY}, {"thetaUm", thetaUm}})) return {};
    const bool en = basis == EN_BASIS::En1998;
    const char* clause = en ? "EN 1998-3 A.3.2" : kCircolare;
    const CODE_MARK mark = en ? S1 : R;
    T_CHORD_LIMITS limits;
    limits.DL = sheet.Put(en ? "DL" : "SLD", thetaY, clause, "theta_y", mark);
    limits.SD = sheet.Put(en ? "SD" : "SLV", 0.75 * thetaUm, clause, "3/4 theta_um", mark);
    limits.NC = sheet.Put(en ? "NC" : "SLC", thetaUm, clause, "theta_um", mark);
    return limits;
}
