// The section as edges and arcs about its point of moments, with its laws; checked once.
#pragma once

#include "qm_solver/section/stresslaw.h"
#include "qm_solver/sectionresult.h"

#include <vector>

namespace solver {

/// Straight edge; the region's material lies to its left where sign is +1, else to its right.
struct T_EDGE {
    double y0 = 0.0, z0 = 0.0, y1 = 0.0, z1 = 0.0;
    double sign = 1.0;
    std::size_t region = 0;
};
/// Arc that turns left from the angle `from` (0 along +y) over `sweep`, at most a full circle.
struct T_ARC {
    double y = 0.0, z = 0.0, radius = 0.0;
    double from = 0.0, sweep = 0.0;
    double sign = 1.0;
    std::size_t region = 0;
};
/// Law `host` of the concrete is taken off.
struct T_SHAPE_BAR {
    double y = 0.0, z = 0.0, area = 0.0;
    std::size_t law = 0, host = 0;
};

struct T_SECTION_SHAPE {
    T_SECTION_MODEL model;
    std::vector<CStressLaw> laws;
    std::vector<T_EDGE> edges;
    std::vector<T_ARC> arcs;
    std::vector<T_SHAPE_BAR> bars;
    const T_STRESS_LAW& LawOf(const T_SECTION_REGION& region) const
    {
        return model.laws[region.law];
    }
};

/// 1 done; 0 with the fault, `out` unchanged.
[[nodiscard]] int MakeShape(const T_SECTION_MODEL& model, T_SECTION_SHAPE& out,
                            T_SECTION_ERROR& error);

} // namespace solver
