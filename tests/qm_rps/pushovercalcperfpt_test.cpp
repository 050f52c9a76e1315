// What every procedure must do: ATC-40 A and B, FEMA 440 a, b and c.
#include "perfptfixture.h"
#include "qm_base/debugout.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <tuple>

// Expected: tests/oracle/evaluate.py on the same curves, the independent calculation.
TEST(PerfPt, MatchesTheReferenceCalculation)
{
    struct T_ROW {
        char procedure;
        T_POINTS capacity;
        T_SPFC_ATC40 spectrum;
        T_DAMP_PARAM damping;
        std::size_t trials;
        double D, A, beta;
    };
    const T_POINTS example = Atc40ExampleCurve(), hard5 = Bilinear(10, 0.1, 0.05, 2000),
                   hard20 = Bilinear(10, 0.1, 0.2, 2000), soft = Bilinear(10, 0.1, -0.02, 400);
    const T_DAMP_PARAM user{3, 5, 10, 0.9, 30, 0.5};
    // clang-format off
    const T_ROW rows[] = {
        {'A', example, kExampleSd, {0},  15, 105.1130823496, 0.348744079943, 24.9925809758},
        {'A', example, kExampleSd, user,  2, 123.7352489726, 0.355004499391, 19.8839913189},
        {'A', hard20,  Atc40(0.6), {1},   3, 138.9837849928, 0.357967569986, 13.9072977793},
        {'A', soft,    Atc40(0.3), {2},   2, 133.1569579410, 0.075368608412, 19.8500000000},
        {'B', example, kExampleSd, {2},  11, 151.1898434685, 0.364234213677, 14.5001738981},
        {'B', example, kExampleSd, user, 11, 124.5640477594, 0.355283125834, 19.7086376971},
        {'B', hard5,   Atc40(0.4), {0},  45,  75.3675997552, 0.132683799878, 37.1708977890},
        {'a', example, kExampleSd, {3},   1, 141.4249224404, 0.360951432315, 15.9069896828},
        {'a', hard5,   Atc40(0.4), {2},   4, 106.3914749099, 0.148195737455, 21.7722623011},
        {'b', hard20,  Atc40(0.6), {2},   5, 260.4224180197, 0.600844836039,  1.3618994193},
        {'b', soft,    Atc40(0.3), {2},   3,  68.9460025800, 0.088210799484, 33.5730130822},
        {'c', hard5,   Atc40(0.6), {0},   7, 150.6366805928, 0.170318340296, 31.7371862796},
        {'c', hard20,  Atc40(0.6), {2},  18, 260.8224006802, 0.601644801360,  1.3516099074},
    };
    // clang-format on
    for (const T_ROW& r : rows) {
        SCOPED_TRACE(r.procedure + std::to_string(r.D));
        CTestRecord record(r.capacity, r.spectrum, r.damping);
        const T_RUN run = RunProcedure(record, r.procedure);
        EXPECT_EQ(r.beta < 5.0 ? PUSH_OUTCOME::Elastic : PUSH_OUTCOME::Converged, run.outcome.code);
        EXPECT_EQ(r.beta < 5.0 ? 2 : 1, run.result);
        EXPECT_EQ(r.trials, run.trace.size());
        EXPECT_NEAR(r.D, run.D, 1e-9 * r.D);
        EXPECT_NEAR(r.A, run.A, 1e-9 * r.A + 5e-13); // 12 digits given
        EXPECT_NEAR(r.beta, run.beta.value(), 1e-8 * r.beta);
    }
}

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

TEST(PerfPt, ScalesWithTheLengthUnit)
{
    for (const char procedure : {'A', 'B', 'a', 'b', 'c'}) {
        SCOPED_TRACE(procedure);
        const auto run = [procedure](double scale) {
            T_POINTS capacity = Atc40ExampleCurve();
            for (T_POINT2& p : capacity)
                p.x *= scale;
            CTestRecord record(capacity, kExampleSd, {1}, kGravityMm * scale);
            return RunProcedure(record, procedure);
        };
        const T_RUN mm = run(1.0), m = run(1e-3);
        ASSERT_EQ(1, mm.result);
        EXPECT_EQ(mm.trace.size(), m.trace.size());
        EXPECT_NEAR(mm.D * 1e-3, m.D, 1e-9 * m.D);
        EXPECT_NEAR(mm.A, m.A, 1e-9 * mm.A);
        EXPECT_NEAR(*mm.beta, m.beta.value(), 1e-8);
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
