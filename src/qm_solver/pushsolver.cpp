#include "qm_solver/pushsolver.h"

#include "qm_solver/checks/mechanism.h"
#include "qm_solver/checks/modelcheck.h"
#include "qm_solver/checks/stabilitycheck.h"
#include "qm_solver/modesolver.h"
#include "qm_solver/push/pushcheck.h"
#include "qm_solver/push/pushrun.h"

namespace solver {

struct CPushSolver::T_STATE {
    T_PUSH_MODEL model;
    CPushStructure structure;
    std::unique_ptr<CPushRun> run;
    T_PUSH_SINK sink;

    explicit T_STATE(T_PUSH_MODEL given) : model(std::move(given)), structure(model) {}
};

namespace {

T_SOLVER_ERROR NotPrepared()
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::Failed;
    error.reason = "IDS_QM_ENGINE_NOT_PREPARED";
    return error;
}

} // namespace

CPushSolver::CPushSolver() = default;
CPushSolver::~CPushSolver() = default;
CPushSolver::CPushSolver(CPushSolver&&) noexcept = default;
CPushSolver& CPushSolver::operator=(CPushSolver&&) noexcept = default;

int CPushSolver::Prepare(T_PUSH_MODEL model, T_SOLVER_ERROR& error)
{
    m_state.reset();
    std::optional<T_SOLVER_ERROR> fault = CheckModel(model.frame);
    if (!fault) fault = CheckRigidBodies(model.frame);
    if (!fault) fault = CheckHinges(model);
    std::unique_ptr<T_STATE> state;
    if (!fault) {
        state = std::make_unique<T_STATE>(std::move(model));
        fault = state->structure.Prepare();
    }
    if (fault) {
        error = *fault;
        return 0;
    }
    m_state = std::move(state);
    return 1;
}

int CPushSolver::Modes(std::size_t count, std::vector<T_MODE>& out, T_SOLVER_ERROR& error)
{
    out.clear();
    if (!m_state) {
        error = NotPrepared();
        return 0;
    }
    CPushStructure& structure = m_state->structure;
    if (auto fault = structure.Factorise({})) {
        error = *fault;
        return 0;
    }
    return SolveModes(structure.Frame(), structure.Dofs(), structure.Matrix(), structure.Factor(),
                      count, out, error);
}

int CPushSolver::Run(std::span<const T_PUSH_STAGE> stages, const T_PUSH_SINK& sink, T_PUSH_END& end,
                     T_SOLVER_ERROR& error)
{
    end = {};
    std::optional<T_SOLVER_ERROR> fault;
    if (!m_state) {
        fault = NotPrepared();
    } else {
        for (std::size_t s = 0; s < stages.size() && !fault; ++s)
            fault = CheckStage(m_state->model, m_state->structure.Dofs(), stages[s], s);
        m_state->sink = sink;
        m_state->run =
            std::make_unique<CPushRun>(m_state->model, m_state->structure, m_state->sink);
        if (!fault) fault = m_state->run->Go(stages, end);
    }
    if (!fault) return 1;
    error = *fault;
    return 0;
}

const T_PUSH_COST& CPushSolver::Cost() const
{
    static const T_PUSH_COST kNothing;
    return m_state ? m_state->structure.Cost() : kNothing;
}

int CPushSolver::Forces(const T_PUSH_STEP& step, T_RESULT& out, T_SOLVER_ERROR& error)
{
    const T_PUSH_STATE* state = m_state && m_state->run ? m_state->run->StateOf(step) : nullptr;
    if (!state) {
        error = NotPrepared();
        return 0;
    }
    m_state->structure.Stiffen();
    m_state->structure.Inside(*state, step, out);
    return 1;
}

} // namespace solver
