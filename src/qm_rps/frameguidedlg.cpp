#include "qm_rps/frameguidedlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_rps/create/buildingparts.h"
#include "qm_rps/create/createfault.h"
#include "qm_rps/create/numberlist.h"
#include "qm_rps/push/casegenerator.h"

namespace {

/// A document beside the one that is open.
std::unique_ptr<CDBDoc> MakeAside()
{
    CDBDoc* const open = CDBDoc::GetDocPoint();
    auto aside = std::make_unique<CDBDoc>();
    CDBDoc::SetDocPoint(open);
    return aside;
}

std::string Plain(const std::vector<double>& list)
{
    std::string text = NumberListText(list);
    std::erase(text, ' ');
    return text;
}

std::vector<std::string> WordsOf(const std::string& text)
{
    std::vector<std::string> words(1);
    for (const char c : text)
        if (c != ' ' && c != ',' && c != ';')
            words.back() += c;
        else if (!words.back().empty())
            words.emplace_back();
    if (words.back().empty()) words.pop_back();
    return words;
}

} // namespace

CFrameGuideDlg::CFrameGuideDlg(CDBDoc& doc)
    : m_doc(doc), m_preview(MakeAside()), m_scene(*m_preview)
{
    T_BUILDING& b = m_building;
    b.columns = "0.4x0.4";
    b.beams = "0.3x0.5";
    b.columnGrade = b.beamGrade = "C25/30";
    b.braceSection = "CHS 139.7x6.3";
    b.braceGrade = "S355";
    b.dead = b.deadRoof = 20.0;
    b.live = 8.0;
    b.liveRoof = 4.0;
}

std::string CFrameGuideDlg::LineUnit() const
{
    return std::string(NameOf(Units().force)) + "/" + std::string(NameOf(Units().length));
}

int CFrameGuideDlg::ReadLists(T_BUILDING& out, T_FINDING& fault) const
{
    T_BUILDING in = m_building;
    const std::tuple<const char*, const std::string&, std::vector<double>&> lists[] = {
        {"baysX", m_baysX, in.baysX},
        {"baysY", m_baysY, in.baysY},
        {"storeys", m_storeys, in.storeys}};
    for (const auto& [field, text, list] : lists) {
        std::string why;
        const auto read = ParseNumberList(text, why);
        if (!read) return CreateFault(fault, field, "IDS_QM_NEW_TEXT", why);
        list = *read;
    }
    in.braceBays = WordsOf(m_braceBays);
    out = std::move(in);
    return 1;
}

void CFrameGuideDlg::Update() const
{
    if (m_isTried) return;
    m_isTried = true;
    m_isMade = ReadLists(m_asked, m_fault) && MakeBuilding(m_asked, m_content, m_facts, m_fault);
    m_preview->Data().Assign(m_isMade ? m_content : T_MODEL_CONTENT{});
}

const T_FRAME_SCENE& CFrameGuideDlg::Scene()
{
    Update();
    return m_scene.Scene();
}

T_TEXT_TABLE CFrameGuideDlg::Levels()
{
    Update();
    T_TEXT_TABLE table;
    for (const std::string& head : BuildingHeads(m_building.units))
        table.columns.push_back({head, !table.columns.empty()});
    if (m_isMade) table.rows = BuildingRows(m_facts);
    return table;
}

std::string CFrameGuideDlg::NotesText()
{
    Update();
    if (!m_isMade) return m_fault.text;
    std::string text =
        Say("IDS_QM_NEW_FRAME_IS", m_facts.plan, std::to_string(m_asked.storeys.size()),
            std::to_string(m_facts.nodes), std::to_string(m_facts.elements));
    text += "\n" + Say("IDS_QM_NEW_FRAME_MASS", ShortestText(m_asked.liveInMass));
    if (const std::string doubt = BuildingDoubt(m_asked); !doubt.empty()) text += "\n" + doubt;
    return text;
}

std::string CFrameGuideDlg::CommandText()
{
    Update();
    if (!m_isMade) return {};
    const T_BUILDING& b = m_asked;
    std::string text = "qm-rps new frame --units " + std::string(NameOf(b.units.force)) + "," +
                       std::string(NameOf(b.units.length));
    const auto add = [&text](const char* option, const std::string& value) {
        const bool isPlain = value.find_first_of(" '\"*;()") == value.npos;
        if (!value.empty())
            text += std::string(" ") + option + (isPlain ? " " + value : " '" + value + "'");
    };
    const auto number = [&add](const char* option, double value) {
        if (value != 0.0) add(option, ShortestText(value));
    };
    add("--title", b.title);
    add("--bays-x", Plain(b.baysX));
    add("--bays-y", Plain(b.baysY));
    add("--storeys", Plain(b.storeys));
    add("--columns", b.columns);
    add("--column-grade", b.columnGrade);
    add("--beams", b.beams);
    add("--beam-grade", b.beamGrade);
    if (b.isPinned) text += " --pinned";
    if (b.braces != BUILDING_BRACES::None) {
        add("--braces", b.braces == BUILDING_BRACES::Cross ? "X" : "diagonal");
        add("--brace-bays", m_braceBays);
        add("--brace-section", b.braceSection);
        add("--brace-grade", b.braceGrade);
    }
    number("--dead", b.dead);
    number("--live", b.live);
    add("--dead-roof", ShortestText(b.deadRoof));
    add("--live-roof", ShortestText(b.liveRoof));
    if (b.loaded != LOADED_BEAMS::All)
        add("--load-beams", b.loaded == LOADED_BEAMS::AlongX ? "x" : "y");
    add("--live-in-mass", ShortestText(b.liveInMass));
    if (!b.hasDiaphragms) text += " --no-diaphragms";
    add("--modes", std::to_string(m_modes));
    if (m_push) text += " --push";
    return text + " -o case.json";
}

std::vector<T_FINDING> CFrameGuideDlg::Findings() const
{
    Update();
    if (!m_isMade) return {m_fault};
    constexpr int kMostModes = 1000;
    if (m_modes >= 0 && m_modes <= kMostModes) return {};
    T_FINDING fault;
    (void)CreateFault(fault, "modes", "IDS_QM_NEW_MODES");
    return {fault};
}

int CFrameGuideDlg::FindModes()
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    options.modes = m_modes;
    T_ANALYSIS_ERROR error;
    const auto work = [&](TELL_FN tell) {
        options.progress = std::move(tell);
        return m_doc.RunAnalysis(options, error);
    };
    if (m_withProgress ? m_withProgress(work) : work({})) return 1;
    ShowMessage("IDS_QM_NEW_NO_MODES", Say("IDS_QM_NEW_NO_MODES", error.text));
    return 0;
}

int CFrameGuideDlg::MakePushCases()
{
    T_CASE_CHOICE choice;
    choice.directions = {true, !IsPlane()};
    std::vector<T_POLC_D> cases;
    T_CASE_BASIS basis;
    std::string error;
    CEditScope edit(m_doc, Say("IDS_QM_NEW_FRAME_TITLE"));
    bool done = GenerateCases(m_doc, choice, cases, basis, error) != 0;
    m_pushText = done ? ModeBasisText(basis) : "";
    m_hasLowMass = done && HasLowMass(basis);
    for (const T_POLC_D& record : cases)
        done = done && edit.Put(NextKey(m_doc.Data().Model().pushovers), record);
    if (done && edit.Commit()) return 1;
    ShowMessage("IDS_QM_NEW_NO_PUSH", Say("IDS_QM_NEW_NO_PUSH", error));
    return 0;
}

int CFrameGuideDlg::OnOK()
{
    if (!CheckData() || (m_mayReplace && !m_mayReplace())) return 0;
    m_doc.NewModel();
    m_doc.Data().Assign(m_content);
    m_pushText.clear();
    m_hasLowMass = false;
    m_isWhole = m_modes == 0 || FindModes();
    m_isWhole = (!m_push || MakePushCases()) && m_isWhole;
    const T_TABLE<T_EIGV_D>& modes = m_doc.Data().Model().modes;
    const bool isOdd = !modes.empty() && !IsUsualPeriod(modes.begin()->second.period);
    if (isOdd)
        ShowMessage("IDS_QM_NEW_ODD_PERIOD",
                    Say("IDS_QM_NEW_ODD_PERIOD", FormatText("%.4g", modes.begin()->second.period)));
    if (m_hasLowMass) ShowMessage("IDS_QM_PUSH_GEN_LOW_MASS", m_pushText);
    m_doc.Data().SetModified(true);
    return 1;
}
