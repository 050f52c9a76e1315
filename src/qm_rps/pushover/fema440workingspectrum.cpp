#include "qm_rps/pushover/fema440workingspectrum.h"

#include <cmath>

int CFema440WorkingSpectrum::ReduceByB(double B)
{
    if (B == 0.0 || !std::isfinite(B)) return 0;
    const std::vector<double>& Sa5 = m_owner.Demand().Sa;
    m_curve.Sa.resize(Sa5.size());
    for (std::size_t i = 0; i < Sa5.size(); ++i)
        m_curve.Sa[i] = Sa5[i] / B;
    m_owner.ToAdrs(m_owner.DemandPeriods(), m_curve.Sa, m_curve.Sd);
    m_isReduced = true;
    return 1;
}

void CFema440WorkingSpectrum::Modify(double M)
{
    for (double& a : m_curve.Sa)
        a *= M;
}

int CFema440WorkingSpectrum::OnRadialLine(double D, double A, double& Ds, double& As) const
{
    const auto point = CCurveCrossing::HalfLine({D, A}, Curve().View());
    if (!point) return 0;
    Ds = point->x;
    As = point->y;
    return 1;
}

int CalcFema440B(double betaPct, double& B)
{
    if (!(betaPct > 0.0)) return 0;
    const double value = 4.0 / (5.6 - std::log(betaPct));
    if (!std::isfinite(value)) return 0;
    B = value;
    return 1;
}

int CalcFema440M(double Teff, double T0, double alpha, double mu, double& M)
{
    if (mu == 0.0) return 0;
    const double value = (Teff / T0) * (Teff / T0) * (alpha * (mu - 1.0) + 1.0) / mu;
    if (!std::isfinite(value)) return 0;
    M = value;
    return 1;
}
