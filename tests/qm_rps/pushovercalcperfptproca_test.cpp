#include "qm_rps/pushovercalcperfptproca.h"

#include "perfptfixture.h"

#include <algorithm>
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

TEST(PerfPtProcA, StopsAfter1500Trials)
{
    CTestRecord record(Atc40ExampleCurve(), kExampleSd); // 15 trials
    EXPECT_EQ(1500, RunPerfPt<CLateStart>(record, 1485).trace.back().trial);
    const T_RUN late = RunPerfPt<CLateStart>(record, 1486);
    EXPECT_EQ(PUSH_OUTCOME::Trials1500, late.outcome.code);
    EXPECT_EQ(-1.0, late.D);
}

TEST(PerfPtProcA, StoresTheReducedSpectrum)
{
    CTestRecord record(Atc40ExampleCurve(), kExampleSb, {2});
    const T_RUN run = RunPerfPt<CALC>(record);
    ASSERT_EQ(1u, run.trace.size()) << "converged at once";
    const T_PERFPT_TRIAL& t = run.trace[0];
    const T_ADRS_CURVE& stored = record.PerfPointSpectrum();
    EXPECT_NEAR(t.SRa.value() * 2.5 * 0.4, std::ranges::max(stored.Sa), 1e-12);
    const double T = record.DemandPeriods().back(); // velocity branch; Sd = T2 Sa g / (4 pi2)
    EXPECT_NEAR(t.SRv.value() * 0.4 / T, stored.Sa.back(), 1e-12);
    EXPECT_NEAR(T * T * stored.Sa.back() * kGravityMm / kGravityUnit, stored.Sd.back(), 1e-9);
}
