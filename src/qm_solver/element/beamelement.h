// A straight beam with shear deformation, end releases and rigid end offsets.
#pragma once

#include "qm_solver/element/spanload.h"

#include <span>
#include <vector>

namespace solver {

/// Local axes of a beam from its end points: x from I to J, z the part of the reference vector
/// normal to x, y = z cross x. A zero reference: global Z, or global X for a vertical beam.
/// False if the beam has no length or the reference is parallel to it.
[[nodiscard]] bool BeamAxes(const T_FRAME& frame, const T_ELEMENT& element, T_AXES& axes,
                            double& length);

/// Timoshenko beam, 12 degrees of freedom: translations and rotations of I, then of J. Exact for
/// loads at its ends and, with AddFixedEndForces, on its span. Przemieniecki, Theory of Matrix
/// Structural Analysis (1968) section 5.6. Releases are condensed one after the other.
/// With a tension N, equal along the beam: second order by the consistent geometric stiffness
/// N times the integral of products of slopes (Przemieniecki chapter 15), of bending and not of
/// torsion or rigid offsets, over the same deflected shapes as for loads on the span, so that
/// forces balance in the deflected position at both ends. Displacements are then those from the
/// straight beam.
/// Units: those of the frame. State: fixed.
class CBeamElement {
public:
    /// Of a checked frame.
    CBeamElement(const T_FRAME& frame, const T_ELEMENT& element, double tension = 0.0);

    /// A local displacement (0 to 11) that moves freely inside the element because of its
    /// releases (a beam released at both ends in torsion turns about its axis), or that its
    /// compression makes unstable; -1 none.
    int Loose() const { return m_loose; }

    /// Over the displacements of the nodes, global axes.
    void Stiffness(T_MATRIX12& global) const { ToNodes(m_local, global); }
    /// Over the displacements of the ends, local axes, releases condensed.
    const T_MATRIX12& Local() const { return m_local; }
    /// A stiffness over the displacements of the ends, local axes, taken to those of the nodes.
    void ToNodes(const T_MATRIX12& local, T_MATRIX12& global) const;
    /// Displacements of the ends, local axes, less the motion of a rigid body: what strains the
    /// beam. 0 where that takes all.
    T_VEC12 Strains(const T_VEC12& displacement) const
    {
        return Deformation(displacement, {}).strain;
    }
    /// The same of displacements of the ends, local axes.
    T_VEC12 StrainsOfEnds(const T_VEC12& ends) const;
    /// Displacements of the nodes taken to the ends of the flexible length, local axes, released or
    /// not.
    T_VEC12 EndDisplacements(const T_VEC12& displacement) const;
    double Length() const { return m_shape.length; }

    /// Twice the strain energy under displacements of the nodes, global axes. From the deformations
    /// of the beam, so that a rigid-body motion leaves only the square of its rounding, and what a
    /// tension does when the chord turns.
    double StrainEnergy(const T_VEC12& displacement) const;

    /// Forces of the ends on the beam, local axes, under displacements of the nodes plus the rest
    /// that doubles round away (global axes), from the deformations: exact where EndForces loses
    /// what the rigid-body motion outweighs them by.
    T_VEC12 DeformationForces(const T_VEC12& displacement, const T_VEC12& rest) const;
    /// Forces of the ends on the beam, local axes, when all node displacements are 0, the
    /// releases having given way. axial: the tension that a clamped beam would have from initial
    /// strains.
    T_VEC12 FixedEndForces(std::span<const T_SPAN_LOAD> loads, double axial) const;
    /// Forces of the ends on the beam, local axes: stiffness times displacements of the nodes
    /// (global axes) plus the fixed-end forces.
    T_VEC12 EndForces(const T_VEC12& displacement, const T_VEC12& fixedEnd) const;
    /// The same forces as forces and moments at the nodes, global axes.
    T_VEC12 AtNodes(const T_VEC12& endForces) const;
    /// Internal forces of the cut at fraction s, seen from the I side. A point load exactly at the
    /// cut lies behind it; at s = 1 all loads lie before it, so that the forces are those of the J
    /// end.
    T_VEC6 InternalForces(const T_VEC12& endForces, std::span<const T_SPAN_LOAD> loads,
                          double s) const;
    /// Displacements of the ends of the flexible length, local axes; those of releases as the beam
    /// itself moves there.
    T_VEC12 MovedEnds(const T_VEC12& displacement, std::span<const T_SPAN_LOAD> loads) const;
    /// What the tension adds to the moments of InternalForces: N times the deflection of the cut
    /// from the I end by the ends' displacements (what loads deflect between clamped ends is left
    /// out, as it is from the stiffness).
    void AddDeflectionMoments(const T_VEC12& movedEnds, double s, T_VEC6& internal) const;

private:
    struct T_RELEASE {
        std::size_t at;
        T_VEC12 gain; // column of the stiffness over its diagonal when `at` was released
        double pivot;
    };
    /// Ends' displacements less the rigid-body motion of I's translation, the chord's rotation and
    /// I's twist: local axes, 0 where that takes all.
    struct T_DEFORMATION {
        T_VEC12 strain{};
        double chordY = 0.0, chordZ = 0.0; // rotation of the chord
    };
    T_DEFORMATION Deformation(const T_VEC12& displacement, const T_VEC12& rest) const;
    void MakeLocalStiffness(const T_MATERIAL& material, const T_SECTION& section);
    void Release(std::size_t at, double diagonal);
    void MoveToNodes(T_MATRIX12& global, std::size_t first, const T_VEC3& offset) const;

    T_AXES m_axes{};
    T_BEAM_SHAPE m_shape;
    T_VEC3 m_offsetI{}, m_offsetJ{};
    bool m_hasOffset = false;
    double m_tension = 0.0;
    int m_loose = -1;
    T_MATRIX12 m_local{}; // condensed
    std::vector<T_RELEASE> m_releases;
};

} // namespace solver
