#include "qm_db/stock/matgrades.h"

#include <cmath>
#include <utility>
#include <vector>

namespace {

constexpr double kMpa = 1e6, kPsi = 6894.757293168, kKsi = 1000.0 * kPsi;
constexpr double kEuropean = 210e9, kAmerican = 29000.0 * kKsi, kBars = 200e9;

// fck and fck,cube, MPa: EN 1992-1-1 Table 3.1.
constexpr std::pair<int, int> kConcrete[] = {{12, 15}, {16, 20}, {20, 25}, {25, 30}, {30, 37},
                                             {35, 45}, {40, 50}, {45, 55}, {50, 60}, {55, 67},
                                             {60, 75}, {70, 85}, {80, 95}, {90, 105}};
constexpr int kAciPsi[] = {2500, 3000, 4000, 5000, 6000, 8000, 10000};

struct T_STEEL_ROW {
    const char *name, *clause;
    bool bars;
    double strength, modulus;
};
// Recalled. EN 10025-2: up to 16 mm; behind a stroke above 16 up to 40 mm.
// clang-format off
constexpr T_STEEL_ROW kSteel[] = {
    {"S235",    "EN 10025-2, t <= 16 mm", false, 235 * kMpa, kEuropean},
    {"S235/40", "EN 10025-2, t <= 40 mm", false, 225 * kMpa, kEuropean},
    {"S275",    "EN 10025-2, t <= 16 mm", false, 275 * kMpa, kEuropean},
    {"S275/40", "EN 10025-2, t <= 40 mm", false, 265 * kMpa, kEuropean},
    {"S355",    "EN 10025-2, t <= 16 mm", false, 355 * kMpa, kEuropean},
    {"S355/40", "EN 10025-2, t <= 40 mm", false, 345 * kMpa, kEuropean},
    {"S450",    "EN 10025-2, t <= 16 mm", false, 450 * kMpa, kEuropean},
    {"S460",    "EN 10025-3, t <= 16 mm", false, 460 * kMpa, kEuropean},
    {"A36",     "ASTM A36",               false,  36 * kKsi, kAmerican},
    {"A572-50", "ASTM A572 Gr 50",        false,  50 * kKsi, kAmerican},
    {"A992",    "ASTM A992",              false,  50 * kKsi, kAmerican},
    {"B450C",   "NTC 2018 11.3.2.1",      true,  450 * kMpa, kBars},
    {"B500B",   "EN 1992-1-1 Annex C",    true,  500 * kMpa, kBars},
    {"B500C",   "EN 1992-1-1 Annex C",    true,  500 * kMpa, kBars},
    {"Gr40",    "ASTM A615",              true,   40 * kKsi, kAmerican},
    {"Gr60",    "ASTM A615, A706",        true,   60 * kKsi, kAmerican},
};
// clang-format on
constexpr double kSteelDensity = 7850.0, kConcreteDensity = 2500.0; // kg/m3, EN 1991-1-1 Annex A
constexpr double kSteelNu = 0.3, kConcreteNu = 0.2, kSteelAlpha = 1.2e-5, kConcreteAlpha = 1e-5;

T_MATL_GRADE Concrete(std::string name, std::string clause, double strength, double modulus)
{
    return {std::move(name), std::move(clause), GRADE_OF::Concrete, strength,
            modulus,         kConcreteNu,       kConcreteDensity,   kConcreteAlpha};
}

std::vector<T_MATL_GRADE> MakeGrades()
{
    std::vector<T_MATL_GRADE> out;
    for (const auto& [cylinder, cube] : kConcrete)
        out.push_back(Concrete("C" + std::to_string(cylinder) + "/" + std::to_string(cube),
                               "EN 1992-1-1 Table 3.1", cylinder * kMpa,
                               ConcreteModulus((cylinder + 8) * kMpa)));
    for (const int psi : kAciPsi) // 57000 sqrt(f'c), psi
        out.push_back(Concrete(std::to_string(psi) + "psi", "ACI 318-19 19.2.2.1", psi * kPsi,
                               57000.0 * std::sqrt(psi) * kPsi));
    for (const T_STEEL_ROW& row : kSteel)
        out.push_back({row.name, row.clause, row.bars ? GRADE_OF::Bars : GRADE_OF::Steel,
                       row.strength, row.modulus, kSteelNu, kSteelDensity, kSteelAlpha});
    return out;
}

} // namespace

double ConcreteModulus(double fcm)
{
    return 22e9 * std::pow(fcm / (10.0 * kMpa), 0.3);
}

std::span<const T_MATL_GRADE> MaterialGrades()
{
    static const std::vector<T_MATL_GRADE> kGrades = MakeGrades();
    return kGrades;
}

const T_MATL_GRADE* FindGrade(const std::string& name)
{
    for (const T_MATL_GRADE& grade : MaterialGrades())
        if (grade.name == name) return &grade;
    return nullptr;
}
