// Commands that edit or draw a hinge type.
#include "hingetools.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/hinge/axialforcelist.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingecontext.h"
#include "qm_rps/hinge/hingemirror.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/hinge/pageyield.h"
#include "qm_rps/hinge/sectionstrength.h"
#include "qm_rps/hingeoptionsdlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"

#ifdef QM_UI
#include "qm_ui/hinge/hingeplot.h"
#endif

#include <algorithm>
#include <cmath>

namespace {

/// Puts a changed type back as one undoable step, saves, and says `done`.
EXIT_CODE StoreType(CDBDoc& doc, int key, T_PHGT_D& type, const std::string& out,
                    const std::string& done)
{
    for (T_HINGE_COMPONENT& component : type.components)
        component = MirroredComponent(component);
    if (!StoreHingeType(doc, key, type))
        return Complain(EXIT_CODE::BadInput, Say("IDS_QM_CLI_HINGE_NOT_STORED", doc.Path()));
    const EXIT_CODE code = SaveDocument(doc, out);
    if (code == EXIT_CODE::Done) PrintLine(done);
    return code;
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

/// Takes what the arguments change. False: nothing.
bool Edit(const T_HINGE_OPTIONS& o, CHingeOptionsDlg& options)
{
    bool any = false;
    const auto flag = [&any](const std::string& word, bool& value) {
        if (word.empty()) return;
        value = word == "on";
        any = true;
    };
    const auto code = [&any](const std::optional<std::string>& name, std::string& value) {
        if (!name) return;
        value = *name;
        any = true;
    };
    const auto ratios = [&any](const std::vector<double>& given, std::array<double, 2>& values) {
        if (given.size() != values.size()) return;
        std::ranges::copy(given, values.begin());
        any = true;
    };
    code(o.concreteCode, options.m_concreteCode);
    code(o.steelCode, options.m_steelCode);
    flag(o.alternative, options.m_alternativeHysteresis);
    flag(o.wallDegradation, options.m_wallStrengthDegradation);
    flag(o.gsd, options.m_gsd);
    ratios(o.alpha1, options.m_alpha1);
    ratios(o.alpha2, options.m_alpha2);
    return any;
}

} // namespace

EXIT_CODE RunHingeConvert(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, OUTPUT_KIND::Document, key, type);
        code != EXIT_CODE::Done)
        return code;
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
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_NO_SWITCH", o.file, o.type));
    if (noYield)
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_NO_YIELD_DEFORM", o.file, o.type));
    return StoreType(doc, key, type, o.out,
                     Say("IDS_QM_CLI_HINGE_SWITCHED", std::to_string(switched)));
}

EXIT_CODE RunHingeAxial(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, OUTPUT_KIND::Document, key, type);
        code != EXIT_CODE::Done)
        return code;
    const auto component = ComponentOf(o.component);
    HINGE_END page{};
    T_SKEL_CURVE* curve =
        component ? PageOf(type.components[static_cast<std::size_t>(*component)], o.end, page)
                  : nullptr;
    auto* fema = curve ? std::get_if<T_SKEL_FEMA>(curve) : nullptr;
    if (!fema) return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_NO_FEMA", o.file));
    const auto sources = HingeContextOf(doc).sources;
    CAxialForceList forces(fema->curves, sources->AxialRange(type.section, type.sectionMaterial));
    CAxialForceList::REFUSAL refusal;
    for (const double axial : o.add)
        if (!refusal) refusal = forces.Add(axial);
    for (const double axial : o.remove)
        if (!refusal) refusal = forces.Remove(axial);
    if (o.change.size() == 2 && !refusal) refusal = forces.Change(o.change[0], o.change[1]);
    if (refusal) return Complain(EXIT_CODE::Usage, refusal->text);
    fema->curves = forces.Curves(fema->sides);
    fema->multiCurve = !fema->curves.empty();
    if (fema->curves.size() == 1)
        return Complain(EXIT_CODE::Usage, Say("IDS_RPS_MULTI_CURVE_COUNT"));
    const std::string done =
        Say("IDS_QM_CLI_HINGE_AXIAL_FORCES", std::to_string(fema->curves.size()));
    return StoreType(doc, key, type, o.out, done);
}

EXIT_CODE RunHingeModelOptions(const T_HINGE_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Document}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    CHingeOptionsDlg options(doc);
    const bool edited = Edit(o, options);
    if (edited != !o.out.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_OPTIONS_OUT"));
    if (edited && !options.OnOK())
        return Complain(EXIT_CODE::Usage, o.file + ": " + options.Messages().back().text);
    const auto word = [](bool on) {
        return Say(on ? "IDS_QM_CLI_HINGE_ON" : "IDS_QM_CLI_HINGE_OFF");
    };
    const auto ratio = [](double v) { return ShortestText(v); };
    PrintLine(Say("IDS_QM_CLI_HINGE_CODES", options.m_concreteCode, options.m_steelCode));
    PrintLine(options.ModeText());
    PrintLine(Say("IDS_QM_CLI_HINGE_SWITCHES", word(options.m_alternativeHysteresis),
                  word(options.m_wallStrengthDegradation), word(options.m_gsd)));
    PrintLine(Say("IDS_QM_CLI_HINGE_ALPHAS", ratio(options.m_alpha1[0]), ratio(options.m_alpha1[1]),
                  ratio(options.m_alpha2[0]), ratio(options.m_alpha2[1])));
    return edited ? SaveDocument(doc, o.out) : EXIT_CODE::Done;
}

EXIT_CODE RunHingeSurface(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, OUTPUT_KIND::Document, key, type);
        code != EXIT_CODE::Done)
        return code;
    T_YIELD_SURFACE surface = type.yieldSurface.value_or(T_YIELD_SURFACE{});
    CPO_HingeYieldPropDlgNew dlg(surface, YieldSurfaceCurve(type));
    dlg.m_calculated = CalculatedLevel({type, doc.Unit().Units(), HingeContextOf(doc).sources});
    if (!dlg.OnCalculateBtn())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_NO_LEVEL", o.file, o.type));
    type.yieldSurface = dlg.m_surface;
    return StoreType(doc, key, type, o.out, Say("IDS_QM_CLI_HINGE_SURFACE", o.type));
}

EXIT_CODE RunHingePlot(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, OUTPUT_KIND::Picture, key, type);
        code != EXIT_CODE::Done)
        return code;
#ifdef QM_UI
    T_PLOT plot;
    if (o.interaction) {
        const auto sources = HingeContextOf(doc).sources;
        const auto units = o.values ? std::optional(doc.Unit().Units()) : std::nullopt;
        const auto* result = sources->Strength(type.section, type.sectionMaterial);
        if (type.pmm && HasUserInteraction(type)) {
            plot = UserInteractionPlot(type, *type.pmm);
        } else if (type.yieldSurface) {
            plot = HingeInteractionPlot(type, type.yieldSurface->yield,
                                        Say("IDS_QM_CLI_HINGE_LEVEL_ENTERED"), {}, units);
        } else if (result && result->fault == SECT_FAULT::None) {
            const std::string& section = sources->Section(type.section)->name;
            plot = HingeInteractionPlot(type, result->strength.level,
                                        Say("IDS_QM_CLI_HINGE_LEVEL_SECTION", section),
                                        sources->Lines(type.section, type.sectionMaterial), units);
        } else if (result) {
            return Complain(EXIT_CODE::Usage, o.file + ": " + Say(MessageKeyOf(result->fault)));
        } else {
            return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_NO_SURFACE", o.file, o.type));
        }
    } else {
        const auto component = ComponentOf(o.component);
        HINGE_END page{};
        T_SKEL_CURVE* curve =
            component ? PageOf(type.components[static_cast<std::size_t>(*component)], o.end, page)
                      : nullptr;
        if (!curve) return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_CHOOSE_COMPONENT"));
        plot = HingeBackbonePlot(type, *component, *curve, EndName(page), o.box);
    }
    if (const EXIT_CODE code = WritePicture(plot, o.out); code != EXIT_CODE::Done) return code;
    PrintLine(Say("IDS_QM_CLI_HINGE_WRITTEN", o.out));
    return EXIT_CODE::Done;
#else
    return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NO_PICTURES"));
#endif
}
