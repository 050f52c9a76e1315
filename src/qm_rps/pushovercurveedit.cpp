#include "qm_rps/pushovercurveedit.h"

#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/pushover/report/pushoverintro.h"
#include "qm_rps/pushover/report/pushoverreport.h"
#include "qm_rps/pushovercomparisondlg.h"
#include "qm_rps/pushovercontroldlg.h"
#include "qm_rps/pushoverhingestatedlg.h"
#include "qm_rps/pushoverjudgementdlg.h"
#include "qm_rps/pushovertextdlg.h"

using zql::lib::MMSGFunction;

CPushOverCurveEdit::CPushOverCurveEdit(CDBDoc& doc)
    : m_methodPage(doc, m_settings), m_demandPage(doc, m_settings), m_bilinearPage(m_settings),
      m_doc(doc), m_driver(doc)
{
    Start();
}

void CPushOverCurveEdit::Start()
{
    m_shown.Clear();
    m_steps.clear();
    m_points.clear();
    const std::vector<std::string> stored = Evaluations();
    if (stored.empty() || !OnOpen(stored.front())) OnNew();
}

std::vector<std::string> CPushOverCurveEdit::Evaluations() const
{
    return NamesOf(m_doc.Data().Model().evaluations);
}

int CPushOverCurveEdit::OnOpen(const std::string& evaluation)
{
    if (!m_doc.Attr().GetEval(KeyOf(evaluation), m_settings)) return 0;
    m_opened = evaluation;
    m_stored = m_settings;
    Update();
    return 1;
}

void CPushOverCurveEdit::OnOpenTurned(const T_EVAL_D& evaluation)
{
    m_settings = m_stored = evaluation;
    m_opened = evaluation.name;
    Update();
}

void CPushOverCurveEdit::OnNew()
{
    T_EVAL_D fresh;
    fresh.push = m_settings.push;
    fresh.spectrum = m_settings.spectrum;
    TakeOneOf(m_methodPage.LoadCases(), fresh.push);
    TakeOneOf(m_demandPage.Spectra(), fresh.spectrum);
    const std::vector<std::string> taken = Evaluations();
    const std::string base = MMSGFunction::GetValue("IDS_QM_UI_PUSH_NEW_NAME");
    fresh.name = base;
    for (int i = 2; Contains(taken, fresh.name); ++i)
        fresh.name = base + " " + std::to_string(i);
    m_settings = m_stored = fresh;
    m_opened.clear();
    Update();
}

// ---- evaluation ---------------------------------------------------------------------------------

int CPushOverCurveEdit::Update()
{
    return Evaluate(false);
}

int CPushOverCurveEdit::Evaluate(bool storeSteps)
{
    m_revision = m_doc.Data().Revision();
    m_bilinearPage.DropEmpty();
    m_evaluated = m_settings;
    m_findings = EvaluationFindings(m_settings, m_doc.Data().Model());
    if (!m_findings.empty()) {
        m_shown.Refuse(m_findings.front().text);
        return 0;
    }
    if (!m_driver.SetEvaluation(m_settings)) {
        m_shown.Refuse(m_driver.Refusal().text);
        return 0;
    }
    m_driver.SetStoreSteps(storeSteps);
    m_driver.SetSpectrumShow(m_show.spectrumOver);
    m_evaluatedShow = m_show.spectrumOver;
    m_driver.Evaluate();
    ListAgain();
    m_shown.Take(m_driver.Result());
    return 1;
}

// Additional steps and points belong to one evaluation of the driver; what this one refuses (a step
// that the curve has no more) is left out of the result and stays asked for.
void CPushOverCurveEdit::ListAgain()
{
    for (const int step : m_steps)
        (void)m_driver.OnPushoverCurveAddStep(step);
    if (m_methodPage.IsTarget()) return;
    for (const std::string& spectrum : m_points)
        (void)m_driver.CalcAdditionalPerformancePoint(spectrum);
}

void CPushOverCurveEdit::OnEdited()
{
    m_bilinearPage.DropEmpty();
    if (m_settings != m_evaluated || m_show.spectrumOver != m_evaluatedShow) Update();
}

int CPushOverCurveEdit::OnDocumentChanged()
{
    if (m_revision == m_doc.Data().Revision() || m_doc.Data().IsLocked()) return 0;
    if (!Contains(m_methodPage.LoadCases(),
                  m_settings.push)) { // another document, or the case was deleted
        Start();
        return 1;
    }
    ReadAgain();
    Update();
    return 1;
}

int CPushOverCurveEdit::OnUserDamping()
{
    m_demandPage.SetView(View());
    if (!m_demandPage.OnUserDamping()) return 0;
    Update();
    return 1;
}

int CPushOverCurveEdit::OnControl()
{
    CPushOverControlDlg options(m_doc);
    options.Data2Dlg(m_settings);
    options.SetView(View());
    if (!options.DoModal()) return 0;
    options.Dlg2Data(m_settings);
    Update();
    return 1;
}

int CPushOverCurveEdit::OnSteps()
{
    CPushOverAdditionalStepDlg steps;
    steps.SetCurve(m_shown.Result().steps);
    T_FINDING refusal; // steps that the curve has no more are left out
    for (const int step : m_steps)
        (void)steps.AddStep(step, refusal);
    steps.SetView(View());
    if (!steps.DoModal()) return 0;
    m_steps = steps.Steps();
    Update();
    return 1;
}

// ---- what the person asks for -------------------------------------------------------------------

int CPushOverCurveEdit::Say(const char* key)
{
    ShowMessage(key);
    return 0;
}

int CPushOverCurveEdit::SayRefusal()
{
    ShowMessage(m_driver.Refusal().messageKey, m_driver.Refusal().text);
    return 0;
}

int CPushOverCurveEdit::OnStoreSteps()
{
    if (!m_methodPage.IsTarget() || !Update() || m_shown.Result().limitStates.empty() ||
        m_shown.Result().result == 0)
        return Say("IDS_QM_UI_PUSH_NO_STEPS");
    if (m_doc.Data().IsLocked()) return Say("IDS_QM_UI_EDIT_BUSY");
    Evaluate(true);
    if (m_changed) m_changed();
    return 1;
}

std::string CPushOverCurveEdit::StoredStepsText() const
{
    int key = 0;
    std::array<int, 3> s{};
    if (!m_doc.Attr().FindPolc(m_settings.push, key)) return {}; // of a direction none are kept
    const auto step = [](int number) {
        return number >= 0 ? std::to_string(number) : std::string("-");
    };
    const auto line = [&](const char* names) {
        return MMSGFunction::Format("IDS_QM_UI_PUSH_STORED",
                                    {names, step(s[0]) + ", " + step(s[1]) + ", " + step(s[2])});
    };
    std::string text;
    const CPoverInfo* const info = m_doc.Post().GetPoverInfo();
    if (info->GetStepEC8(key, s)) text += line("DL, SD, NC");
    if (info->GetStepNTC2008(key, s)) text += (text.empty() ? "" : "\n") + line("SLD, SLV, SLC");
    return text;
}

int CPushOverCurveEdit::OnAddStep()
{
    if (!Update()) return Say("IDS_QM_SETTINGS");
    const int done = m_driver.OnPushoverCurveAddStep(m_addStep);
    if (done)
        m_steps.push_back(m_addStep);
    else
        SayRefusal();
    Update();
    return done;
}

int CPushOverCurveEdit::OnAddPoint()
{
    TakeOneOf(m_demandPage.Spectra(), m_addSpectrum);
    if (!Update()) return Say("IDS_QM_SETTINGS");
    const int done = m_driver.CalcAdditionalPerformancePoint(m_addSpectrum);
    if (done)
        m_points.push_back(m_addSpectrum);
    else
        SayRefusal();
    Update();
    return done;
}

void CPushOverCurveEdit::OnRemoveStep(int row)
{
    if (row < 0 || row >= static_cast<int>(m_shown.Result().additionalSteps.size())) return;
    std::erase(m_steps, m_shown.Result().additionalSteps[static_cast<std::size_t>(row)].step);
    Update();
}

void CPushOverCurveEdit::OnRemovePoint(int row)
{
    if (row < 0 || row >= static_cast<int>(m_shown.Result().additionalPoints.size())) return;
    std::erase(m_points, m_shown.Result().additionalPoints[static_cast<std::size_t>(row)].spectrum);
    Update();
}

void CPushOverCurveEdit::ShowText(const char* titleKey, std::string text)
{
    CPushOverTextDlg preview;
    preview.SetView(View());
    preview.m_title = MMSGFunction::GetValue(titleKey);
    preview.m_text = std::move(text);
    preview.m_askPath = [this] { return AskPath("IDS_QM_UI_PUSH_TEXT_FILTER"); };
    (void)preview.DoModal();
}

void CPushOverCurveEdit::OnPushoverCurveTextout()
{
    const T_PUSH_EVALUATION& result = m_shown.Result();
    std::vector<T_HINGES_AT> hinges;
    std::string judgement;
    Pushing([&](const PUSH_PROGRESS_FN& progress) {
        hinges = HingesOfEvaluations(m_doc, {&result, 1}, progress);
        judgement = ReportOfJudgement(m_doc, result, {}, progress);
    });
    CPushOverTextDlg preview;
    preview.SetView(View());
    preview.m_title = MMSGFunction::GetValue("IDS_QM_UI_PUSH_REPORT_TITLE");
    preview.m_intro = PushoverIntroText(result, m_doc.Data().Model());
    preview.m_text = PushoverReportText(result) + HingesAtReport(hinges.front()) + judgement;
    preview.m_askPath = [this] { return AskPath("IDS_QM_UI_PUSH_TEXT_FILTER"); };
    (void)preview.DoModal();
}

void CPushOverCurveEdit::Pushing(const PUSHING_FN& pushing) const
{
    if (m_withProgress)
        m_withProgress(pushing);
    else
        pushing({});
}

template <class DIALOG, class FILL>
int CPushOverCurveEdit::ShowAtPoints(FILL fill)
{
    DIALOG dialog(m_doc);
    std::string why;
    int done = 0;
    if (Update())
        Pushing([&](const PUSH_PROGRESS_FN& progress) { done = fill(dialog, progress, why); });
    else
        why = m_shown.Refused();
    if (!done) {
        ShowMessage("IDS_QM_UI_PUSH_POINTS_NONE", why);
        return 0;
    }
    dialog.SetView(View());
    (void)dialog.DoModal();
    return 1;
}

int CPushOverCurveEdit::OnHinges()
{
    return ShowAtPoints<CPushOverHingeStateDlg>(
        [this](auto& states, const PUSH_PROGRESS_FN& progress, std::string& why) {
            return states.OnShowPoints(m_shown.Result(), progress, why);
        });
}

int CPushOverCurveEdit::OnJudge()
{
    return ShowAtPoints<CPushOverJudgementDlg>(
        [this](auto& judged, const PUSH_PROGRESS_FN& progress, std::string& why) {
            judged.m_askFile = [this] { return AskPath("IDS_QM_UI_SECC_FILES"); };
            return judged.OnJudge(m_shown.Result(), progress, why);
        });
}

void CPushOverCurveEdit::OnCurveText()
{
    ShowText("IDS_QM_UI_PUSH_CURVE_TITLE", PushoverCurveText(m_shown.Result()));
}

void CPushOverCurveEdit::OnCompare()
{
    CPushOverComparisonDlg comparison(m_doc);
    comparison.SetView(View());
    comparison.m_push = m_settings.push;
    comparison.m_spectrum = m_settings.spectrum;
    comparison.m_behavior = std::min(m_settings.behavior.value_or(0), kUserBehavior - 1);
    comparison.m_askPath = [this] { return AskPath("IDS_QM_UI_PICTURE_FILTER"); };
    comparison.Update();
    (void)comparison.DoModal();
}

std::string CPushOverCurveEdit::AskPath(const char* filterKey) const
{
    return m_askPath ? m_askPath(filterKey) : std::string();
}
