// Model behind the pushover curve window: assembles the capacity curve of one pushover load case,
// runs the chosen method, stores the limit-state steps in the model, hands out the result.
//
// One evaluation is: SetEvaluation, Evaluate, Result. Nothing is shown but through messages.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"
#include "qm_rps/pushover/pushovertargetevaluation.h"
#include "qm_rps/pushoveradditionalstepdlg.h"
#include "qm_rps/pushovercalcperfptbase.h"

#include <memory>

/// The calculator of a performance-point method by the driver's procedure number: ATC-40 0 A, 1 B;
/// FEMA 440 0 A, 1 B (MADRS), 2 C. Null, and the release assertion, for any other number.
std::unique_ptr<CPushOverCalcPerfPtBase> MakePerfPtCalculator(PUSH_METHOD method, int procedure,
                                                              CPushOverPerfPtRecord& owner);

class CPushOverCurveDlg : public zql::frx::MDialog, public CPushOverPerfPtRecord {
public:
    /// The document is not owned and must outlive the dialog.
    explicit CPushOverCurveDlg(CDBDoc& doc);

    /// Takes the settings of an evaluation. 1 taken; 0 its load case or spectrum does not exist
    /// (SettingsError names it) or an option is out of range, settings as they were.
    [[nodiscard]] int SetEvaluation(const T_EVAL_D& evaluation);
    const std::string& SettingsError() const { return m_settingsError; }

    /// Runs the evaluation. 0 no point or target, 1 found, 2 found and elastic; Result is filled
    /// in every case.
    int Evaluate();
    const T_PUSH_EVALUATION& Result() const { return m_result; }

    /// Whether limit-state steps are stored in the model (the default).
    void SetStoreSteps(bool store) { m_storeSteps = store; }

    /// Whether every point where demand equals capacity is looked for (the default).
    void SetFindAllPoints(bool find) { m_findAllPoints = find; }

    /// Performance point of the same evaluation with another spectrum, kept with the result. At
    /// most 10 (IDS_RPS_PUSHOVER_Maxnum_reached). 1 kept; 0 full, no such spectrum, or no
    /// performance-point method.
    [[nodiscard]] int CalcAdditionalPerformancePoint(const std::string& spectrum);
    /// Lists a step beside the result; see CPushOverAdditionalStepDlg::AddStep. After Evaluate.
    [[nodiscard]] int OnPushoverCurveAddStep(int step);

    /// Reads the result steps and builds the capacity spectrum. 1 done; 0 the outcome says why.
    [[nodiscard]] int CalcPushoverCurve();

    /// SDOF to MDOF; null arguments are left out. See CPushOverCurveData.
    void TransferToDispAndReac(double* displacement, double* reaction) const
    {
        m_curve.TransferToDispAndReac(displacement, reaction);
    }

    /// Gravity in current units: of the user spectrum where it states one and `fromSpectrum` is
    /// set, else of the model, else 9.80665 m/s2.
    double GetGravity(int fromSpectrum) const;

    /// The cells of the performance point: "%6.4g,  %6.4g", "Elastic(...)" for an elastic point.
    std::string PerfPointCell() const;

    /// True when a hinge type of the model carries the masonry flag: evaluations that don't say
    /// otherwise are then evaluated as masonry.
    bool ExistEC8OrMasonry() const;

    /// Obsolete; asserts and returns 0, on purpose.
    int ExistEC8() const;

private:
    int CheckPages(const T_EVAL_D& evaluation);
    int UpdatePerformancePoint();
    int UpdateTargetDispData();
    T_TARGET_INPUT TargetInput();
    T_BILINEAR_OPTIONS BilinearOptions() const;
    std::optional<double> DriftOfStep(int step);
    void StoreSteps(const CPushOverTargetEvaluation& evaluation);
    T_PERF_POINT MakePoint(double Dp, double Ap, std::optional<double> beta) const;
    void KeepAllPoints();
    void PrepareSpectrum();
    void KeepStateDemands();
    int CheckCurve();
    void WarnAboutCurve();
    void FillResult();
    void PlotCurve();
    int Fail(PUSH_OUTCOME code, const char* key);
    PLOT_TYPE MethodPlotType() const { return static_cast<PLOT_TYPE>(m_eval.method); }

    CDBDoc& m_doc;
    T_EVAL_D m_eval;
    T_SPFC_D m_spectrumRecord;
    int m_pushover = 0;
    bool m_storeSteps = true;
    bool m_findAllPoints = true;
    bool m_driftMissing = false, m_driftUsed = false;
    CPushOverCurveData m_curve;
    CPushOverAdditionalStepDlg m_additionalSteps;
    // What the curve and the spectrum at hand were made from; both are kept while that stands.
    std::optional<T_PUSH_CURVE_SETTINGS> m_curveMade;
    long m_curveRevision = -1;
    std::optional<T_SPFC_D> m_spectrumMade;
    int m_spectrumBehavior = -1;
    double m_spectrumGravity = 0.0;
    T_PUSH_EVALUATION m_result;
    std::string m_settingsError;
};
