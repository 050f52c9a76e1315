#include "qm_rps/hinge/pointrule.h"

#include "qm_base/msgfunction.h"
#include "qm_db/compfunc.h"

#include <algorithm>
#include <cmath>

namespace {

using zql::lib::MMSGFunction;

constexpr double kStrengthTol = 1e-9; // of strength / yield strength
constexpr const char* kPointNames[] = {"A", "B", "C", "D", "E"};

const char* NameOf(SKEL_POINT p)
{
    return kPointNames[static_cast<std::size_t>(p)];
}

const char* SymbolOf(SKEL_VALUE value, const T_HINGE_PLACE& place)
{
    if (value == SKEL_VALUE::Deform) return "D";
    return IsMoment(static_cast<HINGE_COMPONENT>(place.component)) ? "M" : "F";
}

std::string WithSymbol(std::string text, const char* symbol)
{
    for (std::size_t at = 0; (at = text.find("%s", at)) != std::string::npos; ++at)
        text.replace(at, 2, symbol);
    return text;
}

} // namespace

double T_BACKBONE_SIDE::Value(SKEL_VALUE value, SKEL_POINT point) const
{
    static constexpr T_SKEL_POINT T_SKEL_SIDE::*kPoints[] = {&T_SKEL_SIDE::B, &T_SKEL_SIDE::C,
                                                             &T_SKEL_SIDE::D, &T_SKEL_SIDE::E};
    if (point == SKEL_POINT::A) return 0.0;
    const T_SKEL_POINT& p = values.*kPoints[static_cast<std::size_t>(point) - 1];
    return value == SKEL_VALUE::Deform ? p.deform : p.strength;
}

bool SameStrength(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && CCompFunc::CompRealTol(a, b, kStrengthTol) == 0;
}

bool CPointRule::Holds(const T_BACKBONE_SIDE& side) const
{
    const auto value = [&](std::size_t i) { return side.Value(m_value, m_points[i]); };
    if (m_relation == RELATION::Above0) return ::Below(0, value(0));
    if (m_relation == RELATION::NotBelow0) return NotAbove(0, value(0));
    for (std::size_t i = 0; i + 1 < m_count; ++i) {
        const double a = value(i), b = value(i + 1);
        const bool kept = m_relation == RELATION::Below    ? ::Below(a, b)
                          : m_relation == RELATION::AtMost ? NotAbove(a, b)
                                                           : SameStrength(a, b);
        if (!kept) return false;
    }
    return true;
}

/// "D(C)", on the negative side "D(-C)"; the origin has no sign.
std::string CPointRule::Operand(SKEL_POINT p, const T_HINGE_PLACE& place) const
{
    const bool minus = place.side == HINGE_SIDE::Negative && p != SKEL_POINT::A;
    return std::string(SymbolOf(m_value, place)) + (minus ? "(-" : "(") + NameOf(p) + ")";
}

std::string CPointRule::Text(const T_HINGE_PLACE& place) const
{
    const bool negative = place.side == HINGE_SIDE::Negative;
    if (const char* words = m_words[negative ? 1 : 0])
        return WithSymbol(words, SymbolOf(m_value, place));
    if (m_relation == RELATION::Above0)
        return Operand(m_points[0], place) + (negative ? " < 0" : " > 0");
    if (m_relation == RELATION::NotBelow0)
        return Operand(m_points[0], place) + (negative ? " <= 0" : " >= 0");
    std::vector<SKEL_POINT> chain(m_points.begin(),
                                  m_points.begin() + static_cast<std::ptrdiff_t>(m_count));
    if (negative && m_relation != RELATION::Equal) std::ranges::reverse(chain);
    std::string text = Operand(chain[0], place);
    for (std::size_t i = 1; i < chain.size(); ++i) {
        // The spacing is meant, that of the first comparison of a long mirrored chain as well.
        const char* sign = m_relation == RELATION::Below            ? " <  "
                           : m_relation == RELATION::Equal          ? " = "
                           : negative && i == 1 && chain.size() > 2 ? " <=  "
                                                                    : " <= ";
        text += sign + Operand(chain[i], place);
    }
    return text;
}

/// The relation of two points in words: what is not less, or equal, comes first.
std::string CPointRule::Wording(const T_HINGE_PLACE& place) const
{
    const bool equal = m_relation == RELATION::Equal;
    if (m_count != 2 || (!equal && m_relation != RELATION::AtMost)) return {};
    const bool negative = place.side == HINGE_SIDE::Negative;
    const std::size_t first = equal || negative ? 0 : 1;
    return MMSGFunction::Format(
        equal ? "IDS_RPS_PO_FEMA_EQUAL_TO" : "IDS_RPS_PO_FEMA_EQUAL_TO_OR_LARGER_THAN",
        {Operand(m_points[first], place), Operand(m_points[1 - first], place)});
}

void CPointRule::Walk(const T_BACKBONE_SIDE& side, const T_HINGE_PLACE& place,
                      std::vector<T_FINDING>& out) const
{
    if ((m_applies && !m_applies(side)) || Holds(side)) return;
    const T_HINGE_PLACE at = place.On(side.side);
    const std::string text = Text(at);
    const std::string field = std::string("sides.pos.") + NameOf(m_at) +
                              (m_value == SKEL_VALUE::Deform ? ".deform" : ".strength");
    T_HINGE_HEAD head;
    head.text = text.c_str();
    head.field = field.c_str();
    head.point = NameOf(m_at);
    out.push_back(FindingOf(head, at));
    out.back().wording = Wording(at);
}
