#include "qm_rps/pushovercalcperfptfema440proca.h"

#include "qm_base/debugout.h"
#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/fema440coefficients.h"

#include <cmath>

namespace {

constexpr double kAccept = 0.05; // the trial stands when within 5 %

} // namespace

CPushOverCalcPerfPtFEMA440ProcA::CPushOverCalcPerfPtFEMA440ProcA(CPushOverPerfPtRecord& owner,
                                                                 int variant)
    : CPushOverCalcPerfPtFEMA440Base(owner, "src/qm_rps/pushovercalcperfptfema440proca"),
      m_variant(variant)
{
    m_log.kind = variant;
}

int CPushOverCalcPerfPtFEMA440ProcA::CalcPerformancePoint(double& Dp, double& Ap,
                                                          std::optional<double>& beta,
                                                          T_POINT2* slopeChange)
{
    m_trace.clear();
    if (Capacity().Sd.size() < 2) return End(PUSH_OUTCOME::NoCapacity, kPerfPtNone);
    const double Sd1 = Capacity().Sd[1], Sa1 = Capacity().Sa[1];
    if (std::fabs(Sa1) < 1e-15) {
        Assert(72);
        return End(PUSH_OUTCOME::NoCapacity, kPerfPtNone);
    }
    m_T0 = PeriodOf(Sd1, Sa1);
    WarnAnyType(m_T0);
    m_working.Restore();
    double dpi = 0.0, api = 0.0, Dd = 0.0, Ad = 0.0;
    if (!FindTrialPointOnWorkingSpectrum(Sd1, Sa1, true, dpi, api, Dd, Ad)) {
        Assert(88);
        return kPerfPtNone;
    }
    T_POINT2 change;
    const int changes = FindFirstSlopeChange(change.x, change.y);
    GDebugOut("slope change %d at %g, %g", changes, change.x, change.y);
    if (slopeChange) *slopeChange = change;
    m_iteration = 0;
    return IteratePerformancePoint(Dp, Ap, beta, dpi, api, change.x, Dd, Ad);
}

int CPushOverCalcPerfPtFEMA440ProcA::CalcDuctility(double dpi, double api, double& alpha)
{
    double dy = 0.0, ay = 0.0;
    if (!BilinearizeAt(dpi, api, dy, ay)) return Fail(PUSH_OUTCOME::BilinearFailed);
    GDebugOut("#%d Dy:%g Ay:%g", m_iteration, dy, ay);
    m_log.dy = dy;
    m_log.ay = ay;
    if (std::fabs(dy) < 1e-30) return Fail(PUSH_OUTCOME::BilinearFailed);
    m_log.mu = dpi / dy;
    alpha = PostYieldRatio(dy, ay, dpi, api);
    if (!std::isfinite(alpha) || !std::isfinite(m_log.mu))
        return Fail(PUSH_OUTCOME::BilinearFailed);
    m_trace.back().alpha = alpha;
    return 1;
}

// Effective period, damping and reduced spectrum for the ductility.
int CPushOverCalcPerfPtFEMA440ProcA::CalcEquivalentSystem(double mu, double alpha)
{
    if (mu < 1.0) {
        Assert(139);
        return Fail(PUSH_OUTCOME::DuctilityBelow1);
    }
    const int range = Fema440DuctilityRange(mu);
    if (!CalcFema440EffectivePeriod(m_T0, mu, alpha, range, m_log.Teff)) {
        Assert(144);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    if (!CalcFema440EffectiveDamping(m_T0, m_log.Teff, mu, alpha, range, m_log.betaEff)) {
        Assert(145);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    double B = 0.0;
    if (!CalcFema440B(m_log.betaEff, B) || !m_working.ReduceByB(B)) {
        Assert(149);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    return 1;
}

int CPushOverCalcPerfPtFEMA440ProcA::FindTrialResult(double mu, double alpha, double& Di,
                                                     double& Ai)
{
    const T_ADRS_CURVE& working = m_working.Curve();
    if (m_variant == 1) {
        if (!CalcFema440M(m_log.Teff, m_T0, alpha, mu, m_log.M)) {
            Assert(155);
            return Fail(PUSH_OUTCOME::CoefficientsFailed);
        }
        m_working.Modify(m_log.M);
        if (!m_owner.PerfPt_GetCrossPointDiAi(working.Sd, working.Sa, Di, Ai))
            return Fail(PUSH_OUTCOME::NoCrossing);
        return 1;
    }
    if (!IntersectPeriodLineWithCurve(working.Sd, working.Sa, m_log.Teff, Di, Ai))
        return Fail(PUSH_OUTCOME::NoPeriodCrossing);
    if (!GetCapacityPointAtDisplacement2(Di, Ai, Di, Ai)) return Fail(PUSH_OUTCOME::CurveTooShort);
    return 1;
}

int CPushOverCalcPerfPtFEMA440ProcA::CalcTrial(double dpi, double api, T_POINT_FOUND& found,
                                               double& Di, double& Ai)
{
    double alpha = 0.0;
    if (!CalcDuctility(dpi, api, alpha)) return 0;
    if (m_log.mu == 1.0) { // kept unless the trial converges below
        found = {m_log.dy, m_log.ay, 5.0};
        const T_ADRS_CURVE& working = m_working.Curve();
        if (m_variant == 0 &&
            !m_owner.PerfPt_GetCrossPointDiAi(working.Sd, working.Sa, found.D, found.A))
            return Fail(PUSH_OUTCOME::NoCrossing);
    }
    if (!CalcEquivalentSystem(m_log.mu, alpha)) return 0;
    if (!FindTrialResult(m_log.mu, alpha, Di, Ai)) return 0;
    // The printed bounds are 0.97 and 1.03 on purpose; the test uses 0.95 and 1.05.
    GDebugOut("#%d 0.95*Dpi(%g) <= Di(%g) <= 1.05*Dpi(%g) ", m_iteration, 0.97 * dpi, Di,
              1.03 * dpi);
    m_trace.back().Di = Di;
    m_trace.back().Ai = Ai;
    return 1;
}

int CPushOverCalcPerfPtFEMA440ProcA::Converge(double Di, double Ai, T_POINT_FOUND& found)
{
    if (m_log.mu > 10.0) m_owner.AddWarning("IDS_RPS_FEMA440_WARNING_U_GREATER_THAN_10");
    KeepTrial();
    WriteIterationLog(m_log);
    m_owner.SetWorkingDemand(m_working.Curve());
    double beta = 0.0;
    if (!CalcSecantDamping(Di, Ai, 183, beta)) return End(PUSH_OUTCOME::NotComputed, kPerfPtNone);
    found = {Di, Ai, beta};
    if (!IsElasticDamping(beta)) return End(PUSH_OUTCOME::Converged, kPerfPtFound);
    WriteIterationLog(m_log);
    return End(PUSH_OUTCOME::Elastic, kPerfPtElastic);
}

int CPushOverCalcPerfPtFEMA440ProcA::IteratePerformancePoint(double& Dp, double& Ap,
                                                             std::optional<double>& beta,
                                                             double dpi, double api, double, double,
                                                             double)
{
    while (++m_iteration <= kMaxTrials) {
        if (const int cycle = RepeatsAfter(dpi, api))
            return End(PUSH_OUTCOME::Cycles, kPerfPtNone, cycle);
        StartTrial(m_iteration, dpi, api);
        m_log = {m_variant, m_iteration, dpi, api};
        T_POINT_FOUND found;
        double Di = 0.0, Ai = 0.0;
        if (!CalcTrial(dpi, api, found, Di, Ai)) return kPerfPtNone;
        if (Di > (1.0 + kAccept) * dpi || Di < (1.0 - kAccept) * dpi) {
            if (m_variant == 0 && !GetCapacityPointAtDisplacement(Di, Di, Ai))
                return Fail(PUSH_OUTCOME::CurveTooShort);
            KeepTrial();
            WriteIterationLog(m_log);
            dpi = Di;
            api = Ai;
            continue;
        }
        const int result = Converge(Di, Ai, found);
        if (result != kPerfPtNone) {
            Dp = found.D;
            Ap = found.A;
            beta = found.beta;
        }
        return result;
    }
    return End(PUSH_OUTCOME::Trials1500, kPerfPtNone);
}
