// Stiffness of an element of any kind over the displacements of its nodes.
#pragma once

#include "qm_solver/model/vec3.h"

namespace solver {

/// Displacements that an element acts on: 12 (node i, node j), of a spring the first 6.
inline std::size_t ElementSize(const T_ELEMENT& element)
{
    return element.kind == ELEMENT_KIND::Spring ? 6 : 12;
}
/// Full index (6 node + direction) of displacement `local` of an element.
inline std::size_t ElementIndex(const T_ELEMENT& element, std::size_t local)
{
    return local < 6 ? 6 * element.i + local : 6 * element.j + local - 6;
}

/// What the axial force does to the stiffness of a beam or truss.
struct T_AXIAL {
    double tension = 0.0; // of the geometric stiffness; 0: first order
    double modulus = 1.0; // factor on E of a truss, from its sag
};

/// Direction of a truss from i to j, and its length.
T_VEC3 TrussDirection(const T_FRAME& frame, const T_ELEMENT& element, double& length);
/// Axial stiffness E A / L of a truss without sag.
double TrussStiffness(const T_FRAME& frame, const T_ELEMENT& element, double length);

/// Global axes; of a spring the first six rows and columns. Links and springs have one spring per
/// direction, without levers: a link of some length passes its shear without the moment. The
/// geometric stiffness of a truss is N / L across its direction.
void ElementStiffness(const T_FRAME& frame, const T_ELEMENT& element, const T_AXIAL& axial,
                      T_MATRIX12& stiffness);

/// Twice the strain energy of an element under displacements of its nodes (global axes), from its
/// deformations: a motion that does not strain it leaves only the square of its rounding, and the
/// tension times what the turning chord would lengthen.
double StrainEnergy(const T_FRAME& frame, const T_ELEMENT& element, const T_AXIAL& axial,
                    const T_VEC12& displacement);

} // namespace solver
