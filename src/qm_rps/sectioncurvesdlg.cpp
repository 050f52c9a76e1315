#include "qm_rps/sectioncurvesdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_rps/desk/tracetable.h"
#include "qm_rps/section/sectionchecktable.h"
#include "qm_rps/section/sectionexport.h"

#include <algorithm>
#include <numbers>
#include <sstream>

CSectionCurvesDlg::CSectionCurvesDlg(CDBDoc& doc)
    : m_doc(doc), m_pairs(SectionPairs(doc.Data().Model()))
{
    if (!m_pairs.empty()) m_pair = 0;
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
    m_way = std::min(m_way, static_cast<int>(std::ssize(CheckedWays())) - 1);
    if (m_way < 0 && !CheckedWays().empty()) m_way = 0;
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

const CSectionCurvesDlg::T_PAGE<T_SECTION_CHECK>& CSectionCurvesDlg::Checked()
{
    if (m_check) return *m_check;
    T_PAGE<T_SECTION_CHECK>& page = m_check.emplace();
    if (m_pair < 0 || m_forces == T_SECTION_FORCES{}) {
        page.reason = Say(m_pair < 0 ? "IDS_QM_SECC_NONE" : "IDS_QM_UI_SECK_NO_FORCES");
        return page;
    }
    T_SECTION_CHECK_REQUEST request;
    request.options = m_options;
    if (m_checkCode > 0) request.codes = {static_cast<SECTION_CHECK_CODE>(m_checkCode - 1)};
    request.cotTheta = m_cotTheta;
    T_SECTION_FORCES& forces = request.forces.emplace_back();
    for (const T_SECTION_FORCE& force : kSectionForces)
        forces.*force.value = ToSi(m_forces.*force.value, Units(), force.dim);
    const T_SECTION_PAIR& pair = m_pairs[static_cast<std::size_t>(m_pair)];
    const T_MODEL& model = m_doc.Data().Model();
    T_SECTION_CHECK check;
    if (CheckSection(model.sections.at(pair.section), model.materials.at(pair.material), request,
                     Units(), check, page.reason))
        page.answer = std::move(check);
    return page;
}

const std::vector<T_SECTION_WAY>& CSectionCurvesDlg::CheckedWays()
{
    static const std::vector<T_SECTION_WAY> kNone;
    const T_PAGE<T_SECTION_CHECK>& page = Checked();
    return page.answer ? page.answer->sets.front().ways : kNone;
}

T_TEXT_TABLE CSectionCurvesDlg::Ways()
{
    return SectionWaysTable(CheckedWays());
}

const T_SECTION_WAY* CSectionCurvesDlg::WayAt(std::size_t row)
{
    return row < CheckedWays().size() ? &CheckedWays()[row] : nullptr;
}

void CSectionCurvesDlg::OnWay(int row)
{
    if (row >= 0 && row < std::ssize(CheckedWays())) m_way = row;
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
