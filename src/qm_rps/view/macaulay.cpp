#include "qm_rps/view/macaulay.h"

#include <algorithm>

namespace {

/// x^n / n!; 0 where n < 0: a constant that was differentiated.
double Power(double x, int n)
{
    if (n < 0) return 0.0;
    double value = 1.0;
    for (int i = 1; i <= n; ++i)
        value *= x / i;
    return value;
}

} // namespace

void CMacaulay::AddBase(int power, double factor)
{
    if (factor == 0.0) return;
    const auto at = static_cast<std::size_t>(power);
    if (m_base.size() <= at) m_base.resize(at + 1, 0.0);
    m_base[at] += factor;
}

void CMacaulay::Add(int power, double at, double factor)
{
    if (factor != 0.0) m_terms.push_back({power, at, factor});
}

void CMacaulay::AddIntegral(const CMacaulay& other, double factor)
{
    for (std::size_t n = 0; n < other.m_base.size(); ++n)
        AddBase(static_cast<int>(n) + 1, factor * other.m_base[n]);
    for (const T_TERM& term : other.m_terms)
        Add(term.power + 1, term.at, factor * term.factor);
}

double CMacaulay::Integral(int order, double x, bool behind) const
{
    double sum = 0.0;
    for (std::size_t n = 0; n < m_base.size(); ++n)
        sum += m_base[n] * Power(x, static_cast<int>(n) + order);
    for (const T_TERM& term : m_terms)
        if (x > term.at || (behind && x == term.at))
            sum += term.factor * Power(x - term.at, term.power + order);
    return sum;
}

void CMacaulay::Places(std::vector<double>& out) const
{
    for (const T_TERM& term : m_terms)
        out.push_back(term.at);
}

void CMacaulay::AddScaled(const CMacaulay& other, double factor)
{
    for (std::size_t n = 0; n < other.m_base.size(); ++n)
        AddBase(static_cast<int>(n), factor * other.m_base[n]);
    for (const T_TERM& term : other.m_terms)
        Add(term.power, term.at, factor * term.factor);
}

int CMacaulay::Degree() const
{
    int degree = std::max(static_cast<int>(m_base.size()) - 1, 0);
    for (const T_TERM& term : m_terms)
        degree = std::max(degree, term.power);
    return degree;
}
