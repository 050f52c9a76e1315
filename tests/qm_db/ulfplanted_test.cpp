// Problems whose only answer was planted.
#include "ulfplanted.h"

#include "qm_db/rps_unknownloadfactormanager.h"
#include "qm_solver/factors/ulffallback.h"

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

/// Equalities and inequalities each in the other order.
T_PLANTED Backwards(T_PLANTED p)
{
    const auto nEq = p.rhs.begin() + p.nEq;
    std::reverse(p.rhs.begin(), nEq);
    std::reverse(nEq, p.rhs.end());
    const auto end = p.rows.begin() + p.nEq * p.nVar;
    std::reverse(p.rows.begin(), end); // the unknowns too: put right below
    std::reverse(end, p.rows.end());
    for (auto row = p.rows.begin(); row != p.rows.end(); row += p.nVar)
        std::reverse(row, row + p.nVar);
    return p;
}

} // namespace

TEST(UlfPlanted, EveryPlantedAnswerIsFoundAndEveryContradictionNamedInAnyOrderOfTheRows)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& planted, const std::string& what) {
        for (const T_PLANTED& p : {planted, Backwards(planted)}) {
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
        }
    });
}

TEST(UlfPlanted, TheSimplexMethodAndTheTieBreakGiveTheSameAnswer)
{
    ForAll([](const T_KIND& kind, const T_PLANTED& p, const std::string& what) {
        if (p.objective == 2 || kind.kind == PLANT::NearDuplicate) return;
        const T_ULF_ANSWER a =
            SolveUlfFallback(p.Problem(), ScaleUlf(p.Problem()), ULF_PRECISION::Double);
        EXPECT_EQ(kind.error, a.code) << what;
        if (a.code == 0) {
            EXPECT_LE(Apart(p, p.x, a.x), kind.tol) << what;
        }
    });
}
