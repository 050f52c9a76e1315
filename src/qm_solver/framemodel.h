// What the analysis engine takes: a frame as arrays. Indices count from 0 into these arrays; one
// consistent set of units (force, length, second) throughout. Degrees of freedom of a node are in
// the order X, Y, Z, RX, RY, RZ, global axes.
#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <vector>

namespace solver {

/// Global X, Y, Z.
using T_VEC3 = std::array<double, 3>;
/// X, Y, Z, RX, RY, RZ; lengths or forces, then radians or moments.
using T_VEC6 = std::array<double, 6>;
using T_DIRS6 = std::array<bool, 6>; // X, Y, Z, RX, RY, RZ

/// A node with its supports and its mass.
struct T_NODE {
    T_VEC3 xyz{};    // coordinates
    T_DIRS6 fixed{}; // restrained to the ground
    T_VEC3 mass{};   // lumped mass in X, Y, Z
};

/// A linear elastic material.
struct T_MATERIAL {
    double E = 0.0;       // modulus of elasticity
    double G = 0.0;       // of torsion and of shear deformation
    double density = 0.0; // mass per volume
    double alpha = 0.0;   // thermal expansion, 1 / degree
};

/// Local axes of a beam: x from I to J; z is the part of the reference vector normal to x;
/// y = z cross x. Iy bends about y (deflection along z), Iz about z. A shear area of 0 means that
/// there is no shear deformation in that direction.
struct T_SECTION {
    double A = 0.0, Asy = 0.0, Asz = 0.0; // area, shear areas along y and z
    double J = 0.0, Iy = 0.0, Iz = 0.0;   // torsion constant, second moments of area
    /// Area of the axial stiffness where that is not A, which mass and weight have.
    std::optional<double> stiffA{};

    /// Area of the axial stiffness.
    double StiffA() const { return stiffA.value_or(A); }
};

/// What an element resists with.
enum class ELEMENT_KIND {
    Beam,   // Timoshenko beam between two nodes
    Truss,  // axial force alone
    Link,   // six springs between two nodes, global axes
    Spring, // six springs from node i to the ground, global axes
};

/// An element; members that its kind does not name are not read.
struct T_ELEMENT {
    ELEMENT_KIND kind = ELEMENT_KIND::Beam; // which of the members below are read
    std::size_t i = 0, j = 0;               // nodes; a spring has node i alone
    std::size_t material = 0, section = 0;  // beam and truss
    T_VEC3 zAxis{};                 // reference vector; zero: global Z, global X if vertical
    T_DIRS6 releaseI{}, releaseJ{}; // local axes; true: no force is carried there
    T_VEC3 offsetI{}, offsetJ{};    // rigid, from the node to the end of the beam, global
    T_VEC6 stiffness{};             // link and spring
};

/// Nodes that move as one rigid body in the plane normal to an axis (0 X, 1 Y, 2 Z): the two
/// translations in the plane and the rotation about the normal.
struct T_DIAPHRAGM {
    std::vector<std::size_t> nodes; // that move together
    int normal = 2;                 // axis that the plane is normal to
};

/// Nodes whose displacements in these directions are equal.
struct T_EQUAL_DISPLACEMENT {
    std::vector<std::size_t> nodes; // that move alike
    T_DIRS6 directions{};           // true: equal there
};

/// The structure. Elements name nodes, materials and sections by their places here.
struct T_FRAME {
    std::vector<T_NODE> nodes; // results by node are in this order
    std::vector<T_MATERIAL> materials;
    std::vector<T_SECTION> sections;
    std::vector<T_ELEMENT> elements; // results by element are in this order
    std::vector<T_DIAPHRAGM> diaphragms;
    std::vector<T_EQUAL_DISPLACEMENT> equalDisplacements;
    double gravity = 9.80665; // in these units; weight = mass times gravity
};

// ---- loads --------------------------------------------------------------------------------------

/// Load on a node.
struct T_NODAL_LOAD {
    std::size_t node = 0; // place in T_FRAME::nodes
    T_VEC6 load{};        // forces and moments, global
};

/// Kinds of load between the ends of an element.
enum class BEAM_LOAD { Distributed, Point, Moment };

/// Load on a beam; on its flexible length between the rigid offsets. Positions are fractions of
/// that length. Distributed: from w[0] at at[0] to w[1] at at[1], linear, force per length of the
/// beam (not of its projection). Point, moment: w[0] at at[0]. A truss takes loads along
/// global axes alone; its nodes share them by the lever rule.
struct T_BEAM_LOAD {
    std::size_t element = 0; // place in T_FRAME::elements
    BEAM_LOAD type = BEAM_LOAD::Distributed;
    bool local = true;                  // direction of the local axes; false: of the global ones
    int direction = 2;                  // 0 x, 1 y, 2 z; of a moment, the axis it turns about
    std::array<double, 2> w{};          // force per length, force, or moment
    std::array<double, 2> at{0.0, 1.0}; // fractions of the length
};

/// Prescribed displacement of a restrained degree of freedom; others must be 0.
struct T_SETTLEMENT {
    std::size_t node = 0;  // place in T_FRAME::nodes
    T_VEC6 displacement{}; // global; lengths and radians
};

/// Change of temperature of a beam or truss.
struct T_TEMPERATURE {
    std::size_t element = 0; // place in T_FRAME::elements
    double change = 0.0;     // degrees, uniform
};

/// Initial tension as an initial strain T / (E A): what remains is what equilibrium leaves.
struct T_PRETENSION {
    std::size_t element = 0; // place in T_FRAME::elements
    double force = 0.0;      // T, positive in tension
};

/// Loads that act together.
struct T_LOAD_CASE {
    T_VEC3 selfWeight{}; // multiples of gravity in X, Y, Z; of elements with density, not of masses
    std::vector<T_NODAL_LOAD> nodal;
    std::vector<T_BEAM_LOAD> beam;
    std::vector<T_SETTLEMENT> settlement;
    std::vector<T_TEMPERATURE> temperature;
    std::vector<T_PRETENSION> pretension;
};

} // namespace solver
