// The hinges of a push on the picture of the frame.
#pragma once

#include "qm_rps/desk/framescene.h"
#include "qm_rps/push/pushrun.h"

/// A hinge component at its place on the frame.
struct T_HINGE_MARK {
    long line = -1;       // of the scene; -1: at the node
    std::size_t node = 0; // of a point spring
    double at = 0.0;      // fraction of the line, from I
    PUSH_STATE state = PUSH_STATE::Elastic;
    bool chosen = false;
    bool shown = true; // false: its element is hidden, or does not stand
};

struct T_HINGE_MARKS {
    std::vector<T_HINGE_MARK> hinges; // as those of the run
    std::array<bool, kPushStateNames.size()>
        occurs{}; // in any step, so that a legend keeps its lines
};

/// The places; all states elastic. A hinge on an element that is not in the scene has no place and
/// stands at the first node.
T_HINGE_MARKS PlaceHinges(const T_PUSH_RUN& run, const T_FRAME_SCENE& scene, const T_MODEL& model);
/// The states of a step, from 1.
void ShowStates(const T_PUSH_RUN& run, int step, long chosen, T_HINGE_MARKS& marks);

/// The hinges of the push that the frame is shown under. The document must outlive the object.
class CShownHinges {
public:
    explicit CShownHinges(CDBDoc& doc) : m_doc(doc) {}

    /// The states of a step, from 1; valid until the next call. Null: the source is no push of our
    /// own, or its results are older than the model, which then does not know the states.
    const T_HINGE_MARKS* Marks(const T_SHAPE_SOURCE& source, int step, const T_FRAME_SCENE& scene);
    /// The run whose states were given last.
    const T_PUSH_RUN& Run() const { return m_run; }

private:
    CDBDoc& m_doc;
    // What was read last.
    long m_revision = -1, m_variant = 0;
    int m_key = 0, m_turn = 0;
    T_PUSH_RUN m_run;
    T_HINGE_MARKS m_marks;
};
