#include "qm_rps/pushovercurvedlg.h"

#include "qm_base/appbase.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/pushoverallpoints.h"
#include "qm_rps/pushover/pushovercells.h"
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptproca.h"
#include "qm_rps/pushovercalcperfptprocb.h"
#include "qm_rps/pushovercurvesub1dlg.h"
#include "qm_rps/pushovercurvesub4dlg.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr const char* kSource = "src/qm_rps/pushovercurvedlg";

void Assert(int line)
{
    if (CAppBase::IsReleaseAssert_ST()) CAppBase::ReleaseAssertion_ST(kSource, line);
}

/// How Gamma is defined: by the mode as recorded, from the nodal masses, or for NTC.
const char* GammaKey(const T_EVAL_D& eval, const T_PUSH_FACTORS& factors)
{
    if (eval.method >= PUSH_METHOD::Ntc2008) return "IDS_RPS_PO_CURVE_GAMMA_NTC";
    return factors.eigenBased ? "IDS_RPS_PO_CURVE_GAMMA_FEMA" : "IDS_RPS_PO_CURVE_GAMMA_2D_FEMA";
}

} // namespace

std::unique_ptr<CPushOverCalcPerfPtBase> MakePerfPtCalculator(PUSH_METHOD method, int procedure,
                                                              CPushOverPerfPtRecord& owner)
{
    if (method == PUSH_METHOD::Atc40) {
        if (procedure == 0) return std::make_unique<CPushOverCalcPerfPtProcA>(owner);
        if (procedure == 1) return std::make_unique<CPushOverCalcPerfPtProcB>(owner);
    } else if (method == PUSH_METHOD::Fema440) {
        if (procedure == 0 || procedure == 1)
            return std::make_unique<CPushOverCalcPerfPtFEMA440ProcA>(owner, procedure);
        if (procedure == 2) return std::make_unique<CPushOverCalcPerfPtFEMA440ProcC>(owner);
    }
    Assert(__LINE__);
    return nullptr;
}

CPushOverCurveDlg::CPushOverCurveDlg(CDBDoc& doc) : m_doc(doc), m_curve(doc) {}

int CPushOverCurveDlg::SetEvaluation(const T_EVAL_D& evaluation)
{
    int pushover = 0, spectrum = 0;
    T_SPFC_D record;
    if (!m_doc.Attr().FindPolc(evaluation.push, pushover)) {
        m_settingsError = "no pushover load case \"" + evaluation.push + "\"";
        return 0;
    }
    if (!m_doc.Attr().FindSpfc(evaluation.spectrum, spectrum) ||
        !m_doc.Attr().GetSpfc(spectrum, record)) {
        m_settingsError = "no spectrum \"" + evaluation.spectrum + "\"";
        return 0;
    }
    if (!CheckPages(evaluation)) return 0;
    m_settingsError.clear();
    m_eval = evaluation;
    m_eval.masonry = evaluation.masonry.value_or(false) || ExistEC8OrMasonry();
    m_spectrumRecord = record;
    m_pushover = pushover;
    T_DAMP_PARAM damping;
    damping.behaviorType = evaluation.behavior.value_or(0);
    damping.elasticPct = evaluation.elasticDamping.value_or(5.0);
    if (const auto& u = evaluation.userDamping) {
        damping.beta1 = (*u)[0];
        damping.kappa1 = (*u)[1];
        damping.beta2 = (*u)[2];
        damping.kappa2 = (*u)[3];
    }
    SetDamping(damping);
    SetAlphaInPercent(evaluation.alphaInPercent.value_or(false));
    return 1;
}

// The rules of the window's pages; their first message is the reason.
int CPushOverCurveDlg::CheckPages(const T_EVAL_D& evaluation)
{
    CPushOverCurveSub1Dlg method;
    method.m_method = evaluation.method;
    method.m_procedure = evaluation.procedure.value_or('A');
    CPushOverCurveSub4Dlg bilinear;
    bilinear.Data2Dlg(evaluation.bilinear);
    for (zql::frx::MDialog* page :
         {static_cast<zql::frx::MDialog*>(&method), static_cast<zql::frx::MDialog*>(&bilinear)}) {
        if (page->CheckData()) continue;
        m_settingsError = page->Messages().back().text;
        ShowMessage(page->Messages().back().key, m_settingsError);
        return 0;
    }
    return 1;
}

double CPushOverCurveDlg::GetGravity(int fromSpectrum) const
{
    const auto* user = std::get_if<T_SPFC_USER>(&m_spectrumRecord.data);
    if (fromSpectrum && user && user->gravity) return *user->gravity;
    T_STYP_D styp;
    if (m_doc.Attr().GetStyp(styp) && styp.gravity) return *styp.gravity;
    return m_doc.Init().DefaultGravity();
}

int CPushOverCurveDlg::Fail(PUSH_OUTCOME code, const char* key)
{
    m_result.outcome = {code, 0};
    ShowMessage(key);
    return 0;
}

int CPushOverCurveDlg::CalcPushoverCurve()
{
    SetGravity(GetGravity(0), GetGravity(1));
    T_PUSH_CURVE_SETTINGS settings;
    settings.pushover = m_pushover;
    settings.plotType = MethodPlotType();
    settings.eigenFactors = m_eval.eigenFactors.value_or(true);
    settings.gravity = GetGravity(1);
    const bool made = m_curveMade == settings && m_curveRevision == m_doc.Data().Revision();
    m_curveMade.reset();
    if (!made && !m_curve.Calc(settings)) {
        SetCapacity({});
        m_result.outcome = {PUSH_OUTCOME::NoCapacity, 0};
        ShowMessage("IDS_QM_CURVE_NOT_READ",
                    zql::lib::MMSGFunction::Format("IDS_QM_CURVE_NOT_READ",
                                                   {m_eval.push, m_curve.Error()}));
        return 0;
    }
    m_curveMade = settings;
    m_curveRevision = m_doc.Data().Revision();
    if (IsSpectral(m_curve.PlotType())) {
        if (!made) SetCapacity({m_curve.Displacement(), m_curve.Force()});
    } else {
        SetCapacity({});
    }
    WarnAboutCurve();
    return CheckCurve();
}

// What makes a capacity spectrum impossible.
int CPushOverCurveDlg::CheckCurve()
{
    if (m_curve.PlotType() != MethodPlotType())
        return Fail(PUSH_OUTCOME::ConversionFailed, "IDS_QM_VERTICAL_PUSH");
    if (m_curve.NoEigen())
        return Fail(PUSH_OUTCOME::NoEigen, "IDS_PUSHOVER_The_eigen_value_analysis_is_not_perfor");
    if (IsTargetType(MethodPlotType()) && m_curve.EigenError())
        return Fail(PUSH_OUTCOME::EigenError, "IDS_RPS_PO_CURVE_ERROR_EIGEN");
    if (m_curve.ConversionError())
        return Fail(PUSH_OUTCOME::ConversionFailed, "IDS_QM_NO_CONVERSION");
    return 1;
}

void CPushOverCurveDlg::WarnAboutCurve()
{
    if (m_curve.StoreyWithoutMass()) ShowMessage("IDS_RPS_ERROR_DIAPHRAGM_MASS");
    if (const int step = m_curve.FirstDecreasingStep())
        ShowMessage("IDS_QM_WARN_DECREASING_DISPLACEMENT",
                    zql::lib::MMSGFunction::Format("IDS_QM_WARN_DECREASING_DISPLACEMENT",
                                                   {m_eval.push, std::to_string(step)}));
}

int CPushOverCurveDlg::Evaluate()
{
    ClearMessages();
    ClearPerfPoint();
    m_additionalSteps.Clear();
    m_result = {};
    m_result.eval = m_eval;
    m_result.procedure = m_eval.procedure.value_or('A');
    m_result.units = m_doc.Unit().Units();
    if (m_result.IsTarget())
        m_result.limitStates = CPushOverTargetEvaluation::EmptyRows(m_eval.method);
    SetGravity(GetGravity(0), GetGravity(1));
    PrepareSpectrum();
    if (CalcPushoverCurve()) {
        m_result.result = m_result.IsTarget() ? UpdateTargetDispData() : UpdatePerformancePoint();
    }
    FillResult();
    return m_result.result;
}

// The spectrum of the record at its own damping; NTC gives the state SLV here.
void CPushOverCurveDlg::PrepareSpectrum()
{
    const int behavior = Damping().behaviorType;
    const double gravity = CPushOverPerfPtRecord::GetGravity(1);
    if (m_spectrumMade == m_spectrumRecord && m_spectrumBehavior == behavior &&
        m_spectrumGravity == gravity)
        return;
    SetDesignSpectrum(MakeDesignSpectrum(m_spectrumRecord, behavior, LIMIT_STATE::SLV));
    m_spectrumMade = m_spectrumRecord;
    m_spectrumBehavior = behavior;
    m_spectrumGravity = gravity;
}

int CPushOverCurveDlg::UpdatePerformancePoint()
{
    const char* const failed = "IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT";
    if (!DesignSpectrum()) return Fail(PUSH_OUTCOME::NoTrialPoint, failed);
    const std::string& path = m_doc.Path();
    SetModelPath(path.empty() ? path : CFileCtrl::GetFilePathAndNameWithoutExtension(path));
    const auto calculator = MakePerfPtCalculator(m_eval.method, m_result.procedure - 'A', *this);
    if (!calculator) return Fail(PUSH_OUTCOME::NoCapacity, failed);
    constexpr int kUserType = 3;
    if (m_eval.method == PUSH_METHOD::Atc40 && Damping().behaviorType == kUserType &&
        !m_eval.userDamping)
        ShowMessage("IDS_QM_WARN_NO_USER_DAMPING");
    double Dp = 0.0, Ap = 0.0;
    std::optional<double> beta;
    const int result = calculator->CalcPerformancePoint(Dp, Ap, beta, nullptr);
    for (const std::string& key : Warnings())
        ShowMessage(key);
    m_result.trace = calculator->Trace();
    m_result.outcome = calculator->Outcome();
    if (const auto* c = dynamic_cast<CPushOverCalcPerfPtFEMA440ProcC*>(calculator.get()))
        m_result.locus = c->Locus();
    if (result == kPerfPtNone) ShowMessage(failed);
    if (result != kPerfPtNone) m_result.point = MakePoint(Dp, Ap, beta);
    if (m_findAllPoints) KeepAllPoints();
    return result;
}

T_PERF_POINT CPushOverCurveDlg::MakePoint(double Dp, double Ap, std::optional<double> beta) const
{
    T_PERF_POINT p;
    p.Sd = p.D = Dp;
    p.Sa = p.V = Ap;
    TransferToDispAndReac(&p.D, &p.V);
    p.Teff = SecantPeriod(Dp, Ap, GetGravity(1));
    p.damping = beta;
    return p;
}

// The procedure's answer stays as it is; the note says how it lies to the balanced points.
void CPushOverCurveDlg::KeepAllPoints()
{
    constexpr double kAway = 0.02; // of the point's displacement
    const bool fema440 = m_eval.method == PUSH_METHOD::Fema440;
    for (const T_BALANCED_POINT& b : CPushOverAllPoints(*this, fema440).Find())
        m_result.allPoints.push_back(MakePoint(b.Sd, b.Sa, b.betaEff));
    if (m_result.allPoints.empty()) return;
    using zql::lib::MMSGFunction;
    if (!m_result.point) {
        m_result.pointNote = MMSGFunction::Format(
            "IDS_QM_POINT_EXISTS", {std::to_string(m_result.allPoints.size()),
                                    FormatText("%.6g", m_result.allPoints.front().D)});
        return;
    }
    const double D = m_result.point->D;
    const auto nearest = std::ranges::min_element(
        m_result.allPoints, {}, [D](const T_PERF_POINT& p) { return std::fabs(p.D - D); });
    const double away = std::fabs(nearest->D - D) / nearest->D;
    if (away > kAway)
        m_result.pointNote =
            MMSGFunction::Format("IDS_QM_POINT_AWAY", {FormatText("%.2g", 100.0 * away),
                                                       FormatText("%.6g", nearest->D)});
}

int CPushOverCurveDlg::CalcAdditionalPerformancePoint(const std::string& spectrum)
{
    if (m_result.additionalPoints.size() >= kMaxAdditional) {
        ShowMessage("IDS_RPS_PUSHOVER_Maxnum_reached");
        return 0;
    }
    T_EVAL_D other = m_eval;
    other.spectrum = spectrum;
    CPushOverCurveDlg driver(m_doc);
    driver.SetFindAllPoints(false);
    if (m_result.IsTarget()) {
        ShowMessage("IDS_QM_NO_ADDITIONAL_POINT");
        return 0;
    }
    if (!driver.SetEvaluation(other)) {
        ShowMessage("IDS_QM_SETTINGS", driver.SettingsError());
        return 0;
    }
    const int result = driver.Evaluate();
    m_result.additionalPoints.push_back(
        {spectrum, result, driver.Result().point, driver.Result().outcome});
    return 1;
}

int CPushOverCurveDlg::OnPushoverCurveAddStep(int step)
{
    m_additionalSteps.SetStepCount(static_cast<int>(m_result.capacity.Sd.size()) - 1);
    m_additionalSteps.ClearMessages();
    if (!m_additionalSteps.AddStep(step)) {
        for (const auto& m : m_additionalSteps.Messages())
            ShowMessage(m.key, m.text);
        return 0;
    }
    const auto i = static_cast<std::size_t>(step);
    const double Sd = m_result.capacity.Sd[i], Sa = m_result.capacity.Sa[i];
    T_ADDITIONAL_STEP row{step, Sd, Sa, Sd, Sa};
    TransferToDispAndReac(&row.D, &row.V);
    m_result.additionalSteps.push_back(row);
    return 1;
}

T_BILINEAR_OPTIONS CPushOverCurveDlg::BilinearOptions() const
{
    const T_EVAL_BILINEAR given = m_eval.bilinear.value_or(T_EVAL_BILINEAR{});
    const std::string fallback = m_eval.masonry.value_or(false)          ? "masonry"
                                 : m_eval.method == PUSH_METHOD::Ec8Opcm ? "ec8"
                                                                         : "ntc";
    const std::string rule = given.rule.value_or(fallback);
    T_BILINEAR_OPTIONS options = BilinearDefaults(rule == "masonry" ? BILINEAR_RULE::Masonry
                                                  : rule == "ntc"   ? BILINEAR_RULE::Ntc
                                                                    : BILINEAR_RULE::Ec8);
    options.secant = given.secant.value_or(options.secant);
    options.drop = given.drop.value_or(options.drop);
    // The iteration runs on one spectrum; NTC has four.
    options.iterate = m_eval.method == PUSH_METHOD::Ec8Opcm && given.iterate.value_or(false);
    return options;
}

// Ratio of the chosen kind; step 0 is the model at rest.
std::optional<double> CPushOverCurveDlg::DriftOfStep(int step)
{
    m_driftUsed = true;
    if (step == 0) return 0.0;
    double kind1 = 0.0, kind2 = 0.0;
    const int kind = m_eval.driftKind.value_or(1);
    if (kind != 1 && kind != 2) {
        Assert(__LINE__);
        return std::nullopt;
    }
    if (!m_doc.Post().GetPushoverStoryDriftRatio(m_pushover, step, kind1, kind2)) {
        m_driftMissing = true;
        return 0.0; // without storeys no drift limits the capacity: the peak step stands
    }
    return kind == 1 ? kind1 : kind2;
}

T_TARGET_INPUT CPushOverCurveDlg::TargetInput()
{
    T_TARGET_INPUT in;
    in.capacity = Capacity();
    in.gravity = GetGravity(1);
    in.gamma = m_curve.Factors().gamma;
    in.mStar = m_curve.Factors().mass * m_curve.Factors().alpha / in.gamma;
    in.options = BilinearOptions();
    in.drift = [this](int step) { return DriftOfStep(step); };
    const bool ntc = m_eval.method != PUSH_METHOD::Ec8Opcm;
    for (std::size_t i = 0; i < (ntc ? in.spectra.size() : 1); ++i) {
        const LIMIT_STATE state = ntc ? static_cast<LIMIT_STATE>(i) : LIMIT_STATE::SLV;
        const std::shared_ptr<CETC_DESIGN_SPECT> spectrum =
            MakeDesignSpectrum(m_spectrumRecord, Damping().behaviorType, state);
        if (!spectrum) continue;
        in.spectra[i] = {[spectrum](double T) { return spectrum->CalcSaAt(T); },
                         spectrum->CornerPeriod()};
    }
    return in;
}

int CPushOverCurveDlg::UpdateTargetDispData()
{
    m_driftMissing = m_driftUsed = false;
    const char* const failed = "IDS_RPS_FAILED_FINDING_TARGET_DISPLACEMENT";
    T_TARGET_INPUT input = TargetInput();
    const bool enabled = std::ranges::any_of(
        input.spectra, [](const T_TARGET_SPECTRUM& s) { return static_cast<bool>(s.SaAt); });
    if (!enabled) return Fail(PUSH_OUTCOME::NoTarget, failed);
    CPushOverTargetEvaluation evaluation(std::move(input));
    int found = 0;
    if (m_eval.method != PUSH_METHOD::Ec8Opcm)
        found = evaluation.UpdateTargetDispDataNTC(m_eval.method);
    else if (m_result.IsMasonry())
        found = evaluation.UpdateTargetDispDataMasonry();
    else
        found = evaluation.UpdateTargetDispDataEC8();
    if (!found || evaluation.StrengthDropMissing()) ShowMessage(failed);
    if (m_driftMissing)
        ShowMessage("IDS_QM_WARN_NO_DRIFT");
    else if (m_driftUsed && m_doc.Post().HasStoreyGaps(m_pushover))
        ShowMessage("IDS_QM_WARN_STOREY_GAPS");
    m_result.bilinear = evaluation.Bilinear();
    m_result.targets = evaluation.Targets();
    m_result.limitStates = evaluation.Rows();
    m_result.guideLines = evaluation.GuideLines();
    m_result.outcome = evaluation.Outcome();
    if (m_storeSteps) StoreSteps(evaluation);
    return found;
}

void CPushOverCurveDlg::StoreSteps(const CPushOverTargetEvaluation& evaluation)
{
    const std::vector<int>& steps = evaluation.DemandSteps();
    CPoverInfo* info = m_doc.Post().GetPoverInfo();
    if (m_eval.method == PUSH_METHOD::Ec8Opcm)
        info->SetStepEC8(m_pushover, steps[0], steps[1], steps[2]);
    else // SLO is shown but never stored, on purpose
        info->SetStepNTC2008(m_pushover, steps[1], steps[2], steps[3]);
}

void CPushOverCurveDlg::FillResult()
{
    m_result.loadCase = m_curve.LoadCase();
    m_result.factors = m_curve.Factors();
    if (m_result.factors.gamma != 0.0)
        m_result.mStar = m_result.factors.mass * m_result.factors.alpha / m_result.factors.gamma;
    m_result.capacity = Capacity();
    m_result.demand = Demand();
    m_result.reduced = PerfPointSpectrum();
    m_result.working = WorkingDemand();
    if (m_result.locus.Sd.empty()) m_result.locus = PerfPointTrace();
    m_result.gammaNote = zql::lib::MMSGFunction::GetValue(GammaKey(m_eval, m_result.factors));
    KeepStateDemands();
    m_result.teffs = Teffs();
    PlotCurve();
    m_result.messages = Messages();
}

// NTC: one spectrum for each enabled limit state, for the picture.
void CPushOverCurveDlg::KeepStateDemands()
{
    if (m_eval.method < PUSH_METHOD::Ntc2008 ||
        !std::holds_alternative<T_SPFC_NTC>(m_spectrumRecord.data))
        return;
    m_result.stateDemands.resize(kLimitStateNames.size());
    std::vector<double> T;
    for (std::size_t i = 0; i < kLimitStateNames.size(); ++i) {
        const auto spectrum = MakeDesignSpectrum(m_spectrumRecord, Damping().behaviorType,
                                                 static_cast<LIMIT_STATE>(i));
        if (!spectrum) continue;
        T_ADRS_CURVE& curve = m_result.stateDemands[i];
        spectrum->CalcPOSpectrumSRaSRv(1.0, 1.0, T, curve.Sa);
        ToAdrs(T, curve.Sa, curve.Sd);
    }
}

// The curve that the report tabulates: the method's own, or of the plot type asked for.
void CPushOverCurveDlg::PlotCurve()
{
    const auto type =
        static_cast<PLOT_TYPE>(m_eval.plotType.value_or(static_cast<int>(m_eval.method)));
    if (type == MethodPlotType()) {
        if (m_curveMade)
            m_result.curve = {m_curve.PlotType(), m_curve.Displacement(), m_curve.Force()};
        return;
    }
    T_PUSH_CURVE_SETTINGS settings;
    settings.pushover = m_pushover;
    settings.plotType = type;
    settings.eigenFactors = m_eval.eigenFactors.value_or(true);
    settings.gravity = GetGravity(1);
    CPushOverCurveData data(m_doc);
    const bool shear = type == PLOT_TYPE::ShearCoeff || type == PLOT_TYPE::Drift;
    const int made = data.Calc(settings);
    if (made && shear && data.Factors().weight == 0.0) ShowMessage("IDS_QM_WARN_NO_WEIGHT");
    if (made) m_result.curve = {data.PlotType(), data.Displacement(), data.Force()};
}

std::string CPushOverCurveDlg::PerfPointCell() const
{
    return PerfPointPair(m_result, &T_PERF_POINT::Sd, &T_PERF_POINT::Sa);
}

bool CPushOverCurveDlg::ExistEC8OrMasonry() const
{
    const auto isMasonry = [](const auto& entry) { return entry.second.masonry.has_value(); };
    return std::ranges::any_of(m_doc.Data().Model().hingeTypes, isMasonry);
}

int CPushOverCurveDlg::ExistEC8() const
{
    Assert(__LINE__);
    return 0;
}
