#include "qm_rps/pushovercalcperfptproca.h"

#include "perfptfixture.h"
#include "qm_base/appbase.h"
#include "qm_base/debugout.h"
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"
#include "qm_rps/pushovercalcperfptprocb.h"

#include <cmath>
#include <cstdio>
#include <gtest/gtest.h>

namespace {

using CALC = CPushOverCalcPerfPtProcA;

/// Starts the iteration as if some trials had been made.
class CLateStart : public CALC {
public:
    CLateStart(CPushOverPerfPtRecord& record, int trialsMade) : CALC(record), m_made(trialsMade) {}
    int IteratePerformancePoint(double& Dp, double& Ap, std::optional<double>& beta, double dpi,
                                double api, double D, double Dd, double Ad) override
    {
        m_iteration = m_made;
        return CALC::IteratePerformancePoint(Dp, Ap, beta, dpi, api, D, Dd, Ad);
    }

private:
    int m_made;
};

} // namespace

// ATC-40 (1996) 8.3.3.3 example, second-hand: its four capacity points and the converged results
// recomputed by others, in mm, m/s2 and per cent. Each must be a fixed point of one trial. The
// spectrum is a polyline of 0.01 s: its chords lie above the hyperbola by up to 1.3e-5 of it. The
// last digit of dp and ap weighs 76 times in dy.
TEST(PerfPtProcA, PublishedPointsAreFixedPoints)
{
    struct T_ROW {
        T_SPFC_ATC40 spectrum;
        int type;
        double dp, ap, dy, ay, kappa, beta, SRa, SRv;
    };
    const T_SPFC_ATC40 &Sb = kExampleSb, &Sd = kExampleSd;
    // clang-format off
    const T_ROW rows[] = {
        {Sb, 0,  71.549664, 3.032625, 48.830757, 2.493102, 1.000000, 13.893803, 0.670103, 0.746126},
        {Sb, 1,  76.289675, 3.101878, 50.071334, 2.556441, 0.670000, 12.162699, 0.712786, 0.779192},
        {Sb, 2,  85.548375, 3.237152, 51.401068, 2.624332, 0.330000,  9.411247, 0.795049, 0.842920},
        {Sd, 0, 107.608113, 3.428237, 55.450992, 2.831105, 0.971638, 24.218772, 0.491865, 0.608047},
        {Sd, 1, 120.349193, 3.470242, 57.476660, 2.934527, 0.670000, 20.707737, 0.542101, 0.646965},
        {Sd, 2, 150.318743, 3.569046, 59.874121, 3.056932, 0.330000, 14.631780, 0.653503, 0.733266},
    };
    // clang-format on
    for (const T_ROW& r : rows) {
        CTestRecord record(Atc40ExampleCurve(), r.spectrum, {r.type});
        CALC calc(record);
        double D = 0.0, A = 0.0;
        std::optional<double> beta;
        ASSERT_EQ(1, calc.IteratePerformancePoint(D, A, beta, r.dp, r.ap * kMs2ToG, 0, 0, 0))
            << r.dp;
        ASSERT_EQ(1, calc.Trials()) << r.dp;
        const T_PERFPT_TRIAL& t = calc.Trace()[0];
        EXPECT_NEAR(r.dp, D, 2e-5 * r.dp) << r.dp;
        EXPECT_NEAR(r.ap, A / kMs2ToG, 2e-5 * r.ap) << r.dp;
        EXPECT_NEAR(r.beta, beta.value(), 4e-5) << r.dp;
        EXPECT_NEAR(r.dy, t.dy.value(), 4e-5) << r.dp;
        EXPECT_NEAR(r.ay, t.ay.value() / kMs2ToG, 2e-6) << r.dp;
        EXPECT_NEAR(r.kappa, t.kappa.value(), 1e-6) << r.dp;
        EXPECT_NEAR(r.SRa, t.SRa.value(), 1e-6) << r.dp;
        EXPECT_NEAR(r.SRv, t.SRv.value(), 1e-6) << r.dp;
    }
}

// Expected: tests/oracle/evaluate.py on the same curves, the independent calculation.
TEST(PerfPtProcA, MatchesTheReferenceCalculation)
{
    struct T_ROW {
        T_POINTS capacity;
        T_SPFC_ATC40 spectrum;
        T_DAMP_PARAM damping;
        int trials;
        double D, A, beta;
    };
    const T_POINTS example = Atc40ExampleCurve(), hard5 = Bilinear(10, 0.1, 0.05, 2000),
                   hard20 = Bilinear(10, 0.1, 0.2, 2000), soft = Bilinear(10, 0.1, -0.02, 400);
    const T_DAMP_PARAM user{3, 5, 10, 0.9, 30, 0.5};
    const T_SPFC_ATC40 s3{0.3, 0.3, {}}, s4{0.4, 0.4, {}}, s6{0.6, 0.6, {}};
    // clang-format off
    const T_ROW rows[] = {
        {example, kExampleSd, {0}, 15, 105.1130823496, 0.348744079943, 24.9925809758},
        {example, kExampleSd, {1},  5, 118.4842726470, 0.353239220679, 21.1801402270},
        {example, kExampleSd, user,   2, 123.7352489726, 0.355004499391, 19.8839913189},
        {hard5,   s4,         {0},  2,  75.3454009495, 0.132672700475, 37.1842642130},
        {hard5,   s4,         {1},  2,  94.2469281296, 0.142123464065, 27.0549534520},
        {hard20,  s6,         {1},  3, 138.9837849928, 0.357967569986, 13.9072977793},
        {soft,    s3,         {2},  2, 133.1569579410, 0.075368608412, 19.8500000000},
    };
    // clang-format on
    for (const T_ROW& r : rows) {
        CTestRecord record(r.capacity, r.spectrum, r.damping);
        const T_RUN run = RunPerfPt<CALC>(record);
        EXPECT_EQ(1, run.result);
        EXPECT_EQ(r.trials, static_cast<int>(run.trace.size())) << r.D;
        EXPECT_NEAR(r.D, run.D, 1e-9 * r.D);
        EXPECT_NEAR(r.A, run.A, 1e-9 * r.A + 5e-13) << r.D; // 12 digits given
        EXPECT_NEAR(r.beta, run.beta.value(), 1e-9 * r.beta + 5e-11) << r.D;
    }
}

TEST(PerfPtProcA, AnElasticResponseIsTwoAndStoresNoSpectrum)
{
    CTestRecord record(WithTinyStart({{50.0, 0.25}, {400.0, 2.0}}), kExampleSb); // T0 = 0.897 s
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(2, run.result);
    EXPECT_EQ(PUSH_OUTCOME::Elastic, run.outcome.code);
    EXPECT_EQ(5.0, run.beta) << "exactly the elastic damping";
    EXPECT_EQ(1u, run.trace.size());
    EXPECT_NEAR(1.000079, run.D / run.trace[0].dpi, 5e-7) << "SRV at 5 %";
    EXPECT_NEAR(run.D / 200.0, run.A, 1e-12) << "on the capacity";
    EXPECT_EQ(T_ADRS_CURVE{}, record.PerfPointSpectrum());
}

TEST(PerfPtProcA, ARepeatedTrialEndsAsACycle)
{
    const T_POINTS sharp = WithTinyStart(
        {{20, 0.3}, {22, 0.3}, {24, 0.27}, {144, 0.324}, {264, 0.324}, {1320, 0.389}});
    CTestRecord record(sharp, T_SPFC_ATC40{0.2, 0.2, {}}, {1});
    const T_RUN run = RunPerfPt<CALC>(record);
    EXPECT_EQ(0, run.result);
    ASSERT_EQ(PUSH_OUTCOME::Cycles, run.outcome.code);
    ASSERT_EQ(4u, run.trace.size()) << "as the reference calculation has it";
    const auto k = static_cast<std::size_t>(run.outcome.count);
    ASSERT_LE(k, 4u);
    EXPECT_EQ(run.trace[4 - k].dpi, run.trace[3].Di) << "bit for bit";
    EXPECT_EQ(run.trace[4 - k].api, run.trace[3].Ai);
    EXPECT_EQ(-1.0, run.D);
    EXPECT_EQ(-2.0, run.A);
    EXPECT_FALSE(run.beta);
}

TEST(PerfPtProcA, FailuresNameThemselvesAndLeaveTheOutputsAlone)
{
    struct T_CASE {
        PUSH_OUTCOME outcome;
        T_POINTS capacity;
        double Ca;
        T_DAMP_PARAM damping;
        std::size_t trials;
    };
    const T_POINTS dip = WithTinyStart({{10, 0.1}, {11, 0.0}, {60, 0.0}, {600, 0.5}});
    const T_CASE cases[] = {
        {PUSH_OUTCOME::NoCrossing, Bilinear(10, 0.1, 0.0, 2000), 2.0, {0}, 1},
        {PUSH_OUTCOME::BilinearFailed, dip, 1.0, {0}, 1},
        {PUSH_OUTCOME::DampingFailed, Bilinear(10, 0.1, 0.0, 2000), 0.4, {3, 5, 1, -2, 2, -9}, 1},
        {PUSH_OUTCOME::TrialBeyond, Bilinear(10, 0.1, 0.0, 20), 2.0, {0}, 0},
        {PUSH_OUTCOME::NoCapacity, {{0.0, 0.0}}, 0.4, {0}, 0},
    };
    for (const T_CASE& c : cases) {
        CTestRecord record(c.capacity, T_SPFC_ATC40{c.Ca, c.Ca, {}}, c.damping);
        CAppBase::TakeAssertions_ST();
        const T_RUN run = RunPerfPt<CALC>(record);
        const std::string name = OutcomeName(run.outcome);
        EXPECT_EQ(0, run.result) << name;
        EXPECT_EQ(c.outcome, run.outcome.code) << name;
        EXPECT_EQ(c.trials, run.trace.size()) << name;
        EXPECT_EQ(-1.0, run.D) << name;
        EXPECT_EQ(-2.0, run.A) << name;
        EXPECT_FALSE(run.beta) << name;
        EXPECT_EQ(T_ADRS_CURVE{}, record.PerfPointSpectrum()) << name;
        if (c.outcome == PUSH_OUTCOME::BilinearFailed) {
            const std::vector<T_ASSERTION> expected{{"src/qm_rps/pushovercalcperfptproca", 70}};
            EXPECT_EQ(expected, CAppBase::TakeAssertions_ST());
        }
    }
}

TEST(PerfPtProcA, StopsAfter1500Trials)
{
    CTestRecord record(Atc40ExampleCurve(), kExampleSd); // 15 trials
    EXPECT_EQ(1500, RunPerfPt<CLateStart>(record, 1485).trace.back().trial);
    const T_RUN late = RunPerfPt<CLateStart>(record, 1486);
    EXPECT_EQ(PUSH_OUTCOME::Trials1500, late.outcome.code);
    EXPECT_EQ(-1.0, late.D);
}

TEST(PerfPtProcA, StoresTheReducedSpectrumAndWritesTwoDebugLinesATrial)
{
    std::vector<std::string> lines;
    SetDebugSink([&lines](std::string_view line) {
        if (line.starts_with("#")) lines.emplace_back(line);
    });
    CTestRecord record(Atc40ExampleCurve(), kExampleSb, {2});
    const T_RUN run = RunPerfPt<CALC>(record);
    SetDebugSink({});
    ASSERT_EQ(1u, run.trace.size()) << "converged at once";
    const T_PERFPT_TRIAL& t = run.trace[0];
    char text[200];
    std::snprintf(text, sizeof text, "#1 Dy:%g Ay:%g|#1 0.95*Dpi(%g) <= Di(%g) <= 1.05*Dpi(%g) ",
                  *t.dy, *t.ay, 0.95 * t.dpi, *t.Di, 1.05 * t.dpi);
    ASSERT_EQ(2u, lines.size());
    EXPECT_EQ(text, lines[0] + "|" + lines[1]);
    const T_ADRS_CURVE& stored = record.PerfPointSpectrum();
    EXPECT_NEAR(t.SRa.value() * 2.5 * 0.4, std::ranges::max(stored.Sa), 1e-12);
    const double T = record.DemandPeriods().back(); // velocity branch; Sd = T2 Sa g / (4 pi2)
    EXPECT_NEAR(t.SRv.value() * 0.4 / T, stored.Sa.back(), 1e-12);
    EXPECT_NEAR(T * T * stored.Sa.back() * kGravityMm / kGravityUnit, stored.Sd.back(), 1e-9);
}

TEST(PerfPt, EveryProcedureScalesWithTheLengthUnit)
{
    const auto run = [](int procedure, double scale) {
        T_POINTS capacity = Atc40ExampleCurve();
        for (T_POINT2& p : capacity)
            p.x *= scale;
        CTestRecord record(capacity, kExampleSd, {1}, kGravityMm * scale);
        if (procedure == 0) return RunPerfPt<CALC>(record);
        if (procedure == 1) return RunPerfPt<CPushOverCalcPerfPtProcB>(record);
        if (procedure == 4) return RunPerfPt<CPushOverCalcPerfPtFEMA440ProcC>(record);
        return RunPerfPt<CPushOverCalcPerfPtFEMA440ProcA>(record, procedure - 2);
    };
    for (int procedure = 0; procedure < 5; ++procedure) {
        const T_RUN mm = run(procedure, 1.0);
        ASSERT_EQ(1, mm.result) << procedure;
        const T_RUN m = run(procedure, 1e-3);
        EXPECT_EQ(mm.trace.size(), m.trace.size()) << procedure;
        EXPECT_NEAR(mm.D * 1e-3, m.D, 1e-9 * m.D) << procedure;
        EXPECT_NEAR(mm.A, m.A, 1e-9 * mm.A) << procedure;
        EXPECT_NEAR(*mm.beta, m.beta.value(), 1e-8) << procedure;
    }
}
