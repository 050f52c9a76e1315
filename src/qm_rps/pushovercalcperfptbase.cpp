#include "qm_rps/pushovercalcperfptbase.h"

#include "qm_base/appbase.h"
#include "qm_base/debugout.h"
#include "qm_base/logfile.h"
#include "qm_base/testenvmgr.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/pushoverbilinear.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr const char* kSource = "src/qm_rps/pushovercalcperfptbase";
constexpr double kFullLoopPct = 63.7; // 200 / pi as ATC-40 prints it: a rectangular loop
constexpr double kMaxBeta0 = 45.0;    // hysteretic damping is not taken above this, per cent

struct T_KAPPA_ROW {
    int type;
    double kneePct; // kappa is `flat` up to this hysteretic damping
    double flat;
    double k0, k1; // beyond: k0 - k1 * fraction
};

// ATC-40 (1996) Table 8-1, structural behaviour types A, B, C.
// clang-format off
constexpr std::array<T_KAPPA_ROW, 3> kKappa{{
    {0, 16.25,    1.00, 1.130, 0.510},
    {1, 25.00,    0.67, 0.845, 0.446},
    {2, INFINITY, 0.33, 0.000, 0.000},
}};
// clang-format on

void Assert(int line)
{
    if (CAppBase::IsReleaseAssert_ST()) CAppBase::ReleaseAssertion_ST(kSource, line);
}

} // namespace

CPushOverCalcPerfPtBase::CPushOverCalcPerfPtBase(CPushOverPerfPtRecord& owner)
    : m_owner(owner), m_pi(4.0 * std::atan(1.0))
{
    m_trace.reserve(16);
}

int CPushOverCalcPerfPtBase::CalcPerformancePoint(double& Dp, double& Ap,
                                                  std::optional<double>& beta,
                                                  T_POINT2* slopeChange)
{
    m_trace.clear();
    if (Capacity().Sd.size() < 2) return End(PUSH_OUTCOME::NoCapacity, kPerfPtNone);
    double dpi = 0.0, api = 0.0, Dd = 0.0, Ad = 0.0;
    if (!FindInitialTrialPoint(Capacity().Sd[1], Capacity().Sa[1], dpi, api, Dd, Ad)) {
        Assert(__LINE__);
        return kPerfPtNone;
    }
    T_POINT2 change;
    // A curve without a change of slope is evaluated all the same.
    const int changes = FindFirstSlopeChange(change.x, change.y);
    GDebugOut("slope change %d at %g, %g", changes, change.x, change.y);
    if (slopeChange) *slopeChange = change;
    m_iteration = 0;
    return IteratePerformancePoint(Dp, Ap, beta, dpi, api, change.x, Dd, Ad);
}

// The intersections are free of scale, so lengths stay in current units throughout.
int CPushOverCalcPerfPtBase::FindInitialTrialPoint(double D1, double A1, double& dpi, double& api,
                                                   double& Dd, double& Ad)
{
    m_outcome = {PUSH_OUTCOME::NoTrialPoint, 0};
    const auto demand = CCurveCrossing::HalfLine({D1, A1}, m_owner.Demand().View());
    if (!demand) return 0;
    m_outcome = {PUSH_OUTCOME::TrialBeyond, 0};
    const auto trial = CCurveCrossing::Vertical(demand->x, Capacity().View());
    if (!trial) return 0;
    Dd = demand->x;
    Ad = demand->y;
    dpi = trial->x;
    api = trial->y;
    return 1;
}

int CPushOverCalcPerfPtBase::FindFirstSlopeChange(double& D, double& A)
{
    constexpr double kZero = 1e-26;
    constexpr double kChange = 0.1;
    const auto& [Sd, Sa] = Capacity();
    const auto ratio = [&](std::size_t i) {
        return (Sa[i + 1] / Sa[i] - 1.0) / (Sd[i + 1] / Sd[i] - 1.0);
    };
    for (std::size_t i = 0; i + 2 < Sd.size(); ++i) {
        if (std::fabs(Sd[i] * Sa[i]) < kZero || std::fabs(Sd[i + 1] * Sa[i + 1]) < kZero) {
            Assert(__LINE__);
            return 0;
        }
        const double r1 = ratio(i), r2 = ratio(i + 1);
        if (!std::isfinite(r1) || !std::isfinite(r2)) return 0;
        if (std::fabs(r1 - r2) > kChange) {
            D = Sd[i + 1];
            A = Sa[i + 1];
            return 1;
        }
        D = Sd[i + 2];
        A = Sa[i + 2];
    }
    return 0;
}

int CPushOverCalcPerfPtBase::CalcCapacityArea(double d, double& area)
{
    const double sum = CurveArea(Capacity().View(), d);
    if (!std::isfinite(sum)) return 0;
    area = sum;
    return 1;
}

int CPushOverCalcPerfPtBase::BilinearizeAt(double dpi, double api, double& dy, double& ay)
{
    constexpr double kZero = 1e-13;
    constexpr double kOnLine = 0.1;      // ratio this close to 1: on the initial stiffness
    constexpr double kSamePoint = 1e-12; // relative
    const double Sd1 = Capacity().Sd[1], Sa1 = Capacity().Sa[1];
    for (const double v : {dpi, api, Sa1, Sd1}) {
        if (std::fabs(v) < kZero) {
            Assert(__LINE__);
            return 0;
        }
    }
    // The first point and its half point have the ratio 1.
    const double x = dpi / Sd1 - 1.0;
    const double ratio = std::fabs(x) <= kSamePoint ? 1.0 : (api / Sa1 - 1.0) / x;
    if (std::fabs(1.0 - ratio) < kOnLine) {
        dy = dpi;
        ay = api;
        return 1;
    }
    double area = 0.0;
    if (!CalcCapacityArea(dpi, area)) return 0;
    const double den = Sa1 * dpi - Sd1 * api;
    const double excess = 2.0 * area - api * dpi;
    const double newDy = std::min(Sd1 / den * excess, dpi);
    const double newAy = std::min(Sa1 / den * excess, api);
    if (!(newDy > 0.0) || !(newAy > 0.0)) return 0;
    dy = newDy;
    ay = newAy;
    return 1;
}

int CPushOverCalcPerfPtBase::GetCapacityAccelAt(double d, double& Sa) const
{
    const T_ADRS_CURVE& c = Capacity();
    for (std::size_t i = 0; i + 1 < c.Sd.size(); ++i) {
        if (!(c.Sd[i] <= d && d < c.Sd[i + 1])) continue;
        Sa = c.Sa[i] + (c.Sa[i + 1] - c.Sa[i]) * (d - c.Sd[i]) / (c.Sd[i + 1] - c.Sd[i]);
        return 1;
    }
    return 0;
}

int CPushOverCalcPerfPtBase::IntersectSegmentWithCapacity(T_POINT2 P1, T_POINT2 P2,
                                                          T_POINT2& point) const
{
    const auto crossing = CCurveCrossing::Segment(P1, P2, Capacity().View());
    if (!crossing) return 0;
    point = *crossing;
    return 1;
}

int CPushOverCalcPerfPtBase::IntersectPeriodLineWithCurve(const std::vector<double>& Sd,
                                                          const std::vector<double>& Sa, double T,
                                                          double& D, double& A) const
{
    D = A = 0.0;
    const auto crossing = CCurveCrossing::PeriodLine(T, m_owner.GetGravity(1), {Sd, Sa});
    if (!crossing) return 0;
    D = crossing->x;
    A = crossing->y;
    return 1;
}

int CPushOverCalcPerfPtBase::CalcSpectralReductionFactors(double dy, double ay, double dpi,
                                                          double api, double& SRa, double& SRv,
                                                          double& betaEff)
{
    double fraction = (ay * dpi - dy * api) / (api * dpi);
    double beta0 = kFullLoopPct * fraction;
    if (beta0 > kMaxBeta0) {
        beta0 = kMaxBeta0;
        fraction = kMaxBeta0 / kFullLoopPct;
    }
    const T_DAMP_PARAM& damping = m_owner.Damping();
    const double kappa = GetDampingModificationFactor(damping.behaviorType, beta0, fraction);
    const double beta = kappa * beta0 + damping.elasticPct;
    m_last.kappa = kappa;
    if (beta < 0.0) {
        Assert(__LINE__);
        return 0;
    }
    T_SPEC_REDUCTION f;
    if (!CalcSpectralReduction(beta, f)) return 0;
    SRa = f.SRa;
    SRv = f.SRv;
    betaEff = beta;
    return 1;
}

double CPushOverCalcPerfPtBase::GetDampingModificationFactor(int type, double& beta0,
                                                             double fraction) const
{
    for (const T_KAPPA_ROW& row : kKappa) {
        if (row.type == type) return beta0 <= row.kneePct ? row.flat : row.k0 - row.k1 * fraction;
    }
    if (type != 3) return 0.0;
    const T_DAMP_PARAM& user = m_owner.Damping();
    if (beta0 <= user.beta1) return user.kappa1;
    if (beta0 > user.beta2) {
        beta0 = user.beta2; // the damping itself is limited too
        return user.kappa2;
    }
    return user.kappa1 +
           (user.kappa2 - user.kappa1) * (beta0 - user.beta1) / (user.beta2 - user.beta1);
}

bool CPushOverCalcPerfPtBase::IsElasticDamping(double beta) const
{
    return m_owner.Damping().elasticPct > beta || std::fabs(beta - 5.0) < 0.001;
}

int CPushOverCalcPerfPtBase::CalcFema440EffectivePeriod(double T0, double mu, double alpha,
                                                        int range, double& Teff)
{
    const double key = m_owner.AlphaInPercent() ? 100.0 * alpha : alpha;
    const int row = Fema440RowIndex(m_owner.Damping().behaviorType, key);
    m_last.row = row;
    if (CalcFema440Period(Fema440Row(row), range, T0, mu, Teff)) return 1;
    Assert(__LINE__);
    return 0;
}

int CPushOverCalcPerfPtBase::CalcFema440EffectiveDamping(double T0, double Teff, double mu,
                                                         double alpha, int range, double& betaPct)
{
    const double key = m_owner.AlphaInPercent() ? 100.0 * alpha : alpha;
    const int row = Fema440RowIndex(m_owner.Damping().behaviorType, key);
    if (CalcFema440Damping(Fema440Row(row), range, T0, Teff, mu, betaPct)) return 1;
    Assert(__LINE__);
    return 0;
}

int CPushOverCalcPerfPtBase::WriteIterationLog(const T_LOG_RECORD& r) const
{
    if (!CTestEnvMgr::IsTestEnvST("FEMA440", "yes")) return 1;
    if (m_owner.ModelPath().empty()) return 0;
    std::string head =
        FormatText("%10s, %5s, %10s, %10s, %10s, %10s", "Type", "Step", "dpi", "api", "dy", "ay");
    const char* const kind = r.kind == 0 ? "A" : r.kind == 1 ? "B" : "C";
    std::string row =
        FormatText("%10s, %5d, %10g, %10g, %10g, %10g", kind, r.step, r.dpi, r.api, r.dy, r.ay);
    const auto add = [&](const char* label, double value) {
        head += FormatText(", %10s", label);
        row += FormatText(", %10g", value);
    };
    if (r.kind == 2) add("Myu", r.mu);
    add("T_eff", r.Teff);
    add("Beta_eff", r.betaEff);
    if (r.kind >= 1) add("M", r.M);
    if (r.kind == 2) add("Tsec", r.Tsec);
    return CLogFile(m_owner.ModelPath() + "_Pushover.txt").Write(head + "\n" + row + "\n\n");
}

T_PERFPT_TRIAL& CPushOverCalcPerfPtBase::StartTrial(int trial, double dpi, double api)
{
    T_PERFPT_TRIAL& row = m_trace.emplace_back();
    row.trial = trial;
    row.dpi = dpi;
    row.api = api;
    m_last = {};
    return row;
}

int CPushOverCalcPerfPtBase::RepeatsAfter(double dpi, double api) const
{
    for (std::size_t i = m_trace.size(); i-- > 0;) {
        if (m_trace[i].dpi == dpi && m_trace[i].api == api)
            return static_cast<int>(m_trace.size() - i);
    }
    return 0;
}

int CPushOverCalcPerfPtBase::End(PUSH_OUTCOME code, int result, int count)
{
    m_outcome = {code, count};
    return result;
}

double CPushOverCalcPerfPtBase::PeriodOf(double Sd, double Sa) const
{
    return 2.0 * m_pi * std::sqrt(Sd / (Sa * m_owner.GetGravity(1)));
}
