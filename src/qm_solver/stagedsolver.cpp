#include "qm_solver/stagedsolver.h"

#include "qm_base/finite.h"
#include "qm_solver/stages/stagedrun.h"

#include <algorithm>

namespace solver {

namespace {

/// What Prepare makes; runs change the factors of the parts alone.
struct T_PREPARED {
    T_STAGED_MODEL model;
    T_STAGE_PLAN plan;
    std::vector<std::unique_ptr<CStagePart>> parts; // those that differ
    std::vector<std::size_t> partOf;                // by stage

    explicit T_PREPARED(const T_STAGED_MODEL& staged) : model(staged) {}
    std::optional<T_SOLVER_ERROR> MakeParts(T_STAGED_COST& cost);
};

/// All parts share the memory of one factor.
std::optional<T_SOLVER_ERROR> T_PREPARED::MakeParts(T_STAGED_COST& cost)
{
    const auto space = std::make_shared<CFactorSpace>();
    for (std::size_t s = 0; s < plan.active.size(); ++s) {
        const auto at = std::find_if(parts.begin(), parts.end(), [&](const auto& part) {
            return part->Active() == plan.active[s];
        });
        partOf.push_back(static_cast<std::size_t>(at - parts.begin()));
        if (at != parts.end()) continue;
        parts.push_back(std::make_unique<CStagePart>(model.frame, plan.active[s]));
        ++cost.analyses;
        if (auto fault = parts.back()->Prepare(space)) {
            fault->stage = static_cast<long>(s);
            return fault;
        }
    }
    return {};
}

} // namespace

struct CStagedSolver::T_STATE {
    std::shared_ptr<T_PREPARED> prepared;
    T_STAGED_COST cost;
    std::optional<CStagedRun> run;
};

CStagedSolver::CStagedSolver() = default;
CStagedSolver::~CStagedSolver() = default;
CStagedSolver::CStagedSolver(CStagedSolver&&) noexcept = default;
CStagedSolver& CStagedSolver::operator=(CStagedSolver&&) noexcept = default;

int CStagedSolver::Prepare(const T_STAGED_MODEL& model, T_SOLVER_ERROR& error)
{
    m_state.reset();
    auto state = std::make_unique<T_STATE>();
    state->prepared = std::make_shared<T_PREPARED>(model);
    T_PREPARED& prepared = *state->prepared;
    std::optional<T_SOLVER_ERROR> fault = MakePlan(prepared.model, prepared.plan);
    if (!fault) fault = prepared.MakeParts(state->cost);
    if (fault) {
        error = *fault;
        return 0;
    }
    m_state = std::move(state);
    return 1;
}

CStagedSolver CStagedSolver::Again() const
{
    CStagedSolver other;
    if (!m_state) return other;
    other.m_state = std::make_unique<T_STATE>();
    other.m_state->prepared = m_state->prepared;
    return other;
}

int CStagedSolver::Run(std::span<const T_LOAD_CASE> cases, T_SOLVER_ERROR& error,
                       const ProgressFn& progress)
{
    std::optional<T_SOLVER_ERROR> fault;
    if (m_state) m_state->run.reset();
    if (!m_state || cases.size() != m_state->prepared->model.groups.size()) {
        fault.emplace();
        fault->fault = m_state ? SOLVER_FAULT::BadModel : SOLVER_FAULT::Failed;
        fault->reason = m_state ? "IDS_QM_ENGINE_NO_GROUP" : "IDS_QM_ENGINE_NOT_PREPARED";
    } else {
        T_PREPARED& p = *m_state->prepared;
        m_state->run.emplace(p.model, p.plan, p.parts, p.partOf, cases, m_state->cost);
        fault = m_state->run->Go(progress);
        if (fault) m_state->run.reset();
    }
    if (fault) {
        error = *fault;
        return 0;
    }
    return 1;
}

std::size_t CStagedSolver::StageCount() const
{
    return m_state ? m_state->prepared->model.stages.size() : 0;
}

int CStagedSolver::StepCount(std::size_t stage) const
{
    return stage < StageCount() ? m_state->prepared->model.stages[stage].steps : 0;
}

const T_STAGED_COST& CStagedSolver::Cost() const
{
    static const T_STAGED_COST kNothing;
    return m_state ? m_state->cost : kNothing;
}

int CStagedSolver::Read(std::size_t stage, int step, std::span<const double> factors,
                        T_RESULT& out) const
{
    out = {};
    if (!m_state || !m_state->run || factors.size() != m_state->prepared->model.groups.size())
        return 0;
    T_MIX mix;
    for (std::size_t c = 0; c < factors.size(); ++c)
        if (factors[c] != 0.0) mix.emplace_back(c, factors[c]);
    if (m_state->run->Read(stage, step, mix, out) && IsFinite(out)) return 1;
    out = {};
    return 0;
}

int CStagedSolver::ReadCase(std::size_t stage, int step, std::size_t loadCase, T_RESULT& out) const
{
    out = {};
    if (!m_state || loadCase >= m_state->prepared->model.groups.size()) return 0;
    std::vector<double> factors(m_state->prepared->model.groups.size(), 0.0);
    factors[loadCase] = 1.0;
    return Read(stage, step, factors, out);
}

int CStagedSolver::ReadSum(std::size_t stage, int step, STAGE_SUM sum, T_RESULT& out) const
{
    out = {};
    if (!m_state) return 0;
    std::vector<double> factors;
    for (const LOAD_GROUP group : m_state->prepared->model.groups)
        factors.push_back(
            sum == STAGE_SUM::All || static_cast<int>(sum) == static_cast<int>(group) ? 1.0 : 0.0);
    return Read(stage, step, factors, out);
}

} // namespace solver
