#include "qm_solver/factors/ulfsquare.h"

#include <algorithm>
#include <cmath>

namespace {

// Share of the columns' own metric, squared, against the weights': from steps that go far, where
// they are well told apart, to steps that see the least curved of them.
constexpr double kShares[] = {1e-2, 1e-6, 1e-10, 1e-14, 1e-18, 1e-22, 1e-26, 1e-30};
constexpr int kMostPasses = 60;
constexpr long double kStillTol = 1e-17L; // of y: it does not move any more

T_ULF_ROWS Rows(const T_ULF_SCALED& s)
{
    T_ULF_ROWS rows;
    rows.SetWide(s.rows, s.rhs, s.nEq, s.nVar, s.nVar);
    AddUlfSigns(s, rows);
    return rows;
}

/// Whether the square sum curves less along some unknowns than along others.
bool IsFlat(const T_ULF_SCALED& s)
{
    return std::ranges::any_of(s.cost, [](double cost) { return cost != 1.0; });
}

/// Between the weights and the sizes of the columns.
std::vector<long double> MixedMetric(const T_ULF_PROBLEM& problem, double share)
{
    std::vector<long double> metric = UlfColumnSizes(problem);
    long double most = 0.0L; // of weight / size
    for (std::size_t j = 0; j < metric.size(); ++j)
        most = std::max(most, problem.weights[j] / metric[j]);
    for (std::size_t j = 0; j < metric.size(); ++j) {
        const long double own = metric[j] * most, weight = problem.weights[j];
        metric[j] = std::sqrt(weight * weight + share * own * own);
    }
    return metric;
}

/// What the centre adds to the gradient: y is drawn to it where the square sum is flat.
std::vector<double> Drawn(const T_ULF_SCALED& s, std::span<const long double> centre)
{
    std::vector<double> gradient(s.nVar);
    for (std::size_t j = 0; j < s.nVar; ++j) {
        const long double cost = s.cost[j];
        gradient[j] = static_cast<double>(-(1.0L - cost * cost) * centre[j]);
    }
    return gradient;
}

/// Makes the free unknowns of a certified answer as short as its other factors allow, if that is
/// certified by the same multipliers.
void ShortenFree(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& proved,
                 std::span<const long double> multipliers, ULF_PRECISION precision,
                 T_ULF_ANSWER& answer)
{
    const T_ULF_SCALED s = ScaleUlf(problem);
    T_ULF_ROWS rows = Rows(s);
    bool any = false;
    for (std::size_t j = 0; j < s.nVar; ++j) {
        const bool isFree = !(problem.weights[j] > 0.0);
        any = any || isFree;
        if (isFree) continue;
        const long double held = answer.x[j] * s.metric[j] / s.rhsScale;
        rows.AddShort({j, 1.0, j, 0.0}, static_cast<double>(held), T_ULF_ROWS::kHard, true);
    }
    CUlfActiveSet method(rows, precision);
    if (!any || method.Solve(0, rows.Size()) != ULF_STEP::Done) return;
    std::vector<double> x = UnscaleUlf(s, method.Y());
    const T_ULF_CERTIFICATE certificate = CertifyUlf(problem, proved, x, multipliers);
    if (!certificate.Holds(kUlfFeasibleTol)) return;
    answer.x = std::move(x);
    answer.certificate = certificate;
}

/// Proximal points in the metric of one share. The answer is certified, or has code 10.
void Approach(const T_ULF_PROBLEM& problem, double share, ULF_PRECISION precision,
              T_ULF_ANSWER& answer)
{
    const T_ULF_SCALED s = ScaleUlf(problem, MixedMetric(problem, share));
    const T_ULF_ROWS rows = Rows(s);
    CUlfActiveSet method(rows, precision);
    std::vector<long double> centre(s.nVar);
    answer.code = ULF_NOT_CERTIFIED;
    long double moved = 1.0L;
    for (int pass = 0; pass < kMostPasses && moved > kStillTol; ++pass) {
        method.SetObjective(Drawn(s, centre), 1.0);
        if (method.Solve(0, rows.Size()) != ULF_STEP::Done) return;
        moved = 0.0L;
        long double size = 1.0L;
        for (std::size_t j = 0; j < s.nVar; ++j) {
            const long double cost = s.cost[j];
            moved = std::max(moved, (1.0L - cost * cost) * std::fabs(method.Y()[j] - centre[j]));
            centre[j] = method.Y()[j];
            size = std::max(size, std::fabs(centre[j]));
        }
        moved /= size;
    }
    std::vector<long double> multipliers = method.Multipliers();
    multipliers.resize(s.nCon);
    AcceptUlf(problem, s, centre, multipliers, answer);
    if (answer.code != ULF_NOT_CERTIFIED) ShortenFree(problem, s, multipliers, precision, answer);
}

} // namespace

void AcceptUlf(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
               std::span<const long double> y, std::vector<long double> multipliers,
               T_ULF_ANSWER& answer)
{
    std::vector<double> x = UnscaleUlf(scaled, y);
    answer.code = ULF_NOT_CERTIFIED;
    answer.x.clear();
    answer.certificate = CertifyUlf(problem, scaled, x, multipliers);
    if (!answer.certificate.Holds(kUlfRelaxedTol)) return;
    answer.code = answer.certificate.Holds(kUlfFeasibleTol) ? ULF_SOLVED : ULF_RELAXED;
    answer.x = std::move(x);
    const long double unit = problem.objective == 2 ? 2.0L * scaled.rhsScale : 1.0L;
    answer.prices.clear();
    for (std::size_t i = 0; i < scaled.nCon; ++i)
        answer.prices.push_back(-multipliers[i] * unit / scaled.rowNorm[i]);
    answer.multipliers = std::move(multipliers);
}

void AddUlfSigns(const T_ULF_SCALED& scaled, T_ULF_ROWS& rows)
{
    if (scaled.sign == 0) return;
    for (std::size_t j = 0; j < scaled.nVar; ++j)
        rows.AddShort({j, static_cast<double>(-scaled.sign), j, 0.0});
}

T_ULF_ANSWER MeetUlf(const T_ULF_SCALED& scaled, ULF_PRECISION precision,
                     std::vector<long double>& y)
{
    const T_ULF_ROWS rows = Rows(scaled);
    const struct {
        std::size_t end;
        int code;
    } stages[] = {{scaled.nEq, ULF_EQUALITIES_CONTRADICT},
                  {scaled.nCon, ULF_NO_SOLUTION},
                  {rows.Size(), ULF_OTHER_SIGN_ONLY}};
    CUlfActiveSet method(rows, precision);
    T_ULF_ANSWER answer;
    for (std::size_t begin = 0; const auto& stage : stages) {
        const ULF_STEP step = method.Solve(begin, stage.end);
        begin = stage.end;
        if (step == ULF_STEP::Done) continue;
        answer.code = step == ULF_STEP::Limit ? static_cast<int>(ULF_ITERATION_LIMIT) : stage.code;
        for (const auto& [row, factor] : method.Proof()) {
            if (row < scaled.nCon) answer.proof.push_back(row);
            answer.proofNeedsSign = answer.proofNeedsSign || row >= scaled.nCon;
        }
        std::sort(answer.proof.begin(), answer.proof.end());
        return answer;
    }
    answer.code = ULF_SOLVED;
    answer.multipliers = method.Multipliers();
    answer.multipliers.resize(scaled.nCon);
    y.assign(method.Y().begin(), method.Y().end());
    return answer;
}

T_ULF_ANSWER SolveUlfSquare(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& scaled,
                            ULF_PRECISION precision)
{
    std::vector<long double> y;
    T_ULF_ANSWER answer = MeetUlf(scaled, precision, y);
    if (answer.code != ULF_SOLVED) return answer;
    if (!IsFlat(scaled)) {
        AcceptUlf(problem, scaled, y, std::move(answer.multipliers), answer);
        return answer;
    }
    if (std::ranges::none_of(problem.weights, [](double w) { return w > 0.0; })) {
        AcceptUlf(problem, scaled, y, std::vector<long double>(scaled.nCon), answer);
        return answer;
    }
    for (const double share : kShares) {
        Approach(problem, share, precision, answer);
        if (answer.code != ULF_NOT_CERTIFIED) break;
    }
    return answer;
}
