#include "qm_rps/codes/confinement.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;
constexpr const char* kMander = "Mander, Priestley, Park 1988";
constexpr const char* kNtc = "NTC 2018 [4.1.8]-[4.1.12] (EN 1992-1-1 3.1.9)";
constexpr const char* kA2 = "EN 1998-3 (A.2)";
constexpr const char* kA32 = "EN 1998-3 A.3.2.2(8)";
constexpr double kMaxSpacing = 10.0;     // m; hoops farther apart are a slip of the pen
constexpr double kPlainUltimate = 0.004; // crushing strain of cover, and of a core without hoops

/// The core's gaps must lie on its faces: the sum of squares is what counts, and a missing face
/// would make the core too good.
double SumOfSquares(const std::vector<double>& gaps, double perimeter, CCodeSheet& sheet)
{
    if (gaps.size() < 4) {
        sheet.Refuse(CODE_REASON::Missing, "gaps", ">= 4");
        return 0.0;
    }
    double length = 0.0, squares = 0.0;
    for (const double gap : gaps) {
        if (!sheet.NotNegative({{"gaps", gap}})) return 0.0;
        length += gap;
        squares += gap * gap;
    }
    sheet.Within("gaps", length, 0.0, perimeter * (1.0 + 1e-9));
    return sheet.Put("sum bi^2", squares, T_DIM{0, 2}, "", "gaps", K);
}

/// 1 - s / (2 b), not below 0: hoops farther apart than twice the core don't confine.
double Arch(double spacing, double width)
{
    return std::max(0.0, 1.0 - spacing / (2.0 * width));
}

bool Sound(const T_RECT_CORE& core, const T_CONFINED_MATERIAL& m, CCodeSheet& sheet)
{
    sheet.Positive({{"bx", core.bx}, {"by", core.by}, {"hoopDiameter", core.hoopDiameter}});
    sheet.Positive({{"spacing", core.spacing}, {"areaX", core.areaX}, {"areaY", core.areaY}});
    sheet.Positive({{"fc", m.fc}, {"fyh", m.fyh}});
    if (sheet.Sound()) sheet.Within("spacing", core.spacing, core.hoopDiameter, kMaxSpacing);
    return sheet.Within("longRatio", core.longRatio, 0.0, 0.5);
}

bool Sound(const T_ROUND_CORE& core, const T_CONFINED_MATERIAL& m, CCodeSheet& sheet)
{
    sheet.Positive({{"diameter", core.diameter}, {"hoopDiameter", core.hoopDiameter}});
    sheet.Positive({{"spacing", core.spacing}, {"fc", m.fc}, {"fyh", m.fyh}});
    if (sheet.Sound()) sheet.Within("spacing", core.spacing, core.hoopDiameter, kMaxSpacing);
    return sheet.Within("longRatio", core.longRatio, 0.0, 0.5);
}

double HoopArea(double diameter)
{
    return std::numbers::pi * diameter * diameter / 4.0;
}

/// Ultimate strain by the energy of the hoops (Priestley), with their volume ratio.
void PutManderUltimate(double volumeRatio, const T_CONFINED_MATERIAL& m, T_CONFINED& c,
                       CCodeSheet& sheet)
{
    c.ultimateStrain =
        sheet.Put("eps_cu", kPlainUltimate + 1.4 * volumeRatio * m.fyh * m.hoopStrain / c.strength,
                  "Priestley, Seible, Calvi 1996", "0.004 + 1.4 rho_s fyh eps_su/fcc", S2);
}

} // namespace

std::optional<T_CONFINED> ManderConfined(double pressure, const T_CONFINED_MATERIAL& m,
                                         CCodeSheet& sheet)
{
    sheet.NotNegative({{"pressure", pressure}, {"hoopStrain", m.hoopStrain}});
    if (!sheet.Positive({{"fc", m.fc}, {"peakStrain", m.peakStrain}})) return {};
    const double r = pressure / m.fc;
    T_CONFINED c;
    c.pressure = pressure;
    c.strength =
        sheet.Put("fcc", m.fc * (-1.254 + 2.254 * std::sqrt(1.0 + 7.94 * r) - 2.0 * r), kDimStress,
                  kMander, "fco (-1.254 + 2.254 sqrt(1 + 7.94 fl'/fco) - 2 fl'/fco)", S2);
    c.peakStrain = sheet.Put("eps_cc", m.peakStrain * (1.0 + 5.0 * (c.strength / m.fc - 1.0)),
                             kMander, "eps_co (1 + 5 (fcc/fco - 1))", S2);
    c.ultimateStrain = kPlainUltimate;
    return c;
}

std::optional<T_CONFINED> ManderRectangular(const T_RECT_CORE& core, const T_CONFINED_MATERIAL& m,
                                            CCodeSheet& sheet)
{
    if (!Sound(core, m, sheet)) return {};
    const double squares = SumOfSquares(core.gaps, 2.0 * (core.bx + core.by), sheet);
    if (!sheet.Sound()) return {};
    const double area = core.bx * core.by;
    const double clear = core.spacing - core.hoopDiameter;
    const double ke =
        sheet.Put("ke",
                  std::max(0.0, 1.0 - squares / (6.0 * area)) * Arch(clear, core.bx) *
                      Arch(clear, core.by) / (1.0 - core.longRatio),
                  kMander, "(1 - sum w'^2/(6 bc dc)) (1 - s'/2bc) (1 - s'/2dc)/(1 - rho_cc)", S2);
    const double ratioX = core.areaX / (core.spacing * core.by);
    const double ratioY = core.areaY / (core.spacing * core.bx);
    const double x =
        sheet.Put("flx", ke * ratioX * m.fyh, kDimStress, kMander, "ke Asx/(s dc) fyh", S2);
    const double y =
        sheet.Put("fly", ke * ratioY * m.fyh, kDimStress, kMander, "ke Asy/(s bc) fyh", S2);
    if (std::fabs(x - y) > 0.01 * std::max(x, y))
        sheet.WarnConflict(kMander, "fl' = (flx + fly)/2", "fcc(flx, fly); sqrt(flx fly)");
    std::optional<T_CONFINED> c = ManderConfined((x + y) / 2.0, m, sheet);
    if (!c) return {};
    c->effectiveness = ke;
    PutManderUltimate(ratioX + ratioY, m, *c, sheet);
    return sheet.Sound() ? c : std::nullopt;
}

std::optional<T_CONFINED> ManderCircular(const T_ROUND_CORE& core, const T_CONFINED_MATERIAL& m,
                                         CCodeSheet& sheet)
{
    if (!Sound(core, m, sheet)) return {};
    const double arch = Arch(core.spacing - core.hoopDiameter, core.diameter);
    const double ke = sheet.Put("ke", (core.spiral ? arch : arch * arch) / (1.0 - core.longRatio),
                                kMander, "(1 - s'/2ds)^n/(1 - rho_cc), n = 2; spiral: 1", R);
    const double ratio =
        sheet.Put("rho_s", 4.0 * HoopArea(core.hoopDiameter) / (core.diameter * core.spacing),
                  kMander, "4 Asp/(ds s)", K);
    const double pressure =
        sheet.Put("fl'", 0.5 * ke * ratio * m.fyh, kDimStress, kMander, "1/2 ke rho_s fyh", R);
    std::optional<T_CONFINED> c = ManderConfined(pressure, m, sheet);
    if (!c) return {};
    c->effectiveness = ke;
    PutManderUltimate(ratio, m, *c, sheet);
    return sheet.Sound() ? c : std::nullopt;
}

std::optional<T_CONFINED> NtcConfined(double pressure, double fck, CCodeSheet& sheet)
{
    sheet.NotNegative({{"pressure", pressure}});
    if (!sheet.Positive({{"fck", fck}})) return {};
    const double r = pressure / fck;
    T_CONFINED c;
    c.pressure = pressure;
    c.strength = sheet.Put("fck,c", fck * (r <= 0.05 ? 1.0 + 5.0 * r : 1.125 + 2.5 * r), kDimStress,
                           kNtc, "fck (1 + 5 s2/fck); s2 > 0.05 fck: fck (1.125 + 2.5 s2/fck)", S1);
    const double gain = c.strength / fck;
    c.peakStrain = sheet.Put("eps_c2,c", 0.002 * gain * gain, kNtc, "0.002 (fck,c/fck)^2", S1);
    c.ultimateStrain = sheet.Put("eps_cu2,c", 0.0035 + 0.2 * r, kNtc, "0.0035 + 0.2 s2/fck", S1);
    return c;
}

std::optional<T_CONFINED> NtcRectangular(const T_RECT_CORE& core, const T_CONFINED_MATERIAL& m,
                                         CCodeSheet& sheet)
{
    if (!Sound(core, m, sheet)) return {};
    const double squares = SumOfSquares(core.gaps, 2.0 * (core.bx + core.by), sheet);
    if (!sheet.Sound()) return {};
    const double inPlan = std::max(0.0, 1.0 - squares / (6.0 * core.bx * core.by));
    const double along = Arch(core.spacing, core.bx) * Arch(core.spacing, core.by);
    sheet.Put("alpha_n", inPlan, kNtc, "1 - sum bi^2/(6 bx by)", S1);
    sheet.Put("alpha_s", along, kNtc, "(1 - s/2bx) (1 - s/2by)", S1);
    const double slx = sheet.Put("sl,x", core.areaX * m.fyh / (core.by * core.spacing), kDimStress,
                                 kNtc, "Ast,x fyk/(by s)", S1);
    const double sly = sheet.Put("sl,y", core.areaY * m.fyh / (core.bx * core.spacing), kDimStress,
                                 kNtc, "Ast,y fyk/(bx s)", S1);
    const double pressure = sheet.Put("s2", inPlan * along * std::sqrt(slx * sly), kDimStress, kNtc,
                                      "alpha_n alpha_s sqrt(sl,x sl,y)", S1);
    std::optional<T_CONFINED> c = NtcConfined(pressure, m.fc, sheet);
    if (c) c->effectiveness = inPlan * along;
    return sheet.Sound() ? c : std::nullopt;
}

std::optional<T_CONFINED> NtcCircular(const T_ROUND_CORE& core, const T_CONFINED_MATERIAL& m,
                                      CCodeSheet& sheet)
{
    if (!Sound(core, m, sheet)) return {};
    const double arch = Arch(core.spacing, core.diameter);
    const double alpha = sheet.Put("alpha", core.spiral ? arch : arch * arch, kNtc,
                                   "(1 - s/2D0)^n, n = 2; spiral: 1", R);
    const double sl = 2.0 * HoopArea(core.hoopDiameter) * m.fyh / (core.diameter * core.spacing);
    const double pressure =
        sheet.Put("s2", alpha * sl, kDimStress, kNtc, "alpha 2 Ast fyk/(D0 s)", R);
    std::optional<T_CONFINED> c = NtcConfined(pressure, m.fc, sheet);
    if (c) c->effectiveness = alpha;
    return sheet.Sound() ? c : std::nullopt;
}

std::optional<double> HoopEffectiveness(const T_HOOP_GRIP& grip, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"bo", grip.bo}, {"ho", grip.ho}, {"spacing", grip.spacing}})) return {};
    if (!grip.hooks135)
        return sheet.Put("alpha", 0.0, "Circolare 2019 C8.7.2.3.2", "hooks: not 135 degrees", S1);
    // Where the core ends at the neutral axis (ho less than the full core) the gaps go all around
    // the whole section, so they are not held against the perimeter.
    const double squares = SumOfSquares(grip.gaps, std::numeric_limits<double>::infinity(), sheet);
    if (!sheet.Sound()) return {};
    return sheet.Put("alpha",
                     Arch(grip.spacing, grip.bo) * Arch(grip.spacing, grip.ho) *
                         std::max(0.0, 1.0 - squares / (6.0 * grip.ho * grip.bo)),
                     kA2, "(1 - sh/2bo) (1 - sh/2ho) (1 - sum bi^2/(6 ho bo))", S2);
}

std::optional<T_CONFINED> Annex3Confined(double load, double fc, CCodeSheet& sheet)
{
    sheet.NotNegative({{"load", load}});
    if (!sheet.Positive({{"fc", fc}})) return {};
    const double r = load / fc;
    T_CONFINED c;
    c.pressure = load;
    c.strength = sheet.Put("fcc", fc * (1.0 + 3.7 * std::pow(r, 0.86)), kDimStress, kA32,
                           "fc (1 + 3.7 (alpha rho_sx fyw/fc)^0.86)", R);
    c.peakStrain = sheet.Put("eps_cc", 0.002 * (1.0 + 5.0 * (c.strength / fc - 1.0)), kA32,
                             "0.002 (1 + 5 (fcc/fc - 1))", R);
    c.ultimateStrain = sheet.Put("eps_cu", 0.004 + 0.5 * load / c.strength, kA32,
                                 "0.004 + 0.5 alpha rho_sx fyw/fcc", R);
    return c;
}
