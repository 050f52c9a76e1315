// One run of a push: initial loads, stages, stored steps, stops.
#pragma once

#include "qm_solver/push/pushpath.h"

namespace solver {

class CPushRun {
public:
    using T_FAULT = std::optional<T_SOLVER_ERROR>;

    CPushRun(const T_PUSH_MODEL& model, CPushStructure& structure, const T_PUSH_SINK& sink)
        : m_model(model), m_structure(structure), m_sink(sink)
    {
    }
    T_FAULT Go(std::span<const T_PUSH_STAGE> stages, T_PUSH_END& end);
    /// State of the last step that was given to the sink with this load factor and stage.
    const T_PUSH_STATE* StateOf(const T_PUSH_STEP& step) const;

private:
    struct T_TARGET {
        double value;
        bool additional;
    };
    struct T_PEAK {
        double reaction = 0.0, first = 0.0; // largest reaction; first tangent
    };

    bool IsUpdated() const { return m_model.pDelta == P_DELTA::Updated; }
    T_FAULT Initial(T_PUSH_END& end, bool& goesOn);
    T_FAULT InitialPath(T_PUSH_END& end, bool& goesOn);
    T_FAULT Stage(T_PUSH_STAGE stage, std::size_t number, T_PUSH_END& end, bool& goesOn);
    T_FAULT Follow(const T_PUSH_STAGE& stage, int number, T_PUSH_END& end);
    T_FAULT GiveStart(std::size_t number);
    void MakeTargets(const T_PUSH_STAGE& stage);
    std::size_t PresentWatch() const;
    double Present(const T_PUSH_STAGE& stage) const;
    double ToTarget(const T_PUSH_STAGE& stage) const;
    double ToStop(const T_PUSH_STAGE& stage, T_PUSH_END& end) const;
    double ToExtra(std::size_t& found) const;
    double ToReturn(const T_PUSH_STAGE& stage) const;
    bool IsBehind(const T_PUSH_STAGE& stage) const;
    bool StopsAtHinge(const T_PUSH_STOPS& stops, T_PUSH_END& end) const;
    bool StopsHere(const T_PUSH_STAGE& stage, T_PUSH_END& end);
    double Reaction(const T_PUSH_STAGE& stage) const;
    double ReactionRate(const T_PUSH_STAGE& stage) const;
    T_VEC6 Base() const;
    void NoteEvent(int number);
    bool IsStored(double displacement) const;
    T_FAULT Store(const T_PUSH_STAGE& stage, int number, bool additional, T_PUSH_END& end);
    T_FAULT Update(const T_PUSH_STAGE& stage, std::optional<double> control);
    T_FAULT Approach(const T_PUSH_STAGE& stage, double by);
    CPushPath::WAY Leap(const T_PUSH_STAGE& stage, int number, T_PUSH_END& end, T_FAULT& fault);
    bool StopsBehindLeap(const T_PUSH_STAGE& stage, int number, T_PUSH_END& end);
    T_FAULT Flush(T_PUSH_END& end);

    const T_PUSH_MODEL& m_model;
    CPushStructure& m_structure;
    const T_PUSH_SINK& m_sink;
    std::unique_ptr<CPushPath> m_path;
    struct T_FOLLOWED {
        std::size_t node = 0;
        T_VEC6 way{};
    };
    T_FOLLOWED m_follows;                 // what the initial loads are told by
    std::vector<std::size_t> m_nodeWatch; // translations in the direction of control
    std::optional<std::size_t> m_held;    // the one that borders the system
    std::vector<std::array<std::size_t, 2>> m_driftWatch;
    std::size_t m_controlWatch = 0; // displacement of the control node
    std::vector<double> m_extra;    // of it, where something else controls: further steps
    std::vector<T_TARGET> m_targets;
    std::size_t m_target = 0;
    double m_start = 0.0, m_sign = 1.0;
    double m_stored = 0.0;            // load factor of the last stored step
    std::optional<double> m_storedAt; // its displacement; empty: none in this stage
    double m_far = 0.0;               // furthest control displacement of the stage
    double m_origin = 0.0;            // control displacement before the first stage
    bool m_isFirst = true;
    T_PEAK m_peak;
    std::vector<T_PUSH_EVENT> m_events;                // of the initial loads, until they are final
    std::vector<T_PUSH_STEP> m_steps;                  // waiting for their displacements
    std::vector<T_PUSH_STATE> m_states, m_wholeStates; // of the structure as it is, as it was given
    struct T_KEPT {
        std::size_t stage;
        double loadFactor, displacement;
        T_PUSH_STATE state;
    };
    std::vector<T_KEPT> m_kept; // of the steps that were handed on
    bool m_cancelled = false;
    bool m_hasLept = false; // here, or in a stage before
    std::size_t m_eventCount = 0;
};

} // namespace solver
