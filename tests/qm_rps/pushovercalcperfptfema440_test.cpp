// FEMA 440 procedures A (variant 0), B (variant 1: MADRS crossing) and C (ductility locus).
#include "perfptfixture.h"
#include "qm_base/appbase.h"
#include "qm_base/debugout.h"
#include "qm_base/testenvmgr.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushovercalcperfptfema440proca.h"
#include "qm_rps/pushovercalcperfptfema440procc.h"

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>

namespace {

T_RUN RunProcedure(CPushOverPerfPtRecord& record, char procedure)
{
    if (procedure == 'C') return RunPerfPt<CPushOverCalcPerfPtFEMA440ProcC>(record);
    return RunPerfPt<CPushOverCalcPerfPtFEMA440ProcA>(record, procedure == 'A' ? 0 : 1);
}

T_SPFC_ATC40 Atc40(double Ca)
{
    return {Ca, Ca, {}};
}

/// What the iteration log holds after `write`, with its switch on or off.
template <class WRITE>
std::string LogOf(const char* name, bool on, WRITE write)
{
    namespace fs = std::filesystem;
    const std::string model = testing::TempDir() + "qm_fema440_" + name;
    const fs::path file = model + "_Pushover.txt";
    fs::remove(file);
    CTestEnvMgr::SetTestEnvST("FEMA440", on ? "yes" : "no");
    write(model);
    CTestEnvMgr::ClearST();
    std::ostringstream text;
    if (fs::exists(file)) text << std::ifstream(file, std::ios::binary).rdbuf();
    fs::remove(file);
    return text.str();
}

class CLogProbe : public CPushOverCalcPerfPtFEMA440ProcA {
public:
    explicit CLogProbe(CPushOverPerfPtRecord& record) : CPushOverCalcPerfPtFEMA440ProcA(record, 0)
    {
    }
    using CPushOverCalcPerfPtBase::T_LOG_RECORD;
    using CPushOverCalcPerfPtBase::WriteIterationLog;
};

} // namespace

// By hand: yield (1, 1), T0 = 1 s, demand Sa = 3, so the first trial is at mu = 3, bilinear.
// Plateau: alpha 0, Teff = 1 + 4 x 0.11 - 8 x 0.017. Hardening 0.1: row "alpha <= 2".
TEST(PerfPtFema440, FirstTrialByHand)
{
    struct T_CASE {
        char procedure;
        double hardening;
        int row;
        double Teff, beta;
        std::optional<double> M;
        double Di, Ai;
    };
    const T_CASE cases[] = {
        // B = 1.301798: Sa = 2.304504, D = Teff2 Sa
        {'A', 0.0, 0, 1.304, 12.52, {}, 3.918616, 1.0},
        // B = 1.320605, M = 1.288^2 1.2 / 3: the level 3 M / B meets 1 + 0.1 (D - 1)
        {'B', 0.1, 1, 1.288, 13.08, 0.663578, 6.074404, 1.507440},
        // the same level at Tsec2 = 3 / 1.2
        {'C', 0.1, 1, 1.288, 13.08, 0.663578, 3.768601, 1.507440},
    };
    for (const T_CASE& c : cases) {
        SCOPED_TRACE(c.procedure);
        const T_POINTS capacity{{0, 0}, {1, 1}, {60, 1 + 59 * c.hardening}};
        CTestRecord record(capacity, Level(3.0), {0}, kGravityUnit);
        const T_RUN run = RunProcedure(record, c.procedure);
        ASSERT_FALSE(run.trace.empty());
        const T_PERFPT_TRIAL& t = run.trace[0];
        EXPECT_NEAR(3.0, t.mu.value(), 1e-12);
        EXPECT_NEAR(c.hardening, t.alpha.value(), 1e-12);
        EXPECT_EQ(c.row, t.row);
        EXPECT_NEAR(c.Teff, t.Teff.value(), 1e-6);
        EXPECT_NEAR(c.beta, t.betaEff.value(), 1e-5);
        EXPECT_EQ(c.M.has_value(), t.M.has_value());
        EXPECT_NEAR(c.M.value_or(0.0), t.M.value_or(0.0), 1e-6);
        EXPECT_NEAR(c.Di, t.Di.value(), 1e-5);
        EXPECT_NEAR(c.Ai, t.Ai.value(), 1e-6);
    }
}

// Expected: tests/oracle/evaluate.py on the same curves, the independent calculation.
TEST(PerfPtFema440, MatchesTheReferenceCalculation)
{
    struct T_ROW {
        char procedure;
        T_POINTS capacity;
        T_SPFC_ATC40 spectrum;
        int type;
        std::size_t trials;
        int result;
        double D, A, beta;
    };
    const T_POINTS example = Atc40ExampleCurve(), hard5 = Bilinear(10, 0.1, 0.05, 2000),
                   hard20 = Bilinear(10, 0.1, 0.2, 2000), soft = Bilinear(10, 0.1, -0.02, 400);
    // clang-format off
    const T_ROW rows[] = {
        {'A', example, kExampleSd, 0,  1, 1, 134.5868945384, 0.358652616945, 17.1999065656},
        {'A', example, kExampleSd, 3,  1, 1, 141.4249224404, 0.360951432315, 15.9069896828},
        {'A', hard5,   Atc40(0.4), 2,  4, 1, 106.3914749099, 0.148195737455, 21.7722623011},
        {'A', hard20,  Atc40(0.6), 2,  5, 2, 258.6256053611, 0.597251210722,  1.4090971539},
        {'A', soft,    Atc40(0.3), 2,  3, 1,  60.2701455924, 0.089945970882, 37.7243559205},
        {'B', hard5,   Atc40(0.4), 2,  3, 1, 109.8146781755, 0.149907339088, 20.6083578407},
        {'B', hard20,  Atc40(0.6), 2,  5, 2, 260.4224180197, 0.600844836039,  1.3618994193},
        {'B', soft,    Atc40(0.3), 2,  3, 1,  68.9460025800, 0.088210799484, 33.5730130822},
        {'C', example, kExampleSd, 3,  2, 1, 142.1367202629, 0.361190725251, 15.7790801446},
        {'C', hard5,   Atc40(0.6), 0,  7, 1, 150.6366805928, 0.170318340296, 31.7371862796},
        {'C', hard20,  Atc40(0.6), 1, 10, 1, 177.8526589268, 0.435705317854,  6.5305238081},
        {'C', hard20,  Atc40(0.6), 2, 18, 2, 260.8224006802, 0.601644801360,  1.3516099074},
    };
    // clang-format on
    for (const T_ROW& r : rows) {
        CTestRecord record(r.capacity, r.spectrum, {r.type});
        const T_RUN run = RunProcedure(record, r.procedure);
        EXPECT_EQ(r.result, run.result) << r.procedure << r.D;
        EXPECT_EQ(r.result == 2 ? PUSH_OUTCOME::Elastic : PUSH_OUTCOME::Converged,
                  run.outcome.code);
        EXPECT_EQ(r.trials, run.trace.size()) << r.procedure << r.D;
        EXPECT_NEAR(r.D, run.D, 1e-9 * r.D) << r.procedure;
        EXPECT_NEAR(r.A, run.A, 1e-9 * r.A + 5e-13) << r.procedure << r.D;
        EXPECT_NEAR(r.beta, run.beta.value(), 1e-8 * r.beta) << r.procedure << r.D;
    }
}

// Under Sa = 3 the secant demand of a point is Ds = 3 D / A, so B' = 3 / A: a closed form. Reduced
// by B' the level spectrum goes through the point.
TEST(PerfPtFema440, DampingOfThePointComesFromThe5PercentSpectrum)
{
    for (const char procedure : {'A', 'B', 'C'}) {
        CTestRecord record(Bilinear(1, 1, 0.1, 60), Level(3.0), {0}, kGravityUnit);
        const T_RUN run = RunProcedure(record, procedure);
        ASSERT_EQ(1, run.result) << procedure;
        EXPECT_NEAR(1.0 + 0.1 * (run.D - 1.0), run.A, 1e-9) << "on the capacity";
        EXPECT_NEAR(std::exp(5.6 - 4.0 * run.A / 3.0), run.beta.value(), 1e-9) << procedure;
        ASSERT_EQ(2u, record.PerfPointSpectrum().Sa.size());
        EXPECT_NEAR(run.A, record.PerfPointSpectrum().Sa[0], 1e-12) << procedure;
        // The trial's own spectrum: 3 / B, times M for the MADRS.
        const T_PERFPT_TRIAL& t = run.trace.back();
        const double level = 3.0 * (5.6 - std::log(*t.betaEff)) / 4.0 * t.M.value_or(1.0);
        EXPECT_NEAR(level, record.WorkingDemand().Sa[1], 1e-12) << procedure;
    }
}

TEST(PerfPtFema440, ADuctilityOfOneEndsElasticWithFivePercent)
{
    for (const char procedure : {'A', 'B', 'C'}) {
        CTestRecord record(WithTinyStart({{1.0, 1.0}, {20.0, 20.0}}), Level(3.0), {0},
                           kGravityUnit);
        const T_RUN run = RunProcedure(record, procedure);
        EXPECT_EQ(2, run.result) << procedure;
        EXPECT_EQ(PUSH_OUTCOME::Elastic, run.outcome.code);
        EXPECT_NEAR(run.D, run.A, 1e-9) << procedure;
        if (procedure == 'C') { // stops before its first step and sets no damping, on purpose
            EXPECT_NEAR(3.0, run.D, 1e-9);
            EXPECT_FALSE(run.beta);
            EXPECT_TRUE(run.trace.empty());
        } else {
            EXPECT_NEAR(5.0, run.beta.value(), 1e-9) << procedure;
            EXPECT_NEAR(3.0 / 1.0023650584, run.D, 1e-9) << "reduced by B(5)";
            EXPECT_EQ(1.0, run.trace.at(0).mu);
        }
    }
}

TEST(PerfPtFema440, FailuresNameThemselvesAndLeaveTheOutputsAlone)
{
    struct T_CASE {
        char procedure;
        double Ca;
        T_POINTS capacity;
        int type;
        PUSH_OUTCOME outcome;
        std::size_t trials;
    };
    const T_POINTS plateau = Bilinear(10, 0.1, 0.0, 2000);
    const T_POINTS dip = WithTinyStart({{10, 0.1}, {11, 0.0}, {60, 0.0}, {600, 0.5}});
    const T_CASE cases[] = {
        // Strength degrading: no real period beyond mu = 35.3.
        {'A', 3.0, plateau, 2, PUSH_OUTCOME::CoefficientsFailed, 1},
        {'A', 1.0, plateau, 2, PUSH_OUTCOME::NoPeriodCrossing, 2}, // beyond 10 s
        {'A', 0.4, Bilinear(10, 0.1, 0.05, 90), 2, PUSH_OUTCOME::CurveTooShort, 2},
        {'B', 3.0, plateau, 0, PUSH_OUTCOME::NoCrossing, 1},
        {'C', 3.0, plateau, 1, PUSH_OUTCOME::Trials1500, 1499},
        {'C', 20.0, plateau, 0, PUSH_OUTCOME::TrialBeyond, 0},
        {'A', 1.0, {{0.0, 0.0}}, 0, PUSH_OUTCOME::NoCapacity, 0},
    };
    for (const T_CASE& c : cases) {
        CTestRecord record(c.capacity, Atc40(c.Ca), {c.type});
        const T_RUN run = RunProcedure(record, c.procedure);
        const std::string name = c.procedure + (" " + OutcomeName(run.outcome));
        EXPECT_EQ(0, run.result) << name;
        EXPECT_EQ(c.outcome, run.outcome.code) << name;
        EXPECT_EQ(c.trials, run.trace.size()) << name;
        EXPECT_EQ(-1.0, run.D) << name;
        EXPECT_EQ(-2.0, run.A) << name;
        EXPECT_FALSE(run.beta) << name;
        EXPECT_EQ(T_ADRS_CURVE{}, record.PerfPointSpectrum()) << name;
    }
}

TEST(PerfPtFema440, ARepeatedTrialEndsAsACycle)
{
    const T_POINTS sharp = WithTinyStart(
        {{20, 0.3}, {22, 0.3}, {24, 0.27}, {144, 0.324}, {264, 0.324}, {1320, 0.389}});
    CTestRecord record(sharp, Atc40(0.2), {3});
    const T_RUN run = RunProcedure(record, 'B');
    ASSERT_EQ(PUSH_OUTCOME::Cycles, run.outcome.code);
    ASSERT_EQ(7u, run.trace.size()) << "as the reference calculation has it";
    const auto k = static_cast<std::size_t>(run.outcome.count);
    EXPECT_EQ(run.trace.at(7 - k).dpi, run.trace[6].Di);
}

TEST(PerfPtFema440, AnyTypeWarnsOutsidePeriodsOf02To2Seconds)
{
    struct T_CASE {
        double T0;
        int type;
        std::size_t warnings;
    };
    const T_CASE cases[] = {{0.19, 3, 1}, {0.2, 3, 0}, {2.0, 3, 0}, {2.01, 3, 1}, {2.01, 2, 0}};
    for (const T_CASE& c : cases) {
        // Sa = 1, g = 1: Sd = (T0 / 2 pi)2, nudged to the inner side of the limit by a last bit.
        double Sd = std::pow(c.T0 / (2.0 * std::numbers::pi), 2);
        const auto T = [&Sd] { return 2.0 * std::numbers::pi * std::sqrt(Sd); };
        while (c.T0 == 0.2 && T() < 0.2)
            Sd = std::nextafter(Sd, 1.0);
        while (c.T0 == 2.0 && T() > 2.0)
            Sd = std::nextafter(Sd, 0.0);
        ASSERT_NEAR(c.T0, T(), 1e-15);
        for (const char procedure : {'A', 'B', 'C'}) {
            CTestRecord record({{Sd / 10, 0.1}, {Sd, 1.0}, {9 * Sd, 9.0}}, Level(3.0), {c.type}, 1);
            EXPECT_EQ(2, RunProcedure(record, procedure).result) << "a warning does not stop it";
            ASSERT_EQ(c.warnings, record.Warnings().size()) << procedure << c.T0;
            for (const std::string& key : record.Warnings())
                EXPECT_EQ("IDS_RPS_FEMA440_WARNING_ANYTYPE_TO", key);
        }
    }
}

TEST(PerfPtFema440, DuctilityAbove10WarnsOnceAtConvergence)
{
    const std::vector<std::string> warned{"IDS_RPS_FEMA440_WARNING_U_GREATER_THAN_10"};
    for (const char procedure : {'A', 'B'}) {
        CTestRecord high(Bilinear(10, 0.1, 0.05, 2000), Atc40(0.6));
        ASSERT_GT(RunProcedure(high, procedure).trace.back().mu.value(), 10.0);
        EXPECT_EQ(warned, high.Warnings()) << procedure;
        CTestRecord lower(Bilinear(10, 0.1, 0.05, 2000), Atc40(0.4));
        ASSERT_GT(RunProcedure(lower, procedure).trace.back().mu.value(), 6.5);
        EXPECT_TRUE(lower.Warnings().empty()) << procedure;
    }
}

TEST(PerfPtFema440, AlphaInPercentSelectsTheRowByAHundredTimesTheRatio)
{
    CTestRecord record(Bilinear(10, 0.1, 0.04, 2000), Atc40(0.6));
    const T_RUN ratio = RunProcedure(record, 'A');
    EXPECT_NEAR(146.3129890843, ratio.D, 1e-6); // both from tests/oracle/evaluate.py
    record.SetAlphaInPercent(true);
    const T_RUN percent = RunProcedure(record, 'A');
    EXPECT_EQ("bilinear, alpha <= 5", Fema440RowText(percent.trace[0].row.value()));
    EXPECT_NEAR(131.9466001029, percent.D, 1e-6);
    EXPECT_EQ(ratio.trace[0].alpha, percent.trace[0].alpha) << "the ratio itself is not scaled";
    EXPECT_EQ(2, RunProcedure(record, 'C').trace[0].row);
}

TEST(PerfPtFema440, DebugLinePrintsItsOwnBounds)
{
    std::string last;
    SetDebugSink([&last](std::string_view line) { last = line; });
    CTestRecord record(Atc40ExampleCurve(), kExampleSd);
    const T_RUN run = RunProcedure(record, 'A');
    SetDebugSink({});
    char text[200]; // 0.97 and 1.03 are printed on purpose
    const T_PERFPT_TRIAL& t = run.trace[0];
    std::snprintf(text, sizeof text, "#1 0.95*Dpi(%g) <= Di(%g) <= 1.05*Dpi(%g) ", 0.97 * t.dpi,
                  *t.Di, 1.03 * t.dpi);
    EXPECT_EQ(text, last);
}

TEST(PerfPtFema440, IterationLogIsExactToTheByte)
{
    CTestRecord record(Bilinear(1, 1, 0, 9), Level(1.0));
    CLogProbe probe(record);
    CLogProbe::T_LOG_RECORD r{0, 1, 1234.5678, 0.25, -3, 1e-30, 5, 0.1, 12.5, 0.75, 1e9};
    const auto write = [&](const std::string& model) {
        record.SetModelPath(model);
        EXPECT_EQ(model.empty() ? 0 : 1, probe.WriteIterationLog(r));
    };
    const std::string head = "      Type,  Step,        dpi,        api,         dy,         ay,";
    const std::string row = ",     1,    1234.57,       0.25,         -3,      1e-30,";
    const std::string T = "      T_eff,   Beta_eff", values = "        0.1,       12.5";
    const std::string texts[] = {
        head + T + "\n         A" + row + values + "\n\n",
        head + T + ",          M\n         B" + row + values + ",       0.75\n\n",
        head + "        Myu," + T + ",          M,       Tsec\n         C" + row + "          5," +
            values + ",       0.75,      1e+09\n\n"};
    for (r.kind = 0; r.kind < 3; ++r.kind)
        EXPECT_EQ(texts[r.kind], LogOf("kind", true, write));
    r.kind = 0;
    EXPECT_EQ("", LogOf("off", false, write));
    LogOf("no_path", true, [&](const std::string&) { write(""); });
}

TEST(PerfPtFema440, EveryTrialLeavesOneRecordAndAnElasticEndAnother)
{
    struct T_CASE {
        char procedure;
        T_POINTS capacity;
        double Ca;
        int type, records;
        const char* lastRecord; // kind and step, as printed
    };
    const T_POINTS hard5 = Bilinear(10, 0.1, 0.05, 2000), hard20 = Bilinear(10, 0.1, 0.2, 2000);
    const T_CASE cases[] = {
        {'A', hard5, 0.4, 2, 4, "\n         A,     4, "},   // converged
        {'B', hard20, 0.6, 2, 6, "\n         B,     5, "},  // elastic at the fifth trial
        {'C', hard5, 0.6, 0, 7, "\n         C,     8, "},   // its counter starts at 2
        {'C', hard20, 0.6, 2, 19, "\n         C,    19, "}, // elastic at the 18th step
    };
    for (const T_CASE& c : cases) {
        CTestRecord record(c.capacity, Atc40(c.Ca), {c.type});
        const std::string log = LogOf("run", true, [&](const std::string& model) {
            record.SetModelPath(model);
            RunProcedure(record, c.procedure);
        });
        int records = 0;
        for (std::size_t at = 0; (at = log.find("      Type,", at)) != std::string::npos; ++at)
            ++records;
        EXPECT_EQ(c.records, records) << c.procedure << c.Ca;
        EXPECT_NE(std::string::npos, log.rfind(c.lastRecord)) << log;
        EXPECT_GT(log.rfind(c.lastRecord), log.rfind("      Type,")) << "in the last record";
    }
}
