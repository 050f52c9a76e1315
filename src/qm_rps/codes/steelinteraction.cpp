#include "qm_rps/codes/steelinteraction.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kShear = "EN 1993-1-1 6.2.6";
constexpr const char* kCombined = "EN 1993-1-1 6.2.9.1";
constexpr const char* kAisc = "AISC 360 H1-1";

// AISC 360 Table B4.1: limits of b/t over sqrt(E/Fy), of tubes D/t over E/Fy. Flanges welded to a
// web: 0.64 sqrt(kc) with the least kc, 0.35. Of a box either pair of plates may be the flanges.
struct T_SLENDER_ROW {
    STEEL_SHAPE shape;
    double slenderFlange, slenderWeb; // uniform compression
    double compactFlange, compactWeb; // bending
};
// Of a channel b is the whole flange, B4.1.
constexpr std::array<T_SLENDER_ROW, 5> kSlender{{
    {STEEL_SHAPE::RolledI, 0.56, 1.49, 0.38, 3.76},
    {STEEL_SHAPE::WeldedI, 0.378, 1.49, 0.38, 3.76},
    {STEEL_SHAPE::RectangularTube, 1.40, 1.40, 1.12, 1.12},
    {STEEL_SHAPE::CircularTube, 0.11, 0.11, 0.07, 0.07},
    {STEEL_SHAPE::Channel, 0.56, 1.49, 0.38, 3.76},
}};

bool IsI(STEEL_SHAPE shape)
{
    return shape == STEEL_SHAPE::RolledI || shape == STEEL_SHAPE::WeldedI;
}

bool Sound(const T_STEEL_SHAPE& s, CCodeSheet& sheet)
{
    sheet.Positive({{"A", s.A}});
    if (s.shape == STEEL_SHAPE::CircularTube) return sheet.Sound();
    sheet.Positive({{"h", s.h}, {"b", s.b}, {"tf", s.tf}, {"tw", s.tw}});
    sheet.NotNegative({{"r", s.r}});
    if (sheet.Sound()) sheet.Within("tf", s.tf, 0.0, s.h / 2.0);
    if (sheet.Sound()) sheet.Within("tw", s.tw, 0.0, s.b);
    return sheet.Sound();
}

/// a of 6.2.9.1(5): of the webs in the area; of the flanges for the other axis of a tube.
double WebShare(const T_STEEL_SHAPE& s, bool aboutY)
{
    const double flanges = aboutY || IsI(s.shape) ? 2.0 * s.b * s.tf : 2.0 * s.h * s.tw;
    return std::clamp((s.A - flanges) / s.A, 0.0, 0.5);
}

/// Moments and exponents at n = N / Npl < 1.
T_EN_INTERACTION Reduced(const T_STEEL_SHAPE& s, const T_STEEL_PLASTIC_STRENGTH& r, double n,
                         CCodeSheet& sheet)
{
    T_EN_INTERACTION e;
    const auto moments = [&](double y, double z, const char* text, CODE_MARK mark) {
        e.MNy = sheet.Put("MN,y", y, kDimMoment, kCombined, text, mark);
        e.MNz = sheet.Put("MN,z", z, kDimMoment, kCombined, text, mark);
    };
    if (s.shape == STEEL_SHAPE::CircularTube) {
        const double left = 1.0 - std::pow(n, 1.7);
        moments(r.Mply * left, r.Mplz * left, "Mpl (1 - n^1.7)", R);
        e.alpha = e.beta = 2.0;
        return e;
    }
    const double a = sheet.Put("a", WebShare(s, true), kCombined, "(A - 2 b tf)/A <= 0.5", S2);
    const double y = std::min(r.Mply, r.Mply * (1.0 - n) / (1.0 - 0.5 * a));
    if (s.shape == STEEL_SHAPE::RectangularTube) {
        const double af = WebShare(s, false);
        moments(y, std::min(r.Mplz, r.Mplz * (1.0 - n) / (1.0 - 0.5 * af)),
                "Mpl (1 - n)/(1 - 0.5 a) <= Mpl", R);
        e.alpha = e.beta = n * n >= 1.0 / 1.13 ? 6.0 : std::min(6.0, 1.66 / (1.0 - 1.13 * n * n));
        return e;
    }
    const double beyond = std::max(0.0, (n - a) / (1.0 - a));
    moments(y, r.Mplz * (1.0 - beyond * beyond),
            "y: Mpl (1 - n)/(1 - 0.5 a) <= Mpl; z: Mpl, n <= a; Mpl [1 - ((n - a)/(1 - a))^2]", S2);
    e.alpha = 2.0;
    e.beta = std::max(1.0, 5.0 * n);
    return e;
}

/// EN 1993-1-1 (6.2).
T_EN_INTERACTION Summed(const T_STEEL_PLASTIC_STRENGTH& r, const T_STEEL_FORCES& f, double n,
                        CCodeSheet& sheet)
{
    T_EN_INTERACTION e;
    e.MNy = (1.0 - n) * r.Mply;
    e.MNz = (1.0 - n) * r.Mplz;
    e.ratio = sheet.Put("ratio", n + std::fabs(f.My) / r.Mply + std::fabs(f.Mz) / r.Mplz,
                        "EN 1993-1-1 6.2.1(7)", "N/Npl + My/Mpl,y + Mz/Mpl,z, (6.2)", R);
    return e;
}

bool SoundForces(const T_STEEL_PLASTIC_STRENGTH& r, const T_STEEL_FORCES& f, CCodeSheet& sheet)
{
    sheet.Positive({{"Npl", r.Npl}, {"Mply", r.Mply}, {"Mplz", r.Mplz}});
    return sheet.Finite({{"N", f.N}, {"My", f.My}, {"Mz", f.Mz}});
}

} // namespace

std::optional<double> EnShearArea(const T_STEEL_SHAPE& s, bool alongDepth, CCodeSheet& sheet)
{
    if (!Sound(s, sheet)) return {};
    const double web = (s.h - 2.0 * s.tf) * s.tw;
    double area = 0.0;
    const char* text = "";
    if (s.shape == STEEL_SHAPE::CircularTube) {
        area = 2.0 * s.A / std::numbers::pi;
        text = "2 A/pi";
    } else if (s.shape == STEEL_SHAPE::RectangularTube) {
        area = s.A * (alongDepth ? s.h : s.b) / (s.b + s.h);
        text = "A h/(b + h)";
    } else if (!alongDepth) {
        area = s.A - web;
        text = "A - hw tw";
    } else if (s.shape == STEEL_SHAPE::Channel && s.r > 0.0) {
        area = s.A - 2.0 * s.b * s.tf + (s.tw + s.r) * s.tf;
        text = "A - 2 b tf + (tw + r) tf";
    } else if (s.shape == STEEL_SHAPE::RolledI) {
        area = std::max(web, s.A - 2.0 * s.b * s.tf + (s.tw + 2.0 * s.r) * s.tf);
        text = "A - 2 b tf + (tw + 2r) tf >= hw tw";
    } else {
        area = web;
        text = "hw tw";
    }
    if (!sheet.Positive({{"A", area}})) return {};
    return sheet.Put("Av", area, T_DIM{0, 2}, kShear, text, R);
}

std::optional<double> EnPlasticShear(double area, double fy, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"area", area}, {"fy", fy}})) return {};
    return sheet.Put("Vpl", area * fy / std::numbers::sqrt3, kDimForce, kShear, "Av fy/sqrt(3)", R);
}

std::optional<double> EnShearReduction(double shear, double plasticShear, CCodeSheet& sheet)
{
    sheet.Positive({{"plasticShear", plasticShear}});
    if (!sheet.Finite({{"shear", shear}})) return {};
    const double ratio = std::fabs(shear) / plasticShear;
    if (!sheet.Within("shear", ratio, 0.0, 1.0)) return {};
    const double over = std::max(0.0, 2.0 * ratio - 1.0);
    return sheet.Put("rho", over * over, "EN 1993-1-1 6.2.8", "(2 V/Vpl - 1)^2, V > Vpl/2", R);
}

std::optional<T_EN_INTERACTION> EnAxialBending(const T_STEEL_SHAPE& s,
                                               const T_STEEL_PLASTIC_STRENGTH& r,
                                               const T_STEEL_FORCES& f, CCodeSheet& sheet)
{
    if (!Sound(s, sheet) || !SoundForces(r, f, sheet)) return {};
    const double n = sheet.Put("n", std::fabs(f.N) / r.Npl, kCombined, "N/Npl", S2);
    if (!sheet.Within("N", n, 0.0, 1.0 - 1e-9)) return {};
    if (s.shape == STEEL_SHAPE::Channel) {
        const T_EN_INTERACTION sum = Summed(r, f, n, sheet);
        return sheet.Sound() ? std::optional(sum) : std::nullopt;
    }
    T_EN_INTERACTION e = Reduced(s, r, n, sheet);
    sheet.Put("alpha", e.alpha, kCombined, "I: 2; CHS: 2; RHS: 1.66/(1 - 1.13 n^2) <= 6", S2);
    sheet.Put("beta", e.beta, kCombined, "I: 5 n >= 1; CHS: 2; RHS: alpha", S2);
    constexpr double kNothing = 1e-9;
    const double y = std::fabs(f.My) / e.MNy, z = std::fabs(f.Mz) / e.MNz;
    const bool one = std::min(y, z) <= kNothing;
    e.ratio = sheet.Put(
        "ratio", one ? std::max(y, z) : std::pow(y, e.alpha) + std::pow(z, e.beta), kCombined,
        one ? "M/MN about one axis, (2)" : "(My/MN,y)^alpha + (Mz/MN,z)^beta, (6)", S2);
    return sheet.Sound() ? std::optional(e) : std::nullopt;
}

std::optional<double> EnElasticBending(const T_STEEL_PLASTIC_STRENGTH& r, const T_STEEL_FORCES& f,
                                       CCodeSheet& sheet)
{
    if (!SoundForces(r, f, sheet)) return {};
    return sheet.Put("ratio",
                     std::fabs(f.N) / r.Npl + std::fabs(f.My) / r.Mply + std::fabs(f.Mz) / r.Mplz,
                     "EN 1993-1-1 6.2.9.2", "N/(A fy) + My/(Wel,y fy) + Mz/(Wel,z fy)", R);
}

std::optional<double> AiscInteraction(const T_STEEL_PLASTIC_STRENGTH& available,
                                      const T_STEEL_FORCES& f, CCodeSheet& sheet)
{
    if (!SoundForces(available, f, sheet)) return {};
    const double p = sheet.Put("Pr/Pc", std::fabs(f.N) / available.Npl, kAisc, "", S1);
    const double m = std::fabs(f.My) / available.Mply + std::fabs(f.Mz) / available.Mplz;
    return sheet.Put("ratio", p >= 0.2 ? p + 8.0 / 9.0 * m : p / 2.0 + m, kAisc,
                     "Pr/Pc >= 0.2: Pr/Pc + 8/9 (Mrx/Mcx + Mry/Mcy); Pr/2Pc + (...)", S1);
}

std::optional<double> AiscShear(double d, double h, double tw, double Fy, double E,
                                CCodeSheet& sheet)
{
    constexpr const char* kClause = "AISC 360 G2.1";
    constexpr double kBuckling = 5.34; // kv of webs without stiffeners
    if (!sheet.Positive({{"d", d}, {"h", h}, {"tw", tw}, {"Fy", Fy}, {"E", E}})) return {};
    const double slenderness = h / tw;
    const double limit = slenderness <= 2.24 * std::sqrt(E / Fy)
                             ? slenderness
                             : 1.10 * std::sqrt(kBuckling * E / Fy);
    const double cv = sheet.Put("Cv1", std::min(1.0, limit / slenderness), kClause,
                                "1; h/tw > 1.10 sqrt(kv E/Fy): 1.10 sqrt(kv E/Fy)/(h/tw)", R);
    return sheet.Put("Vn", 0.6 * Fy * d * tw * cv, kDimForce, kClause, "0.6 Fy Aw Cv1", R);
}

std::optional<double> AiscShapeShear(const T_STEEL_SHAPE& s, bool alongDepth, double Fy, double E,
                                     CCodeSheet& sheet)
{
    if (!Sound(s, sheet)) return {};
    if (!IsI(s.shape) && s.shape != STEEL_SHAPE::Channel) {
        sheet.Refuse(CODE_REASON::NoRow, "shape", "AISC 360 G2.1 (I, channel)");
        return {};
    }
    if (alongDepth) return AiscShear(s.h, s.h - 2.0 * (s.tf + s.r), s.tw, Fy, E, sheet);
    return sheet.Put("Vn", 0.6 * Fy * 2.0 * s.b * s.tf, kDimForce, "AISC 360 G6", "0.6 Fy 2 bf tf",
                     R);
}

T_AISC_SLENDER AiscSlender(STEEL_SHAPE shape)
{
    const auto row = std::ranges::find(kSlender, shape, &T_SLENDER_ROW::shape);
    return {row->slenderFlange, row->slenderWeb};
}

bool AiscPlastic(const T_STEEL_SHAPE& s, double Fy, double E, bool compressed, bool bent,
                 CCodeSheet& sheet)
{
    constexpr const char* kTable = "AISC 360 Table B4.1";
    if (!Sound(s, sheet) || !sheet.Positive({{"Fy", Fy}, {"E", E}})) return false;
    const auto row = std::ranges::find(kSlender, s.shape, &T_SLENDER_ROW::shape);
    const bool tube = s.shape == STEEL_SHAPE::CircularTube;
    const double unit = tube ? E / Fy : std::sqrt(E / Fy);
    const auto judge = [&](const char* symbol, double ratio, double slender, double compact) {
        const double limit = unit * (bent && compressed ? std::min(slender, compact)
                                     : bent             ? compact
                                                        : slender);
        sheet.Put(symbol, ratio, kTable, "<= " + CodeNumber(limit), R);
        return sheet.Within(symbol, ratio, 0.0, limit);
    };
    if (tube) return judge("D/t", s.h / s.tw, row->slenderFlange, row->compactFlange);
    const bool box = s.shape == STEEL_SHAPE::RectangularTube;
    const double half = s.shape == STEEL_SHAPE::Channel ? s.b : 0.5 * s.b;
    const double flange = box ? (s.b - 2.0 * (s.tw + s.r)) / s.tf : half / s.tf;
    const double web = (s.h - 2.0 * (s.tf + s.r)) / s.tw;
    return judge("b/t (flange)", flange, row->slenderFlange, row->compactFlange) &&
           judge("h/t (web)", web, row->slenderWeb, row->compactWeb);
}

std::optional<double> WideFlangeSurface(double p, double my, double mz, CCodeSheet& sheet)
{
    if (!sheet.Finite({{"p", p}, {"my", my}, {"mz", mz}})) return {};
    // Under n = 0.5 an I keeps 0.58 of its major and 0.85 of its minor plastic moment (fibres): the
    // squared term, 0.63, is that of the major axis.
    const double p2 = p * p, y2 = my * my, z2 = mz * mz;
    return sheet.Put(
        "surface", p2 + y2 + z2 * z2 + 3.5 * p2 * y2 + 3.0 * p2 * p2 * p2 * z2 + 4.5 * y2 * y2 * z2,
        "McGuire, Gallagher, Ziemian 10.18",
        "p^2 + my^2 + mz^4 + 3.5 p^2 my^2 + 3 p^6 mz^2 + 4.5 my^4 mz^2, my: major axis", R);
}
