// Rules of hinge records as table rows, and where in a hinge type a finding stands.
#pragma once

#include "qm_base/ruletable.h"
#include "qm_db/records.h"

#include <string>
#include <vector>

enum class HINGE_END { Both, I, J };
enum class HINGE_SIDE { Positive, Negative };

inline constexpr const char* kHingeRuleMessage =
    "IDS_RPS_Error_Pushove_Hinge_Properties_DOF_s_contains_ERROR";
inline constexpr const char* kHingeItemMessage =
    "IDS_RPS_Error_Pushove_Hinge_Properties_DOF_s_contains_ERROR_Item_s";

/// Where a curve stands. curve: its index in the list by axial force; -1: no list.
struct T_HINGE_PLACE {
    int component = -1; // HINGE_COMPONENT; -1: of none
    HINGE_END end = HINGE_END::Both;
    int curve = -1;
    std::string prefix{}; // of the field: "yield."
    std::string point{};  // where the rule names none
    HINGE_SIDE side = HINGE_SIDE::Positive;

    T_HINGE_PLACE On(HINGE_SIDE which) const
    {
        T_HINGE_PLACE place = *this;
        place.side = which;
        return place;
    }
};

/// Catalogue keys of the two sides; without `neg` that of `pos` serves both.
struct T_SIDE_KEY {
    const char* pos = nullptr;
    const char* neg = nullptr;
};

/// All of a rule but its condition, as of the positive side: that of the negative one is made from
/// it. Without text and key the message says it all.
struct T_HINGE_HEAD {
    using PLACE = T_HINGE_PLACE;
    const char* message = kHingeRuleMessage; // {1} component, {2} rule
    const char* text = nullptr;              // the rule in symbols, alike on both sides
    T_SIDE_KEY key{};                        // catalogue text that says it
    T_SIDE_KEY momentKey{};                  // that of Mx, My and Mz, where they have their own
    const char* suffix = "";                 // follows the catalogue text: " > 0"
    const char* field = "";                  // "sides.pos.yield"
    const char* point = "";
};

template <class DATA>
using T_HINGE_RULE = T_RULE<DATA, T_HINGE_HEAD>;

/// The finding of a rule that is not kept.
T_FINDING FindingOf(const T_HINGE_HEAD& head, const T_HINGE_PLACE& place);

/// The path of a member of the positive side on the other one: "sides.neg.yield".
std::string FieldOn(HINGE_SIDE side, std::string field);

/// Rule by rule, each on all sides before the next. SIDES: values with a member `side`.
template <class RULES, class SIDES>
void WalkRulesBySide(const RULES& rules, const SIDES& sides, const T_HINGE_PLACE& place,
                     std::vector<T_FINDING>& out)
{
    for (const auto& rule : rules)
        for (const auto& side : sides)
            WalkRules(std::span(&rule, 1), side, place.On(side.side), out);
}

/// The component and the end of a finding; it must have a component (part).
inline HINGE_COMPONENT ComponentOf(const T_FINDING& f)
{
    return static_cast<HINGE_COMPONENT>(f.part);
}
inline HINGE_END EndOf(const T_FINDING& f)
{
    return static_cast<HINGE_END>(f.page);
}

/// Where the finding stands in a hinge type: "My.sides.pos.B.strength", of the J-end
/// "My.J.sides.pos.B.strength"; the field alone where it is of no component.
std::string PathInType(const T_FINDING& f);
/// Where it stands on the pages of one component: of the J-end "J.sides.pos.B.strength".
std::string PathOnPages(const T_FINDING& f);

inline bool IsMoment(HINGE_COMPONENT component)
{
    return component >= HINGE_COMPONENT::Mx;
}
inline bool IsBending(HINGE_COMPONENT component)
{
    return component == HINGE_COMPONENT::My || component == HINGE_COMPONENT::Mz;
}
inline bool IsTrilinear(SKEL_TYPE type)
{
    return type == SKEL_TYPE::Trilinear || type == SKEL_TYPE::SlipTrilinear;
}
inline bool IsSlip(SKEL_TYPE type)
{
    return type == SKEL_TYPE::SlipBilinear || type == SKEL_TYPE::SlipTrilinear;
}

/// The type is for elements with a section; links and point springs have none.
inline bool HasLineElement(const T_PHGT_D& type)
{
    return type.element != HINGE_ELEMENT::GeneralLink && type.element != HINGE_ELEMENT::PointSpring;
}

/// A component of a hinge type.
inline const T_HINGE_COMPONENT& At(const T_PHGT_D& type, HINGE_COMPONENT c)
{
    return type.components[static_cast<std::size_t>(c)];
}
inline T_HINGE_COMPONENT& At(T_PHGT_D& type, HINGE_COMPONENT c)
{
    return type.components[static_cast<std::size_t>(c)];
}

/// Separate pages for the I-end and the J-end.
inline bool NeedsIJPages(const T_HINGE_COMPONENT& c)
{
    return !c.sameEnds && c.location == HINGE_LOCATION::BothEnds;
}

/// Calls use(end, curve) for each page of a component: two where the ends differ, else one.
template <class COMPONENT, class USE>
void ForEachPage(COMPONENT& c, USE use)
{
    if (NeedsIJPages(c)) {
        use(HINGE_END::I, c.curves.I);
        use(HINGE_END::J, c.curves.J);
        return;
    }
    const bool jEnd = c.location == HINGE_LOCATION::JEnd;
    const HINGE_END end = c.location == HINGE_LOCATION::IEnd ? HINGE_END::I
                          : jEnd                             ? HINGE_END::J
                                                             : HINGE_END::Both;
    use(end, jEnd && !c.sameEnds ? c.curves.J : c.curves.I);
}

/// Key of the title of a component's page: I-end, J-end, both ends alike, or plain.
const char* PageTitleKey(const T_HINGE_COMPONENT& c, HINGE_END end);
