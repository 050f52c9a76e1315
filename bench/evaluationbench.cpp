// Cost of the evaluation kernels. Every benchmark checks its answer: a fast wrong path fails.
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptproca.h"
#include "qm_rps/pushovertargetevaluation.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <chrono>
#include <cmath>
#include <memory>

namespace {

T_SPFC_D Spectrum()
{
    T_SPFC_D record;
    record.name = "D";
    record.data = T_SPFC_ATC40{0.4, 0.6, std::nullopt};
    return record;
}

/// A softly hardening curve of n steps, lengths in m: yields gradually near 0.04 m.
T_ADRS_CURVE Capacity(std::size_t n)
{
    T_ADRS_CURVE c;
    for (std::size_t i = 0; i <= n; ++i) {
        const double d = 0.4 * (i == 0 ? 0.1 : static_cast<double>(i)) / static_cast<double>(n);
        c.Sd.push_back(d);
        c.Sa.push_back(0.22 * std::tanh(d / 0.03) + 0.1 * d);
    }
    return c;
}

void Prepare(CPushOverPerfPtRecord& record, std::size_t steps)
{
    record.SetGravity(9.80665, 9.80665);
    record.SetCapacity(Capacity(steps));
    T_DAMP_PARAM damping;
    damping.behaviorType = 1;
    record.SetDamping(damping);
    record.SetDesignSpectrum(MakeDesignSpectrum(Spectrum(), 1, LIMIT_STATE::SLV));
}

/// One reduced spectrum of about 1,001 points, as periods and ordinates.
void ReducedSpectrum(benchmark::State& state)
{
    const auto spectrum = MakeDesignSpectrum(Spectrum(), 1, LIMIT_STATE::SLV);
    std::vector<double> T, Sa;
    double SRa = 0.6;
    for (auto _ : state) {
        SRa = 1.2 - SRa; // never the same twice
        spectrum->CalcPOSpectrumSRaSRv(SRa, 0.7, T, Sa);
        benchmark::DoNotOptimize(Sa.data());
        benchmark::ClobberMemory();
    }
    if (T.size() < 1001 || std::fabs(Sa[50] - SRa * 1.0) > 1e-9)
        state.SkipWithError("wrong spectrum");
}
BENCHMARK(ReducedSpectrum);

/// Runs one evaluation per iteration and reports the time per trial.
template <class Make>
void PerTrial(benchmark::State& state, Make make)
{
    CPushOverPerfPtRecord record;
    Prepare(record, 200);
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
    if (result != kPerfPtFound || !(Dp > 0.05)) state.SkipWithError("no performance point");
    state.counters["trials"] = static_cast<double>(trials);
}

void Atc40TrialA(benchmark::State& state)
{
    PerTrial(state, [](auto& r) { return std::make_unique<CPushOverCalcPerfPtProcA>(r); });
}
BENCHMARK(Atc40TrialA)->UseManualTime();

void Fema440TrialA(benchmark::State& state)
{
    PerTrial(state,
             [](auto& r) { return std::make_unique<CPushOverCalcPerfPtFEMA440ProcA>(r, 0); });
}
BENCHMARK(Fema440TrialA)->UseManualTime();

void Fema440TrialB(benchmark::State& state)
{
    PerTrial(state,
             [](auto& r) { return std::make_unique<CPushOverCalcPerfPtFEMA440ProcA>(r, 1); });
}
BENCHMARK(Fema440TrialB)->UseManualTime();

void Fema440TrialC(benchmark::State& state)
{
    PerTrial(state, [](auto& r) { return std::make_unique<CPushOverCalcPerfPtFEMA440ProcC>(r); });
}
BENCHMARK(Fema440TrialC)->UseManualTime();

/// Crossing of a capacity curve of n steps with a demand curve of 5 n points.
void CrossCurves(benchmark::State& state, std::size_t n)
{
    const T_ADRS_CURVE capacity = Capacity(n);
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
    in.capacity = Capacity(steps);
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
        benchmark::DoNotOptimize(CurveArea(input.capacity.View(), 0.4));
        benchmark::DoNotOptimize(FindPeakStep(input.capacity.Sa));
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
