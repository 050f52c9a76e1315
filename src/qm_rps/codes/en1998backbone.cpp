#include "qm_rps/codes/en1998backbone.h"

namespace {

/// The second expression of theta_um: information, nothing is made of it.
void PutSecondForm(const T_EN_MEMBER& m, double thetaY, double thetaUm, CCodeSheet& sheet)
{
    if (m.basis != EN_BASIS::En1998) return;
    CCodeSheet own;
    const std::optional<double> plastic = EnThetaPlastic(m, own);
    if (!plastic) return;
    const double second = sheet.Put("theta_y + theta_pl,um", thetaY + *plastic, "EN 1998-3 (A.3)",
                                    "beside (A.1), not used", CODE_MARK::Recalled);
    sheet.Put("(A.3) over (A.1), %", 100.0 * (second / thetaUm - 1.0), "", "difference",
              CODE_MARK::Computed);
}

} // namespace

std::optional<T_EN_ROTATIONS> EnRotations(const T_EN_HINGE_IN& in, CCodeSheet& sheet)
{
    const T_EN_MEMBER& m = in.member;
    if (!sheet.NotNegative({{"concreteShear", in.concreteShear}})) return {};
    const std::optional<T_EN_YIELD> yield = EnYield(m, sheet);
    if (!yield) return {};
    const bool cracked = in.concreteShear < yield->moment / m.shearSpan;
    sheet.Put("aV", cracked ? 1.0 : 0.0, "EN 1998-3 A.3.2.4", "1: VRd,c < My/LV",
              CODE_MARK::SightedTwice);
    const THETA_Y own = m.wall ? THETA_Y::CircolareWall : THETA_Y::CircolareBeam;
    const THETA_Y form = m.basis == EN_BASIS::Circolare2019 ? own : in.form;
    const std::optional<double> thetaY = EnThetaY(m, form, yield->curvature, cracked, sheet);
    const std::optional<double> thetaUm = EnThetaUm(m, sheet);
    if (!thetaY || !thetaUm) return {};
    PutSecondForm(m, *thetaY, *thetaUm, sheet);

    const std::optional<T_CHORD_LIMITS> limits = EnChordLimits(*thetaY, *thetaUm, m.basis, sheet);
    if (!limits) return {};
    return T_EN_ROTATIONS{*yield, *thetaY, *thetaUm, *limits};
}

std::optional<T_EN_HINGE> EnHinge(const T_EN_HINGE_IN& in, CCodeSheet& sheet)
{
    std::optional<T_EN_ROTATIONS> found = EnRotations(in, sheet);
    if (!found) return {};
    T_CHORD_LIMITS& limits = found->limits;
    limits.residual = in.residual;
    T_BACKBONE_IN curve;
    curve.yield = found->yield.moment;
    curve.yieldDeform = found->thetaY;
    curve.slope = in.strengthCap > 1.0 ? 1.0 : 0.0; // up to the cap, which is reached at theta_um
    curve.strengthCap = in.strengthCap;
    const std::optional<T_CODE_BACKBONE> bone = BackboneOfChord(limits, curve, sheet);
    if (!bone) return {};
    return T_EN_HINGE{found->yield, found->thetaY, found->thetaUm, *bone};
}
