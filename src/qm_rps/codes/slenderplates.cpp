#include "qm_rps/codes/slenderplates.h"

#include "qm_rps/codes/en1993class.h"

#include <cmath>

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
