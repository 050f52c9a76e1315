#include "qm_rps/judge/judgedend.h"

#include "qm_base/say.h"
#include "qm_rps/codes/en1998backbone.h"
#include "qm_rps/codes/en1998shear.h"
#include "qm_rps/generate/rchinge.h"
#include "qm_rps/push/law/lawaxial.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kForce = "ASCE 41-17 7.5.3.2";

/// The side of the section that the moment compresses.
bool IsPositiveSide(const T_JUDGED_END& end, const T_END_STATE& s)
{
    return (s.M >= 0.0) != IsSectionSignOpposite(end.place.component);
}

/// M / V of a state on the sheet. A point without a moment close to the end does not make a member
/// squat: at least the depth, or half the clear length where that is shorter. An end without forces
/// (its hinge has lost them) has what hinges are generated with.
double SpanOf(const T_MEMBER_END& member, const T_END_STATE& s, double longest, const char* beyond,
              CCodeSheet& sheet)
{
    constexpr double kNothing = 1e-9; // of b h fc: rounding
    const T_MATL_D& m = member.material;
    const double M = std::fabs(s.M), V = std::fabs(s.V);
    const double force = kNothing * member.section.size[0] * member.section.size[1] *
                         std::max(m.fck, m.mean.value_or(T_MATL_MEAN{}).fc);
    const double least = std::min(member.section.size[member.aboutY ? 0 : 1], member.clear / 2.0);
    const auto put = [&](double span, const char* text) {
        return sheet.Put("LV", span, kDimLength, "", text, K);
    };
    if (V <= force && M <= force * member.clear)
        return put(member.clear / 2.0, "no forces: clear length/2");
    if (M >= longest * V) return put(longest, beyond);
    return M < least * V ? put(least, "M/V below: min(h; clear length/2)") : put(M / V, "M/V");
}

/// The end at the axial force of a state. Rotations go with the chord: it is no longer than the
/// clear length.
T_MEMBER_END RotationEnd(const T_JUDGED_END& end, const T_END_STATE& s, CCodeSheet& sheet)
{
    T_MEMBER_END member = end.member;
    member.axial = s.N;
    member.shearSpan =
        SpanOf(member, s, member.clear, "M/V beyond the clear length: clear length", sheet);
    return member;
}

/// The same for shear: of a moment without shear so long that no formula sees its end.
T_MEMBER_END ShearEnd(const T_JUDGED_END& end, const T_END_STATE& s, CCodeSheet& sheet)
{
    constexpr double kFar = 1000.0; // clear lengths
    T_MEMBER_END member = end.member;
    member.axial = s.N;
    member.shearSpan = SpanOf(member, s, kFar * member.clear, "no shear", sheet);
    return member;
}

/// The lines and warnings of a sheet of shear.
void KeepShear(const CCodeSheet& sheet, T_END_CHECKS& out)
{
    out.shearTrace = sheet.Trace();
    out.warnings.insert(out.warnings.end(), sheet.Warnings().begin(), sheet.Warnings().end());
}

// ---- EN 1998-3, Circolare 2019 ------------------------------------------------------------------

std::optional<T_EN_ROTATIONS> RotationsOf(const T_MEMBER_END& member, bool positive,
                                          CCodeSheet& sheet)
{
    const std::optional<T_RC_BASIS> basis = RcBasis(member, positive, sheet);
    const auto en = basis ? EnMember(*basis, sheet) : std::nullopt;
    const auto monotonic = en ? EnMonotonicShear(*basis, basis->material, sheet) : std::nullopt;
    if (!monotonic) return {};
    T_EN_HINGE_IN in;
    in.member = *en;
    in.concreteShear = monotonic->concrete;
    return EnRotations(in, sheet);
}

/// A free or pinned end turns without being bent.
bool IsWithoutMoment(const T_MEMBER_END& member, const T_END_STATE& s)
{
    constexpr double kNothing = 1e-6;
    const double V = std::fabs(s.V);
    return s.flowed == 0.0 && V > 0.0 && std::fabs(s.M) <= kNothing * V * member.clear;
}

void ChordRotations(const T_JUDGED_END& end, const T_END_STATE& s, T_END_CHECKS& out)
{
    CCodeSheet sheet;
    const T_MEMBER_END member = RotationEnd(end, s, sheet);
    out.LV = member.shearSpan;
    const auto found = RotationsOf(member, IsPositiveSide(end, s), sheet);
    if (!found) {
        out.whyNoRotation = ReasonOf(sheet);
        return;
    }
    const bool isFree = IsWithoutMoment(member, s);
    const double theta = sheet.Put("theta", isFree ? 0.0 : std::fabs(s.chord), "EN 1998-3 A.3.1",
                                   isFree ? "no moment: the end is not bent"
                                          : "rotation of the end less that of the chord",
                                   K);
    const T_CHORD_LIMITS& limits = found->limits;
    const std::array<double, kLevels> capacity{limits.DL, limits.SD, limits.NC};
    for (std::size_t i = 0; i < kLevels; ++i)
        out.rotation[i] = T_CHECK{theta, capacity[i]};
    out.thetaY = found->thetaY;
    out.ductility = sheet.Put("mu_theta", theta / out.thetaY, "", "theta/theta_y", K);
    out.rotationTrace = sheet.Trace();
    out.warnings = sheet.Warnings();
}

/// VR of (A.12) with the strengths of brittle checks; the compression zone is that of the means.
void ChordShear(const T_JUDGED_END& end, const T_STATE_CONTEXT& with, T_END_CHECKS& out)
{
    CCodeSheet sheet;
    const T_END_STATE& s = with.shear;
    const T_MEMBER_END member = ShearEnd(end, s, sheet);
    const std::optional<T_RC_BASIS> basis = RcBasis(member, IsPositiveSide(end, s), sheet);
    const auto en = basis ? EnMember(*basis, sheet) : std::nullopt;
    const auto yield = en ? EnYield(*en, sheet) : std::nullopt;
    if (!yield) {
        out.whyNoShear = ReasonOf(sheet);
        return;
    }
    T_RC_MATERIAL material = basis->material;
    const char* const clause =
        end.member.code == HINGE_CODE::En1998 ? "EN 1998-3 A.3.3.1" : "Circolare 2019 C8.7.2.3.5";
    material.fc = sheet.Put("fc", material.fc / with.factors.gammaC, kDimStress, clause,
                            "mean.fc/(CF " + CodeNumber(with.factors.gammaC) + ")", R);
    material.fyw = sheet.Put("fyw", material.fyw / with.factors.gammaS, kDimStress, clause,
                             "mean.fyw/(CF " + CodeNumber(with.factors.gammaS) + ")", R);
    T_EN_MEMBER brittle = *en;
    brittle.fc = material.fc;
    brittle.fyw = material.fyw;
    const auto cyclic = EnCyclicShear(brittle, yield->xi * en->d,
                                      std::max(0.0, out.ductility - 1.0), std::nullopt, sheet);
    const auto monotonic = cyclic ? EnMonotonicShear(*basis, material, sheet) : std::nullopt;
    if (!monotonic) {
        out.whyNoShear = ReasonOf(sheet);
        return;
    }
    const double strength =
        sheet.Put("VR", std::min(cyclic->strength, monotonic->strut), kDimForce,
                  "EN 1998-3 A.3.3.1", "min(VR; VRd,max), 45 degrees", CODE_MARK::SightedOnce);
    out.shear.fill(T_CHECK{std::fabs(s.V), strength});
    KeepShear(sheet, out);
}

// ---- ASCE 41, FEMA 356 --------------------------------------------------------------------------

/// Of the knowledge level; a material without one counts as the least known.
double KappaOf(const T_MEMBER_END& member, CCodeSheet& sheet)
{
    const auto& level = member.material.knowledge;
    return AsceKappa(level ? static_cast<ASCE_KNOWLEDGE>(*level) : ASCE_KNOWLEDGE::Minimum, sheet);
}

void PlasticRotations(const T_JUDGED_END& end, const T_END_STATE& s, T_END_CHECKS& out)
{
    CCodeSheet sheet;
    const T_MEMBER_END member = ShearEnd(end, s, sheet);
    T_SIDES<T_CODE_SIDE> sides;
    if (!RcHinge(member, sides, out.whyNoRotation)) return;
    const T_CODE_SIDE& side = IsPositiveSide(end, s) ? sides.pos : sides.neg;
    if (!side.bone.acceptance) {
        out.whyNoRotation = Say("IDS_QM_GEN_NO_ANSWER");
        return;
    }
    out.rotationTrace = side.trace;
    out.warnings = side.warnings;
    std::erase_if(out.warnings, // of the hinge's own shear, which is judged here
                  [](const T_CODE_WARNING& w) { return w.key == "IDS_QM_GEN_WARN_SHEAR"; });
    out.LV = member.shearSpan;
    out.thetaY = side.bone.yieldDeform;
    const double elastic = end.spring > 0.0 ? s.hingeMoment / end.spring : 0.0;
    const double theta = sheet.Put("theta_pl", std::fabs(s.flowed - elastic), "",
                                   "rotation of the hinge beyond yield", K);
    const double kappa = KappaOf(member, sheet);
    for (std::size_t i = 0; i < kLevels; ++i) {
        const double capacity = kappa * side.bone.Plastic((*side.bone.acceptance)[i]);
        out.rotation[i] =
            T_CHECK{theta, sheet.Put(std::string("kappa ") + kLevelNames[0][i], capacity,
                                     "ASCE 41-17 7.5.3.2.1", "kappa times the table", R)};
    }
    out.ductility =
        sheet.Put("ductility", 1.0 + theta / out.thetaY, "", "(theta_y + theta_pl)/theta_y", K);
    out.rotationTrace.insert(out.rotationTrace.end(), sheet.Trace().begin(), sheet.Trace().end());
}

/// Strength with lower-bound strengths, times kappa.
std::optional<double> ForceStrength(const T_JUDGED_END& end, const T_END_STATE& s, double ductility,
                                    CCodeSheet& sheet)
{
    const T_MEMBER_END member = ShearEnd(end, s, sheet);
    const T_MATL_D& m = member.material;
    const std::optional<T_RC_BASIS> basis = RcBasis(member, IsPositiveSide(end, s), sheet);
    if (!basis || !sheet.Positive({{"fck", m.fck}, {"fyk", m.fyk}})) return {};
    T_RC_MATERIAL lower = basis->material;
    lower.fc = sheet.Put("f'cL", m.fck, kDimStress, kForce, "lower bound: fck", R);
    lower.fyw = sheet.Put("fytL", m.fyk, kDimStress, kForce, "lower bound: fyk", R);
    std::optional<double> strength;
    if (IsUpright(member.kind)) {
        if (const auto found = AsceColumnShearOf(*basis, lower, ductility, sheet))
            strength = found->strength;
    } else if (const auto found = AsceBeamShear(*basis, lower, sheet)) {
        strength = found->Vn;
    }
    if (!strength) return {};
    return sheet.Put("kappa QCL", KappaOf(member, sheet) * *strength, kDimForce, kForce,
                     "kappa times the strength", R);
}

void ForceShear(const T_JUDGED_END& end, const T_STATE_CONTEXT& with, T_END_CHECKS& out)
{
    if (!with.gravityShear) {
        out.whyNoShear = Say("IDS_QM_JUDGE_NO_GRAVITY");
        return;
    }
    CCodeSheet sheet;
    const double gravity = *with.gravityShear;
    const std::optional<double> strength = ForceStrength(end, with.shear, out.ductility, sheet);
    if (!strength) {
        out.whyNoShear = ReasonOf(sheet);
        return;
    }
    constexpr std::array<double, kLevels> kChi{1.3, 1.3, 1.0}; // IO, LS, CP
    sheet.Put("QG", std::fabs(gravity), kDimForce, "", "shear of the initial loads", K);
    sheet.Put("gamma", with.factors.gamma, kForce, "1.3: critical action", R);
    for (std::size_t i = 0; i < kLevels; ++i) {
        const double factor = with.factors.gamma * kChi[i];
        const double demand = std::fabs(factor * (with.shear.V - gravity) + gravity);
        sheet.Put(std::string("QUF* ") + kLevelNames[0][i], demand, kDimForce, kForce,
                  "gamma chi (QUF - QG) + QG, chi = " + CodeNumber(kChi[i]), R);
        out.shear[i] = T_CHECK{demand, *strength};
    }
    KeepShear(sheet, out);
}

// ---- the criteria of a hinge --------------------------------------------------------------------

void HingeRotations(const T_JUDGED_END& end, const T_END_STATE& s, T_END_CHECKS& out)
{
    out.whyNoShear = Say("IDS_QM_JUDGE_NO_SHEAR");
    const std::vector<double>& marks = s.flowed < 0.0 ? end.marks.neg : end.marks.pos;
    if (marks.size() < kLevels) {
        out.whyNoRotation = Say("IDS_QM_JUDGE_NO_CRITERIA");
        return;
    }
    for (std::size_t i = 0; i < kLevels; ++i)
        out.rotation[i] = T_CHECK{std::fabs(s.flowed), marks[i]};
}

} // namespace

const T_LEVELS& T_JUDGED_END::Levels() const
{
    if (basis != JUDGE_BASIS::Code || !IsChordCode(member.code)) return kLevelNames[0];
    return kLevelNames[member.code == HINGE_CODE::En1998 ? 1 : 2];
}

std::string T_JUDGED_END::Code() const
{
    if (basis == JUDGE_BASIS::Criteria) return Say("IDS_QM_JUDGE_CRITERIA");
    if (basis == JUDGE_BASIS::Nothing) return {};
    return kHingeCodeNames[static_cast<std::size_t>(member.code)];
}

std::optional<double> T_CHECK::Ratio() const
{
    if (capacity > 0.0) return demand / capacity;
    return demand > 0.0 ? std::nullopt : std::optional(0.0);
}

T_END_CHECKS CheckEnd(const T_JUDGED_END& end, const T_END_STATE& s, const T_STATE_CONTEXT& with)
{
    T_END_CHECKS out;
    if (end.basis == JUDGE_BASIS::Nothing) {
        out.whyNoRotation = out.whyNoShear = end.why;
        return out;
    }
    if (end.basis == JUDGE_BASIS::Criteria) {
        HingeRotations(end, s, out);
        return out;
    }
    const bool chord = IsChordCode(end.member.code);
    if (chord)
        ChordRotations(end, s, out);
    else
        PlasticRotations(end, s, out);
    if (!out.whyNoRotation.empty()) {
        out.whyNoShear = out.whyNoRotation; // the ductility of its strength is not known
        return out;
    }
    if (chord)
        ChordShear(end, with, out);
    else
        ForceShear(end, with, out);
    return out;
}
