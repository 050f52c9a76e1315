// Members of steel: EN 1998-3 Annex B with EN 1993-1-1, Circolare 2019, ASCE 41 and FEMA 356 with
// AISC 360.
#include "qm_base/say.h"
#include "qm_rps/generate/rcend.h"
#include "qm_rps/generate/steelhinge.h"
#include "qm_rps/judge/encolumn.h"
#include "qm_rps/judge/judgedchecks.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;
using enum JUDGE_MODE;

bool FillWhy(T_MODE_CHECK& check, const CCodeSheet& sheet)
{
    check.why = ReasonOf(sheet);
    return false;
}

// ---- shear --------------------------------------------------------------------------------------

/// The shear strength that hinges are generated with; ASCE 41: with the lower-bound yield strength,
/// which is that entered.
std::optional<double> ShearStrength(const T_JUDGED_END& end, CCodeSheet& sheet)
{
    CCodeSheet basis;
    const std::optional<T_STEEL_BASIS> in = SteelBasis(end.member, basis);
    if (!in) {
        sheet = basis;
        return {};
    }
    const bool chord = IsChordCode(end.member.code);
    const auto strength = SteelShear(*in, chord ? in->fy : in->lower, sheet);
    if (!strength) return {};
    const char* const clause = !chord ? (end.member.aboutY ? "AISC 360 G2.1" : "AISC 360 G6")
                               : ClauseOf(sheet.Trace(), {"Vbw"}).empty() ? "EN 1993-1-1 6.2.6"
                                                                          : "EN 1993-1-5 5.2";
    return sheet.Put("Vn", *strength, kDimForce, clause,
                     chord ? "fy over CF" : "with Fy, lower bound", R);
}

bool CheckShear(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(Shear);
    CCodeSheet sheet;
    const auto strength = ShearStrength(c.end, sheet);
    if (!strength) return FillWhy(check, sheet);
    const double V = c.with.brittle.V;
    if (IsChordCode(c.end.By())) {
        const double ratio = std::fabs(V) / *strength;
        if (ratio > 0.5 && ratio <= 1.0)
            sheet.Warn("IDS_QM_GEN_WARN_HALF_SHEAR", {CodeNumber(ratio)});
        check.at.fill(T_CHECK{std::fabs(V), *strength});
    } else {
        if (!c.with.gravity) {
            check.why = Say("IDS_QM_JUDGE_NO_GRAVITY");
            return false;
        }
        const auto demands =
            ForceDemands("Q", V, c.with.gravity->V, kDimForce, c.with.factors.gamma, sheet);
        const double capacity =
            sheet.Put("kappa QCL", KappaOf(c.end.member.material, sheet) * *strength, kDimForce,
                      kForceClause, "kappa times the strength", R);
        for (std::size_t i = 0; i < kLevels; ++i)
            check.at[i] = T_CHECK{std::fabs(demands[i]), capacity};
    }
    Keep(sheet, check, c.out);
    check.clause.fill(ClauseOf(check.trace, {"Vn"}));
    return true;
}

// ---- axial force of columns ---------------------------------------------------------------------

/// The column under the axial force of a state, whose strengths are `fy`.
T_BUCKLING BucklingOf(const T_STEEL_BASIS& in, double fy)
{
    return {in.shape.A, in.end.clear, in.Least(), fy, in.E};
}

/// Moments about y and z of a state of the end.
T_STEEL_FORCES ForcesOf(const T_MEMBER_END& member, double N, double M, double across)
{
    return member.aboutY ? T_STEEL_FORCES{N, M, across} : T_STEEL_FORCES{N, across, M};
}

/// Compression against buckling; with the moments where the code counts on no rotation.
bool EnAxial(const T_CHECKING& c, const T_STEEL_BASIS& in, bool withMoments, CCodeSheet& sheet)
{
    T_MODE_CHECK& check = c.Of(Axial);
    const T_END_STATE& s = c.with.brittle;
    const auto buckled = EnColumnBuckled(in, in.iz > in.iy, sheet);
    if (!buckled) return FillWhy(check, sheet);
    const double pressed = std::max(0.0, s.N);
    if (!withMoments || pressed > buckled->strength) { // nothing is left for moments
        check.clause.fill("EN 1993-1-1 6.3.1");
        check.at.fill(T_CHECK{pressed, buckled->strength});
        return true;
    }
    const auto both = EnColumn(in, ForcesOf(in.end, s.N, s.M, s.across),
                               PlasticRotationOf(c.end, s) > 0.0, sheet);
    if (!both) return FillWhy(check, sheet);
    check.dim = kDimNone;
    check.clause.fill(both->clause);
    check.at.fill(T_CHECK{both->ratio, 1.0});
    return true;
}

bool AsceAxial(const T_CHECKING& c, const T_STEEL_BASIS& in, bool withMoments, CCodeSheet& sheet)
{
    T_MODE_CHECK& check = c.Of(Axial);
    const T_END_STATE &s = c.with.brittle, &g = *c.with.gravity;
    const double gamma = c.with.factors.gamma, kappa = KappaOf(in.end.material, sheet);
    const auto buckled = AiscBuckling(BucklingOf(in, in.lower), in.shape, sheet);
    if (!buckled) return FillWhy(check, sheet);
    const double PCL = sheet.Put("kappa P_CL", kappa * *buckled, kDimForce, kForceClause,
                                 "kappa times Pn with the lower-bound Fy", R);
    const auto N = ForceDemands("P", s.N, g.N, kDimForce, gamma, sheet);
    check.clause.fill(withMoments ? "AISC 360 H1.1" : "AISC 360 E3");
    if (!withMoments) {
        for (std::size_t i = 0; i < kLevels; ++i)
            check.at[i] = T_CHECK{std::max(0.0, N[i]), PCL};
        return true;
    }
    // H1.1 takes plastic moments: plates that do not reach them are not checked.
    if (!AiscPlastic(in.shape, in.lower, in.E, false, true, sheet)) return FillWhy(check, sheet);
    const T_SECT_D& section = in.end.section;
    const auto M = ForceDemands("M", s.M, g.M, kDimMoment, gamma, sheet);
    const auto across = ForceDemands("M across ", s.across, g.across, kDimMoment, gamma, sheet);
    check.dim = kDimNone;
    for (std::size_t i = 0; i < kLevels; ++i) {
        const double pulled = kappa * in.shape.A * in.lower;
        const T_STEEL_PLASTIC_STRENGTH available{N[i] > 0.0 ? PCL : pulled,
                                                 kappa * section.Zy * in.lower,
                                                 kappa * section.Zz * in.lower};
        const auto ratio =
            AiscInteraction(available, ForcesOf(in.end, N[i], M[i], across[i]), sheet);
        if (!ratio) {
            check.at.fill(std::nullopt);
            return FillWhy(check, sheet);
        }
        check.at[i] = T_CHECK{*ratio, 1.0};
    }
    return true;
}

/// withMoments: no rotation may be counted on.
bool CheckAxial(const T_CHECKING& c, bool withMoments)
{
    T_MODE_CHECK& check = c.Of(Axial);
    const bool chord = IsChordCode(c.end.By());
    if (!chord && !c.with.gravity) {
        check.why = Say("IDS_QM_JUDGE_NO_GRAVITY");
        return false;
    }
    CCodeSheet sheet;
    T_MEMBER_END member = c.end.member;
    member.axial = c.with.brittle.N;
    const std::optional<T_STEEL_BASIS> in = SteelBasis(member, sheet);
    if (!in) return FillWhy(check, sheet);
    sheet.Put("N", in->axial, kDimForce, "", "compression positive", K);
    sheet.Put("K L", member.clear, kDimLength, "", "clear length, K = 1", K);
    if (!(chord ? EnAxial(c, *in, withMoments, sheet) : AsceAxial(c, *in, withMoments, sheet)))
        return false;
    Keep(sheet, check, c.out);
    return true;
}

/// The code counts on no rotation under this axial force: P_G/Pye above 0.6, P/P_CL above 0.5
/// (ASCE 41); N/Npl above 0.30 (EN 1998-3 Annex B).
bool CountsOnNoRotation(const T_CHECKING& c)
{
    if (!c.end.member.HasAxial()) return false;
    if (!IsChordCode(c.end.By())) return c.Of(Rotation).why == Say("IDS_QM_GEN_FORCE");
    constexpr double kMost = 0.30;
    CCodeSheet sheet;
    const std::optional<T_STEEL_BASIS> in = SteelBasis(c.end.member, sheet);
    return in && std::max(0.0, c.state.N) > kMost * in->strength.Npl;
}

/// In place of what the code gives: its plastic rotation against none.
void PutNoRotation(const T_CHECKING& c)
{
    T_MODE_CHECK check;
    check.dim = kDimNone;
    CCodeSheet sheet;
    const double turned = sheet.Put("theta_pl", PlasticRotationOf(c.end, c.state), "",
                                    "of the hinge; under this axial force none is counted on", K);
    check.at.fill(T_CHECK{turned, 0.0});
    check.clause.fill(IsChordCode(c.end.By()) ? "EN 1998-3 Annex B" : "ASCE 41 9.4.2.4.2");
    Keep(sheet, check, c.out);
    c.Of(Rotation) = std::move(check);
}

void CheckRotation(const T_CHECKING& c)
{
    if (IsChordCode(c.end.By())) return GeneratedChord(c);
    // Table 9-7.1 and AISC 342 C3.6 count P of the gravity loads.
    const bool ofGravity =
        (c.end.By() == HINGE_CODE::Asce17 || c.end.By() == HINGE_CODE::Aisc342) &&
        c.end.member.HasAxial();
    if (ofGravity && !c.with.gravity) {
        c.Of(Rotation).why = Say("IDS_QM_JUDGE_NO_GRAVITY");
        return;
    }
    PlasticRotations(c, ofGravity ? c.with.gravity->N : c.state.N);
}

/// The rows of beams hold without axial force: up to 0.25 Npl the moment need not be reduced (EN
/// 1993-1-1 6.2.9.1(4)), beyond 0.1 Pye ASCE 41-17 9.4.2.4.2 takes beams for columns (recalled).
void LeaveOutPressedBeam(const T_CHECKING& c)
{
    const T_MEMBER_END& m = c.end.member;
    const double yield =
        m.material.mean && m.material.mean->fy > 0.0 ? m.material.mean->fy : m.material.Fy;
    const double most = IsChordCode(c.end.By()) ? 0.25 : 0.1;
    const double ratio = std::fabs(c.state.N) / (m.section.area * yield);
    if (m.kind != MEMBER_KIND::Beam || !(ratio > most)) return;
    T_MODE_CHECK& check = c.Of(Rotation);
    check.at = {};
    check.why = Say("IDS_QM_JUDGE_BEAM_AXIAL", CodeNumber(ratio), CodeNumber(most));
}

} // namespace

void CheckSteel(const T_CHECKING& c)
{
    CheckRotation(c);
    LeaveOutPressedBeam(c);
    (void)CheckShear(c);
    if (c.end.member.aboutY && BucklesSideways(c.end.member.section))
        c.out.warnings.push_back({kNoSidewaysKey, {}});
    if (!c.out.Of(Axial)) return;
    const bool withMoments = CountsOnNoRotation(c);
    if (withMoments) PutNoRotation(c);
    (void)CheckAxial(c, withMoments);
}

void CheckBrace(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(Elongation);
    const bool chord = IsChordCode(c.end.By());
    const T_END_STATE& s = c.state;
    const double elastic = c.end.spring > 0.0 ? s.hingeMoment / c.end.spring : 0.0;
    const double deformed = chord ? s.chord : s.flowed - elastic;
    T_SIDES<T_CODE_SIDE> sides;
    if (SteelBrace(c.end.member, sides, check.why) == 0) return;
    const bool tension = deformed == 0.0 ? s.N <= 0.0 : deformed > 0.0;
    const T_CODE_SIDE& side = tension ? sides.pos : sides.neg;
    if (!side.bone.acceptance) {
        check.why = Say("IDS_QM_GEN_NO_ANSWER");
        return;
    }
    check.trace = side.trace;
    c.out.warnings = side.warnings;
    CCodeSheet sheet;
    const double demand =
        sheet.Put(chord ? "Delta" : "Delta_pl", std::fabs(deformed), kDimLength, "",
                  chord ? "elongation of the member" : "of the hinge beyond yield", K);
    const double kappa = chord ? 1.0 : KappaOf(c.end.member.material, sheet);
    for (std::size_t i = 0; i < kLevels; ++i) {
        const double limit = (*side.bone.acceptance)[i];
        const double capacity = chord
                                    ? limit
                                    : sheet.Put(std::string("kappa ") + kLevelNames[0][i],
                                                kappa * side.bone.Plastic(limit), kDimLength,
                                                "ASCE 41-17 7.5.3.2.1", "kappa times the table", R);
        check.at[i] = T_CHECK{demand, capacity};
        check.clause[i] = ClauseOf(check.trace, {kLevelNames[chord ? 1 : 0][i]});
    }
    Keep(sheet, check, c.out);
}
