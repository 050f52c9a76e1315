// What follows from the deflected shapes of a Timoshenko beam: fixed-end forces and resultants of
// loads on its flexible length, exact, and the geometric stiffness of a tension.
#pragma once

#include "qm_solver/model/vec3.h"

namespace solver {

/// What the deflected shape of a beam depends on.
struct T_BEAM_SHAPE {
    double length = 0.0;
    /// 12 E I / (G As length^2): shear flexibility against bending flexibility for deflection
    /// along y (I = Iz, As = Asy) and along z (Iy, Asz); 0 without shear deformation.
    double phiY = 0.0, phiZ = 0.0;
};

/// A load in local axes. Force: per length, linear from w0 at a to w1 at b. Point and moment:
/// w0 at a. Positions are lengths from the I end.
struct T_SPAN_LOAD {
    BEAM_LOAD type = BEAM_LOAD::Distributed;
    T_VEC3 w0{}, w1{};
    double a = 0.0, b = 0.0;
};

/// Adds the forces of the clamped ends on the beam (order: forces and moments at I, at J).
/// They are minus the integrals of the load times the exact deflected shapes for a unit
/// displacement of the ends (Betti); shapes: Przemieniecki, Theory of Matrix Structural Analysis
/// (1968) chapter 5, in the form with the shear parameter.
void AddFixedEndForces(const T_BEAM_SHAPE& shape, const T_SPAN_LOAD& load, T_VEC12& forces);

/// Deflections along y and z at x from the I end by displacements of the ends (local axes).
std::array<double, 2> DeflectionAt(const T_BEAM_SHAPE& shape, double x, const T_VEC12& ends);

/// Adds tension times the integral of the products of the shapes' slopes, of both planes of
/// bending. A pinned column of n elements buckles at about (pi / n)^4 / 720 above Euler's load.
void AddGeometricStiffness(const T_BEAM_SHAPE& shape, double tension, T_MATRIX12& stiffness);

/// Adds the resultant, about position x, of the part of the load before x. A point load or moment
/// exactly at x counts as behind it, unless `whole`, which takes everything.
void AddResultantBefore(const T_SPAN_LOAD& load, double x, bool whole, T_VEC6& resultant);

} // namespace solver
