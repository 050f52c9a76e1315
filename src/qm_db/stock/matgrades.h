// Grades of materials by name. SI.
#pragma once

#include <span>
#include <string>

/// Mean elastic modulus of concrete, EN 1992-1-1 Table 3.1: 22 (fcm / 10 MPa)^0.3 GPa; Pa.
double ConcreteModulus(double fcm);

enum class GRADE_OF { Concrete, Steel, Bars };
struct T_MATL_GRADE {
    std::string name;   // "C25/30"
    std::string clause; // where it comes from
    GRADE_OF of = GRADE_OF::Steel;
    double strength = 0.0, modulus = 0.0, nu = 0.0, density = 0.0, alpha = 0.0;
};
/// Concrete of EN 1992-1-1 Table 3.1 and of ACI 318 by psi; structural steel of EN 10025 and of
/// ASTM; bars. All but the concrete of EN are recalled.
std::span<const T_MATL_GRADE> MaterialGrades();
/// Null: there is no such grade.
const T_MATL_GRADE* FindGrade(const std::string& name);
