// Unknown load factors against the linear programming library alone on the same scaled rows.
#include "qm_solver/factors/ulffallback.h"
#include "qm_solver/ulfsolver.h"
#include "ratios.h"
#include "ulfplanted.h"

#include <benchmark/benchmark.h>

namespace {

constexpr int kUnknowns = 300, kConstraints = 2000;
constexpr double kTol = 1e-8; // of the planted optimum

const T_PLANTED& Planted(int objective)
{
    static const T_PLANTED all[] = {
        CUlfPlanter(77).Plant(PLANT::Plain, 1, 0, kUnknowns, kConstraints),
        CUlfPlanter(77).Plant(PLANT::Plain, 2, 0, kUnknowns, kConstraints),
        CUlfPlanter(77).Plant(PLANT::Plain, 3, 0, kUnknowns, kConstraints)};
    return all[objective - 1];
}

void SolveFactors(benchmark::State& state, int objective)
{
    const T_ULF_PROBLEM problem = Planted(objective).Problem();
    const double optimum = UlfObjective(problem, Planted(objective).x);
    for (auto _ : state) {
        const T_ULF_ANSWER answer = SolveUlf(problem);
        if (answer.code != 0 || !(answer.certificate.objective <= optimum * (1.0 + kTol)))
            state.SkipWithError("wrong optimum");
    }
}

/// The simplex method alone: matrix, scaling and certificate are not counted.
void SolveByLibrary(benchmark::State& state, int objective)
{
    const T_ULF_PROBLEM problem = Planted(objective).Problem();
    const T_ULF_SCALED scaled = ScaleUlf(problem);
    const T_ULF_LINEAR linear = LinearUlf(objective, scaled);
    const double optimum = UlfObjective(problem, Planted(objective).x);
    for (auto _ : state) {
        T_ULF_VERTEX vertex;
        if (!SolveUlfVertex(linear, vertex)) state.SkipWithError("no optimum");
        const std::vector<long double> y(vertex.y.begin(), vertex.y.begin() + kUnknowns);
        if (!(UlfObjective(problem, UnscaleUlf(scaled, y)) <= optimum * (1.0 + kTol)))
            state.SkipWithError("wrong optimum");
    }
}

void SumOfFactors(benchmark::State& state)
{
    SolveFactors(state, 1);
}
void SquareSumOfFactors(benchmark::State& state)
{
    SolveFactors(state, 2);
}
void LargestFactor(benchmark::State& state)
{
    SolveFactors(state, 3);
}
void SumByLibrary(benchmark::State& state)
{
    SolveByLibrary(state, 1);
}
void LargestByLibrary(benchmark::State& state)
{
    SolveByLibrary(state, 3);
}

BENCHMARK(SumOfFactors)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK(SquareSumOfFactors)->Unit(benchmark::kMillisecond)->Iterations(5);
BENCHMARK(LargestFactor)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK(SumByLibrary)->Unit(benchmark::kMillisecond)->Iterations(1); // 20 s
BENCHMARK(LargestByLibrary)->Unit(benchmark::kMillisecond)->Iterations(1);

// The library's quadratic method took 85 s on the square sum; its linear one is the stricter limit.
[[maybe_unused]] const int kRatios[] = {
    AddRatio(
        {"factors 300 x 2,000, sum / simplex alone", "SumOfFactors", "SumByLibrary", 1.0, 2.0}),
    AddRatio({"factors 300 x 2,000, largest / simplex alone", "LargestFactor", "LargestByLibrary",
              1.0, 2.0}),
    AddRatio({"factors 300 x 2,000, square sum / simplex alone on the sum", "SquareSumOfFactors",
              "SumByLibrary", 1.0, 2.0}),
};

} // namespace
