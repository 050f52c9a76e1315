// What the results of a push are measured in.
#pragma once

#include "qm_db/records.h"

#include <string>

/// A kind of values: turns them from SI into current units, and names these.
struct T_PUSH_QUANTITY {
    T_DIM dim;
    T_UNITS units;
    double Shown(double si) const { return FromSi(si, units, dim) + 0.0; }
    std::string Unit() const; // "m", "kN m", "rad"
    /// "Displacement (m)"
    std::string Head(const char* key) const;
};

/// Displacement and reaction of a direction of control, 0 to 5.
T_PUSH_QUANTITY DisplacementIn(std::size_t direction, const T_UNITS& units);
T_PUSH_QUANTITY ReactionIn(std::size_t direction, const T_UNITS& units);
/// Deformation and force of a hinge component.
T_PUSH_QUANTITY DeformationOf(HINGE_COMPONENT component, const T_UNITS& units);
T_PUSH_QUANTITY ForceOf(HINGE_COMPONENT component, const T_UNITS& units);
