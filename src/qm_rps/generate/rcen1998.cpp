#include "qm_rps/codes/confinement.h"
#include "qm_rps/codes/en1998backbone.h"
#include "qm_rps/codes/en1998shear.h"
#include "qm_rps/generate/rchinge.h"
#include "qm_rps/generate/roundcurvature.h"

#include <algorithm>
#include <numbers>

namespace {

constexpr auto K = CODE_MARK::Computed;

/// Rotations of one side, and the depth of the compressed zone at yield.
struct T_SIDE_ROTATIONS {
    T_EN_HINGE hinge;
    double compressed = 0.0;
};

std::optional<T_SIDE_ROTATIONS> OfRectangle(const T_RC_BASIS& in, const T_EN_MEMBER& member,
                                            double concreteShear, CCodeSheet& sheet)
{
    T_EN_HINGE_IN hinge;
    hinge.member = member;
    hinge.concreteShear = concreteShear;
    std::optional<T_EN_HINGE> found = EnHinge(hinge, sheet);
    if (!found) return {};
    return T_SIDE_ROTATIONS{*found, found->yield.xi * in.section.d};
}

/// (A.10) and (A.4) with the curvatures of the section.
std::optional<T_SIDE_ROTATIONS> OfCircle(const T_RC_BASIS& in, const T_EN_MEMBER& m,
                                         double concreteShear, double strength, CCodeSheet& sheet)
{
    const auto confined = Annex3Confined(m.alpha * m.hoopRatio * m.fyw, m.fc, sheet);
    if (!confined) return {};
    const auto curvatures = RoundCurvatures(
        {in.end.section, *confined, m.fc, m.fy, m.Es, m.axial, in.section.coreB}, sheet);
    if (!curvatures) return {};
    const bool cracked = concreteShear < strength / m.shearSpan;
    sheet.Put("aV", cracked ? 1.0 : 0.0, "EN 1998-3 A.3.2.4", "1: VRd,c < My/LV",
              CODE_MARK::SightedTwice);
    const bool en = m.basis == EN_BASIS::En1998;
    const std::optional<double> thetaY =
        EnThetaY(m, en ? THETA_Y::A10b : THETA_Y::CircolareBeam, curvatures->yield, cracked, sheet);
    const LPL_FORM form = en ? LPL_FORM::A9 : LPL_FORM::WithEn1992Confinement;
    const std::optional<double> thetaUm =
        thetaY
            ? EnThetaFromCurvature(m, form, *thetaY, curvatures->yield, curvatures->ultimate, sheet)
            : std::nullopt;
    const auto limits = thetaUm ? EnChordLimits(*thetaY, *thetaUm, m.basis, sheet) : std::nullopt;
    if (!limits) return {};
    T_BACKBONE_IN curve;
    curve.yield = strength;
    curve.yieldDeform = *thetaY;
    const std::optional<T_CODE_BACKBONE> bone = BackboneOfChord(*limits, curve, sheet);
    if (!bone) return {};
    T_SIDE_ROTATIONS r;
    r.hinge.yield.curvature = curvatures->yield;
    r.hinge.yield.moment = strength;
    r.hinge.thetaY = *thetaY;
    r.hinge.thetaUm = *thetaUm;
    r.hinge.backbone = *bone;
    r.compressed = curvatures->compressed;
    return r;
}

/// (A.12) at the ultimate rotation, not above the struts of EN 1992-1-1. A circle counts with the
/// area of its core (A.3.3.1).
std::optional<double> ShearStrength(const T_RC_BASIS& in, T_EN_MEMBER m,
                                    const T_SIDE_ROTATIONS& rotations, double strut,
                                    CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    std::optional<double> hoops;
    if (s.round) {
        const double inner = s.coreB - in.end.section.detailing->stirrupDiameter;
        m.b = std::numbers::pi / 4.0 * inner * inner / m.d;
        hoops = CircularHoopShear(s.legArea, s.spacing, m.fyw, s.h, in.end.section.detailing->cover,
                                  sheet);
        if (!hoops) return {};
    }
    const double ductility = std::max(0.0, rotations.hinge.thetaUm / rotations.hinge.thetaY - 1.0);
    const std::optional<T_EN_CYCLIC_SHEAR> cyclic =
        EnCyclicShear(m, rotations.compressed, ductility, hoops, sheet);
    if (!cyclic) return {};
    return sheet.Put("VR", std::min(cyclic->strength, strut), kDimForce, "EN 1998-3 A.3.3.1",
                     "min(VR; VRd,max), 45 degrees", CODE_MARK::SightedOnce);
}

} // namespace

std::optional<T_CODE_BACKBONE> EnBackbone(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                          CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const std::optional<T_EN_MEMBER> member = EnMember(in, sheet);
    if (!member) return {};
    const auto monotonic = EnMonotonicShear(in, in.material, sheet);
    if (!monotonic) return {};
    const auto found = s.round ? OfCircle(in, *member, monotonic->concrete, side.strength, sheet)
                               : OfRectangle(in, *member, monotonic->concrete, sheet);
    const std::optional<double> length =
        EnHingeLength(*member, LPL_FORM::WithEn1992Confinement, sheet);
    if (!found || !length) return {};
    const auto strength = ShearStrength(in, *member, *found, monotonic->strut, sheet);
    if (!strength) return {};
    side.shearStrength = *strength;
    sheet.Warn("IDS_QM_GEN_WARN_GAMMA", {});
    if (in.end.kind == MEMBER_KIND::Wall && !in.end.pushed)
        sheet.Warn("IDS_QM_GEN_WARN_WALL_SHEAR", {});
    side.hingeLength = *length;
    sheet.Put("My LV/(3 theta_y EI)",
              found->hinge.yield.moment * in.end.ShearSpan() /
                  (3.0 * found->hinge.thetaY * in.end.EI),
              "EN 1998-3 A.3.2.4", "effective over the model's stiffness", K);
    T_CODE_BACKBONE bone = found->hinge.backbone;
    bone.yield = side.strength; // of the section calculator: the strength follows the axial force
    return bone;
}
