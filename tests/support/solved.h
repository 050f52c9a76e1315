// Shorthand of the tests: solve or say why not.
#pragma once

#include "frames.h"

#include "qm_solver/framesolver.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace sample {

/// Results of the cases; a refusal is a failure of the test and gives no results.
inline std::vector<T_RESULT> Solved(const T_FRAME& frame, const std::vector<T_LOAD_CASE>& cases)
{
    CFrameSolver frameSolver;
    T_SOLVER_ERROR error;
    std::vector<T_RESULT> results;
    if (!frameSolver.Prepare(frame, error) || !frameSolver.Solve(cases, results, error))
        ADD_FAILURE() << error.reason.Text() << " node " << error.node << " element "
                      << error.element;
    return results;
}

inline T_RESULT Solved(const T_FRAME& frame, const T_LOAD_CASE& load)
{
    const std::vector<T_RESULT> results = Solved(frame, std::vector<T_LOAD_CASE>{load});
    if (!results.empty()) return results[0];
    T_RESULT nothing;
    nothing.displacement.resize(frame.nodes.size());
    nothing.reaction.resize(frame.nodes.size());
    nothing.force.resize(frame.elements.size());
    return nothing;
}

/// The place that an error names: s stage, c load case, e element, n node, each with its index.
inline std::string Place(const T_SOLVER_ERROR& error)
{
    std::string place;
    const std::pair<char, long> parts[] = {
        {'s', error.stage}, {'c', error.loadCase}, {'e', error.element}, {'n', error.node}};
    for (const auto& [letter, index] : parts)
        if (index >= 0) place += (place.empty() ? "" : " ") + (letter + std::to_string(index));
    return place;
}

inline void FixAll(T_FRAME& frame, std::size_t node)
{
    Fix(frame, node, {0, 1, 2, 3, 4, 5});
}

} // namespace sample
