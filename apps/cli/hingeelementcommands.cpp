// Commands on the hinges of elements: their strengths, their assignment and their list.
#include "hingetools.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetheta.h"
#include "qm_rps/pushoverhingelistdlg.h"

#include <algorithm>

namespace {

/// One side at one end: strength and deformation at first yield, "-" where there is no method.
/// False when an automatic strength could not be calculated.
template <class CURVE, class SIDE>
bool PrintYieldSide(const T_HINGE_ELEMENT& in, std::size_t c, SKEL_TYPE type, HINGE_LOCATION end,
                    const CURVE& curve, const SIDE& side, bool positive)
{
    const auto& automatic = in.result->strength.yield[c]; // empty where there is a fault
    std::optional<double> yield;
    if (!curve.autoYield)
        yield = CHingeGenerator::EnteredYield(side, type);
    else if (automatic)
        yield = positive ? automatic->pos : automatic->neg;
    const auto k = static_cast<HINGE_COMPONENT>(c);
    const T_THETA_LOOKUP lookup{&in.section, &in.material, in.memberLength};
    double deform = 0.0;
    if (yield)
        deform = IsMoment(k) ? CHingeTheta::CalcThetaMoment(lookup, k, end, curve.initStiffness,
                                                            side.userStiffness, *yield)
                             : CHingeTheta::CalcThetaShear(lookup, k, end, curve.initStiffness,
                                                           side.userStiffness, *yield);
    PrintLine("  " +
              Say("IDS_QM_CLI_HINGE_YIELD", kComponentNames[c], positive ? "+" : "-",
                  EndName(end == HINGE_LOCATION::IEnd ? HINGE_END::I : HINGE_END::J),
                  yield ? FormatText("%.9g", *yield) : "-",
                  Say(curve.autoYield ? "IDS_QM_CLI_HINGE_AUTOMATIC" : "IDS_QM_CLI_HINGE_ENTERED"),
                  deform != 0.0 ? FormatText("%.9g", deform) : "-"));
    return yield.has_value();
}

/// Both ends, or the one where the hinge is, and both sides of one component.
bool PrintYieldComponent(const T_HINGE_ELEMENT& in, std::size_t c,
                         const T_HINGE_COMPONENT& component)
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
bool PrintYield(const CHingeGenerator& generator, const T_PHGE_D& hinge, const T_PHGT_D& type)
{
    T_HINGE_ELEMENT in;
    T_HINGE_REFUSAL refusal;
    if (!generator.ReadElement(type, hinge.element, in, refusal)) {
        PrintLine(refusal.text);
        return false;
    }
    PrintLine(Say("IDS_QM_CLI_HINGE_ON_ELEMENT", std::to_string(hinge.element), type.name,
                  in.section.name, in.material.name, FormatText("%.6g", in.memberLength)));
    bool whole = true;
    for (std::size_t c = 0; c < type.components.size(); ++c) {
        if (type.components[c].active) whole &= PrintYieldComponent(in, c, type.components[c]);
    }
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
                cells.push_back(FormatText("%.9g", v));
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
            whole &= PrintYield(generator, hinge, type);
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
    if (!CHingeGenerator(doc).Generate(key, *elements, refusal))
        return Complain(EXIT_CODE::BadInput, o.file + ": " + refusal.text);
    PrintLine(Say("IDS_QM_CLI_HINGE_ASSIGNED",
                  std::to_string(doc.Attr().GetElemsByPhgt(key).size()), type.name));
    return SaveDocument(doc, o.out);
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
    }
    PrintLine(Say("IDS_QM_CLI_HINGE_GENERATED", std::to_string(count)));
    return EXIT_CODE::Done;
}
