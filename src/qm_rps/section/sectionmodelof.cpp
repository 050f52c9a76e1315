#include "qm_rps/section/sectionmodelof.h"

#include "qm_db/sectionproperties.h"
#include "qm_rps/codes/concretelaw.h"
#include "qm_rps/codes/confinement.h"
#include "qm_rps/outline/sectionoutline.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

using namespace solver;

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;

constexpr double kAciCrush = 0.003;    // ACI 318-19 22.2.2.1
constexpr double kAciShare = 0.85;     // ACI 318-19 22.2.2.4.1
constexpr double kPlainPeak = 0.002;   // Mander, Priestley, Park 1988
constexpr double kCoverSpalls = 0.004; // Priestley, Seible, Calvi 1996
constexpr double kSteelDuctility = 15; // EN 1993-1-1 3.2.2

// ---- laws of concrete ---------------------------------------------------------------------------

T_STRESS_LAW Parabola(const T_SECTION_STRENGTHS& f, CCodeSheet& sheet)
{
    // A strength in another unit system may miss 90 MPa by a rounding.
    const double mpa = f.fcClass / kPascalsPerMpa;
    if (!sheet.Within("fck", mpa, 0.0, kMaxFckMpa * (1.0 + 1e-9))) return {};
    const T_CONCRETE_LAW c = ConcreteLaw(std::min(mpa, kMaxFckMpa));
    const char* const table = "EN 1992-1-1 Table 3.1";
    T_STRESS_LAW law;
    law.strength = f.fc;
    law.peakStrain = sheet.Put("eps_c2", c.peakStrain, table, "", CODE_MARK::SightedTwice);
    law.limitStrain = sheet.Put("eps_cu2", c.crushStrain, table, "", CODE_MARK::SightedTwice);
    law.exponent = sheet.Put("n", c.n, table, "", CODE_MARK::SightedTwice);
    return law;
}

T_STRESS_LAW Block(const T_SECTION_STRENGTHS& f, CCodeSheet& sheet)
{
    T_STRESS_LAW law;
    law.kind = STRESS_LAW::Block;
    law.strength = sheet.Put("fc", kAciShare * f.fc, kDimStress, "ACI 318-19 22.2.2.4.1",
                             "0.85 f'c", CODE_MARK::SightedTwice);
    law.limitStrain =
        sheet.Put("eps_cu", kAciCrush, "ACI 318-19 22.2.2.1", "", CODE_MARK::SightedTwice);
    law.blockDepth = AciBeta1(f.fcClass, sheet);
    return law;
}

T_STRESS_LAW Mander(double strength, double peakStrain, double limitStrain, double modulus)
{
    T_STRESS_LAW law;
    law.kind = STRESS_LAW::Mander;
    law.strength = strength;
    law.peakStrain = peakStrain;
    law.limitStrain = limitStrain;
    law.modulus = modulus;
    return law;
}

// ---- confined cores -----------------------------------------------------------------------------

double LongitudinalArea(const T_SECT_D& s)
{
    double area = 0.0;
    for (const T_REBAR& bar : s.bars)
        area += bar.area;
    return area;
}

/// Legs stand evenly spaced, each holds a bar; clear of the thinnest bar where `clear`.
T_RECT_CORE RectCore(const T_SECT_D& s, bool clear)
{
    const T_SECT_DETAIL& d = *s.detailing;
    const double edge = 2.0 * d.cover + d.stirrupDiameter;
    const double leg = std::numbers::pi / 4.0 * d.stirrupDiameter * d.stirrupDiameter;
    double thinnest = 0.0;
    if (clear)
        thinnest =
            2.0 * std::sqrt(std::ranges::min(s.bars, {}, &T_REBAR::area).area / std::numbers::pi);
    T_RECT_CORE core;
    core.bx = s.size[1] - edge;
    core.by = s.size[0] - edge;
    core.hoopDiameter = d.stirrupDiameter;
    core.spacing = d.stirrupSpacing;
    core.areaX = d.legsY * leg;
    core.areaY = d.legsZ * leg;
    core.longRatio = LongitudinalArea(s) / (core.bx * core.by);
    for (const auto& [side, legs] : {std::pair(core.bx, d.legsZ), std::pair(core.by, d.legsY)})
        core.gaps.insert(core.gaps.end(), static_cast<std::size_t>(2 * (legs - 1)),
                         std::max(0.0, side / (legs - 1) - thinnest));
    return core;
}

T_ROUND_CORE RoundCore(const T_SECT_D& s)
{
    const T_SECT_DETAIL& d = *s.detailing;
    T_ROUND_CORE core;
    core.diameter = s.size[0] - 2.0 * d.cover - d.stirrupDiameter;
    core.hoopDiameter = d.stirrupDiameter;
    core.spacing = d.stirrupSpacing;
    core.longRatio = LongitudinalArea(s) / (std::numbers::pi / 4.0 * core.diameter * core.diameter);
    return core;
}

/// EN 1998-3 (A.2) and A.3.2.2(8), with the smaller ratio of the two directions.
std::optional<T_CONFINED> Annex3(const T_SECT_D& s, const T_SECTION_STRENGTHS& f, CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1998-3 A.3.2.2";
    const T_SECT_DETAIL& d = *s.detailing;
    double alpha = 0.0, ratio = 0.0;
    if (s.shape == SECT_SHAPE::Circle) {
        const T_ROUND_CORE core = RoundCore(s);
        const double arch = std::max(0.0, 1.0 - core.spacing / (2.0 * core.diameter));
        alpha = sheet.Put("alpha", arch * arch, "EN 1998-1 5.4.3.2.2(8)", "(1 - s/2 D0)^2", R);
        const double leg = std::numbers::pi / 4.0 * d.stirrupDiameter * d.stirrupDiameter;
        ratio = 2.0 * leg / (s.size[0] * core.spacing);
    } else {
        const T_RECT_CORE core = RectCore(s, false);
        const auto grip =
            HoopEffectiveness({core.bx, core.by, core.spacing, core.gaps, true}, sheet);
        if (!grip) return {};
        alpha = *grip;
        ratio = std::min(core.areaX / (s.size[0] * core.spacing),
                         core.areaY / (s.size[1] * core.spacing));
    }
    sheet.Put("rho_sx", ratio, kClause, "Asx/(bw sh), the smaller of both directions", K);
    return Annex3Confined(alpha * ratio * f.fyw, f.fcClass, sheet);
}

std::optional<T_CONFINED> Confined(const T_SECT_D& s, const T_SECTION_STRENGTHS& f,
                                   const T_SECTION_OPTIONS& o, CCodeSheet& sheet)
{
    const bool round = s.shape == SECT_SHAPE::Circle, mander = o.core == SECTION_CORE::Mander;
    if (s.detailing->hooks != STIRRUP_HOOKS::Hooks135 && !round) {
        sheet.Refuse(CODE_REASON::Missing, "hooks: 135", s.name);
        return {};
    }
    if (o.core == SECTION_CORE::En1998) return Annex3(s, f, sheet);
    const T_CONFINED_MATERIAL m{f.fcClass, kPlainPeak, f.fyw, o.hoopStrain};
    if (mander && o.hoopStrain == 0.0) sheet.Warn("IDS_QM_SECC_WARN_HOOP_STRAIN", {});
    if (round)
        return mander ? ManderCircular(RoundCore(s), m, sheet)
                      : NtcCircular(RoundCore(s), m, sheet);
    return mander ? ManderRectangular(RectCore(s, true), m, sheet)
                  : NtcRectangular(RectCore(s, false), m, sheet);
}

/// Cover and core as laws 0 and 2.
void AddCore(const T_SECT_D& s, const T_SECTION_STRENGTHS& f, const T_SECTION_OPTIONS& o,
             T_SECTION_MODEL& model, CCodeSheet& sheet)
{
    const std::vector<T_RING> core = CoreRings(s);
    if (core.empty()) {
        sheet.Refuse(CODE_REASON::Missing, "detailing: rectangle, circle", s.name);
        return;
    }
    const std::optional<T_CONFINED> confined = Confined(s, f, o, sheet);
    if (!confined) return;
    const double design = f.fc / f.fcClass; // of the strength, for design values
    T_STRESS_LAW within;
    if (o.core == SECTION_CORE::Mander) {
        const double modulus = sheet.Put("Ec", 5000.0 * RootMpa(f.fcClass), kDimStress,
                                         "Mander, Priestley, Park 1988", "5000 sqrt(fc) MPa", R);
        model.laws[0] = Mander(f.fc, kPlainPeak, kCoverSpalls, modulus);
        within = Mander(design * confined->strength, confined->peakStrain, confined->ultimateStrain,
                        modulus);
        model.pivot = PIVOT_RULE::CrushOnly;
    } else {
        within = model.laws[0];
        within.strength = design * confined->strength;
        within.peakStrain = confined->peakStrain;
        within.limitStrain = confined->ultimateStrain;
    }
    model.laws[0].spalls = true;
    model.laws.push_back(within);
    model.regions[0].rings.push_back(core.front());
    model.regions.push_back({core, 2});
}

T_SECTION_MODEL ConcreteModel(const T_SECT_D& s, const T_SECTION_STRENGTHS& f,
                              const T_SECTION_OPTIONS& o, CCodeSheet& sheet)
{
    T_SECTION_MODEL model;
    const bool aci = o.law == SECTION_LAW::Aci;
    if (aci && o.core != SECTION_CORE::Plain)
        sheet.Refuse(CODE_REASON::NoRow, "confined", "law aci");
    const bool mander = o.core == SECTION_CORE::Mander; // AddCore gives the laws
    const T_STRESS_LAW concrete = aci      ? Block(f, sheet)
                                  : mander ? T_STRESS_LAW()
                                           : Parabola(f, sheet);
    T_STRESS_LAW steel = SteelLaw(f.fy, f.E);
    steel.limitStrain = o.steelStrain;
    steel.hardening = o.hardening * f.E;
    model.laws = {concrete, steel};
    model.regions = {{SectionRings(s), 0}};
    if (aci) model.pivot = PIVOT_RULE::CrushOnly;
    if (s.bars.empty()) sheet.Refuse(CODE_REASON::Missing, "bars", s.name);
    if (o.core != SECTION_CORE::Plain && sheet.Sound()) AddCore(s, f, o, model, sheet);
    model.lumped = true;
    for (const T_REBAR& bar : s.bars)
        model.bars.push_back({bar.y, bar.z, bar.area, 1});
    return model;
}

/// Loads along z that pass elsewhere twist a channel, which nothing here counts.
void TellShearCentre(const T_SECT_D& s, CCodeSheet& sheet)
{
    if (s.shape != SECT_SHAPE::Channel) return;
    const T_CHANNEL c = ChannelProperties(s);
    sheet.Put("yS", c.shearCentre - c.centroid, kDimLength, "",
              "shear centre from the centroid, along y", K);
    sheet.Warn("IDS_QM_SECC_WARN_CHANNEL", {s.name});
}

T_SECTION_MODEL SteelModel(const T_SECT_D& s, const T_SECTION_STRENGTHS& f,
                           const T_SECTION_OPTIONS& o, bool strains, CCodeSheet& sheet)
{
    T_SECTION_MODEL model;
    T_STRESS_LAW law = SteelLaw(f.fy, f.E);
    if (strains) {
        law.hardening = o.hardening * f.E;
        law.limitStrain = o.steelStrain > 0.0
                              ? o.steelStrain
                              : sheet.Put("eps_u", kSteelDuctility * f.fy / f.E,
                                          "EN 1993-1-1 3.2.2", "15 fy/E, the least allowed", R);
    }
    model.laws = {law};
    model.regions = {{SectionRings(s), 0}};
    model.plastic = !strains;
    return model;
}

} // namespace

std::optional<T_SECTION_MODEL> SectionModelOf(const T_SECT_D& s, const T_MATL_D& m,
                                              const T_SECTION_OPTIONS& o, bool strains,
                                              CCodeSheet& sheet)
{
    sheet.NotNegative({{"steel_strain", o.steelStrain}, {"hoop_strain", o.hoopStrain}});
    sheet.Within("hardening", o.hardening, 0.0, 1.0);
    const std::optional<T_SECTION_STRENGTHS> f = SectionStrengths(m, o, sheet);
    if (!f) return {};
    if (s.shape == SECT_SHAPE::Value) {
        sheet.Refuse(CODE_REASON::Missing, "shape", s.name);
        return {};
    }
    TellShearCentre(s, sheet);
    const T_SECTION_MODEL model = m.type == MATL_CLASS::Concrete
                                      ? ConcreteModel(s, *f, o, sheet)
                                      : SteelModel(s, *f, o, strains, sheet);
    return sheet.Sound() ? std::optional(model) : std::nullopt;
}
