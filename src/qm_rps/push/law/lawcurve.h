// A page of a hinge type as a law of the engine: points of the backbone in the deformation of the
// hinge, beyond the elastic member.
#pragma once

#include "qm_db/records.h"
#include "qm_solver/pushmodel.h"

#include <optional>
#include <string>

/// What a page stands on besides its curve; SI, strengths are magnitudes.
struct T_LAW_BASIS {
    T_SIDES<double> yield, crack;
    /// Elastic stiffness of the member in the measure of the curve (force over displacement, moment
    /// over rotation or curvature); empty: the member does not deform that way.
    std::optional<double> stiffness;
    double axial = 0.0;  // at the initial loads, compression positive: picks the curve by force
    double length = 1.0; // curvatures and strains times this are deformations of the hinge
    /// Strengths at that axial force over `yield`: the member yields at so much of its rotation.
    T_SIDES<double> atAxial{1.0, 1.0};
};

/// A law, and how its points are called.
struct T_PUSH_LAW {
    solver::T_HINGE_LAW law;
    T_SIDES<std::string> letters; // of the points of a side, "BCDE"
    bool criteria = false;        // marks are IO, LS, CP
    bool fails = false;           // beyond the last point the hinge has failed
};

/// The law of a page. A member that is elastic up to yield (initial stiffness 6EI/L, 3EI/L, 2EI/L,
/// elastic) has a hinge that is rigid until then: total deformation D less force over initial
/// stiffness. A user stiffness is a spring in series with the member, its part of the deformation
/// is in the hinge; 0 is rigid. Ratios D/Dy count in Dy = yield strength / stiffness. The elastic
/// part of plastic deformations (D - Dy) is that at the axial force of the initial loads.
///
/// Ratios of a multilinear curve run to 1000 Dy, or to the ultimate strength, where the force
/// stays; entered deformations place the points after the first one, which is elastic. Unloading:
/// to the origin and nonlinear elastic as the curve says, all others with the elastic stiffness,
/// which is what a monotonic path shows of them.
///
/// 1 done; 0 with the reason in words, `out` unchanged: no strength, a point that does not lie on
/// the initial stiffness or falls behind the one before, ratios that leave no yield.
[[nodiscard]] int MakeLaw(const T_SKEL_CURVE& curve, SKEL_TYPE type, const T_LAW_BASIS& basis,
                          T_PUSH_LAW& out, std::string& reason);

/// The sides of a FEMA curve at an axial force, compression positive: straight between the curves
/// of its list, the nearest one's beyond them.
T_SIDES<T_SKEL_SIDE> SidesAt(const T_SKEL_FEMA& curve, double axial);
