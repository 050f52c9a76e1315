// Computes one evaluation: assembles the capacity curve of a pushover load case, runs the chosen
// method, stores the limit-state steps in the model, hands out the result.
//
// One evaluation is: SetEvaluation, Evaluate, Result. Nothing is shown: what there is to say stands
// in the result, and a refusal is handed back.
#pragma once

#include "qm_base/finding.h"
#include "qm_rps/pushover/evaluation/pushtargetinput.h"
#include "qm_rps/pushover/pushevaluation.h"

/// Most additional steps, and most additional performance points, that are kept.
inline constexpr std::size_t kMaxAdditional = 10;

/// What a performance-point procedure answers.
struct T_PERFPT_ANSWER {
    int result = 0; // 0 none, 1 found, 2 found and elastic
    double Sd = 0.0, Sa = 0.0;
    std::optional<double> betaEff; // per cent, where the procedure sets one
    std::vector<T_PERFPT_TRIAL> trace;
    std::optional<T_POINT2> slopeChange; // the first on the capacity spectrum
    T_ADRS_CURVE locus;                  // demand points, where the procedure has them itself
    T_OUTCOME outcome;
};

/// Runs a procedure (0 A, 1 B, 2 C) of a performance-point method on a record, which takes its
/// curves. Empty: the method has no such procedure.
using PERFPT_PROCEDURE = std::optional<T_PERFPT_ANSWER> (*)(PUSH_METHOD method, int procedure,
                                                            CPushOverPerfPtRecord& record);

class CPushEvaluator : public CPushOverPerfPtRecord {
public:
    /// The document is not owned and must outlive this object.
    CPushEvaluator(CDBDoc& doc, PERFPT_PROCEDURE procedure);

    /// Takes the settings of an evaluation. 1 taken; 0 its load case or spectrum does not exist or
    /// an option is out of range (refusal), settings as they were.
    [[nodiscard]] int SetEvaluation(const T_EVAL_D& evaluation, T_FINDING& refusal);

    /// Runs the evaluation. 0 no point or target, 1 found, 2 found and elastic; Result is filled
    /// in every case.
    int Evaluate();
    const T_PUSH_EVALUATION& Result() const { return m_result; }

    /// Whether limit-state steps are stored in the model (the default).
    void SetStoreSteps(bool store) { m_storeSteps = store; }
    /// Multiplies the ordinates of the demand spectra; above 0, 1 is the default.
    void SetSpectrumFactor(double factor);
    /// How the demand spectrum shows itself; Displacement is the default.
    void SetSpectrumShow(SPECTRUM_SHOW over) { m_spectrumShow = over; }
    /// Whether every point where demand equals capacity is looked for (the default).
    void SetFindAllPoints(bool find) { m_findAllPoints = find; }

    /// Performance point of the same evaluation with another spectrum, kept with the result. At
    /// most 10. 1 kept; 0 full, no such spectrum, or no performance-point method (refusal).
    [[nodiscard]] int CalcAdditionalPerformancePoint(const std::string& spectrum,
                                                     T_FINDING& refusal);
    /// Lists a step that is on the curve (T_PUSH_EVALUATION::IndexOf) beside the result.
    void ListStep(int step);

    /// Reads the result steps and builds the capacity spectrum. 1 done; 0 the outcome says why.
    [[nodiscard]] int CalcPushoverCurve();

    /// SDOF to MDOF; null arguments are left out. See CPushOverCurveData.
    void TransferToDispAndReac(double* displacement, double* reaction) const
    {
        m_curve.TransferToDispAndReac(displacement, reaction);
    }

    /// Gravity in current units: of the user spectrum where it states one and `fromSpectrum` is
    /// set, else of the model, else 9.80665 m/s2.
    double FindGravity(bool fromSpectrum) const;

    /// True when a hinge type of the model carries the masonry flag: evaluations that don't say
    /// otherwise are then evaluated as masonry.
    bool ExistEC8OrMasonry() const;

private:
    T_PUSH_CURVE_SETTINGS CurveSettings(PLOT_TYPE type) const;
    int UpdatePerformancePoint();
    T_TARGET_INPUT TargetInput(CStepDrift& drift) const;
    int UpdateTargetDispData();
    void TakeStepNumber(std::optional<int>& step) const;
    void StoreSteps(const std::vector<int>& steps);
    void ForgetSteps();
    T_PERF_POINT MakePoint(double Dp, double Ap, std::optional<double> beta) const;
    void KeepAllPoints();
    void PrepareSpectrum();
    void KeepStateDemands();
    int CheckCurve();
    int IsUsable();
    void WarnAboutCurve();
    void FillResult();
    void GiveUp();
    void PlotCurve();
    void TakePlot(const CPushOverCurveData& data);
    void Say(const char* key, std::initializer_list<std::string_view> values = {});
    int Fail(PUSH_OUTCOME code, const char* key);
    PLOT_TYPE MethodPlotType() const { return static_cast<PLOT_TYPE>(m_eval.method); }

    CDBDoc& m_doc;
    PERFPT_PROCEDURE m_procedure;
    T_EVAL_D m_eval;
    bool m_masonryGiven = false; // by the evaluation itself
    T_SPFC_D m_spectrumRecord;
    T_PUSH_NAME m_push; // load case, and which of its directions
    bool m_storeSteps = true;
    bool m_findAllPoints = true;
    CPushOverCurveData m_curve;
    // What the curve and the spectrum at hand were made from; both are kept while that stands.
    std::optional<T_PUSH_CURVE_SETTINGS> m_curveMade;
    long m_curveRevision = -1;
    std::optional<T_SPFC_D> m_spectrumMade;
    int m_spectrumBehavior = -1;
    double m_spectrumGravity = 0.0;
    double m_spectrumFactor = 1.0;
    SPECTRUM_SHOW m_spectrumShow = SPECTRUM_SHOW::Displacement;
    T_PUSH_EVALUATION m_result;
};
