#include "hingecommands.h"

#include "inputfile.h"
#include "output.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/hingemirror.h"
#include "qm_rps/hingetheta.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/pushoverpmminteractiondlg.h"
#include "qm_rps/sectionstrength.h"

#ifdef QM_UI
#include "qm_ui/hingeplot.h"
#endif

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <tuple>

namespace {

/// What the checks of a type read of its document.
T_HINGE_CONTEXT ContextOf(CDBDoc& doc)
{
    const T_MODEL& model = doc.Data().Model();
    T_HINGE_CONTEXT context;
    context.altHysteresis = model.styp.alternativeHysteresis;
    context.strengthDegradation = model.styp.wallStrengthDegradation;
    context.gsd = context.gsdAllowed = model.styp.gsd;
    context.concreteCode = doc.Lib().GetConCodeName();
    context.steelCode = doc.Lib().GetStlCodeName();
    context.section = [&model](int key) {
        const auto it = model.sections.find(key);
        return it == model.sections.end() ? nullptr : &it->second;
    };
    context.material = [&model](int key) {
        const auto it = model.materials.find(key);
        return it == model.materials.end() ? nullptr : &it->second;
    };
    context.interactionFindings = [](const T_PHGT_D& type, std::vector<T_FINDING>& out) {
        const auto add = [&out](const std::vector<T_FINDING>& more) {
            out.insert(out.end(), more.begin(), more.end());
        };
        if (type.yieldSurface) {
            T_YIELD_SURFACE surface = *type.yieldSurface;
            const auto& [my, mz] = std::tie(type.components[4], type.components[5]);
            const SKEL_TYPE curve = my.active ? my.type : mz.type; // My leads the surface
            add(CPO_HingeYieldPropDlgNew(surface, curve).Findings());
        }
        if (type.pmm) {
            T_PMM_TABLE table = *type.pmm;
            add(CPushOverPMMInteractionDlg(table).Findings());
        }
    };
    return context;
}

/// Calls f(key, type in current units) for the types asked for. Usage when the name is unknown.
template <class F>
EXIT_CODE ForEachType(CDBDoc& doc, const std::string& name, F&& f)
{
    bool any = false;
    for (const auto& entry : doc.Data().Model().hingeTypes) {
        T_PHGT_D type;
        if ((!name.empty() && entry.second.name != name) || !doc.Attr().GetPhgt(entry.first, type))
            continue;
        any = true;
        f(entry.first, type);
    }
    if (any || name.empty()) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::Usage, doc.Path() + ": no hinge type named \"" + name + "\"");
}

std::optional<HINGE_COMPONENT> ComponentOf(const std::string& name)
{
    const auto it = std::ranges::find(kComponentNames, name);
    if (it == kComponentNames.end()) return std::nullopt;
    return static_cast<HINGE_COMPONENT>(it - kComponentNames.begin());
}

const char* EndName(HINGE_END end)
{
    return end == HINGE_END::I ? "I-end" : end == HINGE_END::J ? "J-end" : "both ends";
}

std::string Where(const T_FINDING& f)
{
    std::string text;
    if (f.component >= 0) {
        text += std::string(kComponentNames[static_cast<std::size_t>(f.component)]) + ", ";
        text += std::string(EndName(f.end)) + ", ";
    }
    if (!f.point.empty()) text += "point " + f.point + ", ";
    return text + f.field;
}

void PrintSide(const char* name, const T_SKEL_SIDE& s)
{
    std::printf("      %s yield %s, Dy %s; B (%s, %s) C (%s, %s) D (%s, %s) E (%s, %s); IO %s, LS "
                "%s, CP %s\n",
                name, ShortestText(s.yield).c_str(), ShortestText(s.yieldDeform).c_str(),
                ShortestText(s.B.deform).c_str(), ShortestText(s.B.strength).c_str(),
                ShortestText(s.C.deform).c_str(), ShortestText(s.C.strength).c_str(),
                ShortestText(s.D.deform).c_str(), ShortestText(s.D.strength).c_str(),
                ShortestText(s.E.deform).c_str(), ShortestText(s.E.strength).c_str(),
                ShortestText(s.IO).c_str(), ShortestText(s.LS).c_str(), ShortestText(s.CP).c_str());
}

void PrintSide(const char* name, const T_SKEL_MULTI_SIDE& s)
{
    std::printf("      %s P %s, %s, %s; D %s, %s, %s; alpha %s, %s; gap %s\n", name,
                ShortestText(s.P1).c_str(), ShortestText(s.P2).c_str(), ShortestText(s.P3).c_str(),
                ShortestText(s.D1).c_str(), ShortestText(s.D2).c_str(), ShortestText(s.D3).c_str(),
                ShortestText(s.alpha1).c_str(), ShortestText(s.alpha2).c_str(),
                ShortestText(s.gap).c_str());
}

void PrintCurve(HINGE_END end, const T_SKEL_CURVE& curve)
{
    std::printf("    %s:\n", EndName(end));
    std::visit(
        [](const auto& c) {
            PrintSide("(+)", c.sides.pos);
            PrintSide("(-)", c.sides.neg);
        },
        curve);
    const auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
    if (!fema) return;
    std::printf("      measure: %s, strength loss %s\n",
                fema->measure == SKEL_MEASURE::DDy ? "D/Dy" : "plastic",
                fema->strengthLoss ? "on" : "off");
    for (const T_SKEL_AXIAL& axial : fema->curves)
        std::printf("      curve at axial force %s\n", ShortestText(axial.axial).c_str());
}

const char* SkeletonName(SKEL_TYPE type)
{
    static constexpr std::array<const char*, 7> kNames{
        "bilinear", "trilinear", "slip bilinear",   "slip trilinear",
        "FEMA",     "EC8",       "compression only"};
    return kNames[static_cast<std::size_t>(type)];
}

/// Puts a changed type back as one undoable step.
EXIT_CODE StoreType(CDBDoc& doc, int key, T_PHGT_D& type, const std::string& out)
{
    for (T_HINGE_COMPONENT& component : type.components)
        component = MirroredComponent(component);
    if (!doc.Edit().Begin("hinge type") || !doc.Edit().Put(key, type) || !doc.Edit().Commit())
        return Complain(EXIT_CODE::BadInput, doc.Path() + ": the hinge type can't be stored");
    return SaveDocument(doc, out);
}

/// Opens the document and takes the type of that name with its key.
EXIT_CODE OpenType(CDBDoc& doc, const T_HINGE_OPTIONS& o, int& key, T_PHGT_D& type)
{
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    if (doc.Attr().FindPhgt(o.type, key) && doc.Attr().GetPhgt(key, type)) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::Usage, doc.Path() + ": no hinge type named \"" + o.type + "\"");
}

/// True where every side that the curve uses has a yield deformation to convert with.
bool HasYieldDeform(const T_SKEL_FEMA& curve)
{
    constexpr double kNone = 1e-7;
    const auto has = [&](const T_SIDES<T_SKEL_SIDE>& s) {
        return std::fabs(s.pos.yieldDeform) >= kNone &&
               (curve.symmetric || std::fabs(s.neg.yieldDeform) >= kNone);
    };
    if (!curve.multiCurve) return has(curve.sides);
    return std::ranges::all_of(curve.curves, [&](const T_SKEL_AXIAL& a) { return has(a.sides); });
}

/// The curve of the page that the options name, or null.
T_SKEL_CURVE* PageOf(T_HINGE_COMPONENT& component, const std::string& end, HINGE_END& page)
{
    T_SKEL_CURVE* found = nullptr;
    ForEachPage(component, [&](HINGE_END e, T_SKEL_CURVE& curve) {
        const bool wanted =
            end.empty() || (end == "I" && e != HINGE_END::J) || (end == "J" && e != HINGE_END::I);
        if (found || !wanted) return;
        found = &curve;
        page = e;
    });
    return found;
}

} // namespace

EXIT_CODE RunHingeList(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    return ForEachType(doc, o.type, [&](int key, const T_PHGT_D& type) {
        std::printf("%s: %s, used by %zu elements\n",
                    CPO_HingeTypeListDlg::NameOf(key, type.name).c_str(),
                    CPO_HingeTypeListDlg::DataToStr(type.element).c_str(),
                    doc.Attr().GetElemsByPhgt(key).size());
    });
}

EXIT_CODE RunHingeShow(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const T_UNITS units = doc.Unit().Units();
    return ForEachType(doc, o.type, [&](int key, T_PHGT_D& type) {
        std::printf("%s: %s (%s, %s)\n", CPO_HingeTypeListDlg::NameOf(key, type.name).c_str(),
                    CPO_HingeTypeListDlg::DataToStr(type.element).c_str(),
                    std::string(NameOf(units.force)).c_str(),
                    std::string(NameOf(units.length)).c_str());
        for (std::size_t c = 0; c < type.components.size(); ++c) {
            T_HINGE_COMPONENT& component = type.components[c];
            if (!component.active) continue;
            std::printf("  %s: %s\n", kComponentNames[c], SkeletonName(component.type));
            ForEachPage(component, PrintCurve);
        }
    });
}

EXIT_CODE RunHingeCheck(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const T_HINGE_CONTEXT context = ContextOf(doc);
    std::size_t findings = 0, types = 0;
    const EXIT_CODE code = ForEachType(doc, o.type, [&](int key, const T_PHGT_D& type) {
        ++types;
        for (const T_FINDING& f : CPO_HingeTypeDlg::TypeFindings(type, context)) {
            ++findings;
            std::printf("%s: %s: %s: %s\n", CPO_HingeTypeListDlg::NameOf(key, type.name).c_str(),
                        Where(f).c_str(), f.ruleText.c_str(), f.text.c_str());
        }
    });
    if (code != EXIT_CODE::Done) return code;
    std::printf("%zu hinge types, %zu findings\n", types, findings);
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

namespace {

/// What the look-ups and the strength calculation gave for one element.
struct T_YIELD_INPUT {
    T_SECT_D section;
    T_MATL_D material;
    double length = 0.0;
    bool known = false; // automatic strengths could be calculated
    T_SECTION_STRENGTH strength;
    SECT_FAULT fault{};
};

/// Entered yield strength of one side; P2 of a trilinear curve, whose P1 is the crack strength.
double EnteredYield(const T_SKEL_SIDE& side, SKEL_TYPE)
{
    return side.yield;
}
double EnteredYield(const T_SKEL_MULTI_SIDE& side, SKEL_TYPE type)
{
    const bool trilinear = type == SKEL_TYPE::Trilinear || type == SKEL_TYPE::SlipTrilinear;
    return trilinear ? side.P2 : side.P1;
}

/// One side at one end: strength and deformation at first yield, "-" where there is no method.
/// False when an automatic strength could not be calculated.
template <class CURVE, class SIDE>
bool PrintYieldSide(const T_YIELD_INPUT& in, std::size_t c, SKEL_TYPE type, HINGE_LOCATION end,
                    const CURVE& curve, const SIDE& side, bool positive)
{
    const auto automatic = in.known ? in.strength.yield[c] : std::nullopt;
    std::optional<double> yield;
    if (!curve.autoYield)
        yield = EnteredYield(side, type);
    else if (automatic)
        yield = positive ? automatic->pos : automatic->neg;
    const auto k = static_cast<HINGE_COMPONENT>(c);
    const T_THETA_LOOKUP lookup{&in.section, &in.material, in.length};
    double deform = 0.0;
    if (yield)
        deform = IsMoment(static_cast<int>(c))
                     ? CHingeTheta::CalcThetaMoment(lookup, k, end, curve.initStiffness,
                                                    side.userStiffness, *yield)
                     : CHingeTheta::CalcThetaShear(lookup, k, end, curve.initStiffness,
                                                   side.userStiffness, *yield);
    std::printf("  %s(%c) %s-end: yield strength %s (%s), yield deformation %s\n",
                kComponentNames[c], positive ? '+' : '-', end == HINGE_LOCATION::IEnd ? "I" : "J",
                yield ? FormatText("%.9g", *yield).c_str() : "-",
                curve.autoYield ? "automatic" : "entered",
                deform != 0.0 ? FormatText("%.9g", deform).c_str() : "-");
    return yield.has_value();
}

/// Both ends, or the one where the hinge is, and both sides of one component.
bool PrintYieldComponent(const T_YIELD_INPUT& in, std::size_t c, const T_HINGE_COMPONENT& component)
{
    bool whole = true;
    for (const HINGE_LOCATION end : {HINGE_LOCATION::IEnd, HINGE_LOCATION::JEnd}) {
        const HINGE_LOCATION other =
            end == HINGE_LOCATION::IEnd ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd;
        if (component.location == other) continue;
        const bool j = end == HINGE_LOCATION::JEnd && !component.sameEnds;
        std::visit(
            [&](const auto& curve) {
                const auto& neg = curve.symmetric ? curve.sides.pos : curve.sides.neg;
                whole &= PrintYieldSide(in, c, component.type, end, curve, curve.sides.pos, true);
                whole &= PrintYieldSide(in, c, component.type, end, curve, neg, false);
            },
            j ? component.curves.J : component.curves.I);
    }
    return whole;
}

/// Yield strengths and deformations of a hinge on one element. False when something is missing.
bool PrintYield(CDBDoc& doc, const T_PHGE_D& hinge, const T_PHGT_D& type)
{
    T_YIELD_INPUT in;
    if (!doc.Attr().GetSectMatlByElem(hinge.element, in.section, in.material) ||
        !doc.Memb().GetMembLengByIncludeElem(hinge.element, in.length)) {
        std::printf("element %d: section, material or member is missing\n", hinge.element);
        return false;
    }
    in.known = CSectionStrength::Calc(in.section, in.material, in.strength, in.fault);
    std::printf("element %d, hinge type %s, section %s, material %s, member length %.6g\n",
                hinge.element, type.name.c_str(), in.section.name.c_str(), in.material.name.c_str(),
                in.length);
    bool whole = true;
    for (std::size_t c = 0; c < type.components.size(); ++c) {
        if (type.components[c].active) whole &= PrintYieldComponent(in, c, type.components[c]);
    }
    if (!whole && !in.known)
        std::printf("  %s\n", zql::lib::MMSGFunction::GetValue(MessageKeyOf(in.fault)).c_str());
    return whole;
}

} // namespace

EXIT_CODE RunHingeYield(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    int named = 0;
    if (!o.type.empty() && !doc.Attr().FindPhgt(o.type, named))
        return Complain(EXIT_CODE::Usage, o.file + ": no hinge type named \"" + o.type + "\"");
    bool whole = true;
    for (const auto& entry : doc.Data().Model().hinges) {
        T_PHGE_D hinge;
        T_PHGT_D type;
        if (doc.Attr().GetPhge(entry.first, hinge) && doc.Attr().GetPhgt(hinge.hingeType, type) &&
            (o.type.empty() || o.type == type.name))
            whole &= PrintYield(doc, hinge, type);
    }
    return whole ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunHingeConvert(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, key, type); code != EXIT_CODE::Done) return code;
    const SKEL_MEASURE to = o.to == "plastic" ? SKEL_MEASURE::Plastic : SKEL_MEASURE::DDy;
    int switched = 0;
    bool noYield = false; // a switch without a yield deformation would make every value 0
    for (std::size_t c = 0; c < type.components.size(); ++c) {
        if (!type.components[c].active ||
            (!o.component.empty() && o.component != kComponentNames[c]))
            continue;
        ForEachPage(type.components[c], [&](HINGE_END, T_SKEL_CURVE& curve) {
            auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
            if (!fema || fema->measure == to) return;
            if (!HasYieldDeform(*fema)) noYield = true;
            switched += to == SKEL_MEASURE::Plastic
                            ? CPO_HingeSkcvTabFemaDlg::ConvertHingeParamPR2DDy(*fema)
                            : CPO_HingeSkcvTabFemaDlg::ConvertHingeParamDDy2PR(*fema);
        });
    }
    if (switched == 0 && !noYield)
        return Complain(EXIT_CODE::Usage,
                        o.file + ": hinge type \"" + o.type + "\" has no curve to switch");
    if (noYield)
        return Complain(EXIT_CODE::Usage, o.file + ": hinge type \"" + o.type +
                                              "\": a curve has no yield deformation; enter "
                                              "yield_deform first (see qm-rps hinge yield)");
    std::printf("%d curves switched\n", switched);
    return StoreType(doc, key, type, o.out);
}

EXIT_CODE RunHingeAxial(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, key, type); code != EXIT_CODE::Done) return code;
    const auto component = ComponentOf(o.component);
    HINGE_END page{};
    T_SKEL_CURVE* curve =
        component ? PageOf(type.components[static_cast<std::size_t>(*component)], o.end, page)
                  : nullptr;
    auto* fema = curve ? std::get_if<T_SKEL_FEMA>(curve) : nullptr;
    if (!fema) return Complain(EXIT_CODE::Usage, o.file + ": that component has no FEMA curve");
    CPO_HingeSkcvTabFemaAxialGrid grid;
    grid.Data2Dlg(fema->curves);
    bool ok = true;
    for (const double axial : o.add)
        ok = ok && grid.AddForce(axial);
    for (const double axial : o.remove)
        ok = ok && grid.RemoveForce(axial);
    if (o.change.size() == 2) ok = ok && grid.ChangeForce(o.change[0], o.change[1]);
    if (!ok) return Complain(EXIT_CODE::Usage, grid.Messages().back().text);
    grid.Dlg2Data(fema->curves, fema->sides);
    fema->multiCurve = !fema->curves.empty();
    if (fema->curves.size() == 1)
        return Complain(EXIT_CODE::Usage,
                        zql::lib::MMSGFunction::GetValue("IDS_RPS_MULTI_CURVE_COUNT"));
    std::printf("%zu axial forces\n", fema->curves.size());
    return StoreType(doc, key, type, o.out);
}

EXIT_CODE RunHingePlot(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, key, type); code != EXIT_CODE::Done) return code;
#ifdef QM_UI
    T_PLOT plot;
    if (o.interaction) {
        T_SECT_D section;
        T_MATL_D material;
        T_SECTION_STRENGTH strength;
        SECT_FAULT fault{};
        if (type.yieldSurface) {
            plot = HingeInteractionPlot(type, type.yieldSurface->yield, "yield level, as entered");
        } else if (doc.Attr().GetSect(type.section, section) &&
                   doc.Attr().GetMatl(type.sectionMaterial, material) &&
                   CSectionStrength::Calc(section, material, strength, fault)) {
            plot = HingeInteractionPlot(type, strength.level, "from section " + section.name);
        } else {
            return Complain(EXIT_CODE::Usage, o.file + ": hinge type \"" + o.type +
                                                  "\" has no yield surface and no section that "
                                                  "gives one");
        }
    } else {
        const auto component = ComponentOf(o.component);
        HINGE_END page{};
        T_SKEL_CURVE* curve =
            component ? PageOf(type.components[static_cast<std::size_t>(*component)], o.end, page)
                      : nullptr;
        if (!curve) return Complain(EXIT_CODE::Usage, "choose a component, Fx to Mz");
        plot = HingeBackbonePlot(type, *component, *curve, EndName(page));
    }
    if (const EXIT_CODE code = WritePicture(plot, o.out); code != EXIT_CODE::Done) return code;
    std::printf("%s written\n", o.out.c_str());
    return EXIT_CODE::Done;
#else
    return Complain(EXIT_CODE::Usage, "this qm-rps was built without pictures");
#endif
}

EXIT_CODE RunCaseCheck(const std::string& file)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, file); code != EXIT_CODE::Done) return code;
    const auto hasFunction = [&](int key) {
        return doc.Data().Model().incrementFunctions.contains(key);
    };
    std::size_t findings = 0;
    for (const auto& entry : doc.Data().Model().pushovers) {
        T_POLC_D polc;
        if (!doc.Attr().GetPolc(entry.first, polc)) continue;
        CPO_LoadCaseDlg dialog(hasFunction);
        dialog.Data2Dlg(polc);
        std::vector<T_FINDING> all = dialog.Findings();
        const auto rows = CPO_LoadCaseDlg::PatternFindings(polc.patterns);
        all.insert(all.end(), rows.begin(), rows.end());
        for (const T_FINDING& f : all)
            std::printf("%s: %s: %s\n", polc.name.c_str(), f.field.c_str(), f.text.c_str());
        findings += all.size();
    }
    std::printf("%zu load cases, %zu findings\n", doc.Data().Model().pushovers.size(), findings);
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
