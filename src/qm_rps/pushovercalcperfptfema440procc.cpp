#include "qm_rps/pushovercalcperfptfema440procc.h"

#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/fema440coefficients.h"

#include <cmath>

namespace {

constexpr int kKindC = 2;
constexpr double kElasticMu = 0.05; // ductility this close to 1: elastic

} // namespace

CPushOverCalcPerfPtFEMA440ProcC::CPushOverCalcPerfPtFEMA440ProcC(CPushOverPerfPtRecord& owner)
    : CPushOverCalcPerfPtFEMA440Base(owner, "src/qm_rps/pushovercalcperfptfema440procc")
{
    m_log.kind = kKindC;
}

int CPushOverCalcPerfPtFEMA440ProcC::CalcYield(double dpi, double api)
{
    m_log = {kKindC, m_iteration, dpi, api};
    if (!BilinearizeAt(dpi, api, m_dy, m_ay)) {
        Assert(87);
        return Fail(PUSH_OUTCOME::BilinearFailed);
    }
    m_alpha = PostYieldRatio(m_dy, m_ay, dpi, api);
    m_mu0 = dpi / m_dy;
    if (!std::isfinite(m_alpha) || !std::isfinite(m_mu0)) return Fail(PUSH_OUTCOME::BilinearFailed);
    return 1;
}

int CPushOverCalcPerfPtFEMA440ProcC::CalcPerformancePoint(double& Dp, double& Ap,
                                                          std::optional<double>& beta,
                                                          T_POINT2* slopeChange)
{
    m_trace.clear();
    if (Capacity().Sd.size() < 2) return End(PUSH_OUTCOME::NoCapacity, kPerfPtNone);
    const double Sd1 = Capacity().Sd[1], Sa1 = Capacity().Sa[1];
    m_working.Restore();
    double dpi = 0.0, api = 0.0, Ds = 0.0, As = 0.0;
    if (!FindTrialPointOnWorkingSpectrum(Sd1, Sa1, true, dpi, api, Ds, As)) {
        Assert(79);
        return kPerfPtNone;
    }
    T_POINT2 change;
    if (!FindFirstSlopeChange(change.x, change.y)) Assert(81);
    if (slopeChange) *slopeChange = change;
    m_iteration = 1; // the first step runs with counter 2
    if (!CalcYield(dpi, api)) return kPerfPtNone;
    m_T0 = PeriodOf(Sd1, Sa1);
    WarnAnyType(m_T0);
    double D0 = 0.0, A0 = 0.0;
    if (!IntersectPeriodLineWithCurve(m_working.Curve().Sd, m_working.Curve().Sa, m_T0, D0, A0)) {
        Assert(115);
        return Fail(PUSH_OUTCOME::NoPeriodCrossing);
    }
    m_locus = {};
    if (std::fabs(m_mu0 - 1.0) < kElasticMu) {
        Dp = dpi;
        Ap = api;
        return End(PUSH_OUTCOME::Elastic, kPerfPtElastic); // beta is left as it was, on purpose
    }
    return IteratePerformancePoint(Dp, Ap, beta, dpi, api, change.x, D0, A0);
}

int CPushOverCalcPerfPtFEMA440ProcC::CalcLocusPoint(double mu, double& Di, double& Ai)
{
    if (mu < 1.0) {
        Assert(157);
        return Fail(PUSH_OUTCOME::DuctilityBelow1);
    }
    const int range = Fema440DuctilityRange(mu);
    if (!CalcFema440EffectivePeriod(m_T0, mu, m_alpha, range, m_log.Teff)) {
        Assert(159);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    if (!CalcFema440EffectiveDamping(m_T0, m_log.Teff, mu, m_alpha, range, m_log.betaEff)) {
        Assert(160);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    double B = 0.0;
    if (!CalcFema440B(m_log.betaEff, B) || !m_working.ReduceByB(B)) {
        Assert(164);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    if (!CalcFema440M(m_log.Teff, m_T0, m_alpha, mu, m_log.M)) {
        Assert(166);
        return Fail(PUSH_OUTCOME::CoefficientsFailed);
    }
    m_working.Modify(m_log.M);
    m_log.Tsec = m_T0 * std::sqrt(mu / (m_alpha * (mu - 1.0) + 1.0));
    if (!std::isfinite(m_log.Tsec)) return Fail(PUSH_OUTCOME::PeriodUndefined);
    if (!IntersectPeriodLineWithCurve(m_working.Curve().Sd, m_working.Curve().Sa, m_log.Tsec, Di,
                                      Ai)) {
        Assert(173);
        return Fail(PUSH_OUTCOME::NoPeriodCrossing);
    }
    return 1;
}

int CPushOverCalcPerfPtFEMA440ProcC::Finish(const T_POINT2& point, std::optional<double>& beta)
{
    double damping = 0.0;
    if (!CalcSecantDamping(point.x, point.y, 210, damping))
        return End(PUSH_OUTCOME::NotComputed, kPerfPtNone);
    beta = damping;
    if (!IsElasticDamping(damping)) return End(PUSH_OUTCOME::Converged, kPerfPtFound);
    WriteIterationLog(m_log);
    return End(PUSH_OUTCOME::Elastic, kPerfPtElastic);
}

int CPushOverCalcPerfPtFEMA440ProcC::IteratePerformancePoint(double& Dp, double& Ap,
                                                             std::optional<double>& beta,
                                                             double dpi, double api, double,
                                                             double Dd, double Ad)
{
    T_POINT2 previous{Dd, Ad};
    m_locus = {{Dd}, {Ad}};
    while (++m_iteration <= kMaxTrials) {
        const double mu = m_mu0 + (m_iteration - 2); // grows by 1 a step
        StartTrial(m_iteration - 1, dpi, api);
        m_log = {kKindC, m_iteration, dpi, api, m_dy, m_ay, mu};
        m_trace.back().alpha = m_alpha;
        T_POINT2 next;
        if (!CalcLocusPoint(mu, next.x, next.y)) return kPerfPtNone;
        m_trace.back().Di = next.x;
        m_trace.back().Ai = next.y;
        KeepTrial();
        m_locus.Sd.push_back(next.x);
        m_locus.Sa.push_back(next.y);
        m_owner.SetWorkingDemand(m_working.Curve());
        WriteIterationLog(m_log);
        T_POINT2 crossing;
        if (IntersectSegmentWithCapacity(previous, next, crossing)) {
            const int result = Finish(crossing, beta);
            if (result == kPerfPtNone) return result;
            Dp = crossing.x;
            Ap = crossing.y;
            return result;
        }
        previous = next;
    }
    m_log.step = m_iteration;
    return Fail(PUSH_OUTCOME::Trials1500);
}
