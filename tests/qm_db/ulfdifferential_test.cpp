// The solver against enumeration of all active sets.
#include "ulfplanted.h"

#include "qm_db/rps_unknownloadfactormanager.h"

#include <gtest/gtest.h>

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <optional>

namespace {

using T_LONG_VECTOR = Eigen::Matrix<long double, Eigen::Dynamic, 1>;
using T_LONG_MATRIX = Eigen::Matrix<long double, Eigen::Dynamic, Eigen::Dynamic>;

constexpr int kSmallProblems = 400;
constexpr long double kMetTol = 1e-9L; // rows of small integers
constexpr double kLess = 1e-6;         // of an objective that nothing may reach

/// Row * y <= b, or = b.
struct T_HALF {
    T_LONG_VECTOR a;
    long double b;
    bool isEquality;
};

/// A few unknowns, entries from -2 to 2: repeated, parallel, zero and contradictory rows abound.
T_PLANTED SmallIntegers(int seed)
{
    CUlfPlanter random(static_cast<std::uint64_t>(seed));
    const auto whole = [&](int low, int high) {
        return low + static_cast<int>(random.Below(static_cast<std::size_t>(high - low + 1)));
    };
    T_PLANTED p;
    p.nVar = whole(1, 3);
    const int m = whole(1, 6);
    p.nEq = whole(0, std::min(2, m));
    p.objective = 1 + seed % 3;
    p.sign = seed / 3 % 3 - 1;
    for (int i = 0; i < m * p.nVar; ++i)
        p.rows.push_back(whole(-2, 2));
    for (int i = 0; i < m; ++i)
        p.rhs.push_back(whole(-3, 3));
    for (int j = 0; j < p.nVar; ++j)
        p.weights.push_back(whole(1, 2));
    return p;
}

/// The rows and signs in y = w x.
std::vector<T_HALF> Halves(const T_PLANTED& p, bool signs)
{
    std::vector<T_HALF> all;
    const Eigen::Index n = p.nVar;
    for (std::size_t i = 0; i < p.rhs.size(); ++i) {
        T_HALF h{T_LONG_VECTOR(n), p.rhs[i], i < static_cast<std::size_t>(p.nEq)};
        for (Eigen::Index j = 0; j < n; ++j)
            h.a(j) = p.Problem().Row(i)[static_cast<std::size_t>(j)] /
                     p.weights[static_cast<std::size_t>(j)];
        all.push_back(h);
    }
    for (Eigen::Index j = 0; signs && p.sign != 0 && j < n; ++j)
        all.push_back({-p.sign * T_LONG_VECTOR::Unit(n, j), 0.0L, false});
    return all;
}

/// objective(y) <= value as rows.
void AddObjective(const T_PLANTED& p, long double value, std::vector<T_HALF>& to)
{
    const Eigen::Index n = p.nVar;
    for (int corner = 0; corner < (p.objective == 1 ? 1 << n : 0); ++corner) {
        T_LONG_VECTOR a(n);
        for (Eigen::Index j = 0; j < n; ++j)
            a(j) = corner >> j & 1 ? 1.0L : -1.0L;
        to.push_back({a, value, false});
    }
    for (Eigen::Index j = 0; p.objective == 3 && j < n; ++j)
        for (const long double side : {-1.0L, 1.0L})
            to.push_back({side * T_LONG_VECTOR::Unit(n, j), value, false});
}

bool Meets(const std::vector<T_HALF>& rows, const T_LONG_VECTOR& y)
{
    return std::all_of(rows.begin(), rows.end(), [&](const T_HALF& h) {
        const long double v = h.a.dot(y) - h.b;
        return (h.isEquality ? std::fabs(v) : v) <= kMetTol;
    });
}

/// The shortest y that meets the rows: the best of the shortest points of every set of up to n
/// independent rows taken as equalities.
std::optional<T_LONG_VECTOR> Shortest(const std::vector<T_HALF>& rows, Eigen::Index n)
{
    std::optional<T_LONG_VECTOR> best;
    const auto consider = [&](const std::vector<std::size_t>& set) {
        T_LONG_VECTOR y = T_LONG_VECTOR::Zero(n);
        if (!set.empty()) {
            T_LONG_MATRIX a(static_cast<Eigen::Index>(set.size()), n);
            T_LONG_VECTOR b(a.rows());
            for (Eigen::Index i = 0; i < a.rows(); ++i) {
                a.row(i) = rows[set[static_cast<std::size_t>(i)]].a.transpose();
                b(i) = rows[set[static_cast<std::size_t>(i)]].b;
            }
            const Eigen::FullPivLU<T_LONG_MATRIX> lu(a * a.transpose());
            if (lu.rank() < a.rows()) return;
            y = a.transpose() * lu.solve(b);
        }
        if (Meets(rows, y) && (!best || y.norm() < best->norm())) best = y;
    };
    const std::size_t m = rows.size();
    consider({});
    for (std::size_t i = 0; i < m; ++i) {
        consider({i});
        for (std::size_t j = i + 1; j < m && n > 1; ++j) {
            consider({i, j});
            for (std::size_t k = j + 1; k < m && n > 2; ++k)
                consider({i, j, k});
        }
    }
    return best;
}

/// Code of the stage at which no point is left, and the shortest point otherwise.
int EnumeratedCode(const T_PLANTED& p)
{
    std::vector<T_HALF> rows = Halves(p, false);
    const std::vector<T_HALF> equal(rows.begin(), rows.begin() + p.nEq);
    if (!Shortest(equal, p.nVar)) return 5;
    if (!Shortest(rows, p.nVar)) return 6;
    return Shortest(Halves(p, true), p.nVar) ? 0 : 7;
}

int Solve(const T_PLANTED& p, std::vector<double>& x)
{
    x.assign(p.weights.size(), 7.0);
    CRps_UnknownLoadFactorManager manager;
    int error = 77;
    const int done =
        manager.Calc_UnknownLoadFactor(1, static_cast<int>(p.rhs.size()), p.nVar, p.nEq, p.rows,
                                       p.rhs, x, p.weights, p.objective, p.sign, error);
    return done ? error : 99;
}

double Objective(const T_PLANTED& p, const std::vector<double>& x)
{
    double sum = 0.0, most = 0.0;
    for (std::size_t j = 0; j < x.size(); ++j) {
        sum += std::fabs(p.weights[j] * x[j]);
        most = std::max(most, std::fabs(p.weights[j] * x[j]));
    }
    return p.objective == 1 ? sum : most;
}

} // namespace

TEST(UlfDifferential, SmallProblemsAgreeWithEnumerationOfAllActiveSets)
{
    int solved = 0;
    for (int seed = 0; seed < kSmallProblems; ++seed) {
        const T_PLANTED p = SmallIntegers(seed);
        std::vector<double> x;
        const int code = Solve(p, x);
        ASSERT_EQ(EnumeratedCode(p), code) << "seed " << seed;
        if (code != 0) continue;
        ++solved;
        const std::vector<T_HALF> all = Halves(p, true);
        std::vector<T_HALF> rows = all, better = all;
        AddObjective(p, Objective(p, x), rows);
        AddObjective(p, Objective(p, x) - kLess, better);
        EXPECT_TRUE(p.objective == 2 || !Shortest(better, p.nVar)) << "seed " << seed;
        const std::optional<T_LONG_VECTOR> y = Shortest(rows, p.nVar);
        ASSERT_TRUE(y) << "seed " << seed;
        for (std::size_t j = 0; j < x.size(); ++j)
            EXPECT_NEAR(static_cast<double>((*y)(static_cast<Eigen::Index>(j))),
                        p.weights[j] * x[j], 1e-8)
                << "seed " << seed;
    }
    EXPECT_GT(solved, kSmallProblems / 4); // the sample holds both kinds
    EXPECT_LT(solved, kSmallProblems * 3 / 4);
}
