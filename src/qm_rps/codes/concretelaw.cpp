#include "qm_rps/codes/concretelaw.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;

constexpr const char* kTable = "EN 1992-1-1 Table 3.1";
constexpr double kCrushStrain = 0.003; // ACI 318 22.2.2.1

} // namespace

T_CONCRETE_LAW ConcreteLaw(double fckMpa)
{
    if (fckMpa <= 50.0) return {};
    const double below90 = std::pow((kMaxFckMpa - fckMpa) / 100.0, 4);
    T_CONCRETE_LAW law;
    law.n = 1.4 + 23.4 * below90;
    law.crushStrain = (2.6 + 35.0 * below90) / 1000.0;
    // At C90 the formulas cross in the fourth digit; the table prints 2.6 for both strains.
    law.peakStrain =
        std::min((2.0 + 0.085 * std::pow(fckMpa - 50.0, 0.53)) / 1000.0, law.crushStrain);
    return law;
}

std::optional<T_CONCRETE_CLASS> ConcreteClass(double fck, CCodeSheet& sheet)
{
    if (!sheet.Within("fck", fck, 12.0 * kPascalsPerMpa, kMaxFckMpa * kPascalsPerMpa)) return {};
    const double mpa = fck / kPascalsPerMpa, above = std::max(0.0, mpa - 50.0);
    const double fcm = mpa + 8.0;
    const double fctm =
        mpa <= 50.0 ? 0.30 * std::pow(mpa, 2.0 / 3.0) : 2.12 * std::log(1.0 + fcm / 10.0);
    const auto stress = [&](const char* symbol, double value, const char* text, CODE_MARK mark) {
        return sheet.Put(symbol, value * kPascalsPerMpa, kDimStress, kTable, text, mark);
    };
    T_CONCRETE_CLASS c;
    c.fck = fck;
    c.fcm = stress("fcm", fcm, "fck + 8 MPa", S2);
    c.fctm = stress("fctm", fctm, "0.30 fck^(2/3); > C50: 2.12 ln(1 + fcm/10)", S2);
    c.fctk005 = stress("fctk,0.05", 0.7 * fctm, "0.7 fctm", S2);
    c.fctk095 = stress("fctk,0.95", 1.3 * fctm, "1.3 fctm", S2);
    c.Ecm = stress("Ecm", ConcreteModulus(fcm * kPascalsPerMpa) / kPascalsPerMpa,
                   "22 (fcm/10)^0.3 GPa", S2);
    c.bilinearStrain = sheet.Put("eps_c3", (1.75 + 0.55 * above / 40.0) / 1000.0, kTable,
                                 "1.75 + 0.55 (fck - 50)/40", S2);
    c.lambda = sheet.Put("lambda", 0.8 - above / 400.0, kTable, "0.8 - (fck - 50)/400", S2);
    c.eta = sheet.Put("eta", 1.0 - above / 200.0, kTable, "1 - (fck - 50)/200", S2);
    return c;
}

double AciBeta1(double fc, CCodeSheet& sheet)
{
    const double ksi = fc / kPascalsPerKsi;
    return sheet.Put("beta1", std::clamp(0.85 - 0.05 * (ksi - 4.0), 0.65, 0.85),
                     "ACI 318 22.2.2.4.3", "0.65 <= 0.85 - 0.05 (f'c - 4 ksi) <= 0.85", S2);
}

double BalancedRatio(double fc, double fy, double Es, CCodeSheet& sheet)
{
    const double atCrushing = kCrushStrain * Es;
    return sheet.Put("rho_bal",
                     0.85 * AciBeta1(fc, sheet) * fc / fy * atCrushing / (atCrushing + fy),
                     "ACI 318", "0.85 beta1 f'c/fy * 0.003 Es/(0.003 Es + fy)", S2);
}
