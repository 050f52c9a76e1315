// Sums of singularity functions: what varies along a member, and its integrals.
#pragma once

#include <vector>

/// A polynomial plus terms c <x - a>^n / n!, each 0 before its place a (Macaulay's brackets). So
/// steps, kinks and parabolas of forces along a member integrate exactly, term by term.
/// State: the terms.
class CMacaulay {
public:
    /// c x^n / n!, everywhere.
    void AddBase(int power, double factor);
    /// c <x - a>^n / n!.
    void Add(int power, double at, double factor);
    /// factor times the integral of another sum from x = 0.
    void AddIntegral(const CMacaulay& other, double factor);
    /// factor times another sum.
    void AddScaled(const CMacaulay& other, double factor);
    /// The value at x; where it leaps there, that before the leap, or `behind` it.
    [[nodiscard]] double At(double x, bool behind = false) const { return Integral(0, x, behind); }
    /// The integral of that order, which is 0 at x = 0 with those of the orders below. Order -1:
    /// the slope, -2: that of the slope, without what a leap would add.
    [[nodiscard]] double Integral(int order, double x, bool behind = false) const;
    /// Appends the places of its terms.
    void Places(std::vector<double>& out) const;
    /// Highest power; 0 of none.
    [[nodiscard]] int Degree() const;

private:
    struct T_TERM {
        int power = 0;
        double at = 0.0, factor = 0.0;
    };
    std::vector<double> m_base; // by power
    std::vector<T_TERM> m_terms;
};
