#include "qm_rps/generate/steelhinge.h"

#include "qm_base/say.h"
#include "qm_rps/codes/asce41connection.h"
#include "qm_rps/codes/en1993class.h"
#include "qm_rps/codes/en1998steel.h"
#include "qm_rps/codes/steelbuckling.h"
#include "qm_rps/generate/axialcurve.h"
#include "qm_rps/generate/rcend.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;

/// AISC 342 has columns alone.
bool HasRow(const T_MEMBER_END& end, CCodeSheet& sheet)
{
    return end.code != HINGE_CODE::Aisc342 || end.kind == MEMBER_KIND::Column ||
           sheet.Refuse(CODE_REASON::NoRow, kMemberKindNames[static_cast<std::size_t>(end.kind)],
                        kHingeCodeNames[static_cast<std::size_t>(end.code)]);
}

bool IsI(const T_STEEL_BASIS& in)
{
    return in.shape.shape == STEEL_SHAPE::WeldedI || in.shape.shape == STEEL_SHAPE::RolledI;
}

T_BUCKLING BucklingOf(const T_STEEL_BASIS& in, double fy)
{
    return {in.shape.A, in.end.clear, in.Least(), fy, in.E};
}

// ---- bending ------------------------------------------------------------------------------------

/// a, b, c of the connection with the factors of the joint; it has no acceptance values.
std::optional<T_CODE_PLASTIC> ConnectionOf(const T_STEEL_BASIS& in, CCodeSheet& sheet)
{
    constexpr const char* kClause = "ASCE 41-17 9.4.2.4.3";
    const T_STEEL_CONNECTION& asked = *in.end.connection;
    const auto kind = std::ranges::find(kFrConnectionNames, asked.kind);
    if (kind == kFrConnectionNames.end() || in.end.code != HINGE_CODE::Asce17) {
        sheet.Refuse(CODE_REASON::NoRow, "connection " + asked.kind,
                     kHingeCodeNames[static_cast<std::size_t>(in.end.code)]);
        return {};
    }
    T_FR_CONNECTION c;
    c.kind = static_cast<FR_CONNECTION>(kind - kFrConnectionNames.begin());
    c.depth = in.shape.h;
    c.span = in.end.clear;
    c.flangeWidth = in.shape.b;
    c.flangeThickness = in.shape.tf;
    const bool given = asked.columnFlange > 0.0;
    c.columnFlange = sheet.Put("tcf", given ? asked.columnFlange : in.end.joint.columnFlange,
                               kDimLength, "", given ? "given" : "of the frame", K);
    c.continuityPlate = asked.continuityPlate;
    const auto panel = asked.panelRatio > 0.0
                           ? std::optional(sheet.Put("Vpz/Vye", asked.panelRatio, "", "given", K))
                           : AscePanelRatio(in.end.joint, c.depth, sheet);
    if (!panel) return {};
    c.panelRatio = *panel;
    c.slenderShare = AsceSlenderShare(in.Member(), kClause, sheet);
    sheet.Warn("IDS_QM_GEN_WARN_PANEL", {CodeNumber(*panel)});
    if (c.kind == FR_CONNECTION::ReducedBeamSection) sheet.Warn("IDS_QM_GEN_WARN_RBS", {});
    return AsceConnection(c, sheet);
}

/// A column by its axial force.
std::optional<T_STEEL_PLASTIC> ColumnRow(const T_STEEL_BASIS& in, CCodeSheet& sheet)
{
    T_STEEL_MEMBER m = in.Member();
    if (in.end.code == HINGE_CODE::Aisc342) return Aisc342Column(m, sheet);
    if (in.end.code != HINGE_CODE::Asce17) {
        const auto strength = AiscBuckling(BucklingOf(in, in.lower), in.shape, sheet);
        if (!strength) return {};
        m.axialStrength =
            sheet.Put("P_CL", *strength, kDimForce, "ASCE 41-13 9.4.2.3.2", "Pn with Fy", R);
    }
    return AsceSteelColumn(m, SteelEdition(in.end), sheet);
}

std::optional<T_STEEL_PLASTIC> AsceRow(const T_STEEL_BASIS& in, CCodeSheet& sheet)
{
    if (in.end.kind == MEMBER_KIND::Column) return ColumnRow(in, sheet);
    if (!in.end.connection) return AsceSteelBeam(in.Member(), SteelEdition(in.end), sheet);
    const std::optional<T_CODE_PLASTIC> of = ConnectionOf(in, sheet);
    return of ? std::optional(T_STEEL_PLASTIC{0.0, *of, false}) : std::nullopt;
}

std::optional<T_CODE_BACKBONE> AsceBending(const T_STEEL_BASIS& in, const T_CODE_SIDE& side,
                                           CCodeSheet& sheet)
{
    const std::optional<T_STEEL_PLASTIC> found = AsceRow(in, sheet);
    if (!found) return {};
    T_BACKBONE_IN curve;
    curve.yield = side.strength;
    curve.yieldDeform = sheet.Put("theta_y (model)", in.end.Turn(side.strength), "",
                                  "My L/(6 EI), EI of the model, clear length", K);
    curve.slope = sheet.Put("slope B-C", kSteelSlope, "ASCE 41-17 9.4.2.2", "of the elastic slope",
                            CODE_MARK::SightedOnce);
    curve.acceptance = in.end.kind == MEMBER_KIND::Column || !in.end.connection;
    auto bone = BackboneOfPlastic(found->plastic, curve, sheet);
    if (bone) bone->forceControlled = bone->forceControlled || found->forceControlled;
    return bone;
}

std::optional<T_CODE_BACKBONE> EnBending(const T_STEEL_BASIS& in, T_CODE_SIDE& side,
                                         CCodeSheet& sheet)
{
    const auto number = En1993Class(in.shape, in.end.aboutY, in.axial, in.fy, sheet);
    if (!number) return {};
    T_EN_STEEL steel;
    steel.sectionClass = *number;
    steel.axialRatio = sheet.Put("nu", std::max(0.0, in.axial) / in.strength.Npl,
                                 "EN 1998-3 Annex B", "N/Npl <= 0.30", R);
    const double span = in.end.ShearSpan();
    std::optional<double> yield;
    if (in.end.code == HINGE_CODE::Circolare2019) {
        const double half = (in.end.aboutY ? in.shape.h : in.shape.b) / 2.0;
        const double elastic = sheet.Put("Me,Rd", in.I / half * in.fy, kDimMoment, "", "Wel fy", K);
        yield = CircolareSteelThetaY(elastic, span, in.end.EI, sheet);
    } else {
        yield = sheet.Put("theta_y", side.strength * span / (3.0 * in.end.EI), "",
                          "My LV/(3 EI), EI of the model", K);
    }
    if (!yield) return {};
    steel.yieldDeform = *yield;
    const std::optional<T_CHORD_LIMITS> limits = EnSteelLimits(steel, sheet);
    if (!limits) return {};
    side.hingeLength = sheet.Put("Lpl", in.end.aboutY ? in.shape.h : in.shape.b, kDimLength, "",
                                 "depth of the section", K);
    T_BACKBONE_IN curve;
    curve.yield = side.strength;
    curve.yieldDeform = *yield;
    return BackboneOfChord(*limits, curve, sheet);
}

/// Shear beside the strength of bending, on the sheet.
bool JudgeShear(const T_STEEL_BASIS& in, T_CODE_SIDE& side, CCodeSheet& sheet)
{
    const std::optional<double> strength = SteelShear(in, in.fy, sheet);
    if (!strength) return false;
    side.shear = ShearOf(in.end, 2.0 * side.strength / in.end.clear, sheet);
    side.shearStrength = *strength;
    const double ratio = side.shear / *strength;
    if (ratio > 1.0)
        sheet.Warn("IDS_QM_GEN_WARN_SHEAR", {CodeNumber(ratio)});
    else if (const auto lost = EnShearReduction(side.shear, *strength, sheet); lost && *lost > 0.0)
        sheet.Warn("IDS_QM_GEN_WARN_HALF_SHEAR", {CodeNumber(ratio)});
    return true;
}

int Finish(const std::optional<T_CODE_BACKBONE>& bone, CCodeSheet& sheet, T_CODE_SIDE& side,
           std::string& reason)
{
    if (!bone || bone->forceControlled) {
        reason = bone ? Say("IDS_QM_GEN_FORCE") : ReasonOf(sheet);
        return 0;
    }
    side.bone = *bone;
    side.trace = sheet.Trace();
    side.warnings = sheet.Warnings();
    return 1;
}

int Fail(const CCodeSheet& sheet, std::string& reason)
{
    reason = ReasonOf(sheet);
    return 0;
}

// ---- braces -------------------------------------------------------------------------------------

/// The elongation of the whole member at a force.
double ElongationOf(const T_STEEL_BASIS& in, double force, const char* symbol, CCodeSheet& sheet)
{
    return sheet.Put(symbol, force * in.end.clear / in.end.EA, kDimLength, "",
                     "F L/(EA), EA of the model", K);
}

std::optional<double> BuckledStrength(const T_STEEL_BASIS& in, CCodeSheet& sheet)
{
    const T_BUCKLING b = BucklingOf(in, in.fy);
    sheet.Put("K L", b.length, kDimLength, "", "clear length, K = 1", K);
    if (!IsChordCode(in.end.code)) return AiscBuckling(b, in.shape, sheet);
    return EnBuckling(b, EnImperfection(in.shape, in.iz <= in.iy, sheet), sheet);
}

std::optional<T_CODE_BACKBONE> AsceAxial(const T_STEEL_BASIS& in, const T_BACKBONE_IN& curve,
                                         bool tension, CCodeSheet& sheet)
{
    T_STEEL_BRACE brace;
    brace.shape = IsI(in) ? BRACE_SHAPE::WideFlange : BRACE_SHAPE::Tube;
    brace.slenderness = in.end.clear / in.Least();
    brace.Fy = in.fy;
    brace.E = in.E;
    brace.yieldDeform = curve.yieldDeform;
    brace.tension = tension;
    brace.primary = !in.end.secondary;
    const std::optional<T_STEEL_PLASTIC> found = AsceBrace(brace, sheet);
    return found ? BackboneOfPlastic(found->plastic, curve, sheet) : std::nullopt;
}

std::optional<T_CODE_BACKBONE> EnAxial(const T_STEEL_BASIS& in, const T_BACKBONE_IN& curve,
                                       bool tension, CCodeSheet& sheet)
{
    T_EN_STEEL steel;
    steel.action = tension ? STEEL_ACTION::BraceTension : STEEL_ACTION::BraceCompression;
    steel.yieldDeform = curve.yieldDeform;
    const auto number = En1993ClassCompressed(in.shape, in.fy, sheet);
    if (!number) return {};
    steel.sectionClass = *number;
    const std::optional<T_CHORD_LIMITS> limits = EnSteelLimits(steel, sheet);
    return limits ? BackboneOfChord(*limits, curve, sheet) : std::nullopt;
}

int BraceSide(const T_MEMBER_END& end, bool tension, T_CODE_SIDE& side, std::string& reason)
{
    CCodeSheet sheet;
    const std::optional<T_STEEL_BASIS> in = SteelBasis(end, sheet);
    if (!in || !HasRow(end, sheet)) return Fail(sheet, reason);
    const auto strength =
        tension ? std::optional(sheet.Put("Ny", in->strength.Npl, kDimForce, "", "A fy", K))
                : BuckledStrength(*in, sheet);
    if (!strength || !sheet.Positive({{"EA", end.EA}})) return Fail(sheet, reason);
    side.strength = side.strengthAtZero = *strength;
    T_BACKBONE_IN curve;
    curve.yield = *strength;
    curve.yieldDeform = ElongationOf(*in, *strength, tension ? "Delta_T" : "Delta_c", sheet);
    curve.dim = kDimLength;
    const auto bone = IsChordCode(end.code) ? EnAxial(*in, curve, tension, sheet)
                                            : AsceAxial(*in, curve, tension, sheet);
    return Finish(bone, sheet, side, reason);
}

} // namespace

int SteelHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out, std::string& reason)
{
    CCodeSheet sheet, atZero;
    const std::optional<T_STEEL_BASIS> in = SteelBasis(end, sheet);
    if (!in || !HasRow(end, sheet) || !sheet.Positive({{"EI", end.EI}})) return Fail(sheet, reason);
    if (!IsChordCode(end.code) && !IsI(*in)) {
        sheet.Refuse(CODE_REASON::NoRow, "shape: I", "ASCE 41 Tables 9-6, 9-7.1");
        return Fail(sheet, reason);
    }
    T_CODE_SIDE side;
    sheet.Put("N", in->axial, kDimForce, "", end.HasAxial() ? "initial loads" : "beam: 0", K);
    if (!(std::fabs(in->axial) < in->strength.Npl)) {
        reason = Say("IDS_QM_GEN_AXIAL", CodeNumber(in->axial / 1000.0));
        return 0;
    }
    const std::optional<double> moment = SteelMoment(*in, in->axial, sheet);
    const std::optional<double> bare = SteelMoment(*in, 0.0, atZero);
    if (!moment || !bare) return Fail(moment ? atZero : sheet, reason);
    side.strength = sheet.Put("My", *moment, kDimMoment, "", "with N", K);
    side.strengthAtZero = sheet.Put("My (N = 0)", *bare, kDimMoment, "", "", K);
    if (!JudgeShear(*in, side, sheet)) return Fail(sheet, reason);
    const auto bone =
        IsChordCode(end.code) ? EnBending(*in, side, sheet) : AsceBending(*in, side, sheet);
    if (!Finish(bone, sheet, side, reason)) return 0;
    out = {side, side}; // the shapes are symmetrical
    return 1;
}

int SteelBrace(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out, std::string& reason)
{
    T_SIDES<T_CODE_SIDE> sides;
    if (!BraceSide(end, true, sides.pos, reason) || !BraceSide(end, false, sides.neg, reason))
        return 0;
    out = std::move(sides);
    return 1;
}

std::optional<T_PMM_TABLE> SteelAxialCurve(const std::vector<T_MEMBER_END>& ends,
                                           const T_ENDS<double>& given)
{
    T_PMM_TABLE table;
    table.negative.emplace();
    table.balanced = true;
    for (const T_MEMBER_END& end : ends) {
        CCodeSheet sheet;
        const std::optional<T_STEEL_BASIS> in = SteelBasis(end, sheet);
        if (!in) return {};
        const double full = in->strength.Npl;
        const double a = std::clamp((in->shape.A - 2.0 * in->shape.b * in->shape.tf) / in->shape.A,
                                    0.0, 0.5); // 6.2.9.1(5)
        // Where the formulas bend.
        const double corner = IsChordCode(end.code) ? (end.aboutY ? 0.5 * a : a)
                              : SteelEdition(end) == ASCE_EDITION::Asce17 ? 0.2
                                                                          : 1.0 - 1.0 / 1.18;
        const std::size_t axis = end.aboutY ? 0 : 1;
        const auto forces =
            AxialForces(full, -full, {0.0, corner * full, -corner * full, given.I, given.J},
                        table.curves[axis].size());
        if (forces.size() != table.curves[axis].size()) return {};
        double largest = 0.0;
        for (std::size_t i = 0; i < forces.size(); ++i) {
            const bool tip = i == 0 || i + 1 == forces.size();
            const auto moment = tip ? std::optional(0.0) : SteelMoment(*in, forces[i], sheet);
            if (!moment) return {};
            table.curves[axis][i] = {forces[i] / full, *moment};
            largest = std::max(largest, *moment);
        }
        for (T_PM_POINT& p : table.curves[axis])
            p.m /= largest;
        (*table.negative)[axis] = table.curves[axis];
        table.Pmax = full;
    }
    if (ends.size() == 1) UseForBoth(table, ends.front().aboutY);
    return table;
}
