// What the section calculator takes: a cross-section as arrays. Any consistent units. Strains,
// stresses and axial forces are positive in compression. Indices count from 0.
//
// Axes y and z lie in the section; My = sum of stress z compresses +z, Mz = sum of stress y
// compresses +y. A direction is an angle in radians: 0 is +z, pi / 2 is +y. Bending in a direction
// compresses that side; the neutral axis is normal to it.
#pragma once

#include <cstddef>
#include <vector>

namespace solver {

/// Stress by strain, with the source of each law.
enum class STRESS_LAW {
    /// Concrete, EN 1992-1-1 3.1.7: strength (1 - (1 - strain / peakStrain)^exponent) up to
    /// peakStrain, then strength. No tension.
    ParabolaRectangle,
    /// Concrete, ACI 318-19 22.2.2.4: strength (0.85 f'c) over blockDepth (beta1) times the depth
    /// of the neutral axis. It hangs on the largest strain of the section, so that it gives
    /// capacities, no moment-curvature.
    Block,
    /// Concrete, confined or not, J. B. Mander et al. (1988): strength x r / (r - 1 + x^r) with x =
    /// strain / peakStrain, r = modulus / (modulus - strength / peakStrain). No tension.
    Mander,
    /// Elastic up to the strength, then linear with the modulus `hardening`, the same in tension.
    Steel,
};

/// A law with its numbers; those that its kind does not name are not read.
struct T_STRESS_LAW {
    STRESS_LAW kind = STRESS_LAW::ParabolaRectangle; // which of the members below are read
    double strength = 0.0;                           // stress, above 0
    double peakStrain = 0.0;  // parabola-rectangle, Mander: where the strength is reached
    double limitStrain = 0.0; // where concrete crushes; of steel in either sign, 0: no limit
    double exponent = 2.0;    // parabola-rectangle, at least 1
    double blockDepth = 0.0;  // block: beta1
    double modulus = 0.0;     // Mander, steel
    double hardening = 0.0;   // steel
    /// Parabola-rectangle, Mander: beyond limitStrain the concrete is gone (a cover); it ends
    /// nothing. Otherwise a fibre at its limit ends the section.
    bool spalls = false;
};

/// A corner of an outline. The way to the next corner bulges by tan(a quarter of the angle of its
/// arc): 0 straight, 1 a half circle; positive turns left.
struct T_CORNER {
    double y = 0.0, z = 0.0; // place
    double bulge = 0.0;      // of the way to the next corner
};
using T_RING = std::vector<T_CORNER>; // closed: the last corner leads to the first

/// The outline first, then holes, each in either sense. Regions do not overlap: what lies within
/// another (a core in its cover, a steel shape in concrete) has a hole there.
struct T_SECTION_REGION {
    std::vector<T_RING> rings; // outline, holes
    std::size_t law = 0;       // place in T_SECTION_MODEL::laws
};

/// Lies in a region of concrete, whose stress is taken off over the area of the bar.
struct T_SECTION_BAR {
    double y = 0.0, z = 0.0, area = 0.0; // centre, area above 0
    std::size_t law = 0;                 // of steel
};

/// How far a section may be strained at its capacity.
enum class PIVOT_RULE {
    /// EN 1992-1-1 6.1: limit of the steel (pivot A), limitStrain of the concrete at its edge (B),
    /// and for a parabola-rectangle peakStrain at 1 - peakStrain / limitStrain of the depth of its
    /// region (C).
    Eurocode,
    CrushOnly, // ACI 318-19 22.2.2.1: limitStrain of the concrete at its edge; limits of the steel
};

/// A cross-section.
struct T_SECTION_MODEL {
    std::vector<T_STRESS_LAW> laws; // named by regions and bars
    std::vector<T_SECTION_REGION> regions;
    std::vector<T_SECTION_BAR> bars;
    bool lumped = false; // bars stand for groups: circles may overlap, but hold no other's centre
    double momentY = 0.0, momentZ = 0.0;     // the point (y, z) that moments refer to
    PIVOT_RULE pivot = PIVOT_RULE::Eurocode; // of capacities
    /// Full plasticity of steel without strains: the strength in compression on one side of a
    /// straight neutral axis, in tension on the other.
    bool plastic = false;
};

} // namespace solver
