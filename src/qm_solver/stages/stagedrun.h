// One run of a staged model through its stages.
#pragma once

#include "qm_solver/stagedsolver.h"
#include "qm_solver/stages/stagerecords.h"

namespace solver {

/// Follows the plan step by step and keeps the records. Model, plan and parts outlive it.
class CStagedRun {
public:
    using T_FAULT = std::optional<T_SOLVER_ERROR>;
    using T_PARTS = std::span<const std::unique_ptr<CStagePart>>;

    /// partOf: index into parts, by stage.
    CStagedRun(const T_STAGED_MODEL& model, const T_STAGE_PLAN& plan, T_PARTS parts,
               std::span<const std::size_t> partOf, std::span<const T_LOAD_CASE> cases,
               T_STAGED_COST& cost);

    /// Through all stages. The first fault with its stage; the records are then not to be read.
    T_FAULT Go(const ProgressFn& progress);
    /// Results of a mix of load cases at the end of a step; 0 there is no such step.
    [[nodiscard]] int Read(std::size_t stage, int step, const T_MIX& mix, T_RESULT& out) const;

private:
    using T_FIELD = std::vector<double>;

    bool SecondOrder() const
    {
        return m_model.options.geometricStiffness || m_model.options.cableSag;
    }
    CStagePart& Part() const { return *m_parts[m_now.part]; }
    T_FAULT BeginPart(std::size_t stage);
    T_FAULT Step(std::size_t stage, std::size_t step);
    T_FAULT ChangeLoads(const T_LOAD_CHANGE& change);
    void HoldDisplacements();
    T_FAULT SolveCases(std::span<const std::size_t> cases);
    T_FAULT SolveBlock(std::span<const std::size_t> cases);
    std::vector<std::size_t> Moving() const;
    T_MIX Everything() const;
    T_LOAD_CASE Loads(const T_STEP_RECORD& record, const T_MIX& mix) const;

    T_FAULT Iterate();
    T_FAULT CheckBuckling() const;
    void GuessTensions();
    void ReadTensions(const T_FIELD& displacement);
    std::vector<T_AXIAL> AxialState(bool first) const;

    const T_STAGED_MODEL& m_model;
    const T_STAGE_PLAN& m_plan;
    T_PARTS m_parts;
    std::span<const std::size_t> m_partOf;
    std::vector<T_LOAD_CASE> m_cases;
    T_STAGED_COST& m_cost;
    CStageRecords m_records;
    std::vector<char> m_cable; // by element: it sags

    T_STEP_RECORD m_now;           // the step that is under way
    std::vector<T_FIELD> m_held;   // by load case; empty: 0
    std::vector<double> m_tension; // by element: all load cases together
    std::vector<double> m_clamped; // by element: of initial tension and temperature
    bool m_factorised = false;     // the part's factor is that of the first order
};

} // namespace solver
