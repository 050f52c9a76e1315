// Members of concrete: EN 1998-3 Annex A, Circolare 2019, ASCE 41, FEMA 356.
#include "qm_base/say.h"
#include "qm_rps/codes/en1998backbone.h"
#include "qm_rps/codes/en1998shear.h"
#include "qm_rps/generate/rchinge.h"
#include "qm_rps/judge/judgedchecks.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;

bool IsRound(const T_JUDGED_END& end)
{
    return end.member.section.shape == SECT_SHAPE::Circle;
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

void ChordRotations(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Rotation);
    CCodeSheet sheet;
    const T_MEMBER_END member = RotationEnd(c.end, c.state, sheet);
    c.out.LV = member.shearSpan;
    const auto found = RotationsOf(member, IsPositiveSide(c.end, c.state), sheet);
    if (!found) {
        check.why = ReasonOf(sheet);
        return;
    }
    const double theta = SpanChordDemand(c, member, sheet);
    const T_CHORD_LIMITS& limits = found->limits;
    const std::array<double, kLevels> capacity{limits.DL, limits.SD, limits.NC};
    c.out.thetaY = found->thetaY;
    c.out.ductility = sheet.Put("mu_theta", theta / c.out.thetaY, "", "theta/theta_y", K);
    Keep(sheet, check, c.out);
    for (std::size_t i = 0; i < kLevels; ++i) {
        check.at[i] = T_CHECK{theta, capacity[i]};
        check.clause[i] = ClauseOf(check.trace, {i == 0 ? "theta_y" : "theta_um"});
    }
}

/// VR of (A.12) with the strengths of brittle checks; the compression zone is that of the means.
std::optional<double> ChordStrength(const T_CHECKING& c, CCodeSheet& sheet)
{
    const T_END_STATE& s = c.with.brittle;
    const T_JUDGE_FACTORS& factors = c.with.factors;
    const T_MEMBER_END member = ShearEnd(c.end, s, sheet);
    const std::optional<T_RC_BASIS> basis = RcBasis(member, IsPositiveSide(c.end, s), sheet);
    const auto en = basis ? EnMember(*basis, sheet) : std::nullopt;
    const auto yield = en ? EnYield(*en, sheet) : std::nullopt;
    if (!yield) return {};
    T_RC_MATERIAL material = basis->material;
    const char* const clause =
        c.end.By() == HINGE_CODE::En1998 ? "EN 1998-3 A.3.3.1" : "Circolare 2019 C8.7.2.3.5";
    material.fc = sheet.Put("fc", material.fc / factors.gammaC, kDimStress, clause,
                            "mean.fc/(CF " + CodeNumber(factors.gammaC) + ")", R);
    material.fyw = sheet.Put("fyw", material.fyw / factors.gammaS, kDimStress, clause,
                             "mean.fyw/(CF " + CodeNumber(factors.gammaS) + ")", R);
    T_EN_MEMBER brittle = *en;
    brittle.fc = material.fc;
    brittle.fyw = material.fyw;
    const auto cyclic = EnCyclicShear(brittle, yield->xi * en->d,
                                      std::max(0.0, c.out.ductility - 1.0), std::nullopt, sheet);
    const auto monotonic = cyclic ? EnMonotonicShear(*basis, material, sheet) : std::nullopt;
    if (!monotonic) return {};
    return sheet.Put("VR", std::min(cyclic->strength, monotonic->strut), kDimForce,
                     "EN 1998-3 A.3.3.1", "min(VR; VRd,max), 45 degrees", CODE_MARK::SightedOnce);
}

void ChordShear(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Shear);
    if (IsRound(c.end)) {
        check.why = Say("IDS_QM_JUDGE_ROUND_SHEAR");
        return;
    }
    CCodeSheet sheet;
    const std::optional<double> strength = ChordStrength(c, sheet);
    if (!strength) {
        check.why = ReasonOf(sheet);
        return;
    }
    Keep(sheet, check, c.out);
    check.at.fill(T_CHECK{std::fabs(c.with.brittle.V), *strength});
    check.clause.fill(ClauseOf(check.trace, {"Vw"})); // (A.12) and what limits it
}

// ---- ASCE 41, FEMA 356 --------------------------------------------------------------------------

/// Strength with lower-bound strengths, times kappa.
std::optional<double> ForceStrength(const T_CHECKING& c, CCodeSheet& sheet)
{
    const T_END_STATE& s = c.with.brittle;
    T_MEMBER_END member = ShearEnd(c.end, s, sheet);
    member.gravity = c.with.gravity->N;
    const T_MATL_D& m = member.material;
    const std::optional<T_RC_BASIS> basis = RcBasis(member, IsPositiveSide(c.end, s), sheet);
    if (!basis || !sheet.Positive({{"fck", m.fck}, {"fyk", m.fyk}})) return {};
    T_RC_MATERIAL lower = basis->material;
    lower.fc = sheet.Put("f'cL", m.fck, kDimStress, kForceClause, "lower bound: fck", R);
    lower.fyw = sheet.Put("fytL", m.fyk, kDimStress, kForceClause, "lower bound: fyk", R);
    const T_RC_BENDING& section = basis->section;
    std::optional<double> strength;
    if (member.kind == MEMBER_KIND::Wall) {
        strength = AciWallShear(section.area, lower.fc, lower.fyw,
                                section.shear / (section.b * section.spacing), sheet);
    } else if (IsUpright(member.kind)) {
        if (const auto found = AsceColumnShearOf(*basis, lower, c.out.ductility, sheet))
            strength = found->strength;
    } else if (const auto found = AsceBeamShear(*basis, lower, sheet)) {
        strength = found->Vn;
    }
    if (!strength) return {};
    return sheet.Put("kappa QCL", KappaOf(m, sheet) * *strength, kDimForce, kForceClause,
                     "kappa times the strength", R);
}

void ForceShear(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Shear);
    if (!c.with.gravity) {
        check.why = Say("IDS_QM_JUDGE_NO_GRAVITY");
        return;
    }
    CCodeSheet sheet;
    const std::optional<double> strength = ForceStrength(c, sheet);
    if (!strength) {
        check.why = ReasonOf(sheet);
        return;
    }
    const auto demands = ForceDemands("Q", c.with.brittle.V, c.with.gravity->V, kDimForce,
                                      c.with.factors.gamma, sheet);
    Keep(sheet, check, c.out);
    for (std::size_t i = 0; i < kLevels; ++i)
        check.at[i] = T_CHECK{std::fabs(demands[i]), *strength};
    check.clause.fill(ClauseOf(check.trace, {"V_Col", "Vn"}));
}

} // namespace

void CheckConcrete(const T_CHECKING& c)
{
    const bool chord = IsChordCode(c.end.By());
    if (chord && IsRound(c.end))
        GeneratedChord(c);
    else if (chord)
        ChordRotations(c);
    else
        PlasticRotations(c, c.state.N);
    const std::string& why = c.Of(JUDGE_MODE::Rotation).why;
    const bool needsRotation = chord || c.end.member.kind == MEMBER_KIND::Column;
    if (!why.empty() && needsRotation)
        c.Of(JUDGE_MODE::Shear).why = why; // the ductility of its strength is not known
    else if (chord)
        ChordShear(c);
    else
        ForceShear(c);
}
