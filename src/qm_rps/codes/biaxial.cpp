#include "qm_rps/codes/biaxial.h"

#include <algorithm>
#include <cmath>
#include <limits>

std::optional<double> BreslerAxial(double Pnx, double Pny, double P0, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"Pnx", Pnx}, {"Pny", Pny}, {"P0", P0}})) return {};
    // Below, the reciprocal would be negative or above the strength of one axis.
    if (!sheet.Within("P0", P0, std::max(Pnx, Pny), std::numeric_limits<double>::infinity()))
        return {};
    return sheet.Put("Pn", 1.0 / (1.0 / Pnx + 1.0 / Pny - 1.0 / P0), kDimForce, "Bresler 1960",
                     "1/Pn = 1/Pnx + 1/Pny - 1/P0", CODE_MARK::SightedTwice);
}

std::optional<double> EnBiaxialRatio(double axialRatio, double ratioY, double ratioZ, bool circle,
                                     CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1992-1-1 5.8.9(4)";
    sheet.NotNegative({{"ratioY", ratioY}, {"ratioZ", ratioZ}});
    if (!sheet.Within("axialRatio", axialRatio, 0.0, 1.0)) return {};
    const double rising = axialRatio < 0.7 ? LinearClamped(axialRatio, 0.1, 1.0, 0.7, 1.5)
                                           : LinearClamped(axialRatio, 0.7, 1.5, 1.0, 2.0);
    const double a =
        sheet.Put("a", circle ? 2.0 : rising, kClause,
                  "1.0, 1.5, 2.0 at NEd/NRd 0.1, 0.7, 1.0; circle: 2", CODE_MARK::Recalled);
    return sheet.Put("ratio", std::pow(ratioZ, a) + std::pow(ratioY, a), kClause,
                     "(MEdz/MRdz)^a + (MEdy/MRdy)^a", CODE_MARK::Recalled);
}
