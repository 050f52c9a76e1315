#include "qm_rps/codes/concreteshear.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kEn = "EN 1992-1-1 6.2";
constexpr const char* kAci = "ACI 318 22.5";

bool Sound(const T_SHEAR_SECTION& s, CCodeSheet& sheet)
{
    sheet.Positive({{"bw", s.bw}, {"d", s.d}, {"Ag", s.Ag}, {"fc", s.fc}});
    sheet.NotNegative({{"tensionRatio", s.tensionRatio}, {"legArea", s.legArea}});
    if (s.legArea != 0.0) sheet.Positive({{"spacing", s.spacing}, {"fyw", s.fyw}});
    return sheet.Finite({{"axial", s.axial}});
}

/// 6.2.2, MPa and mm; stresses in Pa out.
double EnConcreteStress(const T_SHEAR_SECTION& s, const T_EN_SHEAR_OPTIONS& o, CCodeSheet& sheet)
{
    const double fck = s.fc / kPascalsPerMpa;
    const double k =
        sheet.Put("k", std::min(2.0, 1.0 + std::sqrt(0.2 / s.d)), kEn, "1 + sqrt(200/d) <= 2", S2);
    const double rho = sheet.Put("rho_l", std::min(0.02, s.tensionRatio), kEn, "<= 0.02", S2);
    const double axial =
        std::min(s.axial / s.Ag, 0.2 * o.alphaCc * s.fc / o.gammaC) / kPascalsPerMpa;
    sheet.Put("s_cp", axial * kPascalsPerMpa, kDimStress, kEn, "N/Ac <= 0.2 fcd", S2);
    const double formula = 0.18 / o.gammaC * k * std::cbrt(100.0 * rho * fck);
    const double least = 0.035 * std::pow(k, 1.5) * std::sqrt(fck);
    return std::max(0.0, std::max(formula, least) + 0.15 * axial) * kPascalsPerMpa;
}

} // namespace

std::optional<T_EN_SHEAR> EnShear(const T_SHEAR_SECTION& s, const T_EN_SHEAR_OPTIONS& options,
                                  CCodeSheet& sheet)
{
    sheet.Positive({{"gammaC", options.gammaC}, {"gammaS", options.gammaS}});
    sheet.Within("cotTheta", options.cotTheta, 1.0, 2.5);
    sheet.Within("alphaCc", options.alphaCc, 0.5, 1.0);
    if (!Sound(s, sheet)) return {};
    T_EN_SHEAR v;
    v.concrete =
        sheet.Put("VRd,c", EnConcreteStress(s, options, sheet) * s.bw * s.d, kDimForce, kEn,
                  "max(0.18/gc k (100 rho_l fck)^(1/3); 0.035 k^1.5 fck^0.5) bw d"
                  " + 0.15 s_cp bw d",
                  S2);
    v.VRd = v.concrete;
    if (!(s.legArea > 0.0)) return sheet.Sound() ? std::optional(v) : std::nullopt;

    const double z = 0.9 * s.d, cot = options.cotTheta;
    const double fcd = options.alphaCc * s.fc / options.gammaC,
                 ratio = std::max(0.0, s.axial) / s.Ag / fcd;
    const double chord = ratio <= 0.25  ? 1.0 + ratio
                         : ratio <= 0.5 ? 1.25
                                        : std::max(0.0, 2.5 * (1.0 - ratio));
    const double nu = 0.6 * (1.0 - s.fc / kPascalsPerMpa / 250.0);
    v.hoops = sheet.Put("VRd,s", s.legArea / s.spacing * z * s.fyw / options.gammaS * cot,
                        kDimForce, kEn, "Asw/s z fywd cot", S1);
    sheet.Put("a_cw", chord, kEn, "1 + s_cp/fcd; 1.25; 2.5 (1 - s_cp/fcd)", R);
    v.strut = sheet.Put("VRd,max", chord * s.bw * z * nu * fcd / (cot + 1.0 / cot), kDimForce, kEn,
                        "a_cw bw z 0.6 (1 - fck/250) fcd/(cot + tan)", S1);
    const double ties = options.addConcrete ? v.hoops + v.concrete : v.hoops;
    v.VRd =
        sheet.Put("VRd", std::min(ties, v.strut), kDimForce, kEn,
                  options.addConcrete ? "min(VRd,c + VRd,s; VRd,max)" : "min(VRd,s; VRd,max)", S1);
    return sheet.Sound() ? std::optional(v) : std::nullopt;
}

std::optional<T_ACI_SHEAR> AciShear(const T_SHEAR_SECTION& s, double lambda, CCodeSheet& sheet)
{
    sheet.Within("lambda", lambda, 0.5, 1.0);
    if (!Sound(s, sheet)) return {};
    const double root = std::min(RootPsi(s.fc), 100.0 * kPascalsPerPsi); // sqrt(f'c) <= 100 psi
    const double area = s.bw * s.d;
    const double axial = std::min(s.axial / (6.0 * s.Ag), 0.05 * s.fc);
    T_ACI_SHEAR v;
    const double least = std::max(0.75 * root, 50.0 * kPascalsPerPsi); // 9.6.3.4, Av,min fyt/(bw s)
    const bool hooped = s.legArea > 0.0;
    const bool enough = hooped && s.legArea * s.fyw >= least * s.bw * s.spacing;
    const double size = std::min(1.0, std::sqrt(2.0 / (1.0 + s.d / kMetresPerInch / 10.0)));
    const double stress =
        (enough ? 2.0 : 8.0 * size * std::cbrt(s.tensionRatio)) * lambda * root + axial;
    v.concrete =
        sheet.Put("Vc", std::clamp(stress, 0.0, 5.0 * lambda * root) * area, kDimForce, kAci,
                  enough ? "(2 lambda sqrt(f'c) + Nu/(6 Ag)) bw d <= 5 lambda sqrt(f'c) "
                           "bw d (psi)"
                         : "Av < Av,min: (8 l_s lambda rho^(1/3) sqrt(f'c) + Nu/(6 Ag)) "
                           "bw d <= 5 lambda sqrt(f'c) bw d (psi)",
                  R);
    if (hooped)
        v.hoops = sheet.Put("Vs", std::min(s.legArea * s.fyw * s.d / s.spacing, 8.0 * root * area),
                            kDimForce, kAci, "Av fyt d/s <= 8 sqrt(f'c) bw d (psi)", R);
    v.Vn = sheet.Put("Vn", v.concrete + v.hoops, kDimForce, kAci, "Vc + Vs", R);
    return sheet.Sound() ? std::optional(v) : std::nullopt;
}

std::optional<double> AciWallShear(double area, double fc, double fyt, double ratio,
                                   CCodeSheet& sheet)
{
    constexpr const char* kClause = "ACI 318 18.10.4";
    sheet.NotNegative({{"ratio", ratio}, {"fyt", fyt}});
    if (!sheet.Positive({{"area", area}, {"fc", fc}})) return {};
    const double root = RootPsi(fc);
    sheet.Put("rho_t", ratio, kClause, "horizontal bars", CODE_MARK::Computed);
    return sheet.Put("Vn", std::min(2.0 * root + ratio * fyt, 10.0 * root) * area, kDimForce,
                     kClause, "(2 sqrt(f'c) + rho_t fyt) Acv <= 10 sqrt(f'c) Acv (psi)", R);
}
