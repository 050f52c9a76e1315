// Curves that keep every rule; tests spoil one number each.
#pragma once

#include "qm_rps/hinge/hingefindings.h"

#include <string>
#include <vector>

/// Two sides of different numbers, strength loss from 1.2 (-1.3) to 0.2 (-0.3).
template <class CURVE>
CURVE ValidBackbone()
{
    CURVE f;
    f.symmetric = false;
    f.autoYield = false;
    f.initStiffness = INIT_STIFFNESS::User;
    T_SKEL_SIDE& p = f.sides.pos;
    T_SKEL_SIDE& n = f.sides.neg;
    p.yield = 100, p.yieldDeform = 0.01, p.userStiffness = 5;
    n.yield = 90, n.yieldDeform = 0.02, n.userStiffness = 5;
    p.B = {1, 1}, p.C = {6, 1.2}, p.D = {6, 0.2}, p.E = {8, 0.2};
    n.B = {-1, -1}, n.C = {-5, -1.3}, n.D = {-5, -0.3}, n.E = {-7, -0.3};
    p.IO = 2, p.LS = 4, p.CP = 6;
    n.IO = -2, n.LS = -3, n.CP = -5;
    p.energy = n.energy = {1, 0.75, 0.5, 0.25};
    return f;
}

inline T_HINGE_COMPONENT ComponentWith(SKEL_TYPE type, const T_SKEL_CURVE& curve)
{
    T_HINGE_COMPONENT c;
    c.active = true;
    c.type = type;
    c.curves = {curve, curve};
    return c;
}

inline std::string First(const std::vector<T_FINDING>& found)
{
    return found.empty() ? "" : found.front().ruleText;
}
