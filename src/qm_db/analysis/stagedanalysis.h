// Analysis in construction stages of the model of the database.
#pragma once

#include "qm_db/analysis/analysismodel.h"
#include "qm_db/results/stagedresult.h"
#include "qm_solver/stagedsolver.h"

/// Translates one model, which must stay as it is meanwhile, and runs it through its stages. In a
/// plane model the directions out of the plane are held at every node from the first stage on;
/// supports that come and go are those in the plane.
class CStagedAnalysis {
public:
    explicit CStagedAnalysis(const T_MODEL& model);

    /// Number of steps of all stages: what the progress counts.
    std::size_t StepCount() const;
    /// before: results of an earlier run, may be null; where they are of the same structure and
    /// stages its symbolic part is used again, and they stay readable.
    /// 1 done; 0 error filled: stage, and element, node or load case named; `out` as it was.
    [[nodiscard]] int Run(const solver::ProgressFn& progress,
                          const std::shared_ptr<IStagedResult>& before,
                          std::shared_ptr<IStagedResult>& out, T_ANALYSIS_ERROR& error);

    /// Of the displacements that are known worst, after Run; 0 where all kept their digits.
    const solver::T_ACCURACY& Accuracy() const { return m_accuracy; }

private:
    int Build(T_ANALYSIS_ERROR& error);
    int AddStage(int key, const T_STAG_D& stage, T_ANALYSIS_ERROR& error);
    int AddSupport(int node, std::vector<solver::T_STAGE_SUPPORT>& out,
                   T_ANALYSIS_ERROR& error) const;
    int AddElements(const std::vector<int>& ids, std::vector<std::size_t>& out,
                    T_ANALYSIS_ERROR& error) const;
    void AddLoads(const std::vector<T_STAG_LOAD>& loads,
                  std::vector<solver::T_STAGE_LOAD>& out) const;
    void HoldOutOfPlane();
    int InStage(int key, T_ANALYSIS_ERROR& error) const;
    int Fail(const solver::T_SOLVER_ERROR& fault, T_ANALYSIS_ERROR& error) const;

    const T_MODEL& m_model;
    CAnalysisModel m_frame;
    std::vector<int> m_stages, m_cases; // keys by index
    solver::T_STAGED_MODEL m_staged;
    std::vector<solver::T_LOAD_CASE> m_loads;
    solver::T_ACCURACY m_accuracy;
};
