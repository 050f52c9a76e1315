#include "qm_rps/pushover/evaluation/pushevaluator.h"

#include "qm_base/finite.h"
#include "qm_base/msgfunction.h"
#include "qm_db/filectrl.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushended.h"
#include "qm_rps/pushover/evaluation/pushremarks.h"
#include "qm_rps/pushover/refusal.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

constexpr const char* kNoPoint = "IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT";

T_DAMP_PARAM DampingOf(const T_EVAL_D& evaluation)
{
    T_DAMP_PARAM damping;
    damping.behaviorType = evaluation.behavior.value_or(0);
    damping.elasticPct = evaluation.elasticDamping.value_or(5.0);
    if (const auto& u = evaluation.userDamping) {
        damping.beta1 = (*u)[0];
        damping.kappa1 = (*u)[1];
        damping.beta2 = (*u)[2];
        damping.kappa2 = (*u)[3];
    }
    return damping;
}

} // namespace

CPushEvaluator::CPushEvaluator(CDBDoc& doc, PERFPT_PROCEDURE procedure)
    : m_doc(doc), m_procedure(procedure), m_curve(doc)
{
}

int CPushEvaluator::SetEvaluation(const T_EVAL_D& evaluation, T_FINDING& refusal)
{
    int spectrum = 0;
    T_SPFC_D record;
    const std::optional<T_PUSH_NAME> push = FindPush(m_doc.Data().Model(), evaluation.push);
    if (!push) return Refuse(refusal, "push", "IDS_QM_PUSH_CASE_UNKNOWN", {evaluation.push});
    const std::vector<std::string> directions =
        TurnedNames(m_doc.Data().Model().pushovers.at(push->key));
    if (push->turn == 0 && !directions.empty() && !m_doc.Post().SelectPushover(push->key))
        return Refuse(refusal, "push", "IDS_QM_PUSH_MANY_DIRECTIONS",
                      {evaluation.push, directions.front(), directions.back()});
    if (!m_doc.Attr().FindSpfc(evaluation.spectrum, spectrum) ||
        !m_doc.Attr().GetSpfc(spectrum, record))
        return Refuse(refusal, "spectrum", "IDS_QM_PUSH_SPECTRUM_UNKNOWN", {evaluation.spectrum});
    const std::vector<T_FINDING> wrong = OptionFindings(evaluation);
    if (!wrong.empty()) {
        refusal = wrong.front();
        return 0;
    }
    m_eval = evaluation;
    m_masonryGiven = evaluation.masonry.has_value();
    m_eval.masonry = evaluation.masonry.value_or(ExistEC8OrMasonry());
    m_spectrumRecord = record;
    m_push = *push;
    SetDamping(DampingOf(evaluation));
    SetAlphaInPercent(evaluation.alphaInPercent.value_or(false));
    return 1;
}

double CPushEvaluator::FindGravity(bool fromSpectrum) const
{
    const auto* user = std::get_if<T_SPFC_USER>(&m_spectrumRecord.data);
    if (fromSpectrum && user && user->gravity) return *user->gravity;
    T_STYP_D styp;
    if (m_doc.Attr().GetStyp(styp) && styp.gravity) return *styp.gravity;
    return m_doc.Init().DefaultGravity();
}

void CPushEvaluator::Say(const char* key, std::initializer_list<std::string_view> values)
{
    m_result.messages.push_back({key, MMSGFunction::Format(key, values)});
}

int CPushEvaluator::Fail(PUSH_OUTCOME code, const char* key)
{
    m_result.outcome = {code, 0};
    Say(key);
    return 0;
}

T_PUSH_CURVE_SETTINGS CPushEvaluator::CurveSettings(PLOT_TYPE type) const
{
    T_PUSH_CURVE_SETTINGS settings;
    settings.pushover = m_push.key;
    settings.turn = m_push.turn;
    settings.plotType = type;
    settings.eigenFactors = m_eval.eigenFactors.value_or(true);
    settings.gravity = FindGravity(true);
    settings.userWeight = m_eval.weight.value_or(0.0);
    for (std::size_t i = 0; i < m_eval.monitoredNodes.size(); ++i)
        settings.extraNodes.at(i) = m_eval.monitoredNodes[i];
    return settings;
}

int CPushEvaluator::CalcPushoverCurve()
{
    SetGravity(FindGravity(false), FindGravity(true));
    const T_PUSH_CURVE_SETTINGS settings = CurveSettings(MethodPlotType());
    const bool made = m_curveMade == settings && m_curveRevision == m_doc.Data().Revision();
    m_curveMade.reset();
    if (!made && !m_curve.Calc(settings)) {
        SetCapacity({});
        Say("IDS_QM_CURVE_NOT_READ", {m_eval.push, m_curve.Error()});
        m_result.outcome = {PUSH_OUTCOME::NoCapacity, 0};
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
int CPushEvaluator::CheckCurve()
{
    if (IsUsable()) return 1;
    if (!m_result.IsTarget()) Say(kNoPoint);
    return 0;
}

int CPushEvaluator::IsUsable()
{
    if (m_curve.PlotType() != MethodPlotType())
        return Fail(PUSH_OUTCOME::ConversionFailed, "IDS_QM_VERTICAL_PUSH");
    if (m_curve.NoEigen())
        return Fail(PUSH_OUTCOME::NoEigen, "IDS_PUSHOVER_The_eigen_value_analysis_is_not_perfor");
    if (IsTargetType(MethodPlotType()) && m_curve.EigenError())
        return Fail(PUSH_OUTCOME::EigenError, "IDS_RPS_PO_CURVE_ERROR_EIGEN");
    if (m_curve.ConversionError())
        return Fail(PUSH_OUTCOME::ConversionFailed, "IDS_QM_NO_CONVERSION");
    if (m_curve.Factors().gamma < 0.0)
        return Fail(PUSH_OUTCOME::NegativeGamma, "IDS_QM_ADVICE_NEGATIVE_GAMMA");
    return 1;
}

void CPushEvaluator::WarnAboutCurve()
{
    if (std::string why; m_doc.Post().IsStale(m_push.key, why, m_push.turn))
        m_result.messages.push_back({kResultsAreOld, why});
    if (auto remark = PushRemark(m_doc, m_eval.push))
        m_result.messages.push_back(std::move(*remark));
    if (m_curve.StoreyWithoutMass()) Say("IDS_RPS_ERROR_DIAPHRAGM_MASS");
    if (const int step = m_curve.FirstDecreasingStep())
        Say("IDS_QM_WARN_DECREASING_DISPLACEMENT", {m_eval.push, std::to_string(step)});
}

int CPushEvaluator::Evaluate()
{
    ClearPerfPoint();
    m_result = {};
    m_result.eval = m_eval;
    m_result.procedure = m_eval.procedure.value_or('A');
    m_result.units = m_doc.Unit().Units();
    if (m_result.IsTarget())
        m_result.limitStates = CPushOverTargetEvaluation::EmptyRows(m_eval.method);
    SetGravity(FindGravity(false), FindGravity(true));
    PrepareSpectrum();
    if (CalcPushoverCurve())
        m_result.result = m_result.IsTarget() ? UpdateTargetDispData() : UpdatePerformancePoint();
    else
        ForgetSteps();
    FillResult();
    if (IsFinite(m_result))
        AddRemarks(m_doc, m_spectrumRecord, m_result);
    else
        GiveUp();
    return m_result.result;
}

void CPushEvaluator::GiveUp()
{
    T_PUSH_EVALUATION none;
    none.eval = m_result.eval;
    none.procedure = m_result.procedure;
    none.loadCase = m_result.loadCase;
    none.units = m_result.units;
    if (none.IsTarget()) none.limitStates = CPushOverTargetEvaluation::EmptyRows(m_eval.method);
    m_result = std::move(none);
    (void)Fail(PUSH_OUTCOME::NotFinite, "IDS_QM_ADVICE_NOT_FINITE");
    ForgetSteps();
}

void CPushEvaluator::SetSpectrumFactor(double factor)
{
    m_spectrumFactor = factor;
    m_spectrumMade.reset();
}

// The spectrum of the record at its own damping; NTC gives the state SLV here.
void CPushEvaluator::PrepareSpectrum()
{
    const int behavior = Damping().behaviorType;
    const double gravity = GetGravity(1);
    const bool shown =
        !DesignSpectrum() || DesignSpectrum()->GetShowMode() == static_cast<int>(m_spectrumShow);
    if (shown && m_spectrumMade == m_spectrumRecord && m_spectrumBehavior == behavior &&
        m_spectrumGravity == gravity)
        return;
    auto spectrum = MakeDesignSpectrum(m_spectrumRecord, behavior, LIMIT_STATE::SLV);
    if (spectrum) {
        if (m_spectrumFactor != 1.0) spectrum->ScaleBy(m_spectrumFactor);
        spectrum->SetCurrentDlg(static_cast<int>(m_eval.method));
        spectrum->SetShowMode(static_cast<int>(m_spectrumShow));
    }
    SetDesignSpectrum(std::move(spectrum));
    m_spectrumMade = m_spectrumRecord;
    m_spectrumBehavior = behavior;
    m_spectrumGravity = gravity;
}

int CPushEvaluator::UpdatePerformancePoint()
{
    if (!DesignSpectrum()) return Fail(PUSH_OUTCOME::NoTrialPoint, kNoPoint);
    const std::string& path = m_doc.Path();
    SetModelPath(path.empty() ? path : CFileCtrl::GetFilePathAndNameWithoutExtension(path));
    if (m_eval.method == PUSH_METHOD::Atc40 && Damping().behaviorType == kUserBehavior &&
        !m_eval.userDamping)
        Say("IDS_QM_WARN_NO_USER_DAMPING");
    auto answer = m_procedure(m_eval.method, m_result.procedure - 'A', *this);
    if (!answer) return Fail(PUSH_OUTCOME::NoCapacity, kNoPoint);
    for (const std::string& key : Warnings())
        Say(key.c_str());
    m_result.trace = std::move(answer->trace);
    m_result.locus = std::move(answer->locus);
    m_result.slopeChange = answer->slopeChange;
    m_result.outcome = answer->outcome;
    if (answer->result == 0)
        Say(kNoPoint);
    else
        m_result.point = MakePoint(answer->Sd, answer->Sa, answer->betaEff);
    if (m_findAllPoints) KeepAllPoints();
    return answer->result;
}

T_TARGET_INPUT CPushEvaluator::TargetInput(CStepDrift& drift) const
{
    T_TARGET_INPUT in;
    in.capacity = Capacity();
    in.gravity = GetGravity(1);
    in.gamma = m_curve.Factors().gamma;
    in.mStar = m_curve.Factors().mass * m_curve.Factors().alpha / in.gamma;
    in.options = BilinearOptionsOf(m_eval);
    in.drift = [&drift, &steps = m_curve.Steps()](int index) {
        return drift.Of(steps[static_cast<std::size_t>(index)]);
    };
    in.spectra =
        TargetSpectraOf(m_spectrumRecord, m_eval.method, Damping().behaviorType, m_spectrumFactor);
    return in;
}

int CPushEvaluator::UpdateTargetDispData()
{
    const char* const failed = "IDS_RPS_FAILED_FINDING_TARGET_DISPLACEMENT";
    CStepDrift drift(m_doc, m_push, m_eval.driftKind.value_or(1));
    T_TARGET_INPUT input = TargetInput(drift);
    const bool enabled = std::ranges::any_of(
        input.spectra, [](const T_TARGET_SPECTRUM& s) { return static_cast<bool>(s.SaAt); });
    if (!enabled) {
        ForgetSteps();
        return Fail(PUSH_OUTCOME::NoTarget, failed);
    }
    CPushOverTargetEvaluation evaluation(std::move(input));
    const int found = m_eval.method != PUSH_METHOD::Ec8Opcm
                          ? evaluation.UpdateTargetDispDataNTC(m_eval.method)
                      : m_result.IsMasonry() ? evaluation.UpdateTargetDispDataMasonry()
                                             : evaluation.UpdateTargetDispDataEC8();
    if (!found || evaluation.StrengthDropMissing()) Say(failed);
    if (ExistEC8OrMasonry() && m_masonryGiven != m_eval.masonry.value_or(false)) // NTC's rule too
        Say(m_masonryGiven ? "IDS_QM_MASONRY_OFF" : "IDS_QM_MASONRY_BY_HINGES");
    if (const char* const key = drift.WarningKey()) Say(key);
    m_result.bilinear = evaluation.Bilinear();
    m_result.targets = evaluation.Targets();
    m_result.limitStates = evaluation.Rows();
    for (T_LIMIT_ROW& row : m_result.limitStates) {
        TakeStepNumber(row.demandStep);
        TakeStepNumber(row.capacityStep);
    }
    m_result.guideLines = evaluation.GuideLines();
    m_result.outcome = evaluation.Outcome();
    if (!m_storeSteps || m_push.turn != 0) return found; // they are of a load case
    std::vector<int> demands;
    for (std::optional<int> step : evaluation.DemandSteps()) {
        TakeStepNumber(step);
        demands.push_back(*step);
    }
    StoreSteps(demands);
    return found;
}

/// From an index of the curve; what stands for no step stays.
void CPushEvaluator::TakeStepNumber(std::optional<int>& step) const
{
    if (step && *step > 0) step = m_curve.Steps()[static_cast<std::size_t>(*step)];
}

void CPushEvaluator::StoreSteps(const std::vector<int>& steps)
{
    CPoverInfo* info = m_doc.Post().GetPoverInfo();
    if (m_eval.method == PUSH_METHOD::Ec8Opcm)
        info->SetStepEC8(m_push.key, steps[0], steps[1], steps[2]);
    else // SLO is shown but never stored, on purpose
        info->SetStepNTC2008(m_push.key, steps[1], steps[2], steps[3]);
}

// An evaluation that ended early found none; those of an earlier one don't stand any more.
void CPushEvaluator::ForgetSteps()
{
    if (!m_result.IsTarget() || !m_storeSteps || m_push.turn != 0) return;
    std::array<int, 3> stored{};
    CPoverInfo* info = m_doc.Post().GetPoverInfo();
    if (m_eval.method == PUSH_METHOD::Ec8Opcm ? info->GetStepEC8(m_push.key, stored)
                                              : info->GetStepNTC2008(m_push.key, stored))
        StoreSteps(std::vector<int>(m_result.limitStates.size(), kStepNone));
}

bool CPushEvaluator::ExistEC8OrMasonry() const
{
    const auto isMasonry = [](const auto& entry) { return entry.second.masonry.has_value(); };
    return std::ranges::any_of(m_doc.Data().Model().hingeTypes, isMasonry);
}

int CPushEvaluator::CalcAdditionalPerformancePoint(const std::string& spectrum, T_FINDING& refusal)
{
    if (m_result.additionalPoints.size() >= kMaxAdditional)
        return Refuse(refusal, "", "IDS_RPS_PUSHOVER_Maxnum_reached");
    const auto listed = [&](const T_ADDITIONAL_POINT& p) { return p.spectrum == spectrum; };
    if (std::ranges::any_of(m_result.additionalPoints, listed))
        return Refuse(refusal, "", "IDS_QM_POINT_LISTED", {spectrum});
    if (m_result.IsTarget()) return Refuse(refusal, "", "IDS_QM_NO_ADDITIONAL_POINT");
    CPushEvaluator other(m_doc, m_procedure);
    other.SetFindAllPoints(false);
    T_EVAL_D settings = m_eval;
    settings.spectrum = spectrum;
    if (!other.SetEvaluation(settings, refusal)) {
        refusal.messageKey = "IDS_QM_SETTINGS";
        return 0;
    }
    const int result = other.Evaluate();
    m_result.additionalPoints.push_back(
        {spectrum, result, other.Result().point, other.Result().outcome});
    return 1;
}

void CPushEvaluator::ListStep(int step)
{
    const std::size_t i = m_result.IndexOf(step).value_or(0);
    const double Sd = m_result.capacity.Sd[i], Sa = m_result.capacity.Sa[i];
    T_ADDITIONAL_STEP row{step, Sd, Sa, Sd, Sa};
    TransferToDispAndReac(&row.D, &row.V);
    m_result.additionalSteps.push_back(row);
}
