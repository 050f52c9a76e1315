#include "qm_rps/optdsgn.h"

#include "qm_base/appbase.h"
#include "qm_base/msgfunction.h"
#include "qm_base/testenvmgr.h"
#include "qm_db/rps_unknownloadfactormanager.h"
#include "qm_rps/factors/optdump.h"
#include "qm_solver/ulfproblem.h"

#include <algorithm>
#include <cmath>
#include <exception>
#include <new>
#include <numeric>

using zql::lib::MMSGFunction;

namespace {

constexpr const char* kSource = "src/qm_rps/optdsgn";
constexpr const char* kUnknownObjective = "IDS_RPS_Unknown_object_funtion_type_";
constexpr const char* kNoSolution = "IDS_RPS_Unknown_CANNOT_FIND_OPTIMIZED_SOLUTION";
constexpr const char* kRowViolated = "IDS_RPS_Error_code_9___The_load_factors_are_determ";
constexpr int kSolverFailed = 10;
constexpr int kRelaxed = 9;

struct T_CODE_KEY {
    int code;
    const char* key;
};
// Codes of the solver that end the run; 9 is judged by the solution, others need no message.
constexpr T_CODE_KEY kCodeKeys[] = {
    {-1, kUnknownObjective},
    {4, "IDS_RPS_Error_code_4___The_calculation_cannot_begi"},
    {5, "IDS_RPS_Error_code_5___The_equality_constraints_ar"},
    {6, "IDS_RPS_Error_code_6___The_equality_constraints_an"},
    {7, "IDS_RPS_Error_code_7___There_is_no_solution_vector"},
    {8, "IDS_RPS_Error_code_8___Maximum_number_of_object_fu"},
    {kSolverFailed, kNoSolution},
};

/// Keys of a factor with the wrong sign.
struct T_SIGN_KEYS {
    const char *negative, *positive; // found while the sign asked for is positive, negative
};
constexpr T_SIGN_KEYS kExactSign{"IDS_RPS_Load_factor___d__can_be_determined_in_nega",
                                 "IDS_RPS_Load_factor___d__can_be_determined_in_posi"};
constexpr T_SIGN_KEYS kRelaxedSign{"IDS_RPS_Error_code_9___The_load_factors_are_determ_MSG2",
                                   "IDS_RPS_Error_code_9___The_load_factors_are_determ_MSG3"};

int Fail(T_OPT_ANSWER& answer, const char* key, int number = 0)
{
    std::fill(answer.factors.begin(), answer.factors.end(), 0.0);
    answer.key = key;
    answer.message = MMSGFunction::Format(key, {std::to_string(number)});
    return 0;
}
int FailConstraint(T_OPT_ANSWER& answer, const char* key, int number)
{
    answer.constraint = number;
    return Fail(answer, key, number);
}

/// A single coefficient, that of row i in column i, is looked at: this diagonal reading is meant.
const char* PreCheckKey(const T_OPT_ROW& row, std::size_t i, int isign)
{
    const double c = row.coefficients[i];
    if (isign == 1 && ((c > 0 && row.rhs <= 0 && row.relation != 1) ||
                       (c < 0 && row.rhs >= 0 && row.relation != -1)))
        return "IDS_RPS_Constraint___d__cannot_be_satisfied_with_t";
    if (isign == -1 && ((c > 0 && row.rhs >= 0 && row.relation != -1) ||
                        (c < 0 && row.rhs <= 0 && row.relation != 1)))
        return "IDS_RPS_Constraint___d__cannot_be_satisfied_with_t_MSG1";
    // No absolute value is below this bound, so the message is never shown: this is meant.
    if (row.relation == 0 && std::fabs(c) <= -1.0)
        return "IDS_RPS_Constraint___d__seems_be_always_satisfied_";
    return nullptr;
}

int PreCheck(const std::vector<T_OPT_ROW>& rows, const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer)
{
    if (!problem.solveByEquations || CTestEnvMgr::IsTestEnvST("KTR_ULF_TEST", "yes")) return 1;
    const std::size_t checked = std::min(rows.size(), static_cast<std::size_t>(problem.nvar));
    for (std::size_t i = 0; i < checked; ++i)
        if (const char* key = PreCheckKey(rows[i], i, problem.isign))
            return FailConstraint(answer, key, static_cast<int>(i) + 1);
    return 1;
}

/// Equalities first, then inequalities, each in input order, with "at least" turned round.
T_OPT_SYSTEM SystemOf(const std::vector<T_OPT_ROW>& rows, const T_OPT_PROBLEM& problem)
{
    T_OPT_SYSTEM s;
    s.ncon = static_cast<int>(rows.size());
    s.nvar = problem.nvar;
    s.order.resize(rows.size());
    std::iota(s.order.begin(), s.order.end(), 0);
    const auto relation = [&](int i) { return rows[static_cast<std::size_t>(i)].relation; };
    const auto split = std::stable_partition(s.order.begin(), s.order.end(),
                                             [&](int i) { return relation(i) == 0; });
    s.neq = static_cast<int>(split - s.order.begin());
    for (const int i : s.order) {
        const T_OPT_ROW& row = rows[static_cast<std::size_t>(i)];
        const double turn = row.relation == 1 ? -1.0 : 1.0;
        for (const double c : row.coefficients)
            s.matrix.push_back(turn * c);
        s.rhs.push_back(turn * row.rhs);
        s.relations.push_back(row.relation);
    }
    for (const T_OPT_ITEM& item : problem.items)
        if (IsUnknownItem(item)) s.weights.push_back(item[2]);
    return s;
}

/// Factors of equations whose part in every row is rounding are exactly zero, as those that the
/// optimum mode gives.
void ClearNoise(T_OPT_ANSWER& answer)
{
    const T_OPT_SYSTEM& s = answer.system;
    const auto part = [&](std::size_t row, std::size_t j) {
        return std::fabs(s.matrix[row * answer.factors.size() + j] * answer.factors[j]);
    };
    for (std::size_t j = 0; j < answer.factors.size(); ++j) {
        bool isNoise = false;
        for (std::size_t row = 0; row < s.rhs.size(); ++row) {
            double size = std::fabs(s.rhs[row]);
            for (std::size_t k = 0; k < answer.factors.size(); ++k)
                size = std::max(size, part(row, k));
            if (!(part(row, j) > 0.0)) continue; // not felt
            isNoise = part(row, j) <= kUlfFeasibleTol * size;
            if (!isNoise) break;
        }
        if (isNoise) answer.factors[j] = 0.0;
    }
}

/// The first factor with the wrong sign fails the run.
int CheckSigns(int isign, const T_SIGN_KEYS& keys, T_OPT_ANSWER& answer)
{
    if (isign == 0) return 1;
    const auto wrong = std::find_if(answer.factors.begin(), answer.factors.end(),
                                    [&](double f) { return isign * f < 0; });
    if (wrong == answer.factors.end()) return 1;
    answer.factor = static_cast<int>(wrong - answer.factors.begin()) + 1;
    return Fail(answer, isign > 0 ? keys.negative : keys.positive, answer.factor);
}

/// Code 9: factors were found, but a row may be met only within a relaxed tolerance.
int CheckRelaxed(int isign, T_OPT_ANSWER& answer)
{
    const T_OPT_SYSTEM& s = answer.system;
    for (int row = s.neq; row < s.ncon; ++row) {
        const auto at = static_cast<std::size_t>(row);
        const double sum = std::inner_product(answer.factors.begin(), answer.factors.end(),
                                              s.matrix.begin() + std::ptrdiff_t{row} * s.nvar, 0.0);
        if (sum > s.rhs[at]) return FailConstraint(answer, kRowViolated, s.order[at] + 1);
    }
    return CheckSigns(isign, kRelaxedSign, answer);
}

} // namespace

COptDsgn::COptDsgn(IUlfResponse& staticSource, IUlfResponse* stageSource)
    : m_static(staticSource), m_stage(stageSource), m_solver([](auto&&... arguments) {
          return CRps_UnknownLoadFactorManager().Calc_UnknownLoadFactor(arguments...);
      })
{
}

int COptDsgn::CheckProblem(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer) const
{
    if (problem.iobj < 1 || problem.iobj > 3) return Fail(answer, kUnknownObjective);
    const auto unknown = std::count_if(problem.items.begin(), problem.items.end(), IsUnknownItem);
    if (unknown == problem.nvar && !(problem.stage && !m_stage)) return 1;
    if (CAppBase::IsReleaseAssert_ST()) CAppBase::ReleaseAssertion_ST(kSource, __LINE__);
    return Fail(answer, "IDS_QM_ULF_BAD_PROBLEM");
}

int COptDsgn::ReadRows(const T_OPT_PROBLEM& problem, std::vector<T_OPT_ROW>& rows,
                       T_OPT_ANSWER& answer)
{
    IUlfResponse& source = problem.stage ? *m_stage : m_static;
    if (!BuildRows(problem.items, problem.constraints, source, rows, answer.coefficients)) {
        constexpr const char* key = "IDS_QM_ULF_NO_RESPONSE";
        (void)Fail(answer, key);
        answer.message = MMSGFunction::Format(key, {source.Error()});
        return 0;
    }
    if (!problem.stage) return 1;
    for (const std::vector<double>& c : answer.coefficients) {
        double constant = 0.0;
        for (std::size_t i = 0; i < c.size(); ++i)
            if (!IsUnknownItem(problem.items[i])) constant += c[i] * problem.items[i][1];
        answer.constants.push_back(constant);
    }
    return 1;
}

int COptDsgn::Run(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer)
{
    answer = {};
    answer.factors.assign(static_cast<std::size_t>(std::max(0, problem.nvar)), 0.0);
    std::vector<T_OPT_ROW> rows;
    if (!CheckProblem(problem, answer) || !ReadRows(problem, rows, answer)) return 0;
    answer.system = SystemOf(rows, problem);
    const T_OPT_SYSTEM& system = answer.system;
    if (!PreCheck(rows, problem, answer)) return 0;
    answer.exact = system.neq == system.nvar && system.ncon == system.nvar;
    if (!answer.exact && problem.solveByEquations)
        return Fail(answer, "IDS_RPS_NOT_SOLVED_SIMUL_EQ_METHOD");
    if (m_dump.enabled) WriteOptDump(m_dump, answer, problem.iobj, problem.isign);
    return answer.exact ? SolveExact(problem, answer) : SolveOptimum(problem, answer);
}

int COptDsgn::CallSolver(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer)
{
    const T_OPT_SYSTEM& s = answer.system;
    try {
        return m_solver(answer.exact ? 0 : 1, s.ncon, s.nvar, s.neq, s.matrix, s.rhs,
                        answer.factors, s.weights, problem.iobj, problem.isign, answer.code);
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception&) {
        return 0; // the solver gave up
    } catch (...) {
        if (CAppBase::IsReleaseAssert_ST()) CAppBase::ReleaseAssertion_ST(kSource, __LINE__);
        return 0;
    }
}

int COptDsgn::SolveExact(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer)
{
    CallSolver(problem, answer); // its return is not used, on purpose: residuals tell what holds
    ClearNoise(answer);
    return CheckSigns(problem.isign, kExactSign, answer);
}

int COptDsgn::SolveOptimum(const T_OPT_PROBLEM& problem, T_OPT_ANSWER& answer)
{
    if (!CallSolver(problem, answer)) answer.code = kSolverFailed;
    const auto* row = std::find_if(std::begin(kCodeKeys), std::end(kCodeKeys),
                                   [&](const T_CODE_KEY& c) { return c.code == answer.code; });
    if (row != std::end(kCodeKeys)) return Fail(answer, row->key);
    return answer.code == kRelaxed ? CheckRelaxed(problem.isign, answer) : 1;
}
