#include "qm_solver/ulfdiagnosis.h"

#include "qm_solver/factors/ulfcompromise.h"
#include "qm_solver/ulfsolver.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <algorithm>
#include <cmath>

namespace {

using T_MATRIX = Eigen::Matrix<double, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;

constexpr double kActiveTol = 1e-9; // slack of an active row, scaled

/// row * x - rhs.
long double Excess(const T_ULF_PROBLEM& problem, std::size_t i, std::span<const double> x)
{
    long double sum = -static_cast<long double>(problem.rhs[i]);
    for (std::size_t j = 0; j < x.size(); ++j)
        sum += static_cast<long double>(problem.Row(i)[j]) * x[j];
    return sum;
}

/// What is large in the right-hand side of row i, for the solution x.
long double RowUnit(const T_ULF_SCALED& s, std::size_t i, std::span<const double> x)
{
    long double size = 1.0L;
    for (std::size_t j = 0; j < s.nVar; ++j)
        size = std::max(size, std::fabs(s.metric[j] * x[j] / s.rhsScale));
    return s.rowNorm[i] * s.rhsScale * size;
}

std::vector<T_ULF_HELD> HeldRows(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s,
                                 const T_ULF_ANSWER& answer)
{
    std::vector<T_ULF_HELD> held;
    for (std::size_t i = 0; i < s.nCon; ++i) {
        const long double slack = -Excess(problem, i, answer.x) / RowUnit(s, i, answer.x);
        if (i >= s.nEq && slack > kActiveTol) continue;
        held.push_back({static_cast<int>(i), static_cast<double>(answer.prices[i])});
    }
    return held;
}

/// Price of row i where its limit has been moved; the price of before where the two agree, which
/// has more digits.
std::optional<double> PriceAt(const T_ULF_PROBLEM& problem, std::size_t i, double limit,
                              double before)
{
    std::vector<double> rhs(problem.rhs.begin(), problem.rhs.end());
    rhs[i] = limit;
    T_ULF_PROBLEM moved = problem;
    moved.rhs = rhs;
    const T_ULF_ANSWER answer = SolveUlf(moved);
    if (answer.code != ULF_SOLVED && answer.code != ULF_RELAXED) return std::nullopt;
    const auto price = static_cast<double>(answer.prices[i]);
    constexpr double kSame = 5e-3; // of the square sum the price itself moves with the limit
    return std::fabs(price - before) <= kSame * std::fabs(before) ? before : price;
}

/// The prices of a held row to each side.
void PriceSides(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s, std::span<const double> x,
                T_ULF_HELD& held)
{
    constexpr long double kStep = 1e-7L; // of the row's unit: beyond kUlfRelaxedTol
    const auto i = static_cast<std::size_t>(held.index);
    const auto step = static_cast<double>(kStep * RowUnit(s, i, x));
    held.raised = PriceAt(problem, i, problem.rhs[i] + step, held.multiplier);
    held.lowered = PriceAt(problem, i, problem.rhs[i] - step, held.multiplier);
    if (held.lowered) held.lowered = 0.0 - *held.lowered;
}

/// What a factor that is held at zero would gain by crossing it.
std::vector<T_ULF_HELD> HeldSigns(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s,
                                  const T_ULF_ANSWER& answer)
{
    std::vector<T_ULF_HELD> held;
    for (std::size_t j = 0; s.sign != 0 && j < s.nVar; ++j) {
        if (std::fabs(s.metric[j] * answer.x[j] / s.rhsScale) > kActiveTol) continue;
        long double push = 0.0L, terms = 0.0L; // of the rows towards the wrong sign
        for (std::size_t i = 0; i < s.nCon; ++i) {
            const long double term = -s.sign * answer.prices[i] * problem.Row(i)[j];
            push += term;
            terms += std::fabs(term);
        }
        // The other side of |y| costs as well.
        if (problem.objective == 1) push -= problem.weights[j];
        if (push > kActiveTol * terms)
            held.push_back({static_cast<int>(j), static_cast<double>(push)});
    }
    return held;
}

std::vector<double> PositiveWeights(std::span<const double> weights)
{
    std::vector<double> all(weights.begin(), weights.end());
    double smallest = 0.0;
    for (double w : all)
        if (w > 0.0 && (smallest <= 0.0 || w < smallest)) smallest = w;
    for (double& w : all)
        if (!(w > 0.0)) w = smallest > 0.0 ? smallest : 1.0;
    return all;
}

std::vector<int> Unfelt(const T_ULF_SCALED& s)
{
    std::vector<int> unknowns;
    for (std::size_t j = 0; j < s.nVar; ++j) {
        double most = 0.0;
        for (std::size_t i = 0; i < s.nCon; ++i)
            most = std::max(most, std::fabs(s.rows[i * s.nVar + j]));
        if (most <= kUlfRankTol) unknowns.push_back(static_cast<int>(j));
    }
    return unknowns;
}

/// A part of the problem with storage of its own.
class CPart {
public:
    CPart(const T_ULF_PROBLEM& problem, const std::vector<int>& rows, bool sign)
        : m_problem(problem)
    {
        m_problem.nEq = 0;
        m_problem.objective = 2;
        if (!sign) m_problem.sign = 0;
        for (int row : rows) {
            const auto i = static_cast<std::size_t>(row);
            m_rows.insert(m_rows.end(), problem.Row(i).begin(), problem.Row(i).end());
            m_rhs.push_back(problem.rhs[i]);
            if (row < problem.nEq) ++m_problem.nEq;
        }
        m_problem.coefficients = m_rows;
        m_problem.rhs = m_rhs;
        m_answer = MeetUlf(m_problem);
    }
    CPart(const CPart&) = delete;
    CPart& operator=(const CPart&) = delete;
    bool IsContradiction() const
    {
        return m_answer.code >= ULF_EQUALITIES_CONTRADICT && m_answer.code <= ULF_OTHER_SIGN_ONLY;
    }
    bool IsSolvable() const { return m_answer.code == ULF_SOLVED; }
    const T_ULF_ANSWER& Answer() const { return m_answer; }

private:
    T_ULF_PROBLEM m_problem;
    std::vector<double> m_rows, m_rhs;
    T_ULF_ANSWER m_answer;
};

/// A set of rows, and the sign, that has no solution.
struct T_SET {
    std::vector<int> rows;
    bool sign = false;
    std::size_t Size() const { return rows.size() + (sign ? 1 : 0); }
    /// Member `at`; the sign is the first.
    T_SET Without(std::size_t at) const
    {
        T_SET rest = *this;
        if (sign && at == 0)
            rest.sign = false;
        else
            rest.rows.erase(rest.rows.begin() + static_cast<std::ptrdiff_t>(at - (sign ? 1 : 0)));
        return rest;
    }
};

/// The members of `set` that the proof of its contradiction needs, where those alone are a
/// contradiction; else `set`.
T_SET Needed(const T_ULF_PROBLEM& problem, const T_SET& set, const T_ULF_ANSWER& proof)
{
    T_SET needed;
    needed.sign = set.sign && proof.proofNeedsSign;
    for (std::size_t i : proof.proof)
        needed.rows.push_back(set.rows[i]);
    return CPart(problem, needed.rows, needed.sign).IsContradiction() ? needed : set;
}

} // namespace

int CUlfDiagnosis::Explain(const T_ULF_PROBLEM& problem, T_ULF_EXPLANATION& out) const
{
    if (!CheckUlfProblem(problem)) return 0;
    const T_ULF_ANSWER answer = SolveUlf(problem);
    if (answer.code != ULF_SOLVED && answer.code != ULF_RELAXED) return 0;
    const T_ULF_SCALED scaled =
        answer.byWeights ? ScaleUlf(problem, UlfWeights(problem.weights)) : ScaleUlf(problem);
    T_ULF_EXPLANATION e{answer.x, answer.certificate.objective, HeldRows(problem, scaled, answer),
                        HeldSigns(problem, scaled, answer)};
    for (T_ULF_HELD& held : e.rows)
        if (e.rows.size() <= kUlfMostPriced) PriceSides(problem, scaled, answer.x, held);
    out = std::move(e);
    return 1;
}

int CUlfDiagnosis::Examine(const T_ULF_PROBLEM& problem, T_ULF_MATRIX& out) const
{
    if (!CheckUlfProblem(problem)) return 0;
    const std::vector<double> weights = PositiveWeights(problem.weights);
    T_ULF_PROBLEM weighted = problem;
    weighted.weights = weights;
    const T_ULF_SCALED s = ScaleUlf(weighted);
    T_ULF_MATRIX info;
    info.unfelt = Unfelt(s);
    const Eigen::Map<const T_MATRIX> matrix(s.rows.data(), static_cast<Eigen::Index>(s.nCon),
                                            static_cast<Eigen::Index>(s.nVar));
    const Eigen::VectorXd values = Eigen::BDCSVD<Eigen::MatrixXd>(matrix).singularValues();
    info.singularValues.assign(values.begin(), values.end());
    for (double value : info.singularValues) {
        if (!(value > kUlfRankTol * info.singularValues.front())) break;
        ++info.rank;
        info.condition = info.singularValues.front() / value;
    }
    out = std::move(info);
    return 1;
}

int CUlfDiagnosis::Compromise(const T_ULF_PROBLEM& problem, T_ULF_COMPROMISE& out) const
{
    if (!CheckUlfProblem(problem)) return 0;
    const T_ULF_SCALED scaled = ScaleUlf(problem);
    std::vector<long double> y;
    if (!LeastViolation(scaled, y)) return 0;
    T_ULF_COMPROMISE best;
    best.factors = UnscaleUlf(scaled, y);
    long double sum = 0.0L;
    for (std::size_t i = 0; i < scaled.nCon; ++i) {
        const long double excess = Excess(problem, i, best.factors);
        const long double noise = kUlfFeasibleTol * scaled.rowNorm[i] * scaled.rhsScale;
        const bool isMet = i < scaled.nEq ? std::fabs(excess) <= noise : excess <= noise;
        best.violation.push_back(isMet ? 0.0 : static_cast<double>(excess));
        sum += std::pow(best.violation.back() / scaled.rowNorm[i], 2.0L);
    }
    best.sumOfSquares = static_cast<double>(sum);
    out = std::move(best);
    return 1;
}

T_ULF_CONFLICT CUlfDiagnosis::Conflict(const T_ULF_PROBLEM& problem,
                                       const std::function<bool(int, int)>& progress) const
{
    if (!CheckUlfProblem(problem)) return {};
    T_SET set;
    set.sign = problem.sign != 0;
    for (std::size_t i = 0; i < problem.Rows(); ++i)
        set.rows.push_back(static_cast<int>(i));
    {
        const CPart all(problem, set.rows, set.sign);
        if (all.IsSolvable()) return {ULF_CONFLICT::Solvable, {}, false};
        if (!all.IsContradiction()) return {ULF_CONFLICT::NotProved, {}, false};
        set = Needed(problem, set, all.Answer());
    }
    int tried = 0;
    for (std::size_t at = 0; at < set.Size();) { // members before `at` can't be spared
        const int members = tried + static_cast<int>(set.Size() - at);
        if (progress && !progress(tried, members)) return {ULF_CONFLICT::Cancelled, {}, false};
        ++tried;
        const T_SET rest = set.Without(at);
        if (CPart(problem, rest.rows, rest.sign).IsContradiction())
            set = rest;
        else
            ++at;
    }
    return {ULF_CONFLICT::Found, set.rows, set.sign};
}
