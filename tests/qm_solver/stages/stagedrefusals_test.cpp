// What the staged analysis refuses, with the stage and the place that is at fault.
#include "numbers.h"
#include "staged.h"

#include <functional>

namespace {

using namespace sample;

struct T_STAGED_INPUT {
    T_STAGED_MODEL model;
    std::vector<T_LOAD_CASE> cases;
};

/// A cantilever of two beams with a tie that comes in the second stage; a weight and a push.
T_STAGED_INPUT Good()
{
    T_STAGED_INPUT in;
    T_FRAME& frame = in.model.frame;
    frame = Empty();
    for (const T_VEC3 at : {T_VEC3{0, 0, 0}, {4, 0, 0}, {8, 0, 0}, {0, 0, 6}})
        AddNode(frame, at);
    FixAll(frame, 0);
    Fix(frame, 3, {0, 1, 2});
    Join(frame, ELEMENT_KIND::Beam, 0, 1);
    Join(frame, ELEMENT_KIND::Beam, 1, 2);
    Join(frame, ELEMENT_KIND::Truss, 3, 2);
    in.model.groups = {LOAD_GROUP::Dead, LOAD_GROUP::Rest};
    in.model.stages.resize(2);
    in.model.stages[0].activateElements = {0};
    in.model.stages[0].activateSupports = {{0, {}}};
    in.model.stages[0].activateLoads = {{0, 1}};
    in.model.stages[1].activateElements = {1, 2};
    in.model.stages[1].activateSupports = {{3, {}}};
    in.model.stages[1].activateLoads = {{1, 2}};
    in.model.stages[1].steps = 2;
    in.cases.resize(2);
    in.cases[0].nodal.push_back({1, {0, 0, -1, 0, 0, 0}});
    in.cases[1].pretension.push_back({2, 10.0});
    return in;
}

struct T_REFUSED_STAGES {
    const char* label;
    std::function<void(T_STAGED_INPUT&)> spoil;
    const char* place;  // as Place writes it
    const char* reason; // part of it
    SOLVER_FAULT fault = SOLVER_FAULT::BadModel;
};

constexpr T_DIRS6 kAll{true, true, true, true, true, true};
using T_IN = T_STAGED_INPUT;

T_STAGE& S(T_IN& in, std::size_t stage)
{
    return in.model.stages[stage];
}

// clang-format off
const T_REFUSED_STAGES kRefused[] = {
    {"no stages", [](T_IN& in) { in.model.stages.clear(); }, "", "no construction stages"},
    {"steps", [](T_IN& in) { S(in, 1).steps = 0; }, "s1", "no steps"},
    {"nothing stands", [](T_IN& in) { S(in, 0).activateElements.clear(); },
     "s0", "no element is active"},
    {"born twice", [](T_IN& in) { S(in, 1).activateElements.push_back(0); },
     "s1 e0", "second time"},
    {"leaves unborn", [](T_IN& in) { S(in, 0).deactivateElements = {2}; },
     "s0 e2", "before it is born"},
    {"missing element", [](T_IN& in) { S(in, 1).activateElements = {3}; }, "s1 e3", "missing"},
    {"support of nothing", [](T_IN& in) { S(in, 1).activateSupports = {{2, {}}}; },
     "s1 n2", "holds no direction"},
    {"support twice", [](T_IN& in) { S(in, 1).activateSupports = {{0, {}}}; },
     "s1 n0", "there already"},
    {"support not there", [](T_IN& in) { S(in, 1).deactivateSupports = {{1, {}}}; },
     "s1 n1", "not there"},
    {"missing step", [](T_IN& in) { S(in, 1).activateLoads[0].step = 3; },
     "s1 c1", "step 3 does not exist"},
    {"missing case", [](T_IN& in) { S(in, 1).activateLoads[0].loadCase = 2; },
     "s1 c2", "load case is missing"},
    {"load twice", [](T_IN& in) { S(in, 1).activateLoads[0].loadCase = 0; },
     "s1 c0", "acts already"},
    {"load not there", [](T_IN& in) { S(in, 0).deactivateLoads = {{1, 1}}; },
     "s0 c1", "does not act"},
    {"groups", [](T_IN& in) { in.cases.pop_back(); }, "", "group"},
    {"load unborn", [](T_IN& in) { in.cases[0].beam.push_back({1, {}, true, 2, {1, 1}, {0, 1}}); },
     "s0 c0 e1", "not active"},
    {"tension unborn", [](T_IN& in) {
        S(in, 0).activateLoads = {{1, 1}}; S(in, 1).activateLoads.clear();
     }, "s0 c1 e2", "not active"},
    {"node unborn", [](T_IN& in) { in.cases[0].nodal[0].node = 2; },
     "s0 c0 n2", "no element joins"},
    {"settlement unheld", [](T_IN& in) {
        in.cases[0].settlement.push_back({3, {0, 0, 1, 0, 0, 0}});
     }, "s0 c0 n3", "not restrained"},
    {"left under load", [](T_IN& in) {
        in.cases[1].beam.push_back({0, {}, true, 2, {1, 1}, {0, 1}});
        in.model.stages.push_back({}); S(in, 2).deactivateElements = {0};
        S(in, 2).activateSupports = {{1, kAll}};
     }, "s2 c1 e0", "not active"},
    {"mechanism", [](T_IN& in) {
        in.model.stages.push_back({}); S(in, 2).deactivateSupports = {{0, {}}};
     }, "s2 n0", "free to", SOLVER_FAULT::Mechanism},
};
// clang-format on

TEST(StagedRefusals, NameTheStageAndThePlace)
{
    for (const T_REFUSED_STAGES& row : kRefused) {
        T_STAGED_INPUT in = Good();
        row.spoil(in);
        CStagedSolver staged;
        T_SOLVER_ERROR error;
        EXPECT_FALSE(staged.Prepare(in.model, error) && staged.Run(in.cases, error)) << row.label;
        EXPECT_EQ(row.fault, error.fault) << row.label;
        EXPECT_EQ(row.place, Place(error)) << row.label;
        EXPECT_NE(std::string::npos, error.reason.Text().find(row.reason))
            << row.label << ": " << error.reason.Text();
        T_RESULT r;
        EXPECT_FALSE(staged.ReadSum(0, 1, STAGE_SUM::All, r)) << row.label;
    }
}

TEST(StagedRefusals, TheInputThatTheySpoilIsGood)
{
    const T_STAGED_INPUT in = Good();
    CStagedSolver staged;
    Build(staged, in.model, in.cases);
    EXPECT_GT(Case(staged, 1, 1).force[2][0][0], 0.0);
}

TEST(StagedRefusals, ALoadMayLeaveWithItsElement)
{
    T_STAGED_INPUT in = Good();
    in.cases[1].beam.push_back({1, BEAM_LOAD::Distributed, true, 2, {1, 1}, {0, 1}});
    in.model.stages.push_back({});
    S(in, 2).deactivateElements = {1, 2};
    S(in, 2).deactivateLoads = {{1, kFirstStep}};
    CStagedSolver staged;
    Build(staged, in.model, in.cases);
    EXPECT_NEAR(0, Case(staged, 2, 1).displacement[1][2], 1e-15);
}

} // namespace
