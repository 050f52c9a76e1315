// FEMA 440 (2005) equivalent linearization: effective period and damping, Tables 6-1 and 6-2.
#pragma once

#include <array>
#include <string>

/// Coefficients of one table row: period G to L, damping A to F.
struct T_FEMA440_ROW {
    std::array<double, 6> period;
    std::array<double, 6> damping;
};

/// Row for a hysteresis model (0 bilinear, 1 stiffness degrading, 2 strength degrading, 3 and
/// other any type) and the post-yield stiffness ratio, compared with 0, 2, 5, 10 (type 2: -3) as
/// it is passed. The published tables mean per cent.
int Fema440RowIndex(int type, double alpha);
const T_FEMA440_ROW& Fema440Row(int index);
/// "stiffness degrading, alpha <= 2".
std::string Fema440RowText(int index);

/// Ductility range: 0 for mu < 4, 1 for 4 <= mu <= 6.5, 2 beyond.
int Fema440DuctilityRange(double mu);

/// Teff in s from the initial period T0. FEMA 440 (6-7) to (6-9). 1 done; 0 another range or no
/// real value, output as it was.
[[nodiscard]] int CalcFema440Period(const T_FEMA440_ROW& row, int range, double T0, double mu,
                                    double& Teff);
/// Effective damping in per cent, 5 included. FEMA 440 (6-1) to (6-3). As above.
[[nodiscard]] int CalcFema440Damping(const T_FEMA440_ROW& row, int range, double T0, double Teff,
                                     double mu, double& betaPct);
