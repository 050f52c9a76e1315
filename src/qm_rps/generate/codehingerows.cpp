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

} // namespace

std::vector<T_CODE_ROW_OF_HINGE> HingeRows(const T_CODE_ELEMENT& element)
{
    std::vector<T_CODE_ROW_OF_HINGE> rows;
    for (const T_CODE_COMPONENT& b : element.hinge->components) {
        const auto at = static_cast<std::size_t>(b.component);
        const HINGE_LOCATION location = element.hinge->type.components[at].location;
        const bool middle = location == HINGE_LOCATION::Center;
        const bool same = location == HINGE_LOCATION::BothEnds &&
                          Alike(b.ends.I.pos, b.ends.J.pos) && Alike(b.ends.I.neg, b.ends.J.neg);
        const auto put = [&](const char* end, bool atI, const char* side, bool positive) {
            const auto& sides = atI ? b.ends.I : b.ends.J;
            const bool own = positive != IsSectionSignOpposite(b.component);
            const double axial = atI ? element.member.axial.I : element.member.axial.J;
            rows.push_back({element.member.element, element.member.kind, end, b.component, side,
                            element.member.HasAxial() ? axial : 0.0,
                            own ? &sides.pos : &sides.neg});
        };
        for (const bool atI : {true, false}) {
            if (location == (atI ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd)) continue;
            if ((same || middle) && !atI) continue;
            const char* const end = middle ? "C" : same ? "I, J" : atI ? "I" : "J";
            const auto& sides = atI ? b.ends.I : b.ends.J;
            if (Alike(sides.pos, sides.neg)) {
                put(end, atI, "+-", true);
            } else {
                put(end, atI, "+", true);
                put(end, atI, "-", false);
            }
        }
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
