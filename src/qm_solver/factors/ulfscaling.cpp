#include "qm_solver/factors/ulfscaling.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kLargestRhs = 1e300; // beyond it a scaled right-hand side is no bound at all

constexpr long double kNoise = 1e-17L; // part of the largest factor that is rounding

constexpr int kSweeps = 6;                 // of the equilibration
constexpr int kNoExponent = -100000;       // of a zero
constexpr long double kLeastSize = 1e-40L; // of a column, against the largest, both by weight

bool AllFinite(std::span<const double> values)
{
    return std::all_of(values.begin(), values.end(), [](double v) { return std::isfinite(v); });
}

/// Divides row i by the weights and by its length. Long double holds every product of doubles, so
/// neither can overflow.
void ScaleRow(const T_ULF_PROBLEM& problem, std::size_t i, T_ULF_SCALED& s)
{
    const std::span<const double> row = problem.Row(i);
    long double sum = 0.0L;
    for (std::size_t j = 0; j < s.nVar; ++j) {
        const long double v = row[j] / s.metric[j];
        sum += v * v;
    }
    const long double norm = sum > 0.0L ? std::sqrt(sum) : 1.0L;
    s.rowNorm[i] = norm;
    for (std::size_t j = 0; j < s.nVar; ++j)
        s.rows[i * s.nVar + j] = static_cast<double>(row[j] / s.metric[j] / norm);
}

long double RhsScale(const T_ULF_PROBLEM& problem, const T_ULF_SCALED& s)
{
    long double largest = 0.0L;
    for (std::size_t i = 0; i < s.nCon; ++i) {
        const long double b = problem.rhs[i] / s.rowNorm[i];
        largest = std::max(largest, i < s.nEq ? std::fabs(b) : -b);
    }
    return largest > 0.0L ? std::exp2(std::floor(std::log2(largest))) : 1.0L;
}

/// Whether any row feels unknown j.
bool IsFelt(const T_ULF_PROBLEM& p, std::size_t j)
{
    for (std::size_t i = 0; i < p.Rows(); ++i)
        if (std::fabs(p.Row(i)[j]) > 0.0) return true;
    return false;
}

/// The sizes times a common factor, see UlfColumnSizes.
std::vector<long double> FittedToWeights(const T_ULF_PROBLEM& p, std::vector<long double> size)
{
    long double least = 0.0L, most = 0.0L; // of size / weight
    for (std::size_t j = 0; j < size.size(); ++j) {
        if (!(p.weights[j] > 0.0) || !IsFelt(p, j)) continue;
        const long double ratio = size[j] / p.weights[j];
        least = least > 0.0L ? std::min(least, ratio) : ratio;
        most = std::max(most, ratio);
    }
    least = std::max(least, kLeastSize * most);
    const long double unit = most > 0.0L ? std::sqrt(least) * std::sqrt(most) : 1.0L;
    for (std::size_t j = 0; j < size.size(); ++j) {
        const bool isWeighted = p.weights[j] > 0.0;
        const long double own = isWeighted ? p.weights[j] : 1.0L;
        size[j] =
            IsFelt(p, j) ? std::max(size[j] / unit, isWeighted ? kLeastSize * own : 0.0L) : own;
    }
    return size;
}

} // namespace

int CheckUlfProblem(const T_ULF_PROBLEM& p)
{
    if (p.nVar < 1 || p.nEq < 0 || static_cast<std::size_t>(p.nEq) > p.Rows()) return 0;
    const std::size_t n = static_cast<std::size_t>(p.nVar);
    if (p.weights.size() != n || p.coefficients.size() != n * p.Rows()) return 0;
    if (p.sign < -1 || p.sign > 1) return 0;
    if (!AllFinite(p.coefficients) || !AllFinite(p.rhs) || !AllFinite(p.weights)) return 0;
    return std::all_of(p.weights.begin(), p.weights.end(), [](double w) { return w >= 0.0; });
}

std::vector<long double> UlfWeights(std::span<const double> weights)
{
    double smallest = 0.0;
    for (double w : weights)
        if (w > 0.0 && (smallest <= 0.0 || w < smallest)) smallest = w;
    const long double free =
        smallest > 0.0 ? kUlfFreeWeight * static_cast<long double>(smallest) : 1.0L;
    std::vector<long double> all(weights.begin(), weights.end());
    for (long double& w : all)
        if (!(w > 0.0L)) w = free;
    return all;
}

std::vector<long double> UlfColumnSizes(const T_ULF_PROBLEM& p)
{
    // Powers of two: what is compared are the exponents of the entries.
    const auto n = static_cast<std::size_t>(p.nVar);
    std::vector<int> exponents;
    exponents.reserve(p.coefficients.size());
    for (const double entry : p.coefficients)
        exponents.push_back(std::fabs(entry) > 0.0 ? std::ilogb(entry) : kNoExponent);
    std::vector<int> column(n, 0);
    for (int sweep = 0; sweep < kSweeps; ++sweep) {
        std::vector<int> most(n, kNoExponent);
        for (std::size_t i = 0; i < p.Rows(); ++i) {
            const std::span<const int> row = std::span(exponents).subspan(i * n, n);
            int size = kNoExponent;
            for (std::size_t j = 0; j < n; ++j)
                size = std::max(size, row[j] - column[j]);
            for (std::size_t j = 0; j < n; ++j)
                if (row[j] != kNoExponent) most[j] = std::max(most[j], row[j] - size);
        }
        for (std::size_t j = 0; j < n; ++j)
            if (most[j] != kNoExponent) column[j] = most[j];
    }
    std::vector<long double> sizes;
    for (const int exponent : column)
        sizes.push_back(std::exp2(static_cast<long double>(exponent)));
    return FittedToWeights(p, std::move(sizes));
}

T_ULF_SCALED ScaleUlf(const T_ULF_PROBLEM& problem)
{
    std::vector<long double> weights = UlfWeights(problem.weights);
    std::vector<long double> sizes = UlfColumnSizes(problem);
    long double least = 0.0L, most = 0.0L;
    for (std::size_t j = 0; j < sizes.size(); ++j) {
        const bool isFree = !(problem.weights[j] > 0.0);
        const long double size = sizes[j] / weights[j] * (isFree ? kUlfFreeWeight : 1.0);
        least = j == 0 ? size : std::min(least, size);
        most = std::max(most, size);
    }
    const bool spreads = most > kUlfSpread * least;
    return ScaleUlf(problem, spreads ? std::move(sizes) : std::move(weights));
}

T_ULF_SCALED ScaleUlf(const T_ULF_PROBLEM& problem, std::vector<long double> metric)
{
    T_ULF_SCALED s;
    s.nVar = static_cast<std::size_t>(problem.nVar);
    s.nCon = problem.Rows();
    s.nEq = static_cast<std::size_t>(problem.nEq);
    s.sign = problem.sign;
    s.metric = std::move(metric);
    for (std::size_t j = 0; j < s.nVar; ++j) {
        s.cost.push_back(static_cast<double>(problem.weights[j] / s.metric[j]));
        s.isByWeight &= s.cost[j] == 1.0 || s.cost[j] == 0.0; // w / w is exactly 1
    }
    s.rows.resize(s.nCon * s.nVar);
    s.rowNorm.resize(s.nCon);
    for (std::size_t i = 0; i < s.nCon; ++i)
        ScaleRow(problem, i, s);
    s.rhsScale = RhsScale(problem, s);
    s.rhs.resize(s.nCon);
    for (std::size_t i = 0; i < s.nCon; ++i) {
        const long double b = problem.rhs[i] / s.rowNorm[i] / s.rhsScale;
        s.rhs[i] = static_cast<double>(std::clamp<long double>(b, -kLargestRhs, kLargestRhs));
    }
    return s;
}

std::vector<double> UnscaleUlf(const T_ULF_SCALED& scaled, std::span<const long double> y)
{
    std::vector<double> x(scaled.nVar);
    long double size = 0.0L;
    for (long double v : y)
        size = std::max(size, std::fabs(v));
    for (std::size_t j = 0; j < scaled.nVar; ++j) {
        const bool isNoise = std::fabs(y[j]) <= kNoise * size;
        const bool isPastSign = scaled.sign * y[j] < 0.0L; // within the tolerance of a row
        if (!isNoise && !isPastSign)
            x[j] = static_cast<double>(y[j] * scaled.rhsScale / scaled.metric[j]);
    }
    return x;
}
