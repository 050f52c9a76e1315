#include "qm_rps/codes/codebackbone.h"

#include <algorithm>
#include <utility>

namespace {

constexpr const char* kCurve = "ASCE 41";
constexpr const char* kChordCurve = "EN 1998-3";

bool SoundInput(const T_BACKBONE_IN& in, CCodeSheet& sheet)
{
    sheet.Positive({{"yield", in.yield}, {"yieldDeform", in.yieldDeform}});
    sheet.Within("slope", in.slope, 0.0, 1.0);
    if (in.strengthCap != 0.0) sheet.Within("strengthCap", in.strengthCap, 1.0, kAnyValue);
    return sheet.Sound();
}

/// Strength at C over the yield strength, after a plastic deformation.
double StrengthAtC(const T_BACKBONE_IN& in, double plastic)
{
    const double risen = 1.0 + in.slope * plastic / in.yieldDeform;
    return in.strengthCap > 0.0 ? std::min(risen, in.strengthCap) : risen;
}

void PutPoints(const T_CODE_BACKBONE& bone, const char* clause, T_DIM dim, CCodeSheet& sheet)
{
    constexpr auto K = CODE_MARK::Computed;
    const std::pair<const char*, const T_CODE_POINT*> points[] = {
        {"B", &bone.B}, {"C", &bone.C}, {"D", &bone.D}, {"E", &bone.E}};
    for (const auto& [name, point] : points) {
        sheet.Put(std::string("D(") + name + ")", point->deform, dim, clause, "", K);
        sheet.Put(std::string("F(") + name + ")", point->strength, clause, "F / Fy", K);
    }
    if (!bone.acceptance) return;
    const bool fema = bone.levels == CODE_LEVELS::IoLsCp;
    const std::array<const char*, 3> names =
        fema ? std::array{"D(IO)", "D(LS)", "D(CP)"} : std::array{"D(DL)", "D(SD)", "D(NC)"};
    for (std::size_t i = 0; i < names.size(); ++i)
        sheet.Put(names[i], (*bone.acceptance)[i], dim, clause, "", K);
}

/// Point E after D; `plateau`: b lies beyond a.
T_CODE_POINT EndOf(const T_CODE_BACKBONE& bone, bool plateau, double end, CCodeSheet& sheet)
{
    if (plateau) return {end, bone.D.strength};
    if (bone.strengthLoss && bone.D.strength > 0.0) return {bone.D.deform, 0.0};
    if (bone.D.strength > 0.0)
        sheet.Warn("IDS_QM_CODE_WARN_CONTINUED", {kCurve, CodeNumber(bone.D.strength)});
    return {kEndOverUltimate * bone.D.deform, bone.D.strength};
}

/// FEMA 356 Table 6-8 prints IO above LS in a row of nonconforming columns: the smaller one counts.
double RisingIo(const T_CODE_PLASTIC& p, CCodeSheet& sheet)
{
    if (p.IO <= p.LS) return p.IO;
    sheet.Warn("IDS_QM_CODE_WARN_IO_ABOVE_LS", {CodeNumber(p.IO), CodeNumber(p.LS)});
    return p.LS;
}

} // namespace

std::optional<T_CODE_BACKBONE> BackboneOfPlastic(const T_CODE_PLASTIC& p, const T_BACKBONE_IN& in,
                                                 CCodeSheet& sheet)
{
    if (!SoundInput(in, sheet)) return {};
    sheet.NotNegative({{"a", p.a}, {"b", p.b}, {"c", p.c}});
    sheet.NotNegative({{"IO", p.IO}, {"LS", p.LS}, {"CP", p.CP}});
    if (!sheet.Sound()) return {};

    const double y = in.yieldDeform, end = std::max(p.a, p.b);
    T_CODE_BACKBONE bone;
    bone.yield = in.yield;
    bone.yieldDeform = y;
    bone.B = {y, 1.0};
    bone.C = {y + p.a, StrengthAtC(in, p.a)};
    bone.D = {y + p.a, p.c};
    bone.strengthLoss = p.c < bone.C.strength;
    bone.E = EndOf(bone, p.b > p.a, y + end, sheet);
    if (in.acceptance)
        bone.acceptance = {{y + RisingIo(p, sheet), y + p.LS, y + p.CP}};
    else
        sheet.Warn("IDS_QM_CODE_WARN_NO_ACCEPTANCE", {kCurve});
    bone.forceControlled = !(end > 0.0);
    if (bone.forceControlled) sheet.Warn("IDS_QM_CODE_WARN_FORCE", {kCurve});
    PutPoints(bone, kCurve, in.dim, sheet);
    return sheet.Sound() ? std::optional(bone) : std::nullopt;
}

std::optional<T_CODE_BACKBONE> BackboneOfChord(const T_CHORD_LIMITS& limits,
                                               const T_BACKBONE_IN& in, CCodeSheet& sheet)
{
    if (!SoundInput(in, sheet) || !sheet.Within("residual", limits.residual, 0.0, 0.999)) return {};
    if (!sheet.Within("NC", limits.NC, in.yieldDeform, kAnyValue)) return {};
    if (!sheet.Within("SD", limits.SD, 0.0, limits.NC)) return {};
    if (!sheet.Within("DL", limits.DL, 0.0, limits.NC)) return {};

    T_CODE_BACKBONE bone;
    bone.levels = CODE_LEVELS::DlSdNc;
    bone.yield = in.yield;
    bone.yieldDeform = in.yieldDeform;
    bone.B = {in.yieldDeform, 1.0};
    bone.C = {limits.NC, StrengthAtC(in, limits.NC - in.yieldDeform)};
    bone.D = {limits.NC, limits.residual};
    bone.E = {kEndOverUltimate * limits.NC, limits.residual};
    // Where 0.75 theta_u lies below theta_y, damage is significant before yield.
    bone.acceptance = {{std::min(limits.DL, limits.SD), limits.SD, limits.NC}};
    sheet.Warn("IDS_QM_CODE_WARN_CONTINUED", {kChordCurve, CodeNumber(limits.residual)});
    PutPoints(bone, kChordCurve, in.dim, sheet);
    return sheet.Sound() ? std::optional(bone) : std::nullopt;
}
