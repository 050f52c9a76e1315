// Commands that print hinge types and load cases.
#include "hingetools.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/recordrules.h"
#include "qm_db/records/hingenames.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingetypelistdlg.h"

namespace {

std::string Where(const T_FINDING& f)
{
    std::string text;
    if (f.part >= 0) {
        text += std::string(kComponentNames[static_cast<std::size_t>(f.part)]) + ", ";
        text += std::string(EndName(EndOf(f))) + ", ";
    }
    if (!f.point.empty()) text += "point " + f.point + ", ";
    return text + f.field;
}

std::string Text(const T_SKEL_POINT& p)
{
    return "(" + ShortestText(p.deform) + ", " + ShortestText(p.strength) + ")";
}

void PrintSide(const char* name, const T_SKEL_SIDE& s)
{
    std::printf("      %s yield %s, Dy %s; B %s C %s D %s E %s; IO %s, LS %s, CP %s\n", name,
                ShortestText(s.yield).c_str(), ShortestText(s.yieldDeform).c_str(),
                Text(s.B).c_str(), Text(s.C).c_str(), Text(s.D).c_str(), Text(s.E).c_str(),
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
    if (!fema->compliance)
        std::printf("      acceptance criteria: %s\n",
                    zql::lib::MMSGFunction::GetValue("IDS_RPS_PO_FEMA_Inactive").c_str());
    for (const T_SKEL_AXIAL& axial : fema->curves)
        std::printf("      curve at axial force %s\n", ShortestText(axial.axial).c_str());
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
            std::printf("  %s: %s\n", kComponentNames[c],
                        kSkelNames[static_cast<std::size_t>(component.type)]);
            ForEachPage(component, PrintCurve);
        }
    });
}

EXIT_CODE RunHingeCheck(const T_HINGE_OPTIONS& o)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    const T_HINGE_CONTEXT context = HingeContextOf(doc);
    const CHingeGenerator generator(doc);
    std::size_t findings = 0, types = 0, warnings = 0;
    const EXIT_CODE code = ForEachType(doc, o.type, [&](int key, const T_PHGT_D& type) {
        ++types;
        const auto print = [&](const char* what, const std::vector<T_FINDING>& found) {
            for (const T_FINDING& f : found)
                std::printf("%s: %s%s: %s: %s\n",
                            CPO_HingeTypeListDlg::NameOf(key, type.name).c_str(), what,
                            Where(f).c_str(), f.ruleText.c_str(), f.text.c_str());
            return found.size();
        };
        findings += print("", HingeTypeFindings(type, context));
        findings += print("", generator.ElementFindings(key));
        warnings += print("warning: ", HingeTypeWarnings(type));
    });
    if (code != EXIT_CODE::Done) return code;
    std::printf("%zu hinge types, %zu findings\n", types, findings);
    if (warnings > 0) std::printf("%zu warnings\n", warnings);
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}

EXIT_CODE RunCaseCheck(const std::string& file)
{
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, file); code != EXIT_CODE::Done) return code;
    std::size_t findings = 0;
    for (const auto& entry : doc.Data().Model().pushovers) {
        T_POLC_D polc;
        if (!doc.Attr().GetPolc(entry.first, polc)) continue;
        std::vector<T_FINDING> all = LoadCaseFindings(polc, doc.Data().Model());
        const auto rows = PatternFindings(polc.patterns);
        all.insert(all.end(), rows.begin(), rows.end());
        for (const T_FINDING& f : all)
            std::printf("%s: %s: %s\n", polc.name.c_str(), f.field.c_str(), f.text.c_str());
        findings += all.size();
    }
    std::printf("%zu load cases, %zu findings\n", doc.Data().Model().pushovers.size(), findings);
    return findings == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
