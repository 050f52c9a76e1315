#include "qm_rps/judge/encolumn.h"

#include "qm_rps/codes/en1993class.h"
#include "qm_rps/codes/slenderplates.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;

/// Of the section in bending about the axes that have a moment, the worse; without any in
/// compression.
std::optional<int> ClassOf(const T_STEEL_BASIS& in, const T_STEEL_FORCES& f, CCodeSheet& sheet)
{
    constexpr double kNothing = 1e-9; // of the plastic moment: rounding
    std::optional<int> worst;
    for (const bool aboutY : {true, false}) {
        const bool bent = aboutY ? std::fabs(f.My) > kNothing * in.strength.Mply
                                 : std::fabs(f.Mz) > kNothing * in.strength.Mplz;
        if (!bent) continue;
        const auto number = En1993Class(in.shape, aboutY, f.N, in.fy, sheet);
        if (!number) return {};
        worst = std::max(worst.value_or(1), *number);
    }
    return worst || f.N <= 0.0 ? worst.value_or(1) : En1993ClassCompressed(in.shape, in.fy, sheet);
}

/// With the elastic moments.
T_STEEL_PLASTIC_STRENGTH Elastic(const T_STEEL_BASIS& in, CCodeSheet& sheet)
{
    const T_SECT_D& s = in.end.section;
    const auto moment = [&](const char* symbol, double I, double depth) {
        return sheet.Put(symbol, 2.0 * I / depth * in.fy, kDimMoment, "", "Wel fy", K);
    };
    return {in.strength.Npl, moment("Mel,y", s.Iyy, in.shape.h),
            moment("Mel,z", s.Izz, in.shape.b)};
}

} // namespace

std::optional<T_EN_BUCKLED> EnColumnBuckled(const T_STEEL_BASIS& in, bool aboutY, CCodeSheet& sheet)
{
    const auto area = EnCompressedArea(in.shape, in.fy, sheet);
    if (!area) return {};
    const T_BUCKLING b{in.shape.A, in.end.clear, aboutY ? in.iy : in.iz, in.fy, in.E, *area};
    return EnBuckled(b, EnImperfection(in.shape, !aboutY, sheet), sheet);
}

std::optional<T_EN_COLUMN_CHECK> EnColumn(const T_STEEL_BASIS& in, const T_STEEL_FORCES& f,
                                          bool onSurface, CCodeSheet& sheet)
{
    constexpr double kRounding = 1e-6;
    const auto number = ClassOf(in, f, sheet);
    if (!number) return {};
    if (*number > 3) {
        sheet.Refuse(CODE_REASON::NoRow, "class 4", "EN 1993-1-1 6.2.9.3: Aeff, Weff");
        return {};
    }
    const bool plastic = *number < 3;
    const T_STEEL_PLASTIC_STRENGTH strength = plastic ? in.strength : Elastic(in, sheet);
    std::optional<double> section;
    if (!plastic)
        section = EnElasticBending(strength, f, sheet);
    else if (const auto found = EnAxialBending(in.shape, strength, f, sheet))
        section = onSurface && found->ratio < 1.0 + kRounding ? std::min(1.0, found->ratio)
                                                              : found->ratio;
    if (!section) return {};
    T_EN_COLUMN_CHECK out{*section, plastic ? "EN 1993-1-1 6.2.9.1" : "EN 1993-1-1 6.2.9.2"};
    if (!(f.N > 0.0)) return out;
    const auto y = EnColumnBuckled(in, true, sheet);
    const auto z = y ? EnColumnBuckled(in, false, sheet) : std::nullopt;
    if (!z) return {};
    const auto member =
        EnBeamColumn({in.shape.shape, plastic, strength.Mply, strength.Mplz, *y, *z}, f, sheet);
    if (!member) return {};
    if (*member >= out.ratio) out = {*member, "EN 1993-1-1 6.3.3"};
    return out;
}
