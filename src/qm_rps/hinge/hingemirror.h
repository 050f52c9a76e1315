// What an editor of skeleton curves hands back: symmetric sides mirrored, equal ends copied.
#pragma once

#include "qm_rps/hinge/hingefindings.h"

/// The component with the negative side of every symmetric curve made from the positive one (a gap
/// keeps its own entry on each side), and the J-end's curve made the I-end's where both are alike.
T_HINGE_COMPONENT MirroredComponent(T_HINGE_COMPONENT component);

/// Members of the negative side of a symmetric curve that contradict the positive one. A negative
/// side of zeros is one that was left out.
void MirrorFindings(const T_SKEL_CURVE& curve, const T_HINGE_PLACE& place,
                    std::vector<T_FINDING>& out);
