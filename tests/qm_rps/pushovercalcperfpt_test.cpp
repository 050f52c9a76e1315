// What every procedure must do: ATC-40 A and B, FEMA 440 a, b and c. Their numbers are compared
// with the reference calculation by the acceptance tests.
#include "perfptfixture.h"
#include "qm_base/debugout.h"

#include <algorithm>
#include <cstdio>
#include <gtest/gtest.h>
#include <tuple>

// Elastic to (3.3, 3.3) with a period of 1 s, under a level demand of 3.
TEST(PerfPt, AnElasticResponseIsTwo)
{
    struct T_CASE {
        char procedure;
        double D;
        std::optional<double> beta;
    };
    const T_CASE cases[] = {
        {'A', 3.0 * 0.997916, 5.0},     // SRA at 5 %
        {'B', 3.0, 5.0},                // the elastic demand point starts the locus
        {'a', 3.0 / 1.0023650584, 5.0}, // B(5)
        {'b', 3.0 / 1.0023650584, 5.0},
        {'c', 3.0, {}}, // stops before its first step and sets no damping, on purpose
    };
    for (const T_CASE& c : cases) {
        SCOPED_TRACE(c.procedure);
        CTestRecord record(Bilinear(3.3, 3.3, 0.0, 60.0), Level(3.0), {0}, kGravityUnit);
        const T_RUN run = RunProcedure(record, c.procedure);
        EXPECT_EQ(2, run.result);
        EXPECT_EQ(PUSH_OUTCOME::Elastic, run.outcome.code);
        EXPECT_NEAR(c.D, run.D, 2e-6); // digits of SRA
        EXPECT_NEAR(run.D, run.A, 1e-9) << "on the capacity";
        ASSERT_EQ(c.beta.has_value(), run.beta.has_value());
        EXPECT_NEAR(c.beta.value_or(0.0), run.beta.value_or(0.0), 1e-9);
        EXPECT_EQ(c.procedure == 'c', run.trace.empty());
        EXPECT_TRUE(c.procedure != 'A' || record.PerfPointSpectrum().Sd.empty());
        EXPECT_TRUE(record.Teffs().empty());
    }
}

TEST(PerfPt, ARepeatedTrialEndsAsACycle)
{
    const T_POINTS sharp = WithTinyStart(
        {{20, 0.3}, {22, 0.3}, {24, 0.27}, {144, 0.324}, {264, 0.324}, {1320, 0.389}});
    // The numbers of trials are those of tests/oracle/evaluate.py.
    for (const auto& [procedure, type, trials] : {std::tuple('A', 1, 4u), {'b', 3, 7u}}) {
        CTestRecord record(sharp, Atc40(0.2), {type});
        const T_RUN run = RunProcedure(record, procedure);
        ASSERT_EQ(PUSH_OUTCOME::Cycles, run.outcome.code) << procedure;
        ASSERT_EQ(trials, run.trace.size()) << procedure;
        const auto k = static_cast<std::size_t>(run.outcome.count);
        EXPECT_EQ(run.trace.at(trials - k).dpi, run.trace[trials - 1].Di) << "bit for bit";
        EXPECT_EQ(-1.0, run.D) << procedure;
    }
}

TEST(PerfPt, FailuresNameThemselvesAndLeaveTheOutputsAlone)
{
    struct T_CASE {
        char procedure;
        PUSH_OUTCOME outcome;
        T_POINTS capacity;
        double Ca;
        T_DAMP_PARAM damping;
        std::size_t trials;
    };
    const T_POINTS plateau = Bilinear(10, 0.1, 0.0, 2000), shortOne = Bilinear(10, 0.1, 0.05, 90);
    const T_POINTS dip = WithTinyStart({{10, 0.1}, {11, 0.0}, {60, 0.0}, {600, 0.5}});
    const T_POINTS longOne = Bilinear(3000, 0.1, 0.0, 9000); // 11 s, the spectrum ends at 10 s
    const T_DAMP_PARAM negative{3, 5, 1, -2, 2, -9};
    using enum PUSH_OUTCOME;
    // clang-format off
    const T_CASE cases[] = {
        {'A', NoCrossing,         plateau,      2.0,  {0},      1},
        {'A', BilinearFailed,     dip,          1.0,  {0},      1},
        {'A', DampingFailed,      plateau,      0.4,  negative, 1},
        {'A', NoCapacity,         {{0.0, 0.0}}, 0.4,  {0},      0},
        {'B', NoLocusCrossing,    Bilinear(10, 0.1, 0.05, 2000), 0.6, {0}, 45},
        {'B', DampingFailed,      plateau,      0.4,  negative, 1},
        {'B', CapacityEnds,       Bilinear(10, 0.1, 0.0, 11.9), 0.07, {0}, 0}, // before 1.2 dy
        {'a', CoefficientsFailed, plateau,      3.0,  {2},      1}, // no real period past mu = 35.3
        {'a', NoPeriodCrossing,   plateau,      1.0,  {2},      2}, // beyond 10 s
        {'a', CurveTooShort,      shortOne,     0.4,  {2},      2},
        {'b', NoCrossing,         plateau,      3.0,  {0},      1},
        {'c', Trials1500,         plateau,      3.0,  {1},   1499},
        {'c', NoTrialPoint,       longOne,      0.4,  {0},      0},
        {'c', TrialBeyond,        plateau,     20.0,  {0},      0},
    };
    // clang-format on
    for (const T_CASE& c : cases) {
        CTestRecord record(c.capacity, Atc40(c.Ca), c.damping);
        const T_RUN run = RunProcedure(record, c.procedure);
        SCOPED_TRACE(c.procedure + (" " + OutcomeName(run.outcome)));
        EXPECT_EQ(0, run.result);
        EXPECT_EQ(c.outcome, run.outcome.code);
        EXPECT_EQ(c.trials, run.trace.size());
        EXPECT_EQ(-1.0, run.D);
        EXPECT_EQ(-2.0, run.A);
        EXPECT_FALSE(run.beta);
        EXPECT_EQ(T_ADRS_CURVE{}, record.PerfPointSpectrum());
    }
}

// FEMA 440 prints "0.95" and "1.05" before bounds of 0.97 and 1.03, on purpose.
TEST(PerfPt, TheDebugLineOfATrialPrintsItsBounds)
{
    std::string last;
    SetDebugSink([&last](std::string_view line) {
        if (line.starts_with("#")) last = line;
    });
    for (const auto& [procedure, type, tolerance] : {std::tuple('A', 2, 0.05), {'a', 0, 0.03}}) {
        CTestRecord record(Atc40ExampleCurve(), type ? kExampleSb : kExampleSd, {type});
        const T_RUN run = RunProcedure(record, procedure);
        ASSERT_EQ(1u, run.trace.size());
        const T_PERFPT_TRIAL& t = run.trace[0];
        char text[200];
        std::snprintf(text, sizeof text, "#1 0.95*Dpi(%g) <= Di(%g) <= 1.05*Dpi(%g) ",
                      (1 - tolerance) * t.dpi, *t.Di, (1 + tolerance) * t.dpi);
        EXPECT_EQ(text, last);
    }
    SetDebugSink({});
}

TEST(PerfPt, ProcedureAStoresTheReducedSpectrum)
{
    CTestRecord record(Atc40ExampleCurve(), kExampleSb, {2});
    const T_RUN run = RunProcedure(record, 'A');
    ASSERT_EQ(1u, run.trace.size()) << "converged at once";
    const T_PERFPT_TRIAL& t = run.trace[0];
    const T_ADRS_CURVE& stored = record.PerfPointSpectrum();
    EXPECT_NEAR(t.SRa.value() * 2.5 * 0.4, std::ranges::max(stored.Sa), 1e-12);
    const double T = record.DemandPeriods().back(); // velocity branch; Sd = T2 Sa g / (4 pi2)
    EXPECT_NEAR(t.SRv.value() * 0.4 / T, stored.Sa.back(), 1e-12);
    EXPECT_NEAR(T * T * stored.Sa.back() * kGravityMm / kGravityUnit, stored.Sd.back(), 1e-9);
}
