#include "qm_rps/po_hingeyieldpropdlgnew.h"

#include "qm_rps/hinge/hingesiderules.h"
#include "qm_rps/po_hingeyieldpropgrid.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace {

constexpr const char* kMsg = "IDS_CMD_IEHP_YIELD";
constexpr auto kLit = RULE_TEXT::Literal;
constexpr auto kPos = HINGE_SIDE::Positive;
constexpr auto kNeg = HINGE_SIDE::Negative;
constexpr int kMy = static_cast<int>(HINGE_COMPONENT::My);
constexpr int kMz = static_cast<int>(HINGE_COMPONENT::Mz);

using L = T_YIELD_LEVEL;

bool UsesY(const L& l)
{
    return l.y.used;
}
bool UsesZ(const L& l)
{
    return l.z.used;
}
template <double T_YIELD_LEVEL::*FORCE>
bool ForceAbove0(const L& l)
{
    return Below(0, l.*FORCE);
}
/// A moment of an axis: of (+) or (-), MY or the largest one.
template <T_YIELD_AXIS T_YIELD_LEVEL::*AXIS, T_SIDES<double> T_YIELD_AXIS::*WHAT, bool POS>
bool MomentAbove0(const L& l)
{
    const T_SIDES<double>& m = l.*AXIS.*WHAT;
    return Below(0, POS ? m.pos : m.neg);
}
constexpr auto kTension = ForceAbove0<&L::tension>;
constexpr auto kPmax = ForceAbove0<&L::compression>;
constexpr auto kYPos = MomentAbove0<&L::y, &T_YIELD_AXIS::moment, true>;
constexpr auto kYNeg = MomentAbove0<&L::y, &T_YIELD_AXIS::moment, false>;
constexpr auto kZPos = MomentAbove0<&L::z, &T_YIELD_AXIS::moment, true>;
constexpr auto kZNeg = MomentAbove0<&L::z, &T_YIELD_AXIS::moment, false>;
constexpr auto kYMaxPos = MomentAbove0<&L::y, &T_YIELD_AXIS::momentMax, true>;
constexpr auto kYMaxNeg = MomentAbove0<&L::y, &T_YIELD_AXIS::momentMax, false>;
constexpr auto kZMaxPos = MomentAbove0<&L::z, &T_YIELD_AXIS::momentMax, true>;
constexpr auto kZMaxNeg = MomentAbove0<&L::z, &T_YIELD_AXIS::momentMax, false>;

/// Head of the rule of a moment of the component's axis.
constexpr T_HINGE_HEAD Of(int component, const char* text, const char* field, HINGE_SIDE side)
{
    return {kMsg, kLit, text, nullptr, field, side, "", "", nullptr, "", "", component};
}

// clang-format off
const T_HINGE_RULE<L> kCrackRules[] = {
    {{kMsg, kLit, "PC(t) > 0", nullptr, "tension"}, kTension},
    {{kMsg, kLit, "Pmax(c) > 0", nullptr, "compression"}, kPmax},
    {Of(kMy, "MCy(+) > 0", "y.moment.pos", kPos), kYPos, UsesY},
    {Of(kMz, "MCz(+) > 0", "z.moment.pos", kPos), kZPos, UsesZ},
    {Of(kMy, "MCy(-) > 0", "y.moment.neg", kNeg), kYNeg, UsesY},
    {Of(kMz, "MCz(-) > 0", "z.moment.neg", kNeg), kZNeg, UsesZ},
    {Of(kMy, "MYy,max(+) > 0", "y.momentMax.pos", kPos), kYMaxPos, UsesY},
    {Of(kMz, "MYz,max(+) > 0", "z.momentMax.pos", kPos), kZMaxPos, UsesZ},
    {Of(kMy, "MYy,max(-) > 0", "y.momentMax.neg", kNeg), kYMaxNeg, UsesY},
    {Of(kMz, "MYz,max(-) > 0", "z.momentMax.neg", kNeg), kZMaxNeg, UsesZ},
};
const T_HINGE_RULE<L> kYieldRules[] = {
    {{kMsg, kLit, "PY(t) > 0", nullptr, "tension"}, kTension},
    {{kMsg, kLit, "Pmax(c) > 0", nullptr, "compression"}, kPmax},
    {Of(kMy, "MYy(+) > 0", "y.moment.pos", kPos), kYPos, UsesY},
    {Of(kMz, "MYz(+) > 0", "z.moment.pos", kPos), kZPos, UsesZ},
    {Of(kMy, "MYy(-) > 0", "y.moment.neg", kNeg), kYNeg, UsesY},
    {Of(kMz, "MYz(-) > 0", "z.moment.neg", kNeg), kZNeg, UsesZ},
    {Of(kMy, "MUy,max(+) > 0", "y.momentMax.pos", kPos), kYMaxPos, UsesY},
    {Of(kMz, "MUz,max(+) > 0", "z.momentMax.pos", kPos), kZMaxPos, UsesZ},
    {Of(kMy, "MUy,max(-) > 0", "y.momentMax.neg", kNeg), kYMaxNeg, UsesY},
    {Of(kMz, "MUz,max(-) > 0", "z.momentMax.neg", kNeg), kZMaxNeg, UsesZ},
};
const T_HINGE_RULE<L> kEc8Rules[] = {
    {{kMsg, kLit, "PC0(t) > 0", nullptr, "tension"}, kTension},
    {{kMsg, kLit, "Pmax(c) > 0", nullptr, "compression"}, kPmax},
    {Of(kMy, "MC0y(+) > 0", "y.moment.pos", kPos), kYPos, UsesY},
    {Of(kMy, "MUy,max(+) > 0", "y.momentMax.pos", kPos), kYMaxPos, UsesY},
    {Of(kMz, "MC0z(+) > 0", "z.moment.pos", kPos), kZPos, UsesZ},
    {Of(kMz, "MUz,max(+) > 0", "z.momentMax.pos", kPos), kZMaxPos, UsesZ},
    {Of(kMy, "MC0y(-) > 0", "y.moment.neg", kNeg), kYNeg, UsesY},
    {Of(kMy, "MUy,max(-) > 0", "y.momentMax.neg", kNeg), kYMaxNeg, UsesY},
    {Of(kMz, "MC0z(-) > 0", "z.moment.neg", kNeg), kZNeg, UsesZ},
    {Of(kMz, "MUz,max(-) > 0", "z.momentMax.neg", kNeg), kZMaxNeg, UsesZ},
};

/// A point of a curve beside the one before it on the same side of the axial force.
struct T_POINT_CHECK {
    const T_PM_POINT& now;
    const T_PM_POINT* before; // null: the first
};
using P = T_POINT_CHECK;

bool RatioInside(const P& c) { return Below(-1, c.now.m) && Below(c.now.m, 1); }
bool Falls(const P& c) { return c.before ? Below(c.now.p, c.before->p) : std::isfinite(c.now.p); }
const T_HINGE_RULE<P> kRatioPos[] = {{{kMsg, kLit, "-1 < M/MY,max(+) < 1", nullptr, "m", kPos}, RatioInside}};
const T_HINGE_RULE<P> kRatioNeg[] = {{{kMsg, kLit, "-1 < M/MY,max(-) < 1", nullptr, "m", kNeg}, RatioInside}};
const T_HINGE_RULE<P> kFallTension[] = {{{kMsg, kLit, "P/Pmax(t)", nullptr, "p"}, Falls}};
const T_HINGE_RULE<P> kFallCompression[] = {{{kMsg, kLit, "P/Pmax(c)", nullptr, "p"}, Falls}};
// clang-format on

/// A level with its name in the record and the rules of its strengths.
struct T_LEVEL_VIEW {
    const char* prefix;
    const T_YIELD_LEVEL* level;
    std::span<const T_HINGE_RULE<L>> rules;
};

/// A curve of a used axis.
struct T_CURVE_VIEW {
    std::string field;
    const T_PM_CURVE* curve;
    int component;
    HINGE_SIDE side;
};

std::vector<T_CURVE_VIEW> CurvesOf(const T_LEVEL_VIEW& view)
{
    std::vector<T_CURVE_VIEW> out;
    for (const int c : {kMy, kMz}) {
        const T_YIELD_AXIS& axis = c == kMy ? view.level->y : view.level->z;
        if (!axis.used) continue;
        const std::string field = std::string(view.prefix) + (c == kMy ? "y" : "z") + ".curves.";
        out.push_back({field + "pos", &axis.curves.pos, c, kPos});
        out.push_back({field + "neg", &axis.curves.neg, c, kNeg});
    }
    return out;
}

/// One rule on the points first ... first + count - 1 of a curve.
void WalkPoints(std::span<const T_HINGE_RULE<P>> rules, const T_CURVE_VIEW& v, std::size_t first,
                std::size_t count, std::vector<T_FINDING>& out)
{
    for (std::size_t i = first; i < first + count; ++i) {
        const P check{(*v.curve)[i], i == first ? nullptr : &(*v.curve)[i - 1]};
        WalkRules(rules, check,
                  {v.component, HINGE_END::Both, -1, v.field + "[" + std::to_string(i) + "].",
                   kPmPointNames[i]},
                  out);
    }
}

/// The levels of a curve type; `missing` stands in for a crack level that is not there.
std::vector<T_LEVEL_VIEW> LevelsOf(const T_YIELD_SURFACE& s, SKEL_TYPE type, T_YIELD_LEVEL& missing)
{
    missing.y.used = s.yield.y.used;
    missing.z.used = s.yield.z.used;
    if (type == SKEL_TYPE::Ec8) return {{"yield.", &s.yield, kEc8Rules}};
    std::vector<T_LEVEL_VIEW> out;
    if (type == SKEL_TYPE::Trilinear || type == SKEL_TYPE::SlipTrilinear)
        out.push_back({"crack.", s.crack ? &*s.crack : &missing, kCrackRules});
    out.push_back({"yield.", &s.yield, kYieldRules});
    return out;
}

} // namespace

std::vector<T_FINDING> CPO_HingeYieldPropDlgNew::Findings() const
{
    std::vector<T_FINDING> out;
    std::vector<T_CURVE_VIEW> curves;
    T_YIELD_LEVEL missing;
    for (const T_LEVEL_VIEW& view : LevelsOf(m_surface, m_type, missing)) {
        WalkRules(view.rules, *view.level, {-1, HINGE_END::Both, -1, view.prefix}, out);
        for (T_CURVE_VIEW& c : CurvesOf(view))
            curves.push_back(std::move(c));
    }
    for (std::size_t i = 0; i < curves.size(); i += 2)
        for (std::size_t p = 0; p < kPmPointNames.size(); ++p) {
            WalkPoints(kRatioPos, curves[i], p, 1, out);
            WalkPoints(kRatioNeg, curves[i + 1], p, 1, out);
        }
    for (const T_CURVE_VIEW& c : curves) {
        WalkPoints(kFallTension, c, 5, 5, out);
        WalkPoints(kFallCompression, c, 0, 5, out);
    }
    return out;
}

int CPO_HingeYieldPropDlgNew::OnOK()
{
    if (!CheckData()) return 0;
    m_record = m_surface;
    return 1;
}

std::vector<CPO_HingeYieldPropDlgNew::T_LEVEL> CPO_HingeYieldPropDlgNew::Levels()
{
    constexpr const char* yield = "IDS_QM_UI_HINGE_LEVEL_YIELD";
    if (m_type == SKEL_TYPE::Ec8)
        return {{"yield.", yield, &m_surface.yield, "PC0(t)", "MC0", "MU"}};
    std::vector<T_LEVEL> out;
    if (m_type == SKEL_TYPE::Trilinear || m_type == SKEL_TYPE::SlipTrilinear) {
        if (!m_surface.crack) m_surface.crack.emplace();
        out.push_back(
            {"crack.", "IDS_QM_UI_HINGE_LEVEL_CRACK", &*m_surface.crack, "PC(t)", "MC", "MY"});
    }
    out.push_back({"yield.", yield, &m_surface.yield, "PY(t)", "MY", "MU"});
    return out;
}

void CPO_HingeYieldPropDlgNew::OnAxisChk(bool aboutY, bool used)
{
    (aboutY ? m_surface.yield.y : m_surface.yield.z).used = used;
    if (m_surface.crack) (aboutY ? m_surface.crack->y : m_surface.crack->z).used = used;
}

std::string CPO_HingeYieldPropDlgNew::AxisNoteKey(bool aboutY) const
{
    if (aboutY) return m_surface.yield.y.used ? "" : "IDS_RPS_PO_Y_AXIS_NOT_USED";
    return m_surface.yield.z.used ? "" : "IDS_RPS_PO_Z_AXIS_NOT_USED";
}

double CPO_HingeYieldPropDlgNew::MomentNormaliser(const T_YIELD_LEVEL& level)
{
    return std::max({std::fabs(level.y.momentMax.pos), std::fabs(level.y.momentMax.neg),
                     std::fabs(level.z.momentMax.pos), std::fabs(level.z.momentMax.neg)});
}
