// Shear and shear span of member ends in a push.
#pragma once

#include "qm_rps/generate/memberend.h"
#include "qm_rps/push/pushrun.h"

/// Of each element V and M / V of the I-end, then of the J-end, for each axis of bending, at the
/// step at which the end's hinge flows for the first time (never: at which V is largest); of
/// several results of a load case the one with the larger V. V is the difference of the end moments
/// over the clear length: loads along the member do not count. Elements whose ends have no hinges
/// about an axis, or no shear in the push, are left out.
std::map<int, std::vector<double>> PushedShears(const std::vector<T_PUSH_RUN>& runs,
                                                const std::vector<T_HINGE_MEMBER>& members);

/// The element whose V has changed most, and by how much of its new value.
struct T_SHEAR_CHANGE {
    int element = 0;
    double change = 0.0;
    double before = 0.0, now = 0.0; // V
};
/// An element that is not in `before` had V = 0.
T_SHEAR_CHANGE LargestChange(const std::map<int, std::vector<double>>& before,
                             const std::map<int, std::vector<double>>& now);
