#include "qm_rps/pushover/fema440coefficients.h"

#include <cmath>
#include <limits>

namespace {

constexpr double kAny = std::numeric_limits<double>::infinity();

struct T_ROW {
    int type;         // hysteresis model
    double maxAlpha;  // last alpha of the row
    bool atMost;      // false: the row is for alpha below maxAlpha, not at it
    const char* text; // the row's alpha in words; empty: any
};

/// Hysteresis models by their number.
constexpr std::array<const char*, 4> kModels{"bilinear", "stiffness degrading",
                                             "strength degrading", "any type"};

constexpr std::size_t kRowCount = 13;

// Rows of FEMA 440 Tables 6-1 and 6-2.
// clang-format off
constexpr std::array<T_ROW, kRowCount> kRows{{
    {0, 0.0,  true,  "<= 0"},
    {0, 2.0,  true,  "<= 2"},
    {0, 5.0,  true,  "<= 5"},
    {0, 10.0, true,  "<= 10"},
    {0, kAny, true,  "> 10"},
    {1, 0.0,  true,  "<= 0"},
    {1, 2.0,  true,  "<= 2"},
    {1, 5.0,  true,  "<= 5"},
    {1, 10.0, true,  "<= 10"},
    {1, kAny, true,  "> 10"},
    {2, -3.0, false, "< -3"},
    {2, kAny, true,  ">= -3"},
    {3, kAny, true,  ""},
}};

// The same rows of Table 6-2 (period G to L) and of Table 6-1 (damping A to F).
// Behind each: its model and alpha.
constexpr std::array<T_FEMA440_ROW, kRowCount> kCoefficients{{
    {{0.11, -0.017, 0.27, 0.090, 0.57,  0.00}, {3.2, -0.66, 11.0, 0.12, 19.0, 0.73}}, // 0, <= 0
    {{0.10, -0.014, 0.17, 0.120, 0.67,  0.02}, {3.3, -0.64,  9.4, 1.10, 19.0, 0.42}}, // 0, <= 2
    {{0.11, -0.018, 0.09, 0.140, 0.77,  0.05}, {4.2, -0.83, 10.0, 1.60, 22.0, 0.40}}, // 0, <= 5
    {{0.13, -0.022, 0.27, 0.100, 0.87,  0.10}, {5.1, -1.10, 12.0, 1.60, 24.0, 0.36}}, // 0, <= 10
    {{0.10, -0.015, 0.17, 0.094, 0.98,  0.20}, {4.6, -0.99, 12.0, 1.10, 25.0, 0.37}}, // 0, > 10
    {{0.17, -0.032, 0.10, 0.190, 0.85,  0.00}, {5.1, -1.10, 12.0, 1.40, 20.0, 0.62}}, // 1, <= 0
    {{0.18, -0.034, 0.22, 0.160, 0.88,  0.02}, {5.3, -1.20, 11.0, 1.60, 20.0, 0.51}}, // 1, <= 2
    {{0.18, -0.037, 0.15, 0.160, 0.92,  0.05}, {5.6, -1.30, 10.0, 1.80, 20.0, 0.38}}, // 1, <= 5
    {{0.17, -0.034, 0.26, 0.120, 0.97,  0.10}, {5.3, -1.20,  9.2, 1.90, 21.0, 0.37}}, // 1, <= 10
    {{0.13, -0.027, 0.11, 0.110, 1.00,  0.20}, {4.6, -1.00,  9.6, 1.30, 23.0, 0.34}}, // 1, > 10
    {{0.20, -0.038, 0.25, 0.170, 0.71, -0.05}, {5.6, -1.30, 14.0, 0.61, 22.0, 0.90}}, // 2, < -3
    {{0.18, -0.033, 0.17, 0.180, 0.76, -0.03}, {5.3, -1.20, 14.0, 0.69, 24.0, 0.90}}, // 2, >= -3
    {{0.20, -0.038, 0.28, 0.130, 0.89,  0.05}, {4.9, -1.10, 14.0, 0.32, 19.0, 0.64}}, // 3
}};
// clang-format on

/// Keeps a finite value. 1 kept; 0 not finite.
int Keep(double value, double& out)
{
    if (!std::isfinite(value)) return 0;
    out = value;
    return 1;
}

} // namespace

int Fema440RowIndex(int type, double alpha)
{
    for (std::size_t i = 0; i + 1 < kRows.size(); ++i) {
        const T_ROW& row = kRows[i];
        if (row.type == type && (row.atMost ? alpha <= row.maxAlpha : alpha < row.maxAlpha))
            return static_cast<int>(i);
    }
    return static_cast<int>(kRows.size()) - 1;
}

const T_FEMA440_ROW& Fema440Row(int index)
{
    return kCoefficients[static_cast<std::size_t>(index)];
}

std::string Fema440RowText(int index)
{
    const T_ROW& row = kRows[static_cast<std::size_t>(index)];
    const std::string model = kModels[static_cast<std::size_t>(row.type)];
    return *row.text ? model + ", alpha " + row.text : model;
}

int Fema440DuctilityRange(double mu)
{
    if (mu < 4.0) return 0;
    return mu <= 6.5 ? 1 : 2;
}

int CalcFema440Period(const T_FEMA440_ROW& row, int range, double T0, double mu, double& Teff)
{
    const auto& [G, H, I, J, K, L] = row.period;
    const double m = mu - 1.0;
    switch (range) {
    case 0:
        return Keep((G * m * m + H * m * m * m + 1.0) * T0, Teff);
    case 1:
        return Keep((I + J * m + 1.0) * T0, Teff);
    case 2:
        return Keep((K * (std::sqrt(m / (1.0 + L * (mu - 2.0))) - 1.0) + 1.0) * T0, Teff);
    default:
        return 0;
    }
}

int CalcFema440Damping(const T_FEMA440_ROW& row, int range, double T0, double Teff, double mu,
                       double& betaPct)
{
    const auto& [A, B, C, D, E, F] = row.damping;
    const double m = mu - 1.0;
    const double Fm = F * m;
    switch (range) {
    case 0:
        return Keep(A * m * m + B * m * m * m + 5.0, betaPct);
    case 1:
        return Keep(C + D * m + 5.0, betaPct);
    case 2:
        return Keep(E * (Fm - 1.0) / (Fm * Fm) * (Teff / T0) * (Teff / T0) + 5.0, betaPct);
    default:
        return 0;
    }
}
