#include "qm_rps/generate/rchinge.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr auto K = CODE_MARK::Computed;

ASCE_EDITION EditionOf(const T_MEMBER_END& end)
{
    if (end.code == HINGE_CODE::Asce17) return ASCE_EDITION::Asce17;
    if (end.code == HINGE_CODE::Asce13) return ASCE_EDITION::Asce13;
    return end.secondary ? ASCE_EDITION::Fema356Secondary : ASCE_EDITION::Fema356Primary;
}

std::optional<T_CODE_PLASTIC> AsceBeamEnd(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                          CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const auto strength = AsceBeamShear(in, in.material, sheet);
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

std::optional<T_CODE_PLASTIC> AsceColumnEnd(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                            CCodeSheet& sheet)
{
    const T_RC_BENDING& s = in.section;
    const T_RC_MATERIAL& m = in.material;
    const auto strength = AsceColumnShearOf(in, m, 0.0, sheet);
    if (!strength) return {};
    side.shearStrength = strength->initial;
    const T_SECT_DETAIL& detail = *in.end.section.detailing;
    T_ASCE_COLUMN column;
    column.circular = s.round && detail.hooks == STIRRUP_HOOKS::Hooks135;
    column.bw = s.b;
    column.d = s.d;
    column.Ag = s.area;
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
    column.longRatio = s.Bars() / s.area;
    column.fyl = m.fy;
    column.twoTiesInLap = detail.lapLength >= 2.0 * s.spacing;
    return AsceColumn(column, EditionOf(in.end), sheet);
}

/// The table's plastic rotations as displacements of one end across the other.
std::optional<T_CODE_BACKBONE> ShearBackbone(const T_RC_BASIS& in, const T_CODE_PLASTIC& plastic,
                                             const T_CODE_SIDE& side, CCodeSheet& sheet)
{
    const double length = sheet.Put("L", in.end.clear, kDimLength, "",
                                    "of the hinge of shear: rotations x clear length", K);
    T_CODE_PLASTIC moved = Scaled(plastic, length);
    T_BACKBONE_IN curve;
    curve.yield = side.shearStrength;
    curve.yieldDeform = sheet.Put("Delta_y", in.end.Sway(side.shearStrength), kDimLength, "",
                                  "Vn L^3/(12 EI) + Vn L/(G Av) of the model", K);
    curve.dim = kDimLength;
    return BackboneOfPlastic(moved, curve, sheet);
}

T_ASCE_WALL WallOf(const T_RC_BASIS& in, const T_CODE_SIDE& side)
{
    const T_RC_BENDING& s = in.section;
    T_ASCE_WALL wall;
    wall.thickness = s.b;
    wall.length = s.h;
    wall.fc = in.material.fc;
    wall.fy = in.material.fy;
    wall.As = s.As;
    wall.AsPrime = s.AsPrime;
    wall.Ast = s.Bars();
    wall.axial = in.axial;
    wall.shear = side.shear;
    return wall;
}

/// Table 10-20 where shear comes before bending.
bool WallShear(const T_RC_BASIS& in, const T_ASCE_WALL& wall, T_CODE_SIDE& side, CCodeSheet& sheet)
{
    const std::optional<T_ASCE_WALL_SHEAR> drifts = AsceWallShear(wall, sheet);
    if (!drifts) return false;
    T_ASCE_WALL_SHEAR moved = *drifts;
    for (double* drift : {&moved.g, &moved.d, &moved.e, &moved.IO, &moved.LS, &moved.CP})
        *drift *= in.end.clear;
    side.shearBone = BackboneOfWallShear(moved, side.shearStrength, sheet, kDimLength);
    sheet.Warn("IDS_QM_GEN_WARN_CRACK", {CodeNumber(moved.f)});
    return side.shearBone.has_value();
}

std::optional<T_CODE_PLASTIC> AsceWallEnd(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                          CCodeSheet& sheet)
{
    if (in.end.code != HINGE_CODE::Asce17) {
        sheet.Refuse(CODE_REASON::NoRow, "wall",
                     kHingeCodeNames[static_cast<std::size_t>(in.end.code)]);
        return {};
    }
    const T_RC_BENDING& s = in.section;
    const auto strength =
        AciWallShear(s.area, in.material.fc, in.material.fyw, s.shear / (s.b * s.spacing), sheet);
    if (!strength) return {};
    side.shearStrength = *strength;
    const T_ASCE_WALL wall = WallOf(in, side);
    sheet.Warn("IDS_QM_GEN_WARN_BOUNDARY", {});
    if (!in.end.pushed) sheet.Warn("IDS_QM_GEN_WARN_WALL_SHEAR", {});
    if (side.shear > side.shearStrength && !WallShear(in, wall, side, sheet)) return {};
    return AsceWallFlexure(wall, sheet);
}

/// Table 10-5 beside the stiffness of the model, which the push takes.
bool CompareStiffness(const T_RC_BASIS& in, CCodeSheet& sheet)
{
    constexpr double kSame = 0.05;
    constexpr const char* kTable = "ASCE 41 Table 10-5";
    constexpr T_DIM kDimBending{1, 2};
    if (in.end.code == HINGE_CODE::Fema356) return true; // its table is not known to us
    const T_RC_BENDING& s = in.section;
    const ASCE_MEMBER member = in.end.kind == MEMBER_KIND::Wall     ? ASCE_MEMBER::Wall
                               : in.end.kind == MEMBER_KIND::Column ? ASCE_MEMBER::Column
                                                                    : ASCE_MEMBER::Beam;
    const double ratio = in.axial / (s.area * in.material.fc);
    const auto share = AsceStiffness(member, ratio, EditionOf(in.end), sheet);
    if (!share) return false;
    const double Ec = sheet.Put("EcE", 57000.0 * RootPsi(in.material.fc), kDimStress,
                                "ACI 318 19.2.2.1", "57000 sqrt(f'cE) psi", CODE_MARK::Recalled);
    const double gross =
        s.round ? std::numbers::pi / 64.0 * std::pow(s.h, 4) : s.b * s.h * s.h * s.h / 12.0;
    const double code =
        sheet.Put("EI (code)", share->flexure * Ec * gross, kDimBending, kTable, "effective", K);
    sheet.Put("EI (model)", in.end.EI, kDimBending, "", "E I of the file", K);
    sheet.Put("GA (code)", share->shear * Ec * s.area, kDimForce, kTable, "effective", K);
    sheet.Put("GA (model)", in.end.GA, kDimForce, "", "G As of the file; 0: rigid in shear", K);
    if (std::fabs(in.end.EI / code - 1.0) > kSame)
        sheet.Warn("IDS_QM_GEN_WARN_STIFFNESS", {CodeNumber(in.end.EI / code), kTable});
    return sheet.Sound();
}

std::optional<T_CODE_PLASTIC> PlasticOf(const T_RC_BASIS& in, T_CODE_SIDE& side, CCodeSheet& sheet)
{
    if (in.end.kind == MEMBER_KIND::Wall) return AsceWallEnd(in, side, sheet);
    return in.end.kind == MEMBER_KIND::Column ? AsceColumnEnd(in, side, sheet)
                                              : AsceBeamEnd(in, side, sheet);
}

} // namespace

std::optional<T_CODE_BACKBONE> AsceBackbone(const T_RC_BASIS& in, T_CODE_SIDE& side,
                                            CCodeSheet& sheet)
{
    if (in.end.section.detailing->lapLength > 0.0 && !in.end.section.detailing->poorSplice)
        sheet.Warn("IDS_QM_GEN_WARN_LAP", {});
    const auto plastic = PlasticOf(in, side, sheet);
    if (!plastic || !CompareStiffness(in, sheet)) return {};
    const bool shearFirst = side.shear > side.shearStrength;
    if (shearFirst && in.end.kind != MEMBER_KIND::Wall) {
        side.shearBone = ShearBackbone(in, *plastic, side, sheet);
        if (!side.shearBone) return {};
    }
    T_BACKBONE_IN curve;
    curve.yield = side.strength;
    curve.yieldDeform = sheet.Put("theta_y", in.end.Turn(side.strength), "",
                                  "My L/(6 EI), EI of the model, clear length", K);
    return BackboneOfPlastic(*plastic, curve, sheet);
}
