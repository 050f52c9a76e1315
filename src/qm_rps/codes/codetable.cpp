#include "qm_rps/codes/codetable.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace {

/// A value of T_CODE_PLASTIC and its symbol: the one list of them.
struct T_PLASTIC_MEMBER {
    double T_CODE_PLASTIC::*member;
    const char* symbol;
    bool deformation;
};
constexpr std::array<T_PLASTIC_MEMBER, 6> kMembers{{
    {&T_CODE_PLASTIC::a, "a", true},
    {&T_CODE_PLASTIC::b, "b", true},
    {&T_CODE_PLASTIC::c, "c", false},
    {&T_CODE_PLASTIC::IO, "IO", true},
    {&T_CODE_PLASTIC::LS, "LS", true},
    {&T_CODE_PLASTIC::CP, "CP", true},
}};

struct T_WEIGHTED_ROW {
    const T_CODE_ROW* row = nullptr;
    double weight = 1.0;
};
using ROWS = std::vector<const T_CODE_ROW*>;

/// Rows whose variable is one of the two knots around x, each with its share.
struct T_BRACKET {
    ROWS low, high;
    double share = 0.0; // of `high`
};

T_BRACKET BracketOf(const ROWS& rows, std::size_t variable, double x)
{
    double low = -kAnyValue, high = kAnyValue;
    for (const T_CODE_ROW* r : rows) {
        const double knot = r->at[variable];
        if (knot == kAnyValue) continue;
        if (knot <= x) low = std::max(low, knot);
        if (knot >= x) high = std::min(high, knot);
    }
    if (low == -kAnyValue) low = high;
    if (high == kAnyValue) high = low;
    T_BRACKET bracket;
    for (const T_CODE_ROW* r : rows) {
        const double knot = r->at[variable];
        if (knot == kAnyValue || knot == low) bracket.low.push_back(r);
        if (knot == high && high != low) bracket.high.push_back(r);
    }
    if (high > low) bracket.share = (x - low) / (high - low);
    return bracket;
}

void Weigh(const ROWS& rows, std::size_t variable, const std::array<double, 3>& x, double weight,
           std::vector<T_WEIGHTED_ROW>& out)
{
    if (rows.empty() || weight <= 0.0) return;
    if (variable == x.size()) {
        out.push_back({rows.front(), weight});
        return;
    }
    const T_BRACKET bracket = BracketOf(rows, variable, x[variable]);
    Weigh(bracket.low, variable + 1, x, weight * (1.0 - bracket.share), out);
    Weigh(bracket.high, variable + 1, x, weight * bracket.share, out);
}

std::string TextOf(const T_WEIGHTED_ROW& w)
{
    std::string at;
    for (const double knot : w.row->at)
        if (knot != kAnyValue) at += (at.empty() ? "" : "; ") + CodeNumber(knot);
    return CodeNumber(w.weight) + " (" + at + ")";
}

} // namespace

std::optional<T_CODE_PLASTIC> Interpolate(const T_CODE_TABLE& table, int group,
                                          std::string_view name, std::array<double, 3> x,
                                          CCodeSheet& sheet)
{
    ROWS rows;
    for (const T_CODE_ROW& r : table.rows)
        if (r.group == group) rows.push_back(&r);
    if (rows.empty()) {
        sheet.Refuse(CODE_REASON::NoRow, name, table.clause);
        return {};
    }
    for (std::size_t i = 0; i < x.size(); ++i)
        if (std::any_of(rows.begin(), rows.end(), [&](auto* r) { return r->at[i] != kAnyValue; }))
            sheet.Put(table.variables[i], x[i], table.clause, name, CODE_MARK::Computed);
    if (!sheet.Sound()) return {};

    std::vector<T_WEIGHTED_ROW> used;
    Weigh(rows, 0, x, 1.0, used);
    T_CODE_PLASTIC sum;
    std::string text{name};
    CODE_MARK mark = CODE_MARK::Computed;
    for (const T_WEIGHTED_ROW& w : used) {
        text += (&w == &used.front() ? ": " : " + ") + TextOf(w);
        mark = std::max(mark, w.row->mark);
        for (const T_PLASTIC_MEMBER& m : kMembers)
            sum.*m.member += w.weight * (w.row->values.*m.member);
    }
    PutPlastic(sum, table.clause, text, mark, sheet);
    return sum;
}

T_CODE_PLASTIC LeastOf(const T_CODE_PLASTIC& p, const T_CODE_PLASTIC& q)
{
    T_CODE_PLASTIC least;
    for (const T_PLASTIC_MEMBER& m : kMembers)
        least.*m.member = std::min(p.*m.member, q.*m.member);
    return least;
}

T_CODE_PLASTIC Between(const T_CODE_PLASTIC& p, const T_CODE_PLASTIC& q, double weight)
{
    T_CODE_PLASTIC between;
    for (const T_PLASTIC_MEMBER& m : kMembers)
        between.*m.member = p.*m.member + weight * (q.*m.member - p.*m.member);
    return between;
}

T_CODE_PLASTIC Scaled(const T_CODE_PLASTIC& p, double factor)
{
    T_CODE_PLASTIC scaled = p;
    for (const T_PLASTIC_MEMBER& m : kMembers)
        if (m.deformation) scaled.*m.member *= factor;
    return scaled;
}

void PutPlastic(const T_CODE_PLASTIC& p, std::string_view clause, std::string_view text,
                CODE_MARK mark, CCodeSheet& sheet, T_DIM dim)
{
    for (const T_PLASTIC_MEMBER& m : kMembers)
        sheet.Put(m.symbol, p.*m.member, m.deformation ? dim : kDimNone, clause, text, mark);
}

T_CODE_PLASTIC InYields(const T_CODE_PLASTIC& multiples, double yieldDeform,
                        std::string_view clause, std::string_view symbol, CCodeSheet& sheet,
                        T_DIM dim)
{
    const T_CODE_PLASTIC p = Scaled(multiples, yieldDeform);
    PutPlastic(p, clause, "x " + std::string(symbol), CODE_MARK::Computed, sheet, dim);
    return p;
}
