// Sums of two doubles, for differences that doubles round away.
#pragma once

#include <cmath>

namespace solver {

/// A number as hi + lo with |lo| at most half a unit in the last place of hi: about 32 digits.
/// Dekker, A floating-point technique for extending the available precision (1971); the product
/// by a fused multiply-add.
class CFine {
public:
    CFine(double value = 0.0) : m_hi(value) {}

    double Value() const { return m_hi; }
    /// What Value leaves.
    double Rest() const { return m_lo; }

    friend CFine operator-(CFine a) { return CFine(-a.m_hi, -a.m_lo); }
    friend CFine operator+(CFine a, CFine b)
    {
        const double sum = a.m_hi + b.m_hi, part = sum - a.m_hi;
        return Settled(sum, (a.m_hi - (sum - part)) + (b.m_hi - part) + (a.m_lo + b.m_lo));
    }
    friend CFine operator-(CFine a, CFine b) { return a + -b; }
    friend CFine operator*(CFine a, double b)
    {
        const double product = a.m_hi * b;
        return Settled(product, std::fma(a.m_hi, b, -product) + a.m_lo * b);
    }
    friend CFine operator/(CFine a, double b)
    {
        const double first = a.m_hi / b;
        const CFine left = a - CFine(first) * b;
        return Settled(first, left.Value() / b);
    }

private:
    CFine(double hi, double lo) : m_hi(hi), m_lo(lo) {}
    static CFine Settled(double large, double small)
    {
        const double sum = large + small;
        return CFine(sum, small - (sum - large));
    }
    double m_hi, m_lo = 0.0;
};

} // namespace solver
