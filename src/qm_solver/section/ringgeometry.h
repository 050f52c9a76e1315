// Outlines of corners and arcs: area, crossings, what lies within.
#pragma once

#include "qm_solver/sectionmodel.h"

namespace solver {

/// Circle through a bulging way from a to b.
struct T_BULGE {
    double y = 0.0, z = 0.0, radius = 0.0; // centre
    double from = 0.0, sweep = 0.0;        // angle of a (0 along +y); turning left is positive
};
T_BULGE BulgeOf(const T_CORNER& a, const T_CORNER& b);

/// Positive where the ring turns left.
double AreaOf(const T_RING& ring);
/// Largest coordinate difference.
double ExtentOf(const T_RING& ring);
bool Within(const T_RING& ring, double y, double z);
/// Whether ways of the rings cross or touch but at a common corner of neighbours. The same ring
/// twice: whether it meets itself. Arcs count as chords of at most 15 degrees.
bool Crossing(const T_RING& a, const T_RING& b, bool same);

} // namespace solver
