// Shorthand of the tests of construction stages.
#pragma once

#include "solved.h"

#include "qm_solver/stagedsolver.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace sample {

inline std::vector<std::size_t> Range(std::size_t from, std::size_t to)
{
    std::vector<std::size_t> range(to - from);
    std::iota(range.begin(), range.end(), from);
    return range;
}

/// All elements, supports and load cases in one stage.
inline T_STAGED_MODEL OneStage(const T_FRAME& frame, std::size_t loadCases)
{
    T_STAGED_MODEL model;
    model.frame = frame;
    model.groups.assign(loadCases, LOAD_GROUP::Dead);
    T_STAGE stage;
    stage.activateElements = Range(0, frame.elements.size());
    for (std::size_t n = 0; n < frame.nodes.size(); ++n)
        if (frame.nodes[n].fixed != T_DIRS6{}) stage.activateSupports.push_back({n, {}});
    for (std::size_t c = 0; c < loadCases; ++c)
        stage.activateLoads.push_back({c, kFirstStep});
    model.stages.push_back(stage);
    return model;
}

inline T_LOAD_CASE Weight()
{
    T_LOAD_CASE load;
    load.selfWeight = {0, 0, -1};
    return load;
}

inline T_LOAD_CASE At(std::size_t node, T_VEC6 force)
{
    T_LOAD_CASE load;
    load.nodal.push_back({node, force});
    return load;
}

inline T_LOAD_CASE Tension(std::size_t element, double force)
{
    T_LOAD_CASE load;
    load.pretension.push_back({element, force});
    return load;
}

inline void Build(CStagedSolver& staged, const T_STAGED_MODEL& model,
                  const std::vector<T_LOAD_CASE>& cases)
{
    T_SOLVER_ERROR error;
    if (!staged.Prepare(model, error) || !staged.Run(cases, error))
        ADD_FAILURE() << error.reason.Text() << " stage " << error.stage << " case "
                      << error.loadCase << " node " << error.node << " element " << error.element;
}

inline T_RESULT Case(const CStagedSolver& staged, std::size_t stage, std::size_t loadCase,
                     int step = kLastStep)
{
    T_RESULT result;
    if (!staged.ReadCase(stage, step, loadCase, result)) {
        ADD_FAILURE() << "no result of stage " << stage;
        result.displacement.resize(1000);
        result.reaction.resize(1000);
        result.force.resize(1000);
    }
    return result;
}

template <class ROWS>
double LargestOf(const ROWS& rows)
{
    double largest = 0.0;
    for (const auto& row : rows)
        for (const double v : row)
            largest = std::max(largest, std::fabs(v));
    return largest;
}

/// Row by row within tolerance times the largest value of either.
template <class ROWS>
void ExpectRows(const ROWS& expected, const ROWS& found, double tolerance, const char* what)
{
    ASSERT_EQ(expected.size(), found.size()) << what;
    const double size = std::max(LargestOf(expected), LargestOf(found));
    for (std::size_t i = 0; i < expected.size(); ++i)
        for (std::size_t k = 0; k < expected[i].size(); ++k)
            EXPECT_NEAR(expected[i][k], found[i][k], tolerance * size)
                << what << " of " << i << ", component " << k;
}

inline void ExpectSame(const T_RESULT& expected, const T_RESULT& found, double tolerance)
{
    ExpectRows(expected.displacement, found.displacement, tolerance, "displacement");
    ExpectRows(expected.reaction, found.reaction, tolerance, "reaction");
    ASSERT_EQ(expected.force.size(), found.force.size());
    for (std::size_t p = 0; p < kBeamPositions; ++p) {
        std::vector<T_VEC6> a, b;
        for (std::size_t e = 0; e < expected.force.size(); ++e) {
            a.push_back(expected.force[e][p]);
            b.push_back(found.force[e][p]);
        }
        ExpectRows(a, b, tolerance, "force");
    }
}

inline T_RESULT Sum(T_RESULT first, const T_RESULT& second)
{
    const auto add = [](auto& rows, const auto& more) {
        for (std::size_t i = 0; i < rows.size(); ++i)
            for (std::size_t k = 0; k < rows[i].size(); ++k)
                rows[i][k] += more[i][k];
    };
    add(first.displacement, second.displacement);
    add(first.reaction, second.reaction);
    for (std::size_t e = 0; e < first.force.size(); ++e)
        add(first.force[e], second.force[e]);
    return first;
}

} // namespace sample
