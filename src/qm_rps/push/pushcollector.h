// Collects what the engine tells while a load case is pushed.
#pragma once

#include "qm_rps/push/pushrun.h"

#include <algorithm>

/// Steps and events of the last stage become the results of the case.
class CPushCollector {
public:
    CPushCollector(const T_MODEL& model, const CAnalysisModel& frame, const T_PUSH_HINGES& hinges,
                   const T_PUSH_CASE& c);

    /// Load factors at the ends of the stages before the case, where their steps are not told.
    void SetFactorsBefore(const std::vector<double>& factors)
    {
        std::ranges::copy(factors, m_factors.begin());
    }
    /// The state before the first step of a stage.
    void Start(const solver::T_PUSH_STEP& step);
    /// True: the step is one of the case.
    bool Take(const solver::T_PUSH_STEP& step);
    void Take(const solver::T_PUSH_EVENT& event);
    const T_PUSH_RUN& SoFar() const { return m_run; }
    /// storey: whose drift ended it, from 1, where the end does not tell (0).
    T_PUSH_RUN Finish(solver::T_PUSH_END end, int storey = 0);

private:
    static T_RUN_HEAD HeadOf(const T_PUSH_CASE& c);
    double Along(const solver::T_VEC6& v) const;
    bool IsEvaluated(double displacement) const;
    bool IsBeyondLastStep(const T_PUSH_EVENT_ROW& event) const;
    void EndAtLastStep();
    void TakeStoreys(const solver::T_PUSH_STEP& step);
    std::string HingeWords(long hinge) const;
    std::string PlaceWords(const solver::T_PUSH_END& end, int storey) const;

    const solver::T_FRAME& m_frame;
    const T_PUSH_HINGES& m_hinges;
    const T_PUSH_CASE& m_case;
    std::size_t m_vertical = 2;
    std::vector<T_PUSH_STOREY> m_storeys;
    std::vector<int> m_driftStorey;                    // of the engine's drifts: the storey, from 1
    std::vector<std::vector<solver::T_VEC3>> m_forces; // by stage and node, at load factor 1
    std::vector<double> m_factors;                     // of the stages, at present
    std::vector<std::vector<std::size_t>> m_lawAt;     // by hinge and law: index of the run's
    CPushRecorder m_recorder;
    T_PUSH_RUN m_run;
};
