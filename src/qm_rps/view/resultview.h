// What the view of the frame shows, without any window: the source, the step, which quantity and
// how. Window, picture command and report draw from it.
#pragma once

#include "qm_rps/desk/hingemarks.h"
#include "qm_rps/desk/selection.h"
#include "qm_rps/view/loadmarks.h"
#include "qm_rps/view/stress.h"

enum class VIEW_WHAT { Deformed, N, Vy, Vz, T, My, Mz, Reactions, Loads, Hinges, Stress };
inline constexpr std::size_t kViewWhats = 11;
/// As commands name them.
inline constexpr std::array<const char*, kViewWhats> kViewWhatNames{
    "deformed", "N", "Vy", "Vz", "T", "My", "Mz", "reactions", "loads", "hinges", "stress"};
/// In the user's language.
std::string ViewWhatText(VIEW_WHAT what);

/// Numbers beside what is drawn: none; the largest and the smallest of the picture; those of each
/// member; the ends of the members, too.
enum class VIEW_LABELS { None, Largest, Member, All };
inline constexpr std::size_t kViewLabels = 4;
inline constexpr std::array<const char*, kViewLabels> kViewLabelNames{"none", "largest", "member",
                                                                      "all"};

struct T_VIEW_CHOICE {
    VIEW_WHAT what = VIEW_WHAT::Deformed;
    VIEW_LABELS labels = VIEW_LABELS::Member;
    bool onDeformed = false, filled = true; // of diagrams
    std::optional<double> scale{};          // of the displacements; empty: one that suits
    double size = 1.0;                      // of diagrams and arrows, times the one that suits
    bool operator==(const T_VIEW_CHOICE&) const = default;
};

/// Base reaction over the displacement of the control, step by step.
struct T_VIEW_CURVE {
    std::vector<double> displacement, reaction; // current units; index 0 is step 1
    std::string forceUnit, lengthUnit;
};

/// Document, scene and selection must outlive the object. What it gives is valid until the next
/// call of one of its handlers.
class CResultView {
public:
    CResultView(CDBDoc& doc, CFrameScene& scene, const CSelection& selection);

    /// The document has changed: everything again; source and step stay where they can.
    void Refresh();
    /// Other elements are hidden.
    void OnHidden();
    const std::vector<T_SHAPE_SOURCE>& Sources() const { return m_sources; }
    std::size_t SourceIndex() const { return m_at; }
    const T_SHAPE_SOURCE& Source() const { return m_sources[m_at]; }
    int Step() const { return m_step; }
    int Steps() const { return std::max(Source().steps, 1); }
    const T_VIEW_CHOICE& Choice() const { return m_choice; }

    /// The source at its last step.
    void OnSource(std::size_t index);
    void OnStep(int step);
    void OnChoice(const T_VIEW_CHOICE& choice);
    /// 1 shown; 0 there is no such source.
    [[nodiscard]] int OnShow(const T_SHAPE_SOURCE& source, int step);

    /// Without what is hidden.
    const T_FRAME_SCENE& Scene() const { return *m_scene; }
    /// Translations by node, current units; null: none are shown.
    const std::vector<std::array<double, 3>>* Moves() const;
    double Scale() const { return m_scale; }
    const T_BENT_LINES* Bent() const { return Moves() && m_bent.parts ? &m_bent : nullptr; }
    const T_DIAGRAM* Diagram() const { return m_diagram.members.empty() ? nullptr : &m_diagram; }
    const T_LOAD_MARKS* Marks() const { return m_marks.IsEmpty() ? nullptr : &m_marks; }
    const T_STRESS_PICTURE* Stress() const { return m_stress.lines.empty() ? nullptr : &m_stress; }
    const T_HINGE_MARKS* Hinges() const { return m_hingeMarks; }
    std::vector<T_SCENE_DRIFT> Drifts() const;
    /// Source, step and what is shown; what holds for the picture, or why something is not in it.
    std::string Subtitle() const;
    std::string Note() const;
    /// Why what was asked for is not there; empty: it is.
    const std::string& Missing() const { return m_missing; }
    /// Of a push; empty of others.
    const T_VIEW_CURVE& Curve() const { return m_curve; }
    static std::string NameOf(const T_SHAPE_SOURCE& source);

private:
    void ShowSource();
    void Show();
    void ReadMoves(const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads, bool hasFrame);
    void ReadQuantity(const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads);
    void ReadCurve();
    std::vector<std::string> Facts() const;
    std::string DiagramFacts() const;

    CDBDoc& m_doc;
    CFrameScene& m_source;
    const CSelection& m_selection;
    CViewFrame m_frame;
    CShownHinges m_hinges;
    std::vector<T_SHAPE_SOURCE> m_sources{{}};
    std::size_t m_at = 0;
    int m_step = 1;
    T_VIEW_CHOICE m_choice;
    double m_scale = 1.0;
    const T_FRAME_SCENE* m_scene = nullptr;
    std::vector<std::array<double, 3>> m_moves;
    bool m_hasMoves = false;
    T_BENT_LINES m_bent;
    T_DIAGRAM m_diagram;
    T_LOAD_MARKS m_marks;
    T_STRESS_PICTURE m_stress;
    const T_HINGE_MARKS* m_hingeMarks = nullptr;
    T_VIEW_CURVE m_curve;
    std::string m_missing;
};
