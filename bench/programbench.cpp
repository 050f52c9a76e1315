// Whole runs of the program: start to exit.
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <string>

namespace {

void Run(benchmark::State& state, const std::string& arguments)
{
    const std::string command = std::string(QM_RPS_PROGRAM) + " " + arguments + " > /dev/null";
    for (auto _ : state) {
        if (std::system(command.c_str()) != 0) state.SkipWithError("the program failed");
    }
}

void ProgramVersion(benchmark::State& state)
{
    Run(state, "--version");
}
void ProgramEvaluate(benchmark::State& state)
{
    Run(state, "evaluate " QM_EXAMPLES "/first-steps/case.json");
}
BENCHMARK(ProgramVersion)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(ProgramEvaluate)->Unit(benchmark::kMillisecond)->UseRealTime();

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"evaluate a small case / --version, start to exit", "ProgramEvaluate",
              "ProgramVersion", 1.0, 5.0}),
};

} // namespace
