#include "qm_rps/hinge/hingetypefindings.h"

#include "qm_base/textformat.h"
#include "qm_rps/hinge/curvefindings.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/hinge/hingepartfindings.h"
#include "qm_rps/hinge/pageyield.h"

#include <algorithm>

namespace {

struct T_TYPE_CHECK {
    const T_PHGT_D& type;
    const CHingeSources* sources; // null: nothing is looked up
    const T_SECT_D* Section() const { return sources->Section(type.section); }
    const T_MATL_D* Material() const { return sources->Material(type.sectionMaterial); }
    const T_SECT_D* Fibre() const { return sources->Section(type.fibreSection); }
    const T_SECT_D* Thickness() const { return sources->Section(type.thicknessSection); }
    bool IsWall() const { return type.element == HINGE_ELEMENT::Wall; }
    /// Automatic strengths are calculated from the type's own section and material.
    bool Calculates() const
    {
        return sources && (type.section != 0 || type.sectionMaterial != 0) && AnyAutoYield(type);
    }
};
using T = T_TYPE_CHECK;

bool FibresFit(const T& t)
{
    return t.IsWall() ? CHingeSources::IsWall(*t.Fibre()) : CHingeSources::HasFibres(*t.Fibre());
}
bool ThicknessFits(const T& t)
{
    return t.IsWall() && (!t.sources || !t.Thickness() || CHingeSources::IsWall(*t.Thickness()));
}
bool NeedsBars(const T& t)
{
    return t.Calculates() && t.Section() && t.Material() &&
           t.Material()->type == MATL_CLASS::Concrete;
}

bool HasShearInteraction(const T& t)
{
    return t.type.interaction == HINGE_INTERACTION::VyVz ||
           t.type.interactionMz == HINGE_INTERACTION::VyVz;
}

constexpr const char* kNoSection = "IDS_CMD_IEHP_NO_SECT";
constexpr const char* kNoWall = "IDS_CMD_IEHP_NO_WALL";
constexpr T_RULE<T> kTypeRules[] = {
    {{.message = "IDS_QM_HINGE_NAME_EMPTY", .field = "name"},
     [](const T& t) { return !t.type.name.empty(); }},
    {{.message = kNoSection, .field = "section"},
     [](const T& t) { return t.Section() != nullptr; },
     [](const T& t) { return t.sources && (t.type.section != 0 || t.Calculates()); }},
    {{.message = "IDS_CMD_IEHP_NO_MATL", .field = "sectionMaterial"},
     [](const T& t) { return t.Material() != nullptr; },
     [](const T& t) { return t.sources && (t.type.sectionMaterial != 0 || t.Calculates()); }},
    {{.message = kNoSection, .field = "fibreSection"},
     [](const T& t) { return t.Fibre() != nullptr; },
     [](const T& t) { return t.sources && t.type.fibreSection != 0; }},
    {{.message = "IDS_QM_HINGE_NO_FIBRES", .field = "fibreSection"},
     [](const T& t) { return HasLineElement(t.type); },
     [](const T& t) { return t.type.fibreSection != 0; }},
    {{.message = "IDS_QM_HINGE_FIBRE_SHAPE", .field = "fibreSection"},
     FibresFit,
     [](const T& t) { return t.sources && t.Fibre() && HasLineElement(t.type); }},
    {{.message = kNoSection, .field = "thicknessSection"},
     [](const T& t) { return t.Thickness() != nullptr; },
     [](const T& t) { return t.sources && t.type.thicknessSection != 0; }},
    {{.message = kNoWall, .field = "thicknessSection"},
     ThicknessFits,
     [](const T& t) { return t.type.thicknessSection != 0; }},
    {{.message = kNoWall, .field = "section"},
     [](const T& t) { return CHingeSources::IsWall(*t.Section()); },
     [](const T& t) { return t.sources && t.IsWall() && t.Section(); }},
    {{.message = "IDS_QM_HINGE_SHEAR_PAIR", .field = "interaction"},
     [](const T& t) { return HasShearPair(t.type); },
     HasShearInteraction},
    {{.message = "IDS_QM_HINGE_SURFACE_PMM", .field = "exactSurface"},
     [](const T& t) { return SharesMoments(t.type); },
     [](const T& t) { return t.type.exactSurface; }},
    {{.message = "IDS_CMD_IEHP_NO_RBAR", .field = "section"},
     [](const T& t) { return !t.Section()->bars.empty(); },
     NeedsBars},
    {{.message = "IDS_QM_HINGE_SPAN", .field = "length.span"},
     [](const T& t) { return Below(0, t.type.length.span); },
     [](const T& t) { return !t.type.length.autoSpan; }},
};

/// An active component's curve type that is not offered for such a type, or not under the codes.
void OfferFindings(const T_PHGT_D& type, const T_HINGE_CONTEXT& context, std::size_t i,
                   std::vector<T_FINDING>& out)
{
    const SKEL_TYPE code = type.components[i].type;
    const auto list = OfferedCurves(type, static_cast<HINGE_COMPONENT>(i), context);
    const auto at = std::ranges::find(list, code, &T_SKCV_ENTRY::code);
    if (at != list.end() && at->enabled) return;
    T_HINGE_HEAD head;
    head.message = at != list.end() ? "IDS_QM_HINGE_CURVE_CODES" : "IDS_QM_HINGE_CURVE_NOT_OFFERED";
    head.key = {CurveKey(code)};
    head.field = "type";
    out.push_back(FindingOf(head, {static_cast<int>(i)}));
}

/// What is found in a part, its fields as members of the type.
void Append(const char* prefix, std::vector<T_FINDING> found, std::vector<T_FINDING>& out)
{
    for (T_FINDING& f : found) {
        f.field = prefix + f.field;
        out.push_back(std::move(f));
    }
}

void PartFindings(const T_PHGT_D& type, std::vector<T_FINDING>& out)
{
    if (type.masonry) Append("masonry.", MasonryFindings(*type.masonry), out);
    if (type.yieldSurface)
        Append("yieldSurface.", YieldSurfaceFindings(*type.yieldSurface, YieldSurfaceCurve(type)),
               out);
    if (type.pmm) Append("pmm.", PmmFindings(*type.pmm), out);
}

/// The strengths of one side.
struct T_STRENGTH_SIDE {
    double crack, yield;
    HINGE_SIDE side;
};
std::array<T_STRENGTH_SIDE, 2> SidesOf(const T_PAGE_STRENGTH& s)
{
    return {{{s.crack.pos, s.yield.pos.value_or(0.0), HINGE_SIDE::Positive},
             {s.crack.neg, s.yield.neg.value_or(0.0), HINGE_SIDE::Negative}}};
}
/// An entered crack strength beside a calculated yield strength.
constexpr T_HINGE_RULE<T_STRENGTH_SIDE> kCalculated[] = {
    {{.message = kHingeItemMessage,
      .key = {"IDS_DB_CRACK_FORCE_COMP_PLUS", "IDS_DB_CRACK_FORCE_COMP_MNUS"},
      .field = "sides.pos.P1",
      .point = "P1"},
     [](const T_STRENGTH_SIDE& s) { return NotAbove(s.crack, s.yield); }},
};

void RatioWarnings(const T_PHGT_D& type, std::vector<T_FINDING>& out)
{
    std::vector<T_FINDING> found;
    int curves = 0;
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            const auto* m = std::get_if<T_SKEL_MULTI>(&curve);
            if (!m || m->useDeformation) return;
            ++curves;
            RatioWarnings(*m, c.type, {static_cast<int>(i), end}, found);
        });
    }
    if (curves < 2) return; // the warning is about several curves at once
    out.insert(out.end(), found.begin(), found.end());
}

/// Entered strengths by axial force that say nothing about the hinge without one.
void ForceWarning(const T_SKEL_FEMA& curve, const T_HINGE_PLACE& place, std::vector<T_FINDING>& out)
{
    const std::optional<double> force = ForceAwayFrom0(curve);
    if (!force || curve.autoYield) return;
    const std::string text = "P = " + ShortestText(*force);
    out.push_back(FindingOf(T_HINGE_HEAD{.message = "IDS_QM_HINGE_FORCES_AWAY",
                                         .text = text.c_str(),
                                         .field = "curves"},
                            place));
}

} // namespace

bool IsAutoYield(const T_SKEL_CURVE& curve)
{
    return std::visit([](const auto& c) { return c.autoYield; }, curve);
}

bool AnyAutoYield(const T_PHGT_D& type)
{
    bool any = false;
    for (const T_HINGE_COMPONENT& c : type.components)
        if (c.active)
            ForEachPage(c, [&](HINGE_END, const T_SKEL_CURVE& k) { any = any || IsAutoYield(k); });
    return any;
}

void AutoStrengthFindings(const T_PHGT_D& type, const CHingeSources::T_RESULT& result,
                          std::vector<T_FINDING>& out)
{
    const char* why =
        result.fault == SECT_FAULT::None ? "IDS_QM_HINGE_NO_METHOD" : MessageKeyOf(result.fault);
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            if (!IsAutoYield(curve)) return;
            const T_HINGE_PLACE place{static_cast<int>(i), end};
            const T_PAGE_STRENGTH s =
                PageStrength(curve, c.type, static_cast<HINGE_COMPONENT>(i), result);
            if (result.fault != SECT_FAULT::None || !s.yield.pos)
                out.push_back(FindingOf(T_HINGE_HEAD{.message = "IDS_QM_HINGE_AUTO_STRENGTH",
                                                     .key = {why},
                                                     .field = "autoYield"},
                                        place));
            else
                WalkRulesBySide(kCalculated, SidesOf(s), place, out);
        });
    }
}

std::vector<T_FINDING> HingeTypeFindings(const T_PHGT_D& type, const T_HINGE_CONTEXT& context)
{
    const T check{type, context.sources.get()};
    std::vector<T_FINDING> out;
    WalkRules(kTypeRules, check, {}, out);
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        OfferFindings(type, context, i, out);
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            const T_HINGE_PLACE place{static_cast<int>(i), end};
            CurveFindings(curve, c.type, place, out);
            MirrorFindings(curve, place, out);
        });
    }
    if (check.Calculates()) {
        const auto* result = context.sources->Strength(type.section, type.sectionMaterial);
        // Bars that are missing have their own rule above.
        if (result && result->fault != SECT_FAULT::NoBars) AutoStrengthFindings(type, *result, out);
    }
    PartFindings(type, out);
    return out;
}

std::vector<T_FINDING> VoidInputWarnings(const T_PHGT_D& type)
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            StiffnessWarnings(curve, c.type, {static_cast<int>(i), end}, out);
        });
    }
    return out;
}

std::vector<T_FINDING> HingeTypeWarnings(const T_PHGT_D& type)
{
    std::vector<T_FINDING> out;
    RatioWarnings(type, out);
    for (std::size_t i = 0; i < type.components.size(); ++i) {
        const T_HINGE_COMPONENT& c = type.components[i];
        if (!c.active) continue;
        ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
            const T_HINGE_PLACE place{static_cast<int>(i), end};
            PointWarnings(curve, place, out);
            if (const auto* f = std::get_if<T_SKEL_FEMA>(&curve)) ForceWarning(*f, place, out);
        });
    }
    const std::vector<T_FINDING> voids = VoidInputWarnings(type);
    out.insert(out.end(), voids.begin(), voids.end());
    return out;
}
