// Commands on the hinges of elements: their strengths, their assignment and their list.
#include "hingetools.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/hinge/pageyield.h"
#include "qm_rps/pushoverhingelistdlg.h"

#include <algorithm>

namespace {

/// "yield rotation 0.0074 rad", "yield curvature 0.0012 1/m", "yield deformation -".
std::string DeformText(const T_PHGT_D& type, HINGE_COMPONENT c, std::optional<double> deform,
                       const T_UNITS& units)
{
    const std::string value = deform ? FormatText("%.9g", *deform) : "-";
    if (!IsMoment(c)) return Say("IDS_QM_CLI_HINGE_DEFORM", value);
    const bool rotation = type.definition == HINGE_DEFINITION::MomentRotation;
    const std::string unit = rotation ? "rad" : "1/" + std::string(NameOf(units.length));
    return Say(rotation ? "IDS_QM_CLI_HINGE_ROTATION" : "IDS_QM_CLI_HINGE_CURVATURE",
               deform ? value + " " + unit : value);
}

/// What the command prints the values of.
struct T_YIELD_OF {
    const T_PHGT_D& type;
    const T_HINGE_ELEMENT& in;
    CHingeGenerator::T_STRENGTHS strengths;
    T_UNITS units;
};

/// The page that holds an end's strengths.
HINGE_END PageOf(const T_HINGE_COMPONENT& c, HINGE_LOCATION end)
{
    const bool both = !NeedsIJPages(c) && c.location != HINGE_LOCATION::IEnd &&
                      c.location != HINGE_LOCATION::JEnd;
    if (both) return HINGE_END::Both;
    return end == HINGE_LOCATION::IEnd ? HINGE_END::I : HINGE_END::J;
}

/// One curve at one end: strengths and deformations at first yield of both sides, "-" where there
/// is no method. False when an automatic strength could not be calculated.
bool PrintYieldCurve(const T_YIELD_OF& of, std::size_t i, HINGE_LOCATION end,
                     const T_SKEL_CURVE& curve)
{
    const auto c = static_cast<HINGE_COMPONENT>(i);
    const T_THETA_LOOKUP lookup =
        LookupOf(of.type, of.in.section ? &*of.in.section : nullptr,
                 of.in.material ? &*of.in.material : nullptr, of.in.memberLength);
    const T_SIDE_VALUES yield = PageStrength(curve, of.type.components[i].type, c,
                                             of.strengths.at(PageOf(of.type.components[i], end)))
                                    .yield;
    const T_SIDE_VALUES deform = PageDeform(curve, c, end, lookup, yield);
    const auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
    const char* source = IsAutoYield(curve)         ? "IDS_QM_CLI_HINGE_AUTOMATIC"
                         : fema && fema->multiCurve ? "IDS_QM_CLI_HINGE_ENTERED_AXIAL"
                                                    : "IDS_QM_CLI_HINGE_ENTERED";
    for (const bool positive : {true, false}) {
        const std::optional<double> strength = positive ? yield.pos : yield.neg;
        PrintLine("  " + Say("IDS_QM_CLI_HINGE_YIELD", kComponentNames[i], positive ? "+" : "-",
                             EndName(end == HINGE_LOCATION::IEnd ? HINGE_END::I : HINGE_END::J),
                             strength ? FormatText("%.9g", *strength) : "-", Say(source),
                             DeformText(of.type, c, positive ? deform.pos : deform.neg, of.units)));
    }
    return yield.pos.has_value();
}

/// Both ends, or the one where the hinge is.
bool PrintYieldComponent(const T_YIELD_OF& of, std::size_t i)
{
    const T_HINGE_COMPONENT& component = of.type.components[i];
    bool whole = true;
    for (const HINGE_LOCATION end : {HINGE_LOCATION::IEnd, HINGE_LOCATION::JEnd}) {
        const bool j = end == HINGE_LOCATION::JEnd;
        if (component.location == (j ? HINGE_LOCATION::IEnd : HINGE_LOCATION::JEnd)) continue;
        const bool own = j && !component.sameEnds;
        whole &= PrintYieldCurve(of, i, end, own ? component.curves.J : component.curves.I);
    }
    return whole;
}

/// Yield strengths and deformations of a hinge on one element. False when something is missing.
bool PrintYield(const CHingeGenerator& generator, const T_PHGE_D& hinge, const T_PHGT_D& type,
                const T_UNITS& units)
{
    T_HINGE_ELEMENT in;
    T_HINGE_REFUSAL refusal;
    if (!generator.ReadElement(type, hinge.element, in, refusal)) {
        PrintLine(refusal.text);
        return false;
    }
    PrintLine(Say("IDS_QM_CLI_HINGE_ON_ELEMENT", std::to_string(hinge.element), type.name,
                  in.section ? in.section->name : "-", in.material ? in.material->name : "-",
                  in.section ? FormatText("%.6g", in.memberLength) : "-"));
    if (!type.length.autoSpan)
        PrintLine("  " + Say("IDS_QM_CLI_HINGE_OWN_SPAN", FormatText("%.6g", type.length.span)));
    T_YIELD_OF of{type, in, {}, units};
    if (!generator.CalcStrengths(type, hinge.element, hinge.axialCase, in, of.strengths, refusal)) {
        PrintLine("  " + refusal.text);
        return false;
    }
    bool whole = true;
    for (std::size_t i = 0; i < type.components.size(); ++i)
        if (type.components[i].active) whole &= PrintYieldComponent(of, i);
    if (!whole && in.result->fault != SECT_FAULT::None)
        PrintLine("  " + Say(MessageKeyOf(in.result->fault)));
    return whole;
}

/// A table with right-aligned columns under their heads.
void PrintTable(const std::vector<std::vector<std::string>>& rows)
{
    std::vector<std::size_t> width(rows.front().size());
    for (const auto& row : rows)
        for (std::size_t c = 0; c < row.size(); ++c)
            width[c] = std::max(width[c], row[c].size());
    for (const auto& row : rows) {
        for (std::size_t c = 0; c < row.size(); ++c)
            std::printf("%s%*s", c ? "  " : "", static_cast<int>(width[c]), row[c].c_str());
        std::printf("\n");
    }
}

/// The crack or the yield strengths of the generated hinges; crack strengths only if there are any.
void PrintHinges(const CPushOverHingeListDlg& list, bool crack, const T_UNITS& units)
{
    std::vector<std::vector<std::string>> table{
        {Say("IDS_QM_CLI_HINGE"), Say("IDS_QM_CLI_ELEMENT"), Say("IDS_QM_CLI_HINGE_TYPE")}};
    for (const std::string& head : CPushOverHingeListDlg::Heads())
        table.front().push_back(head);
    bool any = !crack;
    for (const CPushOverHingeListDlg::T_ROW& row : list.Rows(crack)) {
        auto& cells = table.emplace_back();
        cells = {std::to_string(row.key), std::to_string(row.element), row.type};
        for (const T_SIDES<double>& s : row.strengths)
            for (const double v : {s.pos, s.neg}) {
                cells.push_back(v == 0.0 ? "-" : FormatText("%.9g", v));
                any = any || v != 0.0;
            }
    }
    if (!any) return;
    std::printf("%s (%s), %s (%s %s)\n",
                CPushOverHingeListDlg::StrengthText(HINGE_COMPONENT::Fx, crack).c_str(),
                std::string(NameOf(units.force)).c_str(),
                CPushOverHingeListDlg::StrengthText(HINGE_COMPONENT::My, crack).c_str(),
                std::string(NameOf(units.force)).c_str(),
                std::string(NameOf(units.length)).c_str());
    PrintTable(table);
}

/// Hinges whose strengths are not those of today, once each.
void PrintStale(const CPushOverHingeListDlg& list)
{
    int last = 0;
    for (const CPushOverHingeListDlg::T_ROW& row : list.Rows(false)) {
        if (row.key != last && !row.stale.empty())
            PrintLine(Say("IDS_QM_CLI_HINGE_STALE", std::to_string(row.key),
                          Say("IDS_QM_HINGE_STALE", row.stale)));
        last = row.key;
    }
}

} // namespace

EXIT_CODE RunHingeYield(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    int named = 0;
    if (!o.type.empty() && !doc.Attr().FindPhgt(o.type, named)) return NoSuchType(o.file, o.type);
    const CHingeGenerator generator(doc);
    bool whole = true;
    for (const auto& entry : doc.Data().Model().hinges) {
        T_PHGE_D hinge;
        T_PHGT_D type;
        if (doc.Attr().GetPhge(entry.first, hinge) && doc.Attr().GetPhgt(hinge.hingeType, type) &&
            (o.type.empty() || o.type == type.name))
            whole &= PrintYield(generator, hinge, type, doc.Unit().Units());
    }
    return whole ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunHingeAssign(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    int key = 0;
    T_PHGT_D type;
    if (const EXIT_CODE code = OpenType(doc, o, OUTPUT_KIND::Document, key, type);
        code != EXIT_CODE::Done)
        return code;
    const std::optional<std::vector<int>> elements = ParseElementList(o.elements);
    if (!elements || elements->empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_ELEMENT_LIST", o.elements));
    T_HINGE_REFUSAL refusal;
    int axialCase = 0;
    if (!o.axialCase.empty() && !doc.Attr().FindStld(o.axialCase, axialCase))
        return Complain(EXIT_CODE::Usage,
                        o.file + ": " + Say("IDS_QM_DB_RESULT_NO_CASE", o.axialCase));
    if (!CHingeGenerator(doc).Generate(key, *elements, refusal, axialCase))
        return Complain(EXIT_CODE::BadInput, o.file + ": " + refusal.text);
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    PrintLine(Say("IDS_QM_CLI_HINGE_ASSIGNED",
                  std::to_string(doc.Attr().GetElemsByPhgt(key).size()), type.name));
    return EXIT_CODE::Done;
}

EXIT_CODE RunHingeGenerated(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const CPushOverHingeListDlg list(doc);
    const std::size_t count = doc.Data().Model().hinges.size();
    if (count > 0) {
        PrintHinges(list, false, doc.Unit().Units());
        PrintHinges(list, true, doc.Unit().Units());
        PrintStale(list);
    }
    PrintLine(Say("IDS_QM_CLI_HINGE_GENERATED", std::to_string(count)));
    return EXIT_CODE::Done;
}
