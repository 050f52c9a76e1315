#include "qm_rps/generate/masonryhinge.h"

#include "qm_rps/codes/masonrypier.h"
#include "qm_rps/generate/rcend.h"

#include <algorithm>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kLimits = "Circolare 2019 C8.7.1.3.1.1";

/// Strengths of the two hinges of a member, and their drifts.
struct T_STRENGTHS {
    double moment = 0.0, shear = 0.0;
    T_CHORD_LIMITS bending, sliding; // chord rotations
};

/// The material's strengths, whether mean or characteristic.
struct T_MASONRY {
    double fm = 0.0, confidence = 1.0;
    T_MATL_MASONRY more;
};
std::optional<T_MASONRY> MasonryOf(const T_MEMBER_END& end, CCodeSheet& sheet)
{
    const T_MATL_D& m = end.material;
    if (end.section.shape != SECT_SHAPE::Rectangle)
        sheet.Refuse(CODE_REASON::Missing, "shape: rectangle", end.section.name);
    if (!m.masonry) sheet.Refuse(CODE_REASON::Missing, "masonry", m.name);
    if (!sheet.Sound()) return {};
    T_MASONRY out;
    const double mean = m.mean ? m.mean->fc : 0.0;
    if (!(mean > 0.0)) sheet.Warn("IDS_QM_GEN_WARN_NO_MEAN", {m.name});
    out.fm = sheet.Put("fm", mean > 0.0 ? mean : m.fck, kDimStress, "",
                       mean > 0.0 ? "mean.fc" : "fck", K);
    const std::optional<double> factor = ConfidenceOf(m, sheet);
    if (!factor) return {};
    out.confidence = *factor;
    out.more = *m.masonry;
    return out;
}

/// SLC, with 3/4 of it for SLV; SLD is yield.
T_CHORD_LIMITS NtcLimits(double drift, CCodeSheet& sheet)
{
    T_CHORD_LIMITS limits;
    limits.SD = sheet.Put("SLV", 0.75 * drift, kLimits, "3/4 SLC", R);
    limits.NC = drift;
    return limits;
}

std::optional<T_STRENGTHS> SpandrelOf(const T_MEMBER_END& end, const T_MASONRY& m,
                                      CCodeSheet& sheet)
{
    if (end.code != HINGE_CODE::Circolare2019) {
        sheet.Refuse(CODE_REASON::NoRow, "spandrel", "EN 1998-3 Annex C");
        return {};
    }
    T_SPANDREL s;
    s.depth = end.Depth();
    s.thickness = end.section.size[end.aboutY ? 1 : 0];
    s.length = end.clear;
    s.tie = end.tie;
    s.fm = m.fm;
    s.tau0 = m.more.tau0;
    s.confidence = m.confidence;
    const std::optional<T_SPANDREL_STRENGTH> found = NtcSpandrel(s, sheet);
    if (!found) return {};
    T_STRENGTHS out{found->moment, found->shear, {}, {}};
    out.bending = NtcLimits(found->bendingDrift, sheet);
    out.sliding = NtcLimits(found->shearDrift, sheet);
    return out;
}

std::optional<T_STRENGTHS> PierOf(const T_MEMBER_END& end, const T_MASONRY& m, CCodeSheet& sheet)
{
    T_PIER p;
    p.length = end.Depth();
    p.thickness = end.section.size[end.aboutY ? 1 : 0];
    p.height = end.clear;
    p.shearSpan = end.ShearSpan();
    p.axial = end.axial;
    p.fm = m.fm;
    p.tau0 = m.more.tau0;
    p.fv0 = m.more.fv0;
    p.fb = m.more.fb;
    p.confidence = m.confidence;
    p.bond = m.more.bond == BOND_KIND::Regular ? MASONRY_BOND::Regular : MASONRY_BOND::Irregular;
    p.interlocking = m.more.interlocking;
    p.hollowBlocks = m.more.hollowBlocks;
    const bool en = end.code == HINGE_CODE::En1998;
    const auto found = en ? AnnexCPier(p, sheet) : NtcPier(p, sheet);
    if (!found) return {};
    T_STRENGTHS out;
    out.moment = found->moment;
    out.shear =
        en ? *found->sliding : std::min(found->diagonal, found->sliding.value_or(found->diagonal));
    if (!en) {
        const bool sliding = found->sliding && *found->sliding < found->diagonal;
        const PIER_MODE mode = sliding ? PIER_MODE::Sliding : PIER_MODE::Diagonal;
        out.bending = NtcLimits(NtcPierDrift(PIER_MODE::Flexure, p.hollowBlocks, sheet), sheet);
        out.sliding = NtcLimits(NtcPierDrift(mode, p.hollowBlocks, sheet), sheet);
        return out;
    }
    for (const bool flexure : {true, false}) {
        const auto drifts = AnnexCDrifts(p.shearSpan, p.length, flexure, end.secondary, sheet);
        if (!drifts) return {};
        (flexure ? out.bending : out.sliding) = {0.0, drifts->SD, drifts->NC, 0.0};
    }
    return out;
}

/// A curve up to the drifts; a length makes displacements of them.
std::optional<T_CODE_BACKBONE> CurveOf(T_CHORD_LIMITS limits, double yield, double yieldDeform,
                                       double length, T_DIM dim, CCodeSheet& sheet)
{
    limits.DL = yieldDeform;
    limits.SD *= length;
    limits.NC *= length;
    T_BACKBONE_IN curve;
    curve.yield = yield;
    curve.yieldDeform = yieldDeform;
    curve.dim = dim;
    return BackboneOfChord(limits, curve, sheet);
}

} // namespace

int MasonryHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out, std::string& reason)
{
    CCodeSheet sheet;
    const auto fail = [&] {
        reason = ReasonOf(sheet);
        return 0;
    };
    if (!IsChordCode(end.code)) {
        sheet.Refuse(CODE_REASON::NoRow, "masonry",
                     kHingeCodeNames[static_cast<std::size_t>(end.code)]);
        return fail();
    }
    const std::optional<T_MASONRY> masonry = MasonryOf(end, sheet);
    if (!masonry || !sheet.Positive({{"clear length", end.clear}, {"EI", end.EI}})) return fail();
    const bool pier = end.kind == MEMBER_KIND::Pier;
    if (pier) {
        sheet.Put("N", end.axial, kDimForce, "", "initial loads", K);
        sheet.Warn("IDS_QM_GEN_WARN_FIXED_AXIAL", {});
    }
    const auto strengths = pier ? PierOf(end, *masonry, sheet) : SpandrelOf(end, *masonry, sheet);
    if (!strengths) return fail();
    T_CODE_SIDE side;
    side.strength = side.strengthAtZero = strengths->moment;
    side.shearStrength = strengths->shear;
    side.shear = ShearOf(end, 2.0 * side.strength / end.clear, sheet);
    side.hingeLength = end.Depth();
    const double turn = sheet.Put("theta_y", end.Turn(side.strength), "",
                                  "Mu L/(6 EI), EI of the model, clear length", K);
    const double sway = sheet.Put("Delta_y", end.Sway(strengths->shear), kDimLength, "",
                                  "V L^3/(12 EI) + V L/(G Av) of the model", K);
    const auto bending = CurveOf(strengths->bending, strengths->moment, turn, 1.0, kDimNone, sheet);
    side.shearBone =
        CurveOf(strengths->sliding, strengths->shear, sway, end.clear, kDimLength, sheet);
    if (!bending || !side.shearBone) return fail();
    side.bone = *bending;
    side.trace = sheet.Trace();
    side.warnings = sheet.Warnings();
    out = {side, side};
    return 1;
}
