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
    EXPECT_NEAR(10.0, run.trace.back().mu.value(), 1e-9);
    EXPECT_NEAR(10.0, run.trace.back().dpi, kMissed) << "the yield point did not move";

    const T_ADRS_CURVE& locus = record.PerfPointTrace();
    ASSERT_EQ(46u, locus.Sd.size());
    EXPECT_NEAR(2.0, locus.Sd[0], 1e-12) << "the elastic demand point";
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

TEST(PerfPtProcB, AnElasticStructureIsFoundWhateverTheRounding)
{
    // Below the plateau the locus is one point, (SRA L, SRA L), to the last bits or not.
    for (const double elasticPct : {5.0, 7.0}) {
        const double SRa = (3.21 - 0.68 * std::log(elasticPct)) / 2.12; // 0.998 at 5 %
        T_DAMP_PARAM damping;
        damping.elasticPct = elasticPct;
        std::vector<int> results(3, 0);
        for (int i = 1; i <= 160; ++i) {
            const double level = 0.1 + 0.00437 * i;
            CTestRecord record(kPlateau, Level(level), damping, kGravityUnit);
            const T_RUN run = RunPerfPt<CALC>(record);
            ++results.at(static_cast<std::size_t>(run.result));
            EXPECT_NEAR(SRa * level, run.D, 1e-6) << level;
            EXPECT_NEAR(elasticPct, run.beta.value_or(0.0), 1e-6) << level;
        }
        // 5 % is named elastic; another damping would have to be above beta, which it equals.
        EXPECT_EQ(elasticPct == 5.0 ? (std::vector<int>{0, 0, 160}) : (std::vector<int>{0, 160, 0}),
                  results);
    }
}

TEST(PerfPtProcB, AMissedPeriodLineIsPassedOver)
{
    // Periods up to 1.2 s only: Teff = sqrt(mu) finds the demand at mu = 1.2 and 1.4.
    CTestRecord record(kPlateau, T_SPFC_USER{{0.0, 1.2}, {2.0, 2.0}, {}}, {0}, kGravityUnit);
    CAppBase::TakeAssertions_ST();
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(PUSH_OUTCOME::NoLocusCrossing, run.outcome.code);
    EXPECT_EQ(45u, run.trace.size());
    EXPECT_EQ(3u, record.PerfPointTrace().Sd.size());
    const std::vector<T_ASSERTION> raised = CAppBase::TakeAssertions_ST();
    const T_ASSERTION missed{"src/qm_rps/pushovercalcperfptprocb", 117};
    EXPECT_EQ(43, std::ranges::count(raised, missed));
}
