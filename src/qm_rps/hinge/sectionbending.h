// Uniaxial bending with axial force of one section about one axis in one direction.
#pragma once

#include "qm_db/records.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/codes/concretelaw.h"

#include <memory>
#include <vector>

/// Axial force (compression positive) and moment about the centroid.
struct T_AXIAL_MOMENT {
    double axial = 0.0, moment = 0.0;
};

/// The capacities over a parameter u that runs from 0 (pure tension) to 2 (pure compression); the
/// axial force rises with u.
class ISectionBending {
public:
    ISectionBending() = default;
    ISectionBending(const ISectionBending&) = delete;
    ISectionBending& operator=(const ISectionBending&) = delete;
    virtual ~ISectionBending() = default;
    virtual T_AXIAL_MOMENT At(double u) const = 0;
};

/// Bending that compresses the side +z (about y) or +y (about z), the other side when not positive.
/// The section must be sound and carry its properties; the methods stand at CSectionStrength.
std::unique_ptr<ISectionBending> MakeSteelBending(const T_SECT_D& section, double fy, bool aboutY);
std::unique_ptr<ISectionBending> MakeConcreteBending(const T_SECT_D& section,
                                                     const T_MATL_D& material,
                                                     const T_CONCRETE_LAW& law, bool aboutY,
                                                     bool positive);
