// Rules of hinge records as table rows, and where in a hinge type a finding stands.
#pragma once

#include "qm_base/ruletable.h"
#include "qm_db/records.h"

#include <string>
#include <vector>

enum class HINGE_END { Both, I, J };
enum class HINGE_SIDE { None, Positive, Negative };

/// Where a curve stands. curve: its index in the list by axial force; -1: no list.
struct T_HINGE_PLACE {
    int component = -1;
    HINGE_END end = HINGE_END::Both;
    int curve = -1;
    std::string prefix{}; // of the field: "masonry."
    std::string point{};  // where the rule names none
};

/// What a rule's text is: a literal (with %s for the symbol of deformation "D" or strength "F" or
/// "M"), or the key of a catalogue text.
enum class RULE_TEXT { Literal, Deform, Strength, Key };

/// All of a rule but its condition.
struct T_HINGE_HEAD {
    using PLACE = T_HINGE_PLACE;
    const char* messageKey; // {1} component, {2} rule
    RULE_TEXT kind;
    const char* text;       // null: the message says it all
    const char* textMoment; // the same for Mx, My, Mz; null: text
    const char* field;
    HINGE_SIDE side = HINGE_SIDE::None;
    const char* point = "";
    const char* suffix = "";            // follows a catalogue text: " > 0"
    const char* wordingKey = nullptr;   // relation in words, {1} left, {2} right
    const char *left = "", *right = ""; // with %s for the symbol
    int component = -1;                 // of a rule that belongs to one; -1: the place's
};

template <class DATA>
using T_HINGE_RULE = T_RULE<DATA, T_HINGE_HEAD>;

/// The finding of a rule that is not kept.
T_FINDING FindingOf(const T_HINGE_HEAD& head, const T_HINGE_PLACE& place);

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

inline constexpr const char* kHingeRuleMessage =
    "IDS_RPS_Error_Pushove_Hinge_Properties_DOF_s_contains_ERROR";
inline constexpr const char* kHingeItemMessage =
    "IDS_RPS_Error_Pushove_Hinge_Properties_DOF_s_contains_ERROR_Item_s";

inline bool IsMoment(int component)
{
    return component >= static_cast<int>(HINGE_COMPONENT::Mx);
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

/// Keys of the titles of a component's pages, one or two.
std::vector<const char*> PageTitleKeys(const T_HINGE_COMPONENT& c);

/// Key of the title of a component's page: I-end, J-end, both ends alike, or plain.
const char* PageTitleKey(const T_HINGE_COMPONENT& c, HINGE_END end);
