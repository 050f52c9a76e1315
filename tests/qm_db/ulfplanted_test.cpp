// Problems whose only answer was planted, and the conditions of optimality from the original rows.
#include "ulfplanted.h"

#include "qm_db/rps_unknownloadfactormanager.h"
#include "qm_solver/factors/ulffallback.h"
#include "qm_solver/ulfdiagnosis.h"

#include <gtest/gtest.h>
#include <numeric>

namespace {

constexpr int kSizes[] = {3, 4, 7, 12, 25};
constexpr int kDraws = 8;

struct T_KIND {
    const char* label;
    PLANT kind;
    int error;
    double tol; // of the answer, relative: rounding times the conditioning of the rows
};

const T_KIND kKinds[] = {
    {"plain", PLANT::Plain, 0, 1e-10},
    {"degenerate", PLANT::Degenerate, 0, 1e-10},
    {"scaled", PLANT::Scaled, 0, 1e-10},
    {"near duplicate", PLANT::NearDuplicate, 0, 1e-6}, // rows 1e-7 apart, known to 1e-16
    {"no equalities", PLANT::NoEqualities, 5, 0.0},
    {"no rows", PLANT::NoRows, 6, 0.0},
    {"wrong sign", PLANT::WrongSign, 7, 0.0},
};

/// Runs every draw of every class: use(kind, planted, description).
template <class T_USE>
void ForAll(const T_USE& use)
{
    for (const T_KIND& kind : kKinds)
        for (int objective = 1; objective <= 3; ++objective)
            for (int sign = -1; sign <= 1; ++sign)
                for (const int n : kSizes)
                    for (int draw = 0; draw < kDraws; ++draw) {
                        if (kind.kind == PLANT::WrongSign && sign == 0) continue;
                        const int seed = 1000 * n + 100 * objective + 10 * (sign + 1) + draw;
                        CUlfPlanter planter(static_cast<std::uint64_t>(seed));
                        use(kind, planter.Plant(kind.kind, objective, sign, n, n + 6 * draw),
                            std::string(kind.label) + " seed " + std::to_string(seed));
                    }
}

int Solve(const T_PLANTED& p, std::vector<double>& x, int& error)
{
    x.assign(p.weights.size(), 7.0);
    CRps_UnknownLoadFactorManager manager;
    return manager.Calc_UnknownLoadFactor(1, static_cast<int>(p.rhs.size()), p.nVar, p.nEq, p.rows,
                                          p.rhs, x, p.weights, p.objective, p.sign, error);
}

/// Largest difference of w x, relative to the largest w x of the first.
double Apart(const T_PLANTED& p, const std::vector<double>& a, const std::vector<double>& b)
{
    double most = 0.0, size = 0.0;
    for (std::size_t j = 0; j < a.size(); ++j) {
        most = std::max(most, p.weights[j] * std::fabs(a[j] - b[j]));
        size = std::max(size, p.weights[j] * std::fabs(a[j]));
    }
    return most / size;
}

/// What the gradient of the objective lacks against the multipliers, relative; unknowns by weight.
long double KktMiss(const T_PLANTED& p, const T_ULF_EXPLANATION& e)
{
    std::vector<long double> pull(p.weights.size()); // sum of d objective / d rhs * row
    for (const T_ULF_HELD& held : e.rows)
        for (std::size_t j = 0; j < pull.size(); ++j)
            pull[j] += static_cast<long double>(held.multiplier) *
                       p.Problem().Row(static_cast<std::size_t>(held.index))[j] / p.weights[j];
    for (const T_ULF_HELD& held : e.signs)
        pull[static_cast<std::size_t>(held.index)] +=
            p.sign * held.multiplier / p.weights[static_cast<std::size_t>(held.index)];
    long double miss = 0.0L, largest = 0.0L, all = 0.0L;
    for (std::size_t j = 0; j < pull.size(); ++j)
        largest = std::max<long double>(largest, p.weights[j] * std::fabs(e.factors[j]));
    for (std::size_t j = 0; j < pull.size(); ++j) {
        const long double y = static_cast<long double>(p.weights[j]) * e.factors[j];
        if (p.objective == 2) miss = std::max(miss, std::fabs(2.0L * y - pull[j]) / largest);
        if (p.objective == 1 && std::fabs(y) > 1e-9L * largest)
            miss = std::max(miss, std::fabs(pull[j] - std::copysign(1.0L, y)));
        const bool isAtSign = p.sign != 0 && !(std::fabs(y) > 1e-9L * largest);
        const long double over = isAtSign ? p.sign * pull[j] : std::fabs(pull[j]);
        if (p.objective == 1) miss = std::max(miss, over - 1.0L);
        if (p.objective == 3 && std::fabs(y) < (1.0L - 1e-6L) * largest)
            miss = std::max(miss, isAtSign ? over : std::fabs(pull[j]));
        all += std::max(0.0L, y >= 0.0L ? pull[j] : -pull[j]);
    }
    return p.objective == 3 ? std::max(miss, std::fabs(all - 1.0L)) : miss;
}

/// Largest violation, each row relative to the sum of its terms' sizes.
long double Violation(const T_PLANTED& p, const std::vector<double>& x)
{
    long double most = 0.0L;
    for (std::size_t i = 0; i < p.rhs.size(); ++i) {
        long double sum = 0.0L, size = std::fabs(p.rhs[i]);
        for (std::size_t j = 0; j < x.size(); ++j) {
            sum += static_cast<long double>(p.Problem().Row(i)[j]) * x[j];
            size += std::fabs(p.Problem().Row(i)[j] * x[j]);
        }
        const long double v = (sum - p.rhs[i]) / size;
        most = std::max(most, i < static_cast<std::size_t>(p.nEq) ? std::fabs(v) : v);
    }
    for (double v : x)
        if (p.sign * v < 0.0) return 1.0L;
    return most;
}

} // namespace

TEST(UlfPlanted, EveryPlantedAnswerIsFoundAndEveryContradictionNamed)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& p, const std::string& what) {
        std::vector<double> x;
        int error = 77;
        EXPECT_EQ(1, Solve(p, x, error)) << what;
        EXPECT_EQ(kind.error, error) << what;
        if (error == 0) {
            EXPECT_LE(Apart(p, p.x, x), kind.tol) << what;
            EXPECT_LE(Violation(p, x), 1e-11L) << what;
        } else {
            EXPECT_EQ(std::vector<double>(x.size(), 0.0), x) << what;
        }
    });
}

TEST(UlfPlanted, TheOrderOfTheRowsDoesNotMatter)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& p, const std::string& what) {
        T_PLANTED turned = p;
        const std::size_t m = p.rhs.size(), n = p.weights.size();
        const auto nEq = static_cast<std::size_t>(p.nEq);
        for (std::size_t i = 0; i < m; ++i) { // equalities and inequalities each backwards
            const std::size_t from = i < nEq ? nEq - 1 - i : m - 1 - (i - nEq);
            turned.rhs[i] = p.rhs[from];
            for (std::size_t j = 0; j < n; ++j)
                turned.rows[i * n + j] = p.rows[from * n + j];
        }
        std::vector<double> x, y;
        int error = 77, other = 78;
        EXPECT_EQ(1, Solve(p, x, error)) << what;
        EXPECT_EQ(1, Solve(turned, y, other)) << what;
        EXPECT_EQ(error, other) << what;
        if (error == 0) {
            EXPECT_LE(Apart(p, x, y), kind.tol) << what;
        }
    });
}

TEST(UlfPlanted, MultipliersInTheUsersUnitsMeetTheConditionsOfOptimality)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& p, const std::string& what) {
        T_ULF_EXPLANATION e;
        EXPECT_EQ(kind.error == 0 ? 1 : 0, CUlfDiagnosis().Explain(p.Problem(), e)) << what;
        if (kind.error != 0) return;
        EXPECT_LE(KktMiss(p, e), 2e-9L) << what;
        for (const T_ULF_HELD& held : e.rows)
            if (held.index >= p.nEq) {
                EXPECT_LE(held.multiplier, 1e-9) << what;
            }
        for (const T_ULF_HELD& held : e.signs)
            EXPECT_GE(held.multiplier, 0.0) << what;
    });
}

TEST(UlfPlanted, TheSimplexMethodAndTheTieBreakGiveTheSameAnswer)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& p, const std::string& what) {
        if (p.objective == 2 || kind.kind == PLANT::NearDuplicate) return;
        const T_ULF_ANSWER a = SolveUlfFallback(p.Problem(), ScaleUlf(p.Problem()));
        EXPECT_EQ(kind.error, a.code) << what;
        if (a.code == 0) {
            EXPECT_LE(Apart(p, p.x, a.x), kind.tol) << what;
        }
    });
}

TEST(UlfPlanted, ScalingTheLoadsScalesTheFactors)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& p, const std::string& what) {
        T_PLANTED twice = p;
        for (double& b : twice.rhs)
            b *= 3.0;
        std::vector<double> x, y;
        int error = 77, other = 78;
        EXPECT_EQ(1, Solve(p, x, error)) << what;
        EXPECT_EQ(1, Solve(twice, y, other)) << what;
        EXPECT_EQ(error, other) << what;
        for (double& v : x)
            v *= 3.0;
        if (error == 0) {
            EXPECT_LE(Apart(p, x, y), kind.tol) << what;
        }
    });
}
