#include "qm_rps/generate/codehingerows.h"

#include "qm_base/say.h"
#include "qm_rps/push/lawaxial.h"

#include <algorithm>
#include <cmath>

namespace {

bool Near(double a, double b)
{
    constexpr double kDigits = 1e-9;
    return std::fabs(a - b) <= kDigits * std::max(std::fabs(a), std::fabs(b));
}

bool Alike(const T_CODE_POINT& a, const T_CODE_POINT& b)
{
    return Near(a.deform, b.deform) && Near(a.strength, b.strength);
}

bool Alike(const T_CODE_SIDE& a, const T_CODE_SIDE& b)
{
    const T_CODE_BACKBONE &p = a.bone, &q = b.bone;
    return Near(a.strength, b.strength) && Near(a.shearStrength, b.shearStrength) &&
           Near(p.yieldDeform, q.yieldDeform) && Alike(p.C, q.C) && Alike(p.D, q.D) &&
           Alike(p.E, q.E);
}

std::string Power(std::string_view unit, int exponent)
{
    return std::string(unit) + (exponent == 1 ? "" : std::to_string(exponent));
}

/// Rows of both ends of a component at axial forces.
void AppendRows(const T_CODE_ELEMENT& element, const T_CODE_COMPONENT& b,
                const T_ENDS<T_SIDES<T_CODE_SIDE>>& ends, const T_ENDS<double>& axial,
                std::vector<T_CODE_ROW_OF_HINGE>& rows)
{
    const bool middle = b.location == HINGE_LOCATION::Center;
    const bool same = b.location == HINGE_LOCATION::BothEnds && Alike(ends.I.pos, ends.J.pos) &&
                      Alike(ends.I.neg, ends.J.neg);
    for (const bool atI : {true, false}) {
        if (b.location == (atI ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd)) continue;
        if ((same || middle) && !atI) continue;
        const T_SIDES<T_CODE_SIDE>& sides = atI ? ends.I : ends.J;
        const auto put = [&](const char* side, bool positive) {
            const bool own = positive != IsSectionSignOpposite(b.component);
            rows.push_back({element.member.element, element.member.kind,
                            middle ? "C"
                            : same ? "I, J"
                            : atI  ? "I"
                                   : "J",
                            b.component, side,
                            !element.member.HasAxial() ? 0.0
                            : atI                      ? axial.I
                                                       : axial.J,
                            own ? &sides.pos : &sides.neg});
        };
        if (Alike(sides.pos, sides.neg)) {
            put("+-", true);
        } else {
            put("+", true);
            put("-", false);
        }
    }
}

} // namespace

std::vector<T_CODE_ROW_OF_HINGE> HingeRows(const T_CODE_ELEMENT& element)
{
    std::vector<T_CODE_ROW_OF_HINGE> rows;
    for (const T_CODE_COMPONENT& b : element.hinge->components) {
        AppendRows(element, b, b.ends, element.member.axial, rows);
        for (const T_CODE_AXIAL& at : b.byAxial)
            AppendRows(element, b, at.ends, {at.axial, at.axial}, rows);
    }
    return rows;
}

std::string MarkText(CODE_MARK mark)
{
    constexpr std::array<const char*, 4> kKeys{"IDS_QM_GEN_COMPUTED", "IDS_QM_GEN_SIGHTED_TWICE",
                                               "IDS_QM_GEN_SIGHTED_ONCE", "IDS_QM_GEN_RECALLED"};
    return Say(kKeys[static_cast<std::size_t>(mark)]);
}

std::string UnitText(T_DIM dim, const T_UNITS& units)
{
    std::string over = dim.force > 0 ? Power(NameOf(units.force), dim.force) : "";
    if (dim.length > 0) over += (over.empty() ? "" : " ") + Power(NameOf(units.length), dim.length);
    if (dim.length >= 0) return over;
    return (over.empty() ? "1" : over) + '/' + Power(NameOf(units.length), -dim.length);
}
