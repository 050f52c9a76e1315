// Model behind the pushover curve window: the evaluation being edited and what it gives. Every
// change is evaluated at once. The fields stand on the pages, the result and its picture in Shown.
//
// The document changes only by OnStore, OnKeep and OnStoreSteps. Settings that can't be evaluated
// leave the last picture and values, with the reason.
#pragma once

#include "qm_rps/push/pushrun.h"
#include "qm_rps/pushover/report/shownevaluation.h"
#include "qm_rps/pushovercurvedlg.h"
#include "qm_rps/pushovercurvesub1dlg.h"
#include "qm_rps/pushovercurvesub2dlg.h"
#include "qm_rps/pushovercurvesub4dlg.h"

#include <functional>

/// What of a picture is drawn. Guide lines hides all three kinds.
struct T_PUSH_SHOW {
    bool guideLines = true;
    bool demandLines = true, capacityLines = true, qStarLine = true;
    bool symbols = true;                                // of the trials and demand points
    SPECTRUM_SHOW spectrumOver = SPECTRUM_SHOW::Period; // in the picture of the demand alone
    bool operator==(const T_PUSH_SHOW&) const = default;
};

class CPushOverCurveEdit : public zql::frx::MDialog {
public:
    /// Starts with the document's first evaluation, or a new one. The document must outlive this.
    explicit CPushOverCurveEdit(CDBDoc& doc);

    // ---- what is edited; call OnEdited after a change ----
    T_EVAL_D m_settings;
    CPushOverCurveSub1Dlg m_methodPage;
    CPushOverCurveSub2Dlg m_demandPage;
    CPushOverCurveSub4Dlg m_bilinearPage;
    T_PUSH_SHOW m_show;
    int m_addStep = 1;                   // to be listed by OnAddStep
    std::string m_addSpectrum;           // likewise, by OnAddPoint
    int m_stepRow = -1, m_pointRow = -1; // chosen in the lists

    /// Names of those of the document.
    std::vector<std::string> Evaluations() const;

    // ---- operations; each evaluates again ----
    /// The settings of a stored evaluation. 0 there is none of that name.
    [[nodiscard]] int OnOpen(const std::string& evaluation);
    /// The settings of one direction of a load case that is pushed in several, as EvaluationsOf
    /// gives them; they are stored under another name only.
    void OnOpenTurned(const T_EVAL_D& evaluation);
    /// Name of the stored evaluation that is edited; empty: none, it is a new one.
    const std::string& Opened() const { return m_opened; }
    /// Whether the settings differ from what is stored, or from those of a new evaluation.
    bool HasUnsaved() const;
    /// Defaults, for the same load case and spectrum.
    void OnNew();
    /// Evaluates the settings. 1 the result is of these settings; 0 they are refused (Findings,
    /// Shown), result as it was.
    int Update();
    /// The person has changed something: evaluates where it changes the result.
    void OnEdited();
    /// To be called now and then: takes up what has changed in the document. 1 something had.
    int OnDocumentChanged();
    /// The points of kappa, the control options and the additional steps in their own windows. 1
    /// taken.
    int OnUserDamping();
    int OnControl();
    int OnSteps();
    /// Keeps the settings in the document under their name, as one edit; asks before it replaces
    /// another evaluation. 0 with a message: no name, settings refused, the person said no.
    [[nodiscard]] int OnStore();
    /// Keeps what was changed of the opened evaluation, as one edit. 1 kept; 0 nothing was changed,
    /// the settings are refused, or bear another name (that is for OnStore).
    int OnKeep();
    /// Stores the limit-state steps of the result for the load case. 0 with a message: there are
    /// none to store.
    [[nodiscard]] int OnStoreSteps();
    /// Lists a step, or a point of another spectrum, with each evaluation from now on. 0 with a
    /// message (see CPushOverCurveDlg).
    int OnAddStep();
    int OnAddPoint();
    void OnRemoveStep(int row);
    void OnRemovePoint(int row);

    // ---- other windows and files ----
    /// Previews of the report and of the curve table, from where they are saved.
    void OnPushoverCurveTextout();
    void OnCurveText();
    /// The hinges at the points of the result, in their window. 0 with a message why not.
    int OnHinges();
    /// Every member end judged at them, likewise.
    int OnJudge();
    /// Every method on the load case and spectrum of the settings.
    void OnCompare();
    /// Asks for the name of a file of the kind that the filter (a key) names; empty: cancelled.
    std::string AskPath(const char* filterKey) const;
    std::function<std::string(const char* filterKey)> m_askPath;
    /// Runs a push with a window that shows its progress and can stop it; empty: it runs without.
    using PUSHING_FN = std::function<void(const PUSH_PROGRESS_FN&)>;
    std::function<void(const PUSHING_FN& pushing)> m_withProgress;
    /// Says that a picture could not be written or printed, and why.
    void SayNotWritten(const std::string& why) { ShowMessage("IDS_QM_UI_FILE_REFUSED", why); }

    // ---- what is on show ----
    /// Whether the settings are of masonry: as they say, else as the hinge types of the model do.
    bool IsMasonry() const { return m_settings.masonry.value_or(m_driver.ExistEC8OrMasonry()); }
    CShownEvaluation& Shown() { return m_shown; }
    const CShownEvaluation& Shown() const { return m_shown; }
    const std::vector<T_FINDING>& Findings() const { return m_findings; }
    /// Steps that the document holds for the load case.
    std::string StoredStepsText() const;

    /// Called after the document was changed from here.
    std::function<void()> m_changed;

protected:
    /// The first stored evaluation, else a new one.
    void Start();
    /// Of the stored evaluation with this name; 0: there is none.
    int KeyOf(const std::string& name) const;
    void Pushing(const PUSHING_FN& pushing) const;

    CDBDoc& m_doc;

private:
    int Put(int key);
    void ReadAgain();
    int Evaluate(bool storeSteps);
    void ListAgain();
    int Say(const char* key);
    int SayRefusal();
    /// A window at the points of the result, which `fill` pushes to. 0 with a message why not.
    template <class DIALOG, class FILL>
    int ShowAtPoints(FILL fill);
    void ShowText(const char* titleKey, std::string text);

    CPushOverCurveDlg m_driver;
    CShownEvaluation m_shown;
    SPECTRUM_SHOW m_evaluatedShow = SPECTRUM_SHOW::Displacement;
    std::string m_opened;
    T_EVAL_D m_stored;    // of the opened evaluation, or as a new one began
    T_EVAL_D m_evaluated; // settings of the latest evaluation, refused ones too
    std::vector<T_FINDING> m_findings;
    std::vector<int> m_steps;
    std::vector<std::string> m_points;
    long m_revision = -1;
};
