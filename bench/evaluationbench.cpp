// Cost of the evaluation kernels. Every benchmark checks its answer: a fast wrong path fails.
#include "qm_rps/pushover/pushovertargetevaluation.h"
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptproca.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <chrono>
#include <cmath>
#include <memory>

namespace {

/// A curve and a demand on which a procedure needs several trials, so that what a run costs
/// before the first and after the last trial counts little. Lengths in m.
struct T_SETUP {
    int type;     // structural behaviour
    double yield; // displacement where the curve bends
    double slope; // of the curve beyond, g per m
    double Cv;    // velocity coefficient
};
constexpr T_SETUP kSmooth{0, 0.2, -0.1, 0.8};
constexpr T_SETUP kSharp{2, 0.01, -0.1, 0.8};

T_ADRS_CURVE Capacity(std::size_t n, const T_SETUP& setup)
{
    T_ADRS_CURVE c;
    for (std::size_t i = 0; i <= n; ++i) {
        const double d = 0.6 * (i == 0 ? 0.1 : static_cast<double>(i)) / static_cast<double>(n);
        c.Sd.push_back(d);
        c.Sa.push_back(0.22 * std::tanh(d / setup.yield) + setup.slope * d);
    }
    return c;
}

void Prepare(CPushOverPerfPtRecord& record, std::size_t steps, const T_SETUP& setup)
{
    record.SetGravity(9.80665, 9.80665);
    record.SetCapacity(Capacity(steps, setup));
    T_DAMP_PARAM damping;
    damping.behaviorType = setup.type;
    record.SetDamping(damping);
    T_SPFC_D spectrum;
    spectrum.data = T_SPFC_ATC40{0.4, setup.Cv, std::nullopt};
    record.SetDesignSpectrum(MakeDesignSpectrum(spectrum, setup.type, LIMIT_STATE::SLV));
}

/// One reduced spectrum of about 1,001 points in ADRS.
void ReducedSpectrum(benchmark::State& state)
{
    CPushOverPerfPtRecord record;
    Prepare(record, 200, kSmooth);
    std::vector<double> T, Sa, Sd;
    for (auto _ : state) {
        record.DesignSpectrum()->CalcPOSpectrumSRaSRv(0.6, 0.7, T, Sa);
        record.ToAdrs(T, Sa, Sd);
        benchmark::DoNotOptimize(Sd.data());
        benchmark::ClobberMemory();
    }
    if (T.size() < 1001 || std::fabs(Sa[30] - 0.6) > 1e-9) state.SkipWithError("wrong spectrum");
}
BENCHMARK(ReducedSpectrum);

/// Runs one evaluation per iteration and reports the time per trial.
template <class Make>
void PerTrial(benchmark::State& state, const T_SETUP& setup, Make make)
{
    CPushOverPerfPtRecord record;
    Prepare(record, 200, setup);
    double Dp = 0.0, Ap = 0.0;
    int result = 0;
    std::size_t trials = 0;
    for (auto _ : state) {
        const auto begin = std::chrono::steady_clock::now();
        auto calculator = make(record);
        std::optional<double> beta;
        result = calculator->CalcPerformancePoint(Dp, Ap, beta, nullptr);
        const auto end = std::chrono::steady_clock::now();
        trials = calculator->Trace().size();
        state.SetIterationTime(std::chrono::duration<double>(end - begin).count() /
                               static_cast<double>(trials));
    }
    if (result != kPerfPtFound || !(Dp > 0.01)) state.SkipWithError("no performance point");
    state.counters["trials"] = static_cast<double>(trials);
}

void Atc40TrialA(benchmark::State& state)
{
    PerTrial(state, kSmooth, [](auto& r) { return std::make_unique<CPushOverCalcPerfPtProcA>(r); });
}
BENCHMARK(Atc40TrialA)->UseManualTime();

void Fema440TrialA(benchmark::State& state)
{
    PerTrial(state, kSharp,
             [](auto& r) { return std::make_unique<CPushOverCalcPerfPtFEMA440ProcA>(r, 0); });
}
BENCHMARK(Fema440TrialA)->UseManualTime();

void Fema440TrialB(benchmark::State& state)
{
    PerTrial(state, kSmooth,
             [](auto& r) { return std::make_unique<CPushOverCalcPerfPtFEMA440ProcA>(r, 1); });
}
BENCHMARK(Fema440TrialB)->UseManualTime();

void Fema440TrialC(benchmark::State& state)
{
    PerTrial(state, kSharp,
             [](auto& r) { return std::make_unique<CPushOverCalcPerfPtFEMA440ProcC>(r); });
}
BENCHMARK(Fema440TrialC)->UseManualTime();

/// Crossing of a capacity curve of n steps with a demand curve of 5 n points.
void CrossCurves(benchmark::State& state, std::size_t n)
{
    const T_ADRS_CURVE capacity = Capacity(n, kSmooth);
    T_ADRS_CURVE demand;
    for (std::size_t i = 0; i <= 5 * n; ++i) {
        const double T = 10.0 * static_cast<double>(i) / static_cast<double>(5 * n);
        const double Sa = std::min(0.6, 0.4 / std::max(T, 0.01));
        demand.Sa.push_back(Sa);
        demand.Sd.push_back(T * T * Sa * 9.80665 / 39.4784176);
    }
    std::optional<T_POINT2> point;
    for (auto _ : state) {
        point = CCurveCrossing::CapacityWithDemand(capacity.View(), demand.View());
        benchmark::DoNotOptimize(point);
    }
    if (!point) state.SkipWithError("no crossing");
}
void Crossing1(benchmark::State& state)
{
    CrossCurves(state, 1000);
}
void Crossing4(benchmark::State& state)
{
    CrossCurves(state, 4000);
}
BENCHMARK(Crossing1);
BENCHMARK(Crossing4);

T_TARGET_INPUT TargetInput(std::size_t steps)
{
    T_TARGET_INPUT in;
    in.capacity = Capacity(steps, kSmooth);
    in.gamma = 1.3;
    in.mStar = 200.0;
    in.options = BilinearDefaults(BILINEAR_RULE::Ec8);
    in.spectra[0] = {[](double T) { return std::min(0.6, 0.3 / std::max(T, 1e-3)); }, 0.5};
    in.drift = [](int) { return 0.001; };
    return in;
}

void TargetEvaluation(benchmark::State& state)
{
    const T_TARGET_INPUT input = TargetInput(2000);
    int found = 0;
    for (auto _ : state) {
        CPushOverTargetEvaluation evaluation(input);
        found = evaluation.UpdateTargetDispDataEC8();
        benchmark::DoNotOptimize(evaluation.Rows().data());
    }
    if (!found) state.SkipWithError("no target");
}
BENCHMARK(TargetEvaluation);

/// One pass of area, peak and step search over the same arrays.
void AreaPeakSearch(benchmark::State& state)
{
    const T_TARGET_INPUT input = TargetInput(2000);
    const std::array<double, 3> demands{0.05, 0.1, 0.2};
    for (auto _ : state) {
        const T_ADRS_VIEW curve = input.capacity.View();
        benchmark::DoNotOptimize(AreaTo(curve, FirstPlaceAt(curve, 0.4)));
        benchmark::DoNotOptimize(FirstMaximum(input.capacity.Sa));
        benchmark::DoNotOptimize(FindNearestSteps(input.capacity.Sd, demands));
    }
}
BENCHMARK(AreaPeakSearch);

[[maybe_unused]] const int kRatios[] = {
    AddRatio(
        {"ATC-40 A: one trial / one reduced spectrum", "Atc40TrialA", "ReducedSpectrum", 1.0, 4.0}),
    AddRatio({"FEMA 440 A: one trial / one reduced spectrum", "Fema440TrialA", "ReducedSpectrum",
              1.0, 6.0}),
    AddRatio({"FEMA 440 B: one trial / one reduced spectrum", "Fema440TrialB", "ReducedSpectrum",
              1.0, 6.0}),
    AddRatio({"FEMA 440 C: one trial / one reduced spectrum", "Fema440TrialC", "ReducedSpectrum",
              1.0, 6.0}),
    AddRatio({"crossing with four times the points / once", "Crossing4", "Crossing1", 1.0, 5.0}),
    AddRatio({"target displacement / area, peak and step search", "TargetEvaluation",
              "AreaPeakSearch", 1.0, 3.0}),
};

} // namespace
