#include "qm_rps/codes/slenderplates.h"

#include "qm_rps/codes/en1993class.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr auto R = CODE_MARK::Recalled;

/// A kind of plate under uniform compression, psi = 1.
struct T_PLATE_KIND {
    double buckling; // k_sigma
    double loss;     // rho = (lambda_p - loss) / lambda_p^2
    double class3;   // c/t over eps up to which all of it counts
};
constexpr T_PLATE_KIND kInternal{4.0, 0.22, 42.0};   // Table 4.1, (4.2)
constexpr T_PLATE_KIND kOutstand{0.43, 0.188, 14.0}; // Table 4.2, (4.3)

/// Imperfection of a plate, AISC 360 Table E7.1.
struct T_AISC_PLATE {
    double c1, c2;
};

double Epsilon(double fy)
{
    return std::sqrt(235.0 * kPascalsPerMpa / fy);
}

/// The share of its width that counts.
double Rho(const T_PLATE_KIND& kind, double width, double thickness, double eps, CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1993-1-5 4.4";
    const double ratio = width / thickness;
    if (ratio <= kind.class3 * eps) return 1.0;
    const double slender =
        sheet.Put("lambda_p", ratio / (28.4 * eps * std::sqrt(kind.buckling)), kClause,
                  "c/t/(28.4 eps sqrt(k)), k = " + CodeNumber(kind.buckling), R);
    return sheet.Put("rho", std::min(1.0, (slender - kind.loss) / (slender * slender)), kClause,
                     "(l - " + CodeNumber(kind.loss) + ")/l^2 <= 1", R);
}

} // namespace

std::optional<double> EnCompressedArea(const T_STEEL_SHAPE& s, double fy, CCodeSheet& sheet)
{
    CCodeSheet classes;
    const auto number = En1993ClassCompressed(s, fy, classes);
    if (!number) return {};
    if (*number < 4) return s.A;
    const bool box = s.shape == STEEL_SHAPE::RectangularTube;
    if (s.shape == STEEL_SHAPE::CircularTube) {
        sheet.Refuse(CODE_REASON::NoRow, "class 4", "EN 1993-1-6 (CHS)");
        return {};
    }
    const double eps = Epsilon(fy), web = s.h - 2.0 * (s.tf + s.r);
    const double flange =
        box ? s.b - 2.0 * (s.tw + s.r) : (s.b - s.tw - 2.0 * s.r) / 2.0; // I: four of them
    const double flanges = (box ? 2.0 : 4.0) * flange * s.tf, webs = (box ? 2.0 : 1.0) * web * s.tw;
    const double lost =
        flanges * (1.0 - Rho(box ? kInternal : kOutstand, flange, s.tf, eps, sheet)) +
        webs * (1.0 - Rho(kInternal, web, s.tw, eps, sheet));
    return sheet.Put("Aeff", s.A - lost, T_DIM{0, 2}, "EN 1993-1-5 4.4",
                     "A - sum (1 - rho) c t, class 4 in compression", R);
}

std::optional<double> EnShearStrength(const T_STEEL_SHAPE& s, bool alongDepth, double fy,
                                      CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1993-1-5 5.3";
    constexpr double kStocky = 72.0, kPost = 0.83; // hw/tw over eps; chi_w lambda_w of Table 5.1
    const auto area = EnShearArea(s, alongDepth, sheet);
    const auto plastic = area ? EnPlasticShear(*area, fy, sheet) : std::nullopt;
    if (!plastic) return {};
    const bool box = s.shape == STEEL_SHAPE::RectangularTube;
    // Across its web an I is sheared in its flanges, which are stocky.
    if (s.shape == STEEL_SHAPE::CircularTube || (!box && !alongDepth)) return plastic;
    const double eps = Epsilon(fy);
    const double depth = alongDepth ? s.h - 2.0 * s.tf : s.b - 2.0 * s.tw;
    const double thickness = alongDepth ? s.tw : s.tf;
    const double ratio = depth / thickness;
    if (ratio <= kStocky * eps) return plastic;
    const double slender =
        sheet.Put("lambda_w", ratio / (86.4 * eps), kClause, "hw/(86.4 t eps), hw/t > 72 eps", R);
    const double chi = sheet.Put("chi_w", std::min(1.0, kPost / slender), "EN 1993-1-5 Table 5.1",
                                 "0.83/lambda_w <= 1, no rigid end post", R);
    const double webs = (box ? 2.0 : 1.0) * depth * thickness;
    const double buckled = sheet.Put("Vbw", chi * webs * fy / std::numbers::sqrt3, kDimForce,
                                     "EN 1993-1-5 5.2", "chi_w hw t fy/sqrt(3)", R);
    return std::min(*plastic, buckled);
}

std::optional<double> AiscCompressedArea(const T_STEEL_SHAPE& s, double Fcr, double Fy, double E,
                                         CCodeSheet& sheet)
{
    constexpr const char* kClause = "AISC 360 E7";
    if (!sheet.Positive({{"Fcr", Fcr}, {"Fy", Fy}, {"E", E}})) return {};
    const T_AISC_SLENDER limits = AiscSlender(s.shape);
    if (s.shape == STEEL_SHAPE::CircularTube) {
        constexpr double kMost = 0.45; // E7.2
        const double ratio = s.h / s.tw, unit = E / Fy;
        if (!sheet.Within("D/t", ratio, 0.0, kMost * unit)) return {};
        if (ratio <= limits.flange * unit) return s.A;
        return sheet.Put("Ae", (0.038 * unit / ratio + 2.0 / 3.0) * s.A, T_DIM{0, 2}, kClause,
                         "(0.038 E/(Fy D/t) + 2/3) Ag, D/t > 0.11 E/Fy", R);
    }
    const bool box = s.shape == STEEL_SHAPE::RectangularTube;
    // Table E7.1: walls of tubes; other plates on two edges; on one edge.
    constexpr T_AISC_PLATE kWall{0.20, 1.38}, kStiffened{0.18, 1.31}, kOther{0.22, 1.49};
    const double root = std::sqrt(E / Fy);
    const auto lost = [&](const T_AISC_PLATE& c, double width, double thickness, double limit) {
        const double ratio = width / thickness;
        if (ratio <= limit * root * std::sqrt(Fy / Fcr)) return 0.0;
        const double elastic = std::pow(c.c2 * limit * root / ratio, 2.0) * Fy;
        const double share = std::sqrt(elastic / Fcr);
        return width * (1.0 - std::min(1.0, sheet.Put("be/b", (1.0 - c.c1 * share) * share, kClause,
                                                      "(1 - c1 sqrt(Fel/Fcr)) sqrt(Fel/Fcr)", R)));
    };
    const double flange = box ? s.b - 2.0 * (s.tw + s.r) : s.b / 2.0; // I: four of them
    const double web = s.h - 2.0 * (s.tf + s.r);
    const double gone =
        (box ? 2.0 : 4.0) * s.tf * lost(box ? kWall : kOther, flange, s.tf, limits.flange) +
        (box ? 2.0 : 1.0) * s.tw * lost(box ? kWall : kStiffened, web, s.tw, limits.web);
    if (gone == 0.0) return s.A;
    return sheet.Put("Ae", s.A - gone, T_DIM{0, 2}, kClause, "Ag - sum (b - be) t", R);
}
