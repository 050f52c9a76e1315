// Interaction curve and biaxial surface of a reinforced column, against one integration.
#include "qm_solver/sectionsolver.h"
#include "ratios.h"

#include <benchmark/benchmark.h>

#include <cmath>

namespace {

using namespace solver;

/// 400 x 400, C30, 24 bars of 314 mm2 around.
const CSectionSolver& Column()
{
    static const CSectionSolver column = [] {
        T_STRESS_LAW concrete, steel;
        concrete.strength = 30, concrete.peakStrain = 0.002, concrete.limitStrain = 0.0035;
        steel.kind = STRESS_LAW::Steel, steel.strength = 500, steel.modulus = 2e5;
        T_SECTION_MODEL m;
        m.laws = {concrete, steel};
        m.regions = {{{{{-200, -200}, {200, -200}, {200, 200}, {-200, 200}}}, 0}};
        for (int i = 0; i < 7; ++i)
            for (int k = 0; k < 7; ++k)
                if (i % 6 == 0 || k % 6 == 0)
                    m.bars.push_back({-150.0 + 50.0 * i, -150.0 + 50.0 * k, 314.0, 1});
        CSectionSolver solver;
        T_SECTION_ERROR error;
        (void)!solver.Prepare(m, error);
        return solver;
    }();
    return column;
}

/// Forces and tangent for a plane of strains.
void SectionIntegral(benchmark::State& state)
{
    T_SECTION_RESPONSE out;
    T_SECTION_ERROR error;
    for (auto _ : state)
        if (!Column().Respond({0.001, 1e-5, 4e-6}, out, error) || !(out.My > 0.0))
            state.SkipWithError("no forces");
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(SectionIntegral)->Unit(benchmark::kMicrosecond);

/// Squash load: 30 (160000 - 7536) + 7536 * 400.
constexpr double kSquash = 30 * (160000 - 7536.0) + 7536 * 400.0;

void SectionCurve(benchmark::State& state)
{
    T_AXIAL_CURVE out;
    T_SECTION_ERROR error;
    for (auto _ : state)
        if (!Column().Curve(0.3, 40, out, error) || out.points.size() != 40 ||
            std::fabs(out.points[0].axial - kSquash) > 1e-3)
            state.SkipWithError("no curve");
    state.SetItemsProcessed(state.iterations() * 40);
}
BENCHMARK(SectionCurve)->Unit(benchmark::kMicrosecond);

void SectionSurface(benchmark::State& state)
{
    std::vector<T_CAPACITY> out;
    T_SECTION_ERROR error;
    for (auto _ : state)
        if (!Column().Surface(36, 40, out, error) || out.size() != 1440 ||
            std::fabs(out[720].axial - kSquash) > 1e-3)
            state.SkipWithError("no surface");
    state.SetItemsProcessed(state.iterations() * 1440);
}
BENCHMARK(SectionSurface)->Unit(benchmark::kMicrosecond); // as the others, for their ratios

[[maybe_unused]] const int kRatios[] = {
    AddRatio({"point of an interaction curve of 40 / one integration", "SectionCurve",
              "SectionIntegral", 1.0 / 40, 4.0}),
    AddRatio({"point of a biaxial surface of 36 x 40 / one integration", "SectionSurface",
              "SectionIntegral", 1.0 / 1440, 4.0}),
};

} // namespace
