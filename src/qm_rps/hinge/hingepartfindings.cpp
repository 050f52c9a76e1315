#include "qm_rps/hinge/hingepartfindings.h"

#include "qm_base/textformat.h"

namespace {

using T_FINDINGS = std::vector<T_FINDING>;
using M = T_MASONRY_HINGE;

constexpr T_RULE<M> kMasonry[] = {
    {{.message = "IDS_QM_MASONRY_FORM", .field = "form"},
     [](const M& m) { return m.form == 1 || m.form == 2; }},
    {{.message = "IDS_RPS_PO_Masonry_Comp_Strength_larger_than_0", .field = "compStrength"},
     [](const M& m) { return Below(0, m.compStrength); }},
    {{.message = "IDS_RPS_PO_Masonry_Shear_Strength_larger_than_0", .field = "shearStrength"},
     [](const M& m) { return Below(0, m.shearStrength); }},
    {{.message = "IDS_RPS_PO_Masonry_Hp_0", .field = "Hp"},
     [](const M& m) { return Below(0, m.Hp); },
     [](const M& m) { return m.form == 1; }},
    {{.message = "IDS_RPS_PO_Masonry_Dist_Coeff_0_1", .field = "distribution"},
     [](const M& m) { return Below(0, m.distribution) && NotAbove(m.distribution, 1); },
     [](const M& m) { return m.form == 2; }},
};

/// A point of a curve beside the one before it.
struct T_POINT_CHECK {
    const T_PM_POINT& now;
    const T_PM_POINT* before; // null: the first, which must only be finite
    bool mayRise = false;     // the moment, on its way to the balanced point
};
using P = T_POINT_CHECK;

constexpr const char* kCurve = "IDS_PUSHOVER_Wrong_Data_in_P_values";
constexpr T_RULE<P> kUserPoint[] = {
    {{.message = kCurve, .text = "P/Pmax", .field = "p"},
     [](const P& c) { return c.before ? NotAbove(c.now.p, c.before->p) : std::isfinite(c.now.p); }},
    {{.message = kCurve, .text = "M/Mmax", .field = "m"},
     [](const P& c) {
         return c.before && !c.mayRise ? NotAbove(c.now.m, c.before->m) : std::isfinite(c.now.m);
     }},
};
constexpr T_RULE<T_PMM_TABLE> kUserTable[] = {
    {{.message = "IDS_PUSHOVER_PMAX_POS", .text = "Pmax >= 0", .field = "Pmax"},
     [](const T_PMM_TABLE& t) { return NotAbove(0, t.Pmax); }},
};

// ---- yield surface ------------------------------------------------------------------------------

constexpr const char* kYield = "IDS_CMD_IEHP_YIELD";
constexpr HINGE_SIDE kSides[] = {HINGE_SIDE::Positive, HINGE_SIDE::Negative};
constexpr HINGE_COMPONENT kAxes[] = {HINGE_COMPONENT::My, HINGE_COMPONENT::Mz};

/// "y" or "z".
const char* AxisName(HINGE_COMPONENT axis)
{
    return axis == HINGE_COMPONENT::My ? "y" : "z";
}
const T_YIELD_AXIS& AxisOf(const T_YIELD_LEVEL& level, HINGE_COMPONENT axis)
{
    return axis == HINGE_COMPONENT::My ? level.y : level.z;
}
template <class T>
const T& SideOf(const T_SIDES<T>& sides, HINGE_SIDE side)
{
    return side == HINGE_SIDE::Positive ? sides.pos : sides.neg;
}

/// A level as it is checked.
struct T_LEVEL_VIEW {
    T_YIELD_LEVEL_NAMES names;
    T_YIELD_LEVEL level;
    bool eurocode = false;
};

void CheckAxial(const T_LEVEL_VIEW& v, T_FINDINGS& out)
{
    const auto check = [&](double force, const std::string& name, const char* field) {
        const std::string rule = name + " > 0";
        if (!Below(0, force))
            out.push_back(
                FindingOf(T_HINGE_HEAD{.message = kYield, .text = rule.c_str(), .field = field},
                          {.prefix = v.names.prefix}));
    };
    check(v.level.tension, v.names.tension, "tension");
    check(v.level.compression, "Pmax(c)", "compression");
}

/// The moment of an axis or, with `max`, the largest one: "MCy(+) > 0", "MYy,max(+) > 0".
void CheckMoment(const T_LEVEL_VIEW& v, HINGE_SIDE side, HINGE_COMPONENT axis, bool max,
                 T_FINDINGS& out)
{
    const T_YIELD_AXIS& a = AxisOf(v.level, axis);
    if (!a.used || Below(0, SideOf(max ? a.momentMax : a.moment, side))) return;
    const std::string name = AxisName(axis);
    const std::string rule = (max ? v.names.momentMax + name + ",max" : v.names.moment + name) +
                             (side == HINGE_SIDE::Positive ? "(+) > 0" : "(-) > 0");
    const std::string field = name + (max ? ".momentMax.pos" : ".moment.pos");
    T_HINGE_PLACE place{.component = static_cast<int>(axis), .prefix = v.names.prefix};
    out.push_back(
        FindingOf(T_HINGE_HEAD{.message = kYield, .text = rule.c_str(), .field = field.c_str()},
                  place.On(side)));
}

/// The moments in the order of the editor: the largest ones last, of an Eurocode level each beside
/// its moment.
void CheckMoments(const T_LEVEL_VIEW& v, T_FINDINGS& out)
{
    if (v.eurocode) {
        for (const HINGE_SIDE side : kSides)
            for (const HINGE_COMPONENT axis : kAxes)
                for (const bool max : {false, true})
                    CheckMoment(v, side, axis, max, out);
        return;
    }
    for (const bool max : {false, true})
        for (const HINGE_SIDE side : kSides)
            for (const HINGE_COMPONENT axis : kAxes)
                CheckMoment(v, side, axis, max, out);
}

bool RatioInside(const P& c)
{
    return Below(-1, c.now.m) && Below(c.now.m, 1);
}
bool Falls(const P& c)
{
    return c.before ? Below(c.now.p, c.before->p) : std::isfinite(c.now.p);
}
constexpr T_HINGE_RULE<P> kRatioPos[] = {
    {{.message = kYield, .text = "-1 < M/MY,max(+) < 1", .field = "m"}, RatioInside}};
constexpr T_HINGE_RULE<P> kRatioNeg[] = {
    {{.message = kYield, .text = "-1 < M/MY,max(-) < 1", .field = "m"}, RatioInside}};
constexpr T_HINGE_RULE<P> kTension[] = {
    {{.message = kYield, .text = "P/Pmax(t)", .field = "p"}, Falls}};
constexpr T_HINGE_RULE<P> kCompression[] = {
    {{.message = kYield, .text = "P/Pmax(c)", .field = "p"}, Falls}};

/// A curve of a used axis.
struct T_CURVE_VIEW {
    std::string field;
    const T_PM_CURVE* curve;
    HINGE_COMPONENT axis;
};

std::vector<T_CURVE_VIEW> CurvesOf(const T_LEVEL_VIEW& view)
{
    std::vector<T_CURVE_VIEW> out;
    for (const HINGE_COMPONENT axis : kAxes) {
        const T_YIELD_AXIS& a = AxisOf(view.level, axis);
        if (!a.used) continue;
        const std::string field = std::string(view.names.prefix) + AxisName(axis) + ".curves.";
        out.push_back({field + "pos", &a.curves.pos, axis});
        out.push_back({field + "neg", &a.curves.neg, axis});
    }
    return out;
}

/// A rule on `count` points of a curve from `first` on.
void WalkPoints(std::span<const T_HINGE_RULE<P>> rules, const T_CURVE_VIEW& v, std::size_t first,
                std::size_t count, T_FINDINGS& out)
{
    for (std::size_t i = first; i < first + count; ++i) {
        const P check{(*v.curve)[i], i == first ? nullptr : &(*v.curve)[i - 1]};
        WalkRules(rules, check,
                  {.component = static_cast<int>(v.axis),
                   .prefix = v.field + "[" + std::to_string(i) + "].",
                   .point = kPmPointNames[i]},
                  out);
    }
}

std::vector<T_LEVEL_VIEW> ViewsOf(const T_YIELD_SURFACE& surface, SKEL_TYPE type)
{
    T_YIELD_LEVEL missing;
    missing.y.used = surface.yield.y.used;
    missing.z.used = surface.yield.z.used;
    std::vector<T_LEVEL_VIEW> views;
    for (const T_YIELD_LEVEL_NAMES& names : YieldLevels(type)) {
        const T_YIELD_LEVEL& level = names.crack ? surface.crack.value_or(missing) : surface.yield;
        views.push_back({names, level, type == SKEL_TYPE::Ec8});
    }
    return views;
}

} // namespace

std::vector<T_YIELD_LEVEL_NAMES> YieldLevels(SKEL_TYPE type)
{
    if (type == SKEL_TYPE::Ec8) return {{"yield.", "PC0(t)", "MC0", "MU"}};
    std::vector<T_YIELD_LEVEL_NAMES> levels;
    if (IsTrilinear(type)) levels.push_back({"crack.", "PC(t)", "MC", "MY", true});
    levels.push_back({"yield.", "PY(t)", "MY", "MU"});
    return levels;
}

std::vector<T_FINDING> YieldSurfaceFindings(const T_YIELD_SURFACE& surface, SKEL_TYPE type)
{
    const std::vector<T_LEVEL_VIEW> views = ViewsOf(surface, type);
    T_FINDINGS out;
    std::vector<T_CURVE_VIEW> curves; // of an axis the positive one, then the negative one
    for (const T_LEVEL_VIEW& view : views) {
        CheckAxial(view, out);
        CheckMoments(view, out);
        for (T_CURVE_VIEW& c : CurvesOf(view))
            curves.push_back(std::move(c));
    }
    for (std::size_t i = 0; i < curves.size(); i += 2)
        for (std::size_t p = 0; p < kPmPointNames.size(); ++p) {
            WalkPoints(kRatioPos, curves[i], p, 1, out);
            WalkPoints(kRatioNeg, curves[i + 1], p, 1, out);
        }
    for (const T_CURVE_VIEW& c : curves) {
        WalkPoints(kTension, c, 5, 5, out);
        WalkPoints(kCompression, c, 0, 5, out);
    }
    return out;
}

std::vector<T_FINDING> PmmFindings(const T_PMM_TABLE& table)
{
    T_FINDINGS out;
    const auto walk = [&](const T_PMM_CURVES& curves, const char* field) {
        for (std::size_t c = 0; c < curves.size(); ++c) {
            bool mayRise = table.balanced;
            for (std::size_t i = 0; i < curves[c].size(); ++i) {
                const P check{curves[c][i], i ? &curves[c][i - 1] : nullptr, mayRise};
                WalkRules(kUserPoint, check,
                          {.prefix = FormatText("%s[%zu][%zu].", field, c, i),
                           .point = std::to_string(i + 1)},
                          out);
                mayRise = mayRise && !(check.before && check.now.m < check.before->m);
            }
        }
    };
    walk(table.curves, "curves");
    if (table.negative) walk(*table.negative, "negative");
    WalkRules(kUserTable, table, {}, out);
    return out;
}

std::vector<T_FINDING> MasonryFindings(const T_MASONRY_HINGE& masonry)
{
    T_FINDINGS out;
    WalkRules(kMasonry, masonry, {}, out);
    return out;
}
