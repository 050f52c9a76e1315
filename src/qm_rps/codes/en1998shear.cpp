#include "qm_rps/codes/en1998shear.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kA12 = "EN 1998-3 (A.12)";
constexpr const char* kJoint = "Circolare 2019 [C8.7.2.11]-[C8.7.2.12]";

/// What the formulas of A.3.3 share.
struct T_ARGUMENTS {
    double area = 0.0;  // Ac = bw d
    double ratio = 0.0; // 100 rho_tot
    double span = 0.0;  // LV / h
    double axial = 0.0; // N >= 0
    double mu = 0.0;    // min(5; mu_pl)
    double gamma = 1.0;
};

/// Web crushing of walls (A.15), of short columns along the diagonal (A.16); 0: neither.
double StrutStrength(const T_EN_MEMBER& m, const T_ARGUMENTS& arg, CCodeSheet& sheet)
{
    const double z = m.d - m.dPrime;
    const double fc = m.fc / kPascalsPerMpa;
    const double nu = arg.axial / (arg.area * m.fc);
    if (m.wall)
        return sheet.Put(
            "VR,max",
            0.85 * (1.0 - 0.06 * arg.mu) / arg.gamma * (1.0 + 1.8 * std::min(0.15, nu)) *
                (1.0 + 0.25 * std::max(1.75, arg.ratio)) * (1.0 - 0.2 * std::min(2.0, arg.span)) *
                std::sqrt(fc) * kPascalsPerMpa * m.b * z,
            kDimForce, "EN 1998-3 (A.15)",
            "0.85 (1 - 0.06 min(5; mu_pl))/gamma_el (1 + 1.8 min(0.15; N/(Ac fc)))"
            " (1 + 0.25 max(1.75; 100 rho_tot)) (1 - 0.2 min(2; LV/h)) sqrt(fc) bw z",
            R);
    if (arg.span > 2.0) return 0.0;
    const double delta = std::atan(m.h / (2.0 * m.shearSpan));
    return sheet.Put("VR,max",
                     4.0 / 7.0 * (1.0 - 0.02 * arg.mu) / arg.gamma * (1.0 + 1.35 * nu) *
                         (1.0 + 0.45 * arg.ratio) * std::sqrt(std::min(40.0, fc)) * kPascalsPerMpa *
                         m.b * z * std::sin(2.0 * delta),
                     kDimForce, "EN 1998-3 (A.16)",
                     "4/7 (1 - 0.02 min(5; mu_pl))/gamma_el (1 + 1.35 N/(Ac fc))"
                     " (1 + 0.45 100 rho_tot) sqrt(min(40; fc)) bw z sin(2 delta)",
                     R);
}

} // namespace

std::optional<T_EN_CYCLIC_SHEAR> EnCyclicShear(const T_EN_MEMBER& m, double compressionDepth,
                                               double muPlastic,
                                               std::optional<double> tensionOfHoops,
                                               CCodeSheet& sheet)
{
    if (!SoundMember(m, sheet)) return {};
    sheet.Within("compressionDepth", compressionDepth, 0.0, m.h);
    sheet.NotNegative({{"tensionOfHoops", tensionOfHoops.value_or(0.0)}});
    if (!sheet.NotNegative({{"muPlastic", muPlastic}})) return {};
    const double area = m.b * m.d;
    const T_ARGUMENTS arg{area,
                          100.0 * (m.As + m.AsPrime + m.AsWeb) / area,
                          m.shearSpan / m.h,
                          std::max(0.0, m.axial),
                          std::min(5.0, muPlastic),
                          m.secondary ? 1.0 : 1.15};
    sheet.Put("gamma_el", arg.gamma, kA12, "1.15, secondary 1.0", S2);
    sheet.Put("100 rho_tot", arg.ratio, kA12, "100 (As1 + As2 + Asv)/(b d)", S2);
    sheet.Put("min(5; mu_pl)", arg.mu, kA12, "mu_theta - 1", S2);
    if (m.basis == EN_BASIS::Circolare2019)
        sheet.Warn("IDS_QM_CODE_WARN_MISPRINT",
                   {"Circolare 2019 [C8.7.2.8]", "min(0,5; mu_pl)", "min(5; mu_pl)"});

    T_EN_CYCLIC_SHEAR v;
    const double z = m.d - m.dPrime;
    v.hoops = tensionOfHoops ? *tensionOfHoops : m.hoopRatio * m.b * z * m.fyw;
    sheet.Put("Vw", v.hoops, kDimForce, kA12, "rho_w bw z fyw", S2);
    const double strutAxial =
        (m.h - compressionDepth) / (2.0 * m.shearSpan) * std::min(arg.axial, 0.55 * area * m.fc);
    const double concrete = 0.16 * std::max(0.5, arg.ratio) *
                            (1.0 - 0.16 * std::min(5.0, arg.span)) * RootMpa(m.fc) * area;
    v.strength = sheet.Put(
        "VR", (strutAxial + (1.0 - 0.05 * arg.mu) * (concrete + v.hoops)) / arg.gamma, kDimForce,
        kA12,
        "1/gamma_el {(h - x)/(2 LV) min(N; 0.55 Ac fc) + [1 - 0.05 min(5; mu_pl)] [0.16 max(0.5;"
        " 100 rho_tot) (1 - 0.16 min(5; LV/h)) sqrt(fc) Ac + Vw]}",
        S2);
    v.strut = StrutStrength(m, arg, sheet);
    if (v.strut > 0.0 && v.strut < v.strength)
        v.strength = sheet.Put("VR", v.strut, kDimForce, "EN 1998-3 A.3.3.1", "min(VR; VR,max)", R);
    return sheet.Sound() ? std::optional(v) : std::nullopt;
}

std::optional<double> CircularHoopShear(double legArea, double spacing, double fyw, double diameter,
                                        double cover, CCodeSheet& sheet)
{
    sheet.Positive({{"legArea", legArea}, {"spacing", spacing}, {"fyw", fyw}});
    sheet.Positive({{"diameter", diameter}});
    if (sheet.Sound()) sheet.Within("cover", cover, 0.0, diameter / 2.0);
    if (!sheet.Sound()) return {};
    return sheet.Put("Vw",
                     std::numbers::pi / 2.0 * legArea / spacing * fyw * (diameter - 2.0 * cover),
                     kDimForce, "Circolare 2019 C8.7.2.3.5", "pi/2 Asx/s fyw (D - 2c)", S1);
}

std::optional<T_JOINT_STRESS> CircolareJoint(double axial, double shear, double area, double fc,
                                             CCodeSheet& sheet)
{
    sheet.Positive({{"area", area}, {"fc", fc}});
    if (!sheet.Finite({{"axial", axial}, {"shear", shear}})) return {};
    const double half = axial / (2.0 * area), tau = shear / area;
    const double radius = std::sqrt(half * half + tau * tau);
    T_JOINT_STRESS s;
    s.tension = sheet.Put("s_jt", std::fabs(half - radius), kDimStress, kJoint,
                          "|N/2Aj - sqrt((N/2Aj)^2 + (Vj/Aj)^2)|", S1);
    s.compression = sheet.Put("s_jc", half + radius, kDimStress, kJoint,
                              "N/2Aj + sqrt((N/2Aj)^2 + (Vj/Aj)^2)", S1);
    s.tensionLimit =
        sheet.Put("s_jt,max", 0.3 * RootMpa(fc), kDimStress, kJoint, "0.3 sqrt(fc)", S1);
    s.compressionLimit = sheet.Put("s_jc,max", 0.5 * fc, kDimStress, kJoint, "0.5 fc", S1);
    return s;
}
