#include "qm_rps/codes/masonrypier.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;
constexpr const char* kFlexure = "NTC 2018 [7.8.2]";
constexpr const char* kSliding = "NTC 2018 [7.8.3]";
constexpr const char* kIrregular = "Circolare 2019 [C8.7.1.16]";
constexpr const char* kRegular = "Circolare 2019 [C8.7.1.17]-[C8.7.1.18]";
constexpr const char* kDrift = "Circolare 2019 C8.7.1.3.1.1";
constexpr double kFriction = 0.4;        // of sliding
constexpr double kJointFriction = 0.577; // of the joints of a regular bond
constexpr double kGammaM = 0.7;          // fv,lim = 0.065 fb / 0.7

double Area(const T_PIER& p)
{
    return p.length * p.thickness;
}

double ShapeFactor(double height, double length, CCodeSheet& sheet)
{
    return sheet.Put("b", std::clamp(height / length, 1.0, 1.5), kIrregular, "1 <= h/l <= 1.5", S1);
}

double TensileStrength(double tau0, double confidence, CCodeSheet& sheet)
{
    return sheet.Put("ftd", 1.5 * tau0 / confidence, kDimStress, kIrregular, "1.5 tau0/CF", S1);
}

/// Sliding over the compressed length l' = 3 (l/2 - M/N) <= l with M = V h0, solved for V where
/// the stress is cohesion + 0.4 N/(l' t), not above the limit; 0: there is none.
double SlidingForce(const T_PIER& p, double limit)
{
    const double fv0 = p.fv0 / p.confidence, friction = kFriction * p.axial;
    const double turn = 3.0 * p.shearSpan * p.thickness / p.axial;
    const auto solved = [&](double stress, double constant) {
        const double cracked = (1.5 * Area(p) * stress + constant) / (1.0 + turn * stress);
        return std::min(cracked, Area(p) * stress + constant);
    };
    double v = solved(fv0, friction);
    if (limit > 0.0) v = std::min(v, solved(limit, 0.0));
    return std::min(v, p.axial * p.length / (2.0 * p.shearSpan)); // nothing is compressed any more
}

double SlidingStrength(const T_PIER& p, double limit, const char* clause, const char* text,
                       CODE_MARK mark, CCodeSheet& sheet)
{
    const double v = SlidingForce(p, limit);
    const double length = std::min(p.length, 3.0 * (p.length / 2.0 - v * p.shearSpan / p.axial));
    sheet.Put("l'", length, kDimLength, clause, "3 (l/2 - V h0/N) <= l", K);
    return sheet.Put("Vs", v, kDimForce, clause, text, mark);
}

double IrregularStrength(const T_PIER& p, double stress, CCodeSheet& sheet)
{
    const double ftd = TensileStrength(p.tau0, p.confidence, sheet);
    const double b = ShapeFactor(p.height, p.length, sheet);
    return sheet.Put("Vt", Area(p) * ftd / b * std::sqrt(1.0 + stress / ftd), kDimForce, kIrregular,
                     "l t ftd/b sqrt(1 + s0/ftd)", S1);
}

double RegularStrength(const T_PIER& p, double stress, CCodeSheet& sheet)
{
    const double b = ShapeFactor(p.height, p.length, sheet);
    const double loss = 1.0 + kJointFriction * p.interlocking;
    const double joints = (p.fv0 / p.confidence + kJointFriction * stress) / loss;
    double v = Area(p) / b * joints;
    if (p.fb > 0.0) {
        const double fbt = 0.1 * p.fb / p.confidence;
        v = std::min(v, Area(p) / b * fbt / 2.3 * std::sqrt(1.0 + stress / fbt));
    }
    return sheet.Put("Vt", v, kDimForce, kRegular,
                     "l t/b (fv0 + 0.577 s0)/(1 + 0.577 phi) <= l t/b fbt/2.3 sqrt(1 + s0/fbt),"
                     " fbt = 0.1 fb",
                     R);
}

double NtcSliding(const T_PIER& p, CCodeSheet& sheet)
{
    return SlidingStrength(p, 0.065 * p.fb / kGammaM / p.confidence, kSliding,
                           "l' t min(fv0/CF + 0.4 N/(l' t); 0.065 fb/(0.7 CF)); l' >= 0", S1,
                           sheet);
}

bool SoundPier(const T_PIER& p, CCodeSheet& sheet)
{
    sheet.Positive({{"length", p.length}, {"thickness", p.thickness}, {"height", p.height}});
    sheet.Positive({{"shearSpan", p.shearSpan}, {"axial", p.axial}, {"fm", p.fm}});
    sheet.NotNegative({{"fv0", p.fv0}, {"fb", p.fb}});
    sheet.Within("confidence", p.confidence, 1.0, 2.0);
    if (sheet.Sound()) sheet.Within("axial", p.axial, 0.0, 0.85 * p.fm / p.confidence * Area(p));
    return sheet.Sound();
}

bool Sound(const T_PIER& p, CCodeSheet& sheet)
{
    if (p.bond == MASONRY_BOND::Irregular)
        sheet.Positive({{"tau0", p.tau0}});
    else
        sheet.Positive({{"fv0", p.fv0}});
    sheet.NotNegative({{"interlocking", p.interlocking}});
    return SoundPier(p, sheet);
}

} // namespace

double NtcPierDrift(PIER_MODE mode, bool hollowBlocks, CCodeSheet& sheet)
{
    const bool hollow = mode == PIER_MODE::Diagonal && hollowBlocks;
    return sheet.Put("du/h",
                     mode == PIER_MODE::Flexure ? 0.01
                     : hollow                   ? 0.004
                                                : 0.005,
                     kDrift, "flexure 0.01; sliding, diagonal 0.005; hollow blocks, diagonal 0.004",
                     S1);
}

std::optional<T_PIER_STRENGTH> NtcPier(const T_PIER& pier, CCodeSheet& sheet)
{
    if (!Sound(pier, sheet)) return {};
    T_PIER_STRENGTH s;
    const double stress =
        sheet.Put("s0", pier.axial / Area(pier), kDimStress, kFlexure, "N/(l t)", S1);
    const double fd = sheet.Put("fd", pier.fm / pier.confidence, kDimStress, kFlexure, "fm/CF", S1);
    s.moment =
        sheet.Put("Mu", pier.length * Area(pier) * stress / 2.0 * (1.0 - stress / (0.85 * fd)),
                  kDimMoment, kFlexure, "l^2 t s0/2 (1 - s0/(0.85 fd))", S1);
    s.flexure = sheet.Put("V(Mu)", s.moment / pier.shearSpan, kDimForce, kFlexure, "Mu/h0", K);
    s.strength = s.flexure;
    const auto take = [&](PIER_MODE mode, double v) {
        if (v < s.strength) s.mode = mode, s.strength = v;
    };
    if (pier.fv0 > 0.0 && !(pier.fb > 0.0)) sheet.Warn("IDS_QM_CODE_WARN_NO_FB", {});
    if (pier.fv0 > 0.0) take(PIER_MODE::Sliding, *(s.sliding = NtcSliding(pier, sheet)));
    s.diagonal = pier.bond == MASONRY_BOND::Regular ? RegularStrength(pier, stress, sheet)
                                                    : IrregularStrength(pier, stress, sheet);
    take(PIER_MODE::Diagonal, s.diagonal);
    s.drift = NtcPierDrift(s.mode, pier.hollowBlocks, sheet);
    return sheet.Sound() ? std::optional(s) : std::nullopt;
}

std::optional<T_PIER_STRENGTH> AnnexCPier(const T_PIER& pier, CCodeSheet& sheet)
{
    constexpr const char* kBending = "EN 1998-3 (C.1)";
    constexpr const char* kShear = "EN 1998-3 (C.3)";
    sheet.Positive({{"fv0", pier.fv0}});
    if (!SoundPier(pier, sheet)) return {};
    T_PIER_STRENGTH s;
    const double nu = sheet.Put("nu_d", pier.axial / (Area(pier) * pier.fm / pier.confidence),
                                kBending, "N/(D t fm/CF)", R);
    s.flexure =
        sheet.Put("Vf", pier.length * pier.axial / (2.0 * pier.shearSpan) * (1.0 - 1.15 * nu),
                  kDimForce, kBending, "D N/(2 H0) (1 - 1.15 nu_d)", R);
    s.moment = sheet.Put("Mu", s.flexure * pier.shearSpan, kDimMoment, kBending, "Vf H0", K);
    if (!sheet.Positive({{"Mu", s.moment}})) return {};
    s.sliding = SlidingStrength(pier, 0.065 * pier.fm / pier.confidence, kShear,
                                "D' t min(fvm0 + 0.4 N/(D' t); 0.065 fm)", R, sheet);
    s.mode = *s.sliding < s.flexure ? PIER_MODE::Sliding : PIER_MODE::Flexure;
    s.strength = std::min(s.flexure, *s.sliding);
    return s;
}

std::optional<T_SPANDREL_STRENGTH> NtcSpandrel(const T_SPANDREL& p, CCodeSheet& sheet)
{
    constexpr const char* kClause = "NTC 2018 7.8.2.2.4";
    sheet.Positive({{"depth", p.depth}, {"thickness", p.thickness}, {"length", p.length}});
    sheet.Positive({{"tie", p.tie}, {"fm", p.fm}, {"tau0", p.tau0}});
    if (!sheet.Within("confidence", p.confidence, 1.0, 2.0)) return {};
    const double area = p.depth * p.thickness, fd = p.fm / p.confidence;
    const double force = sheet.Put("Hp", std::min(p.tie, 0.4 * fd * area), kDimForce, kClause,
                                   "min(tie; 0.4 fhd h t)", R);
    T_SPANDREL_STRENGTH s;
    s.moment = sheet.Put("Mu", force * p.depth / 2.0 * (1.0 - force / (0.85 * fd * area)),
                         kDimMoment, kClause, "Hp h/2 (1 - Hp/(0.85 fhd h t))", R);
    // Of a spandrel the panel's length and height change places; its compression may be left out.
    const double ftd = TensileStrength(p.tau0, p.confidence, sheet);
    const double b = ShapeFactor(p.length, p.depth, sheet);
    s.shear = sheet.Put("Vt", area * ftd / b, kDimForce, kIrregular, "h t ftd/b, s0 = 0", S1);
    s.bendingDrift =
        sheet.Put("theta_u", 0.02, kDrift, "bending, with an element that carries tension", S1);
    s.shearDrift = sheet.Put("gamma_u", 0.005, kDrift, "diagonal cracks", S1);
    sheet.Warn("IDS_QM_CODE_WARN_NO_LINTEL", {});
    return s;
}

std::optional<T_PIER_DRIFTS> AnnexCDrifts(double H0, double D, bool flexure, bool secondary,
                                          CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1998-3 Annex C";
    // Rows: shear, flexure; columns: primary, secondary.
    constexpr std::array<std::array<double, 2>, 2> kSd{{{0.004, 0.006}, {0.008, 0.012}}};
    if (!sheet.Positive({{"H0", H0}, {"D", D}})) return {};
    const double sd = kSd[flexure ? 1 : 0][secondary ? 1 : 0] * (flexure ? H0 / D : 1.0);
    T_PIER_DRIFTS drifts;
    drifts.SD =
        sheet.Put("SD", sd, kClause,
                  flexure ? "0.008 H0/D, secondary 0.012 H0/D" : "0.004, secondary 0.006", R);
    drifts.NC = sheet.Put("NC", 4.0 / 3.0 * sd, kClause, "4/3 SD", R);
    return drifts;
}
