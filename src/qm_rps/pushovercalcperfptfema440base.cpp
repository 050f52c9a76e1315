#include "qm_rps/pushovercalcperfptfema440base.h"

#include "qm_rps/pushover/releaseassert.h"

#include <cmath>

int CPushOverCalcPerfPtFEMA440Base::FindTrialPointOnWorkingSpectrum(double D, double A,
                                                                    bool withCapacity, double& Dc,
                                                                    double& Ac, double& Ds,
                                                                    double& As)
{
    double d = 0.0, a = 0.0;
    m_outcome = {PUSH_OUTCOME::NoTrialPoint, 0};
    if (!m_working.OnRadialLine(D, A, d, a)) return 0;
    m_outcome = {PUSH_OUTCOME::TrialBeyond, 0};
    if (withCapacity && !GetCapacityPointAtDisplacement2(d, a, Dc, Ac)) return 0;
    Ds = d;
    As = a;
    return 1;
}

int CPushOverCalcPerfPtFEMA440Base::GetCapacityPointAtDisplacement(double d, double& D, double& A)
{
    D = A = 0.0;
    return GetCapacityPointAtDisplacement2(d, 0.0, D, A);
}

int CPushOverCalcPerfPtFEMA440Base::GetCapacityPointAtDisplacement2(double d, double, double& D,
                                                                    double& A)
{
    const auto point = CCurveCrossing::Vertical(d, Capacity().View());
    if (!point) return 0;
    D = point->x;
    A = point->y;
    return 1;
}

void CPushOverCalcPerfPtFEMA440Base::Assert(int line) const
{
    ReleaseAssert(m_source, line);
}

void CPushOverCalcPerfPtFEMA440Base::WarnAnyType(double T0) const
{
    constexpr int kAnyType = 3;
    if (m_owner.Damping().behaviorType == kAnyType && (T0 < 0.2 || T0 > 2.0))
        m_owner.AddWarning("IDS_RPS_FEMA440_WARNING_ANYTYPE_TO");
}

int CPushOverCalcPerfPtFEMA440Base::Fail(PUSH_OUTCOME code)
{
    KeepTrial();
    WriteIterationLog(m_log);
    return End(code, kPerfPtNone);
}

void CPushOverCalcPerfPtFEMA440Base::KeepTrial()
{
    if (m_trace.empty()) return;
    T_PERFPT_TRIAL& row = m_trace.back();
    const auto keep = [](std::optional<double>& to, double value) {
        if (value != 0.0) to = value;
    };
    keep(row.dy, m_log.dy);
    keep(row.ay, m_log.ay);
    keep(row.mu, m_log.mu);
    keep(row.Teff, m_log.Teff);
    keep(row.betaEff, m_log.betaEff);
    keep(row.M, m_log.M);
    row.row = m_last.row;
}

int CPushOverCalcPerfPtFEMA440Base::CalcSecantDamping(double Dp, double Ap, int assertLine,
                                                      double& betaPct)
{
    m_working.Restore();
    double Dc = 0.0, Ac = 0.0, Ds = 0.0, As = 0.0;
    if (!FindTrialPointOnWorkingSpectrum(Dp, Ap, false, Dc, Ac, Ds, As)) {
        Assert(assertLine);
        return 0;
    }
    const double B = Ds / Dp;
    const double beta = std::exp(5.6 - 4.0 / B);
    if (!std::isfinite(beta) || !m_working.ReduceByB(B)) return 0;
    m_owner.SetPerfPointSpectrumData(m_working.Curve().Sa, m_working.Curve().Sd);
    betaPct = beta;
    return 1;
}
