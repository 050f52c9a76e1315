// The push of regular frames with hinges at both ends of all members, against a linear analysis of
// the same frame and against the number of solves that an event needs. Load factors are those of
// another solver (OpenSees 3.8.0, 100 displacement steps with full Newton); its times, taken on
// another day, stand beside them for the counter "faster".
#include "qm_solver/framesolver.h"
#include "qm_solver/pushsolver.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <string>
#include <vector>

namespace {

using namespace solver;

/// As many storeys as bays: n (2 n + 1) members.
struct T_REGULAR {
    std::size_t n = 0;
    double atHalf = 0.0, atEnd = 0.0; // load factors at 1 and at 2 per cent of the height
    double seconds = 0.0;             // of the other solver
};
constexpr T_REGULAR kSmall{7, 173.798971, 216.913682, 0.077};
constexpr T_REGULAR kMiddle{22, 122.567250, 151.368109, 1.5};
constexpr T_REGULAR kLarge{70, 99.458934, 122.220944, 51.0};

constexpr double kStorey = 3.5, kBay = 6.0; // m
constexpr double kE = 2e8;                  // kN/m2
constexpr std::size_t kSteps = 100;
constexpr int kMomentY = 4;

/// Node of a floor (0 is the ground) on an axis from the left.
std::size_t NodeAt(std::size_t n, std::size_t floor, std::size_t axis)
{
    return floor * (n + 1) + axis;
}

/// Springs of ten times 6EI/L, then one per cent of them; strengths differ by up to 4 per cent from
/// hinge to hinge, so that no two yield together.
void AddHinges(T_PUSH_MODEL& model, double I, double strength, double length)
{
    const double stiffness = 10.0 * 6.0 * kE * I / length;
    for (const double at : {0.0, 1.0}) {
        const double number = double(model.hinges.size() + 1);
        const double yield = strength * (1.0 + 0.04 * std::sin(7.3 * number + 1.0));
        T_HINGE_LAW law;
        law.component = kMomentY;
        law.stiffness = stiffness;
        const double deformation = yield / stiffness;
        law.positive.points = {{deformation, yield},
                               {deformation + 0.2, yield + 0.01 * stiffness * 0.2}};
        law.negative = law.positive;
        T_PUSH_HINGE hinge;
        hinge.element = model.frame.elements.size() - 1;
        hinge.at = at;
        hinge.laws.push_back(law);
        model.hinges.push_back(hinge);
    }
}

/// Columns storey by storey from the left, then beams; stronger below.
T_PUSH_MODEL Model(std::size_t n)
{
    T_PUSH_MODEL model;
    T_FRAME& frame = model.frame;
    frame.materials.push_back({kE, kE / 2.6, 0.0, 0.0});
    for (std::size_t floor = 0; floor <= n; ++floor)
        for (std::size_t axis = 0; axis <= n; ++axis) {
            T_NODE node;
            node.xyz = {kBay * double(axis), 0.0, kStorey * double(floor)};
            node.fixed = {false, true, false, true, false, true};
            if (floor == 0) node.fixed.fill(true);
            frame.nodes.push_back(node);
        }
    const auto add = [&](std::size_t i, std::size_t j, double A, double I) {
        T_ELEMENT e;
        e.i = i;
        e.j = j;
        e.section = frame.sections.size();
        frame.sections.push_back({A, 0.0, 0.0, I, I, I});
        frame.elements.push_back(e);
    };
    const auto share = [n](std::size_t floor) { return 1.0 + double(n - floor) / 4.0; };
    for (std::size_t floor = 1; floor <= n; ++floor)
        for (std::size_t axis = 0; axis <= n; ++axis) {
            add(NodeAt(n, floor - 1, axis), NodeAt(n, floor, axis), 0.03, 8e-4 * share(floor));
            AddHinges(model, 8e-4 * share(floor), 1500.0 * share(floor), kStorey);
        }
    for (std::size_t floor = 1; floor <= n; ++floor)
        for (std::size_t axis = 0; axis < n; ++axis) {
            add(NodeAt(n, floor, axis), NodeAt(n, floor, axis + 1), 0.02, 6e-4 * share(floor));
            AddHinges(model, 6e-4 * share(floor), 700.0 * share(floor), kBay);
        }
    return model;
}

/// 1 kN at every node above the ground, times the floor to a power.
T_LOAD_CASE Loads(std::size_t n, double power)
{
    T_LOAD_CASE loads;
    for (std::size_t floor = 1; floor <= n; ++floor)
        for (std::size_t axis = 0; axis <= n; ++axis)
            loads.nodal.push_back(
                {NodeAt(n, floor, axis), {std::pow(double(floor) / double(n), power)}});
    return loads;
}

/// The left node of the roof goes 2 per cent of the height in 100 steps.
T_PUSH_STAGE Stage(std::size_t n, double power, double sign)
{
    T_PUSH_STAGE stage;
    stage.loads = Loads(n, power);
    stage.node = NodeAt(n, n, 0);
    stage.target = sign * 0.02 * kStorey * double(n);
    for (std::size_t i = 1; i <= kSteps; ++i)
        stage.steps.push_back(double(i) / double(kSteps));
    return stage;
}

/// Runs one stage; false with the fault in `says`. Load factors by step.
bool Run(CPushSolver& solver, const T_PUSH_STAGE& stage, std::vector<double>& factors,
         std::string& says)
{
    factors.clear();
    T_PUSH_SINK sink;
    sink.step = [&](const T_PUSH_STEP& step) {
        factors.push_back(step.loadFactor);
        return true;
    };
    T_PUSH_END end;
    T_SOLVER_ERROR error;
    const T_PUSH_STAGE stages[] = {stage};
    if (!solver.Run(stages, sink, end, error)) says = error.reason.Text();
    if (says.empty() && (end.outcome != PUSH_OUTCOME::Reached || factors.size() != kSteps))
        says = "the target was not reached";
    return says.empty();
}

bool Near(double found, double wanted)
{
    return std::fabs(found - wanted) <= 1e-8 * wanted;
}

/// An event that brings a new hinge may cost 1.3 triangular solves, another one 0.05, a stored step
/// 1.2.
bool FewSolves(const T_PUSH_COST& cost)
{
    const double events = double(cost.events), columns = double(cost.columns);
    const double allowed =
        1.3 * columns + 0.05 * std::max(0.0, events - columns) + 1.2 * double(kSteps);
    constexpr double kLoads = 4.0; // initial loads and the pattern
    return double(cost.solves) <= allowed + kLoads && cost.factorisations == 1;
}

void Push(benchmark::State& state, const T_REGULAR& frame)
{
    const T_PUSH_MODEL model = Model(frame.n);
    const T_PUSH_STAGE stage = Stage(frame.n, 0.0, 1.0);
    std::vector<double> factors;
    T_PUSH_COST cost;
    for (auto _ : state) {
        CPushSolver solver;
        T_SOLVER_ERROR error;
        std::string says;
        if (!solver.Prepare(model, error) || !Run(solver, stage, factors, says))
            return state.SkipWithError((error.reason.Text() + says).c_str());
        cost = solver.Cost();
    }
    if (!Near(factors[kSteps / 2 - 1], frame.atHalf) || !Near(factors.back(), frame.atEnd))
        state.SkipWithError("load factors differ from the other solver's");
    if (!FewSolves(cost)) state.SkipWithError("too many solves or factorisations");
    state.counters["events"] = double(cost.events);
    state.counters["columns"] = double(cost.columns);
    state.counters["solves"] = double(cost.solves);
    state.counters["faster"] =
        benchmark::Counter(frame.seconds, benchmark::Counter::kIsIterationInvariantRate);
}
void PushSmall(benchmark::State& state)
{
    Push(state, kSmall);
}
void PushMiddle(benchmark::State& state)
{
    Push(state, kMiddle);
}
void PushLarge(benchmark::State& state)
{
    Push(state, kLarge);
}

/// Assembly, factorisation, one load case to member forces: of the same frame without hinges.
void Analyse(benchmark::State& state, const T_REGULAR& frame)
{
    const T_PUSH_MODEL model = Model(frame.n);
    const std::vector<T_LOAD_CASE> loads{Loads(frame.n, 0.0)};
    for (auto _ : state) {
        CFrameSolver solver;
        T_SOLVER_ERROR error;
        std::vector<T_RESULT> results;
        if (!solver.Prepare(model.frame, error) || !solver.Solve(loads, results, error))
            return state.SkipWithError(error.reason.Text().c_str());
        if (!(results[0].displacement.back()[0] > 0.0)) state.SkipWithError("no sway");
    }
}
void AnalyseSmall(benchmark::State& state)
{
    Analyse(state, kSmall);
}
void AnalyseMiddle(benchmark::State& state)
{
    Analyse(state, kMiddle);
}
void AnalyseLarge(benchmark::State& state)
{
    Analyse(state, kLarge);
}

/// Eight load cases of one model: four patterns, both directions.
void PushEightCases(benchmark::State& state)
{
    const T_PUSH_MODEL model = Model(kMiddle.n);
    std::vector<double> factors;
    for (auto _ : state) {
        CPushSolver solver;
        T_SOLVER_ERROR error;
        std::string says;
        bool good = solver.Prepare(model, error);
        for (const double power : {0.0, 0.5, 1.0, 2.0})
            for (const double sign : {1.0, -1.0})
                good = good && Run(solver, Stage(kMiddle.n, power, sign), factors, says);
        if (!good) return state.SkipWithError((error.reason.Text() + says).c_str());
        if (solver.Cost().factorisations > 1) state.SkipWithError("factorised again");
    }
}

/// The whole program on a frame of nine storeys with P-Delta and loss of strength, start to exit.
void NineStoreys(benchmark::State& state, const std::string& command)
{
    const std::string line = std::string(QM_RPS_PROGRAM) + " " + command +
                             " " QM_EXAMPLES "/../tests/data/push/f9s5b_mode1.json > /dev/null";
    for (auto _ : state)
        if (std::system(line.c_str()) != 0) state.SkipWithError("the program failed");
}
void PushNineStoreys(benchmark::State& state)
{
    NineStoreys(state, "push");
}
void AnalyseNineStoreys(benchmark::State& state)
{
    NineStoreys(state, "analyse");
}
BENCHMARK(PushNineStoreys)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(AnalyseNineStoreys)->Unit(benchmark::kMillisecond)->UseRealTime();

BENCHMARK(PushSmall)->Unit(benchmark::kMillisecond);
BENCHMARK(PushMiddle)->Unit(benchmark::kMillisecond);
BENCHMARK(PushLarge)->Unit(benchmark::kMillisecond)->Iterations(1);
BENCHMARK(AnalyseSmall)->Unit(benchmark::kMillisecond);
BENCHMARK(AnalyseMiddle)->Unit(benchmark::kMillisecond);
BENCHMARK(AnalyseLarge)->Unit(benchmark::kMillisecond)->Iterations(2);
BENCHMARK(PushEightCases)->Unit(benchmark::kMillisecond);

[[maybe_unused]] const int kRatios[] = {
    AddRatio(
        {"push of 105 members / their linear analysis", "PushSmall", "AnalyseSmall", 1.0, 10.0}),
    AddRatio(
        {"push of 990 members / their linear analysis", "PushMiddle", "AnalyseMiddle", 1.0, 30.0}),
    AddRatio(
        {"push of 9,870 members / their linear analysis", "PushLarge", "AnalyseLarge", 1.0, 100.0}),
    AddRatio({"program: push of 9 storeys / their linear analysis", "PushNineStoreys",
              "AnalyseNineStoreys", 1.0, 5.0}),
    AddRatio({"push in eight load cases / in one", "PushEightCases", "PushMiddle", 1.0, 5.0}),
};

} // namespace
