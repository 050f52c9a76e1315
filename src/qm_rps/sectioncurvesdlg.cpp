#include "qm_rps/sectioncurvesdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/desk/tracetable.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/section/forcesets.h"
#include "qm_rps/section/sectionchecktable.h"
#include "qm_rps/section/sectionexport.h"

#include <algorithm>
#include <numbers>
#include <sstream>

CSectionCurvesDlg::CSectionCurvesDlg(CDBDoc& doc)
    : m_doc(doc), m_pairs(SectionPairs(doc.Data().Model()))
{
    if (!m_pairs.empty()) m_pair = 0;
    OnNewSet();
}

std::vector<std::string> CSectionCurvesDlg::PairTexts() const
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<std::string> texts;
    for (const T_SECTION_PAIR& pair : m_pairs)
        texts.push_back(model.sections.at(pair.section).name + ", " +
                        model.materials.at(pair.material).name);
    return texts;
}

void CSectionCurvesDlg::OnSelChangePair(int index)
{
    if (index < 0 || index >= std::ssize(m_pairs)) return;
    m_pair = index;
    OnChanged();
}

void CSectionCurvesDlg::OnOpenSection(int section)
{
    for (std::size_t i = 0; i < m_pairs.size(); ++i)
        if (m_pairs[i].section == section) return OnSelChangePair(static_cast<int>(i));
}

bool CSectionCurvesDlg::ReadAxial(std::vector<double>& out) const
{
    std::istringstream words(m_axial);
    for (std::string word; words >> word;) {
        const std::optional<double> value = ParseFinite(word);
        if (!value) return false;
        out.push_back(ToSi(*value, Units(), kDimForce));
    }
    return true;
}

void CSectionCurvesDlg::OnChanged()
{
    m_answers.clear();
    m_check.reset();
    const int count = static_cast<int>(WayCount());
    m_way = std::min(m_way, count - 1);
    if (m_way < 0 && count > 0) m_way = 0;
}

// ---- curves -------------------------------------------------------------------------------------

const CSectionCurvesDlg::T_PAGE<T_SECTION_ANSWER>& CSectionCurvesDlg::Page(SECTION_TASK task)
{
    const auto [at, fresh] = m_answers.try_emplace(task);
    T_PAGE<T_SECTION_ANSWER>& page = at->second;
    if (!fresh) return page;
    T_SECTION_REQUEST request;
    request.task = task;
    request.options = m_options;
    request.directions = {m_directionDeg * std::numbers::pi / 180.0};
    if (task == SECTION_TASK::Curvature) request.points = kCurvaturePoints;
    // A surface of one axial force is not worth a page: then it has even ones.
    const bool readable = ReadAxial(request.axial);
    if (task == SECTION_TASK::Surface && request.axial.size() < 2) request.axial.clear();
    if (m_pair < 0) {
        page.reason = Say("IDS_QM_SECC_NONE");
    } else if (!readable && task != SECTION_TASK::Interaction) { // which asks for none
        page.reason = Say("IDS_QM_SECC_LIST_NUMBER", m_axial);
    } else {
        const T_SECTION_PAIR& pair = m_pairs[static_cast<std::size_t>(m_pair)];
        const T_MODEL& model = m_doc.Data().Model();
        T_SECTION_ANSWER answer;
        if (CalcSection(model.sections.at(pair.section), model.materials.at(pair.material), request,
                        Units(), answer, page.reason))
            page.answer = std::move(answer);
    }
    return page;
}

const T_SECTION_ANSWER* CSectionCurvesDlg::Answer(SECTION_TASK task)
{
    const T_PAGE<T_SECTION_ANSWER>& page = Page(task);
    return page.answer ? &*page.answer : nullptr;
}

std::string CSectionCurvesDlg::ReasonOf(SECTION_TASK task)
{
    const T_PAGE<T_SECTION_ANSWER>& page = Page(task);
    if (!page.answer) return page.reason;
    std::string text;
    for (const T_CODE_WARNING& warning : page.answer->warnings)
        text += (text.empty() ? "" : "; ") + WarningText(warning);
    return text;
}

T_TEXT_TABLE CSectionCurvesDlg::Table(SECTION_TASK task)
{
    T_SECTION_ANSWER heads; // a page without a result has its columns all the same
    heads.task = task;
    const T_SECTION_ANSWER* const answer = Answer(task);
    const T_SECTION_ANSWER& shown = answer ? *answer : heads;
    const T_TEXT_TABLE states = SectionStates(shown, Units());
    return states.columns.empty() ? SectionPoints(shown, Units()) : states;
}

int CSectionCurvesDlg::OnExport(SECTION_TASK task)
{
    const T_SECTION_ANSWER* const answer = Answer(task);
    if (!answer) {
        ShowMessage("IDS_QM_UI_SECC_NO_EXPORT", ReasonOf(task));
        return 0;
    }
    return Export([&] { return SectionExport({*answer}, Units()); });
}

int CSectionCurvesDlg::Export(const std::function<T_TEXT_TABLE()>& make)
{
    const std::string path = m_askFile ? m_askFile() : std::string();
    if (path.empty()) return 1;
    const T_TEXT_TABLE table = make();
    T_FILE_ERROR error;
    const bool sheet = path.ends_with(".xlsx");
    if (sheet ? WriteSheet(path, TableSheet(table), error)
              : CFileCtrl::WriteWholeFile(path, TableCsv(table), error))
        return 1;
    ShowMessage("IDS_QM_UI_SECC_NO_EXPORT", error.text);
    return 0;
}

// ---- given forces -------------------------------------------------------------------------------

bool CSectionCurvesDlg::IsConcrete() const
{
    if (m_pair < 0) return false;
    const int material = m_pairs[static_cast<std::size_t>(m_pair)].material;
    return m_doc.Data().Model().materials.at(material).type == MATL_CLASS::Concrete;
}

std::string CSectionCurvesDlg::SetHead(std::size_t column) const
{
    if (column == 0) return Say("IDS_QM_SECK_HEAD_SET");
    const T_SECTION_FORCE& force = kSectionForces[column - 1];
    return HeadWithUnit(force.name, force.dim, Units());
}

std::string CSectionCurvesDlg::SetText(std::size_t row, std::size_t column) const
{
    if (row >= m_sets.size() || column >= kSetColumns) return {};
    const T_SECTION_FORCES& set = m_sets[row];
    return column == 0 ? set.name : ShortestText(set.*kSectionForces[column - 1].value);
}

int CSectionCurvesDlg::SetCell(std::size_t row, std::size_t column, const std::string& text)
{
    if (row >= m_sets.size() || column >= kSetColumns) return 0;
    const std::optional<double> number = ParseFinite(text);
    if (column > 0 && !number) return 0;
    if (column == 0)
        m_sets[row].name = text;
    else
        m_sets[row].*kSectionForces[column - 1].value = *number;
    OnChanged();
    return 1;
}

void CSectionCurvesDlg::OnNewSet()
{
    T_SECTION_FORCES& set = m_sets.emplace_back();
    set.name = std::to_string(m_sets.size());
    m_set = static_cast<int>(m_sets.size()) - 1;
    OnChanged();
}

void CSectionCurvesDlg::OnDeleteSet()
{
    if (m_set < 0 || m_set >= std::ssize(m_sets)) return;
    m_sets.erase(m_sets.begin() + m_set);
    m_set = std::min(m_set, static_cast<int>(m_sets.size()) - 1);
    OnChanged();
}

/// Of SI.
int CSectionCurvesDlg::TakeSets(std::vector<T_SECTION_FORCES> sets)
{
    for (T_SECTION_FORCES& set : sets)
        for (const T_SECTION_FORCE& force : kSectionForces)
            set.*force.value = FromSi(set.*force.value, Units(), force.dim) + 0.0;
    m_sets = std::move(sets);
    m_set = m_sets.empty() ? -1 : 0;
    OnChanged();
    return 1;
}

int CSectionCurvesDlg::OnReadSets()
{
    const std::string path = m_askSets ? m_askSets() : std::string();
    if (path.empty()) return 1;
    std::string text, reason;
    T_FILE_ERROR error;
    std::vector<T_SECTION_FORCES> sets;
    if (!CFileCtrl::ReadWholeFile(path, text, error))
        reason = error.text;
    else if (ReadForceSets(text, Units(), sets, reason))
        return TakeSets(std::move(sets));
    ShowMessage("IDS_QM_UI_SECK_NO_SETS", Say("IDS_QM_UI_SECK_NO_SETS", reason));
    return 0;
}

std::vector<std::string> CSectionCurvesDlg::LoadCases() const
{
    std::vector<std::string> names;
    for (const auto& entry : m_doc.Data().Model().loadCases)
        names.push_back(entry.second.name);
    for (const auto& entry : m_doc.Data().Model().combinations)
        names.push_back(entry.second.name);
    return names;
}

int CSectionCurvesDlg::OnTakeResults()
{
    const std::vector<std::string> names = LoadCases();
    const auto elements = ParseElementList(m_elements);
    std::string reason;
    std::vector<T_SECTION_JOB> jobs;
    if (!elements)
        reason = Say("IDS_QM_CLI_HINGE_ELEMENT_LIST", m_elements);
    else if (m_pair < 0 || m_loadCase < 0 || m_loadCase >= std::ssize(names))
        reason = Say(m_pair < 0 ? "IDS_QM_SECC_NONE" : "IDS_QM_CLI_NO_CASES");
    else if (ForcesOfMembers(m_doc, names[static_cast<std::size_t>(m_loadCase)], *elements, jobs,
                             reason)) {
        const T_SECTION_PAIR& pair = m_pairs[static_cast<std::size_t>(m_pair)];
        const auto job = std::ranges::find(jobs, pair, &T_SECTION_JOB::pair);
        if (job != jobs.end()) return TakeSets(std::move(job->forces));
        reason = Say("IDS_QM_SECK_NO_RESULTS", names[static_cast<std::size_t>(m_loadCase)]);
    }
    ShowMessage("IDS_QM_UI_SECK_NO_SETS", Say("IDS_QM_UI_SECK_NO_SETS", reason));
    return 0;
}

const CSectionCurvesDlg::T_PAGE<T_SECTION_CHECK>& CSectionCurvesDlg::Checked()
{
    if (m_check) return *m_check;
    T_PAGE<T_SECTION_CHECK>& page = m_check.emplace();
    T_SECTION_CHECK_REQUEST request;
    request.options = m_options;
    if (m_checkCode > 0) request.codes = {static_cast<SECTION_CHECK_CODE>(m_checkCode - 1)};
    request.cotTheta = m_cotTheta;
    request.forces = m_sets;
    bool any = false;
    for (T_SECTION_FORCES& set : request.forces)
        for (const T_SECTION_FORCE& force : kSectionForces) {
            set.*force.value = ToSi(set.*force.value, Units(), force.dim);
            any = any || set.*force.value != 0.0;
        }
    if (m_pair < 0 || !any) {
        page.reason = Say(m_pair < 0 ? "IDS_QM_SECC_NONE" : "IDS_QM_UI_SECK_NO_FORCES");
        return page;
    }
    const T_SECTION_PAIR& pair = m_pairs[static_cast<std::size_t>(m_pair)];
    const T_MODEL& model = m_doc.Data().Model();
    T_SECTION_CHECK check;
    if (CheckSection(model.sections.at(pair.section), model.materials.at(pair.material), request,
                     Units(), check, page.reason))
        page.answer = std::move(check);
    if (page.answer && m_byRatio) SortByRatio(*page.answer);
    return page;
}

std::size_t CSectionCurvesDlg::WayCount()
{
    const T_PAGE<T_SECTION_CHECK>& page = Checked();
    std::size_t count = 0;
    if (page.answer)
        for (const T_SECTION_CHECKS& set : page.answer->sets)
            count += set.ways.size();
    return count;
}

T_TEXT_TABLE CSectionCurvesDlg::Ways()
{
    const T_PAGE<T_SECTION_CHECK>& page = Checked();
    return SectionSetsTable(page.answer ? *page.answer : T_SECTION_CHECK());
}

const T_SECTION_WAY* CSectionCurvesDlg::WayAt(std::size_t row)
{
    const T_PAGE<T_SECTION_CHECK>& page = Checked();
    if (!page.answer) return nullptr;
    for (const T_SECTION_CHECKS& set : page.answer->sets) {
        if (row < set.ways.size()) return &set.ways[row];
        row -= set.ways.size();
    }
    return nullptr;
}

void CSectionCurvesDlg::OnWay(int row)
{
    if (row >= 0 && static_cast<std::size_t>(row) < WayCount()) m_way = row;
}

T_TEXT_TABLE CSectionCurvesDlg::WayTrace()
{
    const T_SECTION_WAY* const way = m_way < 0 ? nullptr : WayAt(static_cast<std::size_t>(m_way));
    return TraceTable(way ? way->trace : std::vector<T_CODE_TRACE>(), Units());
}

std::string CSectionCurvesDlg::CheckText()
{
    const T_PAGE<T_SECTION_CHECK>& page = Checked();
    if (!page.answer) return page.reason;
    std::string text;
    for (const std::string& line : SectionCheckHead(*page.answer, Units()))
        text += (text.empty() ? "" : "\n") + line;
    return text;
}

int CSectionCurvesDlg::OnExportCheck()
{
    const T_PAGE<T_SECTION_CHECK>& page = Checked();
    if (page.answer) return Export([&] { return SectionCheckExport({*page.answer}, Units()); });
    ShowMessage("IDS_QM_UI_SECC_NO_EXPORT", page.reason);
    return 0;
}
