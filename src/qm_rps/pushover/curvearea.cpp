#include "qm_rps/pushover/curvearea.h"

#include <algorithm>

CCurveArea::CCurveArea(const T_ADRS_VIEW& c)
{
    double sum = 0.0;
    for (std::size_t i = 0; i < c.Size(); ++i) {
        if (i > 0) sum += (c.Sa[i - 1] + c.Sa[i]) / 2.0 * (c.Sd[i] - c.Sd[i - 1]);
        m_sums.push_back(sum);
        m_largest.push_back(i > 0 ? std::max(m_largest.back(), c.Sd[i]) : c.Sd[i]);
    }
}

double CCurveArea::To(const T_ADRS_VIEW& c, double d) const
{
    if (c.Size() < 2) return 0.0;
    const auto beyond = static_cast<std::size_t>(std::ranges::upper_bound(m_largest, d) -
                                                 m_largest.begin()); // first point beyond d
    if (beyond == c.Size()) return m_sums.back();
    double sum = 0.0;
    if (beyond > 0) {
        const std::size_t i = beyond - 1;
        const double w = (d - c.Sd[i]) / (c.Sd[beyond] - c.Sd[i]);
        const double Sad = c.Sa[i] + w * (c.Sa[beyond] - c.Sa[i]);
        sum = m_sums[i] + (Sad + c.Sa[i]) / 2.0 * (d - c.Sd[i]);
    }
    if (beyond + 1 < c.Size() && d >= c.Sd[beyond + 1]) // the segment that starts beyond turns back
        sum += (c.Sa[beyond] + c.Sa[beyond + 1]) / 2.0 * (c.Sd[beyond + 1] - c.Sd[beyond]);
    return sum;
}
