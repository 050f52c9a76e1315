#include "qm_rps/generate/rchinge.h"

#include "qm_base/say.h"
#include "qm_rps/codes/asce41strength.h"
#include "qm_rps/codes/concreteshear.h"
#include "qm_rps/codes/confinement.h"
#include "qm_rps/codes/en1998backbone.h"
#include "qm_rps/codes/en1998shear.h"
#include "qm_rps/hinge/sectionstrength.h"

#include <algorithm>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr const char* kBending = "EN 1992-1-1 3.1.7, 6.1";
constexpr const char* kCapacity = "";
constexpr T_UNITS kSi{FORCE_UNIT::N, LENGTH_UNIT::m};

/// What both sides share.
struct T_BASIS {
    const T_RC_END& end;
    T_RC_BENDING section;
    T_RC_MATERIAL material;
    double axial = 0.0; // that counts
};

ASCE_EDITION EditionOf(const T_RC_END& end)
{
    if (end.code == HINGE_CODE::Asce17) return ASCE_EDITION::Asce17;
    if (end.code == HINGE_CODE::Asce13) return ASCE_EDITION::Asce13;
    return end.secondary ? ASCE_EDITION::Fema356Secondary : ASCE_EDITION::Fema356Primary;
}

void WarnShear(const T_RC_SIDE& side, CCodeSheet& sheet)
{
    if (side.shear > side.shearStrength)
        sheet.Warn("IDS_QM_GEN_WARN_SHEAR", {CodeNumber(side.shear / side.shearStrength)});
}

// ---- ASCE 41, FEMA 356 --------------------------------------------------------------------------

std::optional<T_CODE_PLASTIC> AsceBeamEnd(const T_BASIS& in, T_RC_SIDE& side, CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const std::optional<double> share = AsceTieShare(s.spacing, s.d, sheet);
    if (!share) return {};
    T_SHEAR_SECTION shear{s.b,
                          s.d,
                          s.b * s.h,
                          in.material.fc,
                          in.material.fyw,
                          s.As / (s.b * s.d),
                          0.0,
                          s.shear * *share,
                          s.spacing};
    const std::optional<T_ACI_SHEAR> strength = AciShear(shear, 1.0, sheet);
    if (!strength) return {};
    side.shearStrength = strength->Vn;
    const T_SECT_DETAIL& detail = *in.end.section.detailing;
    T_ASCE_BEAM beam;
    beam.bw = s.b;
    beam.d = s.d;
    beam.fc = in.material.fc;
    beam.fy = in.material.fy;
    beam.Es = in.material.Es;
    beam.tensionRatio = s.As / (s.b * s.d);
    beam.compressionRatio = s.AsPrime / (s.b * s.d);
    beam.spacing = s.spacing;
    beam.shear = side.shear;
    beam.hoopShear = strength->hoops;
    beam.shearControls = side.shear > strength->Vn;
    beam.poorSplice = detail.poorSplice;
    return AsceBeam(beam, EditionOf(in.end), sheet);
}

std::optional<T_CODE_PLASTIC> AsceColumnEnd(const T_BASIS& in, T_RC_SIDE& side, CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const T_RC_MATERIAL& m = in.material;
    T_ASCE_COLUMN_SHEAR shear;
    shear.tieArea = s.shear;
    shear.spacing = s.spacing;
    shear.fyt = m.fyw;
    shear.fc = m.fc;
    shear.d = s.d;
    shear.Ag = s.b * s.h;
    shear.axial = in.axial;
    shear.momentShear = in.end.clear / 2.0;
    const std::optional<T_ASCE_COLUMN_STRENGTH> strength = AsceColumnShear(shear, sheet);
    if (!strength) return {};
    side.shearStrength = strength->initial;
    const T_SECT_DETAIL& detail = *in.end.section.detailing;
    T_ASCE_COLUMN column;
    column.bw = s.b;
    column.d = s.d;
    column.Ag = shear.Ag;
    column.fc = m.fc;
    column.fyt = m.fyw;
    column.axial = in.axial;
    column.tieRatio = s.shear / (s.b * s.spacing);
    column.spacing = s.spacing;
    column.shear = side.shear;
    column.shearStrength = strength->initial;
    column.hoopShear = s.shear * m.fyw * s.d / s.spacing;
    column.hooks = detail.hooks == STIRRUP_HOOKS::Hooks135  ? TIE_HOOKS::Hooks135
                   : detail.hooks == STIRRUP_HOOKS::Hooks90 ? TIE_HOOKS::Hooks90
                                                            : TIE_HOOKS::Other;
    column.tiesAnchored = detail.tiesInCore;
    column.poorSplice = detail.poorSplice;
    column.longRatio = (s.As + s.AsPrime + s.AsWeb) / shear.Ag;
    column.fyl = m.fy;
    column.twoTiesInLap = detail.lapLength >= 2.0 * s.spacing;
    return AsceColumn(column, EditionOf(in.end), sheet);
}

std::optional<T_CODE_BACKBONE> AsceBackbone(const T_BASIS& in, T_RC_SIDE& side, CCodeSheet& sheet)
{
    if (in.end.section.detailing->lapLength > 0.0 && !in.end.section.detailing->poorSplice)
        sheet.Warn("IDS_QM_GEN_WARN_LAP", {});
    const auto plastic =
        in.end.column ? AsceColumnEnd(in, side, sheet) : AsceBeamEnd(in, side, sheet);
    if (!plastic) return {};
    T_BACKBONE_IN curve;
    curve.yield = side.moment;
    curve.yieldDeform = sheet.Put("theta_y", side.moment * in.end.length / (6.0 * in.end.EI), "",
                                  "My L/(6 EI), EI of the model", K);
    return BackboneOfPlastic(*plastic, curve, sheet);
}

// ---- EN 1998-3, Circolare 2019 ------------------------------------------------------------------

/// Legs stand evenly spaced, each holds a bar.
std::vector<double> Gaps(const T_RC_BENDING& s)
{
    std::vector<double> gaps;
    for (const auto& [core, legs] : {std::pair(s.coreB, s.legs), std::pair(s.coreH, s.across)})
        gaps.insert(gaps.end(), static_cast<std::size_t>(2 * (legs - 1)), core / (legs - 1));
    return gaps;
}

std::optional<T_EN_MEMBER> EnMember(const T_BASIS& in, CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const T_SECT_DETAIL& detail = *in.end.section.detailing;
    const bool hooked = detail.hooks == STIRRUP_HOOKS::Hooks135;
    const std::optional<double> alpha =
        HoopEffectiveness({s.coreB, s.coreH, s.spacing, Gaps(s), hooked}, sheet);
    if (!alpha) return {};
    T_EN_MEMBER m;
    m.b = s.b;
    m.h = s.h;
    m.d = s.d;
    m.dPrime = s.dPrime;
    m.fc = in.material.fc;
    m.fy = in.material.fy;
    m.fyw = in.material.fyw;
    m.Es = in.material.Es;
    m.Ec = in.material.Ec;
    m.As = s.As;
    m.AsPrime = s.AsPrime;
    m.AsWeb = s.AsWeb;
    m.barDiameter = s.barDiameter;
    m.axial = in.axial;
    m.shearSpan = in.end.clear / 2.0;
    m.alpha = *alpha;
    m.hoopRatio = s.shear / (s.b * s.spacing);
    m.secondary = in.end.secondary;
    m.seismicDetails = hooked;
    m.lapRatio = detail.lapLength / s.barDiameter;
    m.basis = in.end.code == HINGE_CODE::En1998 ? EN_BASIS::En1998 : EN_BASIS::Circolare2019;
    return m;
}

std::optional<T_CODE_BACKBONE> EnBackbone(const T_BASIS& in, T_RC_SIDE& side, CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const std::optional<T_EN_MEMBER> member = EnMember(in, sheet);
    if (!member) return {};
    const T_SHEAR_SECTION shear{s.b,        s.d,         s.b * s.h,
                                member->fc, member->fyw, s.As / (s.b * s.d),
                                in.axial,   s.shear,     s.spacing};
    const std::optional<T_EN_SHEAR> monotonic = EnShear(shear, {1.0, 1.0, 1.0, false}, sheet);
    if (!monotonic) return {};
    T_EN_HINGE_IN hinge;
    hinge.member = *member;
    hinge.concreteShear = monotonic->concrete;
    std::optional<T_EN_HINGE> found = EnHinge(hinge, sheet);
    const std::optional<double> length =
        EnHingeLength(*member, LPL_FORM::WithEn1992Confinement, sheet);
    if (!found || !length) return {};
    const double ductility = std::max(0.0, found->thetaUm / found->thetaY - 1.0);
    const std::optional<T_EN_CYCLIC_SHEAR> cyclic =
        EnCyclicShear(*member, found->yield.xi * s.d, ductility, std::nullopt, sheet);
    if (!cyclic) return {};
    side.shearStrength =
        sheet.Put("VR", std::min(cyclic->strength, monotonic->strut), kDimForce,
                  "EN 1998-3 A.3.3.1", "min(VR; VRd,max), 45 degrees", CODE_MARK::SightedOnce);
    sheet.Warn("IDS_QM_GEN_WARN_GAMMA", {});
    side.hingeLength = *length;
    sheet.Put("My LV/(3 theta_y EI)",
              found->yield.moment * in.end.clear / (6.0 * found->thetaY * in.end.EI),
              "EN 1998-3 A.3.2.4", "effective over the model's stiffness", K);
    T_CODE_BACKBONE bone = found->backbone;
    bone.yield = side.moment; // of the section calculator: the strength follows the axial force
    return bone;
}

// ---- both ---------------------------------------------------------------------------------------

std::string FaultOf(const CCodeSheet& sheet)
{
    return sheet.Fault() ? FaultText(*sheet.Fault()) : Say("IDS_QM_GEN_NO_ANSWER");
}

int Moment(const T_BASIS& in, bool positive, double axial, double& moment, std::string& reason)
{
    SECT_FAULT fault = SECT_FAULT::None;
    const T_MATL_D material = AssessedMaterial(in.end.material, in.material);
    if (CSectionStrength::CalcMoment(in.end.section, material, kSi, in.end.aboutY, positive, axial,
                                     moment, fault) &&
        moment > 0.0)
        return 1;
    reason = fault == SECT_FAULT::Values || fault == SECT_FAULT::None
                 ? Say("IDS_QM_GEN_AXIAL", CodeNumber(axial / 1000.0))
                 : Say(MessageKeyOf(fault));
    return 0;
}

/// Geometry and strengths of one side on its sheet.
int Prepare(const T_RC_END& end, bool positive, CCodeSheet& sheet, T_BASIS& basis,
            std::string& reason)
{
    const auto section = RcBending(end.section, end.aboutY, positive, sheet);
    const auto material = section ? RcMaterial(end.material, end.code, sheet) : std::nullopt;
    if (!material || !sheet.Positive({{"clear length", end.clear}, {"EI", end.EI}})) {
        reason = FaultOf(sheet);
        return 0;
    }
    basis.section = *section;
    basis.material = *material;
    basis.axial = sheet.Put("N", end.column ? end.axial : 0.0, kDimForce, "",
                            end.column ? "initial loads" : "beam: 0", K);
    return 1;
}

int Side(const T_BASIS& basis, T_RC_SIDE& side, CCodeSheet& sheet, std::string& reason)
{
    sheet.Put("My", side.moment, kDimMoment, kBending, "plane sections, N", K);
    sheet.Put("My (N = 0)", side.momentAtZero, kDimMoment, kBending, "plane sections", K);
    sheet.Put("LV", basis.end.clear / 2.0, kDimLength, kCapacity, "clear length/2", K);
    sheet.Put("V", side.shear, kDimForce, kCapacity, "(My(+) + My(-))/clear length", K);
    const auto bone = IsChordCode(basis.end.code) ? EnBackbone(basis, side, sheet)
                                                  : AsceBackbone(basis, side, sheet);
    if (!bone) {
        reason = FaultOf(sheet);
        return 0;
    }
    if (bone->forceControlled) {
        reason = Say("IDS_QM_GEN_FORCE");
        return 0;
    }
    side.bone = *bone;
    WarnShear(side, sheet);
    side.trace = sheet.Trace();
    side.warnings = sheet.Warnings();
    return 1;
}

} // namespace

T_MATL_D AssessedMaterial(const T_MATL_D& material, const T_RC_MATERIAL& strengths)
{
    T_MATL_D out = material;
    out.fck = strengths.fc;
    out.fyk = strengths.fy;
    return out;
}

int RcHinge(const T_RC_END& end, T_SIDES<T_RC_SIDE>& out, std::string& reason)
{
    T_SIDES<CCodeSheet> sheets;
    T_SIDES<T_RC_SIDE> sides;
    T_BASIS pos{end, {}, {}}, neg{end, {}, {}};
    if (!Prepare(end, true, sheets.pos, pos, reason) ||
        !Prepare(end, false, sheets.neg, neg, reason))
        return 0;
    for (const bool positive : {true, false}) {
        T_RC_SIDE& side = positive ? sides.pos : sides.neg;
        if (!Moment(pos, positive, pos.axial, side.moment, reason) ||
            !Moment(pos, positive, 0.0, side.momentAtZero, reason))
            return 0;
    }
    sides.pos.shear = sides.neg.shear = (sides.pos.moment + sides.neg.moment) / end.clear;
    if (!Side(pos, sides.pos, sheets.pos, reason) || !Side(neg, sides.neg, sheets.neg, reason))
        return 0;
    out = std::move(sides);
    return 1;
}
