// Model behind the pushover curve window: one evaluation of one pushover load case, with what there
// is to say about it.
//
// One evaluation is: SetEvaluation, Evaluate, Result. The computation itself knows no dialog: see
// CPushEvaluator.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/pushover/evaluation/pushevaluator.h"
#include "qm_rps/pushoveradditionalstepdlg.h"

class CPushOverCurveDlg : public zql::frx::MDialog {
public:
    /// The document is not owned and must outlive the dialog.
    explicit CPushOverCurveDlg(CDBDoc& doc);

    /// Takes the settings of an evaluation. 1 taken; 0 its load case or spectrum does not exist or
    /// an option is out of range (Refusal), settings as they were.
    [[nodiscard]] int SetEvaluation(const T_EVAL_D& evaluation);

    /// Runs the evaluation and shows its messages. 0 no point or target, 1 found, 2 found and
    /// elastic; Result is filled in every case.
    int Evaluate();
    const T_PUSH_EVALUATION& Result() const { return m_evaluator.Result(); }
    /// Whether an evaluation that doesn't say is one of masonry in this model.
    bool ExistEC8OrMasonry() const { return m_evaluator.ExistEC8OrMasonry(); }

    /// Whether limit-state steps are stored in the model (the default).
    void SetStoreSteps(bool store) { m_evaluator.SetStoreSteps(store); }
    /// How the demand spectrum shows itself in a picture of its own.
    void SetSpectrumShow(SPECTRUM_SHOW over) { m_evaluator.SetSpectrumShow(over); }
    /// Whether every point where demand equals capacity is looked for (the default).
    void SetFindAllPoints(bool find) { m_evaluator.SetFindAllPoints(find); }

    /// Performance point of the same evaluation with another spectrum, kept with the result. At
    /// most 10 (IDS_RPS_PUSHOVER_Maxnum_reached). 1 kept; 0 full, no such spectrum, or no
    /// performance-point method: Refusal, which is shown too.
    [[nodiscard]] int CalcAdditionalPerformancePoint(const std::string& spectrum);
    /// Lists a step beside the result; see CPushOverAdditionalStepDlg::AddStep. After Evaluate.
    [[nodiscard]] int OnPushoverCurveAddStep(int step);

    /// Why the latest of these operations was refused.
    const T_FINDING& Refusal() const { return m_refusal; }

    /// SDOF to MDOF; null arguments are left out. See CPushOverCurveData.
    void TransferToDispAndReac(double* displacement, double* reaction) const
    {
        m_evaluator.TransferToDispAndReac(displacement, reaction);
    }

    /// Gravity in current units: of the user spectrum where it states one and `fromSpectrum` is
    /// set, else of the model, else 9.80665 m/s2.
    double GetGravity(int fromSpectrum) const { return m_evaluator.FindGravity(fromSpectrum != 0); }

    /// Obsolete; asserts and returns 0, on purpose.
    int ExistEC8() const;

private:
    int ShowRefusal();

    CPushEvaluator m_evaluator;
    CPushOverAdditionalStepDlg m_additionalSteps;
    T_FINDING m_refusal;
};
