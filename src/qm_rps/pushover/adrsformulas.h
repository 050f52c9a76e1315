// Formulas of the ADRS plane: Sd in the model's length, Sa in g, gravity in length/s2, T in s.
#pragma once

#include <cmath>
#include <numbers>

/// Full rectangular hysteresis loop as an equivalent damping, per cent: 200 / pi as ATC-40 prints
/// it.
inline constexpr double kFullLoopPct = 63.7;

/// Forces, or displacements, of one curve that differ by less than this fraction of its largest one
/// are equal: the rest is rounding of a push or of a change of units, and no step is chosen by it.
inline constexpr double kSameOnCurve = 1e-9;

/// Period of the radial line through a point: T = 2 pi sqrt(Sd / (Sa g)).
inline double SecantPeriod(double Sd, double Sa, double gravity)
{
    return 2.0 * std::numbers::pi * std::sqrt(Sd / (Sa * gravity));
}

/// Slope Sa / Sd of the radial line of a period: 4 pi2 / (T2 g).
inline double RadialSlope(double T, double gravity)
{
    return 4.0 * std::numbers::pi * std::numbers::pi / (T * T * gravity);
}

/// Sd of a spectral ordinate: T2 Sa g / (4 pi2).
inline double SpectralDisplacement(double T, double Sa, double gravity)
{
    return T * T * Sa * (gravity / (4.0 * std::numbers::pi * std::numbers::pi));
}

/// Base shear of a spectral acceleration: alpha Sa M g. ATC-40 (1996) 8.2.2.1.
inline double BaseShear(double Sa, double alpha, double mass, double gravity)
{
    return std::fabs(Sa * mass * gravity * alpha);
}

/// Post-yield stiffness over initial stiffness of the bilinear curve through (dy, ay) and
/// (dpi, api); 0 where api is ay. FEMA 440 (2005) 6.2; may be no real value.
inline double PostYieldRatio(double dy, double ay, double dpi, double api)
{
    constexpr double kSameAccel = 1e-12; // g
    return std::fabs(api - ay) > kSameAccel ? ((api - ay) / (dpi - dy)) / (ay / dy) : 0.0;
}
