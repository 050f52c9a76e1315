#include "qm_rps/pushover/perfptoperations.h"

#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/releaseassert.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

// The log names the calculators, whose operations these are.
constexpr const char* kSource = "src/qm_rps/pushovercalcperfptbase";
constexpr double kDampingRounding = 1e-9; // relative
constexpr double kMaxBeta0 = 45.0;        // hysteretic damping is not taken above this, per cent

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

} // namespace

int CPerfPtOperations::FindFirstSlopeChange(double& D, double& A) const
{
    constexpr double kZero = 1e-26;
    constexpr double kChange = 0.1;
    const auto& [Sd, Sa] = Capacity();
    const auto ratio = [&](std::size_t i) {
        return (Sa[i + 1] / Sa[i] - 1.0) / (Sd[i + 1] / Sd[i] - 1.0);
    };
    for (std::size_t i = 0; i + 2 < Sd.size(); ++i) {
        if (std::fabs(Sd[i] * Sa[i]) < kZero || std::fabs(Sd[i + 1] * Sa[i + 1]) < kZero) {
            ReleaseAssert(kSource, __LINE__);
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

int CPerfPtOperations::CalcCapacityArea(double d, double& area) const
{
    const double sum = m_record.CapacityArea().To(Capacity().View(), d);
    if (!std::isfinite(sum)) return 0;
    area = sum;
    return 1;
}

int CPerfPtOperations::BilinearizeAt(double dpi, double api, double& dy, double& ay) const
{
    constexpr double kZero = 1e-13;
    constexpr double kOnLine = 0.1;      // ratio this close to 1: on the initial stiffness
    constexpr double kSamePoint = 1e-12; // relative
    const double Sd1 = Capacity().Sd[1], Sa1 = Capacity().Sa[1];
    for (const double v : {dpi, api, Sa1, Sd1}) {
        if (std::fabs(v) < kZero) {
            ReleaseAssert(kSource, __LINE__);
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

int CPerfPtOperations::GetCapacityAccelAt(double d, double& Sa) const
{
    const T_ADRS_CURVE& c = Capacity();
    for (std::size_t i = 0; i + 1 < c.Sd.size(); ++i) {
        if (!(c.Sd[i] <= d && d < c.Sd[i + 1])) continue;
        Sa = c.Sa[i] + (c.Sa[i + 1] - c.Sa[i]) * (d - c.Sd[i]) / (c.Sd[i + 1] - c.Sd[i]);
        return 1;
    }
    return 0;
}

int CPerfPtOperations::CalcReduction(double dy, double ay, double dpi, double api,
                                     T_PERFPT_REDUCTION& out) const
{
    double fraction = (ay * dpi - dy * api) / (api * dpi);
    double beta0 = kFullLoopPct * fraction;
    if (beta0 > kMaxBeta0) {
        beta0 = kMaxBeta0;
        fraction = kMaxBeta0 / kFullLoopPct;
    }
    const T_DAMP_PARAM& damping = m_record.Damping();
    out.kappa = GetDampingModificationFactor(damping.behaviorType, beta0, fraction);
    const double beta = out.kappa * beta0 + damping.elasticPct;
    if (beta < 0.0) {
        ReleaseAssert(kSource, __LINE__);
        return 0;
    }
    if (!CalcSpectralReduction(beta, out.factors)) return 0;
    out.betaEff = beta;
    return 1;
}

double CPerfPtOperations::GetDampingModificationFactor(int type, double& beta0,
                                                       double fraction) const
{
    for (const T_KAPPA_ROW& row : kKappa) {
        if (row.type == type) return beta0 <= row.kneePct ? row.flat : row.k0 - row.k1 * fraction;
    }
    if (type != 3) return 0.0;
    const T_DAMP_PARAM& user = m_record.Damping();
    if (beta0 <= user.beta1) return user.kappa1;
    if (beta0 > user.beta2) {
        beta0 = user.beta2; // the damping itself is limited too
        return user.kappa2;
    }
    return user.kappa1 +
           (user.kappa2 - user.kappa1) * (beta0 - user.beta1) / (user.beta2 - user.beta1);
}

bool CPerfPtOperations::IsElasticDamping(double beta) const
{
    // A beta that is the elastic damping but for its rounding is not below it.
    const double elastic = m_record.Damping().elasticPct;
    return elastic - beta > kDampingRounding * elastic || std::fabs(beta - 5.0) < 0.001;
}

int CPerfPtOperations::CoefficientRow(double alpha) const
{
    const double key = m_record.AlphaInPercent() ? 100.0 * alpha : alpha;
    return Fema440RowIndex(m_record.Damping().behaviorType, key);
}

double CPerfPtOperations::PeriodOf(double Sd, double Sa) const
{
    return SecantPeriod(Sd, Sa, m_record.GetGravity(1));
}
