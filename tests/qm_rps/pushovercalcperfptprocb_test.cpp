#include "qm_rps/pushovercalcperfptprocb.h"

#include "perfptfixture.h"
#include "qm_base/appbase.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace {

using CALC = CPushOverCalcPerfPtProcB;

/// Yields at (1, 1), T0 = 1 s, and keeps Sa = 1.
const T_POINTS kPlateau = Bilinear(1.0, 1.0, 0.0, 20.0);
constexpr double kMissed = 1e-7; // what the area near the origin that is not counted does

} // namespace

// By hand: the equal-area rule keeps (1, 1), so mu = d, alpha = 0 and Teff = sqrt(mu); the
// hysteretic damping is 63.7 (mu - 1) / mu; the demand is the level 2 SRA.
TEST(PerfPtProcB, LocusOfAPlateauUnderALevelSpectrum)
{
    CTestRecord record(kPlateau, Level(2.0), {0}, kGravityUnit);
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(1, run.result);
    ASSERT_EQ(45u, run.trace.size()) << "mu = 1.2, 1.4, ... 10.0";
    const T_PERFPT_TRIAL& first = run.trace.front();
    EXPECT_NEAR(1.2, first.mu.value(), 1e-12);
    EXPECT_NEAR(1.095445, first.Teff.value(), 5e-7);
    EXPECT_NEAR(15.616667, first.betaEff.value(), 2e-6); // 5 + 63.7 / 6
    EXPECT_NEAR(0.632608, first.SRa.value(), 5e-7);
    EXPECT_NEAR(1.265217, first.Ai.value(), 1e-6);
    EXPECT_NEAR(1.518260, first.Di.value(), 1e-6); // Teff2 Ai
    EXPECT_NEAR(10.0, run.trace.back().mu.value(), 1e-9);
    EXPECT_NEAR(10.0, run.trace.back().dpi, kMissed) << "the yield point did not move";

    const T_ADRS_CURVE& locus = record.PerfPointTrace();
    ASSERT_EQ(46u, locus.Sd.size());
    EXPECT_NEAR(2.0, locus.Sd[0], 1e-12) << "the elastic demand point";
    EXPECT_NEAR(2.0, locus.Sa[0], 1e-12);
    EXPECT_EQ(run.trace[44].Di, locus.Sd[45]);
    EXPECT_EQ(run.trace[44].Ai, locus.Sa[45]);
    ASSERT_EQ(5u, record.Teffs().size());
    for (std::size_t i = 0; i < 5; ++i)
        EXPECT_NEAR(std::sqrt(i == 0 ? 1.0 : 2.0 * double(i)), record.Teffs()[i], kMissed);

    // Closed form: SRA = 1/2 at beta = exp(2.15 / 0.68) = 23.61, which mu = 1.42628 gives. Both
    // lie between two steps of 0.2 in mu, so to a hundredth.
    EXPECT_NEAR(1.0, run.A, 1e-9);
    EXPECT_NEAR(1.42628, run.D, 0.01 * 1.42628);
    EXPECT_NEAR(std::exp(2.15 / 0.68), run.beta.value(), 0.01 * 23.6);
    EXPECT_NEAR(std::sqrt(run.D), record.PerfPointTeff().value(), 1e-9);
    EXPECT_EQ(T_ADRS_CURVE{}, record.PerfPointSpectrum()) << "computed, not handed on";
}

// Expected: tests/oracle/evaluate.py on the same curves, the independent calculation.
TEST(PerfPtProcB, MatchesTheReferenceCalculation)
{
    struct T_ROW {
        T_POINTS capacity;
        T_SPFC_ATC40 spectrum;
        T_DAMP_PARAM damping;
        std::size_t trials;
        double D, A, beta; // D = 0: no crossing
    };
    const T_POINTS example = Atc40ExampleCurve(), hard5 = Bilinear(10, 0.1, 0.05, 2000);
    const T_DAMP_PARAM user{3, 5, 10, 0.9, 30, 0.5};
    const T_SPFC_ATC40 s4{0.4, 0.4, {}}, s6{0.6, 0.6, {}};
    // clang-format off
    const T_ROW rows[] = {
        {example, kExampleSd, {0}, 11, 109.3750941136, 0.350176887514, 23.7885953737},
        {example, kExampleSd, {1}, 11, 122.3617453570, 0.354542753509, 20.2437618668},
        {example, kExampleSd, {2}, 11, 151.1898434685, 0.364234213677, 14.5001738981},
        {example, kExampleSd, user, 11, 124.5640477594, 0.355283125834, 19.7086376971},
        {hard5,   s4,         {0}, 45,  75.3675997552, 0.132683799878, 37.1708977890},
        {hard5,   s4,         {1}, 45,  94.3337089150, 0.142166854458, 27.0164091547},
        {hard5,   s6,         {0}, 45,   0.0,          0.0,             0.0},
    };
    // clang-format on
    for (const T_ROW& r : rows) {
        CTestRecord record(r.capacity, r.spectrum, r.damping);
        const T_RUN run = RunPerfPt<CALC>(record);
        EXPECT_EQ(r.trials, run.trace.size()) << r.D;
        EXPECT_EQ(r.D > 0.0 ? 1 : 0, run.result) << r.D;
        if (r.D == 0.0) {
            EXPECT_EQ(PUSH_OUTCOME::NoLocusCrossing, run.outcome.code);
            EXPECT_EQ(-1.0, run.D);
            EXPECT_FALSE(run.beta);
            EXPECT_EQ(46u, record.PerfPointTrace().Sd.size()) << "shown all the same";
            continue;
        }
        EXPECT_NEAR(r.D, run.D, 1e-9 * r.D);
        EXPECT_NEAR(r.A, run.A, 1e-9 * r.A + 5e-13) << r.D;
        EXPECT_NEAR(r.beta, run.beta.value(), 1e-9 * r.beta + 5e-11) << r.D;
    }
}

TEST(PerfPtProcB, AnUprightLocusIsInterpolatedByAcceleration)
{
    // kappa 0 holds the damping at 6 %, and Sd is 2 at every period beyond 1 s: an upright locus.
    T_SPFC_USER table;
    for (int i = 0; i <= 400; ++i) {
        const double T = i / 100.0;
        table.T.push_back(T);
        table.Sa.push_back(T <= 1.0 ? 2.0 : 2.0 / (T * T));
    }
    CTestRecord record(kPlateau, table, {3, 6.0, 10, 0.0, 20, 0.0}, kGravityUnit);
    const T_RUN run = RunPerfPt<CALC>(record);
    ASSERT_EQ(1, run.result);
    EXPECT_NEAR(6.0, run.beta.value(), 1e-9);
    EXPECT_NEAR(1.0, run.A, 1e-9);
    const double SRv = (2.31 - 0.41 * std::log(6.0)) / 1.65;
    EXPECT_NEAR(2.0 * SRv, run.D, 1e-4) << "chords of the table";
}

TEST(PerfPtProcB, ACapacityThatEndsBefore1Point2DyHasAnEmptyLocus)
{
    CTestRecord record(Bilinear(1.0, 1.0, 0.0, 1.19), Level(1.1), {0}, kGravityUnit);
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(0, run.result);
    EXPECT_EQ(PUSH_OUTCOME::CapacityEnds, run.outcome.code);
    EXPECT_TRUE(run.trace.empty());
    EXPECT_EQ(1u, record.PerfPointTrace().Sd.size()) << "the elastic demand point alone";
    EXPECT_EQ(-1.0, run.D);
}

TEST(PerfPtProcB, AnElasticResponseIsTwoAndStoresNoPeriods)
{
    // Elastic up to 2.2, demand at 2: from mu = 1.2 on the locus leaves the elastic line.
    CTestRecord record(Bilinear(2.2, 2.2, 0.0, 20.0), Level(2.0), {0}, kGravityUnit);
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(2, run.result);
    EXPECT_EQ(PUSH_OUTCOME::Elastic, run.outcome.code);
    EXPECT_NEAR(2.0, run.D, 1e-9);
    EXPECT_NEAR(5.0, run.beta.value(), 1e-9);
    EXPECT_TRUE(record.Teffs().empty());
}

TEST(PerfPtProcB, AMissedPeriodLineIsPassedOverAndUndefinedDampingEndsTheSweep)
{
    // Periods up to 1.2 s only: Teff = sqrt(mu) finds the demand at mu = 1.2 and 1.4.
    CTestRecord record(kPlateau, T_SPFC_USER{{0.0, 1.2}, {2.0, 2.0}, {}}, {0}, kGravityUnit);
    CAppBase::TakeAssertions_ST();
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(0, run.result);
    EXPECT_EQ(PUSH_OUTCOME::NoLocusCrossing, run.outcome.code);
    EXPECT_EQ(45u, run.trace.size());
    EXPECT_EQ(3u, record.PerfPointTrace().Sd.size());
    const std::vector<T_ASSERTION> raised = CAppBase::TakeAssertions_ST();
    const T_ASSERTION missed{"src/qm_rps/pushovercalcperfptprocb", 117};
    EXPECT_EQ(43, std::ranges::count(raised, missed));

    CTestRecord negative(kPlateau, Level(2.0), {3, 5.0, 1, -2, 2, -9}, kGravityUnit);
    const T_RUN none = RunPerfPt<CALC>(negative);
    EXPECT_EQ(0, none.result);
    EXPECT_EQ(PUSH_OUTCOME::DampingFailed, none.outcome.code);
    EXPECT_EQ(1u, none.trace.size());
    EXPECT_TRUE(negative.PerfPointTrace().Sd.empty());
}
