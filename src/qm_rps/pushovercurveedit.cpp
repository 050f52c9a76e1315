#include "qm_rps/pushovercurveedit.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/desk/recordnames.h"
#include "qm_rps/pushovercurvedampparamuser.h"
#include "qm_rps/pushovercurvesub1dlg.h"
#include "qm_rps/pushovercurvesub4dlg.h"

namespace {

using zql::lib::MMSGFunction;
using NAMES = std::vector<std::string>;

constexpr double kMostDamping = 100.0; // per cent

NAMES TextsOf(std::span<const char* const> keys)
{
    NAMES texts;
    for (const char* key : keys)
        texts.push_back(MMSGFunction::GetValue(key));
    return texts;
}

} // namespace

CPushOverCurveEdit::CPushOverCurveEdit(CDBDoc& doc) : m_doc(doc), m_driver(doc)
{
    Start();
}

void CPushOverCurveEdit::Start()
{
    m_result = m_pictured = {};
    m_steps.clear();
    m_points.clear();
    const NAMES stored = Evaluations();
    if (stored.empty() || !OnOpen(stored.front())) OnNew();
}

NAMES CPushOverCurveEdit::LoadCases() const
{
    return NamesOf(m_doc.Data().Model().pushovers);
}

NAMES CPushOverCurveEdit::Spectra() const
{
    return NamesOf(m_doc.Data().Model().spectra);
}

NAMES CPushOverCurveEdit::Evaluations() const
{
    return NamesOf(m_doc.Data().Model().evaluations);
}

NAMES CPushOverCurveEdit::Methods()
{
    NAMES names;
    for (const PUSH_METHOD method : CPushOverCurveSub1Dlg::kPerfPointMethods)
        names.emplace_back(MethodName(method));
    for (const PUSH_METHOD method : CPushOverCurveSub1Dlg::kTargetMethods)
        names.emplace_back(MethodName(method));
    return names;
}

NAMES CPushOverCurveEdit::Procedures() const
{
    return TextsOf(CPushOverCurveSub1Dlg::Procedures(m_settings.method));
}

NAMES CPushOverCurveEdit::Behaviors() const
{
    constexpr std::array kAtc{"IDS_QM_UI_PUSH_TYPE_A", "IDS_QM_UI_PUSH_TYPE_B",
                              "IDS_QM_UI_PUSH_TYPE_C", "IDS_QM_UI_PUSH_TYPE_USER"};
    constexpr std::array kFema{"IDS_QM_UI_PUSH_MODEL_BILINEAR", "IDS_QM_UI_PUSH_MODEL_STIFFNESS",
                               "IDS_QM_UI_PUSH_MODEL_STRENGTH", "IDS_QM_UI_PUSH_MODEL_ANY"};
    return m_settings.method == PUSH_METHOD::Fema440 ? TextsOf(kFema) : TextsOf(kAtc);
}

NAMES CPushOverCurveEdit::PlotTypes()
{
    constexpr std::array kKeys{"IDS_QM_UI_PUSH_PLOT_REACTION", "IDS_QM_UI_PUSH_PLOT_SHEAR",
                               "IDS_QM_UI_PUSH_PLOT_DRIFT", "IDS_QM_UI_PUSH_PLOT_FACTOR"};
    NAMES texts = TextsOf(kKeys);
    for (const std::string& method : Methods())
        texts.push_back(MMSGFunction::Format("IDS_QM_UI_PUSH_PLOT_SPECTRUM", {method}));
    return texts;
}

bool CPushOverCurveEdit::HasUserDamping() const
{
    return m_settings.method == PUSH_METHOD::Atc40 && m_settings.behavior == kUserBehavior;
}

T_EVAL_BILINEAR& CPushOverCurveEdit::Bilinear()
{
    if (!m_settings.bilinear) m_settings.bilinear.emplace();
    return *m_settings.bilinear;
}

void CPushOverCurveEdit::ChangeMethod(PUSH_METHOD method)
{
    if (method == m_settings.method) return;
    if (m_settings.plotType && IsSpectral(static_cast<PLOT_TYPE>(*m_settings.plotType)))
        m_settings.plotType.reset();
    m_settings.method = method;
    const auto offered = CPushOverCurveSub1Dlg::Procedures(method).size();
    const auto index = static_cast<std::size_t>(m_settings.procedure.value_or('A') - 'A');
    if (index >= offered) m_settings.procedure.reset();
}

int CPushOverCurveEdit::OnOpen(const std::string& evaluation)
{
    for (const auto& [key, record] : m_doc.Data().Model().evaluations) {
        if (record.name != evaluation || !m_doc.Attr().GetEval(key, m_settings)) continue;
        Update();
        return 1;
    }
    return 0;
}

void CPushOverCurveEdit::OnNew()
{
    T_EVAL_D fresh;
    fresh.push = m_settings.push;
    fresh.spectrum = m_settings.spectrum;
    TakeOneOf(LoadCases(), fresh.push);
    TakeOneOf(Spectra(), fresh.spectrum);
    const NAMES taken = Evaluations();
    const std::string base = MMSGFunction::GetValue("IDS_QM_UI_PUSH_NEW_NAME");
    fresh.name = base;
    for (int i = 2; Contains(taken, fresh.name); ++i)
        fresh.name = base + " " + std::to_string(i);
    m_settings = fresh;
    Update();
}

// ---- evaluation ---------------------------------------------------------------------------------

void CPushOverCurveEdit::AddFinding(const char* field, const std::string& text)
{
    T_FINDING finding;
    finding.field = field;
    finding.text = text;
    m_findings.push_back(std::move(finding));
}

void CPushOverCurveEdit::CheckPage(const char* field, zql::frx::MDialog& page)
{
    if (!page.CheckData()) AddFinding(field, page.Messages().back().text);
}

// The rules that a case file keeps too, so that what is stored can be read again.
void CPushOverCurveEdit::CheckSettings()
{
    m_findings.clear();
    if (!Contains(LoadCases(), m_settings.push))
        AddFinding("push", MMSGFunction::GetValue("IDS_QM_UI_PUSH_NO_CASE"));
    if (!Contains(Spectra(), m_settings.spectrum))
        AddFinding("spectrum", MMSGFunction::GetValue("IDS_QM_UI_PUSH_NO_SPECTRUM"));
    CPushOverCurveSub1Dlg method;
    method.m_method = m_settings.method;
    method.m_procedure = m_settings.procedure.value_or('A');
    CheckPage("procedure", method);
    const double damping = m_settings.elasticDamping.value_or(0.0);
    if (!(damping >= 0.0 && damping <= kMostDamping))
        AddFinding("elasticDamping", MMSGFunction::GetValue("IDS_QM_UI_PUSH_BAD_DAMPING"));
    if (m_settings.userDamping) {
        const auto& u = *m_settings.userDamping;
        CPushOverCurveDampParamUser points;
        points.Data2Dlg({kUserBehavior, 0.0, u[0], u[1], u[2], u[3]});
        CheckPage("userDamping", points);
    }
    if (!m_settings.bilinear) return;
    CPushOverCurveSub4Dlg secant, drop;
    secant.m_options.secant = m_settings.bilinear->secant;
    drop.m_options.drop = m_settings.bilinear->drop;
    CheckPage("bilinear.secant", secant);
    CheckPage("bilinear.drop", drop);
}

bool CPushOverCurveEdit::HasPicture(const T_PUSH_EVALUATION& e) const
{
    if (IsOtherPlot(e)) return e.curve.x.size() > 1;
    const auto code = e.outcome.code;
    const bool noSpectrum = code == PUSH_OUTCOME::NoCapacity || code == PUSH_OUTCOME::NoEigen ||
                            code == PUSH_OUTCOME::EigenError ||
                            code == PUSH_OUTCOME::ConversionFailed;
    return !noSpectrum && e.capacity.Sd.size() > 1;
}

int CPushOverCurveEdit::Update()
{
    return Evaluate(false);
}

int CPushOverCurveEdit::Evaluate(bool storeSteps)
{
    m_revision = m_doc.Data().Revision();
    if (m_settings.bilinear == T_EVAL_BILINEAR{}) m_settings.bilinear.reset();
    m_evaluated = m_settings;
    CheckSettings();
    m_refusal = m_findings.empty() ? std::string() : m_findings.front().text;
    if (!m_findings.empty()) return 0;
    if (!m_driver.SetEvaluation(m_settings)) {
        m_refusal = m_driver.SettingsError();
        return 0;
    }
    m_driver.SetStoreSteps(storeSteps);
    m_driver.Evaluate();
    ListAgain();
    m_result = m_driver.Result();
    m_noPicture.clear();
    if (HasPicture(m_result))
        m_pictured = m_result;
    else
        m_noPicture = m_result.messages.empty() ? OutcomeAdvice(m_result.outcome)
                                                : m_result.messages.back().text;
    SetTrial(m_trial);
    return 1;
}

// Additional steps and points belong to one evaluation of the driver; what this one refuses (a step
// that the curve has no more) is left out of the result and stays asked for.
void CPushOverCurveEdit::ListAgain()
{
    for (const int step : m_steps)
        (void)m_driver.OnPushoverCurveAddStep(step);
    if (IsTarget()) return;
    for (const std::string& spectrum : m_points)
        (void)m_driver.CalcAdditionalPerformancePoint(spectrum);
}

void CPushOverCurveEdit::OnEdited()
{
    if (m_settings.bilinear == T_EVAL_BILINEAR{}) m_settings.bilinear.reset();
    if (m_settings != m_evaluated) Update();
}

std::string CPushOverCurveEdit::Refusal() const
{
    if (!m_refusal.empty()) return MMSGFunction::Format("IDS_QM_UI_PUSH_REFUSED", {m_refusal});
    if (m_noPicture.empty()) return {};
    return MMSGFunction::Format("IDS_QM_UI_PUSH_NO_PICTURE", {m_noPicture});
}

int CPushOverCurveEdit::OnDocumentChanged()
{
    if (m_revision == m_doc.Data().Revision() || m_doc.Data().IsLocked()) return 0;
    if (!Contains(LoadCases(), m_settings.push)) { // another document, or the case was deleted
        Start();
        return 1;
    }
    Update();
    return 1;
}

void CPushOverCurveEdit::SetTrial(int trial)
{
    m_trial = std::clamp(trial, 0, TrialCount());
}

// ---- texts --------------------------------------------------------------------------------------

std::string CPushOverCurveEdit::CaseText() const
{
    constexpr std::array kPatterns{"IDS_PUSHOVER_Static_Load", "IDS_PUSHOVER_Accerelation",
                                   "IDS_PUSHOVER_Mode_Shape", "IDS_PUSHOVER_Mode_Shape_Story_Mass"};
    const T_POLC_D& polc = m_pictured.loadCase;
    if (polc.name.empty()) return {};
    const char* const direction = kDirectionNames.at(static_cast<std::size_t>(polc.direction - 1));
    return MMSGFunction::Format("IDS_PUSHOVER_Control_Node___d__Dir____",
                                {std::to_string(polc.controlNode), direction}) +
           "; " +
           MMSGFunction::Format(
               "IDS_PUSHOVER_Master_Load_Pattern",
               {MMSGFunction::GetValue(kPatterns.at(static_cast<std::size_t>(polc.patternKind)))});
}

std::string CPushOverCurveEdit::StoredStepsText() const
{
    int key = 0;
    std::array<int, 3> s{};
    if (!m_doc.Attr().FindPolc(m_settings.push, key)) return {};
    const auto line = [&](const char* names) {
        return MMSGFunction::Format("IDS_QM_UI_PUSH_STORED",
                                    {names, std::to_string(s[0]) + ", " + std::to_string(s[1]) +
                                                ", " + std::to_string(s[2])});
    };
    std::string text;
    const CPoverInfo* const info = m_doc.Post().GetPoverInfo();
    if (info->GetStepEC8(key, s)) text += line("DL, SD, NC");
    if (info->GetStepNTC2008(key, s)) text += (text.empty() ? "" : "\n") + line("SLD, SLV, SLC");
    return text;
}
