// What the engine refuses, with the place that is at fault.
#include "numbers.h"
#include "solved.h"

#include <functional>

namespace {

using namespace sample;

struct T_REFUSED_MODEL {
    const char* label;
    std::function<void(T_FRAME&)> spoil;
    const char* place;  // as Place writes it; empty: none, or of a mechanism any node
    const char* reason; // part of it
    SOLVER_FAULT fault = SOLVER_FAULT::BadModel;
};

/// Two columns and a beam, all clamped at the feet.
T_FRAME Portal()
{
    T_FRAME frame = Empty();
    for (T_VEC3 at : {T_VEC3{0, 0, 0}, {0, 0, 3}, {5, 0, 3}, {5, 0, 0}})
        AddNode(frame, at);
    FixAll(frame, 0);
    FixAll(frame, 3);
    for (std::size_t n = 0; n < 3; ++n)
        Join(frame, ELEMENT_KIND::Beam, n, n + 1);
    return frame;
}

constexpr auto kFree = SOLVER_FAULT::Mechanism;

// clang-format off
const T_REFUSED_MODEL kModels[] = {
    {"nothing", [](T_FRAME& f) { f = {}; }, "", "no nodes"},
    {"coordinate", [](T_FRAME& f) { f.nodes[2].xyz[1] = kNan; }, "n2", "coordinate"},
    {"mass", [](T_FRAME& f) { f.nodes[1].mass[0] = -1; }, "n1", "mass"},
    {"node", [](T_FRAME& f) { f.elements[1].j = 4; }, "e1", "node of it is missing"},
    {"section", [](T_FRAME& f) { f.elements[2].section = 7; }, "e2", "section"},
    {"E", [](T_FRAME& f) { f.materials[0].E = 0; }, "e0", "modulus E"},
    {"G", [](T_FRAME& f) { f.materials[0].G = 0; }, "e0", "torsion"},
    {"area", [](T_FRAME& f) { f.sections[0].A = -1; }, "e0", "area A"},
    {"one node", [](T_FRAME& f) { f.elements[0].j = 0; }, "e0", "same node"},
    {"length", [](T_FRAME& f) { f.nodes[1].xyz = {0, 0, 0}; }, "e0", "zero length"},
    {"offset takes the length", [](T_FRAME& f) { f.elements[1].offsetI = {5, 0, 0}; },
     "e1", "zero length"},
    {"offset of a truss",
     [](T_FRAME& f) { Join(f, ELEMENT_KIND::Truss, 0, 2); f.elements[3].offsetI = {1, 0, 0}; },
     "e3", "belong to beams"},
    {"link", [](T_FRAME& f) { Join(f, ELEMENT_KIND::Link, 0, 2, {1, -1, 0, 0, 0, 0}); },
     "e3", "stiffness is negative"},
    {"twice", [](T_FRAME& f) { Join(f, ELEMENT_KIND::Beam, 2, 1); }, "e3", "another element"},
    {"diaphragm", [](T_FRAME& f) { f.diaphragms.push_back({{1, 4}, 2}); }, "", "diaphragm"},
    {"equal", [](T_FRAME& f) { f.equalDisplacements.push_back({{9}, {}}); }, "", "equal"},
    {"torsion released twice",
     [](T_FRAME& f) { f.elements[1].releaseI[3] = f.elements[1].releaseJ[3] = true; },
     "e1", "about local x", kFree},
    {"shear released twice",
     [](T_FRAME& f) { f.elements[1].releaseI[2] = f.elements[1].releaseJ[2] = true; },
     "e1", "along local z", kFree},
    {"free foot", [](T_FRAME& f) { f.nodes[0].fixed = f.nodes[3].fixed = {}; },
     "", "free to", kFree},
    {"released end at a loose node",
     [](T_FRAME& f) { Fix(f, AddNode(f, {9, 0, 3}), {0, 1, 2, 3, 5});
                      Join(f, ELEMENT_KIND::Beam, 2, 4);
                      f.elements[3].releaseJ[4] = true; },
     "n4", "", kFree},
};
// clang-format on

TEST(FrameRefusals, RefusesModelsAndNamesThePlace)
{
    for (const T_REFUSED_MODEL& c : kModels) {
        SCOPED_TRACE(c.label);
        T_FRAME frame = Portal();
        c.spoil(frame);
        CFrameSolver frameSolver;
        T_SOLVER_ERROR error;
        EXPECT_FALSE(frameSolver.Prepare(frame, error));
        EXPECT_EQ(c.fault, error.fault);
        if (*c.place || c.fault != kFree) {
            EXPECT_EQ(c.place, Place(error));
        }
        EXPECT_NE(std::string::npos, error.reason.Text().find(c.reason)) << error.reason.Text();
        std::vector<T_RESULT> out;
        EXPECT_FALSE(frameSolver.Solve(std::vector<T_LOAD_CASE>(1), out, error));
    }
}

struct T_REFUSED_CASE {
    const char* label;
    std::function<void(T_LOAD_CASE&)> spoil;
    const char* place;
    const char* reason; // part of it
};

constexpr auto kPoint = BEAM_LOAD::Point;
constexpr auto kLine = BEAM_LOAD::Distributed;

// The portal with a truss (3) between nodes 0 and 2, a link (4) 1 - 2, a truss (5) up to the
// pinned node 4, and a lone node 5.
// clang-format off
const T_REFUSED_CASE kCases[] = {
    {"not a number", [](auto& c) { c.nodal.push_back({1, {kNan}}); }, "c1 n1", "finite"},
    {"lone node", [](auto& c) { c.nodal.push_back({5, {0, 0, 1, 0, 0, 0}}); }, "c1 n5", "in Z"},
    {"moment on trusses", [](auto& c) { c.nodal.push_back({4, {0, 0, 0, 0, 1, 0}}); },
     "c1 n4", "in RY"},
    {"link", [](auto& c) { c.beam.push_back({4}); }, "c1 e4", "link"},
    {"direction", [](auto& c) { c.beam.push_back({0, kPoint, true, 3}); }, "c1 e0", "direction"},
    {"beyond J", [](auto& c) { c.beam.push_back({0, kPoint, true, 1, {1, 0}, {1.1, 2}}); },
     "c1 e0", "outside"},
    {"backwards", [](auto& c) { c.beam.push_back({0, kLine, true, 1, {1, 0}, {0.5, 0.5}}); },
     "c1 e0", "ends where"},
    {"truss, local", [](auto& c) { c.beam.push_back({3, kPoint, true, 1}); }, "c1 e3", "local"},
    {"truss, moment", [](auto& c) { c.beam.push_back({3, BEAM_LOAD::Moment, false, 1}); },
     "c1 e3", "moment"},
    {"warm link", [](auto& c) { c.temperature.push_back({4, 1}); }, "c1 e4", "temperature"},
    {"settlement, free", [](auto& c) { c.settlement.push_back({1, {0, 1}}); },
     "c1 n1", "in Y, which is not restrained"},
    {"settlement against equal displacements",
     [](auto& c) { c.settlement.push_back({0, {0, 0.01}}); },
     "c1 n3", "forbid"},
};
// clang-format on

TEST(FrameRefusals, RefusesLoadsAndNamesThePlace)
{
    T_FRAME frame = Portal();
    frame.equalDisplacements.push_back({{0, 3}, {false, true, false, false, false, false}});
    Join(frame, ELEMENT_KIND::Truss, 0, 2);
    Join(frame, ELEMENT_KIND::Link, 1, 2, {1, 1, 1, 0, 0, 0});
    Fix(frame, AddNode(frame, {5, 0, 9}), {0, 1, 2});
    Join(frame, ELEMENT_KIND::Truss, 2, 4);
    AddNode(frame, {9, 9, 9});
    CFrameSolver frameSolver;
    T_SOLVER_ERROR error;
    ASSERT_TRUE(frameSolver.Prepare(frame, error)) << error.reason.Text();
    for (const T_REFUSED_CASE& c : kCases) {
        SCOPED_TRACE(c.label);
        std::vector<T_LOAD_CASE> cases(2);
        c.spoil(cases[1]);
        std::vector<T_RESULT> out(1);
        error = {};
        EXPECT_FALSE(frameSolver.Solve(cases, out, error));
        EXPECT_TRUE(out.empty());
        EXPECT_EQ(SOLVER_FAULT::BadModel, error.fault);
        EXPECT_EQ(c.place, Place(error));
        EXPECT_NE(std::string::npos, error.reason.Text().find(c.reason)) << error.reason.Text();
    }
    std::vector<T_RESULT> out;
    EXPECT_TRUE(frameSolver.Solve(std::vector<T_LOAD_CASE>(1), out, error)) << "still usable";
}

} // namespace
