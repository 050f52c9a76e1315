// Cost of 20 construction stages of up to 20,280 unknowns, against the factorisations of their
// active parts alone.
#include "qm_solver/stagedsolver.h"
#include "qm_solver/stages/stagepart.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <ctime>
#include <functional>

namespace {

using namespace solver;

constexpr std::size_t kBays = 13, kStages = 20; // 13 x 13 columns, a storey a stage

std::size_t NodeAt(std::size_t x, std::size_t y, std::size_t z)
{
    return (z * kBays + y) * kBays + x;
}

T_STAGED_MODEL Rising()
{
    T_STAGED_MODEL model;
    T_FRAME& frame = model.frame;
    frame.materials.push_back({2.1e8, 8.1e7, 7.85, 1.2e-5});
    frame.sections.push_back({1.5e-2, 5e-3, 5e-3, 3e-6, 2.5e-4, 8e-5});
    model.groups = {LOAD_GROUP::Dead, LOAD_GROUP::Rest};
    model.stages.resize(kStages);
    for (std::size_t z = 0; z <= kStages; ++z)
        for (std::size_t y = 0; y < kBays; ++y)
            for (std::size_t x = 0; x < kBays; ++x) {
                T_NODE node;
                node.xyz = {6.0 * double(x), 5.0 * double(y), 3.2 * double(z)};
                node.fixed.fill(z == 0);
                frame.nodes.push_back(node);
                if (z == 0) model.stages[0].activateSupports.push_back({NodeAt(x, y, z), {}});
                const auto join = [&](std::size_t other) {
                    T_ELEMENT e;
                    e.i = other;
                    e.j = NodeAt(x, y, z);
                    model.stages[z - 1].activateElements.push_back(frame.elements.size());
                    frame.elements.push_back(e);
                };
                if (z == 0) continue;
                join(NodeAt(x, y, z - 1));
                if (x > 0) join(NodeAt(x - 1, y, z));
                if (y > 0) join(NodeAt(x, y - 1, z));
            }
    model.stages[0].activateLoads = {{0, kFirstStep}};
    model.stages[kStages / 2].activateLoads = {{1, kFirstStep}};
    return model;
}

/// The weight, and wind on the lower half.
std::vector<T_LOAD_CASE> Loads()
{
    std::vector<T_LOAD_CASE> loads(2);
    loads[0].selfWeight = {0, 0, -1};
    for (std::size_t z = 1; z <= kStages / 2; ++z)
        loads[1].nodal.push_back({NodeAt(0, 0, z), {10.0, 0, 0, 0, 0, 0}});
    return loads;
}

const T_STAGED_MODEL& Model()
{
    static const T_STAGED_MODEL model = Rising();
    return model;
}

/// Time of the processor, which other programs on the machine do not change much.
double Seconds(const std::function<void()>& work)
{
    const std::clock_t from = std::clock();
    work();
    return static_cast<double>(std::clock() - from) / CLOCKS_PER_SEC;
}

void Measure(benchmark::State& state, const std::function<void()>& work)
{
    for (auto _ : state)
        state.SetIterationTime(Seconds(work));
}

bool Check(benchmark::State& state, CStagedSolver& staged)
{
    T_SOLVER_ERROR error;
    T_RESULT r;
    if (!staged.Run(Loads(), error)) {
        state.SkipWithError(error.reason.Text().c_str());
        return false;
    }
    const bool good = staged.ReadCase(kStages - 1, kLastStep, 0, r) &&
                      r.displacement.back()[2] < 0.0 && staged.Cost().analyses == kStages;
    if (!good) state.SkipWithError("no settlement");
    return good;
}

void StagesFirst(benchmark::State& state)
{
    Measure(state, [&] {
        CStagedSolver staged;
        T_SOLVER_ERROR error;
        if (!staged.Prepare(Model(), error)) state.SkipWithError(error.reason.Text().c_str());
        Check(state, staged);
    });
}
BENCHMARK(StagesFirst)
    ->Unit(benchmark::kMillisecond)
    ->UseManualTime()
    ->Iterations(1)
    ->Repetitions(3);

void StagesAgain(benchmark::State& state)
{
    CStagedSolver staged;
    T_SOLVER_ERROR error;
    if (!staged.Prepare(Model(), error)) state.SkipWithError(error.reason.Text().c_str());
    Check(state, staged); // the first run also looks for mechanisms
    Measure(state, [&] { Check(state, staged); });
}
BENCHMARK(StagesAgain)
    ->Unit(benchmark::kMillisecond)
    ->UseManualTime()
    ->Iterations(1)
    ->Repetitions(3);

/// The active parts, assembled; analysis and factorisation alone are timed.
struct T_PARTS {
    std::vector<std::unique_ptr<CStagePart>> parts;
    T_PARTS()
    {
        T_STAGE_PLAN plan;
        if (MakePlan(Model(), plan)) return;
        const auto space = std::make_shared<CFactorSpace>();
        for (const T_ACTIVE& active : plan.active) {
            parts.push_back(std::make_unique<CStagePart>(Model().frame, active));
            if (parts.back()->Prepare(space) || parts.back()->Factorise()) parts.clear();
        }
    }
};
T_PARTS& Parts()
{
    static T_PARTS parts;
    return parts;
}

void PartsFactorised(benchmark::State& state)
{
    auto& parts = Parts().parts;
    T_SOLVER_REASON reason;
    if (parts.size() != kStages || parts.back()->Dofs().EquationCount() != 20280)
        state.SkipWithError("parts missing");
    Measure(state, [&] {
        for (auto& part : parts)
            if (!part->Factor().Factor(part->Matrix(), reason))
                state.SkipWithError(reason.Text().c_str());
    });
}
BENCHMARK(PartsFactorised)
    ->Unit(benchmark::kMillisecond)
    ->UseManualTime()
    ->Iterations(1)
    ->Repetitions(3);

void PartsAnalysedAndFactorised(benchmark::State& state)
{
    T_SOLVER_REASON reason;
    Measure(state, [&] {
        for (auto& part : Parts().parts) {
            CSparseFactor factor;
            if (!factor.Analyse(part->Matrix(), part->Dofs().Blocks(), reason) ||
                !factor.Factor(part->Matrix(), reason))
                state.SkipWithError(reason.Text().c_str());
        }
    });
}
BENCHMARK(PartsAnalysedAndFactorised)
    ->Unit(benchmark::kMillisecond)
    ->UseManualTime()
    ->Iterations(1)
    ->Repetitions(3);

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"20 stages / analyses and factorisations of their parts", "StagesFirst",
              "PartsAnalysedAndFactorised", 1.0, 1.3}),
    AddRatio({"20 stages again / factorisations of their parts", "StagesAgain", "PartsFactorised",
              1.0, 1.3}),
};

} // namespace
