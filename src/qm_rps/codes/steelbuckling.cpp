#include "qm_rps/codes/steelbuckling.h"

#include "qm_rps/codes/slenderplates.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

namespace {

constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;
constexpr const char* kCurves = "EN 1993-1-1 Table 6.2";
constexpr const char* kEn = "EN 1993-1-1 6.3.1.2";
constexpr const char* kAisc = "AISC 360 E3";
constexpr double kPi = std::numbers::pi;

enum CURVE { CurveA0, CurveA, CurveB, CurveC, CurveD };
// EN 1993-1-1 Table 6.1.
constexpr std::array<double, 5> kImperfections{0.13, 0.21, 0.34, 0.49, 0.76};
constexpr std::array<const char*, 5> kNames{"a0", "a", "b", "c", "d"};

struct T_ROW {
    STEEL_SHAPE shape;
    double deep;     // h / b above which the row holds
    double thickest; // tf, m
    CURVE major, minor;
};
constexpr double kAny = 1e9;
// clang-format off
// EN 1993-1-1 Table 6.2, S235 to S420; the first row that holds.
constexpr std::array<T_ROW, 8> kRows{{
    // shape                        h/b   tf     y       z
    {STEEL_SHAPE::RolledI,          1.2,  0.040, CurveA, CurveB},
    {STEEL_SHAPE::RolledI,          1.2,  0.100, CurveB, CurveC},
    {STEEL_SHAPE::RolledI,          0.0,  0.100, CurveB, CurveC},
    {STEEL_SHAPE::RolledI,          0.0,  kAny,  CurveD, CurveD},
    {STEEL_SHAPE::WeldedI,          0.0,  0.040, CurveB, CurveC},
    {STEEL_SHAPE::WeldedI,          0.0,  kAny,  CurveC, CurveD},
    {STEEL_SHAPE::RectangularTube,  0.0,  kAny,  CurveC, CurveC},
    {STEEL_SHAPE::CircularTube,     0.0,  kAny,  CurveC, CurveC},
}};
// clang-format on

bool Sound(const T_BUCKLING& b, CCodeSheet& sheet)
{
    sheet.Positive({{"area", b.area}, {"length", b.length}, {"radius", b.radius}});
    return sheet.Positive({{"fy", b.fy}, {"E", b.E}});
}

} // namespace

double EnImperfection(const T_STEEL_SHAPE& s, bool minor, CCodeSheet& sheet)
{
    const double deep = s.b > 0.0 ? s.h / s.b : 1.0;
    const auto row = std::ranges::find_if(kRows, [&](const T_ROW& r) {
        return r.shape == s.shape && deep > r.deep && s.tf <= r.thickest;
    });
    const CURVE curve = row == kRows.end() ? CurveD : minor ? row->minor : row->major;
    return sheet.Put(
        "alpha", kImperfections[curve], kCurves,
        std::string("curve ") + kNames[curve] +
            (s.shape == STEEL_SHAPE::RectangularTube || s.shape == STEEL_SHAPE::CircularTube
                 ? "; hot finished: a"
                 : ""),
        R);
}

std::optional<T_EN_BUCKLED> EnBuckled(const T_BUCKLING& b, double imperfection, CCodeSheet& sheet)
{
    if (!Sound(b, sheet) || !sheet.NotNegative({{"imperfection", imperfection}})) return {};
    const double area = b.counted > 0.0 ? b.counted : b.area;
    T_EN_BUCKLED out;
    out.slenderness = sheet.Put(
        "lambda", std::sqrt(area / b.area) * b.length / b.radius / (kPi * std::sqrt(b.E / b.fy)),
        kEn, area < b.area ? "sqrt(Aeff/A) (K L/i)/(pi sqrt(E/fy))" : "(K L/i)/(pi sqrt(E/fy))", R);
    const double l = out.slenderness, phi = 0.5 * (1.0 + imperfection * (l - 0.2) + l * l);
    const double chi = l <= 0.2 ? 1.0 : 1.0 / (phi + std::sqrt(phi * phi - l * l));
    out.chi =
        sheet.Put("chi", std::min(1.0, chi), kEn,
                  "1/(Phi + sqrt(Phi^2 - l^2)) <= 1, Phi = 0.5 (1 + alpha (l - 0.2) + l^2)", R);
    out.strength = sheet.Put("Nb", out.chi * area * b.fy, kDimForce, kEn,
                             area < b.area ? "chi Aeff fy" : "chi A fy", R);
    return out;
}

std::optional<double> EnBuckling(const T_BUCKLING& b, double imperfection, CCodeSheet& sheet)
{
    const auto buckled = EnBuckled(b, imperfection, sheet);
    return buckled ? std::optional(buckled->strength) : std::nullopt;
}

std::optional<double> EnBeamColumn(const T_EN_BEAM_COLUMN& c, const T_STEEL_FORCES& f,
                                   CCodeSheet& sheet)
{
    constexpr const char* kTable = "EN 1993-1-1 Table B.1";
    constexpr const char* kClause = "EN 1993-1-1 6.3.3";
    constexpr double kCm = 0.9;
    sheet.Positive({{"My", c.My}, {"Mz", c.Mz}, {"Nb,y", c.y.strength}, {"Nb,z", c.z.strength}});
    if (!sheet.Finite({{"N", f.N}, {"My", f.My}, {"Mz", f.Mz}})) return {};
    const bool isI = c.shape == STEEL_SHAPE::RolledI || c.shape == STEEL_SHAPE::WeldedI;
    const double ny = f.N / c.y.strength, nz = f.N / c.z.strength;
    const auto factor = [&](const char* symbol, double l, double n, bool minorOfI) {
        const double grows = !c.plastic ? 0.6 * std::min(l, 1.0)
                             : minorOfI ? std::min(2.0 * l - 0.6, 1.4)
                                        : std::min(l - 0.2, 0.8);
        return sheet.Put(symbol, kCm * (1.0 + grows * n), kTable,
                         !c.plastic ? "0.9 (1 + 0.6 l n), l <= 1; Cm = 0.9: sway"
                         : minorOfI ? "0.9 (1 + (2 l - 0.6) n), l <= 1; Cm = 0.9: sway"
                                    : "0.9 (1 + (l - 0.2) n), l <= 1; Cm = 0.9: sway",
                         R);
    };
    const double kyy = factor("kyy", c.y.slenderness, ny, false);
    const double kzz = factor("kzz", c.z.slenderness, nz, isI);
    const double my = std::fabs(f.My) / c.My, mz = std::fabs(f.Mz) / c.Mz;
    const double first = sheet.Put("(6.61)", ny + kyy * my + (c.plastic ? 0.6 : 1.0) * kzz * mz,
                                   kClause, "N/Nb,y + kyy My/My,Rk + kyz Mz/Mz,Rk, chi_LT = 1", R);
    const double second = sheet.Put("(6.62)", nz + (c.plastic ? 0.6 : 0.8) * kyy * my + kzz * mz,
                                    kClause, "N/Nb,z + kzy My/My,Rk + kzz Mz/Mz,Rk, chi_LT = 1", R);
    return std::max(first, second);
}

std::optional<double> AiscBuckling(const T_BUCKLING& b, const T_STEEL_SHAPE& shape,
                                   CCodeSheet& sheet)
{
    if (!Sound(b, sheet)) return {};
    const double slender = sheet.Put("K L/r", b.length / b.radius, kAisc, "", K);
    const double euler = sheet.Put("Fe", kPi * kPi * b.E / (slender * slender), kDimStress, kAisc,
                                   "pi^2 E/(K L/r)^2", R);
    const double ratio = b.fy / euler;
    const double stress =
        sheet.Put("Fcr", ratio <= 2.25 ? std::pow(0.658, ratio) * b.fy : 0.877 * euler, kDimStress,
                  kAisc, "0.658^(Fy/Fe) Fy, Fy/Fe <= 2.25; 0.877 Fe", R);
    const auto area = AiscCompressedArea(shape, stress, b.fy, b.E, sheet);
    if (!area) return {};
    return sheet.Put("Pn", stress * *area, kDimForce, kAisc, *area < b.area ? "Fcr Ae" : "Fcr A",
                     R);
}
