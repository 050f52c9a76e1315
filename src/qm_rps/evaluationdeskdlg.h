// Model of the evaluation window: the list of the model's evaluations with their verdicts, those of
// them that are overlaid, the one that is edited, and how its picture is seen.
//
// An edit of a stored evaluation is evaluated at once and kept as a step that can be undone; a new
// one is kept when it is stored. What is refused leaves the stored evaluation as it was.
#pragma once

#include "qm_rps/pushover/overview/evaluationcards.h"
#include "qm_rps/pushover/overview/plotregion.h"
#include "qm_rps/pushovercurveedit.h"
#include "qm_rps/pushoverhingestatedlg.h"

#include <set>

/// How the picture is seen: ranges and units by the person. It belongs to the window, not to the
/// model. Empty: as the program chooses.
struct T_DESK_AXES {
    std::optional<double> xFrom{}, xTo{}, yFrom{}, yTo{}; // in the units that are shown
    std::optional<LENGTH_UNIT> length{};
    std::optional<FORCE_UNIT> force{};
    bool whole = false; // the whole curve, not the region of demand and points
    bool operator==(const T_DESK_AXES&) const = default;
};

/// An axis from here to there; an end that is empty is that of the whole picture.
struct T_AXIS_SPAN {
    std::optional<double> lo{}, hi{};
    bool operator==(const T_AXIS_SPAN&) const = default;
};

class CEvaluationDeskDlg : public CPushOverCurveEdit {
public:
    /// Opens the document's first evaluation, or a new one. The document must outlive this.
    explicit CEvaluationDeskDlg(CDBDoc& doc) : CPushOverCurveEdit(doc) {}

    // ---- the list ----
    /// Every evaluation, in the units shown; the chosen row is what is edited, also where that is
    /// not stored. Valid until something is edited.
    const std::vector<T_EVALUATION_ENTRY>& List();
    int Chosen(); // row
    /// Opens another one; asks about what would be lost.
    void OnChoose(int row);
    bool IsTicked(int row);
    void OnTick(int row, bool on);
    /// A new one, of the same load case and spectrum; asks about what would be lost.
    void OnFresh();
    /// Deletes the opened one from the model, as a step that can be undone. 0: it is not stored.
    int OnDelete();
    /// Asked before the window closes: offers to store what is not. 1 it may close.
    [[nodiscard]] int OnClose();
    /// Asked where something was typed that can't be read. 1 it may be lost.
    [[nodiscard]] int OnDropTyped() { return AskYesNo("IDS_QM_UI_DROP_CHANGES") ? 1 : 0; }

    // ---- what the person has changed ----
    /// After an edit that is complete: evaluates, and keeps it where the evaluation is stored.
    void OnTaken();
    /// To be called now and then: takes up what has changed in the document. 1 something had.
    int Follow();

    /// Opens the spectrum of the settings in its window; results follow what is stored there. 1
    /// the window was left with its changes stored.
    int OnSpectrum();

    // ---- what is on show, in the units shown ----
    T_UNITS ShownUnits() const;
    const T_PUSH_EVALUATION& Result();
    const T_PUSH_EVALUATION& Pictured();
    const T_EVALUATION_ENTRY& Entry(); // the chosen row
    const T_SPFC_D* Spectrum() const;  // of the settings; null: there is none such
    /// The ticked ones where two or more have a curve, else none: the chosen one is shown alone.
    std::vector<const T_PUSH_EVALUATION*> Overlaid();
    /// For bars and table of the comparison: the ticked ones, without any all.
    std::vector<T_EVALUATION_ENTRY> Compared();
    CARD m_bars = CARD::D; // what the bars show

    // ---- axes ----
    T_DESK_AXES m_axes;
    /// Of the settings and of the axes: "axes.x" where an axis ends before it begins.
    std::vector<T_FINDING> AllFindings() const;
    T_AXIS_SPAN XSpan();
    T_AXIS_SPAN YSpan();

    // ---- the frame at the point ----
    bool IsFrameShown() const { return m_isFrameShown; }
    void OnShowFrame(bool on);
    /// The push at the answer; null where it is not known: FrameNote says why.
    CPushOverHingeStateDlg* Frame() { return m_frame.get(); }
    const std::string& FrameNote() const { return m_frameNote; }

private:
    /// What the list at hand was made from.
    struct T_MADE {
        long revision = -1, turn = -1;
        T_UNITS units;
        std::string opened;
        bool operator==(const T_MADE&) const = default;
    };
    T_MADE Now() const;
    void Make();
    T_EVALUATION_ENTRY EntryFor(const T_EVAL_D& eval);
    std::optional<T_PLOT_REGION> Region();
    bool MayLeave();
    void UpdateFrame();

    std::vector<T_EVALUATION_ENTRY> m_entries, m_shown; // in units of the model, and as shown
    T_PUSH_EVALUATION m_result, m_pictured;
    T_MADE m_made;
    int m_chosen = 0;
    std::set<std::string> m_ticked; // names
    bool m_isFrameShown = false;
    long m_frameTurn = -1, m_frameRevision = -1;
    std::unique_ptr<CPushOverHingeStateDlg> m_frame, m_frameBefore; // a view may show it still
    std::string m_frameNote;
};
