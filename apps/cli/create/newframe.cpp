#include "create/newcommands.h"

#include "console/tabletext.h"
#include "create/unitwords.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/frameguidedlg.h"

#include <cstdio>

namespace {

EXIT_CODE Refuse(const std::string& why)
{
    return Complain(EXIT_CODE::Usage, "new frame: " + why);
}

/// The option that a field of the model stands for.
std::string OptionOf(const std::string& field)
{
    constexpr std::pair<const char*, const char*> kOptions[] = {
        {"baysX", "--bays-x"},
        {"baysY", "--bays-y"},
        {"storeys", "--storeys"},
        {"columns", "--columns"},
        {"beams", "--beams"},
        {"braceSection", "--brace-section"},
        {"grade.columns", "--column-grade"},
        {"grade.beams", "--beam-grade"},
        {"grade.braceSection", "--brace-grade"},
        {"braceBays", "--brace-bays"},
        {"dead", "--dead"},
        {"live", "--live"},
        {"roofDead", "--dead-roof"},
        {"roofLive", "--live-roof"},
        {"massLive", "--live-in-mass"},
        {"loaded", "--load-beams"},
        {"modes", "--modes"}};
    for (const auto& [name, option] : kOptions)
        if (field == name) return std::string(option) + ": ";
    return {};
}

/// Words and lists of the options.
EXIT_CODE Take(const T_NEW_FRAME_OPTIONS& o, CFrameGuideDlg& dialog)
{
    T_BUILDING& b = dialog.m_building;
    const T_BUILDING preset = b;
    b = o.building;
    if (!ParseUnits(o.units, b.units))
        return Refuse(Say("IDS_QM_CLI_NEW_UNITS", o.units, UnitWords()));
    for (std::string* const grade : {&b.columnGrade, &b.beamGrade})
        if (grade->empty()) *grade = o.grade;
    b.deadRoof = o.deadRoof.value_or(b.dead);
    b.liveRoof = o.liveRoof.value_or(b.live);
    b.hasDiaphragms = !o.noDiaphragms;
    b.braces = o.braces == "X"          ? BUILDING_BRACES::Cross
               : o.braces == "diagonal" ? BUILDING_BRACES::Diagonal
                                        : BUILDING_BRACES::None;
    if (!o.braces.empty() && b.braces == BUILDING_BRACES::None)
        return Refuse(Say("IDS_QM_CLI_NEW_WORD", "--braces", o.braces));
    if (o.braces.empty() && !(o.braceBays + b.braceSection + b.braceGrade).empty())
        return Refuse(Say("IDS_QM_CLI_NEW_NO_BRACES"));
    if (b.braceGrade.empty()) b.braceGrade = preset.braceGrade;
    b.loaded = o.loaded == "x"   ? LOADED_BEAMS::AlongX
               : o.loaded == "y" ? LOADED_BEAMS::AlongY
                                 : LOADED_BEAMS::All;
    if (!o.loaded.empty() && o.loaded != "all" && b.loaded == LOADED_BEAMS::All)
        return Refuse(Say("IDS_QM_CLI_NEW_WORD", "--load-beams", o.loaded));
    dialog.m_baysX = o.baysX;
    dialog.m_baysY = o.baysY;
    dialog.m_storeys = o.storeys;
    dialog.m_braceBays = o.braceBays;
    dialog.m_modes = o.modes;
    dialog.m_push = o.push;
    dialog.OnChange();
    return EXIT_CODE::Done;
}

void Print(CFrameGuideDlg& dialog, CDBDoc& doc)
{
    const T_TEXT_TABLE levels = dialog.Levels();
    T_TABLE_ROWS rows(1);
    for (const T_TEXT_COLUMN& column : levels.columns)
        rows.front().push_back(column.head);
    rows.insert(rows.end(), levels.rows.begin(), levels.rows.end());
    std::printf("%s\n%s", dialog.NotesText().c_str(), TableText(rows).c_str());
    for (const auto& [mode, record] : doc.Data().Model().modes)
        std::printf("%s\n", Say("IDS_QM_CLI_NEW_MODE", std::to_string(mode),
                                FormatText("%.4g", record.period))
                                .c_str());
    for (const auto& [key, record] : doc.Data().Model().pushovers)
        std::printf("%s\n", Say("IDS_QM_CLI_NEW_PUSH", record.name).c_str());
    if (!dialog.PushText().empty()) std::printf("%s\n", dialog.PushText().c_str());
}

} // namespace

EXIT_CODE RunNewFrame(const T_NEW_FRAME_OPTIONS& o)
{
    if (o.out.empty()) return Refuse(Say("IDS_QM_CLI_NEW_MISSING", "-o"));
    if (const EXIT_CODE code = CheckOutputs("", {{o.out, OUTPUT_KIND::Document}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    CFrameGuideDlg dialog(doc);
    if (const EXIT_CODE code = Take(o, dialog); code != EXIT_CODE::Done) return code;
    if (const auto findings = dialog.Findings(); !findings.empty())
        return Refuse(OptionOf(findings.front().field) + findings.front().text);
    // Modes or load cases that can't be had are no frame that was asked for: nothing is written.
    if (!dialog.OnOK() || !dialog.IsWhole()) return Refuse(dialog.Messages().back().text);
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    Print(dialog, doc);
    for (const auto& message : dialog.Messages())
        std::fprintf(stderr, "%s\n", message.text.c_str());
    std::printf("%s\n", Say("IDS_QM_CLI_NEW_NEXT", "analyse " + o.out).c_str());
    return EXIT_CODE::Done;
}
