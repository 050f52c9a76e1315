#include "qm_rps/codes/asce41concrete.h"

#include <algorithm>

namespace {

constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr double kN = kAnyValue;

enum GROUP { Confined, Unconfined };
constexpr std::array<const char*, 2> kNames{"confined boundary", "no confined boundary"};

// ASCE 41-17 Table 10-19: ((As - As') fyE + P)/(tw lw f'cE), V/(tw lw sqrt(f'cE)) in psi.
// clang-format off
constexpr T_CODE_ROW kFlexure[] = {
    //                              a      b      c     IO      LS     CP
    {Confined,   {0.10, 4.0, kN}, {0.015, 0.020, 0.75, 0.005,  0.015, 0.020}, S1},
    {Confined,   {0.10, 6.0, kN}, {0.010, 0.015, 0.40, 0.004,  0.010, 0.015}, S1},
    {Confined,   {0.25, 4.0, kN}, {0.009, 0.012, 0.60, 0.003,  0.009, 0.012}, S1},
    {Confined,   {0.25, 6.0, kN}, {0.005, 0.010, 0.30, 0.0015, 0.005, 0.010}, S1},
    {Unconfined, {0.10, 4.0, kN}, {0.008, 0.015, 0.60, 0.002,  0.008, 0.015}, S1},
    {Unconfined, {0.10, 6.0, kN}, {0.006, 0.010, 0.30, 0.002,  0.006, 0.010}, S1},
    {Unconfined, {0.25, 4.0, kN}, {0.003, 0.005, 0.25, 0.001,  0.003, 0.005}, S1},
    {Unconfined, {0.25, 6.0, kN}, {0.002, 0.004, 0.20, 0.001,  0.002, 0.004}, S1},
};

struct T_SHEAR_ROW {
    double most;       // axial ratio of the row
    double d, e, g;    // total drift, percent
    double c, f;       // strengths over the yield strength
    double IO, LS, CP; // percent
};
// ASCE 41-17 Table 10-20.
constexpr T_SHEAR_ROW kShear[] = {
    // x     d     e    g    c     f     IO    LS    CP
    {0.05, 1.0,  2.0, 0.4, 0.20, 0.60, 0.40, 1.5,  2.0},
    {kN,   0.75, 1.0, 0.4, 0.0,  0.60, 0.40, 0.75, 1.0},
};
// clang-format on
const T_CODE_TABLE kTable{"ASCE 41-17 Table 10-19",
                          {"((As - As') fyE + P)/(tw lw f'cE)", "V/(tw lw sqrt(f'cE)) (psi)", ""},
                          kFlexure};
constexpr const char* kShearTable = "ASCE 41-17 Table 10-20";
constexpr double kForceControlled = 0.15; // P over Ag f'c
constexpr double kNoLateral = 0.35;       // P over P0

bool Sound(const T_ASCE_WALL& w, CCodeSheet& sheet)
{
    sheet.Positive({{"thickness", w.thickness}, {"length", w.length}, {"fc", w.fc}, {"fy", w.fy}});
    sheet.NotNegative({{"As", w.As}, {"AsPrime", w.AsPrime}, {"shear", w.shear}});
    sheet.Finite({{"axial", w.axial}});
    return sheet.Within("Ast", w.Ast, 0.0, w.thickness * w.length);
}

double AxialRatio(const T_ASCE_WALL& w)
{
    return ((w.As - w.AsPrime) * w.fy + w.axial) / (w.thickness * w.length * w.fc);
}

void JudgeAxial(const T_ASCE_WALL& w, CCodeSheet& sheet)
{
    constexpr const char* kClause = "ASCE 41-17 10.7";
    const double strength = 0.85 * w.fc * (w.thickness * w.length - w.Ast) + w.fy * w.Ast;
    const double ratio =
        sheet.Put("P/P0", w.axial / strength, kClause, "P0 = 0.85 f'c (Ag - Ast) + fy Ast", S1);
    if (ratio > kNoLateral) sheet.Warn("IDS_QM_CODE_WARN_NO_LATERAL", {kClause});
}

} // namespace

std::optional<T_CODE_PLASTIC> AsceWallFlexure(const T_ASCE_WALL& wall, CCodeSheet& sheet)
{
    if (!Sound(wall, sheet)) return {};
    JudgeAxial(wall, sheet);
    const GROUP group = wall.confinedBoundary ? Confined : Unconfined;
    const double shear = wall.shear / (wall.thickness * wall.length * RootPsi(wall.fc));
    return Interpolate(kTable, group, kNames[group], {AxialRatio(wall), shear, 0.0}, sheet);
}

std::optional<T_ASCE_WALL_SHEAR> AsceWallShear(const T_ASCE_WALL& wall, CCodeSheet& sheet)
{
    if (!Sound(wall, sheet)) return {};
    JudgeAxial(wall, sheet);
    const double x =
        sheet.Put(kTable.variables[0], AxialRatio(wall), kShearTable, "<= 0.05; > 0.05", S1);
    const auto row = std::find_if(std::begin(kShear), std::end(kShear),
                                  [&](const T_SHEAR_ROW& r) { return x <= r.most; });
    const auto drift = [&](const char* symbol, double percent) {
        return sheet.Put(symbol, percent / 100.0, kShearTable, "total drift", S1);
    };
    T_ASCE_WALL_SHEAR w;
    w.g = drift("g", row->g);
    w.d = drift("d", row->d);
    w.e = drift("e", row->e);
    w.f = sheet.Put("f", row->f, kShearTable, "F / Fy", S1);
    w.c = sheet.Put("c", row->c, kShearTable, "F / Fy", S1);
    w.IO = drift("IO", row->IO);
    w.LS = drift("LS", row->LS);
    w.CP = drift("CP", row->CP);
    const double level =
        sheet.Put("P/(Ag f'c)", wall.axial / (wall.thickness * wall.length * wall.fc), kShearTable,
                  "<= 0.15", S1);
    w.forceControlled = level > kForceControlled;
    if (w.forceControlled) sheet.Warn("IDS_QM_CODE_WARN_FORCE", {kShearTable});
    return sheet.Sound() ? std::optional(w) : std::nullopt;
}

std::optional<T_CODE_BACKBONE> BackboneOfWallShear(const T_ASCE_WALL_SHEAR& wall, double yield,
                                                   CCodeSheet& sheet, T_DIM dim)
{
    if (wall.forceControlled) {
        sheet.Refuse(CODE_REASON::NoRow, "axial", kShearTable);
        return {};
    }
    const T_CODE_PLASTIC beyondYield{wall.d - wall.g,  wall.e - wall.g,  wall.c,
                                     wall.IO - wall.g, wall.LS - wall.g, wall.CP - wall.g};
    T_BACKBONE_IN in;
    in.yield = yield;
    in.yieldDeform = wall.g;
    in.dim = dim;
    std::optional<T_CODE_BACKBONE> bone = BackboneOfPlastic(beyondYield, in, sheet);
    if (bone) bone->crackStrength = wall.f;
    return bone;
}
