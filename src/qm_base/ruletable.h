// Rules as rows of a table, and the walker that finds the rows that are not kept.
//
//     constexpr T_RULE<T_MASONRY> kRules[] = {
//         {{.message = "IDS_QM_MASONRY_FORM", .field = "form"},
//          [](const T_MASONRY& m) { return m.form == 1 || m.form == 2; },
//          [](const T_MASONRY& m) { return m.active; }},
//     };
//     WalkRules(kRules, masonry, {}, findings);
#pragma once

#include "qm_base/finding.h"

#include <cmath>
#include <cstddef>
#include <span>
#include <type_traits>
#include <vector>

/// Where the data stand in their record.
struct T_RULE_PLACE {
    std::string name{};   // as messages call it
    std::string prefix{}; // of the field: "masonry."
    std::string point{};  // where the rule names none
    int part = -1;        // see T_FINDING
    int page = 0;
};

/// All of a rule but its condition. Of `text` and `key` at most one is given; where neither is, the
/// message says it all. Pointers to texts that outlive the row.
struct T_RULE_HEAD {
    using PLACE = T_RULE_PLACE;
    const char* message = "";   // catalogue key; {1} the place's name, {2} the rule
    const char* text = nullptr; // the rule in symbols: "Pmax >= 0"
    const char* key = nullptr;  // catalogue key of the rule's text
    const char* suffix = "";    // follows the text of the key: " > 0"
    const char* field = "";     // path below the place's prefix
    const char* point = "";     // of a curve; empty: the place's
};

/// Rules with a HEAD of their own have their own FindingOf(HEAD, HEAD::PLACE).
template <class DATA, class HEAD = T_RULE_HEAD>
struct T_RULE {
    HEAD head;
    bool (*holds)(const DATA&);             // must be false for a NaN
    bool (*applies)(const DATA&) = nullptr; // null: always
};

/// The finding of a rule that is not kept.
T_FINDING FindingOf(const T_RULE_HEAD& head, const T_RULE_PLACE& place);

/// Appends what is not kept, in the order of the rows.
template <class DATA, class HEAD>
void WalkRules(std::span<const T_RULE<DATA, HEAD>> rows, const std::type_identity_t<DATA>& data,
               const typename HEAD::PLACE& place, std::vector<T_FINDING>& out)
{
    for (const T_RULE<DATA, HEAD>& rule : rows)
        if ((!rule.applies || rule.applies(data)) && !rule.holds(data))
            out.push_back(FindingOf(rule.head, place));
}
template <class DATA, class HEAD, std::size_t N>
void WalkRules(const T_RULE<DATA, HEAD> (&rows)[N], const std::type_identity_t<DATA>& data,
               const typename HEAD::PLACE& place, std::vector<T_FINDING>& out)
{
    WalkRules(std::span<const T_RULE<DATA, HEAD>>(rows), data, place, out);
}

/// Comparisons of entered values for conditions; false where one is not finite.
inline bool Below(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && a < b;
}
inline bool NotAbove(double a, double b)
{
    return std::isfinite(a) && std::isfinite(b) && a <= b;
}
