#include "qm_rps/generate/rchinge.h"

#include "qm_base/say.h"
#include "qm_rps/hinge/sectionstrength.h"

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr const char* kBending = "EN 1992-1-1 3.1.7, 6.1";
constexpr T_UNITS kSi{FORCE_UNIT::N, LENGTH_UNIT::m};

void WarnShear(const T_CODE_SIDE& side, CCodeSheet& sheet)
{
    if (side.shear > side.shearStrength)
        sheet.Warn("IDS_QM_GEN_WARN_SHEAR", {CodeNumber(side.shear / side.shearStrength)});
}

int Moment(const T_RC_BASIS& in, bool positive, double axial, double& moment, std::string& reason)
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

int Side(const T_RC_BASIS& basis, T_CODE_SIDE& side, CCodeSheet& sheet, std::string& reason)
{
    sheet.Put("My", side.strength, kDimMoment, kBending, "plane sections, N", K);
    sheet.Put("My (N = 0)", side.strengthAtZero, kDimMoment, kBending, "plane sections", K);
    side.shear = ShearOf(basis.end, side.shear, sheet);
    const auto bone = IsChordCode(basis.end.code) ? EnBackbone(basis, side, sheet)
                                                  : AsceBackbone(basis, side, sheet);
    if (!bone) {
        reason = ReasonOf(sheet);
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

int RcHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out, std::string& reason)
{
    T_SIDES<CCodeSheet> sheets;
    T_SIDES<T_CODE_SIDE> sides;
    const std::optional<T_RC_BASIS> pos = RcBasis(end, true, sheets.pos);
    const std::optional<T_RC_BASIS> neg = pos ? RcBasis(end, false, sheets.neg) : std::nullopt;
    if (!neg) {
        reason = ReasonOf(pos ? sheets.neg : sheets.pos);
        return 0;
    }
    for (const bool positive : {true, false}) {
        T_CODE_SIDE& side = positive ? sides.pos : sides.neg;
        if (!Moment(*pos, positive, pos->axial, side.strength, reason) ||
            !Moment(*pos, positive, 0.0, side.strengthAtZero, reason))
            return 0;
    }
    sides.pos.shear = sides.neg.shear = (sides.pos.strength + sides.neg.strength) / end.clear;
    if (!Side(*pos, sides.pos, sheets.pos, reason) || !Side(*neg, sides.neg, sheets.neg, reason))
        return 0;
    out = std::move(sides);
    return 1;
}
