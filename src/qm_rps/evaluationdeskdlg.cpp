#include "qm_rps/evaluationdeskdlg.h"

#include "qm_base/say.h"
#include "qm_db/editscope.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/pushover/overview/evaluationunits.h"
#include "qm_rps/pushover/report/pushovercells.h"
#include "qm_rps/pushovercalculators.h"
#include "qm_rps/spectrumdlg.h"

// ---- the list -----------------------------------------------------------------------------------

CEvaluationDeskDlg::T_MADE CEvaluationDeskDlg::Now() const
{
    return {m_doc.Data().Revision(), Shown().Turn(), ShownUnits(), Opened()};
}

/// What was evaluated before stands as long as the document does.
T_EVALUATION_ENTRY CEvaluationDeskDlg::EntryFor(const T_EVAL_D& eval)
{
    const auto it = std::ranges::find(m_entries, eval, &T_EVALUATION_ENTRY::eval);
    if (it != m_entries.end() && m_made.revision == m_doc.Data().Revision()) return *it;
    CPushEvaluator evaluator(m_doc, RunPerfPtProcedure);
    return EvaluateEntry(m_doc, evaluator, eval);
}

void CEvaluationDeskDlg::Make()
{
    const T_MADE now = Now();
    if (now == m_made) return;
    const auto live = [this] {
        return EntryOf(m_doc, m_settings, Shown().Result(), Shown().Refused());
    };
    std::vector<T_EVALUATION_ENTRY> entries;
    m_chosen = -1;
    for (const T_EVAL_D& eval : EvaluationsOf(m_doc)) {
        if (eval.name == Opened()) m_chosen = static_cast<int>(entries.size());
        entries.push_back(eval.name == Opened() ? live() : EntryFor(eval));
    }
    if (m_chosen < 0) {
        m_chosen = static_cast<int>(entries.size());
        entries.push_back(live());
    }
    m_entries = std::move(entries);
    m_shown = m_entries;
    for (T_EVALUATION_ENTRY& entry : m_shown)
        if (entry.refused.empty()) entry.result = InUnits(std::move(entry.result), now.units);
    m_result = InUnits(Shown().Result(), now.units);
    m_pictured = InUnits(Shown().Pictured(), now.units);
    m_made = now;
}

const std::vector<T_EVALUATION_ENTRY>& CEvaluationDeskDlg::List()
{
    Make();
    return m_shown;
}

int CEvaluationDeskDlg::Chosen()
{
    Make();
    return m_chosen;
}

/// Nothing is lost, or the person has decided about it.
bool CEvaluationDeskDlg::MayLeave()
{
    if (!HasUnsaved()) return true;
    constexpr const char* kKey = "IDS_QM_EVAL_STORE_FIRST";
    switch (AskYesNoCancel(kKey, ::Say(kKey, m_settings.name))) {
    case zql::frx::ANSWER::Yes:
        return OnStore() != 0;
    case zql::frx::ANSWER::No:
        return true;
    default:
        return false;
    }
}

void CEvaluationDeskDlg::OnChoose(int row)
{
    if (row < 0 || row >= std::ssize(List()) || row == Chosen()) return;
    const T_EVAL_D wanted = m_entries[static_cast<std::size_t>(row)].eval;
    if (!MayLeave()) return;
    if (!OnOpen(wanted.name)) OnOpenTurned(wanted);
    UpdateFrame();
}

bool CEvaluationDeskDlg::IsTicked(int row)
{
    return row >= 0 && row < std::ssize(List()) &&
           m_ticked.contains(m_shown[static_cast<std::size_t>(row)].eval.name);
}

void CEvaluationDeskDlg::OnTick(int row, bool on)
{
    if (row < 0 || row >= std::ssize(List())) return;
    const std::string& name = m_shown[static_cast<std::size_t>(row)].eval.name;
    if (on)
        m_ticked.insert(name);
    else
        m_ticked.erase(name);
}

void CEvaluationDeskDlg::OnFresh()
{
    if (!MayLeave()) return;
    OnNew();
    UpdateFrame();
}

int CEvaluationDeskDlg::OnDelete()
{
    const int key = KeyOf(Opened());
    if (key == 0) return 0;
    CEditScope edit(m_doc, ::Say("IDS_QM_EVAL_DELETED", Opened()));
    if (!edit.Erase<T_EVAL_D>(key) || !edit.Commit()) {
        ShowMessage("IDS_QM_UI_EDIT_BUSY");
        return 0;
    }
    m_ticked.erase(Opened());
    Start();
    UpdateFrame();
    if (m_changed) m_changed();
    return 1;
}

int CEvaluationDeskDlg::OnClose()
{
    return MayLeave() ? 1 : 0;
}

// ---- what the person has changed ----------------------------------------------------------------

void CEvaluationDeskDlg::OnTaken()
{
    OnEdited();
    Make();
    if (OnKeep()) m_made.revision = m_doc.Data().Revision(); // the others stand
    UpdateFrame();
}

int CEvaluationDeskDlg::Follow()
{
    if (!OnDocumentChanged()) return 0;
    UpdateFrame();
    return 1;
}

int CEvaluationDeskDlg::OnSpectrum()
{
    const auto& spectra = m_doc.Data().Model().spectra;
    const auto named = std::ranges::find_if(
        spectra, [this](const auto& entry) { return entry.second.name == m_settings.spectrum; });
    CSpectrumDlg dialog(m_doc, named == spectra.end() ? 0 : named->first);
    dialog.SetView(View());
    const int done = dialog.DoModal();
    (void)Follow(); // another spectrum may have been stored on the way, too
    return done;
}

// ---- what is on show ----------------------------------------------------------------------------

T_UNITS CEvaluationDeskDlg::ShownUnits() const
{
    const T_UNITS units = m_doc.Unit().Units();
    return {m_axes.force.value_or(units.force), m_axes.length.value_or(units.length)};
}

const T_PUSH_EVALUATION& CEvaluationDeskDlg::Result()
{
    Make();
    return m_result;
}

const T_PUSH_EVALUATION& CEvaluationDeskDlg::Pictured()
{
    Make();
    return m_pictured;
}

const T_EVALUATION_ENTRY& CEvaluationDeskDlg::Entry()
{
    return List()[static_cast<std::size_t>(Chosen())];
}

const T_SPFC_D* CEvaluationDeskDlg::Spectrum() const
{
    for (const auto& [key, record] : m_doc.Data().Model().spectra)
        if (record.name == m_settings.spectrum) return &record;
    return nullptr;
}

std::vector<const T_PUSH_EVALUATION*> CEvaluationDeskDlg::Overlaid()
{
    std::vector<const T_PUSH_EVALUATION*> shown;
    for (const T_EVALUATION_ENTRY& entry : List())
        if (m_ticked.contains(entry.eval.name) && entry.result.capacity.Sd.size() > 1)
            shown.push_back(&entry.result);
    if (shown.size() < 2) shown.clear();
    return shown;
}

std::vector<T_EVALUATION_ENTRY> CEvaluationDeskDlg::Compared()
{
    std::vector<T_EVALUATION_ENTRY> compared;
    for (const T_EVALUATION_ENTRY& entry : List())
        if (m_ticked.contains(entry.eval.name)) compared.push_back(entry);
    return compared.empty() ? List() : compared;
}

// ---- axes ---------------------------------------------------------------------------------------

std::vector<T_FINDING> CEvaluationDeskDlg::AllFindings() const
{
    std::vector<T_FINDING> all = Findings();
    const auto check = [&all](const char* field, std::optional<double> from,
                              std::optional<double> to) {
        if (!from || !to || *from < *to) return;
        T_FINDING finding;
        finding.field = field;
        finding.messageKey = "IDS_QM_EVAL_BAD_AXIS";
        finding.text = ::Say(finding.messageKey);
        all.push_back(std::move(finding));
    };
    check("axes.x", m_axes.xFrom, m_axes.xTo);
    check("axes.y", m_axes.yFrom, m_axes.yTo);
    return all;
}

std::optional<T_PLOT_REGION> CEvaluationDeskDlg::Region()
{
    if (m_axes.whole) return std::nullopt;
    std::vector<const T_PUSH_EVALUATION*> shown = Overlaid();
    if (shown.empty()) {
        if (IsOtherPlot(Pictured())) return std::nullopt; // on axes of its own
        shown.push_back(&Pictured());
    }
    return RegionOf(shown);
}

T_AXIS_SPAN CEvaluationDeskDlg::XSpan()
{
    const std::optional<T_PLOT_REGION> region = Region();
    T_AXIS_SPAN span{m_axes.xFrom, m_axes.xTo};
    if (!span.hi && region) span.hi = region->Sd;
    return span;
}

T_AXIS_SPAN CEvaluationDeskDlg::YSpan()
{
    const std::optional<T_PLOT_REGION> region = Region();
    T_AXIS_SPAN span{m_axes.yFrom, m_axes.yTo};
    if (!span.hi && region) span.hi = region->Sa;
    return span;
}

// ---- the frame at the point ---------------------------------------------------------------------

void CEvaluationDeskDlg::OnShowFrame(bool on)
{
    m_isFrameShown = on;
    UpdateFrame();
}

/// Pushes again to the points of the result, so that nothing is interpolated. The picture of the
/// push before stays until then.
void CEvaluationDeskDlg::UpdateFrame()
{
    const long turn = Shown().Turn(), revision = m_doc.Data().Revision();
    if (!m_isFrameShown || (m_frameTurn == turn && m_frameRevision == revision)) return;
    m_frameTurn = turn;
    m_frameRevision = revision;
    auto next = std::make_unique<CPushOverHingeStateDlg>(m_doc);
    std::string why = Shown().Refused();
    int done = 0;
    if (why.empty())
        Pushing([&](const PUSH_PROGRESS_FN& progress) {
            done = next->OnShowPoints(Shown().Result(), progress, why);
        });
    // The frame stands where the cards do; a demand that the push has not reached is not shown.
    const std::optional<T_EVALUATION_ANSWER> answer = AnswerOf(Shown().Result());
    if (done && answer && !answer->state.empty()) (void)next->OnShowState(answer->state);
    m_frameBefore = std::move(m_frame);
    if (done) m_frame = std::move(next);
    m_frameNote = done ? m_frame->StepText() : why;
}
