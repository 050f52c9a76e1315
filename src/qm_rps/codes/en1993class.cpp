#include "qm_rps/codes/en1993class.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <utility>

namespace {

constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;
constexpr const char* kTable = "EN 1993-1-1 Table 5.2";

// Limits of c/t over eps (of tubes d/t over eps^2) for classes 1, 2, 3; beyond: 4.
using T_LIMITS = std::array<double, 3>;
constexpr T_LIMITS kOutstand{9.0, 10.0, 14.0};
constexpr T_LIMITS kCompressed{33.0, 38.0, 42.0};
constexpr T_LIMITS kTube{50.0, 70.0, 90.0};
constexpr double kEndless = std::numeric_limits<double>::infinity();

/// Internal part of which the share alpha is compressed when all of it is plastic; psi: the stress
/// at its less compressed edge over that at the other, when it is elastic and yields there.
T_LIMITS Internal(double alpha, double psi)
{
    const bool most = alpha > 0.5;
    return {most ? 396.0 / (13.0 * alpha - 1.0) : 36.0 / alpha,
            most ? 456.0 / (13.0 * alpha - 1.0) : 41.5 / alpha,
            psi > -1.0 ? 42.0 / (0.67 + 0.33 * psi) : 62.0 * (1.0 - psi) * std::sqrt(-psi)};
}

int ClassOf(const char* symbol, double ratio, double eps, const T_LIMITS& limits, const char* text,
            CCodeSheet& sheet)
{
    sheet.Put(symbol, ratio, kTable, text, K);
    const auto holds = [&](double limit) { return ratio <= limit * eps; };
    return 1 + static_cast<int>(std::ranges::find_if(limits, holds) - limits.begin());
}

double Epsilon(double fy, CCodeSheet& sheet)
{
    return sheet.Put("eps", std::sqrt(235.0 * kPascalsPerMpa / fy), kTable, "sqrt(235/fy)", R);
}

/// Flange and web about y; `alpha` of the web.
int OfPlates(const T_STEEL_SHAPE& s, double eps, const T_LIMITS& web, CCodeSheet& sheet)
{
    const bool box = s.shape == STEEL_SHAPE::RectangularTube;
    const double depth = s.h - 2.0 * s.tf - 2.0 * s.r;
    const double flange = box ? (s.b - 2.0 * s.tw - 2.0 * s.r) / s.tf
                          : s.shape == STEEL_SHAPE::Channel
                              ? (s.b - s.tw - s.r) / s.tf
                              : (s.b - s.tw - 2.0 * s.r) / (2.0 * s.tf);
    const int first = ClassOf("c/t (flange)", flange, eps, box ? kCompressed : kOutstand,
                              box ? "33, 38, 42 eps" : "9, 10, 14 eps", sheet);
    const int second = ClassOf("c/t (web)", depth / s.tw, eps, web,
                               "a > 0.5: 396, 456/(13 a - 1) eps; 36, 41.5/a eps;"
                               " psi > -1: 42/(0.67 + 0.33 psi) eps; 62 (1 - psi) sqrt(-psi) eps",
                               sheet);
    return std::max(first, second);
}

int PutClass(int number, CCodeSheet& sheet)
{
    return static_cast<int>(sheet.Put("class", number, kTable, "the worst part", R));
}

bool Sound(const T_STEEL_SHAPE& s, double fy, CCodeSheet& sheet)
{
    sheet.Positive({{"fy", fy}, {"h", s.h}, {"tw", s.tw}});
    if (s.shape != STEEL_SHAPE::CircularTube) sheet.Positive({{"b", s.b}, {"tf", s.tf}});
    return sheet.Sound();
}

/// Share of a web of depth c that is compressed: N is carried by a strip around its middle.
double ShareOf(double clear, double thickness, double axial, double fy)
{
    return std::clamp(0.5 * (1.0 + axial / (clear * thickness * fy)), 0.0, 1.0);
}

/// Limits of the web: it bends with the section, or (`alone`) carries the axial force alone.
T_LIMITS WebLimits(const T_STEEL_SHAPE& s, double clear, bool alone, double axial, double fy,
                   CCodeSheet& sheet)
{
    const double thickness = (s.shape == STEEL_SHAPE::RectangularTube ? 2.0 : 1.0) * s.tw;
    double alpha = alone ? (axial > 0.0 ? 1.0 : 0.0) : ShareOf(clear, thickness, axial, fy);
    alpha = sheet.Put("a (web)", alpha, kTable, "(1 + N/(c tw fy))/2, compressed share", R);
    if (!(alpha > 0.0)) return {kEndless, kEndless, kEndless};
    const double psi = alone ? 1.0 : std::min(1.0, 2.0 * axial / (s.A * fy) - 1.0);
    return Internal(alpha, sheet.Put("psi (web)", psi, kTable, "2 N/(A fy) - 1 <= 1", R));
}

} // namespace

std::optional<int> En1993Class(const T_STEEL_SHAPE& s, bool aboutY, double axial, double fy,
                               CCodeSheet& sheet)
{
    if (!Sound(s, fy, sheet) || !sheet.Finite({{"axial", axial}}) || !sheet.Positive({{"A", s.A}}))
        return {};
    const double eps = Epsilon(fy, sheet);
    if (s.shape == STEEL_SHAPE::CircularTube)
        return PutClass(ClassOf("d/t", s.h / s.tw, eps * eps, kTube, "50, 70, 90 eps^2", sheet),
                        sheet);
    const bool box = s.shape == STEEL_SHAPE::RectangularTube;
    T_STEEL_SHAPE turned = s;
    if (box && !aboutY) { // its webs are the other plates
        std::swap(turned.h, turned.b);
        std::swap(turned.tf, turned.tw);
    }
    const double clear = turned.h - 2.0 * turned.tf - 2.0 * turned.r;
    // Across the minor axis the web of an I lies in the middle: it is compressed by N alone. That
    // of a channel lies at the edge, where either sign of the moment may compress it.
    const T_LIMITS web = s.shape == STEEL_SHAPE::Channel && !aboutY
                             ? kCompressed
                             : WebLimits(turned, clear, !box && !aboutY, axial, fy, sheet);
    return PutClass(OfPlates(turned, eps, web, sheet), sheet);
}

std::optional<int> En1993ClassCompressed(const T_STEEL_SHAPE& s, double fy, CCodeSheet& sheet)
{
    if (!Sound(s, fy, sheet)) return {};
    const double eps = Epsilon(fy, sheet);
    if (s.shape == STEEL_SHAPE::CircularTube)
        return PutClass(ClassOf("d/t", s.h / s.tw, eps * eps, kTube, "50, 70, 90 eps^2", sheet),
                        sheet);
    return PutClass(OfPlates(s, eps, kCompressed, sheet), sheet);
}
