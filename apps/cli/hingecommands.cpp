// Commands that print hinge types and load cases.
#include "hingetools.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/generate/codehinges.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingetypedlg.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/push/casecheck.h"
#include "qm_rps/pushoverhingelistdlg.h"

#include <algorithm>

namespace {

// In the order of SKEL_TYPE.
constexpr const char* kCurveTypes[] = {
    "IDS_QM_CLI_HINGE_BILINEAR",      "IDS_QM_CLI_HINGE_TRILINEAR",
    "IDS_QM_CLI_HINGE_SLIP_BILINEAR", "IDS_QM_CLI_HINGE_SLIP_TRILINEAR",
    "IDS_QM_CLI_HINGE_FEMA",          "IDS_QM_CLI_HINGE_EC8",
    "IDS_QM_CLI_HINGE_COMPRESSION"};

std::string Where(const T_FINDING& f)
{
    std::string text;
    if (f.part >= 0) {
        text += std::string(kComponentNames[static_cast<std::size_t>(f.part)]) + ", ";
        text += EndName(EndOf(f)) + ", ";
    }
    if (!f.point.empty()) text += Say("IDS_QM_CLI_HINGE_POINT", f.point) + ", ";
    return text + f.field;
}

std::string Text(const T_SKEL_POINT& p)
{
    return "(" + ShortestText(p.deform) + ", " + ShortestText(p.strength) + ")";
}

/// What stands below an end of a component.
void PrintDetail(const std::string& text)
{
    std::printf("      %s\n", text.c_str());
}

/// A strength, unless it is calculated for each element.
std::string StrengthText(double strength, bool automatic)
{
    return automatic ? Say("IDS_QM_CLI_HINGE_AUTOMATIC") : ShortestText(strength);
}

/// What the sides of a curve are printed with.
struct T_SIDE_LOOK {
    bool automatic = false, criteria = true; // strength; criteria in use
    SKEL_TYPE type = SKEL_TYPE::Bilinear;
};

void PrintSide(const char* name, const T_SKEL_SIDE& s, const T_SIDE_LOOK& look)
{
    const auto criterion = [&](double v) { return CriterionText(look.criteria, v); };
    PrintDetail(Say("IDS_QM_CLI_HINGE_SIDE", name, StrengthText(s.yield, look.automatic),
                    ShortestText(s.yieldDeform), Text(s.B), Text(s.C), Text(s.D), Text(s.E),
                    criterion(s.IO), criterion(s.LS), criterion(s.CP)));
}

void PrintSide(const char* name, const T_SKEL_MULTI_SIDE& s, const T_SIDE_LOOK& look)
{
    const bool tri = IsTrilinear(look.type), automatic = look.automatic;
    PrintDetail(Say("IDS_QM_CLI_HINGE_MULTI_SIDE", name, StrengthText(s.P1, automatic && !tri),
                    StrengthText(s.P2, automatic && tri), ShortestText(s.P3), ShortestText(s.D1),
                    ShortestText(s.D2), ShortestText(s.D3), ShortestText(s.alpha1),
                    ShortestText(s.alpha2), ShortestText(s.gap)));
}

void PrintCurve(HINGE_END end, const T_SKEL_CURVE& curve, SKEL_TYPE type)
{
    std::printf("    %s:\n", EndName(end).c_str());
    std::visit(
        [&](const auto& c) {
            T_SIDE_LOOK look{c.autoYield, true, type};
            if constexpr (requires { c.compliance; }) look.criteria = c.compliance;
            PrintSide("(+)", c.sides.pos, look);
            PrintSide("(-)", c.sides.neg, look);
        },
        curve);
    const auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
    if (!fema) return;
    const bool byDy = fema->measure == SKEL_MEASURE::DDy;
    PrintDetail(Say("IDS_QM_CLI_HINGE_MEASURE", byDy ? "D/Dy" : Say("IDS_QM_CLI_HINGE_PLASTIC"),
                    Say(fema->strengthLoss ? "IDS_QM_CLI_HINGE_ON" : "IDS_QM_CLI_HINGE_OFF")));
    if (!fema->compliance)
        PrintDetail(Say("IDS_QM_CLI_HINGE_CRITERIA", Say("IDS_RPS_PO_FEMA_Inactive")));
    for (const T_SKEL_AXIAL& axial : fema->curves)
        PrintDetail(Say("IDS_QM_CLI_HINGE_AXIAL_CURVE", ShortestText(axial.axial)));
}

/// Initial stiffness of every page, as the window of the type shows it.
void PrintStiffness(CDBDoc& doc, int key, const T_PHGT_D& type)
{
    CPO_HingeTypeDlg dlg(HingeContextOf(doc));
    dlg.Data2Dlg(type);
    const std::vector<int> users = doc.Attr().GetElemsByPhgt(key);
    if (!users.empty() && !doc.Memb().GetMembLengByIncludeElem(users.front(), dlg.m_memberLength))
        dlg.m_memberLength = 0.0;
    for (const T_STIFFNESS_ROW& row : dlg.UpdateInitialStiffness()) {
        const auto cells = dlg.StiffnessCells(row);
        PrintLine("  " + Say("IDS_QM_CLI_HINGE_STIFFNESS", cells[0], cells[1], cells[2], cells[3],
                             cells[4]));
    }
}

} // namespace

EXIT_CODE RunHingeList(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    return ForEachType(doc, o.type, [&](int key, const T_PHGT_D& type) {
        PrintLine(Say("IDS_QM_CLI_HINGE_USED", CPO_HingeTypeListDlg::NameOf(key, type.name),
                      CPO_HingeTypeListDlg::DataToStr(type.element),
                      std::to_string(doc.Attr().GetElemsByPhgt(key).size())));
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
        PrintLine("  " + Say("IDS_QM_CLI_HINGE_KIND", CPushOverHingeListDlg::KindText(type)));
        for (std::size_t c = 0; c < type.components.size(); ++c) {
            T_HINGE_COMPONENT& component = type.components[c];
            if (!component.active) continue;
            const std::string model =
                HingeModelLabel(type.definition, static_cast<HINGE_COMPONENT>(c));
            std::printf("  %s: %s%s\n", kComponentNames[c],
                        Say(kCurveTypes[static_cast<std::size_t>(component.type)]).c_str(),
                        model.empty() ? "" : (", " + model).c_str());
            ForEachPage(component, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
                PrintCurve(end, curve, component.type);
            });
        }
        PrintStiffness(doc, key, type);
    });
}

EXIT_CODE RunHingeCheck(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const T_HINGE_CONTEXT context = HingeContextOf(doc);
    const CHingeGenerator generator(doc);
    CCodeHinges codeHinges(doc);
    std::size_t findings = 0, types = 0, warnings = 0;
    const EXIT_CODE code = ForEachType(doc, o.type, [&](int key, const T_PHGT_D& type) {
        ++types;
        const auto print = [&](const char* line, const std::vector<T_FINDING>& found) {
            for (const T_FINDING& f : found)
                PrintLine(Say(line, CPO_HingeTypeListDlg::NameOf(key, type.name), Where(f),
                              f.ruleText, f.text));
            return found.size();
        };
        constexpr const char* kFinding = "IDS_QM_CLI_HINGE_FINDING";
        findings += print(kFinding, HingeTypeFindings(type, context));
        findings += print(kFinding, generator.ElementFindings(key));
        warnings += print("IDS_QM_CLI_HINGE_WARNING", HingeTypeWarnings(type));
        warnings += print("IDS_QM_CLI_HINGE_WARNING", codeHinges.TypeFindings(key));
    });
    if (code != EXIT_CODE::Done) return code;
    PrintLine(Say("IDS_QM_CLI_HINGE_FINDINGS", std::to_string(types), std::to_string(findings)));
    if (warnings > 0) PrintLine(Say("IDS_QM_CLI_HINGE_WARNINGS", std::to_string(warnings)));
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunCaseCheck(const std::string& file)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, file); code != EXIT_CODE::Done) return code;
    std::size_t findings = 0, warnings = 0;
    for (const T_CASE_REMARK& r : CheckCase(doc)) {
        const T_FINDING& f = r.finding;
        if (!r.isWarning)
            std::printf("%s: %s: %s\n", r.where.c_str(), f.field.c_str(), f.text.c_str());
        else
            PrintLine(r.where.empty() ? f.text
                                      : Say("IDS_QM_CLI_CASE_WARNING", r.where, f.field, f.text));
        ++(r.isWarning ? warnings : findings);
    }
    PrintLine(Say("IDS_QM_CLI_HINGE_CASE_FINDINGS",
                  std::to_string(doc.Data().Model().pushovers.size()), std::to_string(findings)));
    if (warnings > 0) PrintLine(Say("IDS_QM_CLI_HINGE_WARNINGS", std::to_string(warnings)));
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
