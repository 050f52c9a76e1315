// What the section calculator gives. Signs and directions: sectionmodel.h.
#pragma once

#include "qm_solver/sectionmodel.h"

#include <array>
#include <tuple>

namespace solver {

/// Strain = axial + overZ (z - momentZ) + overY (y - momentY).
struct T_STRAIN_PLANE {
    double axial = 0.0, overZ = 0.0, overY = 0.0; // strain; strain per length
};
inline auto Numbers(const T_STRAIN_PLANE& p)
{
    return std::tie(p.axial, p.overZ, p.overY);
}

/// The fibre whose strain is at a mark.
enum class FIBRE_KIND { None, Concrete, Steel, Bar };
/// A place of the section whose strain decides.
struct T_FIBRE {
    FIBRE_KIND kind = FIBRE_KIND::None; // concrete, steel of a shape, bar; none
    std::size_t index = 0;              // of the region or the bar
    bool tension = false;               // at its mark in tension; else in compression
    bool operator==(const T_FIBRE&) const = default;
};

/// Forces for a plane of strains, about the point of moments.
struct T_SECTION_RESPONSE {
    double axial = 0.0, My = 0.0, Mz = 0.0; // force, compression positive; moments
    /// Derivatives of axial, My, Mz by axial, overZ, overY of the plane; symmetric. Fibres at a
    /// jump of their law (concrete that spalls, the end of a block) are not in them.
    std::array<std::array<double, 3>, 3> tangent{};
};
inline auto Numbers(const T_SECTION_RESPONSE& r)
{
    return std::tie(r.axial, r.My, r.Mz, r.tangent);
}

/// A state of capacity. Where the forces jump while the neutral axis moves (concrete around a bar
/// that spalls), the point lies on the straight line over the jump; plane and fibre are those of
/// one side. As the edge of a block passes a bar, the force falls by its concrete: three states
/// have one axial force there, and any of them is given.
struct T_CAPACITY {
    double axial = 0.0, My = 0.0, Mz = 0.0; // force, compression positive; moments
    T_STRAIN_PLANE plane; // of a plastic section: the sides of the neutral axis alone
    T_FIBRE governs;      // the fibre at its limit; None where no strain is limited
};
inline auto Numbers(const T_CAPACITY& c)
{
    return std::tie(c.axial, c.My, c.Mz, c.plane);
}

/// Capacities for one direction, from pure compression to pure tension.
struct T_AXIAL_CURVE {
    std::vector<T_CAPACITY> points; // in that order
    /// Places of the extremes in `points`: the largest moment in the direction, bending without
    /// axial force, and the bar furthest in tension at its yield strain; -1: there is none.
    long largest = -1, bending = -1, balanced = -1;
};

/// How a moment-curvature ends.
enum class CURVATURE_END {
    StrainLimit,   // a fibre reached its limit
    MomentLoss,    // the moment fell to 80 % of the largest
    NoEquilibrium, // beyond it the axial force is no longer carried
    MaxCurvature,  // as asked
};

/// A state of bending at a given axial force.
struct T_CURVATURE_POINT {
    double curvature = 0.0, moment = 0.0; // in the direction that was asked for
    double My = 0.0, Mz = 0.0;            // components of the moment
    T_STRAIN_PLANE plane;                 // that they follow from
};
inline auto Numbers(const T_CURVATURE_POINT& p)
{
    return std::tie(p.curvature, p.moment, p.My, p.Mz, p.plane);
}

/// Bending in one direction at a given axial force, up to its end.
struct T_MOMENT_CURVATURE {
    std::vector<T_CURVATURE_POINT> points; // from curvature 0 to the ultimate
    std::size_t yield = 0;                 // place in `points`; the last where nothing yields
    T_FIBRE yields; // first steel at its yield strain or concrete at peakStrain; None: nothing
    CURVATURE_END end = CURVATURE_END::StrainLimit; // why it goes no further
    T_FIBRE governs;                                // at its limit where the end is StrainLimit
    /// Straight from the first point through yield to the corner, then level up to the ultimate
    /// curvature; beyond yield it has the area of the curve of `points`. False where nothing lies
    /// beyond yield, or the level would lie above the largest moment.
    bool idealised = false;
    double idealCurvature = 0.0, idealMoment = 0.0; // the corner
};
inline auto Numbers(const T_MOMENT_CURVATURE& m)
{
    return std::tie(m.points, m.idealCurvature, m.idealMoment);
}

/// Why a section is refused; behind each, what T_SECTION_ERROR then names.
enum class SECTION_FAULT {
    None,
    NoRegion,
    NotFinite,       // a number of law, region and ring, bar, or of the request
    NoSuchLaw,       // region or bar
    LawStrength,     // law: strength or modulus not above 0
    LawStrains,      // law: strains, exponent, hardening or depth of block out of their range
    WrongLaw,        // bar: not of steel
    RingArea,        // region, ring: without area
    RingCrossed,     // region, ring: meets itself or another ring of the region
    HoleOutside,     // region, ring: not within its outline
    RegionsOverlap,  // region, otherRegion: seen from their borders
    BarArea,         // bar: not above 0
    BarOutside,      // bar: in no region of concrete
    BarsOverlap,     // bar, otherBar
    ConcretePlastic, // region: full plasticity is for steel
    NoLimit,         // law: nothing ends its strains, so that there is no capacity
    BlockCurvature,  // law: a block gives no moment-curvature
    AxialBeyond,     // axialMin, axialMax: what can be carried
    NoSuchMoment,    // no capacity with this direction of the moment at this axial force
    PointsTooFew,    // of a curve or surface: at least kFewestPoints
    NotConverged,
};
/// A refusal and its place; places that the fault does not name are -1.
struct T_SECTION_ERROR {
    SECTION_FAULT fault = SECTION_FAULT::None; // None: nothing was refused
    long law = -1, region = -1, otherRegion = -1, ring = -1, bar = -1, otherBar = -1;
    double axialMin = 0.0, axialMax = 0.0; // of AxialBeyond, compression positive
};

} // namespace solver
