// Beam-column joints by their codes.
#include "qm_base/say.h"
#include "qm_rps/judge/judgedchecks.h"

#include <cmath>

namespace {

constexpr auto R = CODE_MARK::Recalled;

/// Joint shear with its sign: of the bars less that of the column above.
double ShearOf(const T_JOINT& joint, const T_END_STATE& s)
{
    return s.M / joint.lever - s.V;
}

/// Brittle: the mean over the confidence factor over gamma_C, too.
void Reduce(T_JOINT& joint, double gammaC)
{
    CCodeSheet sheet;
    const char* const clause =
        joint.code == HINGE_CODE::En1998 ? "EN 1998-3 2.2.1" : "Circolare 2019 C8.7.2.3.5";
    joint.fcd = sheet.Put("fcd", joint.fc / gammaC, kDimStress, clause,
                          "mean.fc/(CF " + CodeNumber(gammaC) + ")", R);
    joint.trace.insert(joint.trace.end(), sheet.Trace().begin(), sheet.Trace().end());
}

/// Deformation-controlled: up to its yield strength a panel zone passes every limit; beyond, its
/// rotation would have to be known, and the model's joints are rigid.
void CheckPanelOf(const T_CHECKING& c, const T_PANEL_ZONE& zone)
{
    constexpr double kMostAxial = 0.4; // of Pye: the strength holds up to there (AISC 360 J10.6)
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Joint);
    const T_END_STATE& s = c.state;
    check.dim = kDimForce;
    CCodeSheet sheet;
    sheet.Positive({{"columnDepth", zone.joint.columnDepth}, {"columnWeb", zone.joint.columnWeb}});
    sheet.Positive({{"columnFye", zone.joint.columnFye}, {"depth", zone.depth}});
    const double shear = AscePanelShear(s.M, zone.depth, s.V, sheet);
    const double yield = AscePanelStrength(zone.joint, sheet);
    const double axial =
        sheet.Put("P/Pye", std::fabs(s.N) / (zone.joint.columnArea * zone.joint.columnFye),
                  "AISC 360 J10.6", "of the column above", R);
    const double ratio = sheet.Put("Vpz/Vye", shear / yield, "ASCE 41-17 9.4.2.4.3", "", R);
    if (!sheet.Sound()) {
        check.why = FaultText(*sheet.Fault());
        return;
    }
    sheet.Warn("IDS_QM_JUDGE_WARN_PANEL", {});
    Keep(sheet, check, c.out);
    check.clause.fill(ClauseOf(check.trace, {"Vye"}));
    if (axial > kMostAxial)
        check.why = Say("IDS_QM_JUDGE_PANEL_AXIAL", CodeNumber(axial));
    else if (ratio > 1.0)
        check.why = Say("IDS_QM_JUDGE_PANEL_YIELDS", CodeNumber(ratio));
    else
        check.at.fill(T_CHECK{shear, yield});
}

} // namespace

void CheckJointOf(const T_CHECKING& c)
{
    if (c.end.joint->panel) return CheckPanelOf(c, *c.end.joint->panel);
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Joint);
    const T_END_STATE& s = c.with.brittle;
    T_JOINT joint = c.end.joint->joint;
    const bool chord = IsChordCode(joint.code);
    if (!chord && !c.with.gravity) {
        check.why = Say("IDS_QM_JUDGE_NO_GRAVITY");
        return;
    }
    if (chord) Reduce(joint, c.with.factors.gammaC);
    T_JOINT_CHECK found;
    if (CheckJoint(joint, {s.M, s.V, s.N}, found, check.why) == 0) return;
    check.dim = found.dim;
    check.trace = found.trace;
    c.out.warnings = found.warnings;
    check.clause.fill(ClauseOf(check.trace, {"Vj,R", "s_jt,max", "Vj"}));
    if (chord) {
        check.at.fill(T_CHECK{found.demand, found.capacity});
        return;
    }
    CCodeSheet sheet;
    const auto demands = ForceDemands("Vj", ShearOf(joint, s), ShearOf(joint, *c.with.gravity),
                                      kDimForce, c.with.factors.gamma, sheet);
    const double capacity =
        sheet.Put("kappa QCL", KappaOf(c.end.member.material, sheet) * found.capacity, kDimForce,
                  kForceClause, "kappa times the strength", R);
    Keep(sheet, check, c.out);
    for (std::size_t i = 0; i < kLevels; ++i)
        check.at[i] = T_CHECK{std::fabs(demands[i]), capacity};
}
