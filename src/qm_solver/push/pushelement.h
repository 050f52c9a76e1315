// An element with the places of its hinges: how their plastic deformations and springs act on it.
#pragma once

#include "qm_solver/element/beamelement.h"
#include "qm_solver/element/elementstiffness.h"
#include "qm_solver/frame/caseloads.h"

#include <optional>
#include <span>
#include <vector>

namespace solver {

/// A component of the internal forces at a place of an element that is watched or flows.
struct T_PLACED_COMPONENT {
    double at = 0.0; // fraction of the flexible length
    int component = 0;
    double spring = 0.0; // in series with the element; 0: none
};

/// What loads do to an element whose nodes stand still and whose hinges do not flow.
struct T_ELEMENT_LOADS {
    T_VEC12 ends{};            // forces at its nodes, global axes; of beams: ends, local axes
    T_VEC12 nodes{};           // forces at its nodes, global axes
    double tension = 0.0;      // mean axial force
    bool acts = false;         // some of it is not 0
    std::vector<double> force; // by component
    std::vector<double> moved; // by component: what settlements of its nodes add; may be empty
};

/// Elastic stiffness with the springs of the hinges in series, over the displacements of the nodes;
/// influence of plastic deformations; forces. A plastic deformation is the jump of displacement or
/// rotation across the hinge, the side towards J less that towards I, so that force times
/// deformation is its work. Springs are condensed: with C the motion of the ends that stands for
/// unit jumps, k' = k - k C (K0 + C' k C)^-1 C' k. P-Delta is the couple of the axial force and the
/// drift of the chord, N / L across, which no plastic deformation changes, of its rigid ends, N
/// times the turn of each, and inside the element of the axial force and the kinks of its hinges:
/// they lie off the chord.
class CPushElement {
public:
    CPushElement(const T_FRAME& frame, std::size_t element,
                 std::vector<T_PLACED_COMPONENT> components);

    std::size_t Size() const { return m_components.size(); }
    /// Over the displacements of the nodes, global axes; tension: of P-Delta, 0 none.
    void Stiffness(double tension, T_MATRIX12& global) const;
    /// Loads at the nodes by a unit plastic deformation of component c; also its force by unit
    /// displacements of the nodes.
    const T_VEC12& Influence(std::size_t c) const { return m_influence[c]; }
    /// Force of component c that a unit plastic deformation of component d takes away while the
    /// nodes stand still.
    double Own(std::size_t c, std::size_t d) const { return m_own[c * Size() + d]; }
    /// How far off the chord component c lies by a unit kink at component d; 0 of other components
    /// and at the ends. Times the tension it is what P-Delta adds to Own.
    double Kink(std::size_t c, std::size_t d) const;

    /// axial: the tension that it would have between clamped ends from initial strains.
    T_ELEMENT_LOADS Loads(std::span<const T_SPAN_LOAD> loads, double axial) const;
    /// What loads do at the nodes, global axes.
    T_VEC12 LoadsAtNodes(const T_VEC12& loads) const;
    /// Forces of the element on its nodes with the opposite sign (what the nodes need), global
    /// axes, under displacements of the nodes and plastic deformations of its components; with the
    /// couple of `coupled`, without its loads. tension: mean axial force; own: forces of the
    /// components, Size() of them or none.
    T_VEC12 AtNodes(const T_VEC12& displacement, std::span<const double> plastic, double coupled,
                    double& tension, std::span<double> own = {}) const;
    /// Internal forces at fraction s, by the same.
    T_VEC6 Inside(const T_VEC12& displacement, std::span<const double> plastic, double coupled,
                  const T_VEC12& loads, std::span<const T_SPAN_LOAD> span, double s) const;

    /// Mean axial force of loads between clamped ends, tension positive; 0 of links and springs.
    double Tension(const T_VEC12& loads) const;

private:
    void MeasureArms(const T_FRAME& frame);
    T_VEC12 Motion(const T_PLACED_COMPONENT& component) const;
    void CondenseSprings();
    void MakeInfluence();
    void MakeBasic();
    double AxialStiffness() const;
    double OffChord(double s, std::size_t d) const;
    T_VEC12 Ends(const T_VEC12& displacement, std::span<const double> plastic,
                 const T_VEC12& loads) const;
    T_VEC12 Across(const T_VEC12& displacement, double tension) const;

    T_ELEMENT m_element;
    std::vector<T_PLACED_COMPONENT> m_components;
    std::optional<CBeamElement> m_beam;
    T_VEC3 m_direction{};           // of trusses and beams
    std::array<double, 2> m_arms{}; // of beams: rigid ends at I and J, along the direction
    double m_length = 1.0;
    T_MATRIX12 m_stiffness{};      // of beams: local, over the ends; of others: global
    std::vector<T_VEC12> m_motion; // of the ends by a unit jump
    std::vector<T_VEC12> m_spring; // by component: gain of its spring, empty without springs
    std::vector<T_VEC12> m_influence;
    std::vector<double> m_own;
    // Strains (up to 6) by displacements of the nodes, forces by strains, strains by unit jumps.
    using T_STRAIN = std::array<double, 6>;
    std::size_t m_strains = 0;
    std::array<T_VEC12, 6> m_strainOf{};
    std::array<T_STRAIN, 6> m_basic{};
    std::vector<T_STRAIN> m_jump;
};

} // namespace solver
