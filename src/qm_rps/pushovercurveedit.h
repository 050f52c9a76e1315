// Model behind the pushover curve window: the evaluation being edited, what its fields offer, the
// rules of its pages, and the result that is on show. Every change is evaluated at once (Update).
//
// The document changes only by OnStore and OnStoreSteps. Settings that can't be evaluated leave the
// last picture and values, with the reason.
#pragma once

#include "qm_base/finding.h"
#include "qm_rps/pushover/pushovercells.h"
#include "qm_rps/pushovercurvedlg.h"

/// What of a picture is drawn. Guide lines hides all three kinds.
struct T_PUSH_SHOW {
    bool guideLines = true;
    bool demandLines = true, capacityLines = true, qStarLine = true;
    bool symbols = true; // of the trials and demand points
    bool operator==(const T_PUSH_SHOW&) const = default;
};

class CPushOverCurveEdit : public zql::frx::MDialog {
public:
    /// Starts with the document's first evaluation, or a new one. The document must outlive this.
    explicit CPushOverCurveEdit(CDBDoc& doc);

    // ---- what is edited; call Update after a change ----
    T_EVAL_D m_settings;
    T_PUSH_SHOW m_show;
    int m_addStep = 1;         // to be listed by OnAddStep
    std::string m_addSpectrum; // likewise, by OnAddPoint

    // ---- what the fields offer ----
    std::vector<std::string> LoadCases() const;
    std::vector<std::string> Spectra() const;
    std::vector<std::string> Evaluations() const;
    /// Names of the methods, FEMA 440 first, in the order of their codes.
    static std::vector<std::string> Methods();
    std::vector<std::string> Procedures() const; // none for target displacements
    /// ATC-40: structural behaviour; FEMA 440: hysteresis model.
    std::vector<std::string> Behaviors() const;
    static std::vector<std::string> PlotTypes(); // by code 0 to 8
    bool IsTarget() const { return m_settings.method >= PUSH_METHOD::Ec8Opcm; }
    /// Kappa by the person's own points: ATC-40 with the user-defined behaviour.
    bool HasUserDamping() const;
    /// The three factors of the bilinear page in the settings; made on the first call.
    T_EVAL_BILINEAR& Bilinear();

    /// Another method: the procedure becomes one that it offers, the plot its own.
    void ChangeMethod(PUSH_METHOD method);

    // ---- operations; each evaluates again ----
    /// The settings of a stored evaluation. 0 there is none of that name.
    [[nodiscard]] int OnOpen(const std::string& evaluation);
    /// Defaults, for the same load case and spectrum.
    void OnNew();
    /// Evaluates the settings. 1 the result is of these settings; 0 they are refused (Findings,
    /// Refusal), result as it was.
    int Update();
    /// The person has changed something: evaluates where it changes the result.
    void OnEdited();
    /// To be called now and then: takes up what has changed in the document. 1 something had.
    int OnDocumentChanged();
    /// The points of kappa in their own window. 1 taken.
    int OnUserDamping();
    /// Keeps the settings in the document under their name, as one edit; asks before it replaces
    /// another evaluation. 0 with a message: no name, settings refused, the person said no.
    [[nodiscard]] int OnStore();
    /// Stores the limit-state steps of the result for the load case. 0 with a message: there are
    /// none to store.
    [[nodiscard]] int OnStoreSteps();
    /// Previews of the report and of the curve table, from where they are saved.
    void OnPushoverCurveTextout();
    void OnCurveText();
    /// Every method on the load case and spectrum of the settings.
    void OnCompare();
    /// Asks for the name of a file of the kind that the filter (a key) names; empty: cancelled.
    std::string AskPath(const char* filterKey) const;
    std::function<std::string(const char* filterKey)> m_askPath;
    /// Says that a picture could not be written or printed, and why.
    void SayNotWritten(const std::string& why) { ShowMessage("IDS_QM_UI_FILE_REFUSED", why); }
    /// Lists a step, or a point of another spectrum, with each evaluation from now on. 0 with a
    /// message (see CPushOverCurveDlg).
    int OnAddStep();
    int OnAddPoint();
    void OnRemoveStep(int row);
    void OnRemovePoint(int row);
    int m_stepRow = -1, m_pointRow = -1; // chosen in the lists

    // ---- what is on show ----
    /// Latest result; its values and messages.
    const T_PUSH_EVALUATION& Result() const { return m_result; }
    /// The result that the picture is of: the latest one with a curve.
    const T_PUSH_EVALUATION& Pictured() const { return m_pictured; }
    /// Why picture or values are not of the settings; empty: they are.
    std::string Refusal() const;
    const std::vector<T_FINDING>& Findings() const { return m_findings; }
    /// The trial pointed out in the picture, from 1; 0: none.
    int Trial() const { return m_trial; }
    void SetTrial(int trial); // limited to those that there are
    int TrialCount() const { return static_cast<int>(m_pictured.trace.size()); }
    /// Title and pattern of the load case: control node, direction, master load pattern.
    std::string CaseText() const;
    /// Steps that the document holds for the load case.
    std::string StoredStepsText() const;

    /// Called after the document was changed from here.
    std::function<void()> m_changed;

private:
    void Start();
    int Evaluate(bool storeSteps);
    void CheckSettings();
    void AddFinding(const char* field, const std::string& text);
    void CheckPage(const char* field, zql::frx::MDialog& page);
    void ListAgain();
    bool HasPicture(const T_PUSH_EVALUATION& e) const;
    int Say(const char* key);
    void ShowText(const char* titleKey, std::string text);

    CDBDoc& m_doc;
    CPushOverCurveDlg m_driver;
    T_EVAL_D m_evaluated; // settings of the latest evaluation, refused ones too
    T_PUSH_EVALUATION m_result, m_pictured;
    std::vector<T_FINDING> m_findings;
    std::string m_refusal;   // of the settings
    std::string m_noPicture; // of the result
    std::vector<int> m_steps;
    std::vector<std::string> m_points;
    long m_revision = -1;
    int m_trial = 0;
};
