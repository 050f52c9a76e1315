// Pushes of frames with plastic hinges through the program, and the vertices of their paths.
#pragma once

#include "program.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

/// A vertex of a path, as both sides write it.
struct T_VERTEX {
    std::string stage, hinge; // "3 I My B": element, end, component, point
    double loadFactor = 0.0, displacement = 0.0;
};

using T_VERTICES = std::vector<T_VERTEX>;

inline T_VERTICES Expected(const json& events)
{
    T_VERTICES out;
    for (const json& e : events)
        out.push_back({e[0],
                       std::to_string(e[3].get<int>()) + " " + e[4].get<std::string>() + " " +
                           e[5].get<std::string>() + " " + e[6].get<std::string>(),
                       e[1], e[2]});
    return out;
}

inline std::string HingeName(const json& h)
{
    const json& end = h.at("end");
    return std::to_string(h.at("element").get<int>()) + " " +
           (end.is_string() ? end.get<std::string>() : end.dump()) + " " +
           h.at("component").get<std::string>();
}

/// One entry for each hinge of an event.
inline T_VERTICES Found(const json& events)
{
    T_VERTICES out;
    for (const json& e : events)
        for (const json& h : e.at("hinges"))
            out.push_back({e.at("stage"), HingeName(h) + " " + h.at("to").get<std::string>(),
                           e.at("load_factor"), e.at("displacement")});
    return out;
}

/// Sorts what happens at one instant by its names: the order within a tie means nothing.
inline void SortTies(T_VERTICES& vertices, double width)
{
    for (std::size_t i = 0; i < vertices.size();) {
        std::size_t end = i + 1;
        while (end < vertices.size() && vertices[end].stage == vertices[i].stage &&
               std::fabs(vertices[end].loadFactor - vertices[i].loadFactor) <= width)
            ++end;
        const auto at = vertices.begin();
        std::sort(at + static_cast<std::ptrdiff_t>(i), at + static_cast<std::ptrdiff_t>(end),
                  [](const T_VERTEX& a, const T_VERTEX& b) { return a.hinge < b.hinge; });
        i = end;
    }
}

/// Both in the same order, load factors within dLoad and displacements within dDisp.
inline void ExpectVertices(T_VERTICES a, T_VERTICES b, double dLoad, double dDisp, double tie)
{
    SortTies(a, tie);
    SortTies(b, tie);
    EXPECT_EQ(a.size(), b.size());
    for (std::size_t i = 0; i < std::min(a.size(), b.size()); ++i) {
        ASSERT_EQ(a[i].stage + " " + a[i].hinge, b[i].stage + " " + b[i].hinge)
            << "event " << i + 1 << " at " << a[i].loadFactor << ", " << a[i].displacement
            << " and " << b[i].loadFactor << ", " << b[i].displacement;
        EXPECT_NEAR(a[i].loadFactor, b[i].loadFactor, dLoad) << i + 1 << ": " << a[i].hinge;
        EXPECT_NEAR(a[i].displacement, b[i].displacement, dDisp) << i + 1 << ": " << a[i].hinge;
    }
}

inline json Data(const std::string& name)
{
    return json::parse(ReadText(ProjectFolder() / "tests/data/push" / (name + ".json")));
}

/// Runs `qm-rps push` on a case file that is at hand as JSON.
class CPushTest : public CProgramTest {
protected:
    /// The only load case of a file, pushed to its target.
    json Pushed(const json& file, const std::string& more = {}) const
    {
        Write("c.json", file.dump(1));
        json all = Json("push c.json --all" + more);
        EXPECT_EQ(file.at("pushover").size(), all.size());
        for (const json& run : all) {
            EXPECT_EQ("reached", run.at("status")) << run.at("outcome");
            for (const json& r : run.at("residual"))
                EXPECT_GT(1e-8, r.get<double>());
        }
        return all.back();
    }
};
