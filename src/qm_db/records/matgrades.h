// Materials by the names of their grades.
#pragma once

#include "qm_db/records/structrecords.h"

#include <span>

/// Mean elastic modulus of concrete, EN 1992-1-1 Table 3.1: 22 (fcm / 10 MPa)^0.3 GPa; Pa.
double ConcreteModulus(double fcm);

/// A grade with the values that it has; SI, 0: not of this grade.
struct T_MATL_GRADE {
    std::string name;   // "C25/30"
    std::string clause; // where it comes from
    MATL_CLASS type = MATL_CLASS::Steel;
    bool bars = false; // of reinforcement: fyk and Es of concrete
    double strength = 0.0, modulus = 0.0, nu = 0.0, density = 0.0, alpha = 0.0;
};
/// Concrete of EN 1992-1-1 Table 3.1 and of ACI 318 by psi; structural steel of EN 10025-2 and of
/// ASTM; bars. All but the concrete of EN are recalled.
std::span<const T_MATL_GRADE> MaterialGrades();

/// Fills what the material leaves at 0 from one grade or, of concrete, also from one of bars:
/// "C25/30", "C25/30 B500B", "S355". False: there is no such grade, or none for this class of
/// material; the material is as it was. `typed`: the class was given, else it follows the grade.
bool FillFromGrades(const std::string& names, bool typed, T_MATL_D& material);
