#include "qm_rps/codes/en1998steel.h"

#include <algorithm>

namespace {

constexpr const char* kTable = "EN 1998-3 Annex B";
constexpr double kMostAxial = 0.30; // N / Npl

struct T_ROW {
    STEEL_ACTION action;
    int sectionClass;  // 0: any
    double DL, SD, NC; // plastic, over the yield deformation
    const char* text;
};
// clang-format off
constexpr std::array<T_ROW, 6> kRows{{
    {STEEL_ACTION::Bending,          1, 1.0,  6.0, 8.0, "class 1 (theta_y)"},
    {STEEL_ACTION::Bending,          2, 0.25, 2.0, 3.0, "class 2 (theta_y)"},
    {STEEL_ACTION::BraceCompression, 1, 0.25, 4.0, 6.0, "class 1 (Delta_c)"},
    {STEEL_ACTION::BraceCompression, 2, 0.25, 1.0, 2.0, "class 2 (Delta_c)"},
    {STEEL_ACTION::BraceTension,     0, 0.25, 7.0, 9.0, "(Delta_t)"},
    {STEEL_ACTION::MemberTension,    0, 0.25, 3.0, 5.0, "(Delta_t)"},
}};
// clang-format on

} // namespace

std::optional<T_CHORD_LIMITS> EnSteelLimits(const T_EN_STEEL& steel, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"yieldDeform", steel.yieldDeform}})) return {};
    if (steel.action == STEEL_ACTION::Bending &&
        !sheet.Within("axialRatio", steel.axialRatio, -1.0, kMostAxial))
        return {};
    const auto row = std::find_if(kRows.begin(), kRows.end(), [&](const T_ROW& r) {
        return r.action == steel.action &&
               (r.sectionClass == 0 || r.sectionClass == steel.sectionClass);
    });
    if (row == kRows.end()) {
        sheet.Refuse(CODE_REASON::NoRow, "sectionClass", kTable);
        return {};
    }
    const T_DIM dim = steel.action == STEEL_ACTION::Bending ? kDimNone : kDimLength;
    const auto total = [&](const char* symbol, double multiple) {
        return sheet.Put(symbol, (1.0 + multiple) * steel.yieldDeform, dim, kTable,
                         std::string(row->text) + ": 1 + " + CodeNumber(multiple),
                         CODE_MARK::Recalled);
    };
    T_CHORD_LIMITS limits;
    limits.DL = total("DL", row->DL);
    limits.SD = total("SD", row->SD);
    limits.NC = total("NC", row->NC);
    return limits;
}

std::optional<double> CircolareSteelThetaY(double moment, double shearSpan, double EI,
                                           CCodeSheet& sheet)
{
    if (!sheet.Positive({{"moment", moment}, {"shearSpan", shearSpan}, {"EI", EI}})) return {};
    return sheet.Put("theta_y", moment * shearSpan / (2.0 * EI), "Circolare 2019 [C8.7.2.13]",
                     "Me,Rd LV/(2 E I)", CODE_MARK::SightedOnce);
}
