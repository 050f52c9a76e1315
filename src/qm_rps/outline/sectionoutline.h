// The outline of a section of records as the section calculator takes it.
#pragma once

#include "qm_db/records.h"
#include "qm_solver/sectionmodel.h"

/// Outline and hollow about the centroid; none of a section given by values. The dimensions must be
/// sound.
std::vector<solver::T_RING> SectionRings(const T_SECT_D& section);

/// Between the centre lines of the stirrups, of a rectangle or a circle with detailing; none of
/// other sections.
std::vector<solver::T_RING> CoreRings(const T_SECT_D& section);

/// Elastic with this modulus, then perfectly plastic.
solver::T_STRESS_LAW SteelLaw(double strength, double modulus);

/// Smallest and largest place of the ring along a direction of bending.
struct T_RING_EXTENT {
    double low = 0.0, high = 0.0;
};
T_RING_EXTENT ExtentAlong(const solver::T_RING& ring, double direction);
