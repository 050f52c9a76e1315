// Cross-sections for tests of the section calculator.
#pragma once

#include "qm_solver/sectionsolver.h"

#include <gtest/gtest.h>

namespace solver {

inline T_RING RectangleRing(double b, double h, double y = 0.0, double z = 0.0)
{
    return {{y - b / 2, z - h / 2},
            {y + b / 2, z - h / 2},
            {y + b / 2, z + h / 2},
            {y - b / 2, z + h / 2}};
}
inline T_RING CircleRing(double radius, double y = 0.0, double z = 0.0)
{
    return {{y + radius, z, 1.0}, {y - radius, z, 1.0}};
}

inline T_STRESS_LAW ConcreteOf(double f, double peak = 0.002, double limit = 0.0035, double n = 2.0)
{
    T_STRESS_LAW law;
    law.strength = f, law.peakStrain = peak, law.limitStrain = limit, law.exponent = n;
    return law;
}
inline T_STRESS_LAW BlockOf(double fc, double beta1)
{
    T_STRESS_LAW law;
    law.kind = STRESS_LAW::Block;
    law.strength = 0.85 * fc, law.blockDepth = beta1, law.limitStrain = 0.003;
    return law;
}
inline T_STRESS_LAW SteelOf(double f, double E = 2e5, double hardening = 0.0, double limit = 0.0)
{
    T_STRESS_LAW law;
    law.kind = STRESS_LAW::Steel;
    law.strength = f, law.modulus = E, law.hardening = hardening, law.limitStrain = limit;
    return law;
}

/// Law 0 in one region, law 1 in bars of {y, z, area}.
inline T_SECTION_MODEL SectionOf(T_RING ring, T_STRESS_LAW law, T_STRESS_LAW steel = {},
                                 std::vector<std::array<double, 3>> bars = {})
{
    T_SECTION_MODEL m;
    m.laws = {law};
    m.regions = {{{std::move(ring)}, 0}};
    if (!bars.empty()) m.laws.push_back(steel);
    for (const auto& [y, z, area] : bars)
        m.bars.push_back({y, z, area, 1});
    return m;
}

/// Prepared, or a failure of the test.
inline CSectionSolver Prepared(const T_SECTION_MODEL& model)
{
    CSectionSolver solver;
    T_SECTION_ERROR error;
    EXPECT_EQ(1, solver.Prepare(model, error)) << static_cast<int>(error.fault);
    return solver;
}

inline T_CAPACITY CapacityAt(const CSectionSolver& s, double direction, double place)
{
    T_CAPACITY out;
    T_SECTION_ERROR error;
    EXPECT_EQ(1, s.Capacity(direction, place, out, error)) << static_cast<int>(error.fault);
    return out;
}
inline T_CAPACITY CapacityAtAxial(const CSectionSolver& s, double direction, double axial)
{
    T_CAPACITY out;
    T_SECTION_ERROR error;
    EXPECT_EQ(1, s.AtAxial(direction, axial, out, error)) << static_cast<int>(error.fault);
    return out;
}

} // namespace solver
