#include "qm_rps/codes/en1998rotation.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto K = CODE_MARK::Computed;
constexpr const char* kYield = "Panagiotakos, Fardis 2001 (EN 1998-3 A.3.2.4)";

/// Reinforcement over b d, and the compression bars' depth over d.
struct T_RATIOS {
    double tension = 0.0, compression = 0.0, web = 0.0, depth = 0.0;
    double Sum() const { return tension + compression + web; }
    double Moment() const { return tension + compression * depth + web * (1.0 + depth) / 2.0; }
};

/// Root of xi^2 + 2 alpha A xi - 2 alpha B = 0: neutral axis depth of the elastic section.
double NeutralAxis(double alpha, double A, double B)
{
    return std::sqrt(alpha * alpha * A * A + 2.0 * alpha * B) - alpha * A;
}

double Moment(const T_EN_MEMBER& m, const T_RATIOS& r, double xi, double curvature)
{
    const double d1 = r.depth;
    const double concrete = m.Ec * xi * xi / 2.0 * (0.5 * (1.0 + d1) - xi / 3.0);
    const double steel =
        ((1.0 - xi) * r.tension + (xi - d1) * r.compression + r.web * (1.0 - d1) / 6.0) *
        (1.0 - d1) * m.Es / 2.0;
    return m.b * m.d * m.d * m.d * curvature * (concrete + steel);
}

} // namespace

std::optional<T_EN_YIELD> EnYield(const T_EN_MEMBER& m, CCodeSheet& sheet)
{
    if (!SoundMember(m, sheet) || !sheet.Positive({{"Ec", m.Ec}})) return {};
    const double area = m.b * m.d, alpha = m.Es / m.Ec;
    const T_RATIOS r{m.As / area, m.AsPrime / area, m.AsWeb / area, m.dPrime / m.d};
    const double n = m.axial / (area * m.fy), c = m.axial / (area * m.fc);
    sheet.Put("rho1", r.tension, kYield, "As1/(b d)", K);
    sheet.Put("rho2", r.compression, kYield, "As2/(b d)", K);
    sheet.Put("rho_v", r.web, kYield, "Asv/(b d)", K);

    const double steelXi = NeutralAxis(alpha, r.Sum() + n, r.Moment() + n);
    const double steel = m.fy / (m.Es * (1.0 - steelXi) * m.d);
    const double concreteXi = NeutralAxis(alpha, r.Sum() - c / (1.8 * alpha), r.Moment());
    const double concrete = 1.8 * m.fc / (m.Ec * concreteXi * m.d);
    if (!(steelXi > 0.0) || !(concreteXi > 0.0)) { // the whole section is in tension
        sheet.Refuse(CODE_REASON::Tension, "axial", "xi_y > 0");
        return {};
    }
    T_EN_YIELD y;
    // Where the neutral axis leaves the section the steel does not yield.
    y.steelFirst = steelXi < 1.0 && steel <= concrete;
    if (steelXi < 1.0)
        sheet.Put("phi_y (steel)", steel, T_DIM{0, -1}, kYield, "fy/(Es (1 - xi_y) d)", S2);
    sheet.Put("phi_y (concrete)", concrete, T_DIM{0, -1}, kYield, "1.8 fc/(Ec xi_y d)", S2);
    y.xi = sheet.Put("xi_y", y.steelFirst ? steelXi : concreteXi, kYield,
                     "sqrt(al^2 A^2 + 2 al B) - al A", S2);
    y.curvature =
        sheet.Put("phi_y", y.steelFirst ? steel : concrete, T_DIM{0, -1}, kYield, "min", S2);
    y.moment = sheet.Put("My", Moment(m, r, y.xi, y.curvature), kDimMoment, kYield,
                         "b d^3 phi_y {Ec xi^2/2 (0.5 (1 + d') - xi/3) + [(1 - xi) r1 + (xi - d')"
                         " r2 + rv (1 - d')/6] (1 - d') Es/2}",
                         S2);
    if (!sheet.Positive({{"My", y.moment}})) return {};
    return y;
}
