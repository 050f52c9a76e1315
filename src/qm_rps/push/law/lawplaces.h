// Where the hinges of a component stand on an element.
#pragma once

#include "qm_db/records.h"

#include <string>
#include <vector>

struct T_HINGE_SPOT {
    double at = 0.0;     // fraction of the flexible length
    std::string end;     // "I", "J", "C", or the number of an integration point
    bool pageJ = false;  // has the curve and the strengths of the J-end
    double length = 1.0; // over which a curvature or strain acts; of rotations 1
    bool operator==(const T_HINGE_SPOT&) const = default;
};

/// The element that a hinge stands on.
struct T_HINGE_SPAN {
    ELEM_KIND kind = ELEM_KIND::Beam;
    double length = 0.0;       // flexible length
    double memberLength = 0.0; // of its member, which relative hinge lengths are fractions of
    bool isLoaded = false;     // between its ends, so that these differ in their shear
};

/// Places of a component's hinges. Trusses, links and springs have one; so have Fx and Mx of a beam
/// where both ends are alike, and Fy and Fz of one that is not loaded: both would carry the same
/// force, and nothing says which of them flows.
/// Distributed curvature: Gauss-Lobatto points of the element, weights times its length.
/// 1 done; 0 with the reason: a hinge length is missing, the number of points is not 2 to 20.
[[nodiscard]] int HingeSpots(const T_PHGT_D& type, HINGE_COMPONENT component,
                             const T_HINGE_SPAN& span, std::vector<T_HINGE_SPOT>& out,
                             std::string& reason);

/// Position and weight on 0 to 1; the ends are points.
struct T_LOBATTO_POINT {
    double at = 0.0, weight = 0.0;
};
/// n from 2 on (Abramowitz and Stegun 25.4.32).
std::vector<T_LOBATTO_POINT> LobattoPoints(int n);
