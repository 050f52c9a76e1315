#include "qm_rps/judge/judgedend.h"

#include "qm_base/say.h"
#include "qm_rps/codes/asce41strength.h"
#include "qm_rps/generate/masonryhinge.h"
#include "qm_rps/generate/rchinge.h"
#include "qm_rps/generate/steelhinge.h"
#include "qm_rps/judge/judgedchecks.h"
#include "qm_rps/push/law/lawaxial.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;

/// M / V of a state on the sheet, at least LeastSpan. An end without forces
/// (its hinge has lost them) has what hinges are generated with.
double SpanOf(const T_MEMBER_END& member, const T_END_STATE& s, double longest, const char* beyond,
              CCodeSheet& sheet)
{
    constexpr double kNothing = 1e-9; // of the depth squared times the strength: rounding
    const T_MATL_D& m = member.material;
    const T_MATL_MEAN mean = m.mean.value_or(T_MATL_MEAN{});
    const double M = std::fabs(s.M), V = std::fabs(s.V), depth = member.Depth();
    const double force = kNothing * depth * depth * std::max({m.fck, mean.fc, m.Fy});
    const double least = member.LeastSpan();
    const auto put = [&](double span, const char* text) {
        return sheet.Put("LV", span, kDimLength, "", text, K);
    };
    if (V <= force && M <= force * member.clear)
        return put(member.clear / 2.0, "no forces: clear length/2");
    if (M >= longest * V) return put(longest, beyond);
    return M < least * V ? put(least, "M/V below: min(h; clear length/2)") : put(M / V, "M/V");
}

/// A free or pinned end turns without being bent.
bool IsWithoutMoment(const T_MEMBER_END& member, const T_END_STATE& s)
{
    constexpr double kNothing = 1e-6;
    const double V = std::fabs(s.V);
    return s.flowed == 0.0 && V > 0.0 && std::fabs(s.M) <= kNothing * V * member.clear;
}

/// The deformation of the hinge against its own criteria.
void CheckCriteria(const T_CHECKING& c, T_MODE_CHECK& check)
{
    const double flowed = c.state.flowed;
    const std::vector<double>& marks = flowed < 0.0 ? c.end.marks.neg : c.end.marks.pos;
    if (marks.size() < kLevels) {
        check.why = Say("IDS_QM_JUDGE_NO_CRITERIA");
        return;
    }
    for (std::size_t i = 0; i < kLevels; ++i)
        check.at[i] = T_CHECK{std::fabs(flowed), marks[i]};
}

void CheckByCode(const T_CHECKING& c)
{
    if (c.end.kind == JUDGED_KIND::Joint) return CheckJointOf(c);
    if (c.end.kind == JUDGED_KIND::Brace) return CheckBrace(c);
    switch (c.end.member.material.type) {
    case MATL_CLASS::Steel:
        return CheckSteel(c);
    case MATL_CLASS::Masonry:
        return CheckMasonry(c);
    default:
        return CheckConcrete(c); // refuses what is no concrete
    }
}

} // namespace

// ---- shared -------------------------------------------------------------------------------------

bool IsPositiveSide(const T_JUDGED_END& end, const T_END_STATE& s)
{
    return (s.M >= 0.0) != IsSectionSignOpposite(end.place.component);
}

T_MEMBER_END RotationEnd(const T_JUDGED_END& end, const T_END_STATE& s, CCodeSheet& sheet)
{
    T_MEMBER_END member = end.member;
    member.axial = s.N;
    constexpr double kStoreys = 10.0; // that a wall may go on over, in clear lengths
    const bool wall = member.kind == MEMBER_KIND::Wall;
    member.shearSpan = SpanOf(member, s, wall ? kStoreys * member.clear : member.clear,
                              wall ? "M/V beyond ten clear lengths: these"
                                   : "M/V beyond the clear length: clear length",
                              sheet);
    return member;
}

T_MEMBER_END ShearEnd(const T_JUDGED_END& end, const T_END_STATE& s, CCodeSheet& sheet)
{
    constexpr double kFar = 1000.0; // clear lengths
    T_MEMBER_END member = end.member;
    member.axial = s.N;
    member.shearSpan = SpanOf(member, s, kFar * member.clear, "no shear", sheet);
    return member;
}

std::optional<T_CODE_SIDE> GeneratedSide(const T_MEMBER_END& member, bool positive,
                                         std::string& reason)
{
    T_SIDES<T_CODE_SIDE> sides;
    int done = 0;
    switch (member.material.type) {
    case MATL_CLASS::Steel:
        done = SteelHinge(member, sides, reason);
        break;
    case MATL_CLASS::Masonry:
        done = MasonryHinge(member, sides, reason);
        break;
    default:
        done = RcHinge(member, sides, reason);
    }
    if (done == 0) return {};
    T_CODE_SIDE& side = positive ? sides.pos : sides.neg;
    if (!side.bone.acceptance) {
        reason = Say("IDS_QM_GEN_NO_ANSWER");
        return {};
    }
    std::erase_if(side.warnings, // of the hinge's own shear, which is judged here
                  [](const T_CODE_WARNING& w) { return w.key == "IDS_QM_GEN_WARN_SHEAR"; });
    return std::move(side);
}

std::string ClauseOf(const std::vector<T_CODE_TRACE>& trace,
                     std::initializer_list<std::string_view> symbols)
{
    for (const std::string_view symbol : symbols) {
        const auto at = std::find_if(trace.rbegin(), trace.rend(), [&](const T_CODE_TRACE& line) {
            return line.symbol == symbol;
        });
        if (at != trace.rend()) return at->clause;
    }
    return {};
}

void Keep(const CCodeSheet& sheet, T_MODE_CHECK& check, T_END_CHECKS& out)
{
    check.trace.insert(check.trace.end(), sheet.Trace().begin(), sheet.Trace().end());
    out.warnings.insert(out.warnings.end(), sheet.Warnings().begin(), sheet.Warnings().end());
}

double ChordDemand(const T_CHECKING& c, const T_MEMBER_END& member, CCodeSheet& sheet)
{
    const bool isFree = IsWithoutMoment(member, c.state);
    return sheet.Put("theta", isFree ? 0.0 : std::fabs(c.state.chord), "EN 1998-3 A.3.1",
                     isFree ? "no moment: the end is not bent"
                            : "rotation of the end less that of the chord",
                     K);
}

double SpanChordDemand(const T_CHECKING& c, const T_MEMBER_END& member, CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1998-3 A.3.1";
    const T_END_STATE& s = c.state;
    const double moment = c.end.hinge >= 0 ? s.hingeMoment : s.M, span = member.ShearSpan();
    const double bent = moment * span / (3.0 * member.EI);
    const double sheared = member.GA > 0.0 ? moment / (span * member.GA) : 0.0;
    const double elastic =
        sheet.Put("theta_el", bent + sheared, kClause,
                  "M LV/(3 EI) + M/(LV G Av), of the model: the end against its chord to LV", K);
    const double turned = sheet.Put("theta_h", s.flowed, "", "rotation of the hinge", K);
    return sheet.Put("theta", std::fabs(elastic + turned), kClause, "|theta_el + theta_h|", K);
}

void GeneratedChord(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Rotation);
    CCodeSheet span, sheet;
    const T_MEMBER_END member = RotationEnd(c.end, c.state, span);
    c.out.LV = member.shearSpan;
    const auto side = GeneratedSide(member, IsPositiveSide(c.end, c.state), check.why);
    if (!side) return;
    Keep(span, check, c.out);
    check.trace.insert(check.trace.end(), side->trace.begin(), side->trace.end());
    c.out.warnings.insert(c.out.warnings.end(), side->warnings.begin(), side->warnings.end());
    const double theta = SpanChordDemand(c, member, sheet);
    for (std::size_t i = 0; i < kLevels; ++i) {
        check.at[i] = T_CHECK{theta, (*side->bone.acceptance)[i]};
        check.clause[i] =
            ClauseOf(check.trace, {kLevelNames[1][i], i == 0 ? "theta_y" : "theta_um"});
    }
    c.out.thetaY = side->bone.yieldDeform;
    c.out.ductility = sheet.Put("mu_theta", theta / c.out.thetaY, "", "theta/theta_y", K);
    Keep(sheet, check, c.out);
}

double PlasticRotationOf(const T_JUDGED_END& end, const T_END_STATE& s)
{
    constexpr double kNothing = 1e-9; // rad
    const double elastic = end.spring > 0.0 ? s.hingeMoment / end.spring : 0.0;
    const double turned = std::fabs(s.flowed - elastic);
    return turned > kNothing ? turned : 0.0;
}

void PlasticRotations(const T_CHECKING& c, double axial)
{
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Rotation);
    CCodeSheet span, sheet;
    T_MEMBER_END member = ShearEnd(c.end, c.state, span);
    member.axial = axial;
    if (c.with.gravity) member.gravity = c.with.gravity->N;
    // The rows of tables take the V that the member was designed to have: it does not fall again
    // with the strength of its hinges.
    const double V = std::max(c.state.largestV, std::fabs(c.state.V));
    if (V > 0.0) member.pushed = {V, member.ShearSpan()};
    const auto side = GeneratedSide(member, IsPositiveSide(c.end, c.state), check.why);
    if (!side) return;
    if (c.end.hinge < 0) { // plastic rotations are those of a hinge
        check.why = Say("IDS_QM_JUDGE_NO_HINGE");
        return;
    }
    check.trace = side->trace;
    check.trace.insert(check.trace.end(), span.Trace().begin(), span.Trace().end());
    c.out.warnings = side->warnings;
    const auto none = std::ranges::find(side->warnings, std::string("IDS_QM_CODE_WARN_NO_LATERAL"),
                                        &T_CODE_WARNING::key);
    if (none != side->warnings.end()) {
        check.why = WarningText(*none);
        return;
    }
    c.out.LV = member.shearSpan;
    c.out.thetaY = side->bone.yieldDeform;
    const double theta = sheet.Put("theta_pl", PlasticRotationOf(c.end, c.state), "",
                                   "rotation of the hinge beyond yield", K);
    const double kappa = KappaOf(member.material, sheet);
    for (std::size_t i = 0; i < kLevels; ++i) {
        const char* const level = kLevelNames[0][i];
        const double capacity = kappa * side->bone.Plastic((*side->bone.acceptance)[i]);
        check.at[i] = T_CHECK{theta, sheet.Put(std::string("kappa ") + level, capacity,
                                               "ASCE 41-17 7.5.3.2.1", "kappa times the table", R)};
        check.clause[i] = ClauseOf(check.trace, {level});
    }
    c.out.ductility =
        sheet.Put("ductility", 1.0 + theta / c.out.thetaY, "", "(theta_y + theta_pl)/theta_y", K);
    check.trace.insert(check.trace.end(), sheet.Trace().begin(), sheet.Trace().end());
}

double KappaOf(const T_MATL_D& material, CCodeSheet& sheet)
{
    const auto& level = material.knowledge;
    return AsceKappa(level ? static_cast<ASCE_KNOWLEDGE>(*level) : ASCE_KNOWLEDGE::Minimum, sheet);
}

std::array<double, kLevels> ForceDemands(const char* symbol, double force, double gravity,
                                         T_DIM dim, double gamma, CCodeSheet& sheet)
{
    constexpr std::array<double, kLevels> kChi{1.3, 1.3, 1.0}; // IO, LS, CP
    std::array<double, kLevels> out{};
    sheet.Put(std::string(symbol) + "G", gravity, dim, "", "of the initial loads", K);
    sheet.Put("gamma", gamma, kForceClause, "1.3: critical action", R);
    for (std::size_t i = 0; i < kLevels; ++i)
        out[i] = sheet.Put(std::string(symbol) + "UF* " + kLevelNames[0][i],
                           gamma * kChi[i] * (force - gravity) + gravity, dim, kForceClause,
                           "gamma chi (QUF - QG) + QG, chi = " + CodeNumber(kChi[i]), R);
    return out;
}

// ---- what is judged -----------------------------------------------------------------------------

const T_LEVELS& T_JUDGED_END::Levels() const
{
    if (basis != JUDGE_BASIS::Code || !IsChordCode(By())) return kLevelNames[0];
    return kLevelNames[By() == HINGE_CODE::En1998 ? 1 : 2];
}

std::string T_JUDGED_END::Code() const
{
    if (basis == JUDGE_BASIS::Criteria) return Say("IDS_QM_JUDGE_CRITERIA");
    if (basis == JUDGE_BASIS::Nothing) return {};
    return kHingeCodeNames[static_cast<std::size_t>(By())];
}

std::optional<double> T_CHECK::Ratio() const
{
    if (capacity > 0.0) return demand / capacity;
    return demand > 0.0 ? std::nullopt : std::optional(0.0);
}

const T_MODE_CHECK* T_END_CHECKS::Of(JUDGE_MODE mode) const
{
    const auto at = std::ranges::find(modes, mode, &T_MODE_CHECK::mode);
    return at == modes.end() ? nullptr : &*at;
}

T_MODE_CHECK* T_END_CHECKS::Of(JUDGE_MODE mode)
{
    const auto at = std::ranges::find(modes, mode, &T_MODE_CHECK::mode);
    return at == modes.end() ? nullptr : &*at;
}

std::optional<T_CHECK> T_END_CHECKS::At(JUDGE_MODE mode, std::size_t level) const
{
    const T_MODE_CHECK* const check = Of(mode);
    return check ? check->at[level] : std::nullopt;
}

std::vector<JUDGE_MODE> ModesOf(const T_JUDGED_END& end)
{
    using enum JUDGE_MODE;
    if (end.kind == JUDGED_KIND::Joint) return {Joint};
    if (end.kind == JUDGED_KIND::Brace || end.kind == JUDGED_KIND::Spring) return {Elongation};
    const bool code = end.basis == JUDGE_BASIS::Code;
    if (code && end.member.material.type == MATL_CLASS::Steel && end.member.HasAxial())
        return {Rotation, Shear, Axial};
    // A hinge of shear in masonry keeps its strength up to a drift, which rotation is judged by.
    if (code && end.member.material.type == MATL_CLASS::Masonry && end.shearHinge)
        return {Rotation};
    return {Rotation, Shear};
}

T_END_CHECKS CheckEnd(const T_JUDGED_END& end, const T_END_STATE& s, const T_STATE_CONTEXT& with)
{
    T_END_CHECKS out;
    for (const JUDGE_MODE mode : ModesOf(end)) {
        T_MODE_CHECK& check = out.modes.emplace_back();
        check.mode = mode;
        check.dim = mode == JUDGE_MODE::Rotation     ? kDimNone
                    : mode == JUDGE_MODE::Elongation ? kDimLength
                                                     : kDimForce;
        if (end.basis == JUDGE_BASIS::Nothing) check.why = end.why;
        if (end.basis == JUDGE_BASIS::Criteria && mode == JUDGE_MODE::Shear)
            check.why = Say("IDS_QM_JUDGE_NO_SHEAR");
    }
    const T_CHECKING c{end, s, with, out};
    if (end.basis == JUDGE_BASIS::Criteria) CheckCriteria(c, out.modes.front());
    if (end.basis == JUDGE_BASIS::Code) CheckByCode(c);
    for (T_MODE_CHECK& check : out.modes)
        for (const T_CODE_TRACE& line : check.trace)
            check.leastSure = std::max(check.leastSure, line.mark);
    return out;
}
