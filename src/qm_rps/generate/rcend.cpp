#include "qm_rps/generate/rcend.h"

#include "qm_base/say.h"
#include "qm_rps/codes/confinement.h"

#include <algorithm>

namespace {

/// Legs stand evenly spaced, each holds a bar.
std::vector<double> Gaps(const T_RC_BENDING& s)
{
    std::vector<double> gaps;
    for (const auto& [core, legs] : {std::pair(s.coreB, s.legs), std::pair(s.coreH, s.across)})
        gaps.insert(gaps.end(), static_cast<std::size_t>(2 * (legs - 1)), core / (legs - 1));
    return gaps;
}

/// A circle within hoops.
std::optional<double> RoundEffectiveness(const T_RC_BENDING& s, bool hooked, CCodeSheet& sheet)
{
    const double arch = std::max(0.0, 1.0 - s.spacing / (2.0 * s.coreB));
    return sheet.Put("alpha", hooked ? arch * arch : 0.0, "EN 1998-1 5.4.3.2.2(8)",
                     "(1 - s/2 D0)^2; hooks not 135 degrees: 0", CODE_MARK::Recalled);
}

} // namespace

std::optional<T_RC_BASIS> RcBasis(const T_MEMBER_END& end, bool positive, CCodeSheet& sheet)
{
    const auto section = RcBending(end.section, end.aboutY, positive, sheet);
    const auto material = section ? RcMaterial(end.material, end.code, sheet) : std::nullopt;
    if (!material || !sheet.Positive({{"clear length", end.clear}, {"EI", end.EI}})) return {};
    T_RC_BASIS basis{end, *section, *material};
    basis.axial = sheet.Put("N", end.HasAxial() ? end.axial : 0.0, kDimForce, "",
                            end.HasAxial() ? "initial loads" : "beam: 0", CODE_MARK::Computed);
    return basis;
}

std::string ReasonOf(const CCodeSheet& sheet)
{
    return sheet.Fault() ? FaultText(*sheet.Fault()) : Say("IDS_QM_GEN_NO_ANSWER");
}

std::optional<T_EN_MEMBER> EnMember(const T_RC_BASIS& in, CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const T_SECT_DETAIL& detail = *in.end.section.detailing;
    const bool hooked = detail.hooks == STIRRUP_HOOKS::Hooks135;
    const std::optional<double> alpha =
        s.round ? RoundEffectiveness(s, hooked, sheet)
                : HoopEffectiveness({s.coreB, s.coreH, s.spacing, Gaps(s), hooked}, sheet);
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
    m.shearSpan = in.end.ShearSpan();
    m.alpha = *alpha;
    m.hoopRatio = s.shear / (s.b * s.spacing);
    m.wall = in.end.kind == MEMBER_KIND::Wall;
    m.secondary = in.end.secondary;
    m.seismicDetails = hooked;
    m.lapRatio = detail.lapLength / s.barDiameter;
    m.basis = in.end.code == HINGE_CODE::En1998 ? EN_BASIS::En1998 : EN_BASIS::Circolare2019;
    return m;
}

T_SHEAR_SECTION ShearSectionOf(const T_RC_BENDING& s, double fc, double fyw, double axial)
{
    const double width = s.round ? s.area / s.d : s.b;
    return {width, s.d, s.area, fc, fyw, s.As / (width * s.d), axial, s.shear, s.spacing};
}

std::optional<T_EN_SHEAR> EnMonotonicShear(const T_RC_BASIS& in, const T_RC_MATERIAL& material,
                                           CCodeSheet& sheet)
{
    return EnShear(ShearSectionOf(in.section, material.fc, material.fyw, in.axial),
                   {1.0, 1.0, 1.0, false}, sheet);
}

std::optional<T_ACI_SHEAR> AsceBeamShear(const T_RC_BASIS& in, const T_RC_MATERIAL& material,
                                         CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const std::optional<double> share = AsceTieShare(s.spacing, s.d, sheet);
    if (!share) return {};
    const T_SHEAR_SECTION shear{
        s.b,      s.d, s.area, material.fc, material.fyw, s.As / (s.b * s.d), 0.0, s.shear * *share,
        s.spacing};
    return AciShear(shear, 1.0, sheet);
}

std::optional<T_ASCE_COLUMN_STRENGTH> AsceColumnShearOf(const T_RC_BASIS& in,
                                                        const T_RC_MATERIAL& material,
                                                        double ductility, CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    T_ASCE_COLUMN_SHEAR shear;
    shear.tieArea = s.shear;
    shear.spacing = s.spacing;
    shear.fyt = material.fyw;
    shear.fc = material.fc;
    shear.d = s.d;
    shear.Ag = s.area;
    shear.axial = in.end.HasAxial() ? in.end.gravity.value_or(in.axial) : in.axial;
    shear.momentShear = in.end.ShearSpan();
    shear.ductility = ductility;
    return AsceColumnShear(shear, sheet);
}
