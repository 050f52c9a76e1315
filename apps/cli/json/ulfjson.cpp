#include "json/ulfjson.h"

#include "json/jsontext.h"

#include <array>

namespace {

constexpr T_JSON_LAYOUT kTop{1, 0}, kItems{2, 1, true}, kItemsIfAny{2, 1};

std::optional<double> Tidy(const std::optional<double>& v)
{
    return v ? std::optional(*v + 0.0) : v; // no "-0"
}

/// "factors" and "constraints"; empty where there is no result.
void Write(CJsonText& w, const std::optional<T_ULF_RESULT>& r)
{
    w.Key("factors").Object(r ? kItems : kItemsIfAny);
    for (std::size_t i = 0; r && i < r->cases.size(); ++i)
        w.Member(r->cases[i].name, r->factors[i] + 0.0);
    w.End();
    w.Key("constraints").List(r ? kItems : kItemsIfAny);
    for (const T_ULF_RESULT_ROW& row : r ? UlfResultRows(*r) : std::vector<T_ULF_RESULT_ROW>()) {
        w.Object(kJsonOneLine);
        w.Member("name", row.name);
        if (!row.place.empty()) w.Member("place", row.place);
        w.Member("value", row.value + 0.0).Member("unit", row.unit);
        w.Member("upper", Tidy(row.upper)).Member("lower", Tidy(row.lower));
        w.Member("residual", row.residual + 0.0).Member("active", row.active);
        w.End();
    }
    w.End();
}

/// Opens the object of what holds or contradicts; the caller ends it.
template <class T>
void WriteLimit(CJsonText& w, const T& h)
{
    static constexpr std::array<const char*, 4> kNames{"target", "upper", "lower", "sign"};
    w.Object(kJsonOneLine);
    w.Member("name", h.name).Member("limit", kNames[static_cast<std::size_t>(h.limit)]);
    w.Member("value", h.value + 0.0).Member("unit", h.unit);
}

} // namespace

std::string UlfJson(const T_ULF_OUTCOME& o, const std::optional<T_ULF_RESULT>& r)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object(kTop);
    w.Member("status", o.status).Member("code", o.solverCode).Member("message", o.message);
    w.Member("mode", o.exact ? "[EXACT]" : "[OPTIMIZE]");
    Write(w, r);
    w.Member("objective", r ? std::optional(UlfObjective(*r)) : std::nullopt);
    if (r && r->linearForecast) w.Member("linear_forecast", true);
    w.End();
    return w.Text();
}

std::string ExplainJson(const T_ULF_EXPLAINED& e)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object(kTop);
    w.Member("solved", e.solved).Member("unknowns", e.unknowns);
    w.Member("rows", e.rows).Member("rank", e.rank).Member("condition", e.condition);
    w.Items("unfelt", e.unfelt, kItemsIfAny);
    w.Member("objective", e.solved ? std::optional(e.objective + 0.0) : std::nullopt);
    w.Key("held").List(kItemsIfAny);
    for (const T_ULF_HOLD& h : e.held) {
        WriteLimit(w, h);
        w.Member("multiplier", h.multiplier + 0.0);
        w.Member("raised", h.raised).Member("lowered", h.lowered).Member("part", h.part);
        w.End();
    }
    w.End();
    w.Key("conflict").List(kItemsIfAny);
    for (const T_ULF_CLASH& c : e.conflict) {
        WriteLimit(w, c);
        w.End();
    }
    w.End();
    w.Member("conflict_with_sign", e.conflictWithSign).Member("not_proved", e.notProved);
    w.Key("compromise");
    if (e.compromise) {
        w.Object({1, 1});
        Write(w, e.compromise);
        w.End();
    } else {
        w.Value(nullptr);
    }
    w.Items("lines", e.lines, kItemsIfAny);
    w.End();
    return w.Text();
}
