// Curves of a hinge type's components: the alternative that belongs to a type.
#pragma once

#include "qm_db/records/hingerecords.h"

/// An empty curve of the kind that belongs to the type.
T_SKEL_CURVE MakeSkelCurve(SKEL_TYPE type);
bool FitsType(const T_SKEL_CURVE& curve, SKEL_TYPE type);

/// Replaces curves of another kind than their component's type: the J-end's by the I-end's where
/// both are the same, else by an empty one.
void FitCurves(T_PHGT_D& type);

/// A hinge type of one FEMA component, both ends the same, out of the curve of an inelastic hinge;
/// not active, with an empty curve, where that has none. component: 0 to 5. 1 done; 0 no such
/// component, out as it was.
[[nodiscard]] int ConvertIehpToPhgtFema(const T_IEHP_D& in, int component, T_PHGT_D& out);
/// Its name and its I-end's curve back into the inelastic hinge, whose other components stay; a
/// component that is not active is taken out. Both ways and back nothing is lost. 1 done; 0 no such
/// component or no FEMA curve, out as it was.
[[nodiscard]] int ConvertPhgtToIehpFema(const T_PHGT_D& in, int component, T_IEHP_D& out);
