#include "qm_rps/pushoverjudgementdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_rps/judge/judgementsheet.h"
#include "qm_rps/judge/judgementtext.h"
#include "qm_rps/push/pushatpointtext.h"

#include <algorithm>

int CPushOverJudgementDlg::OnJudge(const T_PUSH_EVALUATION& result,
                                   const PUSH_PROGRESS_FN& progress, std::string& error)
{
    T_JUDGEMENT judged = JudgeEvaluation(m_doc, result, m_options, progress);
    error = judged.note;
    if (error.empty() && judged.states.empty()) error = Say("IDS_QM_JUDGE_NO_POINT");
    if (!error.empty()) return 0;
    m_result = result;
    m_judgement = std::move(judged);
    const T_JUDGED_STATE* const worst = WorstState(m_judgement);
    OnSelChangeState(worst ? static_cast<int>(worst - m_judgement.states.data()) : 0);
    return 1;
}

std::vector<std::string> CPushOverJudgementDlg::CodeTexts() const
{
    std::vector<std::string> texts{Say("IDS_QM_UI_JUDGE_OF_HINGES")};
    const std::vector<std::string> codes = JudgedCodeNames();
    texts.insert(texts.end(), codes.begin(), codes.end());
    return texts;
}

int CPushOverJudgementDlg::CodeIndex() const
{
    if (!m_options.code) return 0;
    const std::vector<std::string> texts = CodeTexts();
    const char* const name = kHingeCodeNames[static_cast<std::size_t>(*m_options.code)];
    return static_cast<int>(std::ranges::find(texts, name) - texts.begin());
}

void CPushOverJudgementDlg::OnSelChangeCode(int index)
{
    const T_JUDGE_OPTIONS before = m_options;
    m_options.code.reset();
    const std::vector<std::string> texts = CodeTexts();
    if (index > 0 && index < std::ssize(texts))
        m_options.code = HingeCodeNamed(texts[static_cast<std::size_t>(index)]);
    std::string error;
    if (m_options == before || OnJudge(T_PUSH_EVALUATION(m_result), {}, error)) return;
    m_options = before;
    ShowMessage("IDS_QM_JUDGE_NO_POINT", error);
}

std::vector<std::string> CPushOverJudgementDlg::StateTexts() const
{
    std::vector<std::string> texts;
    for (const T_JUDGED_STATE& state : m_judgement.states)
        texts.push_back(StateAtText(m_judgement, state));
    return texts;
}

void CPushOverJudgementDlg::OnSelChangeState(int index)
{
    if (index < 0 || index >= std::ssize(m_judgement.states)) return;
    m_state = index;
    m_bands = RatioBands(m_judgement, *State(), Scene());
}

const T_JUDGED_STATE* CPushOverJudgementDlg::State() const
{
    return m_state < 0 ? nullptr : &m_judgement.states[static_cast<std::size_t>(m_state)];
}

std::string CPushOverJudgementDlg::CountText() const
{
    const T_JUDGED_STATE* const state = State();
    if (!state) return {};
    if (state->found != AT_POINT::Reached) return WhyNot(state->found);
    const std::string text = VerdictCountText(state->all);
    return state->shearAt.empty() ? text : text + "\n" + state->shearAt;
}

T_TEXT_TABLE CPushOverJudgementDlg::Table() const
{
    T_TEXT_TABLE table;
    for (const std::string& head : JudgedHeads(m_judgement.units))
        table.columns.push_back({head, false});
    for (const JUDGED_COLUMN number :
         {JUDGED_COLUMN::Element, JUDGED_COLUMN::N, JUDGED_COLUMN::M, JUDGED_COLUMN::V,
          JUDGED_COLUMN::Span, JUDGED_COLUMN::ThetaY, JUDGED_COLUMN::Theta,
          JUDGED_COLUMN::ThetaCapacity, JUDGED_COLUMN::ThetaRatio, JUDGED_COLUMN::Shear,
          JUDGED_COLUMN::ShearCapacity, JUDGED_COLUMN::ShearRatio, JUDGED_COLUMN::Other,
          JUDGED_COLUMN::OtherCapacity, JUDGED_COLUMN::OtherRatio})
        table.columns[static_cast<std::size_t>(number)].number = true;
    const T_JUDGED_STATE* const state = State();
    for (std::size_t i = 0; state && i < state->rows.size(); ++i) {
        std::vector<std::string>& cells = table.rows.emplace_back();
        for (const T_JUDGED_CELL& cell : CellsOf(m_judgement, *state, state->rows[i]))
            cells.push_back(cell.number ? FormatText("%.4g", *cell.number) : cell.text);
    }
    return table;
}

VERDICT CPushOverJudgementDlg::VerdictAt(std::size_t row) const
{
    return State()->rows.at(row).verdict;
}

std::string CPushOverJudgementDlg::LimitsText() const
{
    return JudgedLimitsText(m_judgement);
}

std::string CPushOverJudgementDlg::NotesText() const
{
    std::string text;
    for (const std::string& note : JudgementNotes(m_judgement))
        text += (text.empty() ? "" : "\n") + note;
    return text;
}

std::string CPushOverJudgementDlg::TitleText() const
{
    return Say("IDS_QM_JUDGE_TITLE", m_judgement.evaluation, m_judgement.push,
               std::string(NameOf(m_judgement.units.force)),
               std::string(NameOf(m_judgement.units.length)));
}

std::string CPushOverJudgementDlg::VerdictText() const
{
    return WholeVerdictText(m_judgement);
}

int CPushOverJudgementDlg::OnExport()
{
    const std::string path = m_askFile ? m_askFile() : std::string();
    if (path.empty()) return 1;
    const std::span<const T_JUDGEMENT> judged(&m_judgement, 1);
    T_FILE_ERROR error;
    if (path.ends_with(".xlsx") ? WriteSheet(path, JudgementSheet(judged), error)
                                : CFileCtrl::WriteWholeFile(path, JudgementCsv(judged), error))
        return 1;
    ShowMessage("IDS_QM_UI_JUDGE_NO_EXPORT", error.text);
    return 0;
}
