// FEMA 440 procedures a, b (MADRS crossing) and c (ductility locus).
#include "perfptfixture.h"
#include "qm_base/testenvmgr.h"
#include "tempfolder.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

/// What the iteration log holds after `write`, with its switch on or off.
template <class WRITE>
std::string LogOf(bool on, WRITE write)
{
    const CTempFolder folder;
    CTestEnvMgr::SetTestEnvST("FEMA440", on ? "yes" : "no");
    write(folder / "model");
    CTestEnvMgr::ClearST();
    return ReadText(folder / "model_Pushover.txt");
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
        {'a', 0.0, 0, 1.304, 12.52, {}, 3.918616, 1.0},
        // B = 1.320605, M = 1.288^2 1.2 / 3: the level 3 M / B meets 1 + 0.1 (D - 1)
        {'b', 0.1, 1, 1.288, 13.08, 0.663578, 6.074404, 1.507440},
        // the same level at Tsec2 = 3 / 1.2
        {'c', 0.1, 1, 1.288, 13.08, 0.663578, 3.768601, 1.507440},
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

// Under Sa = 3 the secant demand of a point is Ds = 3 D / A, so B' = 3 / A: a closed form. Reduced
// by B' the level spectrum goes through the point.
TEST(PerfPtFema440, DampingOfThePointComesFromThe5PercentSpectrum)
{
    for (const char procedure : {'a', 'b', 'c'}) {
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
        EXPECT_EQ(texts[r.kind], LogOf(true, write));
    r.kind = 0;
    EXPECT_EQ("", LogOf(false, write));
    LogOf(true, [&](const std::string&) { write(""); });
}

TEST(PerfPtFema440, WarnsOfPeriodsAndDuctilitiesOutsideItsRange)
{
    const struct {
        double T0;
        int type;
        std::size_t warnings; // any type of hysteresis is for 0.2 to 2 s
    } cases[] = {{0.199, 3, 1}, {0.201, 3, 0}, {1.999, 3, 0}, {2.001, 3, 1}, {2.001, 2, 0}};
    for (const auto& c : cases) {
        const double Sd = std::pow(c.T0 / (2.0 * std::numbers::pi), 2); // Sa = 1, g = 1
        for (const char procedure : {'a', 'b', 'c'}) {
            CTestRecord record({{Sd / 10, 0.1}, {Sd, 1.0}, {9 * Sd, 9.0}}, Level(3.0), {c.type}, 1);
            EXPECT_EQ(2, RunProcedure(record, procedure).result) << "a warning does not stop it";
            const std::vector<std::string> expected(c.warnings,
                                                    "IDS_RPS_FEMA440_WARNING_ANYTYPE_TO");
            EXPECT_EQ(expected, record.Warnings()) << procedure << c.T0;
        }
    }
    for (const auto& [Ca, mu] : {std::pair(0.6, 10.0), {0.4, 6.5}}) {
        CTestRecord record(Bilinear(10, 0.1, 0.05, 2000), Atc40(Ca));
        ASSERT_GT(RunProcedure(record, 'b').trace.back().mu.value(), mu);
        const std::vector<std::string> expected(Ca > 0.5,
                                                "IDS_RPS_FEMA440_WARNING_U_GREATER_THAN_10");
        EXPECT_EQ(expected, record.Warnings()) << "once, at convergence";
    }
}
