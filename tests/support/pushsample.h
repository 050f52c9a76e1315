// A three-storey model for the tests of curve assembly and driver, small enough to do by hand.
#pragma once

#include "qm_db/dbdoc.h"

#include <cmath>

/// Factors of the model's mode in X (masses 2, 2, 1 kN s2/m, shape 1, 2, 3): L = 9, M = 19,
/// Gamma = 3 * 9/19, alpha = 81 / (19 * 5); gravity 10 m/s2, so Sa = V / (5 * 10 * alpha).
inline constexpr double kGamma = 27.0 / 19.0, kAlpha = 81.0 / 95.0, kWeightStar = 810.0 / 19.0;

inline T_POLC_D PushX(const char* name, int node)
{
    T_POLC_D p;
    p.name = name;
    p.controlNode = node;
    return p;
}

/// Storeys of 3 m with nodes 1, 2, 3. Node 4 in the second storey has a mass of 7 restrained in X;
/// node 5 with a mass of 50 is in no storey. Mode 1 moves in Y, modes 2 and 3 equally in X.
/// "PX": node 3 in X, one displacement (m) and base shear (kN) per step; node 1 moves a third,
/// node 2 two thirds. Shown in kN and m; the store is SI.
inline T_MODEL_CONTENT ThreeMasses(const std::vector<double>& D, const std::vector<double>& V)
{
    T_MODEL_CONTENT c;
    T_MODEL& m = c.model;
    m.styp.gravity = 10.0;
    for (int i = 1; i <= 3; ++i) {
        const double mass = i < 3 ? 2000.0 : 1000.0;
        m.nodes[i] = {i, {0, 0, 3.0 * i}, {mass, 500, mass}, {}};
        m.storeys[i] = {std::to_string(i) + "F", 3.0, {i}};
        m.modes[1].shape[i] = {0, 1.0 * i};
        m.modes[2].shape[i] = {1.0 * i};
    }
    m.nodes[4] = {4, {5, 0, 6}, {7000, 0, 0}, {1, 0, 0, 0, 0, 0}};
    m.nodes[5] = {5, {9, 0, 6}, {50000, 50000, 50000}, {}};
    m.storeys[2].nodes.push_back(4);
    m.modes[2].shape[4] = m.modes[2].shape[5] = {5};
    m.modes[3] = m.modes[2];
    m.pushovers[1] = PushX("PX", 3);
    T_PUSH_DATA data;
    for (std::size_t i = 0; i < D.size(); ++i) {
        data.loadFactor.push_back(0.5 * static_cast<double>(i + 1));
        data.baseReaction.push_back(1e3 * V[i]);
        data.displacement[1].push_back(D[i] / 3.0);
        data.displacement[2].push_back(D[i] * 2.0 / 3.0);
        data.displacement[3].push_back(D[i]);
    }
    c.results[1] = MakePushResult(std::move(data));
    return c;
}
