// Takes what the engine gives while a push goes on, in the model's ids.
#pragma once

#include "qm_db/results/pushprint.h"
#include "qm_solver/pushresult.h"

#include <span>

/// What was done by then can be taken at any time: a run that is cancelled keeps its steps.
class CPushRecorder {
public:
    /// head: turn, angle and control direction; its print is taken from the model. Ids by the
    /// engine's indices, nodes ascending.
    CPushRecorder(const T_MODEL& model, int loadCase, T_RUN_HEAD head,
                  const solver::T_PUSH_MODEL& engine, std::span<const int> nodes,
                  std::span<const int> elements);

    /// The state before the first step.
    void Start(const solver::T_PUSH_STEP& step);
    /// evaluated: see T_RUN_STEP.
    void Add(const solver::T_PUSH_STEP& step, bool evaluated = false);
    void Add(const solver::T_PUSH_EVENT& event);
    /// storey: the one whose drift ended it, from 1; 0: none.
    void End(const solver::T_PUSH_END& end, int storey = 0);

    const T_RUN_DATA& Data() const { return m_data; }
    T_RUN_DATA Take() { return std::move(m_data); }

private:
    double BaseReaction(const T_DOF6& base) const;

    T_RUN_DATA m_data;
    std::vector<std::size_t> m_hinge; // of each component: its hinge in the engine
    std::vector<int> m_first;         // of each hinge: its first component
    std::vector<int> m_element;       // of each hinge: the id of its element
};
