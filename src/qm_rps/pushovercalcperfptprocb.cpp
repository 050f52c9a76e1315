#include "qm_rps/pushovercalcperfptprocb.h"

#include "qm_rps/pushover/releaseassert.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr double kFirstMu = 1.2, kStepMu = 0.2, kLastMu = 10.0;
constexpr std::array<double, 4> kSampledMu{2.0, 4.0, 6.0, 8.0};

void Assert(int line)
{
    ReleaseAssert("src/qm_rps/pushovercalcperfptprocb", line);
}

} // namespace

CPushOverCalcPerfPtProcB::SWEEP CPushOverCalcPerfPtProcB::Step(double mu, double T0, double& dy,
                                                               double& ay)
{
    const double d = mu * dy;
    double a = 0.0;
    if (!GetCapacityAccelAt(d, a)) return SWEEP::CurveEnds;
    T_PERFPT_TRIAL& row = StartTrial(++m_iteration, d, a);
    row.dy = dy;
    row.ay = ay;
    row.mu = mu;
    const double alpha = (a / ay - 1.0) / (d / dy - 1.0);
    const double Teff = T0 * std::sqrt(mu / (alpha * mu + 1.0 - alpha));
    if (!std::isfinite(alpha) || !std::isfinite(Teff)) {
        End(PUSH_OUTCOME::PeriodUndefined, kPerfPtNone);
        return SWEEP::Failed;
    }
    row.alpha = alpha;
    row.Teff = Teff;
    const auto sampled = [mu](double m) { return std::fabs(mu - m) <= 1e-13; };
    if (std::ranges::any_of(kSampledMu, sampled)) m_teffs.push_back(Teff);

    double SRa = 0.0, SRv = 0.0, betaEff = 0.0;
    if (!CalcSpectralReductionFactors(dy, ay, d, a, SRa, SRv, betaEff)) {
        End(PUSH_OUTCOME::DampingFailed, kPerfPtNone);
        return SWEEP::Failed;
    }
    row.kappa = m_last.kappa;
    row.betaEff = betaEff;
    row.SRa = SRa;
    row.SRv = SRv;
    m_owner.DesignSpectrum()->CalcPOSpectrumSRaSRv(SRa, SRv, m_T, m_Sa);
    m_owner.ToAdrs(m_T, m_Sa, m_Sd);
    double Di = 0.0, Ai = 0.0;
    if (!IntersectPeriodLineWithCurve(m_Sd, m_Sa, Teff, Di, Ai)) {
        Assert(117);
        return SWEEP::Next; // the yield point stays
    }
    row.Di = Di;
    row.Ai = Ai;
    m_traceD.push_back(Di);
    m_traceA.push_back(Ai);
    m_traceBeta.push_back(betaEff);
    if (!BilinearizeAt(d, a, dy, ay)) Assert(122);
    return SWEEP::Next;
}

int CPushOverCalcPerfPtProcB::CrossLocus(double& Dp, double& Ap, double& beta)
{
    constexpr double kVertical = 1e-9; // relative difference of D below which A interpolates
    const auto same = [](double a, double b) {
        return std::fabs(b - a) <= kVertical * std::max(std::fabs(a), std::fabs(b));
    };
    for (std::size_t i = 0; i + 1 < m_traceD.size(); ++i) {
        const T_POINT2 from{m_traceD[i], m_traceA[i]}, to{m_traceD[i + 1], m_traceA[i + 1]};
        // Of an elastic structure the locus stays in one point of the capacity, but for rounding.
        const bool stays = same(from.x, to.x) && same(from.y, to.y);
        double onCurve = 0.0, w = 0.0;
        T_POINT2 point = from;
        if (stays) {
            if (!GetCapacityAccelAt(from.x, onCurve) || !same(from.y, onCurve)) continue;
        } else {
            if (!IntersectSegmentWithCapacity(from, to, point)) continue;
            w = same(from.x, to.x) ? (point.y - from.y) / (to.y - from.y)
                                   : (point.x - from.x) / (to.x - from.x);
        }
        beta = m_traceBeta[i] + (m_traceBeta[i + 1] - m_traceBeta[i]) * w;
        if (!std::isfinite(beta)) continue;
        Dp = point.x;
        Ap = point.y;
        return 1;
    }
    return 0;
}

void CPushOverCalcPerfPtProcB::StoreFound(double Dp, double Ap, double beta)
{
    // The spectrum for beta is computed but not handed on: the locus is what this procedure shows.
    if (m_owner.DesignSpectrum()->CalcPOSpectrumByDamping(beta, m_T, m_Sa))
        m_owner.ToAdrs(m_T, m_Sa, m_Sd);
    m_owner.SetPerfPointTeffData(PeriodOf(Dp, Ap));
    m_owner.SetTeffsData(m_teffs);
}

int CPushOverCalcPerfPtProcB::IteratePerformancePoint(double& Dp, double& Ap,
                                                      std::optional<double>& beta, double dpi,
                                                      double api, double, double Dd, double Ad)
{
    const double T0 = PeriodOf(Capacity().Sd[1], Capacity().Sa[1]);
    if (!std::isfinite(T0)) return End(PUSH_OUTCOME::PeriodUndefined, kPerfPtNone);
    m_traceD = {Dd};
    m_traceA = {Ad};
    m_traceBeta = {5.0};
    m_teffs = {T0};
    double dy = 0.0, ay = 0.0;
    if (!BilinearizeAt(dpi, api, dy, ay)) {
        Assert(69);
        return End(PUSH_OUTCOME::BilinearFailed, kPerfPtNone);
    }
    // The running sum is meant: a sampled ductility missed by rounding is simply absent.
    for (double mu = kFirstMu; mu <= kLastMu; mu += kStepMu) {
        const SWEEP step = Step(mu, T0, dy, ay);
        if (step == SWEEP::Failed) return kPerfPtNone;
        if (step == SWEEP::CurveEnds) break;
    }
    m_owner.SetPerfPointTraceData(m_traceD, m_traceA);

    double damping = 0.0;
    if (!CrossLocus(Dp, Ap, damping)) {
        const bool empty = m_traceD.size() == 1 && m_trace.empty();
        return End(empty ? PUSH_OUTCOME::CapacityEnds : PUSH_OUTCOME::NoLocusCrossing, kPerfPtNone);
    }
    beta = damping;
    if (IsElasticDamping(damping)) return End(PUSH_OUTCOME::Elastic, kPerfPtElastic);
    StoreFound(Dp, Ap, damping);
    return End(PUSH_OUTCOME::Converged, kPerfPtFound);
}
