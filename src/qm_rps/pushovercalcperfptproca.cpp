#include "qm_rps/pushovercalcperfptproca.h"

#include "qm_base/debugout.h"
#include "qm_rps/pushover/releaseassert.h"

#include <cmath>

namespace {

constexpr double kAccept = 0.05;     // ATC-40: the trial stands when within 5 %
constexpr double kZeroTrial = 1e-30; // product of a trial point's coordinates

} // namespace

int CPushOverCalcPerfPtProcA::CalcTrial(double dpi, double api, double& Di, double& Ai,
                                        double& betaEff)
{
    T_PERFPT_TRIAL& row = m_trace.back();
    double dy = 0.0, ay = 0.0;
    if (!BilinearizeAt(dpi, api, dy, ay)) {
        ReleaseAssert("src/qm_rps/pushovercalcperfptproca", 70);
        return End(PUSH_OUTCOME::BilinearFailed, 0);
    }
    row.dy = dy;
    row.ay = ay;
    row.mu = dpi / dy;
    row.Teff = PeriodOf(dpi, api);
    GDebugOut("#%d Dy:%g Ay:%g", m_iteration, dy, ay);
    if (std::fabs(api * dpi) < kZeroTrial) return End(PUSH_OUTCOME::ZeroTrial, 0);

    double SRa = 0.0, SRv = 0.0;
    if (!CalcSpectralReductionFactors(dy, ay, dpi, api, SRa, SRv, betaEff))
        return End(PUSH_OUTCOME::DampingFailed, 0);
    row.kappa = m_last.kappa;
    row.betaEff = betaEff;
    row.SRa = SRa;
    row.SRv = SRv;

    m_owner.DesignSpectrum()->CalcPOSpectrumSRaSRv(SRa, SRv, m_T, m_Sa);
    m_owner.ToAdrs(m_T, m_Sa, m_Sd);
    if (!m_owner.PerfPt_GetCrossPointDiAi(m_Sd, m_Sa, Di, Ai))
        return End(PUSH_OUTCOME::NoCrossing, 0);
    row.Di = Di;
    row.Ai = Ai;
    return 1;
}

int CPushOverCalcPerfPtProcA::IteratePerformancePoint(double& Dp, double& Ap,
                                                      std::optional<double>& beta, double dpi,
                                                      double api, double, double, double)
{
    while (++m_iteration <= kMaxTrials) {
        if (const int cycle = RepeatsAfter(dpi, api))
            return End(PUSH_OUTCOME::Cycles, kPerfPtNone, cycle);
        StartTrial(m_iteration, dpi, api);
        double Di = 0.0, Ai = 0.0, betaEff = 0.0;
        if (!CalcTrial(dpi, api, Di, Ai, betaEff)) return kPerfPtNone;
        GDebugOut("#%d 0.95*Dpi(%g) <= Di(%g) <= 1.05*Dpi(%g) ", m_iteration, (1.0 - kAccept) * dpi,
                  Di, (1.0 + kAccept) * dpi);
        if (Di > (1.0 + kAccept) * dpi || Di < (1.0 - kAccept) * dpi) {
            dpi = Di;
            api = Ai;
            continue;
        }
        Dp = Di;
        Ap = Ai;
        beta = betaEff;
        if (IsElasticDamping(betaEff)) return End(PUSH_OUTCOME::Elastic, kPerfPtElastic);
        m_owner.SetPerfPointSpectrumData(m_Sa, m_Sd);
        return End(PUSH_OUTCOME::Converged, kPerfPtFound);
    }
    return End(PUSH_OUTCOME::Trials1500, kPerfPtNone);
}
