// What a section makes of given forces, by every way that its material and shape have. SI; axial
// forces are positive in compression, moments as in qm_solver/sectionmodel.h.
#pragma once

#include "qm_rps/section/sectionvalues.h"

#include <vector>

struct T_SECTION_FORCES {
    double N = 0.0, My = 0.0, Mz = 0.0;
    double Vy = 0.0, Vz = 0.0, T = 0.0; // shear along y and z, torsion
    std::string name{};                 // of the set; empty: none
    bool operator==(const T_SECTION_FORCES&) const = default;
};
struct T_SECTION_FORCE {
    const char* name;
    T_DIM dim;
    double T_SECTION_FORCES::*value;
};
inline constexpr std::array<T_SECTION_FORCE, 6> kSectionForces{
    {{"N", kDimForce, &T_SECTION_FORCES::N},
     {"My", kDimMoment, &T_SECTION_FORCES::My},
     {"Mz", kDimMoment, &T_SECTION_FORCES::Mz},
     {"Vy", kDimForce, &T_SECTION_FORCES::Vy},
     {"Vz", kDimForce, &T_SECTION_FORCES::Vz},
     {"T", kDimMoment, &T_SECTION_FORCES::T}}};

enum class SECTION_CHECK_CODE { En, Aisc, Aci };
inline constexpr std::array<const char*, 3> kSectionCheckCodeNames{"EN", "AISC", "ACI"};

struct T_SECTION_CHECK_REQUEST {
    T_SECTION_OPTIONS options;
    std::vector<SECTION_CHECK_CODE> codes{}; // empty: all that the material has
    double cotTheta = 1.0;                   // EN 1992-1-1 6.2.3(2), of the struts
    std::vector<T_SECTION_FORCES> forces;
};

enum class SECTION_CHECKED { Axial, Bending, ShearY, ShearZ, Torsion };
inline constexpr std::array<const char*, 5> kSectionCheckedNames{"axial", "bending", "shear_y",
                                                                 "shear_z", "torsion"};

/// One way of checking.
struct T_SECTION_WAY {
    SECTION_CHECKED what = SECTION_CHECKED::Bending;
    std::string by;                // clause; empty: the section calculator
    std::optional<double> ratio{}; // above 1: exceeded; none: not checked
    std::string reason;            // why it was not
    std::vector<T_CODE_TRACE> trace;
    std::vector<T_CODE_WARNING> warnings;

    bool IsExceeded() const { return ratio && *ratio > 1.0; }
};
struct T_SECTION_CHECKS {
    T_SECTION_FORCES forces;
    std::vector<T_SECTION_WAY> ways; // those that the forces ask for
};
struct T_SECTION_CHECK {
    std::string section, material;
    T_SECTION_OPTIONS options;
    bool ofConcrete = false;
    std::vector<T_CODE_TRACE> trace; // strengths
    std::vector<T_CODE_WARNING> warnings;
    std::vector<T_SECTION_CHECKS> sets;
};
/// The set with the largest ratio first; those in which nothing was checked last.
void SortByRatio(T_SECTION_CHECK& check);

/// The section calculator gives the ratio of the axial force to the strength without moments, and
/// of the moment to the one that the section carries at this axial force in its direction: exact.
/// Beside it: steel EN 1993-1-1 6.2.3, 6.2.4, 6.2.9 (with the loss by shear of 6.2.8, 6.2.10),
/// AISC 360 H1-1 and the surface of wide flanges; concrete Bresler and EN 1992-1-1 5.8.9(4) under
/// two moments; shear by EN 1993-1-1 6.2.6, AISC 360 G, EN 1992-1-1 6.2, ACI 318 22.5, each
/// direction alone. The section alone: nothing of the member's buckling is in it.
/// 1 done; 0 with the reason in words and `out` unchanged: as CalcSection, no forces, forces that
/// are not finite. A way that has no answer is not checked, with its reason.
[[nodiscard]] int CheckSection(const T_SECT_D& section, const T_MATL_D& material,
                               const T_SECTION_CHECK_REQUEST& request, const T_UNITS& units,
                               T_SECTION_CHECK& out, std::string& reason);
