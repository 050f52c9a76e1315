// What the section calculator gives for a section of the records: capacities, moment-curvature, the
// interaction of axial force and moment, surfaces. SI; axial forces are positive in compression,
// directions as in qm_solver/sectionmodel.h.
#pragma once

#include "qm_rps/section/sectionmodelof.h"
#include "qm_rps/section/sectionpairs.h"
#include "qm_solver/sectionresult.h"

enum class SECTION_TASK { Capacity, Curvature, Interaction, Surface };
inline constexpr std::array<const char*, 4> kSectionTaskNames{"capacity", "curvature",
                                                              "interaction", "surface"};

struct T_SECTION_REQUEST {
    SECTION_TASK task = SECTION_TASK::Capacity;
    T_SECTION_OPTIONS options;
    std::vector<double> directions{0.0}; // rad; of a surface: not used
    std::vector<double> axial;           // empty: 0; of a surface: kSurfaceLevels even ones
    bool ofMoment = false;               // directions are those of the moment (not: interaction)
    std::size_t points = 40;             // of a curve; directions of a surface
    double maxCurvature = 0.0;           // 1/m; 0: until the section ends
};
inline constexpr std::size_t kSurfaceLevels = 9;
inline constexpr std::size_t kMostSectionPoints = 2000;
/// Of a moment-curvature: enough for its peak where the ultimate lies far out.
inline constexpr std::size_t kCurvaturePoints = 120;

/// Plane and forces of a state; the forces once more from the plane alone.
struct T_SECTION_STATE {
    double axial = 0.0, My = 0.0, Mz = 0.0;
    solver::T_STRAIN_PLANE plane;
    solver::T_FIBRE governs;
    double top = 0.0, bottom = 0.0; // strains of the edges along the curvature
    double depth = 0.0;             // of the neutral axis below the compressed edge; 0: none
    /// Largest difference to the forces of the plane, over the section's strength in compression
    /// and its largest moment. None: full plasticity has no strains.
    std::optional<double> residual;
};

struct T_SECTION_CAPACITY_AT {
    double direction = 0.0;
    T_SECTION_STATE at;
};
struct T_SECTION_CURVATURE {
    double direction = 0.0, axial = 0.0;
    solver::T_MOMENT_CURVATURE curve;
    T_SECTION_STATE yield, ultimate;
};
struct T_SECTION_INTERACTION {
    double direction = 0.0;
    solver::T_AXIAL_CURVE curve;
};
/// Moments all around at one axial force.
struct T_SECTION_CONTOUR {
    double axial = 0.0;
    std::vector<solver::T_CAPACITY> points;
};

/// Results of one section; of the task alone.
struct T_SECTION_ANSWER {
    SECTION_TASK task = SECTION_TASK::Capacity;
    std::string section, material;
    T_SECTION_OPTIONS options;
    bool ofConcrete = false, ofMoment = false;
    std::vector<T_CODE_TRACE> trace;
    std::vector<T_CODE_WARNING> warnings;
    double compression = 0.0, tension = 0.0; // pure axial strengths, >= 0; 0: not known
    std::vector<T_SECTION_CAPACITY_AT> capacities;
    std::vector<T_SECTION_CURVATURE> curvatures;
    std::vector<T_SECTION_INTERACTION> interactions;
    std::vector<T_SECTION_CONTOUR> contours;
};

/// 1 done; 0 with the reason in words and `out` unchanged. Units are those of the reason's numbers.
[[nodiscard]] int CalcSection(const T_SECT_D& section, const T_MATL_D& material,
                              const T_SECTION_REQUEST& request, const T_UNITS& units,
                              T_SECTION_ANSWER& out, std::string& reason);
