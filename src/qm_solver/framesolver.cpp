#include "qm_solver/framesolver.h"

#include "qm_base/finite.h"
#include "qm_base/textformat.h"
#include "qm_solver/checks/balance.h"
#include "qm_solver/checks/mechanism.h"
#include "qm_solver/checks/modelcheck.h"
#include "qm_solver/checks/stabilitycheck.h"
#include "qm_solver/frame/caseblock.h"
#include "qm_solver/frame/frameassembly.h"
#include "qm_solver/model/frameextent.h"
#include "qm_solver/modesolver.h"
#include "qm_solver/sparse/sparsefactor.h"

#include <algorithm>
#include <cmath>

namespace solver {

namespace {

constexpr std::size_t kCaseBlock = 64; // right-hand sides solved together

T_SOLVER_ERROR Failed(T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::Failed;
    error.reason = std::move(reason);
    return error;
}

} // namespace

struct CFrameSolver::T_STATE {
    T_FRAME frame;
    CFrameDofs dofs;
    CFrameAssembly assembly;
    CSparseFactor factor;
    double extent = 1.0; // length that compares moments with forces

    explicit T_STATE(const T_FRAME& model) : frame(model), dofs(frame), extent(Extent(frame)) {}
    std::optional<T_SOLVER_ERROR> Factorise();
    std::optional<T_SOLVER_ERROR> SolveBlock(std::span<const T_LOAD_CASE> cases, std::size_t first,
                                             std::vector<T_RESULT>& out);
};

std::optional<T_SOLVER_ERROR> CFrameSolver::T_STATE::Factorise()
{
    T_SOLVER_REASON reason;
    if (!assembly.Prepare(frame, dofs, reason)) return Failed(reason);
    assembly.Assemble(frame);
    if (dofs.EquationCount() == 0) return {}; // everything is held
    if (!factor.Analyse(assembly.Matrix(), dofs.Blocks(), reason)) return Failed(reason);
    T_SOLVER_ERROR error;
    if (!FactorStable(frame, dofs, assembly.Matrix(), factor, error)) return error;
    return {};
}

std::optional<T_SOLVER_ERROR> CFrameSolver::T_STATE::SolveBlock(std::span<const T_LOAD_CASE> cases,
                                                                std::size_t first,
                                                                std::vector<T_RESULT>& out)
{
    const CCaseBlock block(frame, dofs, cases);
    T_SOLUTION solution;
    T_SOLVER_REASON reason;
    std::size_t at = 0;
    if (!SolveBalanced(block, dofs, extent, assembly.Matrix(), factor, solution, at, reason)) {
        T_SOLVER_ERROR error = Failed(reason);
        error.loadCase = at < cases.size() ? static_cast<long>(first + at) : -1;
        return error;
    }
    block.Recover(solution, out);
    for (std::size_t c = 0; c < cases.size(); ++c)
        if (!IsFinite(out[first + c])) {
            T_SOLVER_ERROR error = Failed("IDS_QM_ENGINE_OVERFLOW");
            error.loadCase = static_cast<long>(first + c);
            return error;
        }
    return {};
}

CFrameSolver::CFrameSolver() = default;
CFrameSolver::~CFrameSolver() = default;
CFrameSolver::CFrameSolver(CFrameSolver&&) noexcept = default;
CFrameSolver& CFrameSolver::operator=(CFrameSolver&&) noexcept = default;

int CFrameSolver::Prepare(const T_FRAME& frame, T_SOLVER_ERROR& error)
{
    m_state.reset();
    std::optional<T_SOLVER_ERROR> fault = CheckModel(frame);
    if (!fault) fault = CheckRigidBodies(frame);
    std::unique_ptr<T_STATE> state;
    if (!fault) {
        state = std::make_unique<T_STATE>(frame);
        fault = state->Factorise();
    }
    if (fault) {
        error = *fault;
        return 0;
    }
    m_state = std::move(state);
    return 1;
}

int CFrameSolver::Solve(std::span<const T_LOAD_CASE> cases, std::vector<T_RESULT>& out,
                        T_SOLVER_ERROR& error, const ProgressFn& progress)
{
    out.clear();
    std::optional<T_SOLVER_ERROR> fault;
    if (!m_state) fault = Failed("IDS_QM_ENGINE_NOT_PREPARED");
    for (std::size_t c = 0; c < cases.size() && !fault; ++c)
        fault = CheckCase(m_state->frame, m_state->dofs, cases[c], c);
    std::vector<T_RESULT> results;
    results.reserve(cases.size());
    for (std::size_t first = 0; first < cases.size() && !fault; first += kCaseBlock) {
        const std::size_t count = std::min(kCaseBlock, cases.size() - first);
        fault = m_state->SolveBlock(cases.subspan(first, count), first, results);
        if (!fault && progress && !progress(first + count, cases.size())) {
            fault.emplace();
            fault->fault = SOLVER_FAULT::Cancelled;
            fault->reason = "IDS_QM_ENGINE_CANCELLED";
        }
    }
    if (fault) {
        error = *fault;
        return 0;
    }
    out = std::move(results);
    return 1;
}

int CFrameSolver::Modes(std::size_t count, std::vector<T_MODE>& out, T_SOLVER_ERROR& error,
                        const ProgressFn& progress)
{
    out.clear();
    if (!m_state) {
        error = Failed("IDS_QM_ENGINE_NOT_PREPARED");
        return 0;
    }
    return SolveModes(m_state->frame, m_state->dofs, m_state->assembly.Matrix(), m_state->factor,
                      count, out, error, progress);
}

} // namespace solver
